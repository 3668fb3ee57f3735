// Serves the IP assignment setting sequences.
#include "InstanceOperations.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigAssignmentSettingProvider = "Tarnwick.IPConfigAssignmentSettingProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigAssignmentSettingProvider,
    .file = "IPConfigAssignmentSettingDataProvider",
    .getAll = &IPConfigObjectFactory::getAllIPAssignmentSettingCMPIInstances,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPConfigAssnSettingData_)
IPCONFIG_MODIFY_STUB(IPConfigAssnSettingData_)

CMInstanceMIStub(IPConfigAssnSettingData_, IPConfigAssignmentSettingProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
