// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "agent/log/Line.h"

namespace {

using namespace TWLog;

std::string described(const std::string& text) {
  const std::string component = "C";
  return describe({"f", "F", 1, component, 4000, text});
}

TEST(LineTest, TellsLevelComponentLocationAndText) {
  const std::string component = "Tarnwick.IPConfigProvider";
  const std::string text = "EXITING: f() in F [Line: 7]";
  EXPECT_EQ(describe({"f", "F", 7, component, 4000, text}),
            "4000 Tarnwick.IPConfigProvider f (F:7): EXITING: f() in F [Line: 7]");
}

TEST(LineTest, OfAFileStartsWithTheTimeInUtcAndTheProcessAndEndsTheLine) {
  const std::string component = "C";
  const std::string text = "x";
  const auto time = std::chrono::system_clock::time_point(std::chrono::microseconds(1'700'000'000'000'042));
  EXPECT_EQ(fileLine(time, 99, {"f", "F", 1, component, 6000, text}),
            "2023-11-14T22:13:20.000042Z [99] 6000 C f (F:1): x\n");
}

TEST(LineTest, EscapesWhatWouldBreakIt) {
  EXPECT_EQ(described("a\nb\tc\rd\\e"), "4000 C f (F:1): a\\nb\\tc\\rd\\\\e");
  EXPECT_EQ(described(std::string("\0\x1b[2J\x7f", 6)), "4000 C f (F:1): \\x00\\x1b[2J\\x7f");
}

TEST(LineTest, KeepsBytesBeyondAscii) { EXPECT_EQ(described("größe"), "4000 C f (F:1): größe"); }

TEST(LineTest, EscapesTheComponentAndTheLocationToo) {
  const std::string component = "C\n";
  const std::string text = "x";
  EXPECT_EQ(describe({"f\n", "F\n", 1, component, 1, text}), "1 C\\n f\\n (F\\n:1): x");
}

TEST(LineTest, TakesANullLocationAsEmpty) {
  const std::string component = "C";
  const std::string text = "x";
  EXPECT_EQ(describe({nullptr, nullptr, 0, component, 1, text}), "1 C  (:0): x");
}

}  // namespace
