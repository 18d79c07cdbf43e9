// The global state applied to an acquisition specification.
#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include <fstream>
#include <optional>
#include <string>
#include <vector>

#include "globalstate/fake_host.h"
#include "lumen/globalstate/global_state.h"
#include "lumen/globalstate/gp_scalar.h"
#include "lumen/platform/registry.h"
#include "platform/temp_dir.h"

namespace LumenUtility {
namespace {

using Rigel::CommandParameter;
using Rigel::CPCollection;
using Rigel::DataAcquisitionSpecification;
using testutil::Events;
using testutil::ThrownCode;
using DasPtr = boost::shared_ptr<DataAcquisitionSpecification>;

const std::wstring kKey = L"HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer\\";

template <class T>
void Add(CPCollection& collection, const std::wstring& element, const std::wstring& parameter,
         T value) {
  collection.append(boost::make_shared<CommandParameter>(
      element, boost::make_shared<GPScalar<T>>(parameter, value)));
}

// The value of (element, parameter) when it is a GPScalar<T>.
template <class T>
std::optional<T> ValueOf(const CPCollection& collection, const std::wstring& element,
                         const std::wstring& parameter) {
  const CPCollection::Entry entry = collection.ptr_find(element, parameter);
  if (!entry) return std::nullopt;
  const auto* scalar = dynamic_cast<const GPScalar<T>*>(entry->parameter().get());
  if (!scalar) return std::nullopt;
  return scalar->get_value();
}

// Each element and parameter name of a collection, in order, as "element.parameter".
std::vector<std::wstring> Names(const CPCollection& collection) {
  std::vector<std::wstring> names;
  for (std::uint32_t i = 0; i < collection.size(); ++i) {
    names.push_back(collection.at(i)->element_name() + L"." + collection.at(i)->parameter_name());
  }
  return names;
}

// A specification with two dimensions, each driving all four sources (Freq twice for RFSrc0).
DasPtr SweepSpec() {
  auto das = boost::make_shared<DataAcquisitionSpecification>();
  for (int d = 0; d < 2; ++d) {
    auto dimension = boost::make_shared<Rigel::CPDimension>();
    for (int s = 0; s < 4; ++s) {
      const std::wstring source = L"RFSrc" + std::to_wstring(s);
      Add(*dimension, source, L"Freq", 1e9 * (d + 1));
      if (s == 0) Add(*dimension, source, L"Freq", 2e9);
      Add(*dimension, source, L"Power", -10.0);
      Add<std::int32_t>(*dimension, source, L"PortState", 0);
      Add<std::int32_t>(*dimension, source, L"PortControlSrc", 0);
    }
    das->get_dynamic_spec().push_back(dimension);
  }
  das->get_dynamic_spec().push_back(nullptr);  // an empty dimension entry is passed over
  return das;
}

class DasChanges : public testutil::GlobalStateFixture {
 protected:
  // Switches the second test set on in the registry, clocked from `port` (nothing: absent).
  static void SecondTestSetOn(std::optional<std::uint32_t> port, RegistryStore store = {}) {
    store.SetDword(kKey, L"T2Mode", 1);
    if (port) store.SetDword(kKey, L"T2ClockPort", *port);
    SetRegistryStore(std::move(store));
  }

