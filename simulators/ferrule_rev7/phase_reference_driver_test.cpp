// PhaseReference against the simulated driver, loaded for real through the library search.
// Each suite runs in its own process with the search path its outcome needs (see
// simulators/CMakeLists.txt): the driver, the driver without an export, or no driver.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <set>
#include <string>
#include <type_traits>
#include <vector>

#include "lumen/phase/phase_reference.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"
#include "simulators/ferrule_rev7/ferrule_rev7_control.h"

namespace {

using LumenUtility::LUMEN_E_BOUNDS;

class FakeDiagFeatures final : public IDiagFeaturesInterface {
 public:
  bool IsFeatureOn(const std::wstring& name) override {
    asked.push_back(name);
    return on.count(name) != 0;
  }
  std::set<std::wstring> on;
  std::vector<std::wstring> asked;
};

FakeDiagFeatures& Features() {
  static FakeDiagFeatures features;
  return features;
}

void RegisterFeatures(bool simulate) {
  Features() = FakeDiagFeatures();
  if (simulate) Features().on.insert(L"SimulatePhaseRef");
  LumenUtility::RegisterHostObject<IDiagFeaturesInterface>(LumenUtility::kHostCategoryApplication,
                                                           0, &Features());
}

template <class Call>
void ExpectPhaseReferenceError(Call&& call, const std::wstring& message) {
  try {
    call();
    ADD_FAILURE() << "no exception";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), LUMEN_E_BOUNDS);
    EXPECT_EQ(e.GetMessages(), std::vector<std::wstring>{message});
  }
}

// The simulator's control functions, from the library the first PhaseReference loaded.
struct Simulator {
  Simulator() {
    void* module = ::dlopen("libFerrule_rev7.so", RTLD_NOW | RTLD_NOLOAD);
    EXPECT_NE(module, nullptr) << "the driver is not loaded";
    const auto get = [module](const char* name, auto& f) {
      f = reinterpret_cast<std::remove_reference_t<decltype(f)>>(::dlsym(module, name));
      ASSERT_NE(f, nullptr) << name;
    };
    get("ferruleSimReset", reset);
    get("ferruleSimSetDeviceCount", setDeviceCount);
    get("ferruleSimSetModel", setModel);
    get("ferruleSimSetSerialNumber", setSerialNumber);
    get("ferruleSimSetFailure", setFailure);
    get("ferruleSimCallCount", callCount);
    get("ferruleSimDivideRatio", divideRatio);
    get("ferruleSimLastAccess", lastAccess);
  }
  FerruleSimResetFunc reset = nullptr;
  FerruleSimSetDeviceCountFunc setDeviceCount = nullptr;
  FerruleSimSetTextFunc setModel = nullptr;
  FerruleSimSetTextFunc setSerialNumber = nullptr;
  FerruleSimSetFailureFunc setFailure = nullptr;
  FerruleSimCallCountFunc callCount = nullptr;
  FerruleSimDivideRatioFunc divideRatio = nullptr;
  FerruleSimLastAccessFunc lastAccess = nullptr;
};

class PhaseReferenceDriver : public testing::Test {
 protected:
  void SetUp() override {
    RegisterFeatures(false);
    static const PhaseReference first;  // loads the driver
    static Simulator simulator;
    sim = &simulator;
    sim->reset();
    Features().asked.clear();
  }
  PhaseReference reference;
  Simulator* sim = nullptr;
};

TEST_F(PhaseReferenceDriver, IDStringsAreTheSerialNumbersInDeviceOrder) {
  EXPECT_EQ(reference.GetIDStrings(), std::vector<std::wstring>{L"FR7-SIM-0001"});
  sim->setDeviceCount(3);
  sim->setSerialNumber(1, "B-2");
  sim->setSerialNumber(2, "C-\xc3\xa9");  // UTF-8 from the driver, widened
  EXPECT_EQ(reference.GetIDStrings(),
            (std::vector<std::wstring>{L"FR7-SIM-0001", L"B-2", L"C-\u00e9"}));
  sim->setDeviceCount(0);
  EXPECT_TRUE(reference.GetIDStrings().empty());
  EXPECT_EQ(sim->callCount("getSerialNumber"), 1 + 3);
}

TEST_F(PhaseReferenceDriver, ModelIsTheDevicesTextAndEndsWithTheBuffer) {
  sim->setDeviceCount(2);
  sim->setModel(1, "Ferrule 7B");
  EXPECT_EQ(reference.GetModel(1), L"Ferrule 7B");
  // A text of 1200 bytes fills the 1000-byte buffer with no terminating zero.
  sim->setModel(0, std::string(1200, 'x').c_str());
  EXPECT_EQ(reference.GetModel(0), std::wstring(1000, L'x'));
}

TEST_F(PhaseReferenceDriver, SetupStartsTheDeviceWithTheAccessStringAndSetsEachRatio) {
  sim->setDeviceCount(2);
  for (int divide : {1, 2, 4, 8, 16}) {
    reference.SetupReference(1, divide);
    EXPECT_EQ(sim->divideRatio(1), divide);
    EXPECT_EQ(sim->callCount(("makeRatio" + std::to_string(divide)).c_str()), 1);
  }
  EXPECT_STREQ(sim->lastAccess(), "tamarin47261");
  EXPECT_EQ(sim->callCount("startHalcyon"), 5);
  EXPECT_EQ(sim->divideRatio(0), 0);
}

