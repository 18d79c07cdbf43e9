#include "lumen/globalstate/gp_array.h"

#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include <stdexcept>

#include "lumen/globalstate/gp_ref.h"

namespace LumenUtility {
namespace {

using Rigel::GenericParameter;

template <class T>
GenericParameter::Ptr Scalar(T value) {
  return boost::make_shared<GPScalar<T>>(L"x", value);
}

template <class T>
T ScalarValue(const GenericParameter::Ptr& p) {
  const auto* scalar = dynamic_cast<const GPScalar<T>*>(p.get());
  EXPECT_NE(scalar, nullptr);
  return scalar ? scalar->get_value() : T();
}

TEST(GPArray, AtOnEmptyArrayIsEmptyAndResizeCountsDefaultValues) {
  GPArray<double> array(L"Freq");
  EXPECT_EQ(array.at(0), nullptr);
  EXPECT_EQ(array.referenced_at(0), nullptr);
  array.resize(3);
  EXPECT_EQ(array.size(), 3u);
  EXPECT_EQ(array.total_size(), 3u);
  const GenericParameter::Ptr last = array.at(2);
  ASSERT_NE(last, nullptr);
  EXPECT_EQ(last->name(), L"Freq");
  EXPECT_EQ(ScalarValue<double>(last), 0.0);
  EXPECT_EQ(array.at(3), nullptr);
  EXPECT_FALSE(array.get_change_flag());  // resizing is no change of a value
}

TEST(GPArray, SetAtPastTheEndCountsUpAndGrowsStorageWithRoom) {
  GPArray<double> array(L"P");
  array.set_at(5, Scalar(7.5));
  EXPECT_EQ(array.size(), 6u);
  EXPECT_TRUE(array.get_change_flag());
  ASSERT_EQ(array.get_values().size(), 15u);  // index + 10
  EXPECT_EQ(array.get_values()[5], 7.5);
  for (std::uint32_t i = 0; i < 5; ++i) EXPECT_EQ(ScalarValue<double>(array.at(i)), 0.0) << i;

  // Within the stored values: the count grows, the storage does not.
  array.set_at(9, Scalar(1.0));
  EXPECT_EQ(array.size(), 10u);
  EXPECT_EQ(array.get_values().size(), 15u);
  // Within the count: only the value changes.
  array.set_at(0, Scalar(-2.0));
  EXPECT_EQ(array.size(), 10u);
  EXPECT_EQ(ScalarValue<double>(array.at(0)), -2.0);
}

TEST(GPArray, SetAtIgnoresValuesOfAnotherType) {
  GPArray<double> array(L"P");
  array.set_at(0, Scalar<std::int32_t>(3));
  array.set_at(0, GenericParameter::Ptr());
  array.set_at(0, boost::make_shared<GPArray<double>>(L"P", std::vector<double>{1.0}));
  EXPECT_EQ(array.size(), 0u);
  EXPECT_TRUE(array.get_values().empty());
  EXPECT_FALSE(array.get_change_flag());
}

TEST(GPArray, SetAtTheLastIndexThrowsForTheCountWouldNotFit) {
  GPArray<std::int32_t> array(L"P");
  try {
    array.set_at(0xFFFFFFFFu, Scalar<std::int32_t>(1));
    FAIL() << "stored at index 2^32 - 1";
  } catch (const std::length_error& e) {
    EXPECT_STREQ(e.what(), "GPArray::set_at: index 4294967295 leaves no room for the count");
  }
  EXPECT_EQ(array.size(), 0u);
  EXPECT_FALSE(array.get_change_flag());
}

TEST(GPArray, ShrinkingKeepsStoredValuesForALaterGrowth) {
  GPArray<std::wstring> array(L"Names", {L"a", L"b", L"c"});
  array.resize(1);
  EXPECT_EQ(array.size(), 1u);
  EXPECT_EQ(array.at(1), nullptr);
  array.resize(3);
  EXPECT_EQ(ScalarValue<std::wstring>(array.at(2)), L"c");
  array.resize(5);
  EXPECT_EQ(array.get_values().size(), 5u);
  EXPECT_EQ(ScalarValue<std::wstring>(array.at(4)), L"");
}

TEST(GPArray, AbsentElementsYieldNoObject) {
  GPArray<double> array(L"P", {1.0, 2.0, 3.0});
  EXPECT_TRUE(array.set_absent_flag(1, true));
  EXPECT_FALSE(array.set_absent_flag(3, true));  // past the stored values
  EXPECT_TRUE(array.get_absent_flag(1));
  EXPECT_FALSE(array.get_absent_flag(3));
  EXPECT_EQ(array.at(1), nullptr);
  EXPECT_EQ(array.referenced_at(1), nullptr);
  EXPECT_NE(array.at(2), nullptr);
  // Storing a value leaves the flag as it is.
  array.set_at(1, Scalar(9.0));
  EXPECT_EQ(array.at(1), nullptr);
  array.set_absent_flag(1, false);
  EXPECT_EQ(ScalarValue<double>(array.at(1)), 9.0);
}

TEST(GPArray, ReferenceShowsTheElementAsItIsNow) {
  GPArray<double> array(L"P", {1.0, 2.0});
  const GenericParameter::Ptr ref = array.referenced_at(1);
  ASSERT_NE(ref, nullptr);
  EXPECT_EQ(ref->name(), L"P");
  EXPECT_EQ(ref->value_to_string(false), L"2");
  array.set_at(1, Scalar(4.25));
  EXPECT_EQ(ref->value_to_string(false), L"4.25");
  EXPECT_EQ(ref->to_string(false), L"P 4.25");  // the base form
  EXPECT_EQ(ref->value_type_to_string(), L"");
  EXPECT_EQ(ref->size(), 1u);

  const auto* typed = dynamic_cast<const GPRef<double>*>(ref.get());
  ASSERT_NE(typed, nullptr);
  EXPECT_EQ(typed->get_array(), &array);
  EXPECT_EQ(typed->get_index(), 1u);
  EXPECT_TRUE(typed->is_same_type(ref->clone()));
  EXPECT_FALSE(typed->is_same_type(array.at(0)));
  EXPECT_EQ(ref->clone()->value_to_string(false), L"4.25");
  EXPECT_TRUE(ref->IsEqual(*ref));
  EXPECT_FALSE(ref->IsEqual(*ref->clone()));  // the base compares identity only
}

TEST(GPRef, ReferenceWithoutAnElementShowsNothing) {
  EXPECT_EQ(GPRef<double>().value_to_string(false), L"");
  GPArray<std::int32_t> array(L"P", {5});
  EXPECT_EQ(GPRef<std::int32_t>(L"P", &array, 1).value_to_string(false), L"");
  EXPECT_EQ(GPRef<std::int32_t>(L"P", &array, 0).value_to_string(false), L"5");
  const GenericParameter::Ptr fresh = GPRef<std::int32_t>(L"P", &array, 0).create_default();
  const auto* typed = dynamic_cast<const GPRef<std::int32_t>*>(fresh.get());
  ASSERT_NE(typed, nullptr);
  EXPECT_EQ(typed->get_array(), nullptr);
  EXPECT_EQ(typed->name(), L"");
}

TEST(GPArray, IsEqualComparesCountedElementsAndTheirAbsentFlags) {
  const GPArray<double> a(L"P", {1.0, 2.0});
  EXPECT_TRUE(a.IsEqual(a));
  EXPECT_TRUE(a.IsEqual(GPArray<double>(L"P", {1.0, 2.0})));
  EXPECT_FALSE(a.IsEqual(GPArray<double>(L"Q", {1.0, 2.0})));
  EXPECT_FALSE(a.IsEqual(GPArray<double>(L"P", {1.0, 3.0})));
  EXPECT_FALSE(a.IsEqual(GPArray<double>(L"P", {1.0})));
  EXPECT_FALSE(a.IsEqual(GPArray<std::int32_t>(L"P", {1, 2})));
  EXPECT_FALSE(a.IsEqual(GPScalar<double>(L"P", 1.0)));

  // Values stored past the count do not count.
  GPArray<double> longer(L"P", {1.0, 2.0, 99.0});
  longer.resize(2);
  EXPECT_TRUE(a.IsEqual(longer));

  // Absent elements match each other whatever they store, never a present one.
  GPArray<double> b(L"P", {1.0, 5.0});
  GPArray<double> c(L"P", {1.0, 6.0});
  b.set_absent_flag(1, true);
  EXPECT_FALSE(b.IsEqual(c));
  c.set_absent_flag(1, true);
  EXPECT_TRUE(b.IsEqual(c));
}

TEST(GPArray, TextFormsListTheCountedValues) {
  GPArray<double> p(L"P", {1.0, 2.0});
  EXPECT_EQ(p.to_string(false), L"GPArray<double> P[2]  [ 1 2 ]\n");
  EXPECT_EQ(p.to_string(true), L"GPArray<double> P[2]  [ ]\n");
  EXPECT_EQ(p.value_to_string(false), L" [ 1 2 ]\n");
  p.resize(1);
  EXPECT_EQ(p.value_to_string(false), L" [ 1 ]\n");
  EXPECT_EQ(GPArray<double>().to_string(false), L"GPArray<double> [0]  [ ]\n");
  EXPECT_EQ(GPArray<std::int32_t>(L"S", {-3, 4}).to_string(false), L"GPArray<int> S[2]  [ -3 4 ]\n");
  EXPECT_EQ(GPArray<std::wstring>(L"T", {L"a b", L"c"}).value_to_string(false), L" [ a b c ]\n");
  EXPECT_EQ(GPArray<Vela::BYPASS_SWITCH_STATE>(L"B", {Vela::BYPASS_SWITCH_THRU}).to_string(false),
            L"GPArray<Vela::BYPASS_SWITCH_STATE> B[1]  [ 0 ]\n");
}

TEST(GPArray, CloneIsAnIndependentCopyAndCreateDefaultIsEmpty) {
  GPArray<double> a(L"P", {1.0, 2.0});
  a.set_absent_flag(0, true);
  const GenericParameter::Ptr copy = a.clone();
  a.set_at(1, Scalar(8.0));
  EXPECT_EQ(copy->to_string(false), L"GPArray<double> P[2]  [ 1 2 ]\n");
  EXPECT_EQ(copy->at(0), nullptr);  // the flag came along
  EXPECT_TRUE(a.is_same_type(copy));
  EXPECT_FALSE(a.is_same_type(Scalar(1.0)));
  const GenericParameter::Ptr fresh = a.create_default();
  EXPECT_TRUE(a.is_same_type(fresh));
  EXPECT_EQ(fresh->size(), 0u);
  EXPECT_EQ(fresh->name(), L"");
}

}  // namespace
}  // namespace LumenUtility
