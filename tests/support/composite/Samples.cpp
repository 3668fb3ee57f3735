// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/Samples.h"

#include <stdexcept>

namespace Testing {

const std::vector<Sample>& samples() {
  static const std::vector<std::string> accessPointKeys = {"SystemCreationClassName", "SystemName", "CreationClassName",
                                                           "Name"};
  static const std::vector<Sample> all = {
      {Classes::computerSystem,
       "YRNQV_SPComputerSystem",
       "getAllSPComputerCMPIInstances",
       "makeSPComputerInstance",
       {"CreationClassName", "Name"}},
      {Classes::endpoint, "YRNQV_IPProtocolEndpoint", "getAllIPProtocolendptCMPIInstances",
       "makeIPProtocolEndptInstance", accessPointKeys},
      {Classes::sequence,
       "YRNQV_IPAssignmentSettingData",
       "getAllIPAssignmentSettingCMPIInstances",
       "makeIPAssignmentSettingInstance",
       {"InstanceID"}},
      {Classes::staticSetting,
       "YRNQV_StaticIPAssignmentSettingData",
       "getAllStaticIPAssignmentSettingCMPIInstances",
       "makeStaticIPAssignmentSettingInstance",
       {"InstanceID"}},
      {Classes::dhcpSetting,
       "YRNQV_DHCPSettingData",
       "getAllDHCPAssignmentSettingCMPIInstances",
       "makeDHCPAssignmentSettingInstance",
       {"InstanceID"}},
      {Classes::remoteAccessPoint, "YRNQV_IPRemoteServiceAccessPoint", "getAllIPRemoteSAPCMPIInstances",
       "makeIPRemoteSAPInstance", accessPointKeys},
  };
  return all;
}

const Sample& sampleOf(const std::string& className) {
  for (const Sample& sample : samples()) {
    if (sample.className == className) {
      return sample;
    }
  }
  throw std::invalid_argument("no sample of " + className);
}

Properties acceptable(const Sample& sample, int n) {
  const std::string number = std::to_string(n);
  if (sample.keys.size() == 1) {
    const bool sequence = sample.className == Classes::sequence;
    return {{"InstanceID", "BMC:eth" + number + (sequence ? ":static" : "")},
            {"ElementName", "setting " + number},
            {"AddressOrigin", CMPIUint16(3)}};
  }
  if (sample.keys.size() == 2) {
    return {{"CreationClassName", sample.underlying},
            {"Name", "sp" + number},
            {"Description", "processor " + number},
            {"NameFormat", "Other"},
            {"Dedicated", std::vector<CMPIUint16>{14, 28}}};
  }
  return {{"SystemCreationClassName", "YRNQV_SPComputerSystem"},
          {"SystemName", "sp1"},
          {"CreationClassName", sample.underlying},
          {"Name", "point" + number}};
}

std::vector<std::pair<std::string, std::string>> keysOf(const Sample& sample, int n) {
  const std::string number = std::to_string(n);
  if (sample.keys.size() == 1) {
    return {{"InstanceID", std::get<std::string>(acceptable(sample, n).front().second)}};
  }
  if (sample.keys.size() == 2) {
    return {{"CreationClassName", sample.className}, {"Name", "sp" + number}};
  }
  const bool remote = sample.className == Classes::remoteAccessPoint;
  return {{"SystemCreationClassName", Classes::computerSystem},
          {"SystemName", "sp1"},
          {"CreationClassName", remote ? "YRNx_RemoteAccessPoint" : sample.className},
          {"Name", "point" + number}};
}

}  // namespace Testing
