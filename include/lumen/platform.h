// Platform base: result codes, the library exception and text conversions.
#pragma once

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/text_conversion.h"
#include "lumen/platform/archive.h"
#include "lumen/platform/file.h"
#include "lumen/platform/com_variant.h"
#include "lumen/platform/ole_exception.h"
