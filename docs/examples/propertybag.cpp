// Property bags: a keyed setting, a change subscriber and a global subscriber.
// guide:begin
#include <boost/make_shared.hpp>
#include <cstdio>
#include <string>

#include "lumen/platform.h"
#include "lumen/propertybag.h"

using namespace LumenUtility;

// A setting kept in a bag: one double with a preset value.
struct PowerSetting final : PropertyBagItem {
  double dBm = -10.0;
  void Serialize(CArchive& ar) override { ar.IsStoring() ? void(ar << dBm) : void(ar >> dBm); }
  void LegacyRecall(const unsigned char*, int) override {}
  void LoadPreset(const std::string&, PropertyBag*) override { dBm = -10.0; }
  void CopyFrom(PropertyBagItem* source, const char*) override {
    dBm = static_cast<PowerSetting*>(source)->dBm;
  }
};

struct Printer final : IPropertyBagSubscriber {
  const char* who;
  explicit Printer(const char* name) : who(name) {}
  void OnItemChange(PropertyBag*, const std::string& key, CComVariant value) override {
    std::printf("%s: %s is now %.1f\n", who, key.c_str(), value.GetDouble());
  }
};

int main() {
  PropertyBag bag;
  bag.AddItem("Power", boost::make_shared<PowerSetting>());
  Printer local("channel"), global("logger");
  bag.SubscribeChanges(&local);
  PropertyBag::GlobalSubscribeChanges(&global);

  static_cast<PowerSetting*>(bag.GetItem("Power"))->dBm = 5.0;
  bag.SignalItemChange("Power", CComVariant(5.0));
  bag.UnsubscribeChanges(&local);
  PropertyBag::GlobalUnsubscribeChanges(&global);
  bag.LoadPresetValues();
  std::printf("after preset: %.1f dBm, keys: %zu\n",
              static_cast<PowerSetting*>(bag.GetItem("Power"))->dBm, bag.GetKeys().size());
  try {
    CComVariant(std::wstring(L"text")).GetDouble();
  } catch (const COleException& e) {
    std::printf("%s\n", e.what());
  }
}
// guide:end
