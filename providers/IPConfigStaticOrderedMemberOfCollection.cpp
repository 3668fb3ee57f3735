// Serves the association by which static settings are members of assignment setting sequences. The texts of the
// builder's messages are fixed vocabulary, misnomers and runs of blanks included.
#include "AssociationOperations.h"
#include "ClassNames.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigStaticOrderedMembetOfCollProvider =
    "Tarnwick.IPConfigStaticOrderedMembetOfCollProvider";

const KindWords kindWords = {
    .associators = "static",
    .associatorNames = "static",
    .references = "static",
    .referenceNames = "static",
};

const AssociationUnit unit = {
    .component = loggerIPConfigStaticOrderedMembetOfCollProvider,
    .file = "IPConfigStaticOrderedMemberOfCollection",
    .associationClass = ClassNames::staticOrderedMember,
    .endA = {ClassNames::assignmentSettingSequence, &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances},
    .endB = {ClassNames::staticAssignmentSetting, &IPConfigObjectFactory::getAllStaticIPAssignmentSettingCMPIInstances},
    .referenceToA = "GroupComponent",
    .referenceToB = "PartComponent",
    .kindWords = &kindWords,
};

const AssociationBuilder builder = {
    .component = loggerIPConfigStaticOrderedMembetOfCollProvider,
    .file = "IPConfigStaticOrderedMemberOfCollection",
    .function = "IPConfigStaticOrderedCMPIInstances",
    .entryLine = 51,
    .exitLine = 161,
    .associationClass = ClassNames::staticOrderedMember,
    .outer = {ClassNames::staticAssignmentSetting,
              &IPConfigObjectFactory::getAllStaticIPAssignmentSettingCMPIInstances},
    .inner = {ClassNames::assignmentSettingSequence, &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances},
    .first = "GroupComponent",
    .second = "PartComponent",
    .firstIsOuter = false,
    .keysOnPath = false,
    .outerIdentifierRead = true,
    .innerMarker = "static",
    .settingFlags = false,
    .outerFailed = {Reaction::Course::EndWith1},
    .outerNull = {Reaction::Course::EndWith1, "Fail to get the PartComponent Instances", 83},
    .innerFailed = {Reaction::Course::EndWith0, "Failed to get the GroupComponent Instance", 110},
    .innerNull = {Reaction::Course::EndWith1, "NULL Object of GroupComponent", 120},
    .pathFailed = {Reaction::Course::GoOn},
    .instanceFailed = UnmadeInstance::Skip,
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigStaticOrdered_, IPConfigStaticOrderedCMPIInstances, int)

CMInstanceMIStub(IPConfigStaticOrdered_, IPConfigStaticOrderedMembetOfCollProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigStaticOrdered_, IPConfigStaticOrderedMembetOfCollProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
