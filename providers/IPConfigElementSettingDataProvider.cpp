// SPDX-License-Identifier: Apache-2.0
// Serves the association by which assignment setting sequences apply to IP protocol endpoints.
#include "providers/operations/AssociationOperations.h"
#include "providers/operations/ProviderUnit.h"

namespace QV::IPConfigComposite {

namespace {

UnitBroker broker = nullptr;
const std::string loggerIPConfigElementSettingDataProvider = "Tarnwick.IPConfigElementSettingDataProvider";

const AssociationUnit unit = {
    .association = elementSettingData,
    .trace =
        {
            .component = loggerIPConfigElementSettingDataProvider,
            .file = "IPConfigElementSettingDataProvider",
            .builder = "IPConfigElementSettingDataCMPIInstances",
            .builderEntryLine = 51,
            .builderExitLine = 188,
        },
    .wordInSequence = nullptr,
    .pairing = {.outer = End::B, .setsDefaultCurrentNext = true},
    .onFailure =
        {
            .outerUnreadable = endWith0(),
            .outerUnusable = goOn(),
            .innerUnreadable = endWith1(
                "***Can't get DNS Client ObjectPaths.                  Exiting EnumerateInstanceNames***", 103),
            .innerUnusable = endWith1("CMPIObjectPath is NULL for DNS Client", 113),
            .pathUnmade =
                endWith1("Create CMPIObjectPath failed for                         ipHostedAccessPointClass.", 131),
            .instanceUnmade = UnmadeInstance::Append,
        },
};

}  // namespace

IPCONFIG_ASSOCIATION_OPERATIONS(IPConfigElementSettingData_, IPConfigElementSettingDataCMPIInstances, int)

CMInstanceMIStub(IPConfigElementSettingData_, IPConfigElementSettingDataProvider, broker, CMNoHook)
CMAssociationMIStub(IPConfigElementSettingData_, IPConfigElementSettingDataProvider, broker, CMNoHook)

}  // namespace QV::IPConfigComposite
