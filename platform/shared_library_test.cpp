#include "lumen/platform/shared_library.h"

#include <gtest/gtest.h>

namespace {

using LumenUtility::SharedObjectFileName;

TEST(SharedObjectFileName, DllSuffixBecomesLibPrefixAndSoSuffix) {
  EXPECT_EQ(SharedObjectFileName(L"Ferrule_rev7.dll"), "libFerrule_rev7.so");
  EXPECT_EQ(SharedObjectFileName(L"Ferrule_rev7.DLL"), "libFerrule_rev7.so");
  EXPECT_EQ(SharedObjectFileName(L"Ferrule"), "libFerrule.so");
}

TEST(SharedObjectFileName, DirectoryIsKeptInFrontOfTheMappedName) {
  EXPECT_EQ(SharedObjectFileName(L"/opt/drv/Ferrule.dll"), "/opt/drv/libFerrule.so");
  EXPECT_EQ(SharedObjectFileName(L"drv/x.dll"), "drv/libx.so");
}

TEST(SharedObjectFileName, NamesWithoutAStemGiveNothing) {
  EXPECT_EQ(SharedObjectFileName(L""), "");
  EXPECT_EQ(SharedObjectFileName(L"/opt/drv/"), "");
  // ".dll" alone is a stem, not a suffix.
  EXPECT_EQ(SharedObjectFileName(L".dll"), "lib.dll.so");
}

TEST(LoadLibraryW, MissingOrEmptyNamesGiveNoHandle) {
  EXPECT_EQ(LumenUtility::LoadLibraryW(nullptr), nullptr);
  EXPECT_EQ(LumenUtility::LoadLibraryW(L""), nullptr);
  EXPECT_EQ(LumenUtility::LoadLibraryW(L"No_such_module_4711.dll"), nullptr);
  EXPECT_EQ(LumenUtility::GetProcAddress(nullptr, "startHalcyon"), nullptr);
}

}  // namespace
