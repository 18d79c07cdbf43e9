#include "lumen/util/factory.h"

#include <gtest/gtest.h>

#include <boost/function/function_base.hpp>
#include <string>

namespace LumenUtility {
namespace {

constexpr const char* kEmpty = "call to empty boost::function";

// The text of the boost::bad_function_call that Create(key) throws, or "created".
std::string CreateError(IFactory& factory, const std::wstring& key) {
  try {
    factory.Create(key);
  } catch (const boost::bad_function_call& e) {
    return e.what();
  }
  return "created";
}

TEST(Factory, CreateRunsTheLatestCreatorOncePerCallAndKeysAreCaseSensitive) {
  Factory factory;
  int calls = 0;
  factory.Register(L"A", [&calls] { return boost::any(++calls); });
  EXPECT_EQ(boost::any_cast<int>(factory.Create(L"A")), 1);
  EXPECT_EQ(boost::any_cast<int>(factory.Create(L"A")), 2);
  // A second registration replaces the first; keys are case-sensitive.
  factory.Register(L"A", [] { return boost::any(std::wstring(L"second")); });
  EXPECT_EQ(boost::any_cast<std::wstring>(factory.Create(L"A")), L"second");
  EXPECT_EQ(CreateError(factory, L"a"), kEmpty);
}

TEST(Factory, UnknownOrUnregisteredKeyThrowsAndLeavesEmptyEntry) {
  Factory factory;
  factory.Unregister(L"never");  // absent: ignored
  factory.Register(L"A", [] { return boost::any(5); });
  factory.Unregister(L"A");
  EXPECT_EQ(CreateError(factory, L"A"), kEmpty);
  EXPECT_EQ(CreateError(factory, L"B"), kEmpty);

  // The empty entry left behind takes a later registration like any other.
  factory.Register(L"B", [] { return boost::any(6); });
  EXPECT_EQ(boost::any_cast<int>(factory.Create(L"B")), 6);
  factory.Register(L"C", FactoryCreator());  // registering an empty creator is allowed
  EXPECT_EQ(CreateError(factory, L"C"), kEmpty);
}

TEST(Factory, CreatorMayUnregisterItself) {
  Factory factory;
  // The captured text lives in the creator, and is read after the creator's entry is erased.
  factory.Register(L"once", [&factory, text = std::string(1000, 'x')] {
    factory.Unregister(L"once");
    return boost::any(text);
  });
  EXPECT_EQ(boost::any_cast<std::string>(factory.Create(L"once")).size(), 1000u);
  EXPECT_EQ(CreateError(factory, L"once"), kEmpty);
}

TEST(Factory, ProcessWideFactoryIsShared) {
  boost::shared_ptr<IFactory> first = CreateFactory();
  boost::shared_ptr<IFactory> second = CreateFactory();
  ASSERT_EQ(first.get(), second.get());
  first->Register(L"factory-test-key", [] { return boost::any(3); });
  EXPECT_EQ(boost::any_cast<int>(second->Create(L"factory-test-key")), 3);
  first->Unregister(L"factory-test-key");
}

}  // namespace
}  // namespace LumenUtility
