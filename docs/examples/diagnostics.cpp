// Diagnostics: the switchable debug print on standard error, and TPrint events recorded by a
// trace session.
// guide:begin
#include <cstdio>

#include "lumen/diagnostics.h"
#include "lumen/platform.h"

using namespace LumenUtility;

struct StdoutConsole final : ConsoleDPrint {  // the host's console device
  void Print(const wchar_t* text) override { std::printf("console: %ls", text); }
};

int main() {
  StdoutConsole console;
  gDebugPrint.SetConsolePrintDevice(&console);
  gDebugPrint.SetDeviceOn(CDebugPrint::Debugger, false);
  gDebugPrint.SetDeviceOn(CDebugPrint::Console, true);
  dprint(DebugPrintGeneral, L"not shown: locked out\n");
  gDebugPrint.Lockout(false);
  dprint(DebugPrintGeneral, L"not shown: slot off\n");
  gDebugPrint.SetOn(DebugPrintGeneral, true);
  dprint(DebugPrintGeneral, L"sweep of %d points\n", 201);

  MemoryTraceSink sink;
  TraceSession session(ETWProviderId(), 0, 0, 0, sink);  // every level and keyword
  ETWInit();
  EnableTPrint(true);
  TPrint(3, 42);  // an event of the catalogue with a 4-byte value
  TPrint(9);      // no event has id 9: nothing is written
  session.Stop();
  for (const TraceRecord& r : sink.Records()) {
    const TraceEventInfo* info = ETWManifest().Find(r.descriptor.Id);
    std::printf("event %u (%s), %zu payload item(s)\n", r.descriptor.Id,
                info ? info->name.c_str() : "?", r.items.size());
  }
  ETWReset();
  gDebugPrint.SetConsolePrintDevice(nullptr);
}
// guide:end
