#include "CompositeClass.h"

#include "ClassNames.h"

namespace QV::IPConfigComposite {

namespace {

const char* computerSystemKeys[] = {"CreationClassName", "Name", nullptr};
const char* accessPointKeys[] = {"SystemCreationClassName", "SystemName", "CreationClassName", "Name", nullptr};
const char* settingKeys[] = {"InstanceID", nullptr};

constexpr TextProperty computerSystemConstants[] = {{"CreationClassName", ClassNames::computerSystem}};
constexpr TextProperty endpointConstants[] = {
    {"SystemCreationClassName", ClassNames::computerSystem},
    {"CreationClassName", ClassNames::ipProtocolEndpoint},
};
constexpr TextProperty remoteAccessPointConstants[] = {
    {"SystemCreationClassName", ClassNames::computerSystem},
    {"CreationClassName", ClassNames::remoteServiceAccessPoint},
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

// Clients of this product know the DHCP setting by its DNS caption.
constexpr TextProperty dhcpFinals[] = {{"Caption", "DNS Configuration Setting"}};

// A remote access point leaves the enumeration with this class name in its property and key, while its object path
// keeps the class that it is registered under.
constexpr TextProperty remoteAccessPointFinals[] = {{"CreationClassName", "YRNx_RemoteAccessPoint"}};

}  // namespace

const CompositeClass computerSystem = {
    .getAll = "getAllSPComputerCMPIInstances",
    .make = "makeSPComputerInstance",
    .name = ClassNames::computerSystem,
    .underlying = "YRNQV_SPComputerSystem",
    .selection = Selection::Every,
    .identifierFields = 0,
    .keys = computerSystemKeys,
    .constants = computerSystemConstants,
    .mapped = computerSystemMapped,
    .finals = {},
    .extra = Extra::NumberedSystem,
    .ending = Ending::ExitLine,
};

const CompositeClass ipProtocolEndpoint = {
    .getAll = "getAllIPProtocolendptCMPIInstances",
    .make = "makeIPProtocolEndptInstance",
    .name = ClassNames::ipProtocolEndpoint,
    .underlying = "YRNQV_IPProtocolEndpoint",
    .selection = Selection::OwnedByProcessor,
    .identifierFields = 0,
    .keys = accessPointKeys,
    .constants = endpointConstants,
    .mapped = endpointMapped,
    .finals = {},
    .extra = Extra::None,
    .ending = Ending::ExitLine,
};

const CompositeClass assignmentSettingSequence = {
    .getAll = "getAllIPAssignmentSettingCMPIInstances",
    .make = "makeIPAssignmentSettingInstance",
    .name = ClassNames::assignmentSettingSequence,
    .underlying = "YRNQV_IPAssignmentSettingData",
    .selection = Selection::IdentifierOfFields,
    .identifierFields = 3,
    .keys = settingKeys,
    .constants = {},
    .mapped = settingMapped,
    .finals = {},
    .extra = Extra::None,
    .ending = Ending::ExitMarker,
};

const CompositeClass staticAssignmentSetting = {
    .getAll = "getAllStaticIPAssignmentSettingCMPIInstances",
    .make = "makeStaticIPAssignmentSettingInstance",
    .name = ClassNames::staticAssignmentSetting,
    .underlying = "YRNQV_StaticIPAssignmentSettingData",
    .selection = Selection::IdentifierOfFields,
    .identifierFields = 2,
    .keys = settingKeys,
    .constants = {},
    .mapped = settingMapped,
    .finals = {},
    .extra = Extra::None,
    .ending = Ending::ExitLine,
};

const CompositeClass dhcpAssignmentSetting = {
    .getAll = "getAllDHCPAssignmentSettingCMPIInstances",
    .make = "makeDHCPAssignmentSettingInstance",
    .name = ClassNames::dhcpAssignmentSetting,
    .underlying = "YRNQV_DHCPSettingData",
    .selection = Selection::IdentifierOfFields,
    .identifierFields = 2,
    .keys = settingKeys,
    .constants = {},
    .mapped = settingMapped,
    .finals = dhcpFinals,
    .extra = Extra::None,
    .ending = Ending::ExitLine,
};

const CompositeClass remoteServiceAccessPoint = {
    .getAll = "getAllIPRemoteSAPCMPIInstances",
    .make = "makeIPRemoteSAPInstance",
    .name = ClassNames::remoteServiceAccessPoint,
    .underlying = "YRNQV_IPRemoteServiceAccessPoint",
    .selection = Selection::OwnedByProcessor,
    .identifierFields = 0,
    .keys = accessPointKeys,
    .constants = remoteAccessPointConstants,
    .mapped = remoteAccessPointMapped,
    .finals = remoteAccessPointFinals,
    .extra = Extra::None,
    .ending = Ending::ExitLine,
};

}  // namespace QV::IPConfigComposite
