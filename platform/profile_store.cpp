#include "lumen/platform/profile_store.h"

#include <atomic>

#include "lumen/platform/ini_profile_store.h"

namespace LumenUtility {
namespace {

std::atomic<IProfileStore*> installedStore{nullptr};

}  // namespace

void SetProfileStore(IProfileStore* store) {
  installedStore.store(store, std::memory_order_release);
}

IProfileStore& ProfileStore() {
  IProfileStore* const store = installedStore.load(std::memory_order_acquire);
  return store != nullptr ? *store : DefaultProfileStore();
}

IniProfileStore& DefaultProfileStore() {
  static IniProfileStore store;
  return store;
}

}  // namespace LumenUtility
