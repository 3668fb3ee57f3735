// What a management processor's IP configuration is to the agent: plain values, whatever hardware they come from.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace QV {

// Where an address comes from. The numbers are those of CIM_IPProtocolEndpoint.AddressOrigin (DMTF).
enum class AddressOrigin : std::uint16_t { Unknown = 0, Static = 3, Dhcp = 4 };

// One IP interface. Absent values are those that the processor does not have or does not tell.
struct NetworkInterface {
  std::optional<std::string> name;        // the node name; absent where it cannot be read
  std::optional<std::string> macAddress;  // "aa:bb:cc:dd:ee:ff"
  bool enabled = true;

  std::optional<std::string> ipv4Address;     // dotted decimal
  std::optional<std::string> ipv4SubnetMask;  // dotted decimal
  std::optional<std::string> ipv4Gateway;     // dotted decimal
  AddressOrigin ipv4Origin = AddressOrigin::Unknown;

  std::optional<std::string> ipv6Address;  // RFC 5952 text
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
  std::optional<std::string> ipv4Address;
  std::optional<std::string> ipv4SubnetMask;
};

}  // namespace QV
