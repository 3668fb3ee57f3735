// SPDX-License-Identifier: Apache-2.0
// Serves the management processor's computer system.
#include "providers/operations/InstanceOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigProvider = "Tarnwick.IPConfigProvider";

const InstanceUnit unit = {
    .component = loggerIPConfigProvider,
    .file = "IPConfigProvider",
    .serves = computerSystem,
};

}  // namespace

IPCONFIG_INSTANCE_OPERATIONS(CompositeIPConfig_)
IPCONFIG_MODIFY_STUB(CompositeIPConfig_)

CMInstanceMIStub(CompositeIPConfig_, CompositeIPConfigProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
