// Serves the association by which remote service access points are available to IP protocol endpoints. The texts of the
// builder's messages are fixed vocabulary, misnomers and runs of blanks included.
#include "AssociationOperations.h"
#include "ClassNames.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigClientAccessProvider = "Tarnwick.IPConfigClientAccessProvider";

const AssociationUnit unit = {
    .component = loggerIPConfigClientAccessProvider,
    .file = "IPConfigClientAccessProvider",
    .associationClass = ClassNames::clientAccess,
    .endA = {ClassNames::remoteServiceAccessPoint, &IPConfigObjectFactory::getAllIPRemoteSAPCMPIInstances},
    .endB = {ClassNames::ipProtocolEndpoint, &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances},
    .referenceToA = "Antecedent",
    .referenceToB = "Dependent",
    .kindWords = nullptr,
};

const AssociationBuilder builder = {
    .component = loggerIPConfigClientAccessProvider,
    .file = "IPConfigClientAccessProvider",
    .function = "IPConfigClientAccessCMPIInstances",
    .entryLine = __LINE__,
    .exitLine = __LINE__,
    .associationClass = ClassNames::clientAccess,
    .outer = {ClassNames::ipProtocolEndpoint, &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances},
    .inner = {ClassNames::remoteServiceAccessPoint, &IPConfigObjectFactory::getAllIPRemoteSAPCMPIInstances},
    .first = "Antecedent",
    .second = "Dependent",
    .firstIsOuter = false,
    .keysOnPath = true,
    .outerIdentifierRead = false,
    .innerMarker = nullptr,
    .settingFlags = false,
    .outerFailed = {Reaction::Course::EndWith0},
    .outerNull = {Reaction::Course::GoOn},
    .innerFailed = {Reaction::Course::EndWith1,
                    "***Can't get CLASS_MGMT_HW_REMOTE_SERVICE_ACCESS_POINT ObjectPaths.                  Exiting "
                    "EnumerateInstanceNames***"},
    .innerNull = {Reaction::Course::EndWith1, "CMPIObjectPath is NULL for RemoteSAP"},
    .pathFailed = {Reaction::Course::EndWith1,
                   "Create CMPIObjectPath failed for                         CLASS_MGMT_HW_IP_CLIENT_ACCESS."},
    .instanceFailed = UnmadeInstance::Skip,
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigClientAccess_, IPConfigClientAccessCMPIInstances, unsigned short)

CMInstanceMIStub(IPConfigClientAccess_, IPConfigClientAccessProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigClientAccess_, IPConfigClientAccessProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
