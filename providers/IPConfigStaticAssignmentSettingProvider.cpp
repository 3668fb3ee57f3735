// Serves the static IP assignment settings.
#include "ModifyOperation.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigStaticAssnSettingProvider = "Tarnwick.IPConfigStaticAssnSettingProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigStaticAssnSettingProvider,
    .file = "IPConfigStaticAssignmentSettingProvider",
    .getAll = &IPConfigObjectFactory::getAllStaticIPAssignmentSettingCMPIInstances,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPConfigStaticAssnSettingData_)
IPCONFIG_MODIFY_OPERATION(IPConfigStaticAssnSettingData_, modifyStaticIPCMPIInstance)

CMInstanceMIStub(IPConfigStaticAssnSettingData_, IPConfigStaticAssnSettingDataProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
