#include "lumen/globalstate/global_state.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "globalstate/fake_host.h"

namespace LumenUtility {
namespace {

using testutil::Events;
using testutil::EventLog;
using testutil::ThrownCode;

class GlobalStateSettings : public testutil::GlobalStateFixture {};

TEST_F(GlobalStateSettings, ReferenceStartsInternalAndTakesEitherConstantInAnyCase) {
  EXPECT_EQ(GlobalState::GetExternalReference(), L"Internal");
  GlobalState::SetExternalReference(L"external");
  EXPECT_EQ(GlobalState::GetExternalReference(), L"External");
  EXPECT_TRUE(hardware.external);
  GlobalState::SetExternalReference(L"INTERNAL");
  EXPECT_EQ(*Stored(L"ReferenceState"), L"Internal");
  EXPECT_FALSE(hardware.external);
}

TEST_F(GlobalStateSettings, ReferenceOtherThanTheConstantsIsRefusedAndChangesNothing) {
  for (const wchar_t* bad : {L"ext", L"", L"External ", L"Externa1"}) {
    SCOPED_TRACE(testing::PrintToString(std::wstring(bad)));
    Events().clear();
    EXPECT_EQ(ThrownCode([&] { GlobalState::SetExternalReference(bad); }), E_INVALIDARG);
    EXPECT_EQ(GlobalState::GetExternalReference(), L"Internal");
    EXPECT_TRUE(Events().empty());
  }
}

TEST_F(GlobalStateSettings, HardwareDecidesTheReferenceWhereTheLibraryCannotStoreIt) {
  caps.canStoreReference = false;
  Restart();
  EXPECT_EQ(Stored(L"ReferenceState"), nullptr);
  EXPECT_EQ(GlobalState::GetExternalReference(), L"Internal");
  hardware.external = true;
  EXPECT_EQ(GlobalState::GetExternalReference(), L"External");

  // The value is checked first, then the missing setting; no change is begun.
  EXPECT_EQ(ThrownCode([] { GlobalState::SetExternalReference(L"bogus"); }), E_INVALIDARG);
  EXPECT_EQ(ThrownCode([] { GlobalState::SetExternalReference(L"Internal"); }),
            LUMEN_E_NO_REFERENCE_STATE);
  EXPECT_EQ(static_cast<std::uint32_t>(LUMEN_E_NO_REFERENCE_STATE), 0xE808089Du);
  EXPECT_TRUE(hardware.external);
  EXPECT_TRUE(Events().empty());
}

TEST_F(GlobalStateSettings, StoredReferenceMissingWhereItShouldBeKeptIsAnError) {
  caps.canStoreReference = false;
  Restart();
  caps.canStoreReference = true;  // the capability changed after start-up
  EXPECT_EQ(ThrownCode([] { GlobalState::GetExternalReference(); }), E_INVALIDARG);
}

TEST_F(GlobalStateSettings, NegativePolarityIsStoredAndPositiveRemovesIt) {
  EXPECT_EQ(GlobalState::GetIndexLinePolarity(), GlobalState::IndexLinePositive);
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);
  EXPECT_EQ(GlobalState::GetIndexLinePolarity(), GlobalState::IndexLineNegative);
  EXPECT_EQ(*Stored(L"IndexPolarity"), L"Negative");
  EXPECT_EQ(Events(), EventLog{L"core"});

  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);  // no change: no notice
  EXPECT_EQ(Events(), EventLog{L"core"});

  GlobalState::SetIndexLinePolarity(GlobalState::IndexLinePositive);
  EXPECT_EQ(Stored(L"IndexPolarity"), nullptr);
  EXPECT_EQ(Events(), (EventLog{L"core", L"core"}));

  EXPECT_EQ(ThrownCode([] {
              GlobalState::SetIndexLinePolarity(static_cast<GlobalState::IndexLinePolarity>(2));
            }),
            E_INVALIDARG);
  EXPECT_EQ(Stored(L"IndexPolarity"), nullptr);
  EXPECT_EQ(Events().size(), 2u);
}

TEST_F(GlobalStateSettings, PolarityWithoutAnIndexLineIsPositiveAndCannotBeChanged) {
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);
  caps.hasIndexLine = false;
  Events().clear();
  EXPECT_EQ(GlobalState::GetIndexLinePolarity(), GlobalState::IndexLinePositive);
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLinePositive);  // the current polarity
  EXPECT_EQ(ThrownCode([] { GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative); }),
            E_INVALIDARG);
  EXPECT_EQ(*Stored(L"IndexPolarity"), L"Negative");  // kept for hardware that has the line
  EXPECT_TRUE(Events().empty());
}

TEST_F(GlobalStateSettings, EquationEditorModeIsStoredAsTrueOrFalse) {
  EXPECT_FALSE(GlobalState::GetEquationEditorFastProcessingMode());
  GlobalState::SetEquationEditorFastProcessingMode(true);
  EXPECT_EQ(*Stored(L"EquationEditorFastProcessing"), L"True");
  EXPECT_TRUE(GlobalState::GetEquationEditorFastProcessingMode());
  GlobalState::SetEquationEditorFastProcessingMode(false);
  EXPECT_EQ(*Stored(L"EquationEditorFastProcessing"), L"False");
  EXPECT_FALSE(GlobalState::GetEquationEditorFastProcessingMode());
  EXPECT_EQ(Events(), (EventLog{L"core", L"core"}));
}

