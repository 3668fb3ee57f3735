// SPDX-License-Identifier: Apache-2.0
// The whole product on a BMC that answers real IPMI over RMCP+; ipmitool is the witness of what the BMC itself holds.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <chrono>
#include <future>
#include <optional>

#include "tests/support/Classes.h"
#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using namespace std::chrono_literals;
using Personality = SimulatedBmc::Personality;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;

// Of who asks a BMC that does not answer; the others have times that no machine takes, be it as busy as it may.
constexpr std::chrono::seconds operationTimeout = 4s;
// What starting wbemcli and carrying its request takes on a machine that is busy with other tests.
constexpr auto margin = 20s;

QV::BackEndSettings impatient(QV::BackEndSettings settings) {
  settings["operation_timeout"] = std::to_string(operationTimeout.count());
  return settings;
}

std::string sectionFor(const QV::BackEndSettings& settings) {
  std::string text = "[processor]\nbackend = ipmi\n[ipmi]\n";
  for (const auto& [key, value] : settings) {
    text += key + " = " + value + '\n';
  }
  return text;
}

std::string witnessedAddress(const SimulatedBmc& bmc) {
  return bmc.witness("IP Address") + '/' + bmc.witness("Subnet Mask") + ' ' + bmc.witness("IP Address Source");
}

class BmcStackTest : public testing::Test {
 protected:
  void start(Personality personality = Personality::AppliesOnCommit) {
    bmc_.emplace(personality);
    startObjectManager(bmc_->patientSettings());
  }

  void startObjectManager(const QV::BackEndSettings& settings) { stack_.emplace(sectionFor(settings)); }

  void startImpatient() {
    bmc_.emplace();
    startObjectManager(impatient(bmc_->settings()));
  }

  // A read ends in time with an error that holds the reason, which the log holds too; other requests are served after
  // it.
  void expectFailure(const std::string& reason) const {
    const auto begin = std::chrono::steady_clock::now();
    const std::string read = stack_->failure("ei", Classes::endpoint);
    EXPECT_LT(std::chrono::steady_clock::now() - begin, operationTimeout + margin);
    EXPECT_THAT(read, AllOf(HasSubstr("(1) CIM_ERR_FAILED"), HasSubstr(reason)));
    EXPECT_THAT(stack_->log(), HasSubstr(reason));
    expectServing();
  }

  void expectServing() const {
    EXPECT_EQ(stack_->wbemcli("ecn", "").status, 0);
    EXPECT_THAT(stack_->failure("ei", "YRNx_MgmtHwNothing"), HasSubstr("CIM_ERR_INVALID_CLASS"));
  }

  void expectAnswering() const {
    EXPECT_EQ(stack_->get(endpoint("lan1")).at("IPv4Address"), quoted(bmc_->witness("IP Address")));
  }

  std::optional<SimulatedBmc> bmc_;
  std::optional<CompositeStack> stack_;
};

TEST_F(BmcStackTest, ShowsWhatTheBmcHolds) {
  start();
  EXPECT_EQ(stack_->names("ein", Classes::endpoint), std::vector{endpoint("lan1")});
  const auto shown = stack_->get(endpoint("lan1"));
  EXPECT_EQ(shown.at("IPv4Address"), quoted(bmc_->witness("IP Address")));
  EXPECT_EQ(shown.at("IPv4Address"), quoted("192.0.2.10"));
  EXPECT_EQ(shown.at("SubnetMask"), quoted(bmc_->witness("Subnet Mask")));
  EXPECT_EQ(shown.at("AddressOrigin"), "4");
  EXPECT_EQ(bmc_->witness("IP Address Source"), "DHCP Address");
  EXPECT_EQ(stack_->get(remoteAccessPoint("Gateway:lan1")).at("AccessInfo"),
            quoted(bmc_->witness("Default Gateway IP")));
  EXPECT_THAT(stack_->names("ain -ac YRNx_MgmtHwClientAccess", endpoint("lan1")),
              ElementsAre(remoteAccessPoint("Gateway:lan1")));
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.10/255.255.255.0 DHCP Address");
}

