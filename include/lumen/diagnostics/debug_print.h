/// @file
/// Debug print: switchable diagnostic messages, printf-style, in 256 numbered slots (topics).
///
/// A message is printed only when the facility is not locked out and its slot is on; it then
/// goes to each output device that is on, in this order: the debugger output
/// (LumenUtility::OutputDebugStringW), a UTF-8 text file ("dprint.txt" unless named), and a
/// console object the host supplies. The facility starts locked out with every slot off and
/// only the debugger device on; the host unlocks it with gDebugPrint.Lockout(false). Slot and
/// file settings persist in the host's profile, section "Debug".
///
///   dprint(DebugPrintPhaseReference, L"model %ls, divide %d\n", model.c_str(), divide);
///   CDebugPrintX(__FILE__, __LINE__)(12, L"%d points\n", count);  // "x.cpp (57) 201 points"
///
/// Formats are those of the C library's wide printf: %ls and %lc take wide strings and
/// characters, %s and %c 8-bit (UTF-8) ones. Messages are never cut; no line end is added.
/// Thread-safety: printing may run on any thread while another changes slots, devices or the
/// lockout (the flags are atomic); whole messages reach the file one at a time. Changing the
/// file or console device while others print is allowed; a console device must stay alive
/// while it is set. Ownership: gDebugPrint owns its file; the console device is not owned.
#pragma once

#include <atomic>
#include <cstdarg>
#include <cstdint>
#include <mutex>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/stdio_file.h"

/// Slots of this library's own topics. Any number from 0 to 255 is a slot; these are names
/// for some of them.
enum DebugPrintID : std::int32_t {
  DebugPrintGeneral = 0,
  DebugPrintStimulus = 1,
  DebugPrintInterpolation = 2,
  DebugPrintTouchstone = 3,
  DebugPrintPhaseAcquisition = 4,
  DebugPrintPhaseReference = 5,
  DebugPrintPropertyBag = 6,
  DebugPrintInterprocess = 7,
  DebugPrintDataCapture = 8,
  DebugPrintGlobalState = 9,
  DebugPrintUtility = 10,
};

/// A console output device, implemented by the host. It carries no state of its own.
class LUMEN_API ConsoleDPrint {
 public:
  ConsoleDPrint() = default;
  ///@{
  /// Copies share nothing and print alike.
  ConsoleDPrint(const ConsoleDPrint&) = default;
  ConsoleDPrint& operator=(const ConsoleDPrint&) = default;
  ///@}
  virtual ~ConsoleDPrint() = default;
  /// Shows one message (never null), called on the printing thread.
  virtual void Print(const wchar_t* text) = 0;
};

LUMEN_API void dprint(std::int32_t slot, const wchar_t* format, ...);

/// The debug print facility: lockout, slot switches, output devices and the print file.
/// The process has one instance, gDebugPrint; see the file description for the rules.
class LUMEN_API CDebugPrint {
 public:
  /// Where messages go: the host's console object (SetConsolePrintDevice), the debugger
  /// output stand-in, or the file named by SetFileName.
  enum OutputDevice : int { Console = 0, Debugger = 1, File = 2 };

  /// The start-up state: locked out, every slot off, only the debugger device on, no file
  /// name or directory, no console device. The process's one instance is gDebugPrint.
  CDebugPrint();
  CDebugPrint(const CDebugPrint&) = delete;
  CDebugPrint& operator=(const CDebugPrint&) = delete;

  /// 256.
  std::int32_t GetNumSlots() const { return kNumSlots; }
  /// Switches slot 0 to 255 on or off; other numbers are ignored.
  void SetOn(std::int32_t slot, bool on);
  /// The slot's switch; false for numbers outside 0 to 255.
  bool IsOn(std::int32_t slot) const;

  /// Switches a device. For the file device, switching on opens directory + file name for
  /// writing, created or emptied; switching off closes it. The flag is set even when the file
  /// cannot be opened, and nothing is written to the file until it is opened by a later
  /// switch. Numbers outside the three devices are ignored. Throws CFileException when
  /// closing the file fails (the file is closed and the flag off all the same).
  void SetDeviceOn(OutputDevice device, bool on);
  /// The device's flag; false for numbers outside the three devices.
  bool IsDeviceOn(OutputDevice device) const;

