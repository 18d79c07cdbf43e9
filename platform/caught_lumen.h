// Test helper: what a LumenException thrown by a piece of code carries.
#pragma once

#include <string>
#include <utility>

#include "lumen/platform/lumen_exception.h"

namespace LumenUtility::testutil {

// Runs `f` and returns the code and first message of the LumenException it throws, or
// {S_OK, "nothing thrown"}.
template <typename F>
std::pair<HRESULT, std::wstring> CaughtLumen(F f) {
  try {
    f();
  } catch (const LumenException& e) {
    return {e.GetCode(), e.GetMessage()};
  }
  return {S_OK, L"nothing thrown"};
}

}  // namespace LumenUtility::testutil
