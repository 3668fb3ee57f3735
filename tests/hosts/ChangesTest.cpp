// SPDX-License-Identifier: Apache-2.0
// Changes of address and mask, followed down to what the management processor itself holds.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/hosts/HostTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;

using testing::HasSubstr;

class HostChangesTest : public HostTest {
 protected:
  // As the client and the state file tell it, at once.
  static void expectAddress(const std::string& interface, const std::string& address, const std::string& mask) {
    const auto shown = host().get(endpoint(interface));
    EXPECT_EQ(shown.at("IPv4Address"), quoted(address));
    EXPECT_EQ(shown.at("SubnetMask"), quoted(mask));
    EXPECT_THAT(readFile(ObjectManager::stateFile()),
                HasSubstr("\"address\": \"" + address + "\",\n        \"subnetMask\": \"" + mask));
  }
};

TEST_F(HostChangesTest, OfAnEndpointAreSeenAtOnce) {
  host().modify(endpoint("eth0"), "IPv4Address=203.0.113.77,SubnetMask=255.255.255.128");
  expectAddress("eth0", "203.0.113.77", "255.255.255.128");
  expectAddress("eth1", "198.51.100.23", "255.255.255.0");
}

TEST_F(HostChangesTest, OfStaticSettingsAreSeenAtOnce) {
  host().modify(staticSetting("eth0"), "IPv4Address=203.0.113.78,SubnetMask=255.255.255.192");
  expectAddress("eth0", "203.0.113.78", "255.255.255.192");
}

TEST_F(HostChangesTest, OfOneValueLeaveTheOther) {
  host().modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  expectAddress("eth0", "192.0.2.77", "255.255.255.0");
  host().modify(endpoint("eth0"), "SubnetMask=255.255.0.0");
  expectAddress("eth0", "192.0.2.77", "255.255.0.0");
  host().modify(staticSetting("eth1"), "IPv4Address=198.51.100.99");
  expectAddress("eth1", "198.51.100.99", "255.255.255.0");
  host().modify(staticSetting("eth1"), "SubnetMask=255.255.0.0");
  expectAddress("eth1", "198.51.100.99", "255.255.0.0");
}

TEST_F(HostChangesTest, OneAfterTheOtherAreEachSeenAtOnce) {
  for (int i = 1; i <= 20; ++i) {
    const std::string address = "192.0.2." + std::to_string(100 + i);
    host().modify(i % 2 == 0 ? endpoint("eth0") : staticSetting("eth0"), "IPv4Address=" + address);
    EXPECT_EQ(host().get(endpoint("eth0")).at("IPv4Address"), quoted(address));
  }
}

TEST_F(HostChangesTest, OfALeasedAddressMakeItStatic) {
  EXPECT_EQ(host().get(endpoint("eth1")).at("AddressOrigin"), "4");
  host().modify(endpoint("eth1"), "IPv4Address=198.51.100.99");
  EXPECT_EQ(host().get(endpoint("eth1")).at("AddressOrigin"), "3");
}

TEST_F(HostChangesTest, ThatAreRefusedLeaveEverythingAndSayWhyInTheLog) {
  host().names("ein", "YRNx_MgmtHwComputerSystem");
  const std::string before = readFile(ObjectManager::stateFile());
  for (const char* change :
       {"IPv4Address=192.0.2", "IPv4Address=127.0.0.1", "IPv4Address=0.0.0.0", "IPv4Address=224.0.0.1",
        "SubnetMask=255.0.255.0", "SubnetMask=0.0.0.0", "SubnetMask=24", "IPv4Address=192.0.2.77,SubnetMask=text"}) {
    SCOPED_TRACE(change);
    host().modify(endpoint("eth0"), change);
    EXPECT_EQ(readFile(ObjectManager::stateFile()), before);
    EXPECT_THAT(host().log(), HasSubstr('\'' + std::string(change).substr(std::string(change).rfind('=') + 1) + '\''));
    expectAddress("eth0", "192.0.2.10", "255.255.255.0");
  }
}

TEST_F(HostChangesTest, OfARemoteAccessPointHaveNoEffect) {
  host().names("ein", "YRNx_MgmtHwComputerSystem");
  const std::string before = readFile(ObjectManager::stateFile());
  host().modify(remoteAccessPoint("DNS:1"), "AccessInfo=203.0.113.53");
  EXPECT_EQ(host().get(remoteAccessPoint("DNS:1")).at("AccessInfo"), quoted("192.0.2.53"));
  EXPECT_EQ(readFile(ObjectManager::stateFile()), before);
}

TEST_F(HostChangesTest, OfOtherClassesAreNotSupported) {
  for (const std::string& object : {computerSystem(), sequence("eth0:static"), dhcpSetting("eth0")}) {
    EXPECT_THAT(host().failure("mi", object, {"ElementName=other"}), HasSubstr("(7) CIM_ERR_NOT_SUPPORTED"));
  }
}

TEST_F(HostChangesTest, OutliveTheObjectManager) {
  host().modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  host().restart();
  expectAddress("eth0", "192.0.2.77", "255.255.255.0");
}

}  // namespace