TEST_F(GlobalStateSettings, PowerKnobResolutionIsStoredWithSixDecimals) {
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 0.1);
  GlobalState::SetPowerKnobResolution(0.25);
  EXPECT_EQ(*Stored(L"PowerKnobResolution"), L"0.250000");
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 0.25);

  GlobalState::SetPowerKnobResolution(0.0000004);
  EXPECT_EQ(*Stored(L"PowerKnobResolution"), L"0.000000");
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 0.0);
  GlobalState::SetPowerKnobResolution(1234.5678);
  EXPECT_EQ(*Stored(L"PowerKnobResolution"), L"1234.567800");
  GlobalState::SetPowerKnobResolution(-0.5);
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), -0.5);
  // Six decimals: the value read back lies within half a millionth of the value set.
  for (const double d : {0.1, 0.333333333, 12.0000049, 1e9 / 7}) {
    GlobalState::SetPowerKnobResolution(d);
    EXPECT_NEAR(GlobalState::GetPowerKnobResolution(), d, 5e-7 * (1 + 1e-9 * d)) << d;
  }
  EXPECT_TRUE(Events().empty());  // no notification
}

TEST_F(GlobalStateSettings, PowerKnobResolutionThatCouldNotBeReadBackIsRefused) {
  GlobalState::SetPowerKnobResolution(0.5);
  for (const double bad : {std::numeric_limits<double>::quiet_NaN(),
                           std::numeric_limits<double>::infinity(),
                           -std::numeric_limits<double>::infinity()}) {
    EXPECT_EQ(ThrownCode([bad] { GlobalState::SetPowerKnobResolution(bad); }), E_INVALIDARG);
  }
  EXPECT_EQ(*Stored(L"PowerKnobResolution"), L"0.500000");
  // The largest double still has a text that reads back.
  GlobalState::SetPowerKnobResolution(std::numeric_limits<double>::max());
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), std::numeric_limits<double>::max());
}

TEST_F(GlobalStateSettings, ForcedElementsAnswerByLowestHandle) {
  EXPECT_EQ(GlobalState::ForcePathElementValue(L"Port1/Switch", L"A"), 0);
  EXPECT_EQ(GlobalState::ForcePathElementValue(L"Port1/Switch", L"B"), 1);
  EXPECT_EQ(GlobalState::ForcePathElementValue(L"Port2/Switch", L"C"), 2);
  std::wstring value = L"unchanged";
  EXPECT_TRUE(GlobalState::IsPathForceElementValue(L"Port1/Switch", value));
  EXPECT_EQ(value, L"A");
  GlobalState::UnforcePathElementValue(0);
  EXPECT_TRUE(GlobalState::IsPathForceElementValue(L"Port1/Switch", value));
  EXPECT_EQ(value, L"B");
  GlobalState::UnforcePathElementValue(7);  // unknown: ignored
  GlobalState::UnforcePathElementValue(1);
  value = L"unchanged";
  EXPECT_FALSE(GlobalState::IsPathForceElementValue(L"Port1/Switch", value));
  EXPECT_FALSE(GlobalState::IsPathForceElementValue(L"port2/switch", value));  // exact paths
  EXPECT_EQ(value, L"unchanged");
  EXPECT_TRUE(GlobalState::IsPathForceElementValue(L"Port2/Switch", value));
  EXPECT_EQ(value, L"C");
  // Handles are never given twice, even after removals.
  EXPECT_EQ(GlobalState::ForcePathElementValue(L"Port1/Switch", L"D"), 3);
  EXPECT_TRUE(Events().empty());  // forcing notifies no one
}

TEST_F(GlobalStateSettings, PresetClearsSettingsButKeepsReferenceAndForcedElements) {
  GlobalState::SetExternalReference(L"External");
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);
  GlobalState::SetEquationEditorFastProcessingMode(true);
  GlobalState::SetPowerKnobResolution(2.0);
  const int handle = GlobalState::ForcePathElementValue(L"Path", L"Value");
  Events().clear();
  GlobalState::PresetGlobalState();
  EXPECT_TRUE(Events().empty());  // nor does a preset
  EXPECT_EQ(Stored(L"IndexPolarity"), nullptr);
  EXPECT_EQ(GlobalState::GetIndexLinePolarity(), GlobalState::IndexLinePositive);
  EXPECT_FALSE(GlobalState::GetEquationEditorFastProcessingMode());
  EXPECT_EQ(GlobalState::GetPowerKnobResolution(), 0.1);
  EXPECT_EQ(GlobalState::GetExternalReference(), L"External");
  std::wstring value;
  EXPECT_TRUE(GlobalState::IsPathForceElementValue(L"Path", value));
  EXPECT_EQ(handle, 0);
}

class GlobalStateWithoutHost : public ::testing::Test {
 protected:
  void SetUp() override {
    Events().clear();
    GlobalStateTable::Restart();
  }
};

TEST_F(GlobalStateWithoutHost, MissingHostObjectsAreSkippedNotCalled) {
  // No capabilities: the library keeps the reference and there is no index line.
  EXPECT_EQ(GlobalState::GetExternalReference(), L"Internal");
  GlobalState::SetExternalReference(L"External");  // no hardware to switch, no core, no window
  EXPECT_EQ(GlobalState::GetExternalReference(), L"External");
  EXPECT_EQ(ThrownCode([] { GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative); }),
            E_INVALIDARG);
  GlobalState::SetEquationEditorFastProcessingMode(true);
  EXPECT_TRUE(GlobalState::GetEquationEditorFastProcessingMode());
}

}  // namespace
}  // namespace LumenUtility
