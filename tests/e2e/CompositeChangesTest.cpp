// SPDX-License-Identifier: Apache-2.0
// Changes that a client makes with wbemcli, followed down to the simulated management processor's state file.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>

#include "tests/support/Classes.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/CompositeStack.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;

class CompositeChangeTest : public testing::Test {
 protected:
  // An interface's address and mask, as the state file, the underlying and the composite class tell them.
  void expectAddress(const std::string& interface, const std::string& address, const std::string& mask) const {
    const auto composite = stack_.get(endpoint(interface));
    EXPECT_EQ(composite.at("IPv4Address"), quoted(address));
    EXPECT_EQ(composite.at("SubnetMask"), quoted(mask));
    const auto underlying =
        stack_.get("YRNQV_StaticIPAssignmentSettingData.InstanceID=" + quoted("BMC:" + interface), "root/yrnse");
    EXPECT_EQ(underlying.at("IPv4Address"), quoted(address));
    EXPECT_EQ(underlying.at("SubnetMask"), quoted(mask));
    EXPECT_THAT(contentOf(state_), HasSubstr("\"address\": \"" + address + "\",\n        \"subnetMask\": \"" + mask));
  }

  // The factory state is written when somebody first asks for it.
  std::string factoryState() const {
    stack_.names("ein", Classes::computerSystem);
    return contentOf(state_);
  }

  TemporaryDirectory directory_;
  const std::filesystem::path state_ = directory_.path() / "processor.json";
  const CompositeStack stack_{simulatedProcessor(state_)};
};

TEST_F(CompositeChangeTest, OfAnEndpointReachesTheProcessor) {
  stack_.modify(endpoint("eth0"), "IPv4Address=203.0.113.77,SubnetMask=255.255.255.128");
  expectAddress("eth0", "203.0.113.77", "255.255.255.128");
  expectAddress("eth1", "198.51.100.23", "255.255.255.0");
}

TEST_F(CompositeChangeTest, OfStaticSettingsReachesTheProcessor) {
  stack_.modify(staticSetting("eth0"), "IPv4Address=203.0.113.77,SubnetMask=255.255.255.128");
  expectAddress("eth0", "203.0.113.77", "255.255.255.128");
}

TEST_F(CompositeChangeTest, OfOneValueLeavesTheOther) {
  stack_.modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  expectAddress("eth0", "192.0.2.77", "255.255.255.0");
  stack_.modify(endpoint("eth0"), "SubnetMask=255.255.0.0");
  expectAddress("eth0", "192.0.2.77", "255.255.0.0");
  stack_.modify(staticSetting("eth1"), "IPv4Address=198.51.100.99");
  expectAddress("eth1", "198.51.100.99", "255.255.255.0");
  stack_.modify(staticSetting("eth1"), "SubnetMask=255.255.0.0");
  expectAddress("eth1", "198.51.100.99", "255.255.0.0");
}

TEST_F(CompositeChangeTest, OfALeasedAddressMakesItStatic) {
  EXPECT_EQ(stack_.get(endpoint("eth1")).at("AddressOrigin"), "4");
  stack_.modify(endpoint("eth1"), "IPv4Address=198.51.100.99");
  EXPECT_EQ(stack_.get(endpoint("eth1")).at("AddressOrigin"), "3");
}

TEST_F(CompositeChangeTest, OfWhatNoInterfaceCanHaveIsRefusedWithTheReasonInTheLog) {
  const std::string before = factoryState();
  const std::pair<const char*, const char*> refusals[] = {
      {"IPv4Address=192.0.2", "interface eth0: the IPv4 address '192.0.2' is not four decimal numbers"},
      {"IPv4Address=text", "the IPv4 address 'text' is not four decimal numbers"},
      {"IPv4Address=192.0.2.256", "the IPv4 address '192.0.2.256' is not"},
      {"IPv4Address=127.0.0.1", "the IPv4 address '127.0.0.1' "},
      {"IPv4Address=0.0.0.0", "the IPv4 address '0.0.0.0' "},
      {"IPv4Address=224.0.0.1", "the IPv4 address '224.0.0.1' "},
      {"IPv4Address=255.255.255.255", "the IPv4 address '255.255.255.255' "},
      {"SubnetMask=255.0.255.0", "the subnet mask '255.0.255.0' is not contiguous"},
      {"SubnetMask=0.0.0.0", "the subnet mask '0.0.0.0' leaves no network"},
      {"SubnetMask=24", "the subnet mask '24' is not four decimal numbers"},
  };
  for (const auto& [change, reason] : refusals) {
    // The composite accepts every change; what came of it is in the log.
    stack_.modify(endpoint("eth0"), change);
    EXPECT_THAT(stack_.log(), AllOf(HasSubstr(reason), HasSubstr("Caught Exception : "))) << change;
    EXPECT_EQ(contentOf(state_), before) << change;
  }
  stack_.modify(staticSetting("eth0"), "IPv4Address=169.254.300.1");
  EXPECT_THAT(stack_.log(), HasSubstr("'169.254.300.1'"));
  EXPECT_EQ(contentOf(state_), before);
}

