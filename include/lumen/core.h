// Complex values and trace formats.
#pragma once

#include "lumen/core/ts_complex.h"
#include "lumen/core/vector_formats.h"
