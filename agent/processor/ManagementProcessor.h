// SPDX-License-Identifier: Apache-2.0
// What a management processor's IP configuration is to the agent: plain values, whatever hardware they come from.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "agent/processor/Addresses.h"

namespace QV {

// Where an address comes from. The numbers are those of CIM_IPProtocolEndpoint.AddressOrigin (DMTF).
enum class AddressOrigin : std::uint16_t { Unknown = 0, Static = 3, Dhcp = 4 };

// One IP interface. Absent values are those that the processor does not have or does not report.
struct NetworkInterface {
  std::optional<std::string> name;  // the node name; absent if it cannot be read
  std::optional<MacAddress> macAddress;
  bool enabled = true;

  std::optional<Ipv4Address> ipv4Address;
  std::optional<SubnetMask> ipv4SubnetMask;
  std::optional<Ipv4Address> ipv4Gateway;
  AddressOrigin ipv4Origin = AddressOrigin::Unknown;

  std::optional<Ipv6Address> ipv6Address;
  std::optional<std::uint8_t> ipv6PrefixLength;
  AddressOrigin ipv6Origin = AddressOrigin::Unknown;

  bool operator==(const NetworkInterface&) const = default;
};

struct ManagementProcessor {
  std::string name;
  std::string description;
  std::vector<std::string> dnsServers;  // IPv4 or IPv6 text, in order of preference
  std::vector<NetworkInterface> interfaces;

  bool operator==(const ManagementProcessor&) const = default;
};

// One change of an interface: applied as a whole or not at all. An absent value stays as it is.
struct AddressChange {
  std::optional<Ipv4Address> ipv4Address;
  std::optional<SubnetMask> ipv4SubnetMask;
};

}  // namespace QV
