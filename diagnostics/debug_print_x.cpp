#include <string>

#include "diagnostics/debug_print_format.h"
#include "lumen/diagnostics/debug_print.h"

void dprint(std::int32_t slot, const wchar_t* format, ...) {
  if (!gDebugPrint.ShouldPrint(slot)) return;
  va_list args;
  va_start(args, format);
  try {
    gDebugPrint.Print(slot, format, args);
  } catch (...) {
    va_end(args);
    throw;
  }
  va_end(args);
}

void CDebugPrintX::Print(std::int32_t slot, const wchar_t* format, va_list args) const {
  if (file == nullptr || format == nullptr) {
    gDebugPrint.Print(slot, format, args);
    return;
  }
  gDebugPrint.Print(slot, LumenUtility::TaggedFormat(file, line, format).c_str(), args);
}

void CDebugPrintX::operator()(std::int32_t slot, const wchar_t* format, ...) const {
  if (!gDebugPrint.ShouldPrint(slot)) return;
  va_list args;
  va_start(args, format);
  try {
    Print(slot, format, args);
  } catch (...) {
    va_end(args);
    throw;
  }
  va_end(args);
}

void CDebugPrintX::operator()(DebugPrintID id, const wchar_t* format, ...) const {
  if (!gDebugPrint.ShouldPrint(id)) return;
  va_list args;
  va_start(args, format);
  try {
    Print(id, format, args);
  } catch (...) {
    va_end(args);
    throw;
  }
  va_end(args);
}
