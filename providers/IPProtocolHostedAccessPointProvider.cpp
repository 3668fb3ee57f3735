// SPDX-License-Identifier: Apache-2.0
// Serves the association by which the computer system hosts IP protocol endpoints.
#include "providers/operations/AssociationOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPProtocolHostedAccessPointProvider = "Tarnwick.IPProtocolHostedAccessPointProvider";

const AssociationUnit unit = {
    .association = hostedAccessPoint,
    .trace =
        {
            .component = loggerIPProtocolHostedAccessPointProvider,
            .file = "IPProtocolHostedAccessPointProvider",
            .builder = "IPProtocolHostAccessPointCMPIInstances",
            .builderEntryLine = ownLine(),
            .builderExitLine = ownLine(),
        },
    .wordInSequence = nullptr,
    .pairing = {.outer = End::A},
    .onFailure =
        {
            .outerUnreadable = endWith0(),
            .outerUnusable = goOn(),
            .innerUnreadable = endWith1("***Can't get YRNx_HwIPProtocolEndpoint ObjectPaths.                  Exiting "
                                        "EnumerateInstanceNames***"),
            .innerUnusable = endWith1("CMPIObjectPath is NULL for DNS Client"),
            .pathUnmade =
                endWith1("Create CMPIObjectPath failed for                         ipHostedAccessPointClass."),
            .instanceUnmade = UnmadeInstance::Append,
        },
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPProtocolHostedAccessPoint_, IPProtocolHostAccessPointCMPIInstances, unsigned short)

CMInstanceMIStub(IPProtocolHostedAccessPoint_, IPProtocolHostedAccessPointProvider, broker, CMNoHook)
CMAssociationMIStub(IPProtocolHostedAccessPoint_, IPProtocolHostedAccessPointProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
