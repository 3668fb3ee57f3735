// What a read costs, counted on the wire: over a real network the round trips are the cost.
#include <gmock/gmock.h>

#include <algorithm>
#include <chrono>
#include <thread>

#include "agent/ipmi/RecordedLog.h"
#include "agent/ipmi/SimulatedBmc.h"
#include "agent/ipmi/UdpRelay.h"
#include "instrumentation/ipmi/IpmiBackEnd.h"

namespace {

using IpmiFixture::SimulatedBmc;
using IpmiFixture::UdpRelay;
using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::parseSettings;

bool traced(const std::string& text) {
  const auto log = IpmiFixture::takeLog();
  return std::any_of(log.begin(), log.end(), [&](const auto& line) { return line.trace && line.text == text; });
}

TEST(IpmiRoundTrips, OfAReadAreTwelveFromColdAndSixInAHeldSession) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.settings(wire.port())));
  IpmiFixture::takeLog();

  backEnd.read();
  EXPECT_EQ(wire.requests(), 12u);
  EXPECT_TRUE(traced("read 1 interfaces in 12 round trips"));

  wire.reset();
  backEnd.read();
  EXPECT_EQ(wire.requests(), 6u);
  EXPECT_TRUE(traced("read 1 interfaces in 6 round trips"));
}

TEST(IpmiRoundTrips, AreNoneWithinTheCacheTime) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  auto settings = parseSettings(bmc.settings(wire.port()));
  settings.cache = std::chrono::minutes(1);
  IpmiBackEnd backEnd(settings);
  const auto first = backEnd.read();

  wire.reset();

  EXPECT_EQ(backEnd.read(), first);
  EXPECT_EQ(wire.requests(), 0u);
}

TEST(IpmiRoundTrips, OfAChangeInAHeldSessionAreThirteen) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.settings(wire.port())));
  backEnd.read();

  wire.reset();
  backEnd.change("lan1", {"192.0.2.77", "255.255.255.128"});

  // Three to look, one to see the lock free, lock, source, address, mask, commit, unlock, three to read back.
  EXPECT_EQ(wire.requests(), 13u);
}

TEST(IpmiRoundTrips, OfAChangeToWhatIsSoAlreadyAreThoseOfLooking) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.settings(wire.port())));
  backEnd.change("lan1", {"192.0.2.77", "255.255.255.128"});

  wire.reset();
  backEnd.change("lan1", {"192.0.2.77", "255.255.255.128"});

  EXPECT_EQ(wire.requests(), 3u);
}

TEST(IpmiRoundTrips, IncludeTheOneThatGivesTheSessionBack) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  {
    IpmiBackEnd backEnd(parseSettings(bmc.settings(wire.port())));
    backEnd.read();
    wire.reset();
  }
  EXPECT_EQ(wire.requests(), 1u);
}

// A BMC has few sessions; one that is merely left takes a place of them for a minute.
TEST(IpmiRoundTrips, IncludeTheOneThatGivesAnIdleSessionBack) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  auto settings = bmc.settings(wire.port());
  settings["session_timeout"] = "0.4";
  IpmiBackEnd backEnd(parseSettings(settings));
  backEnd.read();
  wire.reset();

  const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
  while (wire.requests() == 0 && std::chrono::steady_clock::now() < deadline) std::this_thread::yield();
  EXPECT_EQ(wire.requests(), 1u);

  wire.reset();
  backEnd.read();
  EXPECT_EQ(wire.requests(), 12u);
}

}  // namespace
