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

TEST(GenericParameter, BaseIsOneValueWithAChangeFlagAndNoElements) {
  NamedValue value(L"Freq");
  EXPECT_FALSE(value.get_change_flag());
  value.set_change_flag();
  EXPECT_TRUE(value.get_change_flag());
  value.clear_change_flag();
  EXPECT_FALSE(value.get_change_flag());

  const GenericParameter::Ptr other = boost::make_shared<NamedValue>(L"Freq");
  EXPECT_EQ(value.at(0), nullptr);
  EXPECT_EQ(value.referenced_at(0), nullptr);
  value.set_at(0, other);
  EXPECT_FALSE(value.append(other));
  EXPECT_FALSE(value.insert(0, other));
  EXPECT_EQ(value.ptr_find(L"Freq"), nullptr);
  EXPECT_EQ(value.pos_find(L"Freq"), -1);
  EXPECT_EQ(value.ptr_quick_search(L"Freq"), nullptr);
  EXPECT_FALSE(value.remove(0));
  value.resize(5);
  EXPECT_EQ(value.size(), 1u);
  EXPECT_EQ(value.total_size(), 1u);
  EXPECT_EQ(value.to_string(false), L"Freq v");
  EXPECT_EQ(value.to_string(true), L"Freq -");
  EXPECT_EQ(value.value_type_to_string(), L"");
  std::vector<GenericParameter::Ptr> list{other};
  EXPECT_EQ(value.FromVectorToGPPtr(list), nullptr);
  // The base knows no values: equal only to itself, even to a copy.
  EXPECT_TRUE(value.IsEqual(value));
  EXPECT_FALSE(value.IsEqual(*other));
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
