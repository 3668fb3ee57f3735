// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <thread>
#include <vector>

#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/backends/simulated/StateText.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/SystemCalls.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;

class SimulatedBackEndTest : public testing::Test {
 protected:
  const TemporaryDirectory directory_;
  const std::string state_ = directory_ / "processor/state.json";
  SimulatedBackEnd processor_{state_};
};

TEST_F(SimulatedBackEndTest, MakesNothingButItsDirectoryBeforeItIsUsed) {
  EXPECT_TRUE(std::filesystem::is_empty(std::filesystem::path(state_).parent_path()));
}

TEST_F(SimulatedBackEndTest, IsDescribedAsSimulatedWhateverItsStateSays) {
  ManagementProcessor renamed = factoryConfiguration();
  renamed.description = "The BMC of rack 7";
  writeFile(state_, writeState(renamed));
  EXPECT_EQ(processor_.read().description, "The BMC of rack 7 (simulated)");
  processor_.change("eth0", {ipv4("192.0.2.77"), {}});
  EXPECT_THAT(readFile(state_), testing::HasSubstr("\"The BMC of rack 7\""));
}

TEST_F(SimulatedBackEndTest, IsRefusedWhereItsStateCouldNotBeChanged) {
  const std::filesystem::path directory = std::filesystem::path(state_).parent_path();
  std::filesystem::permissions(directory_.path(), std::filesystem::perms::all);
  constexpr auto entered =
      std::filesystem::perms::owner_exec | std::filesystem::perms::group_exec | std::filesystem::perms::others_exec;
  std::filesystem::permissions(directory, entered);
  // Even root is held by permissions once it is somebody else.
  const auto openAsSomebodyElse = [&] {
    const bool somebodyElse = ::geteuid() != 0 || ::seteuid(65534) == 0;
    const auto open = [&] { const SimulatedBackEnd refused(state_); };
    std::fputs(somebodyElse ? thrownBy(open).c_str() : "still root", stderr);
    std::_Exit(0);  // without what sanitizers do at the end, which is the former user's right
  };
  EXPECT_EXIT(openAsSomebodyElse(), testing::ExitedWithCode(0),
              "^" + directory.string() +
                  ": cannot be written: Permission denied; let the object manager's user, [0-9]+, write there, or name "
                  "another file with state in .simulated. of agent.ini$");
  std::filesystem::permissions(directory, std::filesystem::perms::owner_all);
}

TEST_F(SimulatedBackEndTest, WritesItsFactoryConfigurationOnTheFirstRead) {
  EXPECT_EQ(processor_.read(), factoryConfiguration());
  EXPECT_EQ(readFile(state_), writeState(factoryConfiguration()));
}

TEST_F(SimulatedBackEndTest, WritesItsFactoryConfigurationWithTheFirstChange) {
  processor_.change("eth1", {ipv4("198.51.100.99"), mask("255.255.0.0")});
  ManagementProcessor expected = factoryConfiguration();
  expected.interfaces[1].ipv4Address = ipv4("198.51.100.99");
  expected.interfaces[1].ipv4SubnetMask = mask("255.255.0.0");
  expected.interfaces[1].ipv4Origin = AddressOrigin::Static;
  EXPECT_EQ(processor_.read(), expected);
}

TEST_F(SimulatedBackEndTest, ChangesNoMoreThanItIsTold) {
  processor_.change("eth0", {{}, mask("255.255.0.0")});
  ManagementProcessor expected = factoryConfiguration();
  expected.interfaces[0].ipv4SubnetMask = mask("255.255.0.0");
  EXPECT_EQ(processor_.read(), expected);
}

TEST_F(SimulatedBackEndTest, ShowsWhatAnotherProcessWrote) {
  processor_.read();
  SimulatedBackEnd(state_).change("eth0", {ipv4("192.0.2.77"), {}});
  EXPECT_EQ(processor_.read().interfaces[0].ipv4Address, ipv4("192.0.2.77"));
}

