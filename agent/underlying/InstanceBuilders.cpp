// SPDX-License-Identifier: Apache-2.0
#include "agent/underlying/InstanceBuilders.h"

#include <iterator>
#include <optional>
#include <utility>

namespace QV {
namespace {

// Value maps of the DMTF classes.
constexpr std::uint16_t dedicatedManagementController = 28;
constexpr std::uint16_t dedicatedManagement = 14;
constexpr std::uint16_t enabledStateEnabled = 2;
constexpr std::uint16_t enabledStateDisabled = 3;
constexpr std::uint16_t requestedStateNotApplicable = 12;
constexpr std::uint16_t accessContextDefaultGateway = 2;
constexpr std::uint16_t accessContextDnsServer = 3;
constexpr std::uint16_t infoFormatIpv4 = 3;
constexpr std::uint16_t infoFormatIpv6 = 4;

// What an endpoint says about the versions of IP that it speaks, by the versions.
struct Versions {
  bool ipv4;
  bool ipv6;
  std::uint16_t addressType;
  std::uint16_t ipVersionSupport;
  std::uint16_t protocolIfType;
};

constexpr Versions versionTable[] = {
    {true, true, 1, 3, 4098},
    {true, false, 1, 1, 4096},
    {false, true, 2, 2, 4097},
    {false, false, 0, 0, 0},
};

const Versions& versionsOf(const NetworkInterface& interface) {
  const bool ipv4 = interface.ipv4Address || interface.ipv4Origin != AddressOrigin::Unknown;
  const bool ipv6 = interface.ipv6Address || interface.ipv6Origin != AddressOrigin::Unknown;
  for (const Versions& versions : versionTable) {
    if (versions.ipv4 == ipv4 && versions.ipv6 == ipv6) {
      return versions;
    }
  }
  return versionTable[std::size(versionTable) - 1];
}

PropertyValue orNull(const std::optional<std::uint8_t>& number) {
  return number ? PropertyValue(*number) : std::monostate{};
}

template <typename Address>
PropertyValue orNull(const std::optional<Address>& address) {
  return address ? PropertyValue(address->text()) : std::monostate{};
}

std::uint16_t number(AddressOrigin origin) { return static_cast<std::uint16_t>(origin); }

// Moves them in: from a list in braces a vector can only copy.
template <std::size_t count>
InstanceProperties instance(Property (&&properties)[count]) {
  return {std::make_move_iterator(std::begin(properties)), std::make_move_iterator(std::end(properties))};
}

// One instance for each interface that has a name.
template <typename Build>
Instances forEachInterface(const System& system, const Build& build) {
  Instances instances;
  for (const NetworkInterface& interface : system.configuration.interfaces) {
    if (interface.name) {
      instances.push_back(build(interface, *interface.name));
    }
  }
  return instances;
}

InstanceProperties endpoint(const System& system, const NetworkInterface& interface, const std::string& name) {
  const Versions& versions = versionsOf(interface);
  return instance({
      {"SystemCreationClassName", system.creationClassName},
      {"SystemName", system.configuration.name},
      {"CreationClassName", "YRNQV_IPProtocolEndpoint"},
      {"Name", name},
      {"NameFormat", "Interface name"},
      {"ElementName", system.settingPrefix + " IP endpoint " + name},
      {"IPv4Address", orNull(interface.ipv4Address)},
      {"IPv6Address", orNull(interface.ipv6Address)},
      {"SubnetMask", orNull(interface.ipv4SubnetMask)},
      {"PrefixLength", orNull(interface.ipv6PrefixLength)},
      {"AddressType", versions.addressType},
      {"IPVersionSupport", versions.ipVersionSupport},
      {"ProtocolIFType", versions.protocolIfType},
      {"EnabledState", interface.enabled ? enabledStateEnabled : enabledStateDisabled},
      {"RequestedState", requestedStateNotApplicable},
      {"AddressOrigin", number(versions.ipv4 ? interface.ipv4Origin : interface.ipv6Origin)},
  });
}

InstanceProperties setting(const std::string& instanceId, const std::string& elementName, AddressOrigin origin) {
  return instance({{"InstanceID", instanceId}, {"ElementName", elementName}, {"AddressOrigin", number(origin)}});
}

bool isIpv6(const std::string& address) { return address.find(':') != std::string::npos; }

InstanceProperties accessPoint(const System& system, const std::string& name, std::uint16_t context,
                               const std::string& address) {
  return instance({
      {"SystemCreationClassName", system.creationClassName},
      {"SystemName", system.configuration.name},
      {"CreationClassName", "YRNQV_IPRemoteServiceAccessPoint"},
      {"Name", name},
      {"AccessContext", context},
      {"AccessInfo", address},
      {"InfoFormat", isIpv6(address) ? infoFormatIpv6 : infoFormatIpv4},
  });
}

}  // namespace

Instances computerSystem(const System& system) {
  return {{
      {"CreationClassName", system.creationClassName},
      {"Name", system.configuration.name},
      {"Description", system.configuration.description},
      {"NameFormat", "Other"},
      {"Dedicated", std::vector{dedicatedManagement, dedicatedManagementController}},
  }};
}

Instances protocolEndpoints(const System& system) {
  return forEachInterface(system, [&](const NetworkInterface& interface, const std::string& name) {
    return endpoint(system, interface, name);
  });
}

Instances assignmentSettings(const System& system) {
  Instances instances;
  for (const NetworkInterface& interface : system.configuration.interfaces) {
    if (!interface.name) {
      continue;
    }
    const std::string id = system.settingPrefix + ':' + *interface.name;
    instances.push_back(setting(id + ":static", "Static addresses of " + *interface.name, AddressOrigin::Static));
    instances.push_back(setting(id + ":dhcp", "DHCP addresses of " + *interface.name, AddressOrigin::Dhcp));
  }
  return instances;
}

Instances staticSettings(const System& system) {
  return forEachInterface(system, [&](const NetworkInterface& interface, const std::string& name) {
    auto properties = setting(system.settingPrefix + ':' + name, "Static settings of " + name, AddressOrigin::Static);
    properties.push_back({"IPv4Address", orNull(interface.ipv4Address)});
    properties.push_back({"SubnetMask", orNull(interface.ipv4SubnetMask)});
    properties.push_back({"GatewayIPv4Address", orNull(interface.ipv4Gateway)});
    return properties;
  });
}

Instances dhcpSettings(const System& system) {
  return forEachInterface(system, [&](const NetworkInterface&, const std::string& name) {
    return setting(system.settingPrefix + ':' + name, "DHCP settings of " + name, AddressOrigin::Dhcp);
  });
}

Instances remoteAccessPoints(const System& system) {
  Instances instances;
  for (const NetworkInterface& interface : system.configuration.interfaces) {
    if (interface.name && interface.ipv4Gateway) {
      instances.push_back(accessPoint(system, "Gateway:" + *interface.name, accessContextDefaultGateway,
                                      interface.ipv4Gateway->text()));
    }
  }
  int position = 0;
  for (const std::string& server : system.configuration.dnsServers) {
    instances.push_back(accessPoint(system, "DNS:" + std::to_string(++position), accessContextDnsServer, server));
  }
  return instances;
}

}  // namespace QV
