// Measurement data containers and files: named sample buffers and their matrix, error-term
// names, Touchstone traces, their reader and writer, CSV files.
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
