// SPDX-License-Identifier: Apache-2.0
// Serves the IP assignment setting sequences.
#include "providers/operations/InstanceOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigAssignmentSettingProvider = "Tarnwick.IPConfigAssignmentSettingProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigAssignmentSettingProvider,
    .file = "IPConfigAssignmentSettingDataProvider",
    .serves = assignmentSettingSequence,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(IPConfigAssnSettingData_)
IPCONFIG_MODIFY_STUB(IPConfigAssnSettingData_)

CMInstanceMIStub(IPConfigAssnSettingData_, IPConfigAssignmentSettingProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