TEST_F(CompositeChangeTest, OfARemoteAccessPointIsAcceptedWithoutEffect) {
  const std::string before = factoryState();
  stack_.modify(remoteAccessPoint("DNS:1"), "AccessInfo=203.0.113.53");
  EXPECT_EQ(stack_.get(remoteAccessPoint("DNS:1")).at("AccessInfo"), quoted("192.0.2.53"));
  EXPECT_EQ(contentOf(state_), before);
}

TEST_F(CompositeChangeTest, OfAnUnknownInterfaceIsRefused) {
  const std::string before = factoryState();
  EXPECT_THAT(stack_.failure("mi", endpoint("eth9"), {"IPv4Address=192.0.2.77"}), HasSubstr("CIM_ERR_NOT_FOUND"));
  EXPECT_THAT(stack_.failure("mi", staticSetting("eth9"), {"IPv4Address=192.0.2.77"}), HasSubstr("CIM_ERR_NOT_FOUND"));
  EXPECT_EQ(contentOf(state_), before);
}

TEST_F(CompositeChangeTest, OfAnUndeclaredPropertyIsRefused) {
  EXPECT_THAT(stack_.failure("mi", endpoint("eth0"), {"Undeclared=1"}), HasSubstr("Undeclared"));
}

TEST_F(CompositeChangeTest, OfClassesThatCannotChangeIsNotSupported) {
  const std::string before = factoryState();
  for (const std::string& object : {computerSystem(), sequence("eth0:static"), dhcpSetting("eth0")}) {
    EXPECT_THAT(stack_.failure("mi", object, {"ElementName=other"}), HasSubstr("(7) CIM_ERR_NOT_SUPPORTED"));
  }
  EXPECT_EQ(contentOf(state_), before);
}

TEST_F(CompositeChangeTest, BySeveralClientsAtOnceLosesNone) {
  std::vector<std::future<void>> clients;
  for (const char* change : {"eth0 IPv4Address=192.0.2.77", "eth0 SubnetMask=255.255.0.0",
                             "eth1 IPv4Address=198.51.100.99", "eth1 SubnetMask=255.255.0.0"}) {
    const std::string interface = std::string(change).substr(0, 4);
    clients.push_back(std::async(std::launch::async, [this, interface, values = std::string(change).substr(5)] {
      stack_.modify(staticSetting(interface), values);
    }));
  }
  for (int i = 0; i < 4; ++i) {
    clients.push_back(std::async(
        std::launch::async, [this] { EXPECT_THAT(stack_.names("ein", Classes::clientAccess), testing::SizeIs(6)); }));
  }
  for (auto& client : clients) {
    client.get();
  }
  expectAddress("eth0", "192.0.2.77", "255.255.0.0");
  expectAddress("eth1", "198.51.100.99", "255.255.0.0");
}

TEST_F(CompositeChangeTest, ByTwoObjectManagersOnOneProcessorLosesNone) {
  const CompositeStack other(simulatedProcessor(state_));
  const auto change = [](const CompositeStack& stack, const std::string& interface, const std::string& prefix) {
    for (int i = 1; i <= 8; ++i) {
      stack.modify(staticSetting(interface), "IPv4Address=" + prefix + std::to_string(i));
    }
  };
  auto first = std::async(std::launch::async, [&] { change(stack_, "eth0", "192.0.2.10"); });
  auto second = std::async(std::launch::async, [&] { change(other, "eth1", "198.51.100.10"); });
  first.get();
  second.get();
  expectAddress("eth0", "192.0.2.108", "255.255.255.0");
  expectAddress("eth1", "198.51.100.108", "255.255.255.0");
  EXPECT_EQ(other.get(endpoint("eth0")), stack_.get(endpoint("eth0")));
}

TEST_F(CompositeChangeTest, OutlivesTheObjectManager) {
  stack_.modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  const CompositeStack later(simulatedProcessor(state_));
  EXPECT_EQ(later.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.77"));
}

TEST_F(CompositeChangeTest, OfADamagedStateIsRefusedAndTheFileKeptUntilItIsRepaired) {
  const std::string sound = factoryState();
  for (const std::string& damaged : {std::string("{\"name\""), std::string(), sound.substr(0, sound.size() / 2),
                                     std::string("\0\xFF\xFE", 3), std::string("[]")}) {
    directory_.write("processor.json", damaged);
    for (const char* className :
         {Classes::computerSystem, Classes::endpoint, Classes::staticSetting, Classes::remoteAccessPoint}) {
      EXPECT_THAT(stack_.failure("ei", className), AllOf(HasSubstr("(1) CIM_ERR_FAILED"), HasSubstr(state_.string())));
    }
    EXPECT_THAT(stack_.failure("gi", endpoint("eth0")), HasSubstr(state_.string()));
    EXPECT_THAT(stack_.failure("mi", endpoint("eth0"), {"IPv4Address=192.0.2.77"}), HasSubstr(state_.string()));
    EXPECT_EQ(contentOf(state_), damaged);
  }
  directory_.write("processor.json", sound);
  expectAddress("eth0", "192.0.2.10", "255.255.255.0");
  stack_.modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  expectAddress("eth0", "192.0.2.77", "255.255.255.0");
}

}  // namespace
