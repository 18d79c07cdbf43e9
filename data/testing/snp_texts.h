// Small Touchstone files shared by the reader's tests, and the corruption they start from.
#pragma once

#include <gtest/gtest.h>

#include <string>

namespace LumenUtility::fixtures {

// Two-port network in version 1 order (11, 21, 12, 22), magnitude and angle.
inline constexpr const char kV1TwoPort[] =
    "! two-port test network\n"
    "# GHZ S MA R 50\n"
    "1 0.5 0 0.1 90 0.2 0 0.4 45\n"
    "2 0.6 10 0.3 80 0.2 5 0.5 40\n";

// The same network in version 2 with 11, 12, 21, 22 order.
inline constexpr const char kV2TwoPort[] =
    "[Version] 2.0\n"
    "# GHz S MA R 50\n"
    "[Number of Ports] 2\n"
    "[Two-Port Data Order] 12_21\n"
    "[Number of Frequencies] 2\n"
    "[Network Data]\n"
    "1 0.5 0 0.2 0 0.1 90 0.4 45\n"
    "2 0.6 10 0.2 5 0.3 80 0.5 40\n"
    "[End]\n";

// The network of kV1TwoPort followed by two noise records.
inline constexpr const char kV1Noise[] =
    "# GHZ S MA R 50\n"
    "1 0.5 0 0.1 90 0.2 0 0.4 45\n"
    "2 0.6 10 0.3 80 0.2 5 0.5 40\n"
    "! Noise Parameters\n"
    "1 3 0.5 45 0.2\n"
    "2 4 0.25 30 0.3\n";

// `text` with its first `from` replaced by `to`; the calling test fails if `from` is absent.
inline std::string Replace(std::string text, const std::string& from, const std::string& to) {
  const std::size_t at = text.find(from);
  EXPECT_NE(at, std::string::npos) << from;
  if (at != std::string::npos) text.replace(at, from.size(), to);
  return text;
}

}  // namespace LumenUtility::fixtures
