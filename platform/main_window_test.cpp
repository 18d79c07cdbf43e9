#include "lumen/platform/main_window.h"

#include <gtest/gtest.h>

#include <vector>

namespace LumenUtility {
namespace {

TEST(MainWindow, MessageReachesTheInstalledHandlerAtOnce) {
  SetMainWindowHandler(nullptr);
  EXPECT_EQ(SendMainWindowMessage(0x42C, 0, 0), 0);  // no window: nowhere to go

  std::vector<std::uint32_t> received;
  SetMainWindowHandler([&received](std::uint32_t message, std::uintptr_t wParam,
                                   std::intptr_t lParam) -> std::intptr_t {
    received.push_back(message);
    return static_cast<std::intptr_t>(wParam) + lParam;
  });
  EXPECT_EQ(SendMainWindowMessage(0x42C, 2, 3), 5);
  EXPECT_EQ(received, std::vector<std::uint32_t>{0x42C});

  // A handler that removes the window while it runs finishes its message.
  SetMainWindowHandler([](std::uint32_t, std::uintptr_t, std::intptr_t) -> std::intptr_t {
    SetMainWindowHandler(nullptr);
    return 9;
  });
  EXPECT_EQ(SendMainWindowMessage(1, 0, 0), 9);
  EXPECT_EQ(SendMainWindowMessage(1, 0, 0), 0);
}

}  // namespace
}  // namespace LumenUtility
