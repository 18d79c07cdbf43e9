// Measurement data containers and files: error-term names, Touchstone traces, their reader
// and writer.
#pragma once

#include "lumen/data/eterm_names.h"
#include "lumen/data/sn_parameter.h"
#include "lumen/data/sn_parameter_s.h"
#include "lumen/data/snp_file_base.h"
#include "lumen/data/snp_types.h"
#include "lumen/data/touchstone_writer.h"
