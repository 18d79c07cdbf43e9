#include "lumen/platform/debug_output.h"

#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <string>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

std::atomic<IDebugOutputSink*> installedSink{nullptr};

void WriteToStandardError(const wchar_t* text) {
  const std::string utf8 = WideToUtf8(text);
  std::size_t written = 0;
  while (written < utf8.size()) {
    const ssize_t n = ::write(STDERR_FILENO, utf8.data() + written, utf8.size() - written);
    if (n < 0 && errno == EINTR) continue;
    if (n <= 0) return;
    written += static_cast<std::size_t>(n);
  }
}

}  // namespace

void SetDebugOutputSink(IDebugOutputSink* sink) {
  installedSink.store(sink, std::memory_order_release);
}

void OutputDebugStringW(const wchar_t* text) {
  if (text == nullptr) return;
  IDebugOutputSink* const sink = installedSink.load(std::memory_order_acquire);
  if (sink != nullptr) {
    sink->Output(text);
  } else {
    WriteToStandardError(text);
  }
}

}  // namespace LumenUtility
