// SPDX-License-Identifier: Apache-2.0
// What a read costs, counted on the wire: over a real network the round trips are the cost.
#include <gmock/gmock.h>

#include <algorithm>
#include <chrono>
#include <future>
#include <thread>

#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/RecordingLog.h"
#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/agent/UdpRelay.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::parseSettings;

bool traced(const std::string& text) {
  const auto log = takeLog();
  return std::any_of(log.begin(), log.end(),
                     [&](const auto& line) { return line.channel == Channel::Trace && line.message == text; });
}

TEST(IpmiRoundTripsTest, OfAReadAreFourteenFromColdAndFourInAHeldSession) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
  takeLog();

  backEnd.read();
  EXPECT_EQ(wire.requests(), 14u);
  EXPECT_TRUE(traced("read 1 interfaces in 14 round trips"));

  wire.reset();
  backEnd.read();
  EXPECT_EQ(wire.requests(), 4u);
  EXPECT_TRUE(traced("read 1 interfaces in 4 round trips"));
}

TEST(IpmiRoundTripsTest, AreNoneWithinTheCacheTime) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  auto settings = parseSettings(bmc.patientSettings(wire.port()));
  settings.cache = std::chrono::minutes(1);
  IpmiBackEnd backEnd(settings);
  const auto first = backEnd.read();

  wire.reset();

  EXPECT_EQ(backEnd.read(), first);
  EXPECT_EQ(wire.requests(), 0u);
}

// Two back ends are what two processes have: each its own look, and the file in common.
class IpmiRoundTripsWithAnotherTest : public testing::Test {
 protected:
  static QV::Ipmi::IpmiSettings cached(const QV::BackEndSettings& section) {
    auto settings = parseSettings(section);
    settings.cache = std::chrono::minutes(1);
    return settings;
  }

  // Of who repeats what is lost, and nothing else on a machine that stalls.
  QV::BackEndSettings unhurried(std::uint16_t port) const {
    auto settings = bmc.settings(port);
    settings["retransmission_timeout"] = "2";
    return settings;
  }

  // What the next read costs, and whether it shows the address.
  unsigned requestsOfRead(const std::string& address) { return requestsOfRead(reader, address); }
  unsigned requestsOfRead(IpmiBackEnd& backEnd, const std::string& address) {
    wire.reset();
    EXPECT_EQ(backEnd.read().interfaces.at(0).ipv4Address, QV::ipv4(address));
    return wire.requests();
  }

  const SimulatedBmc bmc;
  UdpRelay wire{bmc.port()};
  IpmiBackEnd reader{cached(bmc.patientSettings(wire.port()))};
  IpmiBackEnd writer{cached(bmc.patientSettings())};
};

TEST_F(IpmiRoundTripsWithAnotherTest, AreSevenAfterItsChangeAndThenNone) {
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 14u);
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 0u);

  writer.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});

  EXPECT_EQ(requestsOfRead("192.0.2.77"), 7u);
  EXPECT_EQ(requestsOfRead("192.0.2.77"), 0u);
}

TEST_F(IpmiRoundTripsWithAnotherTest, AreNoneWhereItHadNothingToWrite) {
  writer.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});
  EXPECT_EQ(requestsOfRead("192.0.2.77"), 14u);

  writer.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});
  EXPECT_THROW(writer.change("lan2", {QV::ipv4("192.0.2.78"), QV::mask("255.255.255.128")}), std::runtime_error);

  EXPECT_EQ(requestsOfRead("192.0.2.77"), 0u);
}

TEST_F(IpmiRoundTripsWithAnotherTest, AreFourAfterAChangeThatTheBmcRefused) {
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 14u);

  bmc.hook("check", "exit 1");
  EXPECT_THROW(writer.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")}), std::runtime_error);

  EXPECT_EQ(requestsOfRead("192.0.2.10"), 4u);
}

TEST_F(IpmiRoundTripsWithAnotherTest, AreFourOnceWhileItsChangeIsUnderWayAndSevenOnceWhenItIsOver) {
  // Given a change that waits for the answer to its first write: the lock, three requests to look
  constexpr unsigned firstWrite = 5;
  UdpRelay slowWire(bmc.port());
  IpmiBackEnd slowWriter(cached(unhurried(slowWire.port())));
  slowWriter.read();
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 14u);
  slowWire.reset();
  slowWire.cutAtRequest(firstWrite);
  auto change = std::async(std::launch::async, [&] {
    slowWriter.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});
  });
  ASSERT_TRUE(poll([&] { return slowWire.requests() >= firstWrite; }));

  // When others read meanwhile and afterwards, however it ends
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 4u);
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 0u);
  slowWire.join();
  change.wait();

  // Then they look once more
  wire.reset();
  reader.read();
  EXPECT_EQ(wire.requests(), 7u);
}

