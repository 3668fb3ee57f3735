// SPDX-License-Identifier: Apache-2.0
// The simulated management processor's state as text: JSON that an administrator may read and edit.
//
//   { "name": "...", "description": "...", "dnsServers": ["..."],
//     "interfaces": [ { "name": "...", "macAddress": "...", "enabled": true,
//                       "ipv4": { "origin": "static", "address": "...", "subnetMask": "...", "gateway": "..." },
//                       "ipv6": { "origin": "dhcp", "address": "...", "prefixLength": 64 } } ] }
//
// "name", "description", "dnsServers", "interfaces", each "enabled" and each "origin" ("static", "dhcp" or "unknown")
// are required; every other field may be left out if the processor does not have or does not report the value.
#pragma once

#include <string>

#include "agent/processor/ManagementProcessor.h"

namespace QV {

// Indented by two blanks, with a line feed at the end.
std::string writeState(const ManagementProcessor& processor);

// Throws std::runtime_error naming the field and what is wrong with it: no JSON, a field missing, of the wrong type, no
// address, given twice as an interface's name, or not known (it would be lost with the next change).
ManagementProcessor parseState(const std::string& text);

}  // namespace QV
