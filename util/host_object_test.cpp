#include "lumen/util/host_object.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <typeinfo>
#include <vector>

#include "lumen/util/capabilities_accessor.h"

namespace LumenUtility {
namespace {

// Each test uses its own categories: the table is process-wide and shared by all tests.

class IProbe {
 public:
  virtual int Answer() const = 0;

 protected:
  ~IProbe() = default;
};

class IOtherProbe {
 public:
  virtual int Other() const = 0;

 protected:
  ~IOtherProbe() = default;
};

// Two bases, so the IProbe part sits at an offset from the object's start.
class Probe final : public IOtherProbe, public IProbe {
 public:
  explicit Probe(int answer) : m_answer(answer) {}
  int Answer() const override { return m_answer; }
  int Other() const override { return -m_answer; }

 private:
  int m_answer;
};

TEST(CapabilitiesAccessor, IsOneProcessWideObjectWhereTypesRegisterOnceInOrder) {
  ICapabilitiesAccessor* accessor = CreateCapabilitiesAccessor();
  EXPECT_EQ(CreateCapabilitiesAccessor(), accessor);

  CapabilitiesAccessor second;  // holds no data of its own
  second.SetCapability(40, 1, 2, 99);
  EXPECT_EQ(accessor->GetCapability(40, 1, 2), 99);
  EXPECT_EQ(accessor->ClearCapability(40, 1, 2), 2);
  EXPECT_EQ(second.GetCapability(40, 1, 2), 0);

  // Types register once, in order.
  struct FirstType {};
  struct SecondType {};
  const int first = accessor->RegisterType(typeid(FirstType*));
  EXPECT_EQ(accessor->RegisterType(typeid(SecondType*)), first + 1);
  EXPECT_EQ(accessor->RegisterType(typeid(FirstType*)), first);
  EXPECT_NE(accessor->RegisterType(typeid(FirstType)), first);  // pointer type is the key
}

TEST(HostObject, RealObjectRoundTripsThroughTable) {
  auto probe = std::make_unique<Probe>(42);
  IProbe* asProbe = probe.get();
  // The round trip only proves something if the address needs more than 32 bits.
  ASSERT_GT(reinterpret_cast<std::uintptr_t>(asProbe), std::uintptr_t{0xFFFFFFFF});
  ASSERT_NE(static_cast<void*>(asProbe), static_cast<void*>(probe.get()));

  EXPECT_EQ(FindHostObject<IProbe>(41, 0), nullptr);
  RegisterHostObject<IProbe>(41, 0, probe.get());
  IProbe* found = FindHostObject<IProbe>(41, 0);
  ASSERT_EQ(found, asProbe);
  EXPECT_EQ(found->Answer(), 42);
  EXPECT_EQ(FindHostObject<IOtherProbe>(41, 0), nullptr);  // type is part of the key
  EXPECT_EQ(FindHostObject<IProbe>(41, 1), nullptr);

  // Removal takes the object out of every index of the category, and only that object.
  Probe other(5);
  RegisterHostObject<IProbe>(41, 2, probe.get());
  RegisterHostObject<IProbe>(41, 1, &other);
  RemoveHostObject<IProbe>(41, static_cast<IProbe*>(nullptr));  // not a wildcard
  RemoveHostObject<IProbe>(41, probe.get());
  EXPECT_EQ(FindHostObject<IProbe>(41, 0), nullptr);
  EXPECT_EQ(FindHostObject<IProbe>(41, 2), nullptr);
  EXPECT_EQ(FindHostObject<IProbe>(41, 1), &other);
  RemoveHostObject<IProbe>(41, &other);
}

TEST(HostObject, FindsObjectsRegisteredThroughRawAccessor) {
  Probe probe(7);
  ICapabilitiesAccessor* accessor = CreateCapabilitiesAccessor();
  const int typeIndex = accessor->RegisterType(typeid(IOtherProbe*));
  accessor->SetCapability(42, 3, typeIndex,
                          reinterpret_cast<std::intptr_t>(static_cast<IOtherProbe*>(&probe)));
  IOtherProbe* found = FindHostObject<IOtherProbe>(42, 3);
  ASSERT_NE(found, nullptr);
  EXPECT_EQ(found->Other(), -7);
  EXPECT_EQ(accessor->FindCapabilities(42, typeIndex), std::vector<int>{3});
  RemoveHostObject<IOtherProbe>(42, &probe);
}

}  // namespace
}  // namespace LumenUtility
