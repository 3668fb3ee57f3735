// SPDX-License-Identifier: Apache-2.0
// Serves the association by which remote service access points are available to IP protocol endpoints.
#include "providers/operations/AssociationOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigClientAccessProvider = "Tarnwick.IPConfigClientAccessProvider";

const AssociationUnit unit = {
    .association = clientAccess,
    .trace =
        {
            .component = loggerIPConfigClientAccessProvider,
            .file = "IPConfigClientAccessProvider",
            .builder = "IPConfigClientAccessCMPIInstances",
            .builderEntryLine = ownLine(),
            .builderExitLine = ownLine(),
        },
    .wordInSequence = nullptr,
    .pairing = {.outer = End::B, .referencesAreKeys = true},
    .onFailure =
        {
            .outerUnreadable = endWith0(),
            .outerUnusable = goOn(),
            .innerUnreadable =
                endWith1("***Can't get CLASS_MGMT_HW_REMOTE_SERVICE_ACCESS_POINT ObjectPaths.                  Exiting "
                         "EnumerateInstanceNames***"),
            .innerUnusable = endWith1("CMPIObjectPath is NULL for RemoteSAP"),
            .pathUnmade =
                endWith1("Create CMPIObjectPath failed for                         CLASS_MGMT_HW_IP_CLIENT_ACCESS."),
            .instanceUnmade = UnmadeInstance::Skip,
        },
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigClientAccess_, IPConfigClientAccessCMPIInstances, unsigned short)

CMInstanceMIStub(IPConfigClientAccess_, IPConfigClientAccessProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigClientAccess_, IPConfigClientAccessProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
