// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <stdexcept>
#include <vector>

#include "ground/IniFile.h"

namespace {

using namespace Ground;
using testing::ElementsAre;

// "LINE [SECTION] KEY=VALUE" for every entry of the text.
std::vector<std::string> entriesOf(const std::string& text) {
  std::istringstream stream(text);
  std::vector<std::string> entries;
  readIni(stream, "test.ini", [&](const IniEntry& entry) {
    entries.push_back(std::to_string(entry.line) + " [" + entry.section + "] " + entry.key + "=" + entry.value);
  });
  return entries;
}

std::string complaintAbout(const std::string& text) {
  std::istringstream stream(text);
  try {
    readIni(stream, "test.ini", [](const IniEntry& entry) {
      if (entry.key == "bad") {
        throw std::invalid_argument("unknown key \"bad\"");
      }
    });
  } catch (const std::runtime_error& error) {
    return error.what();
  }
  return "none";
}

TEST(IniFileTest, PassesKeysInOrderWithTheirLines) {
  EXPECT_THAT(entriesOf("a = 1\n\n; comment\nb=2 ; comment\n[s]\n# comment\na = 3"),
              ElementsAre("1 [] a=1", "4 [] b=2", "7 [s] a=3"));
}

TEST(IniFileTest, TakesAnIndentedLineForAKeyOfItsOwn) {
  EXPECT_THAT(entriesOf("a = 1\n  b = 2\n\t; comment\n  [s]\n \tc = 3\n"),
              ElementsAre("1 [] a=1", "2 [] b=2", "5 [s] c=3"));
}

TEST(IniFileTest, TakesTheLineEndsOfAnySystem) { EXPECT_THAT(entriesOf("a = 1\r\n\r\n"), ElementsAre("1 [] a=1")); }

TEST(IniFileTest, NamesTheFirstLineThatIsWrong) {
  EXPECT_EQ(complaintAbout("a = 1\nb\nbad = 1\n"), "test.ini:2: must be a [section] or a key = value");
  EXPECT_EQ(complaintAbout("a = 1\n  b\n"), "test.ini:2: must be a [section] or a key = value");
  EXPECT_EQ(complaintAbout("a = 1\n  bad = 1\nb\n"), "test.ini:2: unknown key \"bad\"");
  EXPECT_EQ(complaintAbout("a = 1\n[s\n"), "test.ini:2: must be a [section] or a key = value");
  EXPECT_EQ(complaintAbout("\n# " + std::string(5000, 'x')), "test.ini:2: the line is longer than 198 characters");
  EXPECT_EQ(complaintAbout(std::string("a = 1\nb = \0\n", 12)), "test.ini:2: the line contains a null character");
}

}  // namespace
