// Serves the association by which the computer system hosts IP protocol endpoints. The texts of the builder's messages
// are fixed vocabulary, misnomers and runs of blanks included.
#include "AssociationOperations.h"
#include "ClassNames.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPProtocolHostedAccessPointProvider = "Tarnwick.IPProtocolHostedAccessPointProvider";

const AssociationUnit unit = {
    .component = loggerIPProtocolHostedAccessPointProvider,
    .file = "IPProtocolHostedAccessPointProvider",
    .associationClass = ClassNames::hostedAccessPoint,
    .endA = {ClassNames::computerSystem, &IPConfigObjectFactory::getAllSPComputerCMPIInstances},
    .endB = {ClassNames::ipProtocolEndpoint, &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances},
    .referenceToA = "Antecedent",
    .referenceToB = "Dependent",
    .kindWords = nullptr,
};

const AssociationBuilder builder = {
    .component = loggerIPProtocolHostedAccessPointProvider,
    .file = "IPProtocolHostedAccessPointProvider",
    .function = "IPProtocolHostAccessPointCMPIInstances",
    .entryLine = __LINE__,
    .exitLine = __LINE__,
    .associationClass = ClassNames::hostedAccessPoint,
    .outer = {ClassNames::computerSystem, &IPConfigObjectFactory::getAllSPComputerCMPIInstances},
    .inner = {ClassNames::ipProtocolEndpoint, &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances},
    .first = "Antecedent",
    .second = "Dependent",
    .firstIsOuter = true,
    .keysOnPath = false,
    .outerIdentifierRead = false,
    .innerMarker = nullptr,
    .settingFlags = false,
    .outerFailed = {Reaction::Course::EndWith0},
    .outerNull = {Reaction::Course::GoOn},
    .innerFailed =
        {Reaction::Course::EndWith1,
         "***Can't get YRNx_HwIPProtocolEndpoint ObjectPaths.                  Exiting EnumerateInstanceNames***"},
    .innerNull = {Reaction::Course::EndWith1, "CMPIObjectPath is NULL for DNS Client"},
    .pathFailed = {Reaction::Course::EndWith1,
                   "Create CMPIObjectPath failed for                         ipHostedAccessPointClass."},
    .instanceFailed = UnmadeInstance::Append,
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPProtocolHostedAccessPoint_, IPProtocolHostAccessPointCMPIInstances, unsigned short)

CMInstanceMIStub(IPProtocolHostedAccessPoint_, IPProtocolHostedAccessPointProvider, broker, CMNoHook)
CMAssociationMIStub(IPProtocolHostedAccessPoint_, IPProtocolHostedAccessPointProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
