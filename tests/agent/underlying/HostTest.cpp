// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <net/if.h>

#include <algorithm>
#include <bit>
#include <set>
#include <sstream>

#include "agent/underlying/Host.h"
#include "tests/support/agent/Addresses.h"

namespace {

using namespace QV;
using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> nameServers(const std::string& text) {
  std::istringstream stream(text);
  return parseResolverConfiguration(stream);
}

std::map<std::string, Ipv4Address> gateways(const std::string& text) {
  std::istringstream stream(text);
  return parseDefaultGateways(stream);
}

TEST(HostTest, HasItsNameAndTheInterfacesOfTheKernel) {
  const ManagementProcessor host = readHost();
  EXPECT_EQ(host.name, getSystemName());
  EXPECT_FALSE(host.dnsServers.empty());

  std::set<std::string> names;
  for (const NetworkInterface& interface : host.interfaces) {
    ASSERT_TRUE(interface.name);
    EXPECT_NE(::if_nametoindex(interface.name->c_str()), 0U) << *interface.name;
    EXPECT_TRUE(names.insert(*interface.name).second) << *interface.name << " is there twice";
  }
}

TEST(HostTest, ReadsItsLoopbackInterface) {
  const ManagementProcessor host = readHost();
  const auto loopback = std::find_if(host.interfaces.begin(), host.interfaces.end(),
                                     [](const NetworkInterface& interface) { return interface.name == "lo"; });
  if (loopback == host.interfaces.end() || !loopback->ipv4Address) {
    GTEST_SKIP() << "no loopback address here";
  }
  EXPECT_TRUE(loopback->enabled);
  EXPECT_EQ(loopback->ipv4Address, ipv4("127.0.0.1"));
  EXPECT_EQ(loopback->ipv4SubnetMask, mask("255.0.0.0"));
  EXPECT_EQ(loopback->macAddress, mac("00:00:00:00:00:00"));
}

TEST(ResolverConfigurationTest, ListsItsNameServersInOrder) {
  EXPECT_THAT(nameServers("# comment\nsearch example\nnameserver 192.0.2.53\n  nameserver\t2001:db8::53 # x\n"),
              ElementsAre("192.0.2.53", "2001:db8::53"));
}

TEST(ResolverConfigurationTest, MeansTheHostItselfWhereItListsNone) {
  EXPECT_THAT(nameServers(""), ElementsAre("127.0.0.1"));
  EXPECT_THAT(nameServers("nameserver\nnameservers 192.0.2.53\n;nameserver 192.0.2.53\n"), ElementsAre("127.0.0.1"));
}

TEST(DefaultGatewaysTest, AreThoseOfTheRoutesToEverywhere) {
  const bool little = std::endian::native == std::endian::little;
  const std::string gateway = little ? "010200C0" : "C0000201";
  EXPECT_EQ(gateways("Iface\tDestination\tGateway\tFlags\tRefCnt\tUse\tMetric\tMask\n"
                     "eth0\t00000000\t" +
                     gateway +
                     "\t0003\t0\t0\t0\t00000000\n"
                     "eth0\t000200C0\t00000000\t0001\t0\t0\t0\t00FFFFFF\n"
                     "tun0\t00000000\t00000000\t0001\t0\t0\t0\t00000000\n"),
            (std::map<std::string, Ipv4Address>{{"eth0", ipv4("192.0.2.1")}}));
}

TEST(DefaultGatewaysTest, AreNoneInATextThatIsNoRouteTable) {
  EXPECT_THAT(gateways(""), IsEmpty());
  EXPECT_THAT(gateways("eth0 00000000\nnonsense\n"), IsEmpty());
}

}  // namespace
