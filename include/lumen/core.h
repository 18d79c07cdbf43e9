// Complex values and trace formats.
#pragma once

#include "lumen/core/ts_complex.h"