  // Whether ModifyDAS applied the second test set to a fresh sweep specification.
  static bool SecondTestSetApplied() {
    DasPtr das = SweepSpec();
    GlobalState::GlobalStateModifyDAS(das);
    return das->get_static_spec().size() > 1;
  }
};

TEST_F(DasChanges, ReferenceAndPolarityGoToThePathManagerInPlace) {
  DasPtr das = boost::make_shared<DataAcquisitionSpecification>();
  GlobalState::GlobalStateModifyDAS(das);
  CPCollection& spec = das->get_static_spec();
  ASSERT_EQ(Names(spec), std::vector<std::wstring>{L"Path_Manager.RefSel"});
  EXPECT_EQ(ValueOf<std::wstring>(spec, L"Path_Manager", L"RefSel"), L"Internal");
  const Rigel::GenericParameter::Ptr refSel = spec.at(0)->parameter();
  EXPECT_TRUE(refSel->get_change_flag());

  GlobalState::SetExternalReference(L"External");
  GlobalState::SetIndexLinePolarity(GlobalState::IndexLineNegative);
  refSel->clear_change_flag();
  GlobalState::GlobalStateModifyDAS(das);
  EXPECT_EQ(Names(spec), (std::vector<std::wstring>{L"Path_Manager.RefSel",
                                                     L"Path_Manager.IndexPolarity"}));
  EXPECT_EQ(spec.at(0)->parameter(), refSel);  // the same value object, given the new value
  EXPECT_TRUE(refSel->get_change_flag());
  EXPECT_EQ(ValueOf<std::wstring>(spec, L"Path_Manager", L"RefSel"), L"External");
  EXPECT_EQ(ValueOf<std::wstring>(spec, L"Path_Manager", L"IndexPolarity"), L"Negative");
  // Nothing asks for external devices while the second test set is off.
  EXPECT_EQ(std::count(Events().begin(), Events().end(), L"devices of kind 3"), 0);
}

TEST_F(DasChanges, ParameterHoldingAnotherTypeGetsAScalarOfTheRightType) {
  DasPtr das = boost::make_shared<DataAcquisitionSpecification>();
  Add<std::int32_t>(das->get_static_spec(), L"Path_Manager", L"RefSel", 7);
  const CPCollection::Entry entry = das->get_static_spec().at(0);
  GlobalState::GlobalStateModifyDAS(das);
  ASSERT_EQ(das->get_static_spec().size(), 1u);
  EXPECT_EQ(das->get_static_spec().at(0), entry);
  EXPECT_EQ(ValueOf<std::wstring>(das->get_static_spec(), L"Path_Manager", L"RefSel"), L"Internal");
  EXPECT_EQ(entry->parameter_name(), L"RefSel");
  EXPECT_TRUE(entry->parameter()->get_change_flag());
}

TEST_F(DasChanges, ReferenceDecidedByTheHardwareIsNotWritten) {
  caps.canStoreReference = false;
  Restart();
  DasPtr das = boost::make_shared<DataAcquisitionSpecification>();
  GlobalState::GlobalStateModifyDAS(das);
  EXPECT_EQ(das->get_static_spec().size(), 0u);
}

TEST_F(DasChanges, SecondTestSetMovesItsClockSourceToAFixedDriveForEachPort) {
  devices.devices = {L"Other", L"T2"};
  for (std::uint32_t port = 1; port <= 4; ++port) {
    SCOPED_TRACE(port);
    SecondTestSetOn(port);
    Events().clear();
    DasPtr das = SweepSpec();
    GlobalState::GlobalStateModifyDAS(das);
    EXPECT_EQ(Events(), std::vector<std::wstring>{L"devices of kind 3"});

    const std::wstring source = L"RFSrc" + std::to_wstring(port - 1);
    const CPCollection& spec = das->get_static_spec();
    EXPECT_EQ(Names(spec), (std::vector<std::wstring>{
                               L"Path_Manager.RefSel", source + L".Freq", source + L".Power",
                               source + L".PortState", source + L".PortControlSrc",
                               L"Path_Manager.PrtBP" + std::to_wstring(port)}));
    EXPECT_EQ(ValueOf<double>(spec, source, L"Freq"), 6000000000.0);
    EXPECT_EQ(ValueOf<double>(spec, source, L"Power"), 6.0);
    EXPECT_EQ(ValueOf<std::int32_t>(spec, source, L"PortState"), 1);
    EXPECT_EQ(ValueOf<std::int32_t>(spec, source, L"PortControlSrc"), 2);
    EXPECT_EQ(ValueOf<std::int32_t>(spec, L"Path_Manager", L"PrtBP" + std::to_wstring(port)), 1);

    // Each dimension loses the source's frequency, power and port state, every copy of them;
    // its port control and the other sources stay.
    for (std::uint32_t d = 0; d < 2; ++d) {
      const CPCollection& dimension = *das->get_dimension(d);
      EXPECT_EQ(dimension.ptr_find_index(source, L"Freq"), -1);
      EXPECT_EQ(dimension.ptr_find_index(source, L"Power"), -1);
      EXPECT_EQ(dimension.ptr_find_index(source, L"PortState"), -1);
      EXPECT_NE(dimension.ptr_find_index(source, L"PortControlSrc"), -1);
      EXPECT_EQ(dimension.size(), 17u - (port == 1 ? 4u : 3u));
      const std::wstring other = L"RFSrc" + std::to_wstring(port % 4);
      EXPECT_EQ(ValueOf<double>(dimension, other, L"Freq"), 1e9 * (d + 1));
    }
  }
}

TEST_F(DasChanges, ExistingStaticSourceParametersAreUpdatedNotDoubled) {
  devices.devices = {L"T2"};
  SecondTestSetOn(2);
  DasPtr das = SweepSpec();
  Add(das->get_static_spec(), L"RFSrc1", L"Freq", 1.0);
  GlobalState::GlobalStateModifyDAS(das);
  GlobalState::GlobalStateModifyDAS(das);
  EXPECT_EQ(das->get_static_spec().size(), 6u);
  EXPECT_EQ(das->get_static_spec().ptr_find_index(L"RFSrc1", L"Freq"), 0);
  EXPECT_EQ(ValueOf<double>(das->get_static_spec(), L"RFSrc1", L"Freq"), 6e9);
}

TEST_F(DasChanges, ClockPortZeroAbsentOrOfAnotherTypeMeansPortFour) {
  devices.devices = {L"T2"};
  RegistryStore stringPort;
  stringPort.SetString(kKey, L"T2ClockPort", L"2");
  for (auto [port, store] : {std::pair<std::optional<std::uint32_t>, RegistryStore>{0u, {}},
                             {std::nullopt, {}},
                             {std::nullopt, stringPort}}) {
    SecondTestSetOn(port, store);
    DasPtr das = SweepSpec();
    GlobalState::GlobalStateModifyDAS(das);
    EXPECT_EQ(ValueOf<std::int32_t>(das->get_static_spec(), L"Path_Manager", L"PrtBP4"), 1);
    EXPECT_EQ(ValueOf<double>(das->get_static_spec(), L"RFSrc3", L"Freq"), 6e9);
  }
}

TEST_F(DasChanges, SecondTestSetNeedsItsModeASelectedDeviceOfItsNameAndAPortFromOneToFour) {
  devices.devices = {L"T2"};
  SecondTestSetOn(1);
  ASSERT_TRUE(SecondTestSetApplied());

  // The mode: exactly the DWORD 1.
  for (const std::uint32_t mode : {0u, 2u}) {
    RegistryStore store;
    store.SetDword(kKey, L"T2Mode", mode);
    SetRegistryStore(store);
    EXPECT_FALSE(SecondTestSetApplied()) << mode;
  }
  RegistryStore textMode;
  textMode.SetString(kKey, L"T2Mode", L"1");
  SetRegistryStore(textMode);
  EXPECT_FALSE(SecondTestSetApplied());
  SetRegistryStore(RegistryStore());
  EXPECT_FALSE(SecondTestSetApplied());

  // The port.
  for (const std::uint32_t port : {5u, 0xFFFFFFFFu}) {
    SecondTestSetOn(port);
    EXPECT_FALSE(SecondTestSetApplied()) << port;
  }

  // The device: selected, under exactly the configured name.
  SecondTestSetOn(1);
  for (const std::vector<std::wstring>& selected :
       {std::vector<std::wstring>{}, {L"t2"}, {L"T2 "}, {L"Other"}}) {
    devices.devices = selected;
    EXPECT_FALSE(SecondTestSetApplied());
  }
  RegistryStore named;
  named.SetString(kKey, L"T2Name", L"Box", REG_EXPAND_SZ);
  SecondTestSetOn(1, named);
  devices.devices = {L"T2"};
  EXPECT_FALSE(SecondTestSetApplied());
  devices.devices = {L"Box"};
  EXPECT_TRUE(SecondTestSetApplied());
  RegistryStore emptyName;
  emptyName.SetString(kKey, L"T2Name", L"");
  SecondTestSetOn(1, emptyName);
  devices.devices = {L"T2"};
  EXPECT_TRUE(SecondTestSetApplied());

  // No device list at all: nothing is selected.
  RemoveHostObject<Interface::ISelectedExternalDevices>(kHostCategoryApplication, &devices);
  EXPECT_FALSE(SecondTestSetApplied());
}

TEST_F(DasChanges, SecondTestSetComesFromTheConfigurationFileTheHostNames) {
  testutil::TempDir dir;
  std::ofstream(dir.NarrowPath("analyzer.ini"))
      << "[HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer]\n"
         "T2Mode = dword:1\nT2ClockPort = dword:3\nT2Name = Box\n";
  SetRegistryConfigurationFile(dir.Path("analyzer.ini"));
  devices.devices = {L"Box"};
  DasPtr das = SweepSpec();
  GlobalState::GlobalStateModifyDAS(das);
  EXPECT_EQ(ValueOf<std::int32_t>(das->get_static_spec(), L"Path_Manager", L"PrtBP3"), 1);
  EXPECT_EQ(ValueOf<double>(das->get_static_spec(), L"RFSrc2", L"Power"), 6.0);
}

TEST_F(DasChanges, EmptySpecificationIsAnError) {
  DasPtr none;
  EXPECT_EQ(ThrownCode([&none] { GlobalState::GlobalStateModifyDAS(none); }), E_POINTER);
}

}  // namespace
}  // namespace LumenUtility
