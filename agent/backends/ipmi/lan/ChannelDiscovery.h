// SPDX-License-Identifier: Apache-2.0
// Which LAN channels the processor has.
#pragma once

#include <cstdint>
#include <vector>

#include "agent/backends/ipmi/session/IpmiTransport.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"

namespace QV::Ipmi {

// The channels of the choice, ascending. Listed ones cost nothing and are not checked here. The one in use costs one
// round trip over LAN (Get Channel Info of the present channel, IPMI 2.0, 22.24); in-band, where the present channel is
// no LAN, one more for each channel up to the first LAN channel. All of them cost eleven. Throws IpmiError where there
// is none.
std::vector<std::uint8_t> discoverChannels(IpmiTransport& transport, const ChannelChoice& choice);

}  // namespace QV::Ipmi
