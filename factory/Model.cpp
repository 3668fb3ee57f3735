// SPDX-License-Identifier: Apache-2.0
#include "factory/Model.h"

namespace QV::IPConfigComposite {

namespace {

// The names that stand both in a row and in a property.
constexpr const char* computerSystemName = "YRNx_MgmtHwComputerSystem";
constexpr const char* endpointName = "YRNx_MgmtHwIPProtocolEndPoint";
constexpr const char* remoteAccessPointName = "YRNx_MgmtHwRemoteServiceAccessPoint";

const char* computerSystemKeys[] = {"CreationClassName", "Name", nullptr};
const char* accessPointKeys[] = {"SystemCreationClassName", "SystemName", "CreationClassName", "Name", nullptr};
const char* settingKeys[] = {"InstanceID", nullptr};

constexpr TextProperty computerSystemConstants[] = {{"CreationClassName", computerSystemName}};
constexpr TextProperty endpointConstants[] = {
    {"SystemCreationClassName", computerSystemName},
    {"CreationClassName", endpointName},
};
constexpr TextProperty remoteAccessPointConstants[] = {
    {"SystemCreationClassName", computerSystemName},
    {"CreationClassName", remoteAccessPointName},
};

// "Dedicated" is an array, which mapProperty cannot copy: Extra::NumberedSystem does.
constexpr MappedProperty computerSystemMapped[] = {{"Name", String}, {"Description", String}, {"NameFormat", String}};
constexpr MappedProperty endpointMapped[] = {
    {"Name", String},           {"SystemName", String},       {"NameFormat", String},     {"ElementName", String},
    {"IPv4Address", String},    {"IPv6Address", String},      {"SubnetMask", String},     {"PrefixLength", Uint8},
    {"AddressType", Uint16},    {"IPVersionSupport", Uint16}, {"ProtocolIFType", Uint16}, {"EnabledState", Uint16},
    {"RequestedState", Uint16}, {"AddressOrigin", Uint16},
};
constexpr MappedProperty settingMapped[] = {{"InstanceID", String}, {"ElementName", String}, {"AddressOrigin", Uint16}};
constexpr MappedProperty remoteAccessPointMapped[] = {
    {"Name", String},       {"SystemName", String},    {"OtherAccessContext", String},
    {"AccessInfo", String}, {"AccessContext", Uint16}, {"InfoFormat", Uint16},
};

// compatibility 4: the caption of the DHCP settings speaks of DNS.
constexpr TextProperty dhcpFinals[] = {{"Caption", "DNS Configuration Setting"}};

// compatibility 5: the class name in the property, and so in the key, is not that of the object path.
constexpr TextProperty remoteAccessPointFinals[] = {{"CreationClassName", "YRNx_RemoteAccessPoint"}};

}  // namespace

constinit const CompositeClass computerSystem = {
    .name = computerSystemName,
    .getAll = &IPConfigObjectFactory::getAllSPComputerCMPIInstances,
    .make = &IPConfigObjectFactory::makeSPComputerInstance,
    .underlying = "YRNQV_SPComputerSystem",
    .selection = Selection::Every,
    .keys = computerSystemKeys,
    .constants = computerSystemConstants,
    .mapped = computerSystemMapped,
    .extra = Extra::NumberedSystem,
};

constinit const CompositeClass ipProtocolEndpoint = {
    .name = endpointName,
    .getAll = &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances,
    .make = &IPConfigObjectFactory::makeIPProtocolEndptInstance,
    .underlying = "YRNQV_IPProtocolEndpoint",
    .selection = Selection::OwnedByProcessor,
    .keys = accessPointKeys,
    .constants = endpointConstants,
    .mapped = endpointMapped,
};

constinit const CompositeClass assignmentSettingSequence = {
    .name = "YRNx_MgmtHwIPAssignmentSettingSequence",
    .getAll = &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances,
    .make = &IPConfigObjectFactory::makeIPAssignmentSettingInstance,
    .underlying = "YRNQV_IPAssignmentSettingData",
    .selection = Selection::IdentifierOfFields,
    .identifierFields = 3,
    .keys = settingKeys,
    .mapped = settingMapped,
    .ending = Ending::ExitMarker,  // compatibility 18
};

constinit const CompositeClass staticAssignmentSetting = {
    .name = "YRNx_MgmtHwStaticIPAssignmentSettingData",
    .getAll = &IPConfigObjectFactory::getAllStaticIPAssignmentSettingCMPIInstances,
    .make = &IPConfigObjectFactory::makeStaticIPAssignmentSettingInstance,
    .underlying = "YRNQV_StaticIPAssignmentSettingData",
    .selection = Selection::IdentifierOfFields,
    .identifierFields = 2,
    .keys = settingKeys,
    .mapped = settingMapped,
};

constinit const CompositeClass dhcpAssignmentSetting = {
    .name = "YRNx_MgmtHwDHCPAssignmentSettingData",
    .getAll = &IPConfigObjectFactory::getAllDHCPAssignmentSettingCMPIInstances,
    .make = &IPConfigObjectFactory::makeDHCPAssignmentSettingInstance,
    .underlying = "YRNQV_DHCPSettingData",
    .selection = Selection::IdentifierOfFields,
    .identifierFields = 2,
    .keys = settingKeys,
    .mapped = settingMapped,
    .finals = dhcpFinals,
};

constinit const CompositeClass remoteServiceAccessPoint = {
    .name = remoteAccessPointName,
    .getAll = &IPConfigObjectFactory::getAllIPRemoteSAPCMPIInstances,
    .make = &IPConfigObjectFactory::makeIPRemoteSAPInstance,
    .underlying = "YRNQV_IPRemoteServiceAccessPoint",
    .selection = Selection::OwnedByProcessor,
    .keys = accessPointKeys,
    .constants = remoteAccessPointConstants,
    .mapped = remoteAccessPointMapped,
    .finals = remoteAccessPointFinals,
};

namespace {

constexpr References dependency = {{{"Antecedent", End::A}, {"Dependent", End::B}}};
constexpr References membership = {{{"GroupComponent", End::A}, {"PartComponent", End::B}}};

}  // namespace

constinit const Association hostedAccessPoint = {
    .name = "YRNx_MgmtHwIPHostedAccessPoint",
    .endA = computerSystem,
    .endB = ipProtocolEndpoint,
    .references = dependency,
    .referencesOfInstance = dependency,
};

constinit const Association remoteHostedAccessPoint = {
    .name = "YRNx_MgmtHwIPRemoteHostedAccessPoint",
    .endA = computerSystem,
    .endB = remoteServiceAccessPoint,
    .references = dependency,
    .referencesOfInstance = dependency,
};

constinit const Association clientAccess = {
    .name = "YRNx_MgmtHwClientAccess",
    .endA = remoteServiceAccessPoint,
    .endB = ipProtocolEndpoint,
    .references = dependency,
    .referencesOfInstance = dependency,
};

constinit const Association elementSettingData = {
    .name = "YRNx_MgmtHwIPElementSettingData",
    .endA = assignmentSettingSequence,
    .endB = ipProtocolEndpoint,
    .references = dependency,
    .referencesOfInstance = {{{"ManagedElement", End::B}, {"SettingData", End::A}}},  // compatibility 9
};

constinit const Association staticOrderedMember = {
    .name = "YRNx_MgmtHwStaticIPOrderedMemberOfCollection",
    .endA = assignmentSettingSequence,
    .endB = staticAssignmentSetting,
    .references = membership,
    .referencesOfInstance = membership,
};

constinit const Association dhcpOrderedMember = {
    .name = "YRNx_MgmtHwDHCPOrderedMemberOfCollection",
    .endA = assignmentSettingSequence,
    .endB = dhcpAssignmentSetting,
    .references = membership,
    .referencesOfInstance = membership,
};

namespace {

constexpr View allViews[] = {
    {hostedAccessPoint, End::B},       {hostedAccessPoint, End::A},  {remoteHostedAccessPoint, End::A},
    {remoteHostedAccessPoint, End::B}, {elementSettingData, End::B}, {elementSettingData, End::A},
    {dhcpOrderedMember, End::A},       {dhcpOrderedMember, End::B},  {staticOrderedMember, End::B},
    {staticOrderedMember, End::A},     {clientAccess, End::A},       {clientAccess, End::B},
};

}  // namespace

constinit const std::span<const View> views = allViews;

}  // namespace QV::IPConfigComposite