TEST_F(BmcStackTest, ShowsWhatOthersChange) {
  start();
  bmc_->ipmitool({"lan", "set", "1", "ipsrc", "static"});
  bmc_->ipmitool({"lan", "set", "1", "ipaddr", "192.0.2.33"});
  const auto shown = stack_->get(endpoint("lan1"));
  EXPECT_EQ(shown.at("IPv4Address"), quoted("192.0.2.33"));
  EXPECT_EQ(shown.at("AddressOrigin"), "3");
}

TEST_F(BmcStackTest, ChangesAnEndpointOnABmcThatAppliesOnCommit) {
  start();
  stack_->modify(endpoint("lan1"), "IPv4Address=192.0.2.77,SubnetMask=255.255.255.128");
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.77/255.255.255.128 Static Address");
  expectAnswering();
}

TEST_F(BmcStackTest, ChangesStaticSettingsOnABmcThatAppliesOnCommit) {
  start();
  stack_->modify(staticSetting("lan1"), "IPv4Address=192.0.2.78");
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.78/255.255.255.0 Static Address");
}

TEST_F(BmcStackTest, ChangesAnEndpointOnABmcThatAppliesAtOnce) {
  start(Personality::AppliesAtOnce);
  EXPECT_EQ(bmc_->witness("IP Address"), "0.0.0.0");
  stack_->modify(staticSetting("lan1"), "IPv4Address=192.0.2.77,SubnetMask=255.255.255.128");
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.77/255.255.255.128 Static Address");
  expectAnswering();
}

TEST_F(BmcStackTest, IsChangedByTwoObjectManagersOneAfterTheOther) {
  start();
  const CompositeStack other(sectionFor(bmc_->patientSettings()));
  auto first = std::async(std::launch::async, [&] { stack_->modify(staticSetting("lan1"), "IPv4Address=192.0.2.77"); });
  other.modify(staticSetting("lan1"), "IPv4Address=192.0.2.78");
  first.get();
  // One of them may have found the BMC busy and said so; the BMC holds what another has written whole.
  const bool firstDone = stack_->log().empty();
  const bool otherDone = other.log().empty();
  EXPECT_TRUE(firstDone || otherDone) << stack_->log() << other.log();
  const std::string address = bmc_->witness("IP Address");
  if (firstDone != otherDone) {
    EXPECT_EQ(address, firstDone ? "192.0.2.77" : "192.0.2.78");
  } else {
    EXPECT_THAT(address, testing::AnyOf("192.0.2.77", "192.0.2.78"));
  }
  stack_->modify(staticSetting("lan1"), "IPv4Address=192.0.2.79");
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.79/255.255.255.0 Static Address");
}

TEST_F(BmcStackTest, ShowsAtOnceWhatAnotherObjectManagerChanged) {
  bmc_.emplace();
  QV::BackEndSettings settings = bmc_->patientSettings();
  settings["cache"] = "60";
  startObjectManager(settings);
  const CompositeStack other(sectionFor(settings));
  EXPECT_EQ(stack_->get(endpoint("lan1")).at("IPv4Address"), quoted("192.0.2.10"));
  EXPECT_EQ(other.get(endpoint("lan1")).at("IPv4Address"), quoted("192.0.2.10"));
  stack_->modify(endpoint("lan1"), "IPv4Address=192.0.2.77");
  EXPECT_EQ(other.get(endpoint("lan1")).at("IPv4Address"), quoted("192.0.2.77"));
  other.modify(staticSetting("lan1"), "IPv4Address=192.0.2.78");
  EXPECT_EQ(stack_->get(endpoint("lan1")).at("IPv4Address"), quoted("192.0.2.78"));
  EXPECT_EQ(bmc_->witness("IP Address"), "192.0.2.78");
  EXPECT_EQ(stack_->log() + other.log(), "");
}