  /// While locked out nothing is printed.
  void Lockout(bool locked) { m_locked.store(locked, std::memory_order_relaxed); }
  /// True while printing is locked out.
  bool IsLocked() const { return m_locked.load(std::memory_order_relaxed); }

  /// The file's directory becomes `path` up to and including its last '/' (nothing when it has
  /// none); the rest of `path` is not used. An empty file name becomes "dprint.txt". When the
  /// file device is on, the file is reopened at the new place. Null counts as empty.
  void SetFilePath(const wchar_t* path);
  /// Names the file within the directory. When the file device is on, the open file is closed
  /// and the named one opened, created or emptied. Null counts as empty.
  void SetFileName(const wchar_t* name);
  /// The file name last set; empty when none is.
  std::wstring GetFileName() const;

  /// Sets the console device, or clears it with null.
  void SetConsolePrintDevice(ConsoleDPrint* device);

  /// Writes the slots ("Debug Print": 256 characters '1' or '0' in slot order), the file name
  /// ("Debug Print Filename") and the file device's flag ("Debug Print File": 1 or 0) to
  /// section "Debug" of the profile (LumenUtility::ProfileStore()). A failing profile is not
  /// reported, as the host's profile functions do not report it.
  void SaveSettings();
  /// Reads the three entries back: slot i is switched on exactly when character i of
  /// "Debug Print" is '1', for the characters there are (slots beyond keep their state); a
  /// non-empty "Debug Print Filename" replaces the file name; "Debug Print File" 0 switches
  /// the file device off, any other value opens the file anew (emptied), also when the device
  /// was on but its file could not be opened before.
  void RecallSettings();

 private:
  friend void dprint(std::int32_t slot, const wchar_t* format, ...);
  friend class CDebugPrintX;

  static constexpr std::int32_t kNumSlots = 256;
  static constexpr int kNumDevices = 3;

  /// The cheap test before any formatting: unlocked, slot in range and on.
  bool ShouldPrint(std::int32_t slot) const {
    return !m_locked.load(std::memory_order_relaxed) &&
           static_cast<std::uint32_t>(slot) < static_cast<std::uint32_t>(kNumSlots) &&
           m_slotOn[slot].load(std::memory_order_relaxed);
  }
  void Print(std::int32_t slot, const wchar_t* format, va_list args);
  void Emit(const wchar_t* text);
  /// Both with m_fileMutex held.
  void OpenFileLocked();
  void SetFileDeviceLocked(bool on);

  std::atomic<bool> m_slotOn[kNumSlots];
  std::atomic<bool> m_deviceOn[kNumDevices];
  std::atomic<bool> m_locked;
  std::wstring m_fileName;
  std::wstring m_fileDirectory;
  CStdioFile m_file;
  std::atomic<ConsoleDPrint*> m_pConsole;
  /// Guards the file, its name and directory; held while a message is written.
  mutable std::mutex m_fileMutex;
};

/// The process's debug print object.
LUMEN_API extern CDebugPrint gDebugPrint;

/// Prints a message to `slot` of gDebugPrint; the arguments are formatted only when it
/// prints. Throws CFileException when writing the file fails.
LUMEN_API void dprint(std::int32_t slot, const wchar_t* format, ...);

/// A call-site tag: messages printed through it start with the source file and line,
/// "file (line) ", when a file is given.
class LUMEN_API CDebugPrintX {
 public:
  CDebugPrintX() : file(nullptr), line(0) {}
  /// `sourceFile` is 8-bit (UTF-8), normally __FILE__; it must outlive the tag.
  CDebugPrintX(const char* sourceFile, int sourceLine) : file(sourceFile), line(sourceLine) {}

  ///@{
  /// As dprint, with the tag before the message. Percent signs in the file name print as
  /// they are; those of `format` keep their meaning.
  void operator()(std::int32_t slot, const wchar_t* format, ...) const;
  void operator()(DebugPrintID id, const wchar_t* format, ...) const;
  ///@}

  /// Source file of the call (`__FILE__`).
  const char* file;
  /// Source line of the call (`__LINE__`).
  int line;

 private:
  void Print(std::int32_t slot, const wchar_t* format, va_list args) const;
};
