#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ground/Settings.h"
#include "ground/Values.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace Ground;
using namespace Testing;
using namespace std::chrono_literals;
using testing::ElementsAre;

TEST(ValuesTest, TakesANumberWithinItsRange) {
  EXPECT_EQ(parseNumber("1", 1, 11), 1U);
  EXPECT_EQ(parseNumber("11", 1, 11), 11U);
  for (const char* text : {"0", "12", "-1", "+1", " 1", "1 ", "1x", "", "99999999999999999999"}) {
    EXPECT_EQ(thrownBy([&] { parseNumber(text, 1, 11); }), "must be a number from 1 to 11") << text;
  }
}

TEST(ValuesTest, TakesSecondsWithDecimals) {
  EXPECT_EQ(parseSeconds("0.25", 100ms, 60s), 250ms);
  EXPECT_EQ(parseSeconds("60", 100ms, 60s), 60s);
  for (const char* text : {"0", "61", "nan", "inf", "1e1", "5s", ""}) {
    EXPECT_EQ(thrownBy([&] { parseSeconds(text, 100ms, 60s); }), "must be seconds from 0.1 to 60") << text;
  }
}

TEST(ValuesTest, SplitsAListAtCommasAndBlanks) {
  EXPECT_THAT(parseList(" a, b\tc,,d "), ElementsAre("a", "b", "c", "d"));
  EXPECT_EQ(thrownBy([] { parseList(", "); }), "must not be an empty list");
}

TEST(ValuesTest, NamesTheWordsOfAChoice) {
  const std::vector<std::pair<std::string, int>> choices = {{"one", 1}, {"two", 2}};
  EXPECT_EQ(parseChoice("two", choices), 2);
  EXPECT_EQ(thrownBy([&] { parseChoice("Two", choices); }), "must be one of one, two");
}

TEST(ValuesTest, TakesYesAndNoAndNothingElseForABoolean) {
  EXPECT_TRUE(parseBoolean("yes"));
  EXPECT_FALSE(parseBoolean("no"));
  for (const char* text : {"true", "1", "Yes", "on", ""}) {
    EXPECT_EQ(thrownBy([&] { parseBoolean(text); }), "must be one of yes, no") << text;
  }
}

TEST(ValuesTest, RefusesARelativePathAndAnEmptyText) {
  EXPECT_EQ(parseAbsolutePath("/a"), "/a");
  EXPECT_EQ(thrownBy([] { parseAbsolutePath("a"); }), "must be an absolute path");
  EXPECT_EQ(thrownBy([] { parseText(""); }), "must not be empty");
}

TEST(SettingsTest, NamesPlaceKeyValueAndReason) {
  const Settings::Section section = {{"port", "0"}, {"name", ""}};
  const Settings settings("file.ini, [section]", section);
  int port = 7;
  std::string name;
  EXPECT_EQ(thrownBy([&] { settings.number("port", port, 1, 9); }),
            "file.ini, [section]: port = 0: must be a number from 1 to 9");
  EXPECT_EQ(thrownBy([&] { settings.text("name", name); }),
            "file.ini, [section]: name = : the key is missing and has no default");
}

TEST(SettingsTest, LeavesTheTargetOfAMissingKeyAsItIs) {
  const Settings::Section section;
  int port = 7;
  Settings("file.ini", section).number("port", port, 1, 9);
  EXPECT_EQ(port, 7);
}

}  // namespace
