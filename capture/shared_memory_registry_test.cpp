#include "capture/shared_memory_registry.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

#include "capture/shm_test_util.h"
#include "lumen/capture/file_mapping_with_view.h"

namespace LumenUtility {
namespace {

using testutil::BlockNameExists;
using testutil::UniqueBlockName;

TEST(SharedMemoryRegistry, ErrnoValuesBecomeWin32StyleCodes) {
  EXPECT_EQ(HResultFromOsError(2), static_cast<HRESULT>(0x80070002));
  EXPECT_EQ(HResultFromOsError(0x12345), static_cast<HRESULT>(0x80072345));
  EXPECT_EQ(HResultFromOsError(0), 0);
  EXPECT_EQ(HResultFromOsError(-5), -5);
  EXPECT_EQ(SharedMemoryRegistry::ObjectName(L"VNASharedMemory_1_\u00e9"),
            "/VNASharedMemory_1_\xc3\xa9");
}

// Threads that each open and drop mappings of one shared name, and of a name of their own,
// meet only in the table of created names; the name is removed once, after the last holder.
TEST(SharedMemoryRegistry, ThreadsOpeningAndDroppingOneNameKeepItsHoldersCounted) {
  constexpr int kThreads = 3;
  constexpr int kRounds = 300;
  const std::wstring shared = UniqueBlockName("threads");
  const std::string sharedObject = SharedMemoryRegistry::ObjectName(shared);
  std::atomic<int> mismatches{0};
  {
    FileMappingWithView<float> anchor(shared, kThreads);  // keeps the memory in one place
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
      threads.emplace_back([&, t] {
        const std::wstring own = UniqueBlockName("thread-" + std::to_string(t));
        for (int round = 0; round < kRounds; ++round) {
          FileMappingWithView<float> view(shared, kThreads);
          FileMappingWithView<float> mine(own, 1);
          *view.GetPtr(t) = static_cast<float>(round);
          *mine.GetPtr(0) = static_cast<float>(round);
          if (*view.GetPtr(t) != static_cast<float>(round)) ++mismatches;
        }
        if (BlockNameExists(own)) ++mismatches;
      });
    }
    for (std::thread& thread : threads) thread.join();
    for (int t = 0; t < kThreads; ++t) EXPECT_EQ(*anchor.GetPtr(t), kRounds - 1.0f);
    EXPECT_TRUE(SharedMemoryRegistry::IsHeld(sharedObject));
  }
  EXPECT_EQ(mismatches.load(), 0);
  EXPECT_FALSE(SharedMemoryRegistry::IsHeld(sharedObject));
  EXPECT_FALSE(BlockNameExists(shared));
}

}  // namespace
}  // namespace LumenUtility
