// Serves the association by which DHCP settings are members of assignment setting sequences. The texts of the builder's
// messages are fixed vocabulary, misnomers and runs of blanks included.
#include "AssociationOperations.h"
#include "ClassNames.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigDHCPOrderedMembetOfCollProvider = "Tarnwick.IPConfigDHCPOrderedMembetOfCollProvider";

// ReferenceNames asks for "static" where the other three ask for "dhcp": clients have come to rely on what it answers.
const KindWords kindWords = {
    .associators = "dhcp",
    .associatorNames = "dhcp",
    .references = "dhcp",
    .referenceNames = "static",
};

const AssociationUnit unit = {
    .component = loggerIPConfigDHCPOrderedMembetOfCollProvider,
    .file = "IPConfigDHCPOrderedMemberOfCollection",
    .associationClass = ClassNames::dhcpOrderedMember,
    .endA = {ClassNames::assignmentSettingSequence, &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances},
    .endB = {ClassNames::dhcpAssignmentSetting, &IPConfigObjectFactory::getAllDHCPAssignmentSettingCMPIInstances},
    .referenceToA = "GroupComponent",
    .referenceToB = "PartComponent",
    .kindWords = &kindWords,
};

const AssociationBuilder builder = {
    .component = loggerIPConfigDHCPOrderedMembetOfCollProvider,
    .file = "IPConfigDHCPOrderedMemberOfCollection",
    .function = "IPConfigDHCPOrderedCMPIInstances",
    .entryLine = 51,
    .exitLine = 162,
    .associationClass = ClassNames::dhcpOrderedMember,
    .outer = {ClassNames::dhcpAssignmentSetting, &IPConfigObjectFactory::getAllDHCPAssignmentSettingCMPIInstances},
    .inner = {ClassNames::assignmentSettingSequence, &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances},
    .first = "GroupComponent",
    .second = "PartComponent",
    .firstIsOuter = false,
    .keysOnPath = false,
    .outerIdentifierRead = true,
    .innerMarker = "dhcp",
    .settingFlags = false,
    .outerFailed =
        {Reaction::Course::EndWith1,
         "***Can't get CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATAObjectPaths.      Exiting EnumerateInstanceNames***",
         68},
    .outerNull = {Reaction::Course::GoOn},
    .innerFailed = {Reaction::Course::EndWith0},
    .innerNull = {Reaction::Course::EndWith1, "CMPIObjectPath is NULL for CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATA",
                  110},
    .pathFailed =
        {Reaction::Course::EndWith1,
         "Create CMPIObjectPath failed for                             CLASS_MGMT_HW_DHCP_ORDER_MEM_OF_COLLECTION.",
         135},
    .instanceFailed = UnmadeInstance::Append,
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigDHCPOrdered_, IPConfigDHCPOrderedCMPIInstances, int)

CMInstanceMIStub(IPConfigDHCPOrdered_, IPConfigDHCPOrderedMembetOfCollProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigDHCPOrdered_, IPConfigDHCPOrderedMembetOfCollProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
