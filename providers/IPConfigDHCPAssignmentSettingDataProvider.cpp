// Serves the DHCP assignment settings.
#include "InstanceOperations.h"
#include "ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

const CMPIBroker* broker = nullptr;
const std::string loggerIPConfigDHCPAssnSettingDataProvider = "Tarnwick.IPConfigDHCPAssnSettingDataProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigDHCPAssnSettingDataProvider,
    .file = "IPConfigDHCPAssignmentSettingDataProvider",
    .getAll = &IPConfigObjectFactory::getAllDHCPAssignmentSettingCMPIInstances,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPConfigDHCPAssnSettingData_)
IPCONFIG_MODIFY_STUB(IPConfigDHCPAssnSettingData_)

CMInstanceMIStub(IPConfigDHCPAssnSettingData_, IPConfigDHCPAssnSettingDataProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
