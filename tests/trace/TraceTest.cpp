// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cstdio>
#include <limits>

#include "tests/support/agent/RecordingLog.h"
#include "tests/support/system/AllocationCount.h"
#include "trace/Trace.h"

namespace {

using namespace Testing;

const std::string component = "Tarnwick.Test";
const std::string rule = "==============================================================================";

class TraceTest : public ::testing::Test {
 protected:
  TraceTest() { logLines().clear(); }
};

TEST_F(TraceTest, EachTypeOfLineHasItsForm) {
  EXPECT_STREQ(QV::trace("file", "f", 10, QV::EntryMessage), "ENTERING: f() in file [Line: 10]");
  EXPECT_STREQ(QV::trace("file", "f", 10, QV::ExitMessage), "EXITING: f() in file [Line: 10]");
  EXPECT_STREQ(QV::trace("file", "f", 10, QV::MethodInvokedMessage), "METHOD: f() was invoked in file [Line: 10]");
  EXPECT_STREQ(QV::trace("file", "x", 10, QV::FreeMessage), "MESSAGE [File: file, Line: 10]: x");
}

TEST_F(TraceTest, TypesAreNumberedFromZeroInTheirOrder) {
  EXPECT_EQ(QV::EntryMessage, 0);
  EXPECT_EQ(QV::ExitMessage, 1);
  EXPECT_EQ(QV::MethodInvokedMessage, 2);
  EXPECT_EQ(QV::FreeMessage, 3);
}

TEST_F(TraceTest, AnUnknownTypeYieldsTheEmptyText) {
  EXPECT_STREQ(QV::trace("file", "f", 10, static_cast<QV::MessageType>(7)), "");
}

TEST_F(TraceTest, AVariableLineNamesVariableValueLineAndFile) {
  EXPECT_STREQ(QV::trace("n", "file", 5, "v"), "VARIABLE: 'n' has Value 'v' at line 5 in file");
}

TEST_F(TraceTest, AShorterTextLeavesNothingOfALongerOneBehind) {
  const char* buffer = QV::trace("file", std::string(300, 'x').c_str(), 1, QV::FreeMessage);
  QV::trace("f", "g", 1, QV::EntryMessage);
  const std::size_t length = std::string(buffer).size();
  for (std::size_t i = length; i < 512; ++i) {
    ASSERT_EQ(buffer[i], '\0') << i;
  }

  const char* variable = QV::trace("n", "file", 1, std::string(300, 'x').c_str());
  QV::trace("n", "file", 1, "v");
  for (std::size_t i = std::string(variable).size(); i < 512; ++i) {
    ASSERT_EQ(variable[i], '\0') << i;
  }
}

TEST_F(TraceTest, ALineIsCutAt511Characters) {
  const std::string endless(2000, 'x');
  EXPECT_EQ(std::string(QV::trace("file", endless.c_str(), 1, QV::FreeMessage)).size(), 511u);
  EXPECT_EQ(std::string(QV::trace("n", "file", 1, endless.c_str())).size(), 511u);
}

TEST_F(TraceTest, ALineIsCutWhereverItsEndFalls) {
  for (std::size_t length = 0; length <= 520; ++length) {
    const std::string file(length, 'x');
    char expected[512];
    std::snprintf(expected, sizeof expected, "MESSAGE [File: %s, Line: %d]: %s", file.c_str(), 123456, "text");
    ASSERT_STREQ(QV::trace(file.c_str(), "text", 123456, QV::FreeMessage), expected) << length;
    std::snprintf(expected, sizeof expected, "VARIABLE: '%s' has Value '%s' at line %d in %s", "n", file.c_str(),
                  123456, "file");
    ASSERT_STREQ(QV::trace("n", "file", 123456, file.c_str()), expected) << length;
  }
}

TEST_F(TraceTest, ALineNumberIsShownAsASignedOne) {
  EXPECT_STREQ(QV::trace("file", "f", std::numeric_limits<int>::max(), QV::EntryMessage),
               "ENTERING: f() in file [Line: 2147483647]");
  EXPECT_STREQ(QV::trace("file", "f", 1U << 31U, QV::EntryMessage), "ENTERING: f() in file [Line: -2147483648]");
}

TEST_F(TraceTest, ALineIsFormattedWithoutAnAllocation) {
  const std::string endless(2000, 'x');
  const long before = allocationCount();
  QV::trace("file", endless.c_str(), 1, QV::EntryMessage);
  QV::trace("n", "file", 1, endless.c_str());
  EXPECT_EQ(allocationCount(), before);
}

TEST_F(TraceTest, ANullTextCountsAsEmpty) {
  EXPECT_STREQ(QV::trace(nullptr, static_cast<const char*>(nullptr), 1, QV::EntryMessage),
               "ENTERING: () in  [Line: 1]");
  EXPECT_STREQ(QV::trace("n", "file", 1, static_cast<const char*>(nullptr)),
               "VARIABLE: 'n' has Value '' at line 1 in file");
}

TEST_F(TraceTest, TheTwoOverloadsOwnABufferEach) {
  const char* message = QV::trace("file", "f", 10, QV::EntryMessage);
  const char* variable = QV::trace("n", "file", 5, "v");
  EXPECT_NE(message, variable);
  EXPECT_STREQ(message, "ENTERING: f() in file [Line: 10]");
}

TEST_F(TraceTest, TheEntryMarkerPutsTheRuleBeforeTheEnteringLine) {
  QV::markProviderEntry(component, "Unit", "Operation", 207);
  const std::vector<std::string> expected = {rule, "ENTERING: Operation() in Unit [Line: 207]"};
  EXPECT_EQ(messages(Channel::Log), expected);
  EXPECT_EQ(messages(Channel::Trace), expected);
}

TEST_F(TraceTest, TheExitMarkerPutsTheRuleAfterTheExitingLine) {
  QV::markProviderExit(component, "Unit", "Operation", 265);
  const std::vector<std::string> expected = {"EXITING: Operation() in Unit [Line: 265]", rule};
  EXPECT_EQ(messages(Channel::Log), expected);
  EXPECT_EQ(messages(Channel::Trace), expected);
}

TEST_F(TraceTest, MarkersReportFromTheirOwnPlace) {
  QV::markProviderEntry(component, "Unit", "Operation", 207);
  QV::markProviderExit(component, "Unit", "Operation", 265);
  const std::vector<int> expectedLines = {336, 336, 337, 337, 348, 348, 349, 349};
  ASSERT_EQ(logLines().size(), expectedLines.size());
  for (std::size_t i = 0; i < logLines().size(); ++i) {
    const LogLine& line = logLines()[i];
    EXPECT_EQ(line.line, expectedLines[i]);
    EXPECT_EQ(line.file, "Trace.h");
    EXPECT_EQ(line.function, i < 4 ? "markProviderEntry" : "markProviderExit");
    EXPECT_EQ(line.component, component);
    EXPECT_EQ(line.level, 4000);
    EXPECT_EQ(line.channel, i % 2 == 0 ? Channel::Log : Channel::Trace);
  }
}

TEST_F(TraceTest, AFunctionsLinesCarryItsOwnPlaceAndReachTheLogBeforeTheTrace) {
  const QV::IPConfigComposite::Frame frame(component, "Unit", "function");
  frame.entering(1);
  frame.progress("going", 2);
  frame.variable("n", "v", 3);
  frame.failure("gone", 4);
  frame.exiting(5);
  const std::vector<std::string> expected = {
      "ENTERING: function() in Unit [Line: 1]", "MESSAGE [File: Unit, Line: 2]: going",
      "VARIABLE: 'n' has Value 'v' at line 3 in Unit", "MESSAGE [File: Unit, Line: 4]: gone",
      "EXITING: function() in Unit [Line: 5]"};
  EXPECT_EQ(messages(Channel::Log), expected);
  EXPECT_EQ(messages(Channel::Trace), expected);
  for (std::size_t i = 0; i < logLines().size(); ++i) {
    const LogLine& line = logLines()[i];
    EXPECT_EQ(line.channel, i % 2 == 0 ? Channel::Log : Channel::Trace);
    EXPECT_EQ(line.line, static_cast<int>(i / 2 + 1));
    EXPECT_EQ(line.file, "Unit");
    EXPECT_EQ(line.function, "function");
    EXPECT_EQ(line.level, i / 2 == 3 ? 6000 : 4000);
  }
}

}  // namespace
