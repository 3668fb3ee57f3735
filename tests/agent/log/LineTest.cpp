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

TEST(LineTest, EscapesEachByteWhereverItStands) {
  for (int value = 0; value < 256; ++value) {
    const auto byte = static_cast<char>(value);
    const bool kept = value >= 0x20 && value != 0x7f && byte != '\\';
    const std::string alone = described(std::string(1, byte)).substr(std::string("4000 C f (F:1): ").size());
    EXPECT_EQ(alone == std::string(1, byte), kept) << value;
    for (std::size_t length = 1; length < 20; ++length) {
      for (std::size_t place = 0; place < length; ++place) {
        std::string text(length, 'x');
        text[place] = byte;
        EXPECT_EQ(described(text),
                  "4000 C f (F:1): " + std::string(place, 'x') + alone + std::string(length - place - 1, 'x'));
      }
    }
  }
}

TEST(LineTest, TellsTimesToTheMicrosecondOverTheAges) {
  using namespace std::chrono;
  const std::string component = "C";
  const std::string text = "x";
  for (const auto& [time, stamp] : std::initializer_list<std::pair<sys_time<microseconds>, const char*>>{
           {sys_days(1970y / 1 / 1) + 0us, "1970-01-01T00:00:00.000000Z"},
           {sys_days(1969y / 12 / 31) + 23h + 59min + 59s + 999999us, "1969-12-31T23:59:59.999999Z"},
           {sys_days(2024y / 2 / 29) + 12h + 5min + 9s + 10us, "2024-02-29T12:05:09.000010Z"},
           {sys_days(2038y / 1 / 19) + 3h + 14min + 8s, "2038-01-19T03:14:08.000000Z"}}) {
    EXPECT_EQ(fileLine(time, 1, {"f", "F", 1, component, 1, text}).substr(0, 27), stamp);
  }
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
