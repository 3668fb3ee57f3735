// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include "agent/backends/ipmi/lan/ChannelDiscovery.h"
#include "tests/agent/backends/ipmi/ScriptedBmc.h"

namespace {

using namespace Testing;
using QV::Ipmi::ChannelChoice;
using QV::Ipmi::discoverChannels;
using QV::Ipmi::IpmiError;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::ThrowsMessage;

constexpr std::uint8_t systemInterface = 0x0F;

TEST(IpmiChannelsTest, InUseOverLanIsTheSessionsOwnAtOneRoundTrip) {
  ScriptedBmc bmc;
  bmc.lanChannels = {1, 8};
  bmc.presentChannel = 8;

  EXPECT_THAT(discoverChannels(bmc, {}), ElementsAre(8));
  EXPECT_EQ(bmc.requests, 1u);
}

TEST(IpmiChannelsTest, InUseInBandIsTheFirstLanChannel) {
  ScriptedBmc bmc;
  bmc.lanChannels = {2, 8};
  bmc.presentChannel = systemInterface;

  EXPECT_THAT(discoverChannels(bmc, {}), ElementsAre(2));
  EXPECT_EQ(bmc.requests, 3u);
}

TEST(IpmiChannelsTest, AllAreFoundAtElevenRoundTrips) {
  ScriptedBmc bmc;
  bmc.lanChannels = {1, 3, 11};

  EXPECT_THAT(discoverChannels(bmc, {ChannelChoice::Mode::All, {}}), ElementsAre(1, 3, 11));
  EXPECT_EQ(bmc.requests, 11u);
}

TEST(IpmiChannelsTest, ListedAreTakenAsTheyAre) {
  ScriptedBmc bmc;
  EXPECT_THAT(discoverChannels(bmc, {ChannelChoice::Mode::Listed, {2, 5}}), ElementsAre(2, 5));
  EXPECT_EQ(bmc.requests, 0u);
}

TEST(IpmiChannelsTest, AreToBeNamedWhereTheBmcShowsNone) {
  ScriptedBmc bmc;
  bmc.lanChannels = {};
  bmc.presentChannel = systemInterface;
  EXPECT_THAT([&] { discoverChannels(bmc, {}); }, ThrowsMessage<IpmiError>(HasSubstr("name them in channels")));
}

}  // namespace
