// Global instrument state: the process-wide settings and the typed values of acquisition
// parameters they are applied through.
#pragma once

#include "lumen/globalstate/global_state.h"
#include "lumen/globalstate/gp_array.h"
#include "lumen/globalstate/gp_ref.h"
#include "lumen/globalstate/gp_scalar.h"
#include "lumen/platform/rigel.h"
