// Measurement data containers and files: error-term names.
#pragma once

#include "lumen/data/eterm_names.h"
