// SPDX-License-Identifier: Apache-2.0
// Serves the DHCP assignment settings.
#include "providers/operations/InstanceOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigDHCPAssnSettingDataProvider = "Tarnwick.IPConfigDHCPAssnSettingDataProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigDHCPAssnSettingDataProvider,
    .file = "IPConfigDHCPAssignmentSettingDataProvider",
    .serves = dhcpAssignmentSetting,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPConfigDHCPAssnSettingData_)
IPCONFIG_MODIFY_STUB(IPConfigDHCPAssnSettingData_)

CMInstanceMIStub(IPConfigDHCPAssnSettingData_, IPConfigDHCPAssnSettingDataProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
