// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "agent/processor/Addresses.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;

std::string refusalOfAddress(const std::string& text) {
  return thrownBy([&] { Ipv4Address::requireHost(text); });
}

std::string refusalOfMask(const std::string& text) {
  return thrownBy([&] { SubnetMask::requireUsable(text); });
}

TEST(Ipv4TextTest, IsFourDecimalOctets) {
  EXPECT_EQ(ipv4("0.0.0.0").number(), 0U);
  EXPECT_EQ(ipv4("192.0.2.10").number(), 0xc000020aU);
  EXPECT_EQ(ipv4("255.255.255.255").number(), 0xffffffffU);
}

TEST(Ipv4TextTest, IsNothingElse) {
  for (const char* text :
       {"",         ".",         "...",       "1",         "1.2.3",      "1.2.3.",           ".1.2.3",
        "1..2.3",   "1.2.3.4.",  "1.2.3.4.5", "256.1.1.1", "1.1.1.999",  "1.1.1.4294967297", "01.2.3.4",
        "1.2.3.00", "1.2.3.010", " 1.2.3.4",  "1.2.3.4 ",  "1. 2.3.4",   "+1.2.3.4",         "-1.2.3.4",
        "1.2.3.-4", "0x1.2.3.4", "1.2.3.a",   "1,2,3,4",   "1.2.3.4/24", "1.2.3.4\n",        "::1",
        "localhost"}) {
    EXPECT_EQ(Ipv4Address::parse(text), std::nullopt) << text;
  }
  EXPECT_EQ(Ipv4Address::parse(std::string_view("1.2.3.4\0", 8)), std::nullopt);
}

TEST(HostAddressTest, IsAcceptedUpToTheEdgesOfTheRangesThatHostsHave) {
  for (const char* text :
       {"1.0.0.0", "10.0.0.1", "126.255.255.255", "128.0.0.0", "169.254.1.1", "192.0.2.10", "223.255.255.255"}) {
    EXPECT_EQ(Ipv4Address::requireHost(text), Ipv4Address::parse(text)) << text;
  }
}

TEST(HostAddressTest, IsRefusedWithTheTextAndTheReason) {
  EXPECT_EQ(refusalOfAddress("0.0.0.0"), "the IPv4 address '0.0.0.0' lies in 0.0.0.0/8, which names no host");
  EXPECT_EQ(refusalOfAddress("0.255.255.255"),
            "the IPv4 address '0.255.255.255' lies in 0.0.0.0/8, which names no host");
  EXPECT_EQ(refusalOfAddress("127.0.0.1"), "the IPv4 address '127.0.0.1' is a loopback address");
  EXPECT_EQ(refusalOfAddress("127.255.255.255"), "the IPv4 address '127.255.255.255' is a loopback address");
  EXPECT_EQ(refusalOfAddress("224.0.0.0"), "the IPv4 address '224.0.0.0' is a multicast address");
  EXPECT_EQ(refusalOfAddress("239.255.255.255"), "the IPv4 address '239.255.255.255' is a multicast address");
  EXPECT_EQ(refusalOfAddress("240.0.0.0"), "the IPv4 address '240.0.0.0' lies in the reserved range 240.0.0.0/4");
  EXPECT_EQ(refusalOfAddress("255.255.255.255"), "the IPv4 address '255.255.255.255' is the broadcast address");
  EXPECT_EQ(refusalOfAddress("192.0.2"),
            "the IPv4 address '192.0.2' is not four decimal numbers from 0 to 255 with dots between them");
}

TEST(HostAddressTest, IsCutInTheRefusalWhereItIsVeryLong) {
  const std::string refusal = refusalOfAddress(std::string(1000, '1'));
  EXPECT_THAT(refusal, testing::HasSubstr('\'' + std::string(64, '1') + "...'"));
  EXPECT_LT(refusal.size(), 200U);
}

