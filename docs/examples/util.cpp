// General utilities: pattern string mapping, error numbers of error codes, and a ZIP archive
// packed and extracted.
// guide:begin
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <string>
#include <vector>

#include "lumen/platform.h"
#include "lumen/util.h"

using namespace LumenUtility;

int main() {
  StringMapper mapper({{LocalRegex(L"Ch([0-9]+)_Tr([0-9]+)"), L"Channel $1, trace $2"}});
  std::printf("%ls\n", mapper.GetMapping(L"Ch2_Tr5").c_str());
  std::printf("0xE8060651 -> %d, 0x12345678 -> %d\n", FromHRESULT(MakeHResult(0xE8060651)),
              FromHRESULT(0x12345678));

  char scratch[] = "/tmp/lumen_guide_XXXXXX";
  if (mkdtemp(scratch) == nullptr) return 1;
  const std::wstring dir = Utf8ToWide(scratch);
  std::ofstream(std::string(scratch) + "/passband.txt") << "S21 passband\n";
  std::vector<std::wstring> extracted;
  const bool packed = ZlibUtil::DoZip(dir, {L"passband.txt"}, dir + L"/sweep.zip");
  const bool unpacked = ZlibUtil::DoUnzip(dir + L"/sweep.zip", dir + L"/out", &extracted);
  std::printf("packed %d, extracted %d: %ls\n", packed, unpacked, extracted.at(0).c_str());
  std::printf("missing archive: %d\n", ZlibUtil::DoUnzip(dir + L"/none.zip", dir, nullptr));
  std::filesystem::remove_all(scratch);
}
// guide:end
