// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Run.h"

#include <cmpimacs.h>

#include <exception>
#include <map>
#include <memory>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/broker/Guard.h"
#include "cimom/broker/RequestScope.h"
#include "tests/faults/Agent.h"
#include "tests/faults/Allocations.h"
#include "tests/faults/Interposed.h"
#include "tests/faults/Model.h"

namespace Testing {

namespace {

using Cimom::Instance;
using Cimom::ObjectPath;
using Cimom::Value;

constexpr const char* underlyingNameSpace = "root/yrnse";

// The run under way.
struct Running {
  Outcome* outcome = nullptr;
  std::map<const CMPIInstance*, std::string> filters;  // that the library has set
};
Running running;

// What the result is handed, as it is at that moment.

std::string shown(const Value& value) {
  if (const Cimom::Array* array = value.elements()) {
    std::string text = "{";
    for (const Value& element : array->elements) {
      text += ' ' + element.toString();
    }
    return text + " }";
  }
  return value.isNull() ? "null" : std::to_string(value.type()) + ':' + value.toString();
}

std::string shown(const CMPIObjectPath* path) {
  if (!path || !path->hdl) {
    return path ? "path without handle" : "null path";
  }
  return "path " + Cimom::modelOf<ObjectPath>(path).toString();
}

std::string shown(const CMPIInstance* instance) {
  if (!instance || !instance->hdl) {
    return instance ? "instance without handle" : "null instance";
  }
  const auto& model = Cimom::modelOf<Instance>(instance);
  std::string text = "instance " + model.path().toString();
  for (std::size_t i = 0; i < model.size(); ++i) {
    if (!model[i].isNull()) {
      text += "; " + model.definition().properties[i].name + '=' + shown(model[i]);
    }
  }
  const auto filter = running.filters.find(instance);
  return text + "; filter " + (filter == running.filters.end() ? "none" : filter->second);
}

CMPIStatus returnInstance(const CMPIResult*, const CMPIInstance* instance) {
  running.outcome->answered.push_back(shown(instance));
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnObjectPath(const CMPIResult*, const CMPIObjectPath* path) {
  running.outcome->answered.push_back(shown(path));
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnDone(const CMPIResult*) {
  running.outcome->answered.push_back("done");
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnData(const CMPIResult*, const CMPIValue*, const CMPIType) {
  running.outcome->answered.push_back("data");
  return {CMPI_RC_OK, nullptr};
}
CMPIStatus returnError(const CMPIResult*, const CMPIError*) {
  running.outcome->answered.push_back("error");
  return {CMPI_RC_OK, nullptr};
}

std::string listed(const char** names) {
  std::string text = names ? "(" : "null";
  for (; names && *names; ++names) {
    text += std::string(*names) + ' ';
  }
  return text;
}

void filtered(const CMPIInstance* instance, const char** properties, const char** keys) {
  running.filters[instance] = listed(properties) + " keys " + listed(keys);
}

// The object manager and what it serves in root/yrnse

std::string everyClassIn(const std::string& nameSpace) {
  std::string mof = "#pragma namespace(\"" + nameSpace + "\")\n";
  for (const char* file : {"CIM_Subset", "CompositeIPConfig", "UnderlyingIPConfig"}) {
    mof += "#pragma include(\"" SOURCE_DIR "/schema/" + std::string(file) + ".mof\")\n";
  }
  return mof;
}

class World {
 public:
  World() {
    for (const char* nameSpace : {"root/cimv2", underlyingNameSpace}) {
      manager_.loadSchemaText(everyClassIn(nameSpace), nameSpace);
    }
    manager_.setTrace([](int level, std::string_view component, std::string_view text) {
      running.outcome->brokerTrace.push_back(std::to_string(level) + ' ' + std::string(component) + ": " +
                                             std::string(text));
    });
    broker = interposedBroker(manager_.broker(), enumerateInstances, filtered);
    addInstances();
    for (const Unit& unit : allUnits()) {
      if (unit.createAssociationMI) {
        associationMIs[unit.file] = unit.createAssociationMI(broker, nullptr, nullptr);
      }
      instances[unit.file] = unit.createInstanceMI(broker, nullptr, nullptr);
    }
    result_ = {this, &resultTable_};
    interpose(&result_);
  }

  const CMPIResult* result() const { return &result_; }

  // An instance of a composite class as a client sends it to be changed.
  CMPIInstance* change(const Request& request) const {
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

  const CMPIBroker* broker;
  std::map<std::string, CMPIInstanceMI*> instances;
  std::map<std::string, CMPIAssociationMI*> associationMIs;
  std::map<std::string, std::vector<Value>> underlying;

 private:
  static CMPIEnumeration* enumerateInstances(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**,
                                             CMPIStatus*);

  using Texts = std::vector<std::pair<const char*, const char*>>;

  Instance instanceOf(const char* className, const Texts& properties) const {
    Instance instance(*manager_.classes().find(className), ObjectPath{"", underlyingNameSpace, className, {}});
    for (const auto& [name, value] : properties) {
      instance.set(name, Value::string(value));
    }
    return instance;
  }

  static void setNumber(Instance& instance, const char* name, CMPIUint16 number) {
    CMPIValue value = {};
    const CMPIType type = instance.definition().findProperty(name)->type;
    if (type == CMPI_uint8) {
      value.uint8 = static_cast<CMPIUint8>(number);
    } else {
      value.uint16 = number;
    }
    instance.set(name, Value::scalar(type, value));
  }

  void add(Instance instance) {
    underlying[instance.definition().name].push_back(Value::instance(std::move(instance)));
  }

  void addSetting(const char* className, const char* identifier) {
    Instance setting = instanceOf(className, {{"InstanceID", identifier}, {"ElementName", "a setting"}});
    setNumber(setting, "AddressOrigin", 3);
    add(setting);
  }

  void addInstances() {
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

    for (const char* identifier : {"BMC:eth0:static", "Host:eth0:static", "BMC:eth0:dhcp"}) {
      addSetting("YRNQV_IPAssignmentSettingData", identifier);
    }
    for (const char* identifier : {"BMC:eth0", "BMC:eth0:static", "BMC:eth1"}) {
      addSetting("YRNQV_StaticIPAssignmentSettingData", identifier);
      addSetting("YRNQV_DHCPSettingData", identifier);
    }

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

  Cimom::ObjectManager manager_;
  CMPIResultFT resultTable_ = {CMPICurrentVersion, nullptr,          nullptr,    returnData,
                               returnInstance,     returnObjectPath, returnDone, returnError};
  CMPIResult result_;
};

World& world() {
  static World only;
  return only;
}

CMPIEnumeration* World::enumerateInstances(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath* path,
                                           const char** properties, CMPIStatus* status) {
  return Cimom::guarded(status, static_cast<CMPIEnumeration*>(nullptr), [&] {
    running.outcome->upCalls.push_back(shown(path) + (properties ? " with properties" : ""));
    const auto& given = Cimom::argumentOf<ObjectPath>(path);
    const auto found = world().underlying.find(given.className);
    if (given.nameSpace != underlyingNameSpace || found == world().underlying.end()) {
      throw Cimom::StatusError(CMPI_RC_ERR_INVALID_CLASS, "no such class");
    }
    return Cimom::make(Cimom::Enumeration{found->second, 0});
  });
}

// The request's own objects, for the time of a run.
struct Objects {
  Cimom::RequestScope scope{world().broker};
  CMPIObjectPath* path;
  CMPIInstance* instance = nullptr;
  CMPIContext* context = scope.context();
  std::vector<const char*> properties;

  explicit Objects(const Request& request)
      : path(Cimom::make(request.path)), properties(request.properties.value_or(std::vector<const char*>{})) {
    interpose(path);
    interpose(context);
    calls().know(path, "the request's path");
    calls().know(context, "the context");
    calls().know(world().result(), "the result");
    calls().know(world().broker, "the broker");
    if (request.operation == Operation::ModifyInstance && request.hasInstance) {
      instance = world().change(request);
      calls().know(instance, "the client's instance");
    }
  }

  const char** list() { return properties.empty() ? nullptr : properties.data(); }
};

CMPIStatus callProduct(const Request& request, Objects& objects) {
  CMPIInstanceMI* mi = world().instances.at(request.unit->file);
  const auto association = world().associationMIs.find(request.unit->file);
  CMPIAssociationMI* ami = association == world().associationMIs.end() ? nullptr : association->second;
  const CMPIResult* result = world().result();
  switch (request.operation) {
    case Operation::EnumInstanceNames:
      return mi->ft->enumerateInstanceNames(mi, objects.context, result, objects.path);
    case Operation::EnumInstances:
      return mi->ft->enumerateInstances(mi, objects.context, result, objects.path, objects.list());
    case Operation::GetInstance:
      return mi->ft->getInstance(mi, objects.context, result, objects.path, objects.list());
    case Operation::ModifyInstance:
      return mi->ft->modifyInstance(mi, objects.context, result, objects.path, objects.instance, objects.list());
    case Operation::CreateInstance:
      return mi->ft->createInstance(mi, objects.context, result, objects.path, objects.instance);
    case Operation::DeleteInstance:
      return mi->ft->deleteInstance(mi, objects.context, result, objects.path);
    case Operation::ExecQuery:
      return mi->ft->execQuery(mi, objects.context, result, objects.path, "SELECT * FROM X", "WQL");
    case Operation::Cleanup:
      return mi->ft->cleanup(mi, objects.context, 1);
    case Operation::Associators:
      return ami->ft->associators(ami, objects.context, result, objects.path, request.associationClass,
                                  request.resultClass, request.role, request.resultRole, objects.list());
    case Operation::AssociatorNames:
      return ami->ft->associatorNames(ami, objects.context, result, objects.path, request.associationClass,
                                      request.resultClass, request.role, request.resultRole);
    case Operation::References:
      return ami->ft->references(ami, objects.context, result, objects.path, request.resultClass, request.role,
                                 objects.list());
    case Operation::ReferenceNames:
      return ami->ft->referenceNames(ami, objects.context, result, objects.path, request.resultClass, request.role);
    case Operation::AssociationCleanup:
      return ami->ft->cleanup(ami, objects.context, 1);
  }
  return {CMPI_RC_ERR_FAILED, nullptr};
}

CMPIStatus call(Who who, const Request& request, Objects& objects) {
  if (who == Who::Product) {
    const CountedAllocations ofTheLibrary;
    return callProduct(request, objects);
  }
  return answerOfModel(
      request, {world().broker, objects.context, world().result(), objects.path, objects.instance, objects.list()});
}

std::string shown(const CMPIStatus& status) {
  const char* message = status.msg && status.msg->hdl ? static_cast<const char*>(status.msg->hdl) : nullptr;
  return std::to_string(status.rc) + (message ? std::string(" \"") + message + '"' : "");
}

RunResult carryOut(Who who, const Request& request) {
  RunResult result;
  running = {&result.outcome, {}};
  agent() = {request.nodes, &result.outcome};
  Objects objects(request);
  const long before = libraryBlocks();
  try {
    result.outcome.status = shown(call(who, request, objects));
  } catch (const std::exception& exception) {
    result.outcome.status = std::string("throws ") + exception.what();
  } catch (int) {
    result.outcome.status = "throws an int";
  }
  result.leaked = libraryBlocks() - before;
  result.fired = calls().fired();
  result.violations = calls().violations();
  return result;
}

}  // namespace

RunResult run(Who who, const Request& request, CallKey key, Fault fault) {
  world();
  calls().begin(key, fault);
  return carryOut(who, request);
}

std::vector<RecordedCall> record(Who who, const Request& request, RunResult* result) {
  world();
  calls().beginRecording();
  RunResult made = carryOut(who, request);
  if (result) {
    *result = std::move(made);
  }
  return calls().recorded();
}

}  // namespace Testing
