// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/World.h"

#include <cmpimacs.h>

#include "cimom/broker/Guard.h"
#include "tests/faults/Interposed.h"
#include "tests/faults/Recording.h"
#include "tests/support/broker/Personality.h"
#include "tests/support/composite/ProductSchema.h"

namespace Testing {

namespace {

using Cimom::Instance;
using Cimom::ObjectPath;
using Cimom::Value;

constexpr const char* underlyingNameSpace = "root/yrnse";

void setNumber(Instance& instance, const char* name, CMPIUint16 number) {
  CMPIValue value = {};
  const CMPIType type = instance.definition().findProperty(name)->type;
  if (type == CMPI_uint8) {
    value.uint8 = static_cast<CMPIUint8>(number);
  } else {
    value.uint16 = number;
  }
  instance.set(name, Value::scalar(type, value));
}

}  // namespace

World& world() {
  static World only;
  return only;
}

World::World()
    : broker_(interposedBroker(personal_.broker(), {enumerateInstances, recordTrace, recordFilter})),
      result_(recordingResult()) {
  loadProductSchema(manager_, {"root/cimv2", underlyingNameSpace});
  interpose(result_);
  addSystems();
  addEndpoints();
  addSettings("YRNQV_IPAssignmentSettingData", {"BMC:eth0:static", "Host:eth0:static", "BMC:eth0:dhcp"});
  addSettings("YRNQV_StaticIPAssignmentSettingData", {"BMC:eth0", "BMC:eth0:static", "BMC:eth1"});
  addSettings("YRNQV_DHCPSettingData", {"BMC:eth0", "BMC:eth0:dhcp", "BMC:eth1"});
  addAccessPoints();
  for (const Unit& unit : allUnits()) {
    instanceMis_[unit.file] = unit.createInstanceMI(broker_, nullptr, nullptr);
    associationMis_[unit.file] =
        unit.createAssociationMI ? unit.createAssociationMI(broker_, nullptr, nullptr) : nullptr;
  }
}

CMPIObjectPath* World::path(const Request& request) const {
  const ObjectPath& wanted = request.path;
  CMPIObjectPath* made =
      CMNewObjectPath(personal_.broker(), wanted.nameSpace.c_str(), wanted.className.c_str(), nullptr);
  if (personality().requestHost) {
    CMSetHostname(made, personality().requestHost);
  }
  for (const auto& [name, value] : wanted.keys) {
    const CMPIData key = Cimom::toCmpi(value);
    CMAddKey(made, name.c_str(), &key.value, key.type);
  }
  interpose(made);
  return made;
}

CMPIInstance* World::change(const Request& request) const {
  Instance instance(*manager_.classes().find(request.path.className), request.path);
  if (request.address) {
    instance.set("IPv4Address", Value::string(*request.address));
  }
  if (request.mask) {
    instance.set("SubnetMask", Value::string(*request.mask));
  }
  CMPIInstance* made = Cimom::make(instance);
  interpose(made);
  return made;
}

Instance World::instanceOf(const char* className, const Texts& properties) const {
  Instance instance(*manager_.classes().find(className), ObjectPath{"", underlyingNameSpace, className, {}});
  for (const auto& [name, value] : properties) {
    instance.set(name, Value::string(value));
  }
  return instance;
}

void World::add(Instance instance) {
  std::vector<Value>& ofClass = underlying_[instance.definition().name];
  ofClass.push_back(Value::instance(std::move(instance)));
}

void World::addSystems() {
  Instance system = instanceOf("YRNQV_SPComputerSystem", {{"CreationClassName", "YRNQV_SPComputerSystem"},
                                                          {"Name", "sp1"},
                                                          {"Description", "a processor"},
                                                          {"NameFormat", "Other"}});
  Cimom::Array dedicated{CMPI_uint16, {}};
  for (const CMPIUint16 number : {CMPIUint16(14), CMPIUint16(28)}) {
    CMPIValue value = {};
    value.uint16 = number;
    dedicated.elements.push_back(Value::scalar(CMPI_uint16, value));
  }
  system.set("Dedicated", Value::array(dedicated));
  add(system);
  add(instanceOf("YRNQV_SPComputerSystem", {{"CreationClassName", "YRNQV_SPComputerSystem"}, {"Name", "sp2"}}));
}

void World::addEndpoints() {
  Instance endpoint = instanceOf("YRNQV_IPProtocolEndpoint", {{"SystemCreationClassName", "YRNQV_SPComputerSystem"},
                                                              {"SystemName", "sp1"},
                                                              {"CreationClassName", "YRNQV_IPProtocolEndpoint"},
                                                              {"Name", "eth0"},
                                                              {"NameFormat", "a format"},
                                                              {"ElementName", "an element"},
                                                              {"IPv4Address", "192.0.2.1"},
                                                              {"IPv6Address", "2001:db8::1"},
                                                              {"SubnetMask", "255.255.255.0"}});
  CMPIUint16 number = 1;
  for (const char* name : {"PrefixLength", "AddressType", "IPVersionSupport", "ProtocolIFType", "EnabledState",
                           "RequestedState", "AddressOrigin"}) {
    setNumber(endpoint, name, ++number);
  }
  add(endpoint);
  add(instanceOf("YRNQV_IPProtocolEndpoint",
                 {{"SystemCreationClassName", "YRNQV_Host"}, {"SystemName", "host"}, {"Name", "eth0"}}));
  add(instanceOf("YRNQV_IPProtocolEndpoint",
                 {{"SystemCreationClassName", "YRNQV_SPComputerSystem"}, {"SystemName", "sp1"}, {"Name", "eth1"}}));
}

void World::addSettings(const char* className, const std::vector<const char*>& identifiers) {
  for (const char* identifier : identifiers) {
    Instance setting = instanceOf(className, {{"InstanceID", identifier}, {"ElementName", "a setting"}});
    setNumber(setting, "AddressOrigin", 3);
    add(setting);
  }
}

void World::addAccessPoints() {
  Instance gateway =
      instanceOf("YRNQV_IPRemoteServiceAccessPoint", {{"SystemCreationClassName", "YRNQV_SPComputerSystem"},
                                                      {"SystemName", "sp1"},
                                                      {"CreationClassName", "YRNQV_IPRemoteServiceAccessPoint"},
                                                      {"Name", "Gateway:eth0"},
                                                      {"OtherAccessContext", "a context"},
                                                      {"AccessInfo", "192.0.2.254"}});
  setNumber(gateway, "AccessContext", 2);
  setNumber(gateway, "InfoFormat", 3);
  add(gateway);
  add(instanceOf("YRNQV_IPRemoteServiceAccessPoint",
                 {{"SystemCreationClassName", "YRNQV_Host"}, {"SystemName", "host"}, {"Name", "DNS:1"}}));
  add(instanceOf("YRNQV_IPRemoteServiceAccessPoint",
                 {{"SystemCreationClassName", "YRNQV_SPComputerSystem"}, {"SystemName", "sp1"}, {"Name", "DNS:1"}}));
}

CMPIEnumeration* World::enumerateInstances(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath* path,
                                           const char** properties, CMPIStatus* status) {
  CMPIEnumeration* made = Cimom::guarded(status, static_cast<CMPIEnumeration*>(nullptr), [&] {
    recording().outcome.upCalls.push_back(textOf(path) + (properties ? " with properties" : ""));
    const auto& given = *Cimom::argumentOf<ObjectPath>(path);
    const auto found = world().underlying_.find(given.className);
    if (given.nameSpace != underlyingNameSpace || found == world().underlying_.end()) {
      throw Cimom::StatusError(CMPI_RC_ERR_INVALID_CLASS, "no such class");
    }
    return Cimom::make(Cimom::Enumeration{found->second, 0});
  });
  // Some object managers answer a failure with an enumeration of nothing.
  return made || personality().failedUpCallIsNull ? made : Cimom::make(Cimom::Enumeration{});
}

}  // namespace Testing
