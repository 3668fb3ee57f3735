// SPDX-License-Identifier: Apache-2.0
// The product on a BMC that answers real IPMI over the network; ipmitool tells what the BMC itself holds.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/hosts/HostTest.h"
#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/FactoryState.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;

class HostBmcTest : public HostTest {
 protected:
  void SetUp() override {
    QV::BackEndSettings settings = bmc_.settings();
    // As an administrator has it, who leaves these keys out: an object manager has little patience with a provider.
    settings.erase("cache");
    settings.erase("operation_timeout");
    std::string processor = "[processor]\nbackend = ipmi\n[ipmi]\n";
    for (const auto& [key, value] : settings) {
      processor += key + " = " + value + '\n';
    }
    serve(processor);
  }

  std::string heldAddress() const { return bmc_.witness("IP Address") + '/' + bmc_.witness("Subnet Mask"); }

  static std::string shownAddress() {
    const auto shown = host().get(endpoint("lan1"));
    std::string text = shown.at("IPv4Address") + '/' + shown.at("SubnetMask");
    std::erase(text, '"');
    return text;
  }

  SimulatedBmc bmc_;
};

TEST_F(HostBmcTest, IsShownAsItIs) {
  EXPECT_EQ(canonical(host().names("ein", "YRNx_MgmtHwIPProtocolEndPoint")), canonical(Objects{endpoint("lan1")}));
  EXPECT_EQ(shownAddress(), heldAddress());
  EXPECT_EQ(host().get(endpoint("lan1")).at("AddressOrigin"), "4");
  EXPECT_EQ(bmc_.witness("IP Address Source"), "DHCP Address");
  EXPECT_EQ(host().get(remoteAccessPoint("Gateway:lan1")).at("AccessInfo"), quoted(bmc_.witness("Default Gateway IP")));
  EXPECT_EQ(canonical(host().names("ain -ac YRNx_MgmtHwClientAccess", endpoint("lan1"))),
            canonical(Objects{remoteAccessPoint("Gateway:lan1")}));
}

TEST_F(HostBmcTest, ShowsChangesAtOnce) {
  for (int i = 1; i <= 6; ++i) {
    const std::string address = "192.0.2." + std::to_string(100 + i);
    const std::string mask = i % 2 == 0 ? "255.255.255.0" : "255.255.255.128";
    host().modify(i % 3 == 0 ? staticSetting("lan1") : endpoint("lan1"),
                  "IPv4Address=" + address + ",SubnetMask=" + mask);
    EXPECT_EQ(shownAddress(), address + '/' + mask);
    EXPECT_EQ(heldAddress(), address + '/' + mask);
  }
  EXPECT_EQ(bmc_.witness("IP Address Source"), "Static Address");
  EXPECT_EQ(host().get(endpoint("lan1")).at("AddressOrigin"), "3");
  EXPECT_EQ(host().log(), "");
}

TEST_F(HostBmcTest, StaysAsItIsWhereAChangeIsRefused) {
  const std::string before = heldAddress();
  host().modify(endpoint("lan1"), "IPv4Address=127.0.0.1");
  host().modify(endpoint("lan1"), "SubnetMask=255.0.255.0");
  bmc_.hook("check", "exit 1");
  host().modify(endpoint("lan1"), "IPv4Address=192.0.2.77");
  bmc_.removeHook("check");
  EXPECT_EQ(heldAddress(), before);
  EXPECT_EQ(shownAddress(), before);
  EXPECT_THAT(host().log(), AllOf(HasSubstr("127.0.0.1"), HasSubstr("255.0.255.0"), HasSubstr("192.0.2.77")));
}

TEST_F(HostBmcTest, IsFoundAgainAfterItWasAway) {
  const std::string before = shownAddress();
  bmc_.kill();
  EXPECT_TRUE(poll([] { return host().wbemcli("ei", "YRNx_MgmtHwIPProtocolEndPoint").status != 0; }));
  const std::string failure = host().failure("ei", "YRNx_MgmtHwIPProtocolEndPoint");
  EXPECT_THAT(failure, HasSubstr("(1) CIM_ERR_FAILED"));
  EXPECT_TRUE(host().guide().explains(failure)) << failure;
  EXPECT_THAT(host().diagnostics(), HasSubstr("127.0.0.1:" + std::to_string(bmc_.port())));
  bmc_.restart();
  EXPECT_EQ(shownAddress(), before);
}

}  // namespace
