/// @file
/// Phase-coherent acquisition: receivers and ratio parameters, phase stitching across band
/// breaks, the component that collects, averages and streams the data of a sweep, and the
/// external phase reference device with its calibration (PRN) file.
///
/// The measurement engine registers PAParameters with a PAComponent, starts each sweep with
/// SetSweepParameters and hands every raw receiver buffer to PutData; the component forms the
/// ratios through the host's test set (an ITestSet host object), averages blocks of samples and
/// keeps the values for a consumer thread or streams them to the host's FIFO. Without a test set
/// PutData throws LumenException(E_POINTER) and consumes nothing.
///
/// @code
/// PAComponent component;
/// const PAParameter b2OverA1(2, false, 1, true, 0, true);  // test receiver 2 / port 1 reference
/// component.AddParameter(b2OverA1);
/// component.SetSweepParameters(3, false, 2);  // 3 points, 2 samples averaged per point
/// component.PutData(buffer.data(), 1, static_cast<int>(buffer.size()), false, false);
/// int ready = component.GetAvailableDataCount(b2OverA1);
/// @endcode
#pragma once

#include "lumen/phase/pa_component.h"
#include "lumen/phase/pa_parameter.h"
#include "lumen/phase/pa_parameter_record.h"
#include "lumen/phase/pa_receiver.h"
#include "lumen/phase/phase_reference.h"
#include "lumen/phase/prn_reader.h"
#include "lumen/phase/stitch_phase.h"
