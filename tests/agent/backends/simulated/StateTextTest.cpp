// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/backends/simulated/StateText.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;
using nlohmann::json;
using Pointer = json::json_pointer;

json factoryJson() { return json::parse(writeState(factoryConfiguration())); }

std::string complaintAbout(const json& state) {
  return thrownBy([&] { parseState(state.dump()); });
}

// The complaint about the factory state with one field set to something else.
std::string complaintWith(const std::string& pointer, const json& value) {
  json state = factoryJson();
  state[Pointer(pointer)] = value;
  return complaintAbout(state);
}

std::string complaintWithout(const std::string& parent, const std::string& field) {
  json state = factoryJson();
  state[Pointer(parent)].erase(field);
  return complaintAbout(state);
}

TEST(StateTextTest, ReadsAsItWasWritten) {
  EXPECT_EQ(parseState(writeState(factoryConfiguration())), factoryConfiguration());
}

TEST(StateTextTest, ReadsAsItWasWrittenWhereValuesAreAbsent) {
  const ManagementProcessor bare{"", "", {}, {NetworkInterface{}}};
  EXPECT_EQ(parseState(writeState(bare)), bare);
  const ManagementProcessor none{"n", "d", {}, {}};
  EXPECT_EQ(parseState(writeState(none)), none);
}

TEST(StateTextTest, IsIndentedForItsReader) {
  EXPECT_THAT(writeState(factoryConfiguration()),
              testing::StartsWith("{\n  \"name\": \"BMC\",\n  \"description\": \"Simulated management processor\",\n"));
  EXPECT_THAT(writeState(factoryConfiguration()), testing::EndsWith("}\n"));
}

TEST(StateTextTest, ThatIsNoJsonIsRefused) {
  for (const char* text : {"", "{", "hello", "{\"name\": \"BMC\"", "{} {}", "\xff"}) {
    EXPECT_THAT(thrownBy([&] { parseState(text); }), testing::HasSubstr("parse error")) << text;
  }
}

TEST(StateTextTest, ThatIsNoObjectIsRefused) {
  EXPECT_EQ(complaintAbout(json::array()), "the state is not an object");
  EXPECT_EQ(complaintAbout(nullptr), "the state is not an object");
}

TEST(StateTextTest, WithoutARequiredFieldIsRefused) {
  EXPECT_EQ(complaintWithout("", "name"), "the field name is missing");
  EXPECT_EQ(complaintWithout("", "description"), "the field description is missing");
  EXPECT_EQ(complaintWithout("", "dnsServers"), "the field dnsServers is missing");
  EXPECT_EQ(complaintWithout("", "interfaces"), "the field interfaces is missing");
  EXPECT_EQ(complaintWithout("/interfaces/1", "enabled"), "the field interfaces[1].enabled is missing");
  EXPECT_EQ(complaintWithout("/interfaces/1", "ipv4"), "the field interfaces[1].ipv4 is missing");
  EXPECT_EQ(complaintWithout("/interfaces/1", "ipv6"), "the field interfaces[1].ipv6 is missing");
  EXPECT_EQ(complaintWithout("/interfaces/0/ipv4", "origin"), "the field interfaces[0].ipv4.origin is missing");
  EXPECT_EQ(complaintWithout("/interfaces/0/ipv6", "origin"), "the field interfaces[0].ipv6.origin is missing");
}

TEST(StateTextTest, WithAFieldOfTheWrongTypeIsRefused) {
  EXPECT_EQ(complaintWith("/name", 1), "the field name is not a text");
  EXPECT_EQ(complaintWith("/description", nullptr), "the field description is not a text");
  EXPECT_EQ(complaintWith("/dnsServers", "192.0.2.53"), "the field dnsServers is not an array");
  EXPECT_EQ(complaintWith("/dnsServers/1", 53), "the field dnsServers[1] is not an IP address");
  EXPECT_EQ(complaintWith("/interfaces", json::object()), "the field interfaces is not an array");
  EXPECT_EQ(complaintWith("/interfaces/0", "eth0"), "the field interfaces[0] is not an object");
  EXPECT_EQ(complaintWith("/interfaces/0/name", true), "the field interfaces[0].name is not a text");
  EXPECT_EQ(complaintWith("/interfaces/0/enabled", "yes"), "the field interfaces[0].enabled is neither true nor false");
  EXPECT_EQ(complaintWith("/interfaces/0/ipv4", json::array()), "the field interfaces[0].ipv4 is not an object");
  EXPECT_EQ(complaintWith("/interfaces/0/ipv4/address", 7), "the field interfaces[0].ipv4.address is not a text");
}

TEST(StateTextTest, WithAValueThatMeansNothingIsRefused) {
  EXPECT_EQ(complaintWith("/dnsServers/0", "dns.example"), "the field dnsServers[0] is not an IP address");
  EXPECT_EQ(complaintWith("/interfaces/0/name", ""), "the field interfaces[0].name is empty or holds a colon: ''");
  EXPECT_EQ(complaintWith("/interfaces/0/name", "a:b"),
            "the field interfaces[0].name is empty or holds a colon: 'a:b'");
  EXPECT_EQ(complaintWith("/interfaces/1/name", "eth0"),
            "the field interfaces[1].name is the name of another interface: 'eth0'");
  EXPECT_EQ(complaintWith("/interfaces/0/ipv4/origin", "guess"),
            "the field interfaces[0].ipv4.origin is not static, dhcp or unknown: 'guess'");
  EXPECT_EQ(complaintWith("/interfaces/0/ipv4/subnetMask", "/24"),
            "the field interfaces[0].ipv4.subnetMask is not a dotted IPv4 address: '/24'");
  EXPECT_EQ(complaintWith("/interfaces/0/ipv6/address", "192.0.2.1"),
            "the field interfaces[0].ipv6.address is not an IPv6 address: '192.0.2.1'");
  for (const json& length : {json(129), json(-1), json(64.5), json("64")}) {
    EXPECT_EQ(complaintWith("/interfaces/0/ipv6/prefixLength", length),
              "the field interfaces[0].ipv6.prefixLength is not a whole number from 0 to 128");
  }
}

TEST(StateTextTest, WithAFieldThatAChangeWouldLoseIsRefused) {
  EXPECT_EQ(complaintWith("/note", "mine"), "the field note is not known");
  EXPECT_EQ(complaintWith("/interfaces/1/vlan", 7), "the field interfaces[1].vlan is not known");
  EXPECT_EQ(complaintWith("/interfaces/1/ipv4/ttl", 7), "the field interfaces[1].ipv4.ttl is not known");
}

}  // namespace
