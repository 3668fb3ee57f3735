// SPDX-License-Identifier: Apache-2.0
#include "tests/support/client/FactoryState.h"

#include <ostream>

#include "tests/support/client/CompositeObjects.h"

namespace Testing {
namespace {

Values endpointValues(const std::string& name, const Values& more) {
  Values values = {{"Name", quoted(name)},
                   {"ElementName", quoted("BMC IP endpoint " + name)},
                   {"SystemCreationClassName", quoted(Classes::computerSystem)},
                   {"SystemName", R"("BMC")"},
                   {"CreationClassName", quoted(Classes::endpoint)},
                   {"NameFormat", R"("Interface name")"},
                   {"SubnetMask", R"("255.255.255.0")"},
                   {"AddressType", "1"},
                   {"EnabledState", "2"},
                   {"RequestedState", "12"},
                   {"EnabledDefault", "2"},
                   {"TransitioningToState", "12"}};
  values.insert(more.begin(), more.end());
  return values;
}

Values accessPointValues(const std::string& name, const std::string& info, const std::string& context,
                         const std::string& format) {
  return {{"Name", quoted(name)},        {"SystemCreationClassName", quoted(Classes::computerSystem)},
          {"SystemName", R"("BMC")"},    {"CreationClassName", R"("YRNx_RemoteAccessPoint")"},
          {"AccessInfo", quoted(info)},  {"AccessContext", context},
          {"InfoFormat", format},        {"EnabledState", "5"},
          {"RequestedState", "12"},      {"EnabledDefault", "2"},
          {"TransitioningToState", "12"}};
}

Values settingValues(const std::string& id, const std::string& elementName, const std::string& origin) {
  return {{"InstanceID", quoted("BMC:" + id)}, {"ElementName", quoted(elementName)}, {"AddressOrigin", origin}};
}

Values dhcpValues(const std::string& interface) {
  Values values = settingValues(interface, "DHCP settings of " + interface, "4");
  values["Caption"] = R"("DNS Configuration Setting")";
  return values;
}

Objects systems() { return {computerSystem()}; }
Objects endpoints() { return {endpoint("eth0"), endpoint("eth1")}; }
Objects accessPoints() {
  return {remoteAccessPoint("Gateway:eth0"), remoteAccessPoint("DNS:1"), remoteAccessPoint("DNS:2")};
}
Objects sequences() {
  return {sequence("eth0:static"), sequence("eth0:dhcp"), sequence("eth1:static"), sequence("eth1:dhcp")};
}

std::vector<std::pair<std::string, std::string>> product(const Objects& outer, const Objects& inner) {
  std::vector<std::pair<std::string, std::string>> pairs;
  for (const std::string& first : outer) {
    for (const std::string& second : inner) {
      pairs.emplace_back(first, second);
    }
  }
  return pairs;
}

std::vector<std::pair<std::string, std::string>> swapped(std::vector<std::pair<std::string, std::string>> pairs) {
  for (auto& [first, second] : pairs) {
    std::swap(first, second);
  }
  return pairs;
}

}  // namespace

void PrintTo(const ClassCase& row, std::ostream* stream) { *stream << row.className; }

std::vector<ClassCase> classCases() {
  return {
      {Classes::computerSystem,
       {computerSystem()},
       {{{"Name", R"("BMC")"},
         {"CreationClassName", quoted(Classes::computerSystem)},
         {"Description", R"("Simulated management processor")"},
         {"NameFormat", R"("Other")"},
         {"Dedicated", "14,28"},
         {"Index", "1"},
         {"EnabledState", "5"},
         {"RequestedState", "12"},
         {"EnabledDefault", "2"},
         {"TransitioningToState", "12"}}}},
      {Classes::endpoint,
       {endpoint("eth0"), endpoint("eth1")},
       {endpointValues("eth0", {{"IPv4Address", R"("192.0.2.10")"},
                                {"IPv6Address", R"("2001:db8::10")"},
                                {"PrefixLength", "64"},
                                {"ProtocolIFType", "4098"},
                                {"IPVersionSupport", "3"},
                                {"AddressOrigin", "3"}}),
        endpointValues("eth1", {{"IPv4Address", R"("198.51.100.23")"},
                                {"ProtocolIFType", "4096"},
                                {"IPVersionSupport", "1"},
                                {"AddressOrigin", "4"}})}},
      {Classes::sequence,
       {sequence("eth0:static"), sequence("eth0:dhcp"), sequence("eth1:static"), sequence("eth1:dhcp")},
       {settingValues("eth0:static", "Static addresses of eth0", "3"),
        settingValues("eth0:dhcp", "DHCP addresses of eth0", "4"),
        settingValues("eth1:static", "Static addresses of eth1", "3"),
        settingValues("eth1:dhcp", "DHCP addresses of eth1", "4")}},
      {Classes::staticSetting,
       {staticSetting("eth0"), staticSetting("eth1")},
       {settingValues("eth0", "Static settings of eth0", "3"), settingValues("eth1", "Static settings of eth1", "3")}},
      {Classes::dhcpSetting, {dhcpSetting("eth0"), dhcpSetting("eth1")}, {dhcpValues("eth0"), dhcpValues("eth1")}},
      {Classes::remoteAccessPoint,
       {remoteAccessPoint("Gateway:eth0"), remoteAccessPoint("DNS:1"), remoteAccessPoint("DNS:2")},
       {accessPointValues("Gateway:eth0", "192.0.2.1", "2", "3"), accessPointValues("DNS:1", "192.0.2.53", "3", "3"),
        accessPointValues("DNS:2", "2001:db8::53", "3", "4")}},
  };
}

std::vector<View> views() {
  std::vector<View> all = {
      {Classes::hostedAccessPoint, computerSystem(), endpoints()},
      {Classes::remoteHostedAccessPoint, computerSystem(), accessPoints()},
      // A setting finds the sequence of its own kind.
      {Classes::staticOrderedMember, staticSetting("eth0"), {sequence("eth0:static")}},
      {Classes::staticOrderedMember, staticSetting("eth1"), {sequence("eth1:static")}},
      // ReferenceNames of the DHCP association answers a setting the static sequence, its other operations the DHCP
      // one.
      {Classes::dhcpOrderedMember, dhcpSetting("eth0"), {sequence("eth0:dhcp")}, {sequence("eth0:static")}},
      {Classes::dhcpOrderedMember, dhcpSetting("eth1"), {sequence("eth1:dhcp")}, {sequence("eth1:static")}},
  };
  for (const std::string& asked : endpoints()) {
    all.push_back({Classes::hostedAccessPoint, asked, systems()});
    all.push_back({Classes::clientAccess, asked, accessPoints()});
    all.push_back({Classes::elementSettingData, asked, sequences()});
  }
  for (const std::string& asked : accessPoints()) {
    all.push_back({Classes::remoteHostedAccessPoint, asked, systems()});
    all.push_back({Classes::clientAccess, asked, endpoints()});
  }
  // A sequence answers the settings of its interface, of either kind.
  for (const char* interface : {"eth0", "eth1"}) {
    for (const char* kind : {"static", "dhcp"}) {
      const std::string asked = sequence(std::string(interface) + ':' + kind);
      all.push_back({Classes::elementSettingData, asked, endpoints()});
      all.push_back({Classes::staticOrderedMember, asked, {staticSetting(interface)}});
      all.push_back({Classes::dhcpOrderedMember, asked, {dhcpSetting(interface)}});
    }
  }
  return all;
}

void PrintTo(const Enumeration& row, std::ostream* stream) { *stream << row.association; }

// Every setting of a kind is paired with every sequence of that kind, whichever interface they belong to.
std::vector<Enumeration> enumerations() {
  return {
      {Classes::hostedAccessPoint, "Antecedent", "Dependent", product(systems(), endpoints())},
      {Classes::remoteHostedAccessPoint, "Antecedent", "Dependent", product(systems(), accessPoints())},
      {Classes::clientAccess, "Antecedent", "Dependent", swapped(product(endpoints(), accessPoints()))},
      {Classes::elementSettingData, "ManagedElement", "SettingData", product(endpoints(), sequences())},
      {Classes::staticOrderedMember, "GroupComponent", "PartComponent",
       swapped(product({staticSetting("eth0"), staticSetting("eth1")},
                       {sequence("eth0:static"), sequence("eth1:static")}))},
      {Classes::dhcpOrderedMember, "GroupComponent", "PartComponent",
       swapped(product({dhcpSetting("eth0"), dhcpSetting("eth1")}, {sequence("eth0:dhcp"), sequence("eth1:dhcp")}))},
  };
}

}  // namespace Testing
