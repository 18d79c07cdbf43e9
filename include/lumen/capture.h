// Shared-memory data capture: named shared-memory blocks of 32-bit floats, the service that
// fills them with channel data, and the read-only view clients open them with.
#pragma once

#include "lumen/capture/data_capture.h"
#include "lumen/capture/data_request.h"
#include "lumen/capture/file_mapping.h"
#include "lumen/capture/file_mapping_reader.h"
#include "lumen/capture/file_mapping_with_view.h"
#include "lumen/capture/no_copy.h"
