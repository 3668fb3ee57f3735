// SPDX-License-Identifier: Apache-2.0
// Serves the remote service access points.
#include "providers/operations/InstanceOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPRemoteServiceAccessPointProvider = "Tarnwick.IPRemoteServiceAccessPointProvider";

const InstanceUnit unit = {
    .component = loggerIPRemoteServiceAccessPointProvider,
    .file = "IPRemoteServiceAccessPoint",
    .serves = remoteServiceAccessPoint,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPRemoteSAP_)
IPCONFIG_MODIFY_OPERATION(IPRemoteSAP_, modifyRemoteSAPCMPIInstance)

CMInstanceMIStub(IPRemoteSAP_, IPRemoteServiceAccessPointProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
