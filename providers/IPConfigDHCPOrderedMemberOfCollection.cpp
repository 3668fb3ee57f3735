// SPDX-License-Identifier: Apache-2.0
// Serves the association by which DHCP settings are members of assignment setting sequences.
#include "providers/operations/AssociationOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigDHCPOrderedMembetOfCollProvider = "Tarnwick.IPConfigDHCPOrderedMembetOfCollProvider";

const WordInSequence wordInSequence = {
    .associators = "dhcp",
    .associatorNames = "dhcp",
    .references = "dhcp",
    .referenceNames = "static",  // compatibility 7
};

const AssociationUnit unit = {
    .association = dhcpOrderedMember,
    .trace =
        {
            .component = loggerIPConfigDHCPOrderedMembetOfCollProvider,
            .file = "IPConfigDHCPOrderedMemberOfCollection",
            .builder = "IPConfigDHCPOrderedCMPIInstances",
            .builderEntryLine = 51,
            .builderExitLine = 162,
        },
    .wordInSequence = &wordInSequence,
    .pairing = {.outer = End::B, .readsOuterIdentifier = true, .wordInInnerIdentifier = "dhcp"},
    .onFailure =
        {
            .outerUnreadable = endWith1("***Can't get CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATAObjectPaths.      "
                                        "Exiting EnumerateInstanceNames***",
                                        68),
            .outerUnusable = goOn(),
            .innerUnreadable = endWith0(),
            .innerUnusable = endWith1("CMPIObjectPath is NULL for CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATA", 110),
            .pathUnmade = endWith1("Create CMPIObjectPath failed for                             "
                                   "CLASS_MGMT_HW_DHCP_ORDER_MEM_OF_COLLECTION.",
                                   135),
            .instanceUnmade = UnmadeInstance::Append,
        },
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigDHCPOrdered_, IPConfigDHCPOrderedCMPIInstances, int)

CMInstanceMIStub(IPConfigDHCPOrdered_, IPConfigDHCPOrderedMembetOfCollProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigDHCPOrdered_, IPConfigDHCPOrderedMembetOfCollProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
