// SPDX-License-Identifier: Apache-2.0
// Serves the IP protocol endpoints.
#include "providers/operations/InstanceOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPProtocolEndpointProvider = "Tarnwick.IPProtocolEndpointProvider";

const InstanceUnit unit = {
    .component = loggerIPProtocolEndpointProvider,
    .file = "IPProtocolEndpointProvider",
    .serves = ipProtocolEndpoint,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPProtocolendpt_)
IPCONFIG_MODIFY_OPERATION(IPProtocolendpt_, modifyIPProtocolendptCMPIInstance)

CMInstanceMIStub(IPProtocolendpt_, IPProtocolendptProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
