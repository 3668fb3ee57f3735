// SPDX-License-Identifier: Apache-2.0
// The composite's objects as wbemcli prints and takes them, without host and namespace: keys in the schema's order.
#pragma once

#include <string>

namespace Testing {

inline std::string quoted(const std::string& text) { return '"' + text + '"'; }

inline std::string computerSystem() {
  return R"(YRNx_MgmtHwComputerSystem.Name="BMC",CreationClassName="YRNx_MgmtHwComputerSystem")";
}

inline std::string accessPointObject(const std::string& className, const std::string& name,
                                     const std::string& creationClassName) {
  return className + ".Name=" + quoted(name) +
         R"(,SystemCreationClassName="YRNx_MgmtHwComputerSystem",SystemName="BMC",CreationClassName=)" +
         quoted(creationClassName);
}

inline std::string endpoint(const std::string& interface) {
  return accessPointObject("YRNx_MgmtHwIPProtocolEndPoint", interface, "YRNx_MgmtHwIPProtocolEndPoint");
}

// Its CreationClassName is not the class's name.
inline std::string remoteAccessPoint(const std::string& name) {
  return accessPointObject("YRNx_MgmtHwRemoteServiceAccessPoint", name, "YRNx_RemoteAccessPoint");
}

// @param id the interface and the kind: "eth0:static"
inline std::string sequence(const std::string& id) {
  return "YRNx_MgmtHwIPAssignmentSettingSequence.InstanceID=" + quoted("BMC:" + id);
}

inline std::string staticSetting(const std::string& interface) {
  return "YRNx_MgmtHwStaticIPAssignmentSettingData.InstanceID=" + quoted("BMC:" + interface);
}

inline std::string dhcpSetting(const std::string& interface) {
  return "YRNx_MgmtHwDHCPAssignmentSettingData.InstanceID=" + quoted("BMC:" + interface);
}

}  // namespace Testing
