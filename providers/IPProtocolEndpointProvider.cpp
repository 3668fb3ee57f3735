// Serves the IP protocol endpoints.
#include "ModifyOperation.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPProtocolEndpointProvider = "Tarnwick.IPProtocolEndpointProvider";

const InstanceUnit unit = {
    .component = loggerIPProtocolEndpointProvider,
    .file = "IPProtocolEndpointProvider",
    .getAll = &IPConfigObjectFactory::getAllIPProtocolendptCMPIInstances,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPProtocolendpt_)
IPCONFIG_MODIFY_OPERATION(IPProtocolendpt_, modifyIPProtocolendptCMPIInstance)

CMInstanceMIStub(IPProtocolendpt_, IPProtocolendptProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
