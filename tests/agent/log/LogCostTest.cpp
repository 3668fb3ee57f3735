// SPDX-License-Identifier: Apache-2.0
// What a line of the agent's log costs who writes it: instructions as callgrind counts them, and system calls. Neither
// depends on what else the machine does.
#include <gtest/gtest.h>
#include <sys/syscall.h>

#include <algorithm>
#include <cstdlib>
#include <iostream>
#include <sstream>
#include <string>

#include "tests/agent/log/FrameLines.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/SystemCalls.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;

constexpr double mostInstructions = 2500;

class LogCostTest : public testing::Test {
 protected:
  LogCostTest() {
    writeFile(directory_ / "agent.ini",
              "[log]\ndestination = off\n[trace]\ndestination = file\nfile = " + (directory_ / "trace") + "\n");
  }

  double instructionsOf(int lines) const {
    const std::string profile = directory_ / ("profile" + std::to_string(lines));
    const Completed completed =
        run({"valgrind", "--tool=callgrind", "--callgrind-out-file=" + profile, LOG_COST, std::to_string(lines)},
            environment_);
    EXPECT_EQ(completed.status, 0) << completed.errors;
    std::istringstream text(readFile(profile));
    constexpr std::string_view totals = "totals: ";
    for (std::string line; std::getline(text, line);) {
      if (line.starts_with(totals)) {
        return std::stod(line.substr(totals.size()));
      }
    }
    ADD_FAILURE() << "no totals in " << profile;
    return 0;
  }

  const TemporaryDirectory directory_;
  const Environment environment_ = {{"QV_AGENT_INI", directory_ / "agent.ini"}};
};

TEST_F(LogCostTest, OfALineIsFewInstructions) {
  constexpr int few = 1000;
  constexpr int many = 3000;
  const double perLine = (instructionsOf(many) - instructionsOf(few)) / (many - few);
  std::cout << perLine << " instructions a line\n";
  EXPECT_GT(perLine, 0);
  EXPECT_LT(perLine, mostInstructions);
}

TEST_F(LogCostTest, OfALineIsOneSystemCall) {
  constexpr int lines = 1000;
  ::setenv("QV_AGENT_INI", environment_.at("QV_AGENT_INI").c_str(), 1);
  const auto calls = traced([] { sendFrameLines(lines); }).calls;
  ::unsetenv("QV_AGENT_INI");
  const auto writes = std::ranges::count(calls, SYS_write, &SystemCall::number);
  const auto others = static_cast<long>(calls.size()) - writes;
  std::cout << writes << " writes and " << others << " other system calls for " << lines << " lines\n";
  EXPECT_EQ(writes, lines);
  EXPECT_LT(others, lines / 10) << "those of the first line, and a look for a rotation now and then";
}

}  // namespace
