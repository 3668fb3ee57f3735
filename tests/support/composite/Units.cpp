// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/Units.h"

#include <stdexcept>

extern "C" {
Testing::CreateInstanceMI CompositeIPConfigProvider_Create_InstanceMI;
Testing::CreateInstanceMI IPConfigAssignmentSettingProvider_Create_InstanceMI;
Testing::CreateInstanceMI IPConfigStaticAssnSettingDataProvider_Create_InstanceMI;
Testing::CreateInstanceMI IPProtocolendptProvider_Create_InstanceMI;
Testing::CreateInstanceMI IPConfigDHCPAssnSettingDataProvider_Create_InstanceMI;
Testing::CreateInstanceMI IPRemoteServiceAccessPointProvider_Create_InstanceMI;
Testing::CreateInstanceMI IPProtocolHostedAccessPointProvider_Create_InstanceMI;
Testing::CreateAssociationMI IPProtocolHostedAccessPointProvider_Create_AssociationMI;
Testing::CreateInstanceMI IPRemoteHostedAccessPointProvider_Create_InstanceMI;
Testing::CreateAssociationMI IPRemoteHostedAccessPointProvider_Create_AssociationMI;
Testing::CreateInstanceMI IPConfigClientAccessProvider_Create_InstanceMI;
Testing::CreateAssociationMI IPConfigClientAccessProvider_Create_AssociationMI;
Testing::CreateInstanceMI IPConfigElementSettingDataProvider_Create_InstanceMI;
Testing::CreateAssociationMI IPConfigElementSettingDataProvider_Create_AssociationMI;
Testing::CreateInstanceMI IPConfigStaticOrderedMembetOfCollProvider_Create_InstanceMI;
Testing::CreateAssociationMI IPConfigStaticOrderedMembetOfCollProvider_Create_AssociationMI;
Testing::CreateInstanceMI IPConfigDHCPOrderedMembetOfCollProvider_Create_InstanceMI;
Testing::CreateAssociationMI IPConfigDHCPOrderedMembetOfCollProvider_Create_AssociationMI;
}

namespace Testing {

const std::vector<Unit>& instanceUnits() {
  static const std::vector<Unit> units = {
      {"CompositeIPConfig_", "IPConfigProvider", "Tarnwick.IPConfigProvider", "CompositeIPConfigProvider",
       Classes::computerSystem, CompositeIPConfigProvider_Create_InstanceMI, nullptr, false},
      {"IPConfigAssnSettingData_", "IPConfigAssignmentSettingDataProvider",
       "Tarnwick.IPConfigAssignmentSettingProvider", "IPConfigAssignmentSettingProvider", Classes::sequence,
       IPConfigAssignmentSettingProvider_Create_InstanceMI, nullptr, false},
      {"IPConfigStaticAssnSettingData_", "IPConfigStaticAssignmentSettingProvider",
       "Tarnwick.IPConfigStaticAssnSettingProvider", "IPConfigStaticAssnSettingDataProvider", Classes::staticSetting,
       IPConfigStaticAssnSettingDataProvider_Create_InstanceMI, nullptr, true},
      {"IPProtocolendpt_", "IPProtocolEndpointProvider", "Tarnwick.IPProtocolEndpointProvider",
       "IPProtocolendptProvider", Classes::endpoint, IPProtocolendptProvider_Create_InstanceMI, nullptr, true},
      {"IPConfigDHCPAssnSettingData_", "IPConfigDHCPAssignmentSettingDataProvider",
       "Tarnwick.IPConfigDHCPAssnSettingDataProvider", "IPConfigDHCPAssnSettingDataProvider", Classes::dhcpSetting,
       IPConfigDHCPAssnSettingDataProvider_Create_InstanceMI, nullptr, false},
      {"IPRemoteSAP_", "IPRemoteServiceAccessPoint", "Tarnwick.IPRemoteServiceAccessPointProvider",
       "IPRemoteServiceAccessPointProvider", Classes::remoteAccessPoint,
       IPRemoteServiceAccessPointProvider_Create_InstanceMI, nullptr, true},
  };
  return units;
}

const std::vector<Unit>& associationUnits() {
  static const std::vector<Unit> units = {
      {"IPProtocolHostedAccessPoint_", "IPProtocolHostedAccessPointProvider",
       "Tarnwick.IPProtocolHostedAccessPointProvider", "IPProtocolHostedAccessPointProvider",
       Classes::hostedAccessPoint, IPProtocolHostedAccessPointProvider_Create_InstanceMI,
       IPProtocolHostedAccessPointProvider_Create_AssociationMI, false},
      {"IPRemoteHostedAccessPoint_", "IPRemoteHostedAccessPointProvider", "Tarnwick.IPRemoteHostedAccessPointProvider",
       "IPRemoteHostedAccessPointProvider", Classes::remoteHostedAccessPoint,
       IPRemoteHostedAccessPointProvider_Create_InstanceMI, IPRemoteHostedAccessPointProvider_Create_AssociationMI,
       false},
      {"IPConfigClientAccess_", "IPConfigClientAccessProvider", "Tarnwick.IPConfigClientAccessProvider",
       "IPConfigClientAccessProvider", Classes::clientAccess, IPConfigClientAccessProvider_Create_InstanceMI,
       IPConfigClientAccessProvider_Create_AssociationMI, false},
      {"IPConfigElementSettingData_", "IPConfigElementSettingDataProvider",
       "Tarnwick.IPConfigElementSettingDataProvider", "IPConfigElementSettingDataProvider", Classes::elementSettingData,
       IPConfigElementSettingDataProvider_Create_InstanceMI, IPConfigElementSettingDataProvider_Create_AssociationMI,
       false},
      {"IPConfigStaticOrdered_", "IPConfigStaticOrderedMemberOfCollection",
       "Tarnwick.IPConfigStaticOrderedMembetOfCollProvider", "IPConfigStaticOrderedMembetOfCollProvider",
       Classes::staticOrderedMember, IPConfigStaticOrderedMembetOfCollProvider_Create_InstanceMI,
       IPConfigStaticOrderedMembetOfCollProvider_Create_AssociationMI, false},
      {"IPConfigDHCPOrdered_", "IPConfigDHCPOrderedMemberOfCollection",
       "Tarnwick.IPConfigDHCPOrderedMembetOfCollProvider", "IPConfigDHCPOrderedMembetOfCollProvider",
       Classes::dhcpOrderedMember, IPConfigDHCPOrderedMembetOfCollProvider_Create_InstanceMI,
       IPConfigDHCPOrderedMembetOfCollProvider_Create_AssociationMI, false},
  };
  return units;
}

std::vector<Unit> allUnits() {
  std::vector<Unit> units = instanceUnits();
  units.insert(units.end(), associationUnits().begin(), associationUnits().end());
  return units;
}

const Unit& unitOf(const std::string& className) {
  for (const std::vector<Unit>* units : {&instanceUnits(), &associationUnits()}) {
    for (const Unit& unit : *units) {
      if (unit.className == className) {
        return unit;
      }
    }
  }
  throw std::invalid_argument("no unit serves " + className);
}

}  // namespace Testing
