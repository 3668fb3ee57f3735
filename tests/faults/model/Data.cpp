// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/model/Data.h"

#include <stdexcept>

namespace Testing::Model {

namespace {

using QV::String;
using QV::Uint16;
using QV::Uint8;

constexpr const char* system = "YRNx_MgmtHwComputerSystem";
constexpr const char* endpoint = "YRNx_MgmtHwIPProtocolEndPoint";
constexpr const char* sequence = "YRNx_MgmtHwIPAssignmentSettingSequence";
constexpr const char* staticSetting = "YRNx_MgmtHwStaticIPAssignmentSettingData";
constexpr const char* dhcpSetting = "YRNx_MgmtHwDHCPAssignmentSettingData";
constexpr const char* accessPoint = "YRNx_MgmtHwRemoteServiceAccessPoint";

constexpr const char* hosted = "YRNx_MgmtHwIPHostedAccessPoint";
constexpr const char* remoteHosted = "YRNx_MgmtHwIPRemoteHostedAccessPoint";
constexpr const char* clientAccess = "YRNx_MgmtHwClientAccess";
constexpr const char* elementSetting = "YRNx_MgmtHwIPElementSettingData";
constexpr const char* staticOrdered = "YRNx_MgmtHwStaticIPOrderedMemberOfCollection";
constexpr const char* dhcpOrdered = "YRNx_MgmtHwDHCPOrderedMemberOfCollection";

const std::vector<const char*> identifierKey = {"InstanceID", nullptr};
const std::vector<const char*> fourKeys = {"SystemCreationClassName", "SystemName", "CreationClassName", "Name",
                                           nullptr};
const std::vector<Property> settingProperties = {
    {"InstanceID", String}, {"ElementName", String}, {"AddressOrigin", Uint16}};

const std::vector<Composite> composites = {
    {system,
     "getAllSPComputerCMPIInstances",
     "makeSPComputerInstance",
     "YRNQV_SPComputerSystem",
     Chosen::All,
     0,
     {"CreationClassName", "Name", nullptr},
     {{"CreationClassName", system}},
     {{"Name", String}, {"Description", String}, {"NameFormat", String}},
     std::nullopt},
    {endpoint,
     "getAllIPProtocolendptCMPIInstances",
     "makeIPProtocolEndptInstance",
     "YRNQV_IPProtocolEndpoint",
     Chosen::OfProcessor,
     0,
     fourKeys,
     {{"SystemCreationClassName", system}, {"CreationClassName", endpoint}},
     {{"Name", String},
      {"SystemName", String},
      {"NameFormat", String},
      {"ElementName", String},
      {"IPv4Address", String},
      {"IPv6Address", String},
      {"SubnetMask", String},
      {"PrefixLength", Uint8},
      {"AddressType", Uint16},
      {"IPVersionSupport", Uint16},
      {"ProtocolIFType", Uint16},
      {"EnabledState", Uint16},
      {"RequestedState", Uint16},
      {"AddressOrigin", Uint16}},
     std::nullopt},
    {sequence,
     "getAllIPAssignmentSettingCMPIInstances",
     "makeIPAssignmentSettingInstance",
     "YRNQV_IPAssignmentSettingData",
     Chosen::ByIdentifier,
     3,
     identifierKey,
     {},
     settingProperties,
     std::nullopt},
    {staticSetting,
     "getAllStaticIPAssignmentSettingCMPIInstances",
     "makeStaticIPAssignmentSettingInstance",
     "YRNQV_StaticIPAssignmentSettingData",
     Chosen::ByIdentifier,
     2,
     identifierKey,
     {},
     settingProperties,
     std::nullopt},
    {dhcpSetting,
     "getAllDHCPAssignmentSettingCMPIInstances",
     "makeDHCPAssignmentSettingInstance",
     "YRNQV_DHCPSettingData",
     Chosen::ByIdentifier,
     2,
     identifierKey,
     {},
     settingProperties,
     Constant{"Caption", "DNS Configuration Setting"}},
    {accessPoint,
     "getAllIPRemoteSAPCMPIInstances",
     "makeIPRemoteSAPInstance",
     "YRNQV_IPRemoteServiceAccessPoint",
     Chosen::OfProcessor,
     0,
     fourKeys,
     {{"SystemCreationClassName", system}, {"CreationClassName", accessPoint}},
     {{"Name", String},
      {"SystemName", String},
      {"OtherAccessContext", String},
      {"AccessInfo", String},
      {"AccessContext", Uint16},
      {"InfoFormat", Uint16}},
     Constant{"CreationClassName", "YRNx_RemoteAccessPoint"}},
};

std::string gap(std::size_t blanks) { return std::string(blanks, ' '); }

const Reaction goesOn = {};
const Reaction succeeds = {0, "", 0};
const Reaction fails = {1, "", 0};

Reaction failsWith(const std::string& message, int line = 0) { return {1, message, line}; }
Reaction succeedsWith(const std::string& message, int line) { return {0, message, line}; }

std::string cannotGet(const std::string& what, std::size_t blanks = 18) {
  return "***Can't get " + what + "ObjectPaths." + gap(blanks) + "Exiting EnumerateInstanceNames***";
}

std::string cannotCreate(const std::string& what, std::size_t blanks = 25) {
  return "Create CMPIObjectPath failed for" + gap(blanks) + what + ".";
}

const std::vector<Association> associations = {
    {.name = hosted,
     .propertyA = "Antecedent",
     .endA = system,
     .propertyB = "Dependent",
     .endB = endpoint,
     .builder = "IPProtocolHostAccessPointCMPIInstances",
     .first = "Antecedent",
     .second = "Dependent",
     .outer = system,
     .inner = endpoint,
     .firstHoldsOuter = true,
     .outerFails = succeeds,
     .outerUnusable = goesOn,
     .innerFails = failsWith(cannotGet("YRNx_HwIPProtocolEndpoint ")),
     .innerUnusable = failsWith("CMPIObjectPath is NULL for DNS Client"),
     .pathUnmade = failsWith(cannotCreate("ipHostedAccessPointClass")),
     .appendsUnmade = true},
    {.name = remoteHosted,
     .propertyA = "Antecedent",
     .endA = system,
     .propertyB = "Dependent",
     .endB = accessPoint,
     .builder = "IPRemoteHostAccessPointCMPIInstances",
     .first = "Antecedent",
     .second = "Dependent",
     .outer = system,
     .inner = accessPoint,
     .firstHoldsOuter = true,
     .outerFails = succeeds,
     .outerUnusable = goesOn,
     .innerFails = failsWith(cannotGet(" YRNx_HwIPRemoteServiceAccessPoint ")),
     .innerUnusable = failsWith("CMPIObjectPath is NULL for DNS Client"),
     .pathUnmade = failsWith(cannotCreate("CLASS_MGMT_HW_IP_REMOTE_HOSTED_ACCESS_POINT")),
     .appendsUnmade = true},
    {.name = clientAccess,
     .propertyA = "Antecedent",
     .endA = accessPoint,
     .propertyB = "Dependent",
     .endB = endpoint,
     .builder = "IPConfigClientAccessCMPIInstances",
     .first = "Antecedent",
     .second = "Dependent",
     .outer = endpoint,
     .inner = accessPoint,
     .keysOnPath = true,
     .outerFails = succeeds,
     .outerUnusable = goesOn,
     .innerFails = failsWith(cannotGet("CLASS_MGMT_HW_REMOTE_SERVICE_ACCESS_POINT ")),
     .innerUnusable = failsWith("CMPIObjectPath is NULL for RemoteSAP"),
     .pathUnmade = failsWith(cannotCreate("CLASS_MGMT_HW_IP_CLIENT_ACCESS")),
     .appendsUnmade = false},
    {.name = elementSetting,
     .propertyA = "Antecedent",
     .endA = sequence,
     .propertyB = "Dependent",
     .endB = endpoint,
     .builder = "IPConfigElementSettingDataCMPIInstances",
     .entryLine = 51,
     .exitLine = 188,
     .first = "ManagedElement",
     .second = "SettingData",
     .outer = endpoint,
     .inner = sequence,
     .firstHoldsOuter = true,
     .flags = true,
     .outerFails = succeeds,
     .outerUnusable = goesOn,
     .innerFails = failsWith(cannotGet("DNS Client "), 103),
     .innerUnusable = failsWith("CMPIObjectPath is NULL for DNS Client", 113),
     .pathUnmade = failsWith(cannotCreate("ipHostedAccessPointClass"), 131),
     .appendsUnmade = true},
    {.name = staticOrdered,
     .propertyA = "GroupComponent",
     .endA = sequence,
     .propertyB = "PartComponent",
     .endB = staticSetting,
     .builder = "IPConfigStaticOrderedCMPIInstances",
     .entryLine = 51,
     .exitLine = 161,
     .first = "GroupComponent",
     .second = "PartComponent",
     .outer = staticSetting,
     .inner = sequence,
     .ordered = true,
     .word = "static",
     .wordOfReferenceNames = "static",
     .outerFails = fails,
     .outerUnusable = failsWith("Fail to get the PartComponent Instances", 83),
     .innerFails = succeedsWith("Failed to get the GroupComponent Instance", 110),
     .innerUnusable = failsWith("NULL Object of GroupComponent", 120),
     .pathUnmade = goesOn,
     .appendsUnmade = false},
    {.name = dhcpOrdered,
     .propertyA = "GroupComponent",
     .endA = sequence,
     .propertyB = "PartComponent",
     .endB = dhcpSetting,
     .builder = "IPConfigDHCPOrderedCMPIInstances",
     .entryLine = 51,
     .exitLine = 162,
     .first = "GroupComponent",
     .second = "PartComponent",
     .outer = dhcpSetting,
     .inner = sequence,
     .ordered = true,
     .word = "dhcp",
     .wordOfReferenceNames = "static",
     .outerFails = failsWith(cannotGet("CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATA", 6), 68),
     .outerUnusable = goesOn,
     .innerFails = succeeds,
     .innerUnusable = failsWith("CMPIObjectPath is NULL for CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATA", 110),
     .pathUnmade = failsWith(cannotCreate("CLASS_MGMT_HW_DHCP_ORDER_MEM_OF_COLLECTION", 29), 135),
     .appendsUnmade = true},
};

template <typename Row>
const Row& rowOf(const std::vector<Row>& rows, const std::string& name) {
  for (const Row& row : rows) {
    if (name == row.name) {
      return row;
    }
  }
  throw std::invalid_argument("the model has no " + name);
}

}  // namespace

const Composite& compositeOf(const std::string& name) { return rowOf(composites, name); }
const Association& associationOf(const std::string& name) { return rowOf(associations, name); }

const std::vector<FarEnd> farEnds = {
    {endpoint, hosted, system},
    {system, hosted, endpoint},
    {system, remoteHosted, accessPoint},
    {accessPoint, remoteHosted, system},
    {endpoint, elementSetting, sequence},
    {sequence, elementSetting, endpoint},
    {sequence, dhcpOrdered, dhcpSetting},
    {dhcpSetting, dhcpOrdered, sequence},
    {staticSetting, staticOrdered, sequence},
    {sequence, staticOrdered, staticSetting},
    {accessPoint, clientAccess, endpoint},
    {endpoint, clientAccess, accessPoint},
};

}  // namespace Testing::Model
