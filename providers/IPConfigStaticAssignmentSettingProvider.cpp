// SPDX-License-Identifier: Apache-2.0
// Serves the static IP assignment settings.
#include "providers/operations/InstanceOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigStaticAssnSettingProvider = "Tarnwick.IPConfigStaticAssnSettingProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigStaticAssnSettingProvider,
    .file = "IPConfigStaticAssignmentSettingProvider",
    .serves = staticAssignmentSetting,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPConfigStaticAssnSettingData_)
IPCONFIG_MODIFY_OPERATION(IPConfigStaticAssnSettingData_, modifyStaticIPCMPIInstance)

CMInstanceMIStub(IPConfigStaticAssnSettingData_, IPConfigStaticAssnSettingDataProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
