// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/InterfaceReader.h"

#include <charconv>

#include "agent/backends/ipmi/lan/LanParameters.h"

namespace QV::Ipmi {
namespace {

constexpr std::string_view namePrefix = "lan";

template <typename Address>
std::optional<Address> addressIn(const std::optional<ParameterData>& data) {
  const auto address = toAddress<Address>(data);
  return address && address->isZero() ? std::nullopt : address;
}

AddressOrigin origin(const std::optional<ParameterData>& data) {
  if (!data || data->empty()) {
    return AddressOrigin::Unknown;
  }
  switch (static_cast<AddressSource>(data->front() & 0x0F)) {
    case AddressSource::Static:
      return AddressOrigin::Static;
    case AddressSource::Dhcp:
      return AddressOrigin::Dhcp;
    default:
      return AddressOrigin::Unknown;
  }
}

// Parameters 56 and 59 share their form: set selector, source (bit 7 of a static one: enabled), address, prefix length,
// status.
void readIpv6(const ParameterData& data, Ipv6Choice choice, NetworkInterface& interface) {
  constexpr std::size_t sourceAt = 1, addressAt = 2, prefixAt = 18;
  constexpr std::uint8_t enabled = 0x80, fromDhcp = 2;
  if (data.size() <= prefixAt) {
    return;
  }
  const std::uint8_t source = data[sourceAt];
  if (choice == Ipv6Choice::Static && (source & enabled) == 0) {
    return;
  }
  const auto address = toAddress<Ipv6Address>(data, addressAt);
  if (!address || address->isZero()) {
    return;
  }
  interface.ipv6Address = address;
  interface.ipv6PrefixLength = data[prefixAt];
  if (choice == Ipv6Choice::Static) {
    interface.ipv6Origin = AddressOrigin::Static;
  } else if ((source & 0x0F) == fromDhcp) {
    interface.ipv6Origin = AddressOrigin::Dhcp;
  }
}

}  // namespace

NetworkInterface readInterface(IpmiTransport& transport, std::uint8_t channel, Ipv6Choice& ipv6) {
  const auto get = [&](LanParameter parameter) { return getParameter(transport, channel, parameter); };
  const auto source = get(LanParameter::AddressSource);
  const auto ipv4 = get(LanParameter::IpAddress);
  const auto mask = get(LanParameter::SubnetMask);
  if (!source && !ipv4 && !mask) {
    throw noLanChannel(channel);
  }

  NetworkInterface interface;
  interface.name = interfaceName(channel);
  interface.ipv4Address = addressIn<Ipv4Address>(ipv4);
  interface.ipv4SubnetMask = addressIn<SubnetMask>(mask);
  interface.ipv4Gateway = addressIn<Ipv4Address>(get(LanParameter::DefaultGateway));
  interface.ipv4Origin = origin(source);
  if (ipv6 != Ipv6Choice::Off) {
    const bool fixed = ipv6 == Ipv6Choice::Static;
    if (const auto data = get(fixed ? LanParameter::Ipv6StaticAddress : LanParameter::Ipv6DynamicAddress)) {
      readIpv6(*data, ipv6, interface);
    } else {
      ipv6 = Ipv6Choice::Off;
    }
  }
  return interface;
}

std::optional<Ipv4Address> readAddress(IpmiTransport& transport, std::uint8_t channel) {
  return addressIn<Ipv4Address>(getParameter(transport, channel, LanParameter::IpAddress));
}

std::string interfaceName(std::uint8_t channel) { return std::string(namePrefix) + std::to_string(channel); }

std::optional<std::uint8_t> channelOf(const std::string& name) {
  std::uint8_t channel = 0;
  if (!name.starts_with(namePrefix)) {
    return std::nullopt;
  }
  const auto [rest, error] = std::from_chars(name.data() + namePrefix.size(), name.data() + name.size(), channel);
  if (error != std::errc() || interfaceName(channel) != name) {
    return std::nullopt;
  }
  return channel;
}

}  // namespace QV::Ipmi
