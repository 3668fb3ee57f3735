// Serves the remote service access points.
#include "ModifyOperation.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPRemoteServiceAccessPointProvider = "Tarnwick.IPRemoteServiceAccessPointProvider";

const InstanceUnit unit = {
    .component = loggerIPRemoteServiceAccessPointProvider,
    .file = "IPRemoteServiceAccessPoint",
    .getAll = &IPConfigObjectFactory::getAllIPRemoteSAPCMPIInstances,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPRemoteSAP_)
IPCONFIG_MODIFY_OPERATION(IPRemoteSAP_, modifyRemoteSAPCMPIInstance)

CMInstanceMIStub(IPRemoteSAP_, IPRemoteServiceAccessPointProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
