// Serves the association by which the computer system hosts remote service access points. The texts of the builder's
// messages are fixed vocabulary, misnomers and runs of blanks included.
#include "AssociationOperations.h"
#include "ClassNames.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPRemoteHostedAccessPointProvider = "Tarnwick.IPRemoteHostedAccessPointProvider";

const AssociationUnit unit = {
    .component = loggerIPRemoteHostedAccessPointProvider,
    .file = "IPRemoteHostedAccessPointProvider",
    .associationClass = ClassNames::remoteHostedAccessPoint,
    .endA = {ClassNames::computerSystem, &IPConfigObjectFactory::getAllSPComputerCMPIInstances},
    .endB = {ClassNames::remoteServiceAccessPoint, &IPConfigObjectFactory::getAllIPRemoteSAPCMPIInstances},
    .referenceToA = "Antecedent",
    .referenceToB = "Dependent",
    .kindWords = nullptr,
};

const AssociationBuilder builder = {
    .component = loggerIPRemoteHostedAccessPointProvider,
    .file = "IPRemoteHostedAccessPointProvider",
    .function = "IPRemoteHostAccessPointCMPIInstances",
    .entryLine = __LINE__,
    .exitLine = __LINE__,
    .associationClass = ClassNames::remoteHostedAccessPoint,
    .outer = {ClassNames::computerSystem, &IPConfigObjectFactory::getAllSPComputerCMPIInstances},
    .inner = {ClassNames::remoteServiceAccessPoint, &IPConfigObjectFactory::getAllIPRemoteSAPCMPIInstances},
    .first = "Antecedent",
    .second = "Dependent",
    .firstIsOuter = true,
    .keysOnPath = false,
    .outerIdentifierRead = false,
    .innerMarker = nullptr,
    .settingFlags = false,
    .outerFailed = {Reaction::Course::EndWith0},
    .outerNull = {Reaction::Course::GoOn},
    .innerFailed = {Reaction::Course::EndWith1,
                    "***Can't get  YRNx_HwIPRemoteServiceAccessPoint ObjectPaths.                  Exiting "
                    "EnumerateInstanceNames***"},
    .innerNull = {Reaction::Course::EndWith1, "CMPIObjectPath is NULL for DNS Client"},
    .pathFailed =
        {Reaction::Course::EndWith1,
         "Create CMPIObjectPath failed for                         CLASS_MGMT_HW_IP_REMOTE_HOSTED_ACCESS_POINT."},
    .instanceFailed = UnmadeInstance::Append,
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPRemoteHostedAccessPoint_, IPRemoteHostAccessPointCMPIInstances, unsigned short)

CMInstanceMIStub(IPRemoteHostedAccessPoint_, IPRemoteHostedAccessPointProvider, broker, CMNoHook)
CMAssociationMIStub(IPRemoteHostedAccessPoint_, IPRemoteHostedAccessPointProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