TEST_F(PhaseReferenceDriver, DeviceIsCheckedBeforeStartAndDivideAfterIt) {
  ExpectPhaseReferenceError([&] { reference.SetupReference(1, 1); },
                            L"Selected phase reference is invalid");
  ExpectPhaseReferenceError([&] { reference.SetupReference(-1, 1); },
                            L"Selected phase reference is invalid");
  EXPECT_EQ(sim->callCount("startHalcyon"), 0);
  int starts = 0;
  for (int divide : {3, 32, 0, -4, 5, 15}) {
    ExpectPhaseReferenceError([&] { reference.SetupReference(0, divide); },
                              L"Invalid argument for setting up phase reference.");
    EXPECT_EQ(sim->callCount("startHalcyon"), ++starts) << divide;
  }
  EXPECT_EQ(sim->divideRatio(0), 0);
}

TEST_F(PhaseReferenceDriver, EachFailingCallThrowsItsMessageWithTheDeviceCode) {
  sim->setFailure("startHalcyon", 7);
  ExpectPhaseReferenceError([&] { reference.SetupReference(0, 2); },
                            L"Could not initialize phase reference.");
  EXPECT_EQ(sim->callCount("makeRatio2"), 0);
  sim->setFailure("startHalcyon", 0);
  for (int divide : {1, 2, 4, 8, 16}) {
    const std::string name = "makeRatio" + std::to_string(divide);
    sim->setFailure(name.c_str(), 40 + divide);
    ExpectPhaseReferenceError([&] { reference.SetupReference(0, divide); },
                              L"Could not set the divide setting on the phase reference.:" +
                                  std::to_wstring(40 + divide));
  }
  sim->setFailure("getModel", -5);
  ExpectPhaseReferenceError([&] { reference.GetModel(0); },
                            L"Couldn't read the model from the phase reference.:-5");
  sim->setDeviceCount(2);
  sim->setFailure("getSerialNumber", 12);
  ExpectPhaseReferenceError([&] { reference.GetIDStrings(); },
                            L"Couldn't read the ID string of the phase reference.:12");
  EXPECT_EQ(sim->callCount("getSerialNumber"), 1);  // stops at the first device
}

TEST_F(PhaseReferenceDriver, DeviceCountErrorMeansNoDevice) {
  sim->setFailure("getNumConnectedDevice", -1);
  EXPECT_TRUE(reference.GetIDStrings().empty());
  ExpectPhaseReferenceError([&] { reference.SetupReference(0, 1); },
                            L"Selected phase reference is invalid");
}

TEST_F(PhaseReferenceDriver, SimulationReplacesTheDeviceCallByCall) {
  Features().on.insert(L"SimulatePhaseRef");
  reference.SetupReference(9, 3);
  EXPECT_EQ(reference.GetModel(9), L"Simulated");
  EXPECT_EQ(reference.GetIDStrings(), std::vector<std::wstring>{L"Simulated"});
  for (const char* name : {"startHalcyon", "getNumConnectedDevice", "getModel", "makeRatio1"})
    EXPECT_EQ(sim->callCount(name), 0) << name;
  EXPECT_EQ(Features().asked, std::vector<std::wstring>(3, L"SimulatePhaseRef"));
}

TEST(PhaseReferenceMissingExport, EveryConstructorThrowsAndTheLibraryStaysLoaded) {
  RegisterFeatures(false);
  ExpectPhaseReferenceError([] { PhaseReference reference; },
                            L"Couldn't find the dll exports for phase reference");
  EXPECT_NE(::dlopen("libFerrule_rev7.so", RTLD_NOW | RTLD_NOLOAD), nullptr);
  ExpectPhaseReferenceError([] { PhaseReference reference; },
                            L"Couldn't find the dll exports for phase reference");
}

TEST(PhaseReferenceMissingLibrary, ConstructorThrowsAndTriesAgainNextTime) {
  // No host object at all: the feature counts as off.
  ExpectPhaseReferenceError([] { PhaseReference reference; }, L"couldn't load Ferrule_rev7.dll");
  ExpectPhaseReferenceError([] { PhaseReference reference; }, L"couldn't load Ferrule_rev7.dll");
  EXPECT_FALSE(PhaseReference::IsSimulated());
}

TEST(PhaseReferenceSimulated, NothingIsLoadedAndAnyArgumentsAreAccepted) {
  RegisterFeatures(true);
  EXPECT_TRUE(PhaseReference::IsSimulated());
  PhaseReference reference;  // no driver on the search path: loading would throw
  reference.SetupReference(-3, 7);
  EXPECT_EQ(reference.GetModel(0), L"Simulated");
  EXPECT_EQ(reference.GetIDStrings(), std::vector<std::wstring>{L"Simulated"});
  EXPECT_EQ(::dlopen("libFerrule_rev7.so", RTLD_NOW | RTLD_NOLOAD), nullptr);

  // Leaving simulation with objects built in it reaches no entry point.
  Features().on.clear();
  EXPECT_FALSE(PhaseReference::IsSimulated());
  ExpectPhaseReferenceError([&] { reference.SetupReference(0, 1); },
                            L"Couldn't find the dll exports for phase reference");
  ExpectPhaseReferenceError([&] { reference.GetModel(0); },
                            L"Couldn't find the dll exports for phase reference");
  ExpectPhaseReferenceError([] { PhaseReference later; }, L"couldn't load Ferrule_rev7.dll");
}

}  // namespace
