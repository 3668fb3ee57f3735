// SPDX-License-Identifier: Apache-2.0
// The LAN configuration parameters of a channel (IPMI 2.0, 23.1 and 23.2, table 23-4), as raw requests.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "agent/backends/ipmi/session/IpmiTransport.h"
#include "agent/processor/Addresses.h"

namespace QV::Ipmi {

// Completion codes (IPMI 2.0, table 5-2; those from 0x80 are the LAN configuration commands' own, table 23-3).
namespace CompletionCode {

constexpr std::uint8_t done = 0x00;
constexpr std::uint8_t parameterNotSupported = 0x80;
constexpr std::uint8_t setInProgress = 0x81;
constexpr std::uint8_t readOnly = 0x82;
constexpr std::uint8_t parameterOutOfRange = 0xC9;
constexpr std::uint8_t notFound = 0xCB;
constexpr std::uint8_t invalidData = 0xCC;

// "invalid value (0xCC)"; a code without a meaning here as "completion code 0x..".
std::string describe(std::uint8_t code);

}  // namespace CompletionCode

enum class LanParameter : std::uint8_t {
  SetInProgress = 0,
  IpAddress = 3,        // 4 bytes, network order
  AddressSource = 4,    // low nibble, see AddressSource
  SubnetMask = 6,       // 4 bytes, network order
  DefaultGateway = 12,  // 4 bytes, network order
  Ipv6StaticAddress = 56,
  Ipv6DynamicAddress = 59
};

// Parameter 0.
enum class SetProgress : std::uint8_t { Complete = 0, InProgress = 1, CommitWrite = 2 };

// Parameter 4.
enum class AddressSource : std::uint8_t { Unspecified = 0, Static = 1, Dhcp = 2, Bios = 3, Other = 4 };

using ParameterData = std::vector<std::uint8_t>;

// The data of a parameter, without the revision byte before it; nothing if the processor does not support the
// parameter. Throws IpmiError that names channel and parameter if the processor refuses the request otherwise.
std::optional<ParameterData> getParameter(IpmiTransport& transport, std::uint8_t channel, LanParameter parameter);

// Writes a parameter; the answer's completion code is the caller's to judge.
IpmiResponse setParameter(IpmiTransport& transport, std::uint8_t channel, LanParameter parameter,
                          const ParameterData& data, Repetition repetition);

// The octets of a parameter's data as an address, nothing if there are fewer; and the address as a parameter's data.
template <typename Address>
std::optional<Address> toAddress(const std::optional<ParameterData>& data, std::size_t first = 0) {
  typename Address::Octets octets{};
  if (!data || data->size() < first + octets.size()) {
    return std::nullopt;
  }
  std::copy_n(data->begin() + static_cast<std::ptrdiff_t>(first), octets.size(), octets.begin());
  return Address(octets);
}

inline ParameterData toData(const DottedDecimal& address) { return {address.octets().begin(), address.octets().end()}; }

// That the channel reports none of its addresses.
IpmiError noLanChannel(std::uint8_t channel);

// "IP address", "subnet mask"
std::string describe(LanParameter parameter);

}  // namespace QV::Ipmi
