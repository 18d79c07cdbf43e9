#include "lumen/platform/rigel/cp_collection.h"

#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include "lumen/platform/rigel/data_acquisition_specification.h"

namespace Rigel {
namespace {

// The least value a test needs: a name and a fixed text.
class NamedValue final : public GenericParameter {
 public:
  explicit NamedValue(std::wstring name) : GenericParameter(std::move(name)) {}
  Ptr create_default() const override { return boost::make_shared<NamedValue>(L""); }
  Ptr clone() const override { return boost::make_shared<NamedValue>(*this); }
  bool is_same_type(const Ptr& other) const override {
    return dynamic_cast<const NamedValue*>(other.get()) != nullptr;
  }
  std::wstring value_to_string(bool brief) const override { return brief ? L"-" : L"v"; }
};

CPCollection::Entry Entry(const std::wstring& element, const std::wstring& parameter) {
  return boost::make_shared<CommandParameter>(element, boost::make_shared<NamedValue>(parameter));
}

TEST(CPCollection, FindsTheFirstEntryOfAnElementAndParameterByExactNames) {
  CPCollection collection;
  const auto first = Entry(L"RFSrc0", L"Freq");
  collection.append(Entry(L"Path_Manager", L"Freq"));
  collection.append(first);
  collection.append(Entry(L"RFSrc0", L"Freq"));
  collection.append(boost::make_shared<CommandParameter>(L"RFSrc0", nullptr));
  collection.append(nullptr);  // ignored

  ASSERT_EQ(collection.size(), 4u);
  EXPECT_EQ(collection.ptr_find(L"RFSrc0", L"Freq"), first);
  EXPECT_EQ(collection.ptr_find_index(L"RFSrc0", L"Freq"), 1);
  EXPECT_EQ(collection.ptr_find_index(L"rfsrc0", L"Freq"), -1);
  EXPECT_EQ(collection.ptr_find_index(L"RFSrc0", L"freq"), -1);
  EXPECT_EQ(collection.ptr_find(L"RFSrc0", L""), nullptr);  // the entry without a value
  EXPECT_EQ(collection.at(3)->parameter_name(), L"");
  EXPECT_EQ(collection.at(4), nullptr);
}

TEST(CPCollection, RemoveTakesOutOneEntryAndRefusesPositionsOutside) {
  CPCollection collection;
  collection.append(Entry(L"A", L"x"));
  collection.append(Entry(L"B", L"y"));
  EXPECT_FALSE(collection.remove(-1));
  EXPECT_FALSE(collection.remove(2));
  EXPECT_EQ(collection.size(), 2u);
  EXPECT_TRUE(collection.remove(0));
  ASSERT_EQ(collection.size(), 1u);
  EXPECT_EQ(collection.at(0)->element_name(), L"B");
  EXPECT_EQ(collection.ptr_find_index(L"B", L"y"), 0);
}

TEST(GenericParameter, BaseKeepsAChangeFlagAndComparesByIdentity) {
  NamedValue value(L"Freq");
  EXPECT_FALSE(value.get_change_flag());
  value.set_change_flag();
  EXPECT_TRUE(value.get_change_flag());
  EXPECT_TRUE(NamedValue(value).get_change_flag());  // a copy takes the flag along
  value.clear_change_flag();
  EXPECT_FALSE(value.get_change_flag());

  EXPECT_EQ(value.to_string(false), L"Freq v");
  EXPECT_EQ(value.to_string(true), L"Freq -");
  // The base knows no values: equal only to itself, even to a copy; no elements to index.
  EXPECT_TRUE(value.IsEqual(value));
  EXPECT_FALSE(value.IsEqual(NamedValue(value)));
  EXPECT_EQ(value.at(0), nullptr);
  EXPECT_EQ(value.size(), 1u);
}

TEST(DataAcquisitionSpecification, DimensionsAreCountedAndAskedForByIndex) {
  DataAcquisitionSpecification das;
  EXPECT_EQ(das.get_number_of_dimensions(), 0u);
  EXPECT_EQ(das.get_dimension(0), nullptr);
  const auto dimension = boost::make_shared<CPDimension>();
  das.get_dynamic_spec().push_back(dimension);
  das.get_static_spec().append(Entry(L"Path_Manager", L"RefSel"));
  EXPECT_EQ(das.get_number_of_dimensions(), 1u);
  EXPECT_EQ(das.get_dimension(0), dimension);
  EXPECT_EQ(das.get_dimension(1), nullptr);
  EXPECT_EQ(das.get_static_spec().size(), 1u);
}

}  // namespace
}  // namespace Rigel
