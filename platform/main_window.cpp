#include "lumen/platform/main_window.h"

namespace LumenUtility {

namespace {

MainWindowHandler& Handler() {
  static MainWindowHandler handler;
  return handler;
}

}  // namespace

void SetMainWindowHandler(MainWindowHandler handler) {
  Handler() = std::move(handler);
}

std::intptr_t SendMainWindowMessage(std::uint32_t message, std::uintptr_t wParam,
                                    std::intptr_t lParam) {
  // Call a copy: the window may install another handler while it handles the message.
  const MainWindowHandler handler = Handler();
  return handler ? handler(message, wParam, lParam) : 0;
}

}  // namespace LumenUtility
