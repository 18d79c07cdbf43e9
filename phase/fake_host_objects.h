// Fake host objects for the phase tests: a 4-port test set with a fixed slot layout and a FIFO
// that records its writes, registered in the capabilities table under category 3, index 0.
//
// The receiver substitution is worked out once per process, by the first PAComponent built.
// The global environment below builds one against the default test set before any test runs,
// so every test sees the substitution of that layout: "a1" (slot 8) over port 1's reference
// (slot 0).
#pragma once

#include <gtest/gtest.h>

#include <map>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/phase/pa_component.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

namespace phase_test {

using LumenUtility::TsComplex;

// Values in one point buffer of the fake layout.
inline constexpr int kPointSize = 9;
// Slot of "a1" in the fake layout.
inline constexpr int kA1Slot = 8;

// Slots with mapping flag false: reference receiver of port p (1..4) at p - 1, test receiver
// i (1..4) at 3 + i, "a1" at 8. Mapping flag true mirrors slots 0..7. Receiver numbers 1..4
// classify as test receivers 1..4, 11..14 as the reference receivers of ports 1..4, other
// numbers as `classification` says (test index -1 and reference port -1 when absent).
class FakeTestSet final : public ITestSet {
 public:
  int GetPortCount() override {
    ++portCountCalls;
    return ports;
  }
  int ReceiverToSlot(int index, bool reference, bool mappingFlag) override {
    ++slotCalls;
    if (index < 1 || index > 4) {
      throw std::out_of_range("fake test set has no receiver " + std::to_string(index));
    }
    const int slot = reference ? index - 1 : 3 + index;
    return mappingFlag ? 7 - slot : slot;
  }
  void ClassifyReceiver(int receiverNumber, int& testIndex, int& refPort, bool) override {
    ++classifyCalls;
    testIndex = -1;
    refPort = -1;
    if (receiverNumber >= 1 && receiverNumber <= 4) {
      testIndex = receiverNumber;
    } else if (receiverNumber >= 11 && receiverNumber <= 14) {
      refPort = receiverNumber - 10;
    } else if (const auto it = classification.find(receiverNumber); it != classification.end()) {
      testIndex = it->second.first;
      refPort = it->second.second;
    }
  }
  int GetReceiverPosition(const std::wstring& name) override {
    return name == L"a1" ? a1Position : 0;
  }

  void Reset() { *this = FakeTestSet(); }

  int ports = 4;
  int a1Position = kA1Slot + 1;
  std::map<int, std::pair<int, int>> classification;  // number -> (test index, ref port)
  int portCountCalls = 0;
  int slotCalls = 0;
  int classifyCalls = 0;
};

// Records every run written; throws std::runtime_error instead while `failing`.
class FakeFifo final : public AI_IFIFO {
 public:
  void Write(const TsComplex* values, int count) override {
    if (failing) throw std::runtime_error("fifo full");
    writes.emplace_back(values, values + count);
  }
  std::vector<std::vector<TsComplex>> writes;
  bool failing = false;
};

inline FakeTestSet& TheTestSet() {
  static FakeTestSet testSet;
  return testSet;
}

inline FakeFifo& TheFifo() {
  static FakeFifo fifo;
  return fifo;
}

inline void RegisterFakes() {
  LumenUtility::RegisterHostObject<ITestSet>(LumenUtility::kHostCategoryApplication, 0,
                                             &TheTestSet());
  LumenUtility::RegisterHostObject<AI_IFIFO>(LumenUtility::kHostCategoryApplication, 0,
                                             &TheFifo());
}

// Takes the host objects out of the table for the lifetime of the guard.
class HostObjectsMissing {
 public:
  HostObjectsMissing() {
    LumenUtility::RemoveHostObject<ITestSet>(LumenUtility::kHostCategoryApplication,
                                             &TheTestSet());
    LumenUtility::RemoveHostObject<AI_IFIFO>(LumenUtility::kHostCategoryApplication, &TheFifo());
  }
  ~HostObjectsMissing() { RegisterFakes(); }
  HostObjectsMissing(const HostObjectsMissing&) = delete;
  HostObjectsMissing& operator=(const HostObjectsMissing&) = delete;
};

class FakeHostEnvironment final : public testing::Environment {
 public:
  void SetUp() override {
    RegisterFakes();
    const PAComponent first;  // fixes the process-wide substitution for this layout
  }
};

inline testing::Environment* const kFakeHostEnvironment =
    testing::AddGlobalTestEnvironment(new FakeHostEnvironment);

// Fixture: default fakes, registered, the FIFO's record empty.
class PhaseHostTest : public testing::Test {
 protected:
  void SetUp() override {
    TheTestSet().Reset();
    TheFifo() = FakeFifo();
    RegisterFakes();
  }
  FakeTestSet& testSet() { return TheTestSet(); }
  FakeFifo& fifo() { return TheFifo(); }
};

// Expects `call` to throw LumenException with exactly `code` and `message`.
template <class Call>
void ExpectLumenError(Call&& call, HRESULT code, const std::wstring& message) {
  try {
    call();
    ADD_FAILURE() << "no exception";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), code);
    EXPECT_EQ(e.GetMessage(), message);
  }
}

// One point buffer of the fake layout, every value distinct unless given.
inline std::vector<TsComplex> PointBuffer(float seed = 1.0f) {
  std::vector<TsComplex> point(kPointSize);
  for (int k = 0; k < kPointSize; ++k) point[k] = TsComplex(seed + k, 0.5f * seed - k);
  return point;
}

}  // namespace phase_test
