// GlobalStateModifyDAS: the settings applied to an acquisition specification.
#include <algorithm>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>

#include "globalstate/global_state_host.h"
#include "globalstate/global_state_names.h"
#include "globalstate/global_state_table.h"
#include "globalstate/second_test_set.h"
#include "lumen/globalstate/global_state.h"
#include "lumen/globalstate/gp_scalar.h"

namespace GlobalState {

namespace {

using LumenUtility::GPScalar;
using Rigel::CPCollection;
namespace names = LumenUtility::GlobalStateNames;

// The kind of external device that a second test set is.
constexpr int kTestSetDeviceKind = 3;
// The fixed drive of the source that clocks the second test set.
constexpr double kClockSourceFrequency = 6000000000.0;  // Hz
constexpr double kClockSourcePower = 6.0;               // dBm
constexpr std::int32_t kClockSourcePortState = 1;
constexpr std::int32_t kClockSourcePortControl = 2;
constexpr std::int32_t kPortBypassed = 1;
constexpr std::uint32_t kLastPort = 4;

// Gives parameter `parameter` of `element` the value `value`, marking it changed: in place
// when the entry holds a GPScalar<T>, as a new GPScalar<T> in the entry when it holds a value
// of another type, or in a new entry appended to the collection.
template <class T>
void SetParameter(CPCollection& collection, const std::wstring& element,
                  const std::wstring& parameter, const T& value) {
  const CPCollection::Entry entry = collection.ptr_find(element, parameter);
  if (entry) {
    if (auto* scalar = dynamic_cast<GPScalar<T>*>(entry->parameter().get())) {
      scalar->set_value(value);
      scalar->set_change_flag();
      return;
    }
  }
  const auto fresh = boost::make_shared<GPScalar<T>>(parameter, value);
  fresh->set_change_flag();
  if (entry) {
    entry->set_parameter(fresh);
  } else {
    collection.append(boost::make_shared<Rigel::CommandParameter>(element, fresh));
  }
}

// Removes every entry of parameter `parameter` of `element`.
void RemoveParameter(CPCollection& collection, const std::wstring& element,
                     const std::wstring& parameter) {
  for (;;) {
    const std::int32_t index = collection.ptr_find_index(element, parameter);
    if (index < 0) return;
    collection.remove(index);
  }
}

// The clock port of the second test set when it is switched on, selected and its port is
// one of 1 to 4; otherwise 0.
std::uint32_t SecondTestSetClockPort() {
  const LumenUtility::SecondTestSet config = LumenUtility::SecondTestSet::Read();
  if (!config.enabled) return 0;
  const std::vector<std::wstring> devices =
      LumenUtility::GlobalStateHost::SelectedDevices(kTestSetDeviceKind);
  if (std::find(devices.begin(), devices.end(), config.name) == devices.end()) return 0;
  return config.clockPort >= 1 && config.clockPort <= kLastPort ? config.clockPort : 0;
}

// Moves the source of `port` from the dynamic dimensions to a fixed drive in the static
// collection and bypasses the port.
void ApplySecondTestSet(Rigel::DataAcquisitionSpecification& das, std::uint32_t port) {
  const std::wstring source = names::kSourcePrefix + std::to_wstring(port - 1);
  for (std::uint32_t i = 0; i < das.get_number_of_dimensions(); ++i) {
    const Rigel::DataAcquisitionSpecification::Dimension dimension = das.get_dimension(i);
    if (!dimension) continue;
    for (const wchar_t* parameter : {names::kFreq, names::kPower, names::kPortState}) {
      RemoveParameter(*dimension, source, parameter);
    }
  }
  CPCollection& spec = das.get_static_spec();
  SetParameter(spec, source, names::kFreq, kClockSourceFrequency);
  SetParameter(spec, source, names::kPower, kClockSourcePower);
  SetParameter(spec, source, names::kPortState, kClockSourcePortState);
  SetParameter(spec, source, names::kPortControlSrc, kClockSourcePortControl);
  SetParameter(spec, names::kPathManager, names::kPortBypassPrefix + std::to_wstring(port),
               kPortBypassed);
}

}  // namespace

void GlobalStateModifyDAS(boost::shared_ptr<Rigel::DataAcquisitionSpecification>& das) {
  const LumenUtility::GlobalStateTable& table = LumenUtility::GlobalStateTable::Instance();
  if (!das) throw static_cast<HRESULT>(LumenUtility::E_POINTER);
  CPCollection& spec = das->get_static_spec();
  if (const std::wstring* reference = table.Find(names::kReferenceState)) {
    SetParameter(spec, names::kPathManager, names::kRefSel, *reference);
  }
  if (const std::wstring* polarity = table.Find(names::kIndexPolarity)) {
    SetParameter(spec, names::kPathManager, names::kIndexPolarity, *polarity);
  }
  if (const std::uint32_t port = SecondTestSetClockPort()) ApplySecondTestSet(*das, port);
}

}  // namespace GlobalState
