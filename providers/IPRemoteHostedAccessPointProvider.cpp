// SPDX-License-Identifier: Apache-2.0
// Serves the association by which the computer system hosts remote service access points.
#include "providers/operations/AssociationOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPRemoteHostedAccessPointProvider = "Tarnwick.IPRemoteHostedAccessPointProvider";

const AssociationUnit unit = {
    .association = remoteHostedAccessPoint,
    .trace =
        {
            .component = loggerIPRemoteHostedAccessPointProvider,
            .file = "IPRemoteHostedAccessPointProvider",
            .builder = "IPRemoteHostAccessPointCMPIInstances",
            .builderEntryLine = ownLine(),
            .builderExitLine = ownLine(),
        },
    .wordInSequence = nullptr,
    .pairing = {.outer = End::A},
    .onFailure =
        {
            .outerUnreadable = endWith0(),
            .outerUnusable = goOn(),
            .innerUnreadable =
                endWith1("***Can't get  YRNx_HwIPRemoteServiceAccessPoint ObjectPaths.                  Exiting "
                         "EnumerateInstanceNames***"),
            .innerUnusable = endWith1("CMPIObjectPath is NULL for DNS Client"),
            .pathUnmade = endWith1("Create CMPIObjectPath failed for                         "
                                   "CLASS_MGMT_HW_IP_REMOTE_HOSTED_ACCESS_POINT."),
            .instanceUnmade = UnmadeInstance::Append,
        },
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPRemoteHostedAccessPoint_, IPRemoteHostAccessPointCMPIInstances, unsigned short)

CMInstanceMIStub(IPRemoteHostedAccessPoint_, IPRemoteHostedAccessPointProvider, broker, CMNoHook)
CMAssociationMIStub(IPRemoteHostedAccessPoint_, IPRemoteHostedAccessPointProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
