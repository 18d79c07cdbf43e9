// Fake host objects for the global state tests, and a fixture that installs them.
//
// Every fake writes what it is asked into one event log, so a test sees the order in which
// the library called the host. The fixture registers the fakes in the capabilities table
// (category 3, index 0), the channel manager's creator in the factory, the main window
// handler and an empty registry, and builds the global state table afresh; it takes them all
// away again afterwards.
#pragma once

#include <gtest/gtest.h>

#include <boost/any.hpp>
#include <boost/make_shared.hpp>

#include <stdexcept>
#include <string>
#include <vector>

#include "globalstate/global_state_table.h"
#include "lumen/globalstate/global_state.h"
#include "lumen/platform/main_window.h"
#include "lumen/platform/registry.h"
#include "lumen/util/factory.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

namespace LumenUtility::testutil {

using EventLog = std::vector<std::wstring>;

// The log of the running test.
inline EventLog& Events() {
  static EventLog events;
  return events;
}

class FakeHardwareCaps final : public INAHardwareCaps {
 public:
  bool CanStoreReference() override { return canStoreReference; }
  bool HasIndexLine() override { return hasIndexLine; }

  bool canStoreReference = true;
  bool hasIndexLine = true;
};

// Logs "hardware External" or "hardware Internal", and what the table holds at that moment.
class FakeHardwareControl final : public HWControl {
 public:
  bool IsExternalReference() override { return external; }
  void SetExternalReference(bool toExternal) override {
    Events().push_back(std::wstring(L"hardware ") + (toExternal ? L"External" : L"Internal") +
                       L", stored " + GlobalState::GetExternalReference());
    if (refuse) throw std::runtime_error("reference unlocked");
    external = toExternal;
  }

  bool external = false;
  bool refuse = false;
};

class FakeCore final : public LumenApp::ILumenCore {
 public:
  void OnGlobalStateChanged() override {
    Events().push_back(L"core");
    if (refuse) throw std::runtime_error("core busy");
  }

  bool refuse = false;
};

class FakeSelectedDevices final : public Interface::ISelectedExternalDevices {
 public:
  std::vector<std::wstring> GetSelectedDevices(int kind) override {
    Events().push_back(L"devices of kind " + std::to_wstring(kind));
    return devices;
  }

  std::vector<std::wstring> devices;
};

// Tokens count up from 1, so that a test can match each end to its begin.
class FakeChannelManager final : public IChannelManager {
 public:
  int BeginChange() override {
    Events().push_back(L"begin change " + std::to_wstring(++m_lastToken));
    return m_lastToken;
  }
  void EndChange(int token) override {
    Events().push_back(L"end change " + std::to_wstring(token));
  }

 private:
  int m_lastToken = 0;
};

// The one channel manager of the test process: the library keeps the first it is given.
inline const boost::shared_ptr<IChannelManager>& ProcessChannelManager() {
  static const boost::shared_ptr<IChannelManager> manager =
      boost::make_shared<FakeChannelManager>();
  return manager;
}

inline void RegisterChannelManagerCreator() {
  CreateFactory()->Register(L"CHANNELS_MANAGER",
                            [] { return boost::any(ProcessChannelManager()); });
}

class GlobalStateFixture : public ::testing::Test {
 protected:
  void SetUp() override {
    Events().clear();
    RegisterHostObject<INAHardwareCaps>(kHostCategoryApplication, 0, &caps);
    RegisterHostObject<HWControl>(kHostCategoryApplication, 0, &hardware);
    RegisterHostObject<LumenApp::ILumenCore>(kHostCategoryApplication, 0, &core);
    RegisterHostObject<Interface::ISelectedExternalDevices>(kHostCategoryApplication, 0, &devices);
    RegisterChannelManagerCreator();
    SetMainWindowHandler([](std::uint32_t message, std::uintptr_t wParam,
                            std::intptr_t lParam) -> std::intptr_t {
      Events().push_back(L"window message " + std::to_wstring(message) + L" " +
                         std::to_wstring(wParam) + L" " + std::to_wstring(lParam));
      return 0;
    });
    SetRegistryStore(RegistryStore());
    Restart();
  }

  void TearDown() override {
    RemoveHostObject<INAHardwareCaps>(kHostCategoryApplication, &caps);
    RemoveHostObject<HWControl>(kHostCategoryApplication, &hardware);
    RemoveHostObject<LumenApp::ILumenCore>(kHostCategoryApplication, &core);
    RemoveHostObject<Interface::ISelectedExternalDevices>(kHostCategoryApplication, &devices);
    SetMainWindowHandler(nullptr);
    SetRegistryStore(RegistryStore());
  }

  // Builds the table again as at start-up, with the fakes as they are now, and clears the log.
  static void Restart() {
    GlobalStateTable::Restart();
    Events().clear();
  }

  static const std::wstring* Stored(const std::wstring& key) {
    return GlobalStateTable::Instance().Find(key);
  }

  FakeHardwareCaps caps;
  FakeHardwareControl hardware;
  FakeCore core;
  FakeSelectedDevices devices;
};

// The HRESULT that `action` throws, or 0.
template <class Action>
HRESULT ThrownCode(Action action) {
  try {
    action();
  } catch (HRESULT code) {
    return code;
  }
  return 0;
}

}  // namespace LumenUtility::testutil
