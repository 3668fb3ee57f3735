// SPDX-License-Identifier: Apache-2.0
// Reading a real RMCP+ server.
#include <gmock/gmock.h>

#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/SimulatedBmc.h"

namespace {

using namespace Testing;
using QV::AddressOrigin;
using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::parseSettings;

TEST(IpmiReadTest, ShowsWhatTheBmcHas) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));

  const auto processor = backEnd.read();

  ASSERT_EQ(processor.interfaces.size(), 1u);
  const auto& interface = processor.interfaces[0];
  EXPECT_EQ(interface.name, "lan1");
  EXPECT_EQ(interface.ipv4Address, QV::ipv4("192.0.2.10"));
  EXPECT_EQ(interface.ipv4SubnetMask, QV::mask("255.255.255.0"));
  EXPECT_EQ(interface.ipv4Gateway, QV::ipv4("192.0.2.1"));
  EXPECT_EQ(interface.ipv4Origin, AddressOrigin::Dhcp);
  EXPECT_TRUE(interface.enabled);
  EXPECT_EQ(interface.ipv6Address, std::nullopt) << "the simulator does not support IPv6 parameters";
  EXPECT_TRUE(processor.dnsServers.empty());
}

TEST(IpmiReadTest, ShowsNoAddressWhereItIsZero) {
  const SimulatedBmc bmc(SimulatedBmc::Personality::AppliesAtOnce);
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));

  const auto interface = backEnd.read().interfaces.at(0);

  EXPECT_EQ(interface.ipv4Address, std::nullopt);
  EXPECT_EQ(interface.ipv4SubnetMask, std::nullopt);
  EXPECT_EQ(interface.ipv4Gateway, std::nullopt);
}

TEST(IpmiReadTest, ShowsWhatAnotherClientChanged) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  ASSERT_EQ(backEnd.read().interfaces.at(0).ipv4Address, QV::ipv4("192.0.2.10"));

  bmc.ipmitool({"lan", "set", "1", "ipsrc", "static"});
  bmc.ipmitool({"lan", "set", "1", "ipaddr", "192.0.2.44"});

  const auto interface = backEnd.read().interfaces.at(0);
  EXPECT_EQ(interface.ipv4Address, QV::ipv4("192.0.2.44"));
  EXPECT_EQ(interface.ipv4Origin, AddressOrigin::Static);
}

// Each change is made whole while a look is between its round trips.
TEST(IpmiReadTest, ShowsNoAddressWithTheMaskOfAnother) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(bmc.settings()));
  const auto readAround = [&](const std::string& address, const std::string& mask) {
    bmc.hook("get", "[ $1 = subnet_mask ] && mv on-get done-get && sed -i 's/^ip_addr=.*/ip_addr=" + address +
                        "/; s/^subnet_mask=.*/subnet_mask=" + mask + "/' lan.state; exit 0");
    const auto interface = backEnd.read().interfaces.at(0);
    EXPECT_EQ(interface.ipv4Address, QV::ipv4(address));
    EXPECT_EQ(interface.ipv4SubnetMask, QV::mask(mask));
  };
  readAround("192.0.2.77", "255.255.255.128");
  readAround("198.51.100.5", "255.255.0.0");
}

TEST(IpmiReadTest, KeepsASnapshotForTheCacheTime) {
  const SimulatedBmc bmc;
  auto settings = parseSettings(bmc.settings());
  settings.cache = std::chrono::minutes(1);
  IpmiBackEnd backEnd(settings);
  ASSERT_EQ(backEnd.read().interfaces.at(0).ipv4Address, QV::ipv4("192.0.2.10"));

  bmc.ipmitool({"lan", "set", "1", "ipaddr", "192.0.2.44"});

  EXPECT_EQ(backEnd.read().interfaces.at(0).ipv4Address, QV::ipv4("192.0.2.10"));
}

TEST(IpmiReadTest, FindsTheSameChannelHoweverItLooks) {
  const SimulatedBmc bmc;
  for (const char* channels : {"auto", "all", "1"}) {
    auto settings = bmc.settings();
    settings["channels"] = channels;
    IpmiBackEnd backEnd(parseSettings(settings));

    const auto processor = backEnd.read();

    ASSERT_EQ(processor.interfaces.size(), 1u) << channels;
    EXPECT_EQ(processor.interfaces[0].name, "lan1") << channels;
  }
}

TEST(IpmiReadTest, SaysThatAListedChannelIsNoLanChannel) {
  const SimulatedBmc bmc;
  auto settings = bmc.settings();
  settings["channels"] = "1, 7";
  IpmiBackEnd backEnd(parseSettings(settings));

  EXPECT_THAT([&] { backEnd.read(); }, testing::ThrowsMessage<std::runtime_error>(testing::HasSubstr("LAN channel 7")));
}

}  // namespace
