// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/underlying/InstanceBuilders.h"
#include "tests/support/agent/Addresses.h"

namespace {

using namespace QV;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

// As "NAME=VALUE" lines, an array as "a,b"; a property without a value as "NAME".
std::string textOf(const Property& property) {
  struct {
    std::string operator()(std::monostate) const { return ""; }
    std::string operator()(const std::string& text) const { return "=" + text; }
    std::string operator()(std::uint16_t number) const { return "=" + std::to_string(number) + "u16"; }
    std::string operator()(std::uint8_t number) const { return "=" + std::to_string(number) + "u8"; }
    std::string operator()(const std::vector<std::uint16_t>& numbers) const {
      std::string text = "=";
      for (const std::uint16_t number : numbers) {
        text += (text.size() > 1 ? "," : "") + std::to_string(number) + "u16";
      }
      return text;
    }
  } text;
  return property.name + std::visit(text, property.value);
}

std::vector<std::string> textsOf(const InstanceProperties& properties) {
  std::vector<std::string> texts;
  for (const Property& property : properties) {
    texts.push_back(textOf(property));
  }
  return texts;
}

System processor(std::vector<NetworkInterface> interfaces, std::vector<std::string> dnsServers = {}) {
  return {"YRNQV_SPComputerSystem", "BMC", {"bmc7", "in rack 7", std::move(dnsServers), std::move(interfaces)}};
}

NetworkInterface eth0() { return factoryConfiguration().interfaces[0]; }
NetworkInterface eth1() { return factoryConfiguration().interfaces[1]; }

NetworkInterface nameless() {
  NetworkInterface interface = eth0();
  interface.name.reset();
  return interface;
}

// The one property of that name, of the one endpoint of the interface.
std::string endpointProperty(const NetworkInterface& interface, const std::string& name) {
  const Instances endpoints = protocolEndpoints(processor({interface}));
  for (const Property& property : endpoints.at(0)) {
    if (property.name == name) {
      return textOf(property);
    }
  }
  return "no " + name;
}

TEST(ComputerSystemTest, TellsTheProcessor) {
  const Instances instances = computerSystem(processor({}));
  ASSERT_THAT(instances, SizeIs(1));
  EXPECT_THAT(textsOf(instances[0]), ElementsAre("CreationClassName=YRNQV_SPComputerSystem", "Name=bmc7",
                                                 "Description=in rack 7", "NameFormat=Other", "Dedicated=14u16,28u16"));
}

TEST(ProtocolEndpointsTest, TellAnInterfaceEach) {
  const Instances instances = protocolEndpoints(processor({eth0(), eth1()}));
  ASSERT_THAT(instances, SizeIs(2));
  EXPECT_THAT(textsOf(instances[0]),
              ElementsAre("SystemCreationClassName=YRNQV_SPComputerSystem", "SystemName=bmc7",
                          "CreationClassName=YRNQV_IPProtocolEndpoint", "Name=eth0", "NameFormat=Interface name",
                          "ElementName=BMC IP endpoint eth0", "IPv4Address=192.0.2.10", "IPv6Address=2001:db8::10",
                          "SubnetMask=255.255.255.0", "PrefixLength=64u8", "AddressType=1u16", "IPVersionSupport=3u16",
                          "ProtocolIFType=4098u16", "EnabledState=2u16", "RequestedState=12u16", "AddressOrigin=3u16"));
  EXPECT_THAT(textsOf(instances[1]),
              ElementsAre("SystemCreationClassName=YRNQV_SPComputerSystem", "SystemName=bmc7",
                          "CreationClassName=YRNQV_IPProtocolEndpoint", "Name=eth1", "NameFormat=Interface name",
                          "ElementName=BMC IP endpoint eth1", "IPv4Address=198.51.100.23", "IPv6Address",
                          "SubnetMask=255.255.255.0", "PrefixLength", "AddressType=1u16", "IPVersionSupport=1u16",
                          "ProtocolIFType=4096u16", "EnabledState=2u16", "RequestedState=12u16", "AddressOrigin=4u16"));
}

TEST(ProtocolEndpointsTest, TellThatAnInterfaceIsDisabled) {
  NetworkInterface interface = eth0();
  interface.enabled = false;
  EXPECT_EQ(endpointProperty(interface, "EnabledState"), "EnabledState=3u16");
}

TEST(ProtocolEndpointsTest, TellAnInterfaceOfIpv6Alone) {
  NetworkInterface interface;
  interface.name = "eth2";
  interface.ipv6Address = ipv6("2001:db8::2");
  interface.ipv6Origin = AddressOrigin::Dhcp;
  EXPECT_EQ(endpointProperty(interface, "AddressType"), "AddressType=2u16");
  EXPECT_EQ(endpointProperty(interface, "IPVersionSupport"), "IPVersionSupport=2u16");
  EXPECT_EQ(endpointProperty(interface, "ProtocolIFType"), "ProtocolIFType=4097u16");
  EXPECT_EQ(endpointProperty(interface, "AddressOrigin"), "AddressOrigin=4u16");
}

TEST(ProtocolEndpointsTest, TellAnInterfaceThatWaitsForALease) {
  NetworkInterface interface;
  interface.name = "eth2";
  interface.ipv4Origin = AddressOrigin::Dhcp;
  EXPECT_EQ(endpointProperty(interface, "IPv4Address"), "IPv4Address");
  EXPECT_EQ(endpointProperty(interface, "ProtocolIFType"), "ProtocolIFType=4096u16");
  EXPECT_EQ(endpointProperty(interface, "AddressOrigin"), "AddressOrigin=4u16");
}

TEST(ProtocolEndpointsTest, TellAnInterfaceOfWhichNothingIsKnown) {
  NetworkInterface interface;
  interface.name = "eth2";
  EXPECT_EQ(endpointProperty(interface, "ProtocolIFType"), "ProtocolIFType=0u16");
  EXPECT_EQ(endpointProperty(interface, "AddressOrigin"), "AddressOrigin=0u16");
}

TEST(AssignmentSettingsTest, AreAStaticAndADhcpOneForEachInterface) {
  const Instances instances = assignmentSettings(processor({eth0(), eth1()}));
  ASSERT_THAT(instances, SizeIs(4));
  EXPECT_THAT(textsOf(instances[0]),
              ElementsAre("InstanceID=BMC:eth0:static", "ElementName=Static addresses of eth0", "AddressOrigin=3u16"));
  EXPECT_THAT(textsOf(instances[1]),
              ElementsAre("InstanceID=BMC:eth0:dhcp", "ElementName=DHCP addresses of eth0", "AddressOrigin=4u16"));
  EXPECT_EQ(textOf(instances[2][0]), "InstanceID=BMC:eth1:static");
  EXPECT_EQ(textOf(instances[3][0]), "InstanceID=BMC:eth1:dhcp");
}

TEST(StaticSettingsTest, TellTheAddressesThatTheInterfaceHas) {
  const Instances instances = staticSettings(processor({eth0(), eth1()}));
  ASSERT_THAT(instances, SizeIs(2));
  EXPECT_THAT(textsOf(instances[0]),
              ElementsAre("InstanceID=BMC:eth0", "ElementName=Static settings of eth0", "AddressOrigin=3u16",
                          "IPv4Address=192.0.2.10", "SubnetMask=255.255.255.0", "GatewayIPv4Address=192.0.2.1"));
  EXPECT_EQ(textOf(instances[1].back()), "GatewayIPv4Address");
}

TEST(DhcpSettingsTest, AreOneForEachInterface) {
  const Instances instances = dhcpSettings(processor({eth0(), eth1()}));
  ASSERT_THAT(instances, SizeIs(2));
  EXPECT_THAT(textsOf(instances[1]),
              ElementsAre("InstanceID=BMC:eth1", "ElementName=DHCP settings of eth1", "AddressOrigin=4u16"));
}

TEST(RemoteAccessPointsTest, AreTheGatewaysAndTheNameServers) {
  const Instances instances = remoteAccessPoints(processor({eth0(), eth1()}, {"192.0.2.53", "2001:db8::53"}));
  ASSERT_THAT(instances, SizeIs(3));
  EXPECT_THAT(textsOf(instances[0]),
              ElementsAre("SystemCreationClassName=YRNQV_SPComputerSystem", "SystemName=bmc7",
                          "CreationClassName=YRNQV_IPRemoteServiceAccessPoint", "Name=Gateway:eth0",
                          "AccessContext=2u16", "AccessInfo=192.0.2.1", "InfoFormat=3u16"));
  EXPECT_THAT(textsOf(instances[1]),
              testing::IsSupersetOf({"Name=DNS:1", "AccessContext=3u16", "AccessInfo=192.0.2.53", "InfoFormat=3u16"}));
  EXPECT_THAT(textsOf(instances[2]), testing::IsSupersetOf({"Name=DNS:2", "AccessContext=3u16",
                                                            "AccessInfo=2001:db8::53", "InfoFormat=4u16"}));
}

TEST(InterfacesTest, WithoutANameAreInNoClass) {
  const System system = processor({nameless()});
  for (const auto build : {protocolEndpoints, assignmentSettings, staticSettings, dhcpSettings, remoteAccessPoints}) {
    EXPECT_THAT(build(system), IsEmpty());
  }
}

TEST(AnotherSystemTest, IsToldApartByItsClassAndItsSettingsPrefix) {
  const System host{"YRNQV_ComputerSystem", "Host", {"node", "", {}, {eth0()}}};
  EXPECT_EQ(textOf(protocolEndpoints(host).at(0).at(0)), "SystemCreationClassName=YRNQV_ComputerSystem");
  EXPECT_EQ(textOf(remoteAccessPoints(host).at(0).at(0)), "SystemCreationClassName=YRNQV_ComputerSystem");
  EXPECT_EQ(textOf(assignmentSettings(host).at(0).at(0)), "InstanceID=Host:eth0:static");
  EXPECT_EQ(textOf(staticSettings(host).at(0).at(0)), "InstanceID=Host:eth0");
}

}  // namespace
