#include "Faults.h"

#include <memory>

namespace Testing {

namespace {

FaultyBroker* current = nullptr;

// An enumeration over a script's instances.
struct ScriptedEnumeration {
  CMPIEnumeration base;
  std::vector<CMPIInstance*> instances;
  std::size_t position = 0;
};

ScriptedEnumeration& scripted(const CMPIEnumeration* enumeration) {
  return *static_cast<ScriptedEnumeration*>(enumeration->hdl);
}

void set(CMPIStatus* status, CMPIrc rc) {
  if (status != nullptr) {
    *status = {rc, nullptr};
  }
}

CMPIBoolean hasNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  set(status, CMPI_RC_OK);
  return scripted(enumeration).position < scripted(enumeration).instances.size();
}

CMPIData getNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  set(status, CMPI_RC_OK);
  CMPIData data = {CMPI_instance, CMPI_goodValue, {}};
  data.value.inst = scripted(enumeration).instances.at(scripted(enumeration).position++);
  return data;
}

CMPIEnumerationFT enumerationTable = {CMPICurrentVersion, nullptr, nullptr, getNext, hasNext, nullptr};

std::vector<std::unique_ptr<ScriptedEnumeration>>& enumerations() {
  static std::vector<std::unique_ptr<ScriptedEnumeration>> made;
  return made;
}

std::string text(const CMPIString* string) {
  const char* const characters = string == nullptr ? nullptr : CMGetCharsPtr(string, nullptr);
  return characters == nullptr ? "" : characters;
}

}  // namespace

FaultyBroker::FaultyBroker(const CMPIBroker* real)
    : real_(real), broker_(*real), upCallTable_(*real->bft), encapsulation_(*real->eft) {
  upCallTable_.enumerateInstances = enumerateInstances;
  encapsulation_.newObjectPath = newObjectPath;
  encapsulation_.newInstance = newInstance;
  encapsulation_.newArray = newArray;
  encapsulation_.newString = newString;
  encapsulation_.trace = trace;
  broker_.bft = &upCallTable_;
  broker_.eft = &encapsulation_;
  current = this;
}

FaultyBroker::~FaultyBroker() {
  enumerations().clear();
  current = nullptr;
}

CMPIEnumeration* FaultyBroker::enumerateInstances(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath* path,
                                                  const char** properties, CMPIStatus* status) {
  const UpCall call = {text(CMGetNameSpace(path, nullptr)), text(CMGetClassName(path, nullptr)), properties != nullptr};
  current->upCalls.push_back(call);
  if (current->onUpCall) {
    current->onUpCall(call);
  }
  const UpCallScript& script = current->upCallScripts[call.className];
  if (status != nullptr) {
    *status = script.status;
  }
  if (script.nullEnumeration) {
    return nullptr;
  }
  auto enumeration = std::make_unique<ScriptedEnumeration>();
  enumeration->base = {enumeration.get(), &enumerationTable};
  enumeration->instances = script.instances;
  enumerations().push_back(std::move(enumeration));
  return &enumerations().back()->base;
}

CMPIObjectPath* FaultyBroker::newObjectPath(const CMPIBroker*, const char* nameSpace, const char* className,
                                            CMPIStatus* status) {
  const int call = ++current->newObjectPathCalls_[className];
  if (current->failNewObjectPath && current->failNewObjectPath(className, call)) {
    set(status, CMPI_RC_ERR_FAILED);
    return nullptr;
  }
  return CMNewObjectPath(current->real_, nameSpace, className, status);
}

CMPIInstance* FaultyBroker::newInstance(const CMPIBroker*, const CMPIObjectPath* path, CMPIStatus* status) {
  const std::string className = text(CMGetClassName(path, nullptr));
  const int call = ++current->newInstanceCalls_[className];
  if (current->failNewInstance && current->failNewInstance(className, call)) {
    set(status, CMPI_RC_ERR_FAILED);
    return nullptr;
  }
  return CMNewInstance(current->real_, path, status);
}

CMPIArray* FaultyBroker::newArray(const CMPIBroker*, CMPICount count, CMPIType type, CMPIStatus* status) {
  if (current->failNewArray) {
    set(status, CMPI_RC_ERROR_SYSTEM);
    return nullptr;
  }
  return CMNewArray(current->real_, count, type, status);
}

CMPIString* FaultyBroker::newString(const CMPIBroker*, const char* characters, CMPIStatus* status) {
  current->strings.push_back(characters);
  return CMNewString(current->real_, characters, status);
}

CMPIStatus FaultyBroker::trace(const CMPIBroker*, int level, const char* component, const char* message,
                               const CMPIString* string) {
  current->traces.push_back({level, component, string == nullptr ? message : "unexpected string"});
  return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};  // as a real object manager answers
}

namespace {

// What a test has replaced in the table of one instance.
struct Alteration {
  CMPIInstanceFT table;
  CMPIInstanceFT* original;
  std::map<std::string, std::pair<CMPIData, CMPIrc>> properties;
};

std::map<const CMPIInstance*, std::unique_ptr<Alteration>>& alterations() {
  static std::map<const CMPIInstance*, std::unique_ptr<Alteration>> all;
  return all;
}

Alteration& alterationOf(CMPIInstance* instance) {
  std::unique_ptr<Alteration>& alteration = alterations()[instance];
  if (alteration == nullptr || instance->ft != &alteration->table) {
    alteration = std::make_unique<Alteration>(Alteration{*instance->ft, instance->ft, {}});
    instance->ft = &alteration->table;
  }
  return *alteration;
}

CMPIData alteredProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status) {
  const Alteration& alteration = *alterations().at(instance);
  const auto found = alteration.properties.find(name);
  if (found == alteration.properties.end()) {
    return alteration.original->getProperty(instance, name, status);
  }
  set(status, found->second.second);
  return found->second.first;
}

CMPIObjectPath* noPath(const CMPIInstance*, CMPIStatus* status) {
  set(status, CMPI_RC_ERR_FAILED);
  return nullptr;
}

}  // namespace

CMPIInstance* withProperty(CMPIInstance* instance, const std::string& name, CMPIData data, CMPIrc rc) {
  Alteration& alteration = alterationOf(instance);
  alteration.properties[name] = {data, rc};
  alteration.table.getProperty = alteredProperty;
  return instance;
}

CMPIInstance* withoutPath(CMPIInstance* instance) {
  alterationOf(instance).table.getObjectPath = noPath;
  return instance;
}

CMPIInstance* withoutHandle() {
  static CMPIInstance instance = {nullptr, nullptr};
  return &instance;
}

namespace {

RecordingResult& recorder(const CMPIResult* result) { return *static_cast<RecordingResult*>(result->hdl); }

CMPIStatus returnInstance(const CMPIResult* result, const CMPIInstance* instance) {
  recorder(result).instances.push_back(instance);
  recorder(result).order.push_back("instance");
  return {CMPI_RC_OK, nullptr};
}

CMPIStatus returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path) {
  recorder(result).paths.push_back(path);
  recorder(result).order.push_back("path");
  return {CMPI_RC_OK, nullptr};
}

CMPIStatus returnDone(const CMPIResult* result) {
  ++recorder(result).done;
  recorder(result).order.push_back("done");
  return {CMPI_RC_OK, nullptr};
}

CMPIResultFT resultTable = {CMPICurrentVersion, nullptr,          nullptr,    nullptr,
                            returnInstance,     returnObjectPath, returnDone, nullptr};

}  // namespace

RecordingResult::RecordingResult() : result_{this, &resultTable} {}

}  // namespace Testing
