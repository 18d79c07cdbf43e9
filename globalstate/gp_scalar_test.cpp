#include "lumen/globalstate/gp_scalar.h"

#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include <locale>

#include "globalstate/value_type_name.h"
#include "lumen/globalstate/gp_array.h"

namespace LumenUtility {
namespace {

using Rigel::GenericParameter;

TEST(GPScalar, TextFormsShowTypeNameAndStreamFormattedValue) {
  const GPScalar<double> freq(L"Freq", 6000000000.0);
  EXPECT_EQ(freq.to_string(false), L"GPScalar<double> Freq 6e+09");
  EXPECT_EQ(freq.to_string(true), L"GPScalar<double> Freq 6e+09");
  EXPECT_EQ(freq.value_to_string(false), L"6e+09");
  EXPECT_EQ(GPScalar<double>(L"Power", 6.0).value_to_string(false), L"6");
  EXPECT_EQ(GPScalar<double>(L"Step", 0.1234567).value_to_string(false), L"0.123457");
  EXPECT_EQ(GPScalar<double>().to_string(false), L"GPScalar<double>  0");

  EXPECT_EQ(GPScalar<std::int32_t>(L"PortState", -1).to_string(false), L"GPScalar<int> PortState -1");
  EXPECT_EQ(GPScalar<Vela::BYPASS_SWITCH_STATE>(L"PrtBP1", Vela::BYPASS_SWITCH_BYPASSED).to_string(false),
            L"GPScalar<Vela::BYPASS_SWITCH_STATE> PrtBP1 1");
  const GPScalar<std::wstring> text(L"RefSel", L"External");
  EXPECT_EQ(text.value_to_string(false), L"External");
  EXPECT_EQ(text.to_string(false),
            L"GPScalar<" + ValueTypeName(typeid(std::wstring)) + L"> RefSel External");
}

// A locale that writes a decimal comma and groups thousands.
struct CommaPunct : std::numpunct<wchar_t> {
  wchar_t do_decimal_point() const override { return L','; }
  wchar_t do_thousands_sep() const override { return L'.'; }
  std::string do_grouping() const override { return "\3"; }
};

TEST(GPScalar, TextFormsIgnoreTheHostsGlobalLocale) {
  const std::locale before = std::locale::global(std::locale(std::locale::classic(), new CommaPunct));
  const std::wstring fraction = GPScalar<double>(L"Power", 0.5).value_to_string(false);
  const std::wstring thousands = GPScalar<std::int32_t>(L"Count", 12345).value_to_string(false);
  std::locale::global(before);
  EXPECT_EQ(fraction, L"0.5");
  EXPECT_EQ(thousands, L"12345");
}

TEST(GPScalar, IsEqualWantsTheSameNameClassAndValue) {
  const GPScalar<double> a(L"Freq", 1.5);
  EXPECT_TRUE(a.IsEqual(a));
  EXPECT_TRUE(a.IsEqual(GPScalar<double>(L"Freq", 1.5)));
  EXPECT_FALSE(a.IsEqual(GPScalar<double>(L"Freq", 2.5)));
  EXPECT_FALSE(a.IsEqual(GPScalar<double>(L"freq", 1.5)));  // names compare exactly
  EXPECT_FALSE(a.IsEqual(GPScalar<double>(L"Power", 1.5)));
  EXPECT_FALSE(a.IsEqual(GPScalar<std::int32_t>(L"Freq", 1)));
  EXPECT_FALSE(a.IsEqual(GPArray<double>(L"Freq", {1.5})));
  EXPECT_TRUE(GPScalar<std::wstring>(L"RefSel", L"Internal")
                  .IsEqual(GPScalar<std::wstring>(L"RefSel", L"Internal")));
}

// A class derived from a scalar still counts as that scalar's type.
class TaggedScalar final : public GPScalar<double> {
 public:
  using GPScalar<double>::GPScalar;
};

TEST(GPScalar, IsSameTypeAcceptsItsClassAndDerivedClassesOnly) {
  const GPScalar<double> a(L"Freq", 1.0);
  EXPECT_TRUE(a.is_same_type(boost::make_shared<GPScalar<double>>(L"Other", 2.0)));
  EXPECT_TRUE(a.is_same_type(boost::make_shared<TaggedScalar>(L"Tagged", 2.0)));
  EXPECT_FALSE(a.is_same_type(GenericParameter::Ptr()));
  EXPECT_FALSE(a.is_same_type(boost::make_shared<GPScalar<std::int32_t>>(L"Freq", 1)));
  EXPECT_FALSE(a.is_same_type(boost::make_shared<GPArray<double>>(L"Freq")));
}

TEST(GPScalar, CloneCopiesNameValueAndFlagAndCreateDefaultStartsEmpty) {
  GPScalar<std::wstring> a(L"RefSel", L"External");
  a.set_change_flag();
  const GenericParameter::Ptr copy = a.clone();
  a.set_value(L"Internal");
  const auto* scalar = dynamic_cast<const GPScalar<std::wstring>*>(copy.get());
  ASSERT_NE(scalar, nullptr);
  EXPECT_EQ(scalar->name(), L"RefSel");
  EXPECT_EQ(scalar->get_value(), L"External");
  EXPECT_TRUE(scalar->get_change_flag());

  const GenericParameter::Ptr fresh = a.create_default();
  const auto* empty = dynamic_cast<const GPScalar<std::wstring>*>(fresh.get());
  ASSERT_NE(empty, nullptr);
  EXPECT_EQ(empty->name(), L"");
  EXPECT_EQ(empty->get_value(), L"");
  EXPECT_FALSE(empty->get_change_flag());
}

TEST(GPScalar, FromVectorToGPPtrGathersScalarValuesInOrder) {
  GPScalar<double> maker(L"Freq");
  std::vector<GenericParameter::Ptr> list{boost::make_shared<GPScalar<double>>(L"a", 3.0),
                                          boost::make_shared<GPScalar<double>>(L"b", 1.0),
                                          boost::make_shared<TaggedScalar>(L"c", 2.0)};
  const GenericParameter::Ptr made = maker.FromVectorToGPPtr(list);
  const auto* array = dynamic_cast<const GPArray<double>*>(made.get());
  ASSERT_NE(array, nullptr);
  EXPECT_EQ(array->name(), L"Freq");
  EXPECT_EQ(array->size(), 3u);
  EXPECT_EQ(array->get_values(), (std::vector<double>{3.0, 1.0, 2.0}));
  EXPECT_FALSE(array->get_absent_flag(0));

  std::vector<GenericParameter::Ptr> none;
  const GenericParameter::Ptr empty = maker.FromVectorToGPPtr(none);
  ASSERT_NE(empty, nullptr);
  EXPECT_EQ(empty->size(), 0u);
}

TEST(GPScalar, FromVectorToGPPtrRefusesElementsWithoutAValueOfItsType) {
  GPScalar<double> maker(L"Freq");
  std::vector<GenericParameter::Ptr> foreign{boost::make_shared<GPScalar<double>>(L"a", 1.0),
                                             boost::make_shared<GPScalar<std::int32_t>>(L"b", 2)};
  EXPECT_EQ(maker.FromVectorToGPPtr(foreign), nullptr);
  std::vector<GenericParameter::Ptr> withEmpty{GenericParameter::Ptr()};
  EXPECT_EQ(maker.FromVectorToGPPtr(withEmpty), nullptr);
}

TEST(ValueTypeName, DemangledNamesKeepThePrefixRules) {
  EXPECT_EQ(ValueTypeName(typeid(double)), L"double");
  EXPECT_EQ(ValueTypeName(typeid(std::int32_t)), L"int");
  EXPECT_EQ(ValueTypeName(typeid(Vela::BYPASS_SWITCH_STATE)), L"Vela::BYPASS_SWITCH_STATE");
  const std::wstring text = ValueTypeName(typeid(std::wstring));
  EXPECT_EQ(text.rfind(L"std::", 0), 0u) << text;
  EXPECT_NE(text.find(L"basic_string<wchar_t"), std::wstring::npos) << text;

  EXPECT_EQ(StripTypeKeyword("class CString"), " CString");
  EXPECT_EQ(StripTypeKeyword("CLASS Pack"), " Pack");
  EXPECT_EQ(StripTypeKeyword("enum Vela::BYPASS_SWITCH_STATE"), " Vela::BYPASS_SWITCH_STATE");
  EXPECT_EQ(StripTypeKeyword("Enum Mode"), " Mode");
  EXPECT_EQ(StripTypeKeyword("enum X"), "enum X");      // 6 characters: kept whole
  EXPECT_EQ(StripTypeKeyword("classy"), "classy");
  EXPECT_EQ(StripTypeKeyword("double"), "double");
  EXPECT_EQ(StripTypeKeyword("unsigned int"), "unsigned int");
}

}  // namespace
}  // namespace LumenUtility
