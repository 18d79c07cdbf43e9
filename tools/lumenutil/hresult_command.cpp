#include <cstdint>
#include <cstdio>
#include <iostream>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "lumen/util.h"
#include "lumenutil/commands.h"
#include "lumenutil/hresult_code.h"

namespace lumenutil {
namespace {

// One line per code: the code in hexadecimal, then its error number. Codes that cannot be
// read are reported on stderr; the others are still printed, and the exit status is 1.
void PrintErrorNumbers(const std::vector<std::string>& texts) {
  bool allRead = true;
  for (const std::string& text : texts) {
    const std::optional<std::int32_t> code = ParseHResultCode(text);
    if (!code) {
      std::cerr << "lumenutil hresult: not a 32-bit code: '" << text << "'\n";
      allRead = false;
      continue;
    }
    char hex[16];
    std::snprintf(hex, sizeof hex, "0x%08X", static_cast<std::uint32_t>(*code));
    std::cout << hex << ' ' << FromHRESULT(*code) << '\n';
  }
  if (!allRead) throw CLI::RuntimeError(1);
}

}  // namespace

void AddHResultCommand(CLI::App& app) {
  CLI::App* command = app.add_subcommand(
      "hresult", "Print the error number of each error code (-200 for codes without one)");
  auto texts = std::make_shared<std::vector<std::string>>();
  command->add_option("CODE", *texts, "code in hexadecimal (0xE8080882) or decimal")->required();
  command->callback([texts] { PrintErrorNumbers(*texts); });
}

}  // namespace lumenutil
