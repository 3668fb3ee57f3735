// SPDX-License-Identifier: Apache-2.0
// What goes wrong between the agent and its BMC: every operation ends in its time, and the next one after the recovery
// works.
#include <gmock/gmock.h>

#include <chrono>

#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/RecordingLog.h"
#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/agent/UdpRelay.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using QV::AddressChange;
using QV::BackEndSettings;
using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::parseSettings;
using testing::HasSubstr;
using testing::ThrowsMessage;
using namespace std::chrono_literals;

const AddressChange bothValues{QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")};

auto refusal(const std::string& text) { return ThrowsMessage<std::runtime_error>(HasSubstr(text)); }

// What is not disturbed takes less even on a machine that stalls for seconds; who takes two of it is found out.
constexpr auto operationTimeout = 4000ms;
constexpr auto tolerance = 3900ms;

BackEndSettings impatient(BackEndSettings settings) {
  settings["operation_timeout"] = std::to_string(operationTimeout / 1s);
  return settings;
}

// Runs the operation and holds it to its time-out.
template <typename Operation>
auto inTime(Operation operation) {
  return [operation] {
    const auto start = std::chrono::steady_clock::now();
    try {
      operation();
    } catch (...) {
      EXPECT_LT(std::chrono::steady_clock::now() - start, operationTimeout + tolerance);
      throw;
    }
  };
}

// Repeats a read until the BMC is back.
bool readsAgain(IpmiBackEnd& backEnd) {
  const auto deadline = std::chrono::steady_clock::now() + 60s;
  while (std::chrono::steady_clock::now() < deadline) {
    try {
      backEnd.read();
      return true;
    } catch (const std::runtime_error&) {
    }
  }
  return false;
}

TEST(IpmiFailureTest, OfABmcThatStallsEndsInTimeAndPasses) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(impatient(bmc.settings())));
  backEnd.read();

  bmc.halt();
  EXPECT_THAT(inTime([&] { backEnd.read(); }), refusal("the BMC at 127.0.0.1"));
  EXPECT_THAT(inTime([&] { backEnd.read(); }), refusal("the BMC at 127.0.0.1"));
  EXPECT_THAT(inTime([&] { backEnd.change("lan1", bothValues); }), refusal("nothing was changed"));
  bmc.resume();

  EXPECT_TRUE(readsAgain(backEnd));
  EXPECT_EQ(bmc.stored("ip_addr"), "192.0.2.10");
}

TEST(IpmiFailureTest, OfABmcThatIsRestartedPasses) {
  SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(impatient(bmc.settings())));
  backEnd.read();

  bmc.kill();
  EXPECT_THAT(inTime([&] { backEnd.read(); }), refusal("the BMC at 127.0.0.1"));
  bmc.restart();

  EXPECT_TRUE(readsAgain(backEnd));
}

TEST(IpmiFailureTest, OfASessionThatTheBmcForgotIsNotSeen) {
  SimulatedBmc bmc;
  auto settings = bmc.settings();
  settings["session_timeout"] = "1";
  IpmiBackEnd backEnd(parseSettings(settings));
  backEnd.read();

  bmc.kill();
  bmc.restart();

  EXPECT_EQ(backEnd.read().interfaces.at(0).ipv4Address, QV::ipv4("192.0.2.10"));
}

TEST(IpmiFailureTest, OfABmcThatStallsInMidChangeLeavesTheOutcomeOpenAndNoLockBehind) {
  const SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(impatient(bmc.settings())));
  bmc.hook("set", "kill -STOP $SIMULATOR");
  takeLog();

  EXPECT_THAT(inTime([&] { backEnd.change("lan1", bothValues); }), refusal("unknown"));
  EXPECT_TRUE(contains(takeLog(), "Tarnwick.Ipmi", 6000, "unknown"));
  bmc.removeHook("set");
  bmc.resume();

  EXPECT_TRUE(readsAgain(backEnd));
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
  backEnd.change("lan1", bothValues);
  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.77");
}

TEST(IpmiFailureTest, OfABmcThatDiesInMidChangeLeavesTheOutcomeOpen) {
  SimulatedBmc bmc;
  IpmiBackEnd backEnd(parseSettings(impatient(bmc.settings())));
  bmc.hook("set", "kill -KILL $SIMULATOR");

  EXPECT_THAT(inTime([&] { backEnd.change("lan1", bothValues); }), refusal("unknown"));
  bmc.removeHook("set");
  bmc.restart();

  EXPECT_TRUE(readsAgain(backEnd));
  backEnd.change("lan1", bothValues);
  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.77");
}

// Has another address for every request, which it answers after the seconds.
void changeAddressAlways(const SimulatedBmc& bmc, const char* seconds) {
  bmc.hook("get", R"sh([ "$1" = ip_addr ] || exit 0
[ ! -e asked ] || read -r count < asked
echo $((count += 1)) > asked
./lancontrol set ip_addr "198.51.100.$((count % 250 + 1))"
sleep )sh" + std::string(seconds));
}

