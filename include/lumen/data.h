// Measurement data containers and files: error-term names, Touchstone traces and their
// reader, CSV files.
#pragma once

#include "lumen/data/csv_file.h"
#include "lumen/data/eterm_names.h"
#include "lumen/data/sn_parameter.h"
#include "lumen/data/sn_parameter_s.h"
#include "lumen/data/snp_file_base.h"
#include "lumen/data/snp_types.h"
