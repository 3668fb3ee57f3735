// The logging library as its callers have it: the shared library behind its contract. agent.ini is read once in a
// process, so each case that needs one of its own runs in a child.
#include <TWLog/TWLog.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <thread>
#include <vector>

#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::ExitedWithCode;

void log(const std::string& component, int level, const std::string& text) {
  TWLog::TWLogger::logLevelMessage("f", "F", 1, component, level, nullptr, 0, 0, text);
}

void trace(const std::string& component, int level, const std::string& text) {
  TWLog::TWLogger::traceLevelMessage("f", "F", 1, component, level, nullptr, 0, 0, text);
}

// Runs the statements in a child that has this agent.ini.
template <typename Statements>
void inChildWith(const std::string& ini, const Statements& statements) {
  ::setenv("QV_AGENT_INI", ini.c_str(), 1);
  EXPECT_EXIT(
      {
        statements();
        std::exit(0);
      },
      ExitedWithCode(0), "");
  ::unsetenv("QV_AGENT_INI");
}

TEST(MessageBufferTest, CollectsTextAndSkipsNulls) {
  TWLog::TWMessageBuffer buffer;
  buffer << "a" << nullptr << "b";
  EXPECT_EQ(str(buffer), "ab");
}

TEST(MessageBufferTest, IsEmptyOnceItsTextIsTaken) {
  TWLog::TWMessageBuffer buffer;
  buffer << "line";
  EXPECT_EQ(str(buffer), "line");
  EXPECT_EQ(str(buffer), "");
  buffer << "line";
  EXPECT_EQ(str(buffer), "line");
}

TEST(LoggerTest, SendsTheLogAndTheTraceTheirOwnWays) {
  const TemporaryDirectory directory;
  const std::string ini = directory / "agent.ini";
  writeFile(ini, "[log]\ndestination = file\nfile = " + (directory / "log") + "\nthreshold.watched = 4000\n" +
                     "[trace]\ndestination = file\nfile = " + (directory / "trace") + "\n");
  inChildWith(ini, [] {
    log("C", 4000, "no");
    log("C", 6000, "failure");
    log("watched", 4000, "progress");
    trace("C", 3999, "no");
    trace("C", 4000, "step");
  });
  EXPECT_THAT(readFile(directory / "log"),
              testing::MatchesRegex(".* 6000 C f \\(F:1\\): failure\n.* 4000 watched f \\(F:1\\): progress\n"));
  EXPECT_THAT(readFile(directory / "trace"), testing::MatchesRegex(".* 4000 C f \\(F:1\\): step\n"));
}

TEST(LoggerTest, ReportsABrokenAgentIniOnceAndGoesOn) {
  const TemporaryDirectory directory;
  const std::string ini = directory / "agent.ini";
  writeFile(ini, "[log]\ndestination = mail\n");
  ::setenv("QV_AGENT_INI", ini.c_str(), 1);
  const auto report = [] {
    log("C", 6000, "one");
    log("C", 6000, "two");
    trace("C", 6000, "three");
    std::exit(0);
  };
  EXPECT_EXIT(report(), ExitedWithCode(0),
              "^management agent: [^\n]*agent.ini:2: .log. destination = mail: must be one of [^\n]*; logging with the "
              "defaults\n$");
  ::unsetenv("QV_AGENT_INI");
}

TEST(LoggerTest, ReportsAMissingAgentIniOnceWithWhatToDoAndGoesOn) {
  ::setenv("QV_AGENT_INI", "/nowhere/agent.ini", 1);
  const auto report = [] {
    log("C", 6000, "one");
    log("C", 6000, "two");
    std::exit(0);
  };
  EXPECT_EXIT(report(), ExitedWithCode(0),
              "^management agent: /nowhere/agent.ini: cannot be opened: No such file or directory; create it[^\n]*; "
              "logging with the defaults\n$");
  ::unsetenv("QV_AGENT_INI");
}

TEST(LoggerTest, TakesMessagesFromSeveralThreads) {
  const TemporaryDirectory directory;
  const std::string ini = directory / "agent.ini";
  writeFile(ini, "[log]\ndestination = file\nfile = " + (directory / "log") + "\n");
  inChildWith(ini, [] {
    std::vector<std::jthread> threads;
    for (int thread = 0; thread < 4; ++thread) {
      threads.emplace_back([] {
        for (int count = 0; count < 250; ++count) {
          log("C", 6000, "x");
        }
      });
    }
  });
  const std::string text = readFile(directory / "log");
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 1000);
}

}  // namespace
