// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/AssociationModel.h"

#include <ostream>
#include <stdexcept>

namespace QV::IPConfigComposite {

unsigned short IPProtocolHostAccessPointCMPIInstances(const CMPIObjectPath*, const char**, const CMPIContext*,
                                                      std::vector<CMPIInstance*>&);
unsigned short IPRemoteHostAccessPointCMPIInstances(const CMPIObjectPath*, const char**, const CMPIContext*,
                                                    std::vector<CMPIInstance*>&);
unsigned short IPConfigClientAccessCMPIInstances(const CMPIObjectPath*, const char**, const CMPIContext*,
                                                 std::vector<CMPIInstance*>&);
int IPConfigElementSettingDataCMPIInstances(const CMPIObjectPath*, const char**, const CMPIContext*,
                                            std::vector<CMPIInstance*>&);
int IPConfigStaticOrderedCMPIInstances(const CMPIObjectPath*, const char**, const CMPIContext*,
                                       std::vector<CMPIInstance*>&);
int IPConfigDHCPOrderedCMPIInstances(const CMPIObjectPath*, const char**, const CMPIContext*,
                                     std::vector<CMPIInstance*>&);

}  // namespace QV::IPConfigComposite

namespace Testing {

namespace {

const Outcome goesOn = {Outcome::Course::GoesOn};
const Outcome succeedsSilently = {Outcome::Course::Ends, 0};
const Outcome failsSilently = {Outcome::Course::Ends, 1};

Outcome succeeds(const std::string& message, int line) { return {Outcome::Course::Ends, 0, message, line}; }
Outcome fails(const std::string& message, int line = 0) { return {Outcome::Course::Ends, 1, message, line}; }

std::string blanks(std::size_t count) { return std::string(count, ' '); }

const Strings systems = {"bmc0", "bmc1", "bmc2"};
const Strings endpoints = {"eth0", "eth1", "eth2"};
const Strings remoteAccessPoints = {"gateway", "dns1", "dns2"};
const Strings settings = {"BMC:eth0", "BMC:eth1", "BMC:eth2"};

AssociationModel hostedAccessPoint() {
  return {
      .className = Classes::hostedAccessPoint,
      .endA = Classes::computerSystem,
      .endB = Classes::endpoint,
      .referenceToA = "Antecedent",
      .referenceToB = "Dependent",
      .pairsByIdentifier = false,
      .builderName = "IPProtocolHostAccessPointCMPIInstances",
      .build = QV::IPConfigComposite::IPProtocolHostAccessPointCMPIInstances,
      .outer = Classes::computerSystem,
      .inner = Classes::endpoint,
      .propertyOfOuter = "Antecedent",
      .propertyOfInner = "Dependent",
      .keysOfPath = "",
      .filterKeys = "Antecedent, Dependent",
      .propertiesSet = {"Antecedent", "Dependent"},
      .outerNames = systems,
      .innerNames = endpoints,
      .entryLine = 0,
      .exitLine = 0,
      .outerFails = succeedsSilently,
      .outerIsUnusable = goesOn,
      .innerFails = fails("***Can't get YRNx_HwIPProtocolEndpoint ObjectPaths." + blanks(18) +
                          "Exiting EnumerateInstanceNames***"),
      .innerIsUnusable = fails("CMPIObjectPath is NULL for DNS Client"),
      .pathFails = fails("Create CMPIObjectPath failed for" + blanks(25) + "ipHostedAccessPointClass."),
      .appendsUnmadeInstance = true,
  };
}

AssociationModel remoteHostedAccessPoint() {
  AssociationModel model = hostedAccessPoint();
  model.className = Classes::remoteHostedAccessPoint;
  model.endB = Classes::remoteAccessPoint;
  model.builderName = "IPRemoteHostAccessPointCMPIInstances";
  model.build = QV::IPConfigComposite::IPRemoteHostAccessPointCMPIInstances;
  model.inner = Classes::remoteAccessPoint;
  model.innerNames = remoteAccessPoints;
  model.innerFails = fails("***Can't get" + blanks(2) + "YRNx_HwIPRemoteServiceAccessPoint ObjectPaths." + blanks(18) +
                           "Exiting EnumerateInstanceNames***");
  model.pathFails =
      fails("Create CMPIObjectPath failed for" + blanks(25) + "CLASS_MGMT_HW_IP_REMOTE_HOSTED_ACCESS_POINT.");
  return model;
}

AssociationModel clientAccess() {
  return {
      .className = Classes::clientAccess,
      .endA = Classes::remoteAccessPoint,
      .endB = Classes::endpoint,
      .referenceToA = "Antecedent",
      .referenceToB = "Dependent",
      .pairsByIdentifier = false,
      .builderName = "IPConfigClientAccessCMPIInstances",
      .build = QV::IPConfigComposite::IPConfigClientAccessCMPIInstances,
      .outer = Classes::endpoint,
      .inner = Classes::remoteAccessPoint,
      .propertyOfOuter = "Dependent",
      .propertyOfInner = "Antecedent",
      .keysOfPath = "Antecedent, Dependent",
      .filterKeys = "Antecedent, Dependent",
      .propertiesSet = {"Antecedent", "Dependent"},
      .outerNames = endpoints,
      .innerNames = remoteAccessPoints,
      .entryLine = 0,
      .exitLine = 0,
      .outerFails = succeedsSilently,
      .outerIsUnusable = goesOn,
      .innerFails = fails("***Can't get CLASS_MGMT_HW_REMOTE_SERVICE_ACCESS_POINT ObjectPaths." + blanks(18) +
                          "Exiting EnumerateInstanceNames***"),
      .innerIsUnusable = fails("CMPIObjectPath is NULL for RemoteSAP"),
      .pathFails = fails("Create CMPIObjectPath failed for" + blanks(25) + "CLASS_MGMT_HW_IP_CLIENT_ACCESS."),
      .appendsUnmadeInstance = false,
  };
}

AssociationModel elementSettingData() {
  return {
      .className = Classes::elementSettingData,
      .endA = Classes::sequence,
      .endB = Classes::endpoint,
      .referenceToA = "Antecedent",
      .referenceToB = "Dependent",
      .pairsByIdentifier = false,
      .builderName = "IPConfigElementSettingDataCMPIInstances",
      .build = QV::IPConfigComposite::IPConfigElementSettingDataCMPIInstances,
      .outer = Classes::endpoint,
      .inner = Classes::sequence,
      .propertyOfOuter = "ManagedElement",
      .propertyOfInner = "SettingData",
      .keysOfPath = "",
      .filterKeys = "ManagedElement, SettingData",
      .propertiesSet = {"ManagedElement", "SettingData", "IsDefault", "IsCurrent", "IsNext"},
      .outerNames = endpoints,
      .innerNames = {"BMC:eth0:static", "BMC:eth0:dhcp", "BMC:eth1:other"},
      .entryLine = 51,
      .exitLine = 188,
      .outerFails = succeedsSilently,
      .outerIsUnusable = goesOn,
      .innerFails =
          fails("***Can't get DNS Client ObjectPaths." + blanks(18) + "Exiting EnumerateInstanceNames***", 103),
      .innerIsUnusable = fails("CMPIObjectPath is NULL for DNS Client", 113),
      .pathFails = fails("Create CMPIObjectPath failed for" + blanks(25) + "ipHostedAccessPointClass.", 131),
      .appendsUnmadeInstance = true,
  };
}

AssociationModel staticOrderedMember() {
  return {
      .className = Classes::staticOrderedMember,
      .endA = Classes::sequence,
      .endB = Classes::staticSetting,
      .referenceToA = "GroupComponent",
      .referenceToB = "PartComponent",
      .pairsByIdentifier = true,
      .builderName = "IPConfigStaticOrderedCMPIInstances",
      .build = QV::IPConfigComposite::IPConfigStaticOrderedCMPIInstances,
      .outer = Classes::staticSetting,
      .inner = Classes::sequence,
      .propertyOfOuter = "PartComponent",
      .propertyOfInner = "GroupComponent",
      .keysOfPath = "",
      .filterKeys = "GroupComponent, PartComponent",
      .propertiesSet = {"GroupComponent", "PartComponent"},
      .outerNames = settings,
      .innerNames = {"BMC:eth0:static", "BMC:eth1:static", "BMC:eth2:static"},
      .entryLine = 51,
      .exitLine = 161,
      .outerFails = failsSilently,
      .outerIsUnusable = fails("Fail to get the PartComponent Instances", 83),
      .innerFails = succeeds("Failed to get the GroupComponent Instance", 110),
      .innerIsUnusable = fails("NULL Object of GroupComponent", 120),
      .pathFails = goesOn,
      .appendsUnmadeInstance = false,
  };
}

AssociationModel dhcpOrderedMember() {
  AssociationModel model = staticOrderedMember();
  model.className = Classes::dhcpOrderedMember;
  model.endB = Classes::dhcpSetting;
  model.builderName = "IPConfigDHCPOrderedCMPIInstances";
  model.build = QV::IPConfigComposite::IPConfigDHCPOrderedCMPIInstances;
  model.outer = Classes::dhcpSetting;
  model.innerNames = {"BMC:eth0:dhcp", "BMC:eth1:dhcp", "BMC:eth2:dhcp"};
  model.exitLine = 162;
  model.outerFails = fails("***Can't get CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATAObjectPaths." + blanks(6) +
                               "Exiting EnumerateInstanceNames***",
                           68);
  model.outerIsUnusable = goesOn;
  model.innerFails = succeedsSilently;
  model.innerIsUnusable = fails("CMPIObjectPath is NULL for CLASS_MGMT_HW_DHCP_ASSIGNMENT_SETTING_DATA", 110);
  model.pathFails =
      fails("Create CMPIObjectPath failed for" + blanks(29) + "CLASS_MGMT_HW_DHCP_ORDER_MEM_OF_COLLECTION.", 135);
  model.appendsUnmadeInstance = true;
  return model;
}

}  // namespace

const std::vector<AssociationModel>& associationModels() {
  static const std::vector<AssociationModel> models = {hostedAccessPoint(),   remoteHostedAccessPoint(),
                                                       clientAccess(),        elementSettingData(),
                                                       staticOrderedMember(), dhcpOrderedMember()};
  return models;
}

const AssociationModel& modelOf(const std::string& className) {
  for (const AssociationModel& model : associationModels()) {
    if (model.className == className) {
      return model;
    }
  }
  throw std::invalid_argument("no association is called " + className);
}

std::vector<AssociationParameter> associationParameters() {
  std::vector<AssociationParameter> parameters;
  for (const AssociationModel& model : associationModels()) {
    parameters.push_back({&model});
  }
  return parameters;
}

std::ostream& operator<<(std::ostream& stream, const AssociationParameter& parameter) {
  return stream << parameter.model->className;
}

}  // namespace Testing