TEST_F(SimulatedBackEndTest, OpensItsStateOnlyWhereItIsAnotherThanBefore) {
  const auto opens = [&] {
    const auto calls = traced([&] { processor_.read(); }).calls;
    return std::ranges::count_if(
        calls, [&](const SystemCall& call) { return call.number == SYS_openat && call.path == state_; });
  };
  const auto settle = [&] { return poll([&] { return StateFile(state_).version().has_value(); }); };
  processor_.read();
  ASSERT_TRUE(settle());
  EXPECT_EQ(opens(), 1);

  processor_.read();
  EXPECT_EQ(opens(), 0);
  EXPECT_EQ(processor_.read(), factoryConfiguration());

  SimulatedBackEnd(state_).change("eth0", {ipv4("192.0.2.77"), {}});
  EXPECT_EQ(opens(), 1);
  ASSERT_TRUE(settle());
  EXPECT_EQ(opens(), 1);
  EXPECT_EQ(processor_.read().interfaces[0].ipv4Address, ipv4("192.0.2.77"));
}

// Of the same length, in place, and many in a tick of the clock that the system marks files with.
TEST_F(SimulatedBackEndTest, MissesNoChangeHoweverFastTheyCome) {
  ManagementProcessor processor = factoryConfiguration();
  for (int round = 0; round < 300; ++round) {
    processor.interfaces[0].ipv4Address = ipv4(round % 2 == 0 ? "192.0.2.77" : "192.0.2.78");
    writeFile(state_, writeState(processor));
    ASSERT_EQ(processor_.read(), processor) << "round " << round;
  }
}

TEST_F(SimulatedBackEndTest, RefusesToChangeAnInterfaceThatItDoesNotHave) {
  EXPECT_EQ(thrownBy([&] {
              processor_.change("eth9", {ipv4("192.0.2.77"), {}});
            }),
            state_ + ": there is no interface 'eth9'");
}

TEST_F(SimulatedBackEndTest, WithADamagedStateTellsTheFileAndTheFieldAndLeavesTheFile) {
  processor_.read();
  for (const std::string damage : {"", "{", "{\"name\": 7}", "\0\0"}) {
    writeFile(state_, damage);
    EXPECT_THAT(thrownBy([&] { processor_.read(); }), testing::StartsWith(state_ + ": "));
    EXPECT_THAT(thrownBy([&] {
                  processor_.change("eth0", {ipv4("192.0.2.77"), {}});
                }),
                testing::StartsWith(state_ + ": "));
    EXPECT_EQ(readFile(state_), damage);
  }
}

TEST_F(SimulatedBackEndTest, LosesNoChangeOfSeveralThreads) {
  // When two threads change an interface each, over and over
  constexpr int changes = 50;
  const auto change = [&](const std::string& interface, const std::string& network) {
    for (int host = 1; host <= changes; ++host) {
      processor_.change(interface, {ipv4(network + std::to_string(host)), {}});
    }
  };
  {
    std::jthread first([&] { change("eth0", "192.0.2."); });
    std::jthread second([&] { change("eth1", "198.51.100."); });
  }

  // Then the last change of each is there
  EXPECT_EQ(processor_.read().interfaces[0].ipv4Address, ipv4("192.0.2.50"));
  EXPECT_EQ(processor_.read().interfaces[1].ipv4Address, ipv4("198.51.100.50"));
}

TEST_F(SimulatedBackEndTest, OfAFreshMachineIsTheSameForAllThatAskAtOnce) {
  std::vector<ManagementProcessor> seen(4);
  {
    std::vector<std::jthread> threads;
    for (ManagementProcessor& processor : seen) {
      threads.emplace_back([&] { processor = SimulatedBackEnd(state_).read(); });
    }
  }
  EXPECT_THAT(seen, testing::Each(factoryConfiguration()));
}

}  // namespace
