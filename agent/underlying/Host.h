// SPDX-License-Identifier: Apache-2.0
// The IP configuration of the host that we run on, described as that of the management processor is.
#pragma once

#include <istream>
#include <map>
#include <string>
#include <vector>

#include "agent/processor/ManagementProcessor.h"

namespace QV {

// The host as the kernel and the resolver's configuration show it now. What cannot be read is left out.
ManagementProcessor readHost();

// The name servers of a resolv.conf(5), in order; where it lists none, the one on the host itself, as its page says.
std::vector<std::string> parseResolverConfiguration(std::istream& text);

// The default gateways of a /proc/net/route, by interface.
std::map<std::string, Ipv4Address> parseDefaultGateways(std::istream& text);

}  // namespace QV
