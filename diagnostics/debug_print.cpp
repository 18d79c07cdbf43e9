#include "lumen/diagnostics/debug_print.h"

#include "diagnostics/debug_print_format.h"
#include "lumen/platform/debug_output.h"

CDebugPrint gDebugPrint;

namespace {

constexpr const wchar_t* kDefaultFileName = L"dprint.txt";

bool IsDevice(CDebugPrint::OutputDevice device) {
  return device >= CDebugPrint::Console && device <= CDebugPrint::File;
}

}  // namespace

CDebugPrint::CDebugPrint() : m_locked(true), m_pConsole(nullptr) {
  for (std::atomic<bool>& slot : m_slotOn) slot.store(false, std::memory_order_relaxed);
  m_deviceOn[Console].store(false, std::memory_order_relaxed);
  m_deviceOn[Debugger].store(true, std::memory_order_relaxed);
  m_deviceOn[File].store(false, std::memory_order_relaxed);
}

void CDebugPrint::SetOn(std::int32_t slot, bool on) {
  if (static_cast<std::uint32_t>(slot) >= static_cast<std::uint32_t>(kNumSlots)) return;
  m_slotOn[slot].store(on, std::memory_order_relaxed);
}

bool CDebugPrint::IsOn(std::int32_t slot) const {
  return static_cast<std::uint32_t>(slot) < static_cast<std::uint32_t>(kNumSlots) &&
         m_slotOn[slot].load(std::memory_order_relaxed);
}

bool CDebugPrint::IsDeviceOn(OutputDevice device) const {
  return IsDevice(device) && m_deviceOn[device].load(std::memory_order_relaxed);
}

void CDebugPrint::OpenFileLocked() {
  const std::wstring path = m_fileDirectory + m_fileName;
  // Creating empties an existing file; a failure leaves the file closed, which Emit skips.
  if (m_file.Open(path.c_str(), CFile::modeCreate | CFile::modeWrite | CFile::shareDenyWrite)) {
    m_file.SeekToEnd();
  }
}

void CDebugPrint::SetFileDeviceLocked(bool on) {
  if (on != m_deviceOn[File].load(std::memory_order_relaxed)) {
    if (on) {
      OpenFileLocked();
    } else {
      // The flag goes first, so that it is off even when closing throws.
      m_deviceOn[File].store(false, std::memory_order_relaxed);
      if (m_file.IsOpen()) m_file.Close();
    }
  }
  m_deviceOn[File].store(on, std::memory_order_relaxed);
}

void CDebugPrint::SetDeviceOn(OutputDevice device, bool on) {
  if (!IsDevice(device)) return;
  if (device == File) {
    const std::lock_guard<std::mutex> lock(m_fileMutex);
    SetFileDeviceLocked(on);
  } else {
    m_deviceOn[device].store(on, std::memory_order_relaxed);
  }
}

void CDebugPrint::SetFilePath(const wchar_t* path) {
  {
    const std::lock_guard<std::mutex> lock(m_fileMutex);
    const std::wstring full = path ? path : L"";
    const std::size_t slash = full.rfind(L'/');
    m_fileDirectory = slash == std::wstring::npos ? std::wstring() : full.substr(0, slash + 1);
    if (m_fileName.empty()) m_fileName = kDefaultFileName;
    m_file.SetFilePath((m_fileDirectory + m_fileName).c_str());
  }
  if (IsDeviceOn(File)) {
    SetDeviceOn(File, false);
    SetDeviceOn(File, true);
  }
}

void CDebugPrint::SetFileName(const wchar_t* name) {
  const std::lock_guard<std::mutex> lock(m_fileMutex);
  const bool deviceOn = m_deviceOn[File].load(std::memory_order_relaxed);
  if (deviceOn && m_file.IsOpen()) m_file.Close();
  m_fileName = name ? name : L"";
  m_file.SetFilePath((m_fileDirectory + m_fileName).c_str());
  if (deviceOn) OpenFileLocked();
}

std::wstring CDebugPrint::GetFileName() const {
  const std::lock_guard<std::mutex> lock(m_fileMutex);
  return m_fileName;
}

void CDebugPrint::SetConsolePrintDevice(ConsoleDPrint* device) {
  m_pConsole.store(device, std::memory_order_release);
}

void CDebugPrint::Print(std::int32_t slot, const wchar_t* format, va_list args) {
  if (!ShouldPrint(slot) || format == nullptr) return;
  wchar_t stack[LumenUtility::kDebugTextStackChars];
  std::wstring heap;
  Emit(LumenUtility::FormatDebugText(stack, heap, format, args));
}

void CDebugPrint::Emit(const wchar_t* text) {
  if (m_deviceOn[Debugger].load(std::memory_order_relaxed)) {
    LumenUtility::OutputDebugStringW(text);
  }
  if (m_deviceOn[File].load(std::memory_order_relaxed)) {
    const std::lock_guard<std::mutex> lock(m_fileMutex);
    if (m_file.IsOpen()) {
      m_file.WriteString(text);
      m_file.Flush();
    }
  }
  if (m_deviceOn[Console].load(std::memory_order_relaxed)) {
    ConsoleDPrint* const console = m_pConsole.load(std::memory_order_acquire);
    if (console != nullptr) console->Print(text);
  }
}