TEST(SubnetMaskTest, IsAcceptedAtEveryUsableLength) {
  for (int length = 1; length <= 31; ++length) {
    const std::uint32_t bits = ~std::uint32_t{0} << (32 - length);
    const auto octet = [&](int shift) { return static_cast<std::uint8_t>(bits >> shift); };
    const SubnetMask expected({octet(24), octet(16), octet(8), octet(0)});
    EXPECT_EQ(SubnetMask::requireUsable(expected.text()), expected);
    EXPECT_EQ(expected.prefixLength(), length) << expected;
  }
}

TEST(SubnetMaskTest, IsRefusedWithTheTextAndTheReason) {
  EXPECT_EQ(refusalOfMask("0.0.0.0"), "the subnet mask '0.0.0.0' leaves no network");
  EXPECT_EQ(refusalOfMask("255.255.255.255"), "the subnet mask '255.255.255.255' leaves no other host");
  EXPECT_EQ(refusalOfMask("255.0.255.0"), "the subnet mask '255.0.255.0' is not contiguous");
  EXPECT_EQ(refusalOfMask("0.0.0.255"), "the subnet mask '0.0.0.255' is not contiguous");
  EXPECT_EQ(refusalOfMask("255.255.255.253"), "the subnet mask '255.255.255.253' is not contiguous");
  EXPECT_EQ(refusalOfMask("255.255.255"),
            "the subnet mask '255.255.255' is not four decimal numbers from 0 to 255 with dots between them");
}

TEST(HostOfSubnetTest, IsNeitherTheNetworkNorItsBroadcastAddress) {
  const SubnetMask mask = SubnetMask::requireUsable("255.255.255.0");
  EXPECT_NO_THROW(requireHostOfSubnet(Ipv4Address::requireHost("192.0.2.1"), mask));
  EXPECT_NO_THROW(requireHostOfSubnet(Ipv4Address::requireHost("192.0.2.254"), mask));
  EXPECT_EQ(thrownBy([&] { requireHostOfSubnet(Ipv4Address::requireHost("192.0.2.0"), mask); }),
            "the IPv4 address '192.0.2.0' is, under the subnet mask '255.255.255.0', the network itself");
  EXPECT_EQ(thrownBy([&] { requireHostOfSubnet(Ipv4Address::requireHost("192.0.2.255"), mask); }),
            "the IPv4 address '192.0.2.255' is, under the subnet mask '255.255.255.0', its broadcast address");
}

TEST(SubnetMaskTest, HasNoPrefixLengthWhereItIsNotContiguous) {
  EXPECT_EQ(mask("255.0.255.0").prefixLength(), std::nullopt);
}

TEST(Ipv6TextTest, IsPrintedInItsShortestForm) {
  EXPECT_EQ(ipv6("2001:DB8:0:0:0:0:0:10").text(), "2001:db8::10");
  EXPECT_TRUE(ipv6("::").isZero());
  for (const char* text : {"", "192.0.2.1", "2001:db8", "2001:db8::10%eth0", "2001:db8::10/64"}) {
    EXPECT_EQ(Ipv6Address::parse(text), std::nullopt) << text;
  }
}

TEST(MacAddressTest, IsSixPairsOfHexadecimalDigits) {
  EXPECT_EQ(mac("02:00:00:00:AB:cd").text(), "02:00:00:00:ab:cd");
  for (const char* text : {"", "02:00:00:00:00", "02:00:00:00:00:01:", "02-00-00-00-00-01", "2:0:0:0:0:1",
                           "02:00:00:00:00:0g", "02:00:00:00:00:001"}) {
    EXPECT_EQ(MacAddress::parse(text), std::nullopt) << text;
  }
}

TEST(HostOfSubnetTest, IsEitherAddressOfAPointToPointLink) {
  const SubnetMask mask = SubnetMask::requireUsable("255.255.255.254");
  EXPECT_NO_THROW(requireHostOfSubnet(Ipv4Address::requireHost("192.0.2.0"), mask));
  EXPECT_NO_THROW(requireHostOfSubnet(Ipv4Address::requireHost("192.0.2.1"), mask));
}

}  // namespace
