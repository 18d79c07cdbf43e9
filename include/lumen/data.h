/// @file
/// Measurement data containers and files: named sample buffers and their matrix, error-term
/// names, Touchstone traces, their reader and writer, CSV files.
///
/// CSnPFileBase reads a Touchstone file (version 1 or 2.0) into one trace per matrix position and
/// carries the traces onto other stimulus points; TouchstoneWriter writes them back. A failed
/// read returns -1, leaves the object as it was and explains itself in GetReadError as
/// "line N: ...". CCSVFile reads and writes CSV fields and reports through statuses; DataMatrix
/// and NamedBuffer hold S-parameter buffers by port pair, alias or name.
///
/// @code
/// CSnPFileBase file(2);
/// if (file.ReadSNPFile(L"dut.s2p") < 0) {
///   std::wcerr << file.GetReadError() << L"\n";  // e.g. "line 7: 'x' is not a number ..."
/// } else {
///   file.InterpolateReadSNPFile(LumenUtility::InputArray(2.3e9, 2.5e9, 5, LumenUtility::Linear),
///                               false);
///   double dB = file.GetParam(SNP_S21).GetData()[0].LogMag();
/// }
/// @endcode
#pragma once

#include "lumen/data/csv_file.h"
#include "lumen/data/data_matrix.h"
#include "lumen/data/eterm_names.h"
#include "lumen/data/named_buffer.h"
#include "lumen/data/sn_parameter.h"
#include "lumen/data/sn_parameter_s.h"
#include "lumen/data/snp_file_base.h"
#include "lumen/data/snp_trace_names.h"
#include "lumen/data/snp_types.h"
#include "lumen/data/touchstone_writer.h"
