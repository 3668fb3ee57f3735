#include "agent/underlying/ClassTable.h"

#include <QV/ProviderHelper.h>

#include <iterator>

#include "agent/backends/SharedBackEnd.h"
#include "agent/config/AgentConfiguration.h"
#include "agent/underlying/Host.h"

namespace QV {
namespace {

constexpr std::array<const char*, 5> systemKeys = {"CreationClassName", "Name"};
constexpr std::array<const char*, 5> settingKeys = {"InstanceID"};
constexpr std::array<const char*, 5> accessPointKeys = {"SystemCreationClassName", "SystemName", "CreationClassName",
                                                        "Name"};

constexpr UnderlyingClass classes[] = {
    {"YRNQV_SPComputerSystem", systemKeys, computerSystem, false},
    {"YRNQV_IPProtocolEndpoint", accessPointKeys, protocolEndpoints, true},
    {"YRNQV_IPAssignmentSettingData", settingKeys, assignmentSettings, true},
    {"YRNQV_StaticIPAssignmentSettingData", settingKeys, staticSettings, true},
    {"YRNQV_DHCPSettingData", settingKeys, dhcpSettings, true},
    {"YRNQV_IPRemoteServiceAccessPoint", accessPointKeys, remoteAccessPoints, true},
};

}  // namespace

const UnderlyingClass* findUnderlyingClass(const char* name) {
  for (const UnderlyingClass& candidate : classes) {
    if (textEqual(candidate.name, name)) {
      return &candidate;
    }
  }
  return nullptr;
}

namespace {

// Who may ask for the processor need not learn the host's own network. Read once, as all of agent.ini.
bool publishesHost() {
  static const bool publishes = readAgentConfiguration().publishesHost;
  return publishes;
}

}  // namespace

Instances readInstances(const UnderlyingClass& underlyingClass) {
  Instances instances = underlyingClass.build({"YRNQV_SPComputerSystem", "BMC", sharedBackEnd()->read()});
  if (underlyingClass.ofHostToo && publishesHost()) {
    Instances ofHost = underlyingClass.build({"YRNQV_ComputerSystem", "Host", readHost()});
    instances.insert(instances.end(), std::make_move_iterator(ofHost.begin()), std::make_move_iterator(ofHost.end()));
  }
  return instances;
}

}  // namespace QV
