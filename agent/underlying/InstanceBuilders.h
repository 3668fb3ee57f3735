// SPDX-License-Identifier: Apache-2.0
// What the instances of the underlying classes hold, made from a system's configuration: plain values, before any
// object manager is involved. Property names and value maps are those of the DMTF classes that the classes stand for.
#pragma once

#include <cstdint>
#include <string>
#include <variant>
#include <vector>

#include "agent/underlying/System.h"

namespace QV {

// std::monostate: the property has no value (null).
using PropertyValue =
    std::variant<std::monostate, std::string, std::uint16_t, std::uint8_t, std::vector<std::uint16_t>>;

struct Property {
  const char* name;
  PropertyValue value;
};

using InstanceProperties = std::vector<Property>;
using Instances = std::vector<InstanceProperties>;

// The system itself, as a management processor (CIM_ComputerSystem).
Instances computerSystem(const System& system);

// An endpoint for each interface (CIM_IPProtocolEndpoint); an interface without a readable name has none, here and in
// the settings, since the name is their key.
Instances protocolEndpoints(const System& system);

// For each interface its two ways to an address, "PREFIX:INTERFACE:static" and "PREFIX:INTERFACE:dhcp"
// (CIM_IPAssignmentSettingData).
Instances assignmentSettings(const System& system);

// For each interface its static settings, with the address and mask that it has now, and its DHCP settings, both
// "PREFIX:INTERFACE" (CIM_StaticIPAssignmentSettingData, CIM_DHCPSettingData).
Instances staticSettings(const System& system);
Instances dhcpSettings(const System& system);

// The default gateway of each interface and the name servers (CIM_RemoteServiceAccessPoint).
Instances remoteAccessPoints(const System& system);

}  // namespace QV
