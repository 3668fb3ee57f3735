// SPDX-License-Identifier: Apache-2.0
// Processes that share a state file: killed in the middle of their work, and side by side.
#include <gtest/gtest.h>
#include <signal.h>
#include <unistd.h>

#include <random>
#include <string>
#include <vector>

#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace QV;
using namespace Testing;

std::vector<std::string> writer(const std::string& state, const std::string& interface, const std::string& network,
                                int changes) {
  return {built("bin/state_writer"), state, interface, network, std::to_string(changes)};
}

TEST(StateWritersTest, ThatAreKilledAtAnyMomentLeaveTheOldStateOrTheNewOne) {
  const TemporaryDirectory directory;
  const std::string state = directory / "state.json";
  SimulatedBackEnd processor(state);
  processor.change("eth0", {ipv4("192.0.2.1"), mask("255.255.255.0")});
  std::mt19937 random(20);
  std::uniform_int_distribution<int> microseconds(0, 6000);  // a change, and the pause before the next
  int interrupted = 0;
  for (int kills = 0; kills < 1000; ++kills) {
    // When a writer is killed somewhere in its work
    Process process(writer(state, "eth0", "192.0.2", 0));
    process.readLine();
    ::usleep(static_cast<useconds_t>(microseconds(random)));
    process.signal(SIGKILL);
    process.wait();
    interrupted += std::filesystem::exists(state + ".new") ? 1 : 0;

    // Then the state is one of the two that it writes, whole
    const NetworkInterface interface = processor.read().interfaces.at(0);
    ASSERT_TRUE((interface.ipv4Address == ipv4("192.0.2.1") && interface.ipv4SubnetMask == mask("255.255.255.0")) ||
                (interface.ipv4Address == ipv4("192.0.2.2") && interface.ipv4SubnetMask == mask("255.255.0.0")))
        << readFile(state);
  }
  RecordProperty("interrupted", interrupted);
  EXPECT_GT(interrupted, 0) << "no kill met a writer between its first byte and its last step";

  // And the next change works and sweeps up
  processor.change("eth0", {ipv4("192.0.2.3"), {}});
  EXPECT_EQ(processor.read().interfaces.at(0).ipv4Address, ipv4("192.0.2.3"));
  EXPECT_FALSE(std::filesystem::exists(state + ".new"));
}

TEST(StateWritersTest, AreSeenByTheNextReadOfAProcessThatHasReadBefore) {
  const TemporaryDirectory directory;
  const std::string state = directory / "state.json";
  SimulatedBackEnd processor(state);
  ASSERT_EQ(processor.read().interfaces.at(0).ipv4Address, ipv4("192.0.2.10"));

  EXPECT_EQ(run(writer(state, "eth0", "192.0.2", 1)).status, 0);

  EXPECT_EQ(processor.read().interfaces.at(0).ipv4Address, ipv4("192.0.2.1"));
}

TEST(StateWritersTest, ThatRunAtOnceLoseNothing) {
  const TemporaryDirectory directory;
  const std::string state = directory / "state.json";
  Process first(writer(state, "eth0", "192.0.2", 300));
  Process second(writer(state, "eth1", "198.51.100", 300));
  EXPECT_EQ(first.wait(), 0);
  EXPECT_EQ(second.wait(), 0);
  const auto interfaces = SimulatedBackEnd(state).read().interfaces;
  EXPECT_EQ(interfaces.at(0).ipv4Address, ipv4("192.0.2.2"));
  EXPECT_EQ(interfaces.at(0).ipv4SubnetMask, mask("255.255.0.0"));
  EXPECT_EQ(interfaces.at(1).ipv4Address, ipv4("198.51.100.2"));
  EXPECT_EQ(interfaces.at(1).ipv4SubnetMask, mask("255.255.0.0"));
}

}  // namespace
