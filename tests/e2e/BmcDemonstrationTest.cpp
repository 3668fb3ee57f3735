// SPDX-License-Identifier: Apache-2.0
// The demonstration against a simulated BMC that answers real IPMI.
#include <gmock/gmock.h>

#include <chrono>
#include <csignal>

#include "tests/e2e/DemonstrationFixture.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using testing::ContainsRegex;
using testing::HasSubstr;

TEST_F(DemonstrationTest, ShowsABmcAChangeAndTheModel) {
  const Completed completed = demonstrate({"--bmc"});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const std::string& shown = completed.output;
  EXPECT_THAT(shown, HasSubstr("a simulated BMC (ipmi_sim): its values are made up"));
  EXPECT_THAT(shown,
              HasSubstr("before  192.0.2.10  255.255.255.0    DHCP\nnow     192.0.2.77  255.255.255.128  static\n"
                        "applied: "));
  EXPECT_THAT(shown, ContainsRegex("wanted  192.0.2.78 .*\nnow     192.0.2.77 .*\n.*\n  .*192.0.2.78"));
  EXPECT_THAT(shown, ContainsRegex("IPRemoteHostedAccessPoint: Gateway:lan1\n"));
  expectNothingLeft();
}

TEST_F(DemonstrationTest, StopsAtOnceAndSaysSo) {
  std::vector<std::string> group = command({"--bmc"});
  group.insert(group.begin(), "setsid");
  Process process(group, environment());
  ASSERT_TRUE(poll([&] { return process.output().find("IP interfaces\n") != std::string::npos; })) << process.errors();
  const auto begin = std::chrono::steady_clock::now();
  process.signalGroup(SIGINT);
  EXPECT_EQ(process.wait(), 130);
  EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(15));
  EXPECT_THAT(process.errors(), HasSubstr("demonstrate: stopping\n"));
  expectNothingLeft();
}

TEST_F(DemonstrationTest, LeavesNoBmcBehindWhereItIsKilled) {
  Process process(command({"--bmc"}), environment());
  ASSERT_TRUE(poll([&] { return process.output().find("IP interfaces\n") != std::string::npos; })) << process.errors();
  process.signal(SIGKILL);
  process.wait();
  expectNoProcessLeft();
}

}  // namespace
