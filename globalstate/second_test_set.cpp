#include "globalstate/second_test_set.h"

#include "globalstate/global_state_names.h"
#include "lumen/platform/registry.h"

namespace LumenUtility {

namespace names = GlobalStateNames;

SecondTestSet SecondTestSet::Read() {
  const RegistryStore& registry = GetRegistryStore();
  SecondTestSet config;
  config.enabled = registry.QueryDword(names::kAnalyzerKey, names::kT2Mode) == 1u;
  const std::uint32_t port = registry.QueryDword(names::kAnalyzerKey, names::kT2ClockPort).value_or(0);
  if (port != 0) config.clockPort = port;
  const std::wstring name = registry.QueryString(names::kAnalyzerKey, names::kT2Name).value_or(L"");
  if (!name.empty()) config.name = name;
  return config;
}

}  // namespace LumenUtility