TEST_F(BmcStackTest, SendsNothingOfAChangeThatNoInterfaceCanHave) {
  start();
  stack_->modify(endpoint("lan1"), "IPv4Address=127.0.0.1");
  stack_->modify(endpoint("lan1"), "SubnetMask=255.0.255.0");
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.10/255.255.255.0 DHCP Address");
  EXPECT_THAT(stack_->log(), AllOf(HasSubstr("127.0.0.1"), HasSubstr("255.0.255.0")));
}

TEST_F(BmcStackTest, SaysInTheLogThatTheBmcRefusedAChange) {
  start();
  bmc_->hook("check", "exit 1");
  stack_->modify(endpoint("lan1"), "IPv4Address=192.0.2.77");
  EXPECT_EQ(witnessedAddress(*bmc_), "192.0.2.10/255.255.255.0 DHCP Address");
  EXPECT_THAT(stack_->log(), AllOf(HasSubstr(" 6000 "), HasSubstr("192.0.2.77"), HasSubstr("lan1")));
  bmc_->removeHook("check");
  stack_->modify(endpoint("lan1"), "IPv4Address=192.0.2.77");
  EXPECT_EQ(bmc_->witness("IP Address"), "192.0.2.77");
}

TEST_F(BmcStackTest, OutlivesABmcThatStalls) {
  startImpatient();
  expectAnswering();
  bmc_->halt();
  expectFailure("127.0.0.1:" + std::to_string(bmc_->port()));
  bmc_->resume();
  expectAnswering();
}

TEST_F(BmcStackTest, ServesOthersWhileABmcStalls) {
  bmc_.emplace();
  QV::BackEndSettings settings = bmc_->settings();
  settings["operation_timeout"] = "12";
  startObjectManager(settings);
  bmc_->halt();
  Process waiting({"wbemcli", "ei", stack_->url(Classes::computerSystem)});
  expectServing();
  EXPECT_TRUE(waiting.isRunning());
  EXPECT_NE(waiting.wait(), 0);
  EXPECT_THAT(waiting.errors(), HasSubstr("127.0.0.1:" + std::to_string(bmc_->port())));
  bmc_->resume();
}

TEST_F(BmcStackTest, SaysInTheLogThatTheOutcomeOfAChangeIsUnknown) {
  startImpatient();
  bmc_->hook("set", "kill -STOP $SIMULATOR");
  const auto begin = std::chrono::steady_clock::now();
  stack_->modify(endpoint("lan1"), "IPv4Address=192.0.2.77");
  EXPECT_LT(std::chrono::steady_clock::now() - begin, 2 * operationTimeout + margin);
  EXPECT_THAT(stack_->log(), AllOf(HasSubstr("192.0.2.77"), HasSubstr("unknown")));
  expectServing();
  bmc_->removeHook("set");
  bmc_->resume();
  expectAnswering();
}

TEST_F(BmcStackTest, OutlivesABmcThatEndsAndStartsAgain) {
  startImpatient();
  expectAnswering();
  bmc_->kill();
  expectFailure("127.0.0.1:" + std::to_string(bmc_->port()));
  bmc_->restart();
  expectAnswering();
  stack_->modify(endpoint("lan1"), "IPv4Address=192.0.2.77");
  EXPECT_EQ(bmc_->witness("IP Address"), "192.0.2.77");
}

TEST_F(BmcStackTest, SaysThatThePasswordIsRefused) {
  bmc_.emplace();
  const TemporaryDirectory secrets;
  QV::BackEndSettings settings = bmc_->settings();
  settings["password_file"] = (secrets.path() / "password").string();
  writePrivateFile(settings["password_file"], "wrong\n");
  startObjectManager(settings);
  expectFailure("password");
}

TEST_F(BmcStackTest, SaysThatNobodyAnswersAtAPort) {
  startImpatient();
  bmc_->kill();
  expectFailure("127.0.0.1:" + std::to_string(bmc_->port()));
}

TEST_F(BmcStackTest, SaysWhatIsWrongWithItsSettings) {
  bmc_.emplace();
  QV::BackEndSettings settings = bmc_->settings();
  settings["cipher_suite"] = "0";
  startObjectManager(settings);
  expectFailure("cipher_suite");
}

}  // namespace