TEST_F(IpmiRoundTripsWithAnotherTest, OfAReadWaitForAMaskWhoseAddressIsWrittenAlready) {
  // Given a change that waits for the answer to its second write: the lock, three requests to look, the address
  constexpr unsigned secondWrite = 6;
  bmc.ipmitool({"lan", "set", "1", "ipsrc", "static"});
  UdpRelay slowWire(bmc.port());
  IpmiBackEnd slowWriter(cached(unhurried(slowWire.port())));
  slowWriter.read();
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 14u);
  slowWire.reset();
  slowWire.cutAtRequest(secondWrite);
  auto change = std::async(std::launch::async, [&] {
    slowWriter.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});
  });
  ASSERT_TRUE(poll([&] { return slowWire.requests() >= secondWrite; }));

  // When another reads meanwhile, and looks more than once
  wire.reset();
  auto read = std::async(std::launch::async, [&] { return reader.read().interfaces.at(0); });
  EXPECT_TRUE(poll([&] { return wire.requests() > 7; }));
  slowWire.join();
  change.get();

  // Then it shows what belongs together
  const auto interface = read.get();
  EXPECT_EQ(interface.ipv4Address, QV::ipv4("192.0.2.77"));
  EXPECT_EQ(interface.ipv4SubnetMask, QV::mask("255.255.255.128"));
}

// Between its reads of the address the first change is over, and the second has written the earlier address and no mask
// yet: both reads of the pair show the same, and between them nobody holds the lock.
TEST_F(IpmiRoundTripsWithAnotherTest, OfAReadAreRepeatedIfTwoChangesInARowMeetIt) {
  bmc.hook("get", R"sh(
write() { sed -i "s/^$1=.*/$1=$2/" lan.state; head -c 8 /dev/urandom > generation; }
echo "$1" >> asked
case "$1 $(grep -cx "$1" asked)" in
  'subnet_mask 1') write ip_addr 198.51.100.5; write subnet_mask 255.255.0.0 ;;
  'ip_addr 2') write ip_addr 192.0.2.10 ;;
  'subnet_mask 3') write subnet_mask 255.255.255.0 ;;
esac)sh");

  const auto interface = reader.read().interfaces.at(0);

  EXPECT_EQ(interface.ipv4Address, QV::ipv4("192.0.2.10"));
  EXPECT_EQ(interface.ipv4SubnetMask, QV::mask("255.255.255.0"));
}

// The text of what the operation throws; empty if it succeeds.
template <typename Operation>
std::string failureOf(const Operation& operation) {
  try {
    operation();
    return {};
  } catch (const std::runtime_error& error) {
    return error.what();
  }
}

// What was written under a lock may be applied or dropped when the lock is given back, whenever that is. The simulator
// shows it until then, and drops it.
TEST_F(IpmiRoundTripsWithAnotherTest, AreNotNoneOnceItHasGivenBackALockThatItLeft) {
  // Given a change that is over and left its lock behind, and a look that was begun since
  UdpRelay brokenWire(bmc.port());
  auto settings = bmc.settings(brokenWire.port());
  settings["operation_timeout"] = "4";
  settings["session_timeout"] = "2";
  settings["retransmission_timeout"] = "1";
  IpmiBackEnd brokenWriter(parseSettings(settings));
  const auto readBroken = [&] { return failureOf([&] { brokenWriter.read(); }); };
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(100);
  const auto inTime = [&] { return std::chrono::steady_clock::now() < deadline; };
  readBroken();
  brokenWire.cutAtRequest(6);
  EXPECT_NE(failureOf([&] { brokenWriter.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")}); }), "");
  while (readBroken().find("did not open a session") == std::string::npos && inTime()) {
  }
  ASSERT_EQ(bmc.witness("Set in Progress"), "Set In Progress");
  // It waits for the lock for half its operation_timeout.
  auto hastySettings = bmc.settings(wire.port());
  hastySettings["operation_timeout"] = "5";
  IpmiBackEnd hasty(cached(hastySettings));
  hasty.read();
  EXPECT_EQ(requestsOfRead(hasty, "192.0.2.77"), 0u);

  // When the lock is given back
  brokenWire.join();
  while (!readBroken().empty() && inTime()) {
  }
  ASSERT_EQ(bmc.witness("Set in Progress"), "Set Complete");

  // Then the processor is looked at once more
  EXPECT_NE(requestsOfRead(hasty, "192.0.2.10"), 0u);
  EXPECT_EQ(requestsOfRead(hasty, "192.0.2.10"), 0u);
}

TEST_F(IpmiRoundTripsWithAnotherTest, AreFourEachTimeWhereChangesCannotBeLearnedOfAndTheLogSaysSoOnce) {
  std::filesystem::create_symlink("/dev/null", bmc.generationFile());
  takeLog();

  EXPECT_EQ(requestsOfRead("192.0.2.10"), 14u);
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 4u);
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 4u);

  const auto log = takeLog();
  const auto tells = [&](const auto& line) {
    return line.channel == Channel::Log && line.level == 6000 &&
           line.message.starts_with(bmc.generationFile() + ": is a symbolic link");
  };
  EXPECT_EQ(std::count_if(log.begin(), log.end(), tells), 1);
  EXPECT_TRUE(contains(log, "Tarnwick.Ipmi", 6000, "generation_file"));

  // And once the file can be used, looks are kept again
  std::filesystem::remove(bmc.generationFile());
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 4u);
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 0u);
}

