// Platform base: result codes, the library exception and text conversions.
#pragma once

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/text_conversion.h"
#include "lumen/platform/archive.h"
#include "lumen/platform/file.h"
#include "lumen/platform/main_window.h"
#include "lumen/platform/registry.h"
#include "lumen/platform/rigel.h"
