/// @file
/// Stimulus arrays: segments and the InputArray built from them.
///
/// An InputArray is the stimulus of a sweep (frequencies in Hz, powers in dBm or times in
/// seconds), an ordered list of Segments read as one array of doubles. Segments store Linear and
/// Log runs by their ends and count, Fixed runs by one value, and Arbitrary points as a list; the
/// array is a copy-on-write value. Archive (lumen/stimulus/archive.h) and the packed records
/// (SaveData, RecallData) are the saved forms. Index errors throw LumenException(E_FAIL) naming
/// the argument ("index", "segIndex", "count"); malformed saved forms throw LumenException
/// 0xE8080882 and leave the array as it was.
///
/// @code
/// LumenUtility::InputArray sweep(1e9, 2e9, 11, LumenUtility::Linear);  // 1 to 2 GHz
/// sweep.push_back(LumenUtility::Segment(2e9, 8e9, 3, LumenUtility::Log));  // 2, 4, 8 GHz
/// double f = sweep[12];                                               // 4e9
/// unsigned n = sweep.size();                                          // 14
/// @endcode
#pragma once

#include "lumen/stimulus/input_array.h"
#include "lumen/stimulus/segment.h"
#include "lumen/stimulus/archive.h"
