/// @file
/// Shared-memory data capture: named shared-memory blocks of 32-bit floats, the service that
/// fills them with channel data, and the read-only view clients open them with.
///
/// DataCapture takes requests such as "1:2:SDATA:201", commits them under a block name and copies
/// the channel data into the block when the engine finishes a channel; a client opens the block
/// by name with FileMappingReader. The mappings throw a bare HRESULT built from the system error,
/// 0x80070002 when a client opens a block that does not exist.
///
/// @code
/// FileMappingWithView<float> block(L"VNASharedMemory_demo", 4);  // zero when new
/// *block.GetPtr(1) = 0.5f;
/// FileMappingReader client(L"VNASharedMemory_demo");  // as another process would
/// float value = *client.GetPtr(1);                    // 0.5
/// @endcode
#pragma once

#include "lumen/capture/data_capture.h"
#include "lumen/capture/data_request.h"
#include "lumen/capture/file_mapping.h"
#include "lumen/capture/file_mapping_reader.h"
#include "lumen/capture/file_mapping_with_view.h"
#include "lumen/capture/no_copy.h"
