/// @file
/// The hardware-interface library's acquisition specification and parameter values.
#pragma once

#include "lumen/platform/rigel/bypass_switch_state.h"
#include "lumen/platform/rigel/command_parameter.h"
#include "lumen/platform/rigel/cp_collection.h"
#include "lumen/platform/rigel/cp_dimension.h"
#include "lumen/platform/rigel/data_acquisition_specification.h"
#include "lumen/platform/rigel/generic_parameter.h"
