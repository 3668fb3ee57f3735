// SPDX-License-Identifier: Apache-2.0
// What a channel's parameters make of an interface.
#include <gmock/gmock.h>

#include "agent/backends/ipmi/lan/InterfaceReader.h"
#include "tests/agent/backends/ipmi/ScriptedBmc.h"
#include "tests/support/agent/Addresses.h"

namespace {

using namespace Testing;
using QV::AddressOrigin;
using QV::Ipmi::channelOf;
using QV::Ipmi::IpmiError;
using QV::Ipmi::Ipv6Choice;
using QV::Ipmi::LanParameter;
using QV::Ipmi::ParameterData;
using testing::HasSubstr;
using testing::ThrowsMessage;

// Parameters 56 and 59: set selector, source, address, prefix length, status.
ParameterData ipv6(std::uint8_t source, bool zero = false) {
  ParameterData data = {0, source};
  const ParameterData address =
      zero ? ParameterData(16, 0) : ParameterData{0x20, 1, 0x0d, 0xb8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0x10};
  data.insert(data.end(), address.begin(), address.end());
  data.insert(data.end(), {64, 0});
  return data;
}

QV::NetworkInterface readInterface(ScriptedBmc& bmc, std::uint8_t channel, Ipv6Choice ipv6) {
  return QV::Ipmi::readInterface(bmc, channel, ipv6);
}

TEST(IpmiInterfaceTest, CostsAtMostFiveRoundTrips) {
  ScriptedBmc bmc;
  readInterface(bmc, 1, Ipv6Choice::Static);
  EXPECT_EQ(bmc.requests, 5u);
}

TEST(IpmiInterfaceTest, IsNotAskedForIpv6AgainWhereTheBmcHasNone) {
  for (const bool supported : {false, true}) {
    ScriptedBmc bmc;
    if (supported) {
      bmc.values[LanParameter::Ipv6StaticAddress] = ipv6(0x80);
    }
    Ipv6Choice choice = Ipv6Choice::Static;

    QV::Ipmi::readInterface(bmc, 1, choice);

    EXPECT_EQ(choice, supported ? Ipv6Choice::Static : Ipv6Choice::Off);
  }
}

TEST(IpmiInterfaceTest, LacksWhatTheBmcDoesNotSupport) {
  for (const std::uint8_t code : {0x80, 0xC9, 0xCC}) {
    ScriptedBmc bmc;
    bmc.readRefused = {{LanParameter::DefaultGateway, code}};

    const auto interface = readInterface(bmc, 1, Ipv6Choice::Static);

    EXPECT_EQ(interface.ipv4Gateway, std::nullopt);
    EXPECT_EQ(interface.ipv6Address, std::nullopt);
    EXPECT_EQ(interface.ipv4Address, QV::ipv4("192.0.2.10"));
  }
}

TEST(IpmiInterfaceTest, LacksWhatTheBmcTellsTooShort) {
  ScriptedBmc bmc;
  bmc.values = {{LanParameter::AddressSource, {}},
                {LanParameter::IpAddress, {192, 0, 2}},
                {LanParameter::SubnetMask, {255}},
                {LanParameter::Ipv6StaticAddress, {0, 0x80, 0x20}}};

  const auto interface = readInterface(bmc, 1, Ipv6Choice::Static);

  EXPECT_EQ(interface.ipv4Origin, AddressOrigin::Unknown);
  EXPECT_EQ(interface.ipv4Address, std::nullopt);
  EXPECT_EQ(interface.ipv4SubnetMask, std::nullopt);
  EXPECT_EQ(interface.ipv6Address, std::nullopt);
}

TEST(IpmiInterfaceTest, SaysWhyTheBmcRefuses) {
  ScriptedBmc bmc;
  bmc.readRefused = {{LanParameter::IpAddress, 0xD4}};
  EXPECT_THAT([&] { readInterface(bmc, 1, Ipv6Choice::Off); },
              ThrowsMessage<IpmiError>(HasSubstr("IP address of LAN channel 1: privilege too low")));
}

TEST(IpmiInterfaceTest, OfAChannelThatTellsNothingIsNone) {
  ScriptedBmc bmc;
  EXPECT_THAT([&] { readInterface(bmc, 7, Ipv6Choice::Off); }, ThrowsMessage<IpmiError>(HasSubstr("no LAN channel 7")));
}

TEST(IpmiInterfaceTest, TellsWhereItsAddressComesFrom) {
  const std::pair<std::uint8_t, AddressOrigin> origins[] = {{0, AddressOrigin::Unknown}, {1, AddressOrigin::Static},
                                                            {2, AddressOrigin::Dhcp},    {0xF2, AddressOrigin::Dhcp},
                                                            {3, AddressOrigin::Unknown}, {4, AddressOrigin::Unknown}};
  for (const auto& [source, origin] : origins) {
    ScriptedBmc bmc;
    bmc.values[LanParameter::AddressSource] = {source};
    EXPECT_EQ(readInterface(bmc, 1, Ipv6Choice::Off).ipv4Origin, origin) << int{source};
  }
}

TEST(IpmiInterfaceTest, HasTheKindOfIpv6AddressThatIsChosen) {
  struct Case {
    Ipv6Choice choice;
    LanParameter parameter;
    std::uint8_t source;
    bool shown;
    AddressOrigin origin;
  };
  const Case cases[] = {{Ipv6Choice::Static, LanParameter::Ipv6StaticAddress, 0x80, true, AddressOrigin::Static},
                        {Ipv6Choice::Static, LanParameter::Ipv6StaticAddress, 0x00, false, AddressOrigin::Unknown},
                        {Ipv6Choice::Static, LanParameter::Ipv6DynamicAddress, 0x02, false, AddressOrigin::Unknown},
                        {Ipv6Choice::Dynamic, LanParameter::Ipv6DynamicAddress, 0x02, true, AddressOrigin::Dhcp},
                        {Ipv6Choice::Dynamic, LanParameter::Ipv6DynamicAddress, 0x01, true, AddressOrigin::Unknown},
                        {Ipv6Choice::Off, LanParameter::Ipv6StaticAddress, 0x80, false, AddressOrigin::Unknown}};
  for (const Case& test : cases) {
    ScriptedBmc bmc;
    bmc.values[test.parameter] = ipv6(test.source);

    const auto interface = readInterface(bmc, 1, test.choice);

    using Address = std::optional<QV::Ipv6Address>;
    using Length = std::optional<std::uint8_t>;
    EXPECT_EQ(interface.ipv6Address, test.shown ? Address(QV::ipv6("2001:db8::10")) : Address());
    EXPECT_EQ(interface.ipv6PrefixLength, test.shown ? Length(64) : Length());
    EXPECT_EQ(interface.ipv6Origin, test.origin);
  }
}

TEST(IpmiInterfaceTest, HasNoIpv6AddressOfZeros) {
  ScriptedBmc bmc;
  bmc.values[LanParameter::Ipv6StaticAddress] = ipv6(0x80, true);
  EXPECT_EQ(readInterface(bmc, 1, Ipv6Choice::Static).ipv6Address, std::nullopt);
}

TEST(IpmiInterfaceNameTest, LeadsToItsChannel) {
  EXPECT_EQ(channelOf("lan1"), 1);
  EXPECT_EQ(channelOf("lan11"), 11);
  for (const char* name : {"", "lan", "lan01", "lan1 ", "LAN1", "eth1", "lan256", "lan-1", "lan+1"}) {
    EXPECT_EQ(channelOf(name), std::nullopt) << name;
  }
}

}  // namespace
