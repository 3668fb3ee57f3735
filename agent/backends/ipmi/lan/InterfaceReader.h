// SPDX-License-Identifier: Apache-2.0
// One LAN channel of the processor as an interface of the agent's model.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "agent/backends/ipmi/session/IpmiTransport.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"
#include "agent/processor/ManagementProcessor.h"

namespace QV::Ipmi {

// Reads a channel in at most five round trips: source, address, mask, gateway and one IPv6 address; the MAC address,
// which no class shows, would be one more. What the processor does not support, and an address of zeros, is absent.
// `ipv6` becomes Off where the processor does not support what it says, so that it is not asked for that again. Throws
// IpmiError if the exchange fails or the channel reports nothing at all, which means that it is no LAN channel.
NetworkInterface readInterface(IpmiTransport& transport, std::uint8_t channel, Ipv6Choice& ipv6);

// The channel's address alone, absent where it is zero: one round trip.
std::optional<Ipv4Address> readAddress(IpmiTransport& transport, std::uint8_t channel);

// The node name of a channel, "lan1", and the channel of a node name; nothing if the name is none.
std::string interfaceName(std::uint8_t channel);
std::optional<std::uint8_t> channelOf(const std::string& interfaceName);

}  // namespace QV::Ipmi
