// Serves the association by which assignment setting sequences apply to IP protocol endpoints. The texts of the
// builder's messages are fixed vocabulary, misnomers and runs of blanks included.
#include "AssociationOperations.h"
#include "ClassNames.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigElementSettingDataProvider = "Tarnwick.IPConfigElementSettingDataProvider";

// References name the ends otherwise than the instances do; clients of each side know its own names.
const AssociationUnit unit = {
    .component = loggerIPConfigElementSettingDataProvider,
    .file = "IPConfigElementSettingDataProvider",
    .associationClass = ClassNames::elementSettingData,
    .endA = {ClassNames::assignmentSettingSequence, &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances},
    .endB = {ClassNames::ipProtocolEndpoint, &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances},
    .referenceToA = "Antecedent",
    .referenceToB = "Dependent",
    .kindWords = nullptr,
};

const AssociationBuilder builder = {
    .component = loggerIPConfigElementSettingDataProvider,
    .file = "IPConfigElementSettingDataProvider",
    .function = "IPConfigElementSettingDataCMPIInstances",
    .entryLine = 51,
    .exitLine = 188,
    .associationClass = ClassNames::elementSettingData,
    .outer = {ClassNames::ipProtocolEndpoint, &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances},
    .inner = {ClassNames::assignmentSettingSequence, &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances},
    .first = "ManagedElement",
    .second = "SettingData",
    .firstIsOuter = true,
    .keysOnPath = false,
    .outerIdentifierRead = false,
    .innerMarker = nullptr,
    .settingFlags = true,
    .outerFailed = {Reaction::Course::EndWith0},
    .outerNull = {Reaction::Course::GoOn},
    .innerFailed = {Reaction::Course::EndWith1,
                    "***Can't get DNS Client ObjectPaths.                  Exiting EnumerateInstanceNames***", 103},
    .innerNull = {Reaction::Course::EndWith1, "CMPIObjectPath is NULL for DNS Client", 113},
    .pathFailed = {Reaction::Course::EndWith1,
                   "Create CMPIObjectPath failed for                         ipHostedAccessPointClass.", 131},
    .instanceFailed = UnmadeInstance::Append,
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigElementSettingData_, IPConfigElementSettingDataCMPIInstances, int)

CMInstanceMIStub(IPConfigElementSettingData_, IPConfigElementSettingDataProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigElementSettingData_, IPConfigElementSettingDataProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
