/// @file
/// Interpolation: resampling of real and complex data from one stimulus array onto another.
///
/// Linear and logarithmic interpolation of real and complex traces, circular interpolation of
/// complex data along arcs in the complex plane (with forms that extrapolate or keep to bands),
/// and a block-oriented resampler built on vector kernels. Every routine returns a
/// tagInterpStatus: INTERP_DONE (0) or INTERP_UNCHANGED (1) on success, INTERP_OUT_OF_RANGE (-2)
/// or INTERP_NOT_MONOTONIC (-1), with nothing written, when the stimuli do not allow it.
///
/// @code
/// const LumenUtility::InputArray measured(1e9, 5e9, 5, LumenUtility::Linear);
/// const LumenUtility::InputArray wanted(1e9, 5e9, 9, LumenUtility::Linear);
/// const std::vector<double> gainDb = {10, 12, 13, 12, 10};
/// std::vector<double> resampled;
/// if (LumenUtility::LinearInterpolation(measured, wanted, gainDb, resampled) ==
///     LumenUtility::INTERP_DONE) {
///   // resampled[1] is 11.0, the value at 1.5 GHz
/// }
/// @endcode
#pragma once

#include "lumen/interpolation/circular_interpolation.h"
#include "lumen/interpolation/interp_status.h"
#include "lumen/interpolation/linear_interpolation.h"
#include "lumen/interpolation/tarn_interpolation.h"
