// Shared libraries loaded by their Windows module names: the stand-in for LoadLibraryW and
// GetProcAddress, for drivers that the library reaches by name at run time.
//
// A module name "NAME.dll" stands for the shared object "libNAME.so", found by the dynamic
// loader's normal search (LD_LIBRARY_PATH, the run path, the system directories). Libraries
// are never unloaded: there is no FreeLibrary, so addresses obtained from a loaded library
// stay valid until the process ends.
// Thread-safety: both functions may be called from any thread (the dynamic loader serialises
// them). Ownership: the loader owns every loaded library.
#pragma once

#include <string>
#include <string_view>

#include "lumen/export.h"

namespace LumenUtility {

/// Handle of a loaded shared library; null means "not loaded".
using HMODULE = void*;

/// The shared-object file name for the module name `moduleName`: "Ferrule_rev7.dll" gives
/// "libFerrule_rev7.so". A trailing ".dll" is dropped whatever its case; a name without it
/// keeps its whole text ("Ferrule" gives "libFerrule.so"). A directory part ("drivers/x.dll")
/// is kept in front of the mapped file name. An empty name, or one that ends in '/', gives an
/// empty string.
LUMEN_API std::string SharedObjectFileName(std::wstring_view moduleName);

/// Loads the shared object for `moduleName` (see SharedObjectFileName) with every symbol
/// bound at once and kept local to it. A name without '/' is searched for along the loader's
/// normal search; one with '/' is opened at that path. Returns the library's handle, the same
/// handle on every call for one library, or null when it cannot be found or loaded (also for
/// a null or empty name).
LUMEN_API HMODULE LoadLibraryW(const wchar_t* moduleName);

/// The address of the export `exportName` of `module`, or null when `module` or `exportName`
/// is null or the library has no such export.
LUMEN_API void* GetProcAddress(HMODULE module, const char* exportName);

}  // namespace LumenUtility
