// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/ChannelDiscovery.h"

#include <optional>

#include "agent/backends/ipmi/lan/LanParameters.h"

namespace QV::Ipmi {
namespace {

constexpr std::uint8_t getChannelInfo = 0x42;
constexpr std::uint8_t presentChannel = 0x0E;
constexpr std::uint8_t firstChannel = 1;
constexpr std::uint8_t lastChannel = 11;

// Channel media (IPMI 2.0, table 6-3).
constexpr std::uint8_t medium802Dot3 = 4;
constexpr std::uint8_t mediumOtherLan = 6;

// The channel's own number where it is a LAN channel.
std::optional<std::uint8_t> lanChannel(IpmiTransport& transport, std::uint8_t channel) {
  const IpmiResponse response =
      transport.send({NetworkFunction::Application, getChannelInfo, {channel}}, Repetition::Allowed);
  if (response.completionCode != CompletionCode::done || response.data.size() < 2) {
    return std::nullopt;
  }
  const std::uint8_t medium = response.data[1] & 0x7F;
  if (medium != medium802Dot3 && medium != mediumOtherLan) {
    return std::nullopt;
  }
  return static_cast<std::uint8_t>(response.data[0] & 0x0F);
}

std::vector<std::uint8_t> scan(IpmiTransport& transport, bool firstOnly) {
  std::vector<std::uint8_t> found;
  for (std::uint8_t channel = firstChannel; channel <= lastChannel; ++channel) {
    if (lanChannel(transport, channel)) {
      found.push_back(channel);
    }
    if (firstOnly && !found.empty()) {
      break;
    }
  }
  if (found.empty()) {
    throw IpmiError("the BMC shows no LAN channel: name them in channels");
  }
  return found;
}

}  // namespace

std::vector<std::uint8_t> discoverChannels(IpmiTransport& transport, const ChannelChoice& choice) {
  switch (choice.mode) {
    case ChannelChoice::Mode::Listed:
      return choice.listed;
    case ChannelChoice::Mode::All:
      return scan(transport, false);
    case ChannelChoice::Mode::InUse:
      break;
  }
  // In-band the present channel is the system interface, which is no LAN.
  if (const auto inUse = lanChannel(transport, presentChannel)) {
    return {*inUse};
  }
  return scan(transport, true);
}

}  // namespace QV::Ipmi
