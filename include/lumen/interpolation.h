// Interpolation: resampling of real and complex data from one stimulus array onto another.
#pragma once

#include "lumen/interpolation/circular_interpolation.h"
#include "lumen/interpolation/interp_status.h"
#include "lumen/interpolation/linear_interpolation.h"
#include "lumen/interpolation/tarn_interpolation.h"
