// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "cimom/http/Address.h"

namespace {

using Cimom::Http::Address;

TEST(AddressTest, IsReadFromATextAndShownAsTheShortest) {
  const struct {
    const char* given;
    const char* shown;
    const char* group;
    bool isLoopback;
  } rows[] = {
      {"192.0.2.1", "192.0.2.1", "192.0.2.1", false},
      {"127.0.0.9", "127.0.0.9", "127.0.0.9", true},
      {"::ffff:192.0.2.1", "192.0.2.1", "192.0.2.1", false},
      {"::ffff:127.0.0.1", "127.0.0.1", "127.0.0.1", true},
      {"::1", "::1", "::", true},
      {"2001:db8:0:1:2:3:4:5", "2001:db8:0:1:2:3:4:5", "2001:db8:0:1::", false},
      {"2001:DB8::1:0:0:1", "2001:db8::1:0:0:1", "2001:db8::", false},
  };
  for (const auto& row : rows) {
    const auto address = Address::parse(row.given);
    ASSERT_TRUE(address) << row.given;
    EXPECT_EQ(address->text(), row.shown);
    EXPECT_EQ(address->group(), row.group) << "who counts as one client";
    EXPECT_EQ(address->isLoopback(), row.isLoopback) << row.given;
    EXPECT_EQ(*address, *Address::parse(row.shown));
  }
  for (const char* text : {"", "localhost", "192.0.2", "192.0.2.256", "[::1]", "2001:db8::1%eth0"}) {
    EXPECT_FALSE(Address::parse(text)) << text;
  }
}

TEST(AddressTest, IsThatOfASocketOrNone) {
  sockaddr_in6 six{};
  six.sin6_family = AF_INET6;
  six.sin6_addr = in6addr_loopback;
  EXPECT_EQ(Address(reinterpret_cast<const sockaddr*>(&six)).text(), "::1");
  sockaddr_in four{};
  four.sin_family = AF_INET;
  four.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  EXPECT_EQ(Address(reinterpret_cast<const sockaddr*>(&four)).text(), "127.0.0.1");
  sockaddr local{};
  local.sa_family = AF_UNIX;
  for (const sockaddr* none : {static_cast<const sockaddr*>(nullptr), static_cast<const sockaddr*>(&local)}) {
    const Address address(none);
    EXPECT_EQ(address.text(), "");
    EXPECT_EQ(address.group(), "");
    EXPECT_FALSE(address.isLoopback());
    EXPECT_EQ(address, Address());
    EXPECT_FALSE(address == *Address::parse("0.0.0.0"));
  }
}

}  // namespace
