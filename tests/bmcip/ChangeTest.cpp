// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "bmcip/model/Change.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace Bmcip;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Pair;
using Testing::thrownBy;

Interface interface(const std::string& address, const std::string& mask, const std::string& origin = "static") {
  Interface made;
  made.name = "eth0";
  made.address = address;
  made.mask = mask;
  made.origin = origin;
  return made;
}

const Interface before = interface("192.0.2.10", "255.255.255.0");

TEST(ChangeTest, ReadsAnAddressWithItsPrefix) {
  EXPECT_EQ(parseAddressWithPrefix("192.0.2.77/25"), (Ipv4Settings{"192.0.2.77", "255.255.255.128", ""}));
  EXPECT_EQ(parseAddressWithPrefix("192.0.2.77/1"), (Ipv4Settings{"192.0.2.77", "128.0.0.0", ""}));
  EXPECT_EQ(parseAddressWithPrefix("192.0.2.77/31"), (Ipv4Settings{"192.0.2.77", "255.255.255.254", ""}));
  EXPECT_EQ(parseAddressWithPrefix("192.0.2.77"), (Ipv4Settings{"192.0.2.77", "", ""}));
  for (const char* text : {"192.0.2.77/", "192.0.2.77/0", "192.0.2.77/32", "192.0.2.77/x", "192.0.2.77/24/1"}) {
    EXPECT_THAT(thrownBy([&] { parseAddressWithPrefix(text); }), HasSubstr("must be a number from 1 to 31")) << text;
  }
}

TEST(ChangeTest, SendsBothWhereOnlyOneIsAskedFor) {
  EXPECT_THAT(planChange(before, "192.0.2.77", "").values(),
              ElementsAre(Pair("IPv4Address", "192.0.2.77"), Pair("SubnetMask", "255.255.255.0")));
  EXPECT_THAT(planChange(before, "", "255.255.255.128").values(),
              ElementsAre(Pair("IPv4Address", "192.0.2.10"), Pair("SubnetMask", "255.255.255.128")));
}

TEST(ChangeTest, LeavesOutWhatNoInterfaceCanHave) {
  EXPECT_THAT(planChange(interface("0.0.0.0", "0.0.0.0", "DHCP"), "192.0.2.77", "").values(),
              ElementsAre(Pair("IPv4Address", "192.0.2.77")));
  EXPECT_THAT(planChange(interface("", "", ""), "192.0.2.77", "255.255.255.0").values(),
              ElementsAre(Pair("IPv4Address", "192.0.2.77"), Pair("SubnetMask", "255.255.255.0")));
}

TEST(ChangeTest, RefusesValuesBeforeTheyAreSent) {
  EXPECT_THAT(thrownBy([] { planChange(before, "127.0.0.1", ""); }), HasSubstr("loopback"));
  EXPECT_THAT(thrownBy([] { planChange(before, "192.0.2", ""); }), HasSubstr("four decimal numbers"));
  EXPECT_THAT(thrownBy([] { planChange(before, "", "255.0.255.0"); }), HasSubstr("255.0.255.0"));
  EXPECT_THAT(thrownBy([] { planChange(before, "192.0.2.255", ""); }), HasSubstr("broadcast"));
}

TEST(ChangeTest, IsNeededUnlessEverythingIsThere) {
  EXPECT_FALSE(planChange(before, "192.0.2.10", "255.255.255.0").isNeeded());
  EXPECT_TRUE(planChange(before, "192.0.2.11", "").isNeeded());
  EXPECT_TRUE(planChange(interface("192.0.2.10", "255.255.255.0", "DHCP"), "192.0.2.10", "").isNeeded());
  // Nobody says where the address is from.
  EXPECT_FALSE(planChange(interface("192.0.2.10", "255.255.255.0", ""), "192.0.2.10", "").isNeeded());
}

TEST(ChangeTest, JudgesWhatShows) {
  const Change change = planChange(before, "192.0.2.77", "255.255.255.128");
  const Ipv4Settings half = {"192.0.2.77", "255.255.255.0", "static"};
  EXPECT_EQ(judge(change, change.wanted, false), Outcome::Applied);
  EXPECT_EQ(judge(change, change.wanted, true), Outcome::Applied);
  EXPECT_EQ(judge(change, change.before, false), Outcome::Ignored);
  EXPECT_EQ(judge(change, change.before, true), Outcome::Refused);
  EXPECT_EQ(judge(change, half, false), Outcome::HalfApplied);
  EXPECT_EQ(judge(change, half, true), Outcome::HalfApplied);
  EXPECT_EQ(judge(change, std::nullopt, false), Outcome::Unknown);
  EXPECT_EQ(judge(change, std::nullopt, true), Outcome::Refused);
}

TEST(ChangeTest, HasAnExitStatusForEveryOutcome) {
  EXPECT_EQ(exitStatusOf(Outcome::Applied), 0);
  EXPECT_EQ(exitStatusOf(Outcome::Unchanged), 0);
  EXPECT_EQ(exitStatusOf(Outcome::WouldChange), 0);
  EXPECT_EQ(exitStatusOf(Outcome::Refused), 3);
  EXPECT_EQ(exitStatusOf(Outcome::Ignored), 4);
  EXPECT_EQ(exitStatusOf(Outcome::HalfApplied), 5);
  EXPECT_EQ(exitStatusOf(Outcome::Unknown), 6);
  EXPECT_EQ(exitStatusOf(Outcome::NotConfirmed), 7);
}

}  // namespace
