// Interpolation: resampling of real and complex traces from one stimulus onto another.
#pragma once

#include "lumen/interpolation/tarn_interpolation.h"
