/// @file
/// The host application's main window, as far as the library talks to it: window messages
/// sent to it synchronously.
///
/// The host installs the handler that stands for its window procedure; SendMainWindowMessage
/// calls it on the sender's thread and returns its result, as sending a message to a window
/// of the same thread does. Without a handler there is no main window and a message goes
/// nowhere.
/// Thread-safety: none; install the handler during start-up. Ownership: the handler is kept
/// by value until it is replaced.
#pragma once

#include <cstdint>
#include <functional>

#include "lumen/export.h"

namespace LumenUtility {

/// (message, wParam, lParam) -> the window's result.
using MainWindowHandler =
    std::function<std::intptr_t(std::uint32_t message, std::uintptr_t wParam, std::intptr_t lParam)>;

/// Installs `handler` as the main window; an empty handler removes the window.
LUMEN_API void SetMainWindowHandler(MainWindowHandler handler);

/// Calls the handler with the message and returns its result; 0 when there is no handler.
/// Exceptions of the handler pass through.
LUMEN_API std::intptr_t SendMainWindowMessage(std::uint32_t message, std::uintptr_t wParam,
                                              std::intptr_t lParam);

}  // namespace LumenUtility