TEST_F(IpmiRoundTripsWithAnotherTest, AreSevenAfterTheChangeOfOneThatCachesNothingItself) {
  IpmiBackEnd uncached(parseSettings(bmc.patientSettings()));
  EXPECT_EQ(requestsOfRead("192.0.2.10"), 14u);

  uncached.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});

  EXPECT_EQ(requestsOfRead("192.0.2.77"), 7u);
}

// What the instrumentation asks for a change: which interfaces there are, and the change.
void changeByName(IpmiBackEnd& backEnd, const char* address, const char* mask) {
  ASSERT_THAT(backEnd.interfaceNames(), testing::ElementsAre("lan1"));
  backEnd.change("lan1", {QV::ipv4(address), QV::mask(mask)});
}

TEST(IpmiRoundTripsTest, OfAChangeAreTenInAHeldSessionAndSixMoreFromCold) {
  const SimulatedBmc bmc;
  bmc.ipmitool({"lan", "set", "1", "ipsrc", "static"});
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));

  changeByName(backEnd, "192.0.2.77", "255.255.255.128");
  // Five to open the session, one to find the channel; then the lock, three to look, address, mask, commit, unlock, two
  // to read back.
  EXPECT_EQ(wire.requests(), 16u);

  wire.reset();
  changeByName(backEnd, "192.0.2.78", "255.255.255.0");
  EXPECT_EQ(wire.requests(), 10u);
}

TEST(IpmiRoundTripsTest, OfAChangeAreTwoMoreWhereTheSourceChanges) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
  backEnd.read();

  wire.reset();
  changeByName(backEnd, "192.0.2.77", "255.255.255.128");

  EXPECT_EQ(wire.requests(), 12u);
}

TEST(IpmiRoundTripsTest, AreOneLessInALaterSessionThatFindsTheChannelKnown) {
  const SimulatedBmc bmc;
  bmc.ipmitool({"lan", "set", "1", "ipsrc", "static"});
  UdpRelay wire(bmc.port());
  auto settings = bmc.settings(wire.port());
  settings["session_timeout"] = "3";
  settings["retransmission_timeout"] = "1.5";
  IpmiBackEnd backEnd(parseSettings(settings));
  backEnd.read();
  const auto giveBack = [&] {
    wire.reset();
    EXPECT_TRUE(poll([&] { return wire.requests() == 1; }));
    wire.reset();
  };

  giveBack();
  backEnd.read();
  EXPECT_EQ(wire.requests(), 9u) << "five to open the session, four of the interface";

  giveBack();
  changeByName(backEnd, "192.0.2.77", "255.255.255.128");
  EXPECT_EQ(wire.requests(), 15u);
}

TEST(IpmiRoundTripsTest, OpenOneSessionForABurstOfRequests) {
  constexpr unsigned clients = 8;
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
  std::vector<std::future<void>> requests;
  for (unsigned client = 0; client < clients; ++client) {
    requests.push_back(std::async(std::launch::async, [&] { backEnd.read(); }));
  }
  for (auto& request : requests) {
    EXPECT_NO_THROW(request.get());
  }

  EXPECT_EQ(wire.requests(), 14u + (clients - 1) * 4u);
}

TEST(IpmiRoundTripsTest, OfAChangeToWhatIsSoAlreadyAreThoseOfLookingWithTheLock) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
  backEnd.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});

  wire.reset();
  backEnd.change("lan1", {QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")});

  EXPECT_EQ(wire.requests(), 5u);
}

TEST(IpmiRoundTripsTest, IncludeTheOneThatGivesTheSessionBack) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  {
    IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
    backEnd.read();
    wire.reset();
  }
  EXPECT_EQ(wire.requests(), 1u);
}

// A BMC has few sessions; one that is merely left takes a place of them for a minute.
TEST(IpmiRoundTripsTest, IncludeTheOneThatGivesAnIdleSessionBack) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  auto settings = bmc.settings(wire.port());
  settings["session_timeout"] = "3";
  settings["retransmission_timeout"] = "1.5";
  IpmiBackEnd backEnd(parseSettings(settings));
  backEnd.read();
  wire.reset();

  EXPECT_TRUE(poll([&] { return wire.requests() != 0; }));
  EXPECT_EQ(wire.requests(), 1u);

  wire.reset();
  backEnd.read();
  EXPECT_EQ(wire.requests(), 9u);
}

}  // namespace
