// SPDX-License-Identifier: Apache-2.0
// The document's own look at the first endpoint, and its first change, as they stand there.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/hosts/HostTest.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

class HostFirstLookTest : public HostTest {};

TEST_F(HostFirstLookTest, ShowsTheEndpoints) {
  EXPECT_THAT(host().carryOut("look"), AllOf(HasSubstr(R"(Name="eth0")"), HasSubstr(R"(Name="eth1")")));
}

TEST_F(HostFirstLookTest, ChangesAnAddressAndReadsItBack) {
  const std::string said = host().carryOut("change");
  EXPECT_THAT(said, AllOf(HasSubstr(R"(IPv4Address="192.0.2.77")"), HasSubstr(R"(SubnetMask="255.255.255.128")")));
  EXPECT_THAT(said, Not(HasSubstr("wbemcli:")));
}

}  // namespace
