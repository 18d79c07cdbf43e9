// Stimulus arrays: segments and the InputArray built from them.
#pragma once

#include "lumen/stimulus/input_array.h"
#include "lumen/stimulus/segment.h"
#include "lumen/stimulus/archive.h"
