// SPDX-License-Identifier: Apache-2.0
// What the agent's own code reports reaches both channels alike. agent.ini is read once in a process, so each case runs
// in a child.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>

#include "agent/log/Report.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::ExitedWithCode;
using testing::IsEmpty;
using testing::MatchesRegex;

class ReportTest : public testing::Test {
 protected:
  ReportTest() {
    writeFile(directory_ / "agent.ini", "[log]\ndestination = file\nfile = " + (directory_ / "log") +
                                            "\n[trace]\ndestination = file\nfile = " + (directory_ / "trace") + "\n");
    ::setenv("QV_AGENT_INI", (directory_ / "agent.ini").c_str(), 1);
  }
  ~ReportTest() override { ::unsetenv("QV_AGENT_INI"); }

  // Runs the statement in a child of its own.
  template <typename Statement>
  static void inChild(const Statement& statement) {
    EXPECT_EXIT((statement(), std::exit(0)), ExitedWithCode(0), "");
  }

  std::string log() const { return readFile(directory_ / "log"); }
  std::string trace() const { return readFile(directory_ / "trace"); }

  const TemporaryDirectory directory_;
};

void failSomewhere() { TWLog::report("C", TWLog::failureLevel, "it failed"); }

TEST_F(ReportTest, SendsAFailureToTheLogAndTheTraceWithTheCallersPlace) {
  inChild(failSomewhere);
  const auto line = MatchesRegex(".* 6000 C failSomewhere \\(ReportTest:[0-9]+\\): it failed\n");
  EXPECT_THAT(log(), line);
  EXPECT_THAT(trace(), line);
}

TEST_F(ReportTest, SendsProgressUnderTheLogsThresholdToTheTraceAlone) {
  inChild([] { TWLog::report("C", TWLog::progressLevel, "a step"); });
  EXPECT_THAT(log(), IsEmpty());
  EXPECT_THAT(trace(), MatchesRegex(".* 4000 C .* \\(ReportTest:[0-9]+\\): a step\n"));
}

TEST_F(ReportTest, TracesWhatIsForTheTraceAlone) {
  inChild([] { TWLog::trace("C", TWLog::failureLevel, "a detail"); });
  EXPECT_THAT(log(), IsEmpty());
  EXPECT_THAT(trace(), MatchesRegex(".* 6000 C .* \\(ReportTest:[0-9]+\\): a detail\n"));
}

}  // namespace