TEST(IpmiFailureTest, OfABmcWhoseAddressNeverStaysIsSaidToBeThat) {
  const SimulatedBmc bmc;
  changeAddressAlways(bmc, "0");
  IpmiBackEnd backEnd(parseSettings(impatient(bmc.settings())));

  EXPECT_THAT(inTime([&] { backEnd.read(); }), refusal("change lan1 again and again"));
  bmc.removeHook("get");

  EXPECT_TRUE(readsAgain(backEnd));
}

// A look takes more than a third of the time that there is.
TEST(IpmiFailureTest, OfASlowBmcWhoseAddressNeverStaysIsSaidToBeThat) {
  const SimulatedBmc bmc;
  changeAddressAlways(bmc, "0.7");
  auto settings = impatient(bmc.settings());
  settings["retransmission_timeout"] = "1";
  IpmiBackEnd backEnd(parseSettings(settings));

  EXPECT_THAT(inTime([&] { backEnd.read(); }), refusal("change lan1 again and again"));
}

TEST(IpmiFailureTest, OfTheNetworkInMidChangeLeavesTheOutcomeOpenAndNoLockBehind) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(impatient(bmc.settings(wire.port()))));
  backEnd.read();

  // Locked, looked (3), source, and there it goes.
  wire.cutAtRequest(6);
  EXPECT_THAT(inTime([&] { backEnd.change("lan1", bothValues); }), refusal("unknown"));
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set In Progress");
  wire.join();

  EXPECT_TRUE(readsAgain(backEnd));
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
}

TEST(IpmiFailureTest, OfTheNetworkForAMomentEndsInAConfirmedChange) {
  const SimulatedBmc bmc;
  UdpRelay wire(bmc.port());
  auto settings = bmc.settings(wire.port());
  settings["session_timeout"] = "3";
  settings["retransmission_timeout"] = "1";
  IpmiBackEnd backEnd(parseSettings(settings));
  backEnd.read();
  // The commit's answer is lost with the session; the network comes back.
  wire.cutAtRequest(8);
  std::jthread healer([&](std::stop_token stop) {
    while (!stop.stop_requested() && bmc.stored("ip_addr") != "192.0.2.77") {
      std::this_thread::yield();
    }
    const auto requests = wire.requests();
    while (!stop.stop_requested() && wire.requests() < requests + 3) {
      std::this_thread::yield();
    }
    wire.join();
  });

  backEnd.change("lan1", bothValues);

  EXPECT_EQ(bmc.witness("IP Address"), "192.0.2.77");
  EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
}

struct Refusal {
  const char* name;
  const char* key;
  const char* value;
  const char* message;
};

class IpmiSessionRefusedTest : public testing::TestWithParam<Refusal> {};

TEST_P(IpmiSessionRefusedTest, TellsWhatToDo) {
  const SimulatedBmc bmc;
  auto settings = impatient(bmc.settings());
  settings[GetParam().key] = GetParam().value;
  IpmiBackEnd backEnd(parseSettings(settings));

  EXPECT_THAT(inTime([&] { backEnd.read(); }), refusal(GetParam().message));
  EXPECT_THAT(inTime([&] { backEnd.change("lan1", bothValues); }), refusal(GetParam().message));

  IpmiBackEnd right(parseSettings(bmc.settings()));
  EXPECT_NO_THROW(right.read());
}

INSTANTIATE_TEST_SUITE_P(Reasons, IpmiSessionRefusedTest,
                         testing::Values(Refusal{"CipherSuite", "cipher_suite", "17", "try cipher_suite = 3"},
                                         Refusal{"User", "user", "nobody", "the user 'nobody'"},
                                         Refusal{"Host", "host", "no-such-host.invalid", "host"},
                                         Refusal{"Port", "port", "9", "no answer; check host and port"}),
                         [](const auto& refusal) { return refusal.param.name; });

TEST(IpmiSessionRefusedTest, ForAWrongPasswordNamesItsFileAndSucceedsOnceItIsCorrected) {
  const SimulatedBmc bmc;
  const TemporaryDirectory directory;
  const std::string file = directory / "password";
  writePrivateFile(file, "wrong\n");
  auto settings = bmc.settings();
  settings["password_file"] = file;
  IpmiBackEnd backEnd(parseSettings(settings));
  EXPECT_THAT([&] { backEnd.read(); }, refusal("refused the password in " + file));

  writePrivateFile(file, "test\n");

  EXPECT_NO_THROW(backEnd.read());
}

TEST(IpmiSessionRefusedTest, InBandWhereThereIsNoDriverNamesTheModules) {
  IpmiBackEnd backEnd(parseSettings({{"device", "/dev/no-such-ipmi"}, {"cache", "0"}}));

  EXPECT_THAT([&] { backEnd.read(); },
              refusal("the BMC behind /dev/no-such-ipmi did not open a session: no such device"));
}

}  // namespace
