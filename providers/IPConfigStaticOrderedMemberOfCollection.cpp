// SPDX-License-Identifier: Apache-2.0
// Serves the association by which static settings are members of assignment setting sequences.
#include "providers/operations/AssociationOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigStaticOrderedMembetOfCollProvider =
    "Tarnwick.IPConfigStaticOrderedMembetOfCollProvider";

const WordInSequence wordInSequence = {
    .associators = "static",
    .associatorNames = "static",
    .references = "static",
    .referenceNames = "static",
};

const AssociationUnit unit = {
    .association = staticOrderedMember,
    .trace =
        {
            .component = loggerIPConfigStaticOrderedMembetOfCollProvider,
            .file = "IPConfigStaticOrderedMemberOfCollection",
            .builder = "IPConfigStaticOrderedCMPIInstances",
            .builderEntryLine = 51,
            .builderExitLine = 161,
        },
    .wordInSequence = &wordInSequence,
    .pairing = {.outer = End::B, .readsOuterIdentifier = true, .wordInInnerIdentifier = "static"},
    .onFailure =
        {
            .outerUnreadable = endWith1(),
            .outerUnusable = endWith1("Fail to get the PartComponent Instances", 83),
            .innerUnreadable = endWith0("Failed to get the GroupComponent Instance", 110),
            .innerUnusable = endWith1("NULL Object of GroupComponent", 120),
            .pathUnmade = goOn(),
            .instanceUnmade = UnmadeInstance::Skip,
        },
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigStaticOrdered_, IPConfigStaticOrderedCMPIInstances, int)

CMInstanceMIStub(IPConfigStaticOrdered_, IPConfigStaticOrderedMembetOfCollProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigStaticOrdered_, IPConfigStaticOrderedMembetOfCollProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
