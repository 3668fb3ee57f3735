// SPDX-License-Identifier: Apache-2.0
// What a line of the agent's log costs who writes it: instructions as callgrind counts them, and system calls. Neither
// depends on what else the machine does.
#include <gtest/gtest.h>
#include <sys/syscall.h>

#include <algorithm>
#include <cstdlib>
#include <iostream>
#include <string>

#include "tests/agent/log/FrameLines.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Callgrind.h"
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

  const TemporaryDirectory directory_;
  const Environment environment_ = {{"QV_AGENT_INI", directory_ / "agent.ini"}};
};

TEST_F(LogCostTest, OfALineIsFewInstructions) {
  constexpr int lines = 2000;
  const double perLine =
      costsOf({built("bin/log_cost"), std::to_string(lines)}, environment_).at("lines").instructions / lines;
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
