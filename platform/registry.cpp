#include "lumen/platform/registry.h"

#include "platform/registry_ini_reader.h"

namespace LumenUtility {

namespace {

RegistryStore& ProcessStore() {
  static RegistryStore store;
  return store;
}

}  // namespace

void SetRegistryConfigurationFile(const std::wstring& path) {
  ProcessStore() = RegistryIniReader::ReadFile(path);
}

void SetRegistryStore(RegistryStore store) {
  ProcessStore() = std::move(store);
}

const RegistryStore& GetRegistryStore() {
  return ProcessStore();
}

}  // namespace LumenUtility
