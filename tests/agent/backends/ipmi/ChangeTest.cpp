// SPDX-License-Identifier: Apache-2.0
// Changing the address of a real RMCP+ server, with ipmitool as the witness.
#include <gmock/gmock.h>

#include <atomic>
#include <future>
#include <vector>

#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/RecordingLog.h"
#include "tests/support/agent/SimulatedBmc.h"

namespace {

using namespace Testing;
using QV::AddressChange;
using QV::AddressOrigin;
using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::parseSettings;
using testing::AllOf;
using testing::HasSubstr;
using testing::ThrowsMessage;

auto refusal(const std::string& text) { return ThrowsMessage<std::runtime_error>(HasSubstr(text)); }

const AddressChange bothValues{QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")};

class IpmiChangeTest : public testing::TestWithParam<SimulatedBmc::Personality> {};

TEST_P(IpmiChangeTest, IsWhatAnotherClientSeesAndWhatTheNextReadShows) {
  const SimulatedBmc bmc(GetParam());
  auto settings = parseSettings(bmc.settings());
  settings.cache = std::chrono::minutes(1);
  IpmiBackEnd backEnd(settings);
  backEnd.read();

  backEnd.change("lan1", bothValues);

  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.77");
  EXPECT_EQ(bmc.witness("Subnet Mask"), "255.255.255.128");
  EXPECT_EQ(bmc.witness("IP Address Source"), "Static Address");
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
  const auto interface = backEnd.read().interfaces.at(0);
  EXPECT_EQ(interface.ipv4Address, QV::ipv4("192.0.2.77"));
  EXPECT_EQ(interface.ipv4SubnetMask, QV::mask("255.255.255.128"));
  EXPECT_EQ(interface.ipv4Origin, AddressOrigin::Static);
}

TEST_P(IpmiChangeTest, OfTheAddressLeavesTheMask) {
  const SimulatedBmc bmc(GetParam());
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  backEnd.change("lan1", {QV::ipv4("192.0.2.76"), QV::mask("255.255.255.0")});

  backEnd.change("lan1", {QV::ipv4("192.0.2.77"), std::nullopt});

  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.77");
  EXPECT_EQ(bmc.witness("Subnet Mask"), "255.255.255.0");
}

INSTANTIATE_TEST_SUITE_P(Personalities, IpmiChangeTest,
                         testing::Values(SimulatedBmc::Personality::AppliesOnCommit,
                                         SimulatedBmc::Personality::AppliesAtOnce),
                         [](const auto& personality) {
                           return personality.param == SimulatedBmc::Personality::AppliesOnCommit ? "OnCommit"
                                                                                                  : "AtOnce";
                         });

TEST(IpmiChangeAmongReadersTest, IsSeenAsAWholeOrNotAtAll) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  std::vector<std::future<int>> readers;
  std::atomic<bool> ended = false;
  for (int reader = 0; reader < 3; ++reader) {
    readers.push_back(std::async(std::launch::async, [&] {
      int mixed = 0;
      while (!ended) {
        const auto interface = backEnd.read().interfaces.at(0);
        const bool changed = interface.ipv4Address == QV::ipv4("192.0.2.77");
        mixed += changed != (interface.ipv4SubnetMask == QV::mask("255.255.255.128"));
      }
      return mixed;
    }));
  }

  backEnd.change("lan1", bothValues);
  backEnd.change("lan1", {QV::ipv4("192.0.2.10"), QV::mask("255.255.255.0")});
  backEnd.change("lan1", bothValues);

  ended = true;
  for (auto& reader : readers) {
    EXPECT_EQ(reader.get(), 0);
  }
  EXPECT_EQ(backEnd.read().interfaces.at(0).ipv4Address, QV::ipv4("192.0.2.77"));
}

TEST(IpmiChangeRefusedTest, ForAnInterfaceThatIsNotThere) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));

  for (const char* name : {"lan2", "eth0", "lan", "lan01", "lan1 ", ""}) {
    EXPECT_THAT([&] { backEnd.change(name, bothValues); }, refusal("there is no interface")) << name;
  }

  EXPECT_EQ(bmc.stored("ip_addr"), "192.0.2.10");
}

TEST(IpmiChangeRefusedTest, WhileAnotherClientsChangeIsInProgress) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  bmc.ipmitool({"raw", "0x0c", "0x01", "1", "0", "1"});

  EXPECT_THAT([&] { backEnd.change("lan1", bothValues); }, refusal("ipmitool raw 0x0c 0x01 1 0 0"));

  EXPECT_EQ(bmc.stored("ip_addr"), "192.0.2.10");
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set In Progress") << "another client's lock is not ours to give back";
  bmc.ipmitool({"raw", "0x0c", "0x01", "1", "0", "0"});
  backEnd.change("lan1", bothValues);
  EXPECT_EQ(bmc.stored("ip_addr"), "192.0.2.77");
}

TEST(IpmiChangeRefusedTest, ByTheBmcChangesNothing) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  bmc.hook("check", "exit 1");  // the simulator asks it about the address source
  takeLog();

  EXPECT_THAT([&] { backEnd.change("lan1", bothValues); },
              ThrowsMessage<std::runtime_error>(AllOf(HasSubstr("refuses the IP address source static"),
                                                      HasSubstr("0xCC"), HasSubstr("nothing was changed"))));

  EXPECT_TRUE(contains(takeLog(), "Tarnwick.Ipmi", 6000, "refuses the IP address source static"));
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.10");
  EXPECT_EQ(bmc.stored("ip_addr_src"), "dhcp");
}

TEST(IpmiChangeRefusedTest, WhereTheBmcAcceptsAndDoesNotApply) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  bmc.hook("set", "exit 1");
  takeLog();

  EXPECT_THAT([&] { backEnd.change("lan1", bothValues); },
              ThrowsMessage<std::runtime_error>(AllOf(HasSubstr("does not show it"),
                                                      HasSubstr("IP address is 192.0.2.10, not 192.0.2.77"),
                                                      HasSubstr("the earlier values hold"))));

  EXPECT_TRUE(contains(takeLog(), "Tarnwick.Ipmi", 6000, "does not show it"));
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
}

TEST(IpmiChangeRefusedTest, WhereTheBmcAppliesAPartPutsTheEarlierValuesBack) {
  const SimulatedBmc bmc;
  // A request that is sent again would be done again, and as a whole then.
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings()));
  backEnd.change("lan1", {QV::ipv4("192.0.2.20"), QV::mask("255.255.255.0")});
  // Once the address alone: the script's second argument is its value.
  bmc.hook("set", "sed -i \"s/^ip_addr=.*/ip_addr=$2/\" \"$(dirname \"$0\")/lan.state\"; rm \"$0\"; exit 1");

  EXPECT_THAT([&] { backEnd.change("lan1", bothValues); },
              ThrowsMessage<std::runtime_error>(AllOf(HasSubstr("subnet mask is 255.255.255.0, not 255.255.255.128"),
                                                      HasSubstr("the earlier values were put back"))));

  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.20");
  EXPECT_EQ(bmc.witness("Subnet Mask"), "255.255.255.0");
}

}  // namespace
