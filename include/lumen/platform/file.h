/// @file
/// File stand-ins: CFile (buffered disk file), CMemFile (memory), CStdioFile (lines of text)
/// and the CFileException they throw.
#pragma once

#include "lumen/platform/cfile.h"
#include "lumen/platform/file_exception.h"
#include "lumen/platform/mem_file.h"
#include "lumen/platform/stdio_file.h"
