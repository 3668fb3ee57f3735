#include "tests/support/broker/Faults.h"

#include <memory>

#include "tests/support/broker/Personality.h"

namespace Testing {

namespace {

FaultyBroker* current = nullptr;

// An enumeration over a script's instances.
struct ScriptedEnumeration {
  CMPIEnumeration base;
  std::vector<CMPIData> items;
  std::size_t position = 0;
};

ScriptedEnumeration& scripted(const CMPIEnumeration* enumeration) {
  return *static_cast<ScriptedEnumeration*>(enumeration->hdl);
}

void set(CMPIStatus* status, CMPIrc rc) {
  if (status) {
    *status = {rc, nullptr};
  }
}

CMPIBoolean hasNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  set(status, CMPI_RC_OK);
  return scripted(enumeration).position < scripted(enumeration).items.size();
}

CMPIData getNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  if (!hasNext(enumeration, status)) {
    ++current->readsPastTheEnd;
    set(status, personality().pastTheEndCode);
    return {CMPI_instance, CMPI_nullValue, {}};
  }
  return scripted(enumeration).items.at(scripted(enumeration).position++);
}

CMPIEnumerationFT& enumerationTable() {
  static CMPIEnumerationFT table = {personality().tableVersion, nullptr, nullptr, getNext, hasNext, nullptr};
  return table;
}

std::vector<std::unique_ptr<ScriptedEnumeration>>& enumerations() {
  static std::vector<std::unique_ptr<ScriptedEnumeration>> made;
  return made;
}

std::string text(const CMPIString* string) {
  const char* characters = !string ? nullptr : CMGetCharsPtr(string, nullptr);
  return !characters ? "" : characters;
}

// The keys that have a value.
std::string keysOf(const CMPIObjectPath* path) {
  std::string list;
  for (CMPICount i = 0; i < CMGetKeyCount(path, nullptr); ++i) {
    CMPIString* name = nullptr;
    if (!CMIsNullValue(CMGetKeyAt(path, i, &name, nullptr))) {
      list += (list.empty() ? "" : ", ") + text(name);
    }
  }
  return list;
}

}  // namespace

FaultyBroker::FaultyBroker(const CMPIBroker* real)
    : personal_(real),
      broker_(*personal_.broker()),
      upCallTable_(*personal_.broker()->bft),
      encapsulation_(*personal_.broker()->eft) {
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
  const UpCall call =
      !path ? UpCall{"", "", properties != nullptr}
            : UpCall{text(CMGetNameSpace(path, nullptr)), text(CMGetClassName(path, nullptr)), properties != nullptr};
  current->upCalls.push_back(call);
  if (current->onUpCall) {
    current->onUpCall(call);
  }
  const UpCallScript& script = current->upCallScripts[call.className];
  if (status) {
    *status = script.status;
  }
  if (script.nullEnumeration || (script.status.rc != CMPI_RC_OK && personality().failedUpCallIsNull)) {
    return nullptr;
  }
  auto enumeration = std::make_unique<ScriptedEnumeration>();
  enumeration->base = {enumeration.get(), &enumerationTable()};
  if (script.status.rc == CMPI_RC_OK) {
    for (CMPIInstance* instance : script.instances) {
      CMPIData item = {CMPI_instance, personality().itemState, {}};
      item.value.inst = instance;
      enumeration->items.push_back(item);
    }
    enumeration->items.insert(enumeration->items.end(), script.items.begin(), script.items.end());
  }
  enumerations().push_back(std::move(enumeration));
  return &enumerations().back()->base;
}

CMPIObjectPath* FaultyBroker::newObjectPath(const CMPIBroker*, const char* nameSpace, const char* className,
                                            CMPIStatus* status) {
  const int call = ++current->newObjectPathCalls_[className];
  if (current->failNewObjectPath && current->failNewObjectPath(className, call)) {
    set(status, CMPI_RC_ERR_FAILED);
    return current->unmadePath;
  }
  return CMNewObjectPath(current->real(), nameSpace, className, status);
}

CMPIInstance* FaultyBroker::newInstance(const CMPIBroker*, const CMPIObjectPath* path, CMPIStatus* status) {
  const std::string className = text(CMGetClassName(path, nullptr));
  const int call = ++current->newInstanceCalls_[className];
  if (current->failNewInstance && current->failNewInstance(className, call)) {
    set(status, CMPI_RC_ERR_FAILED);
    return current->unmadeInstance;
  }
  CMPIInstance* instance = CMNewInstance(current->real(), path, status);
  if (instance) {
    std::vector<std::string>& calls = current->instanceCalls[className];
    calls.push_back("newInstance(" + keysOf(path) + ")");
    withCallsRecorded(instance, calls);
    if (current->onNewInstance) {
      current->onNewInstance(className, call, instance);
    }
  }
  return instance;
}

CMPIArray* FaultyBroker::newArray(const CMPIBroker*, CMPICount count, CMPIType type, CMPIStatus* status) {
  if (current->failNewArray) {
    set(status, CMPI_RC_ERROR_SYSTEM);
    return nullptr;
  }
  return CMNewArray(current->real(), count, type, status);
}

CMPIString* FaultyBroker::newString(const CMPIBroker*, const char* characters, CMPIStatus* status) {
  current->strings.push_back(characters);
  return CMNewString(current->real(), characters, status);
}

CMPIStatus FaultyBroker::trace(const CMPIBroker*, Cmpi::TraceLevel level, const char* component, const char* message,
                               const CMPIString* string) {
  current->traces.push_back({level, component, !string ? message : "unexpected string"});
  return {personality().traceCode, nullptr};
}

namespace {

RecordingResult& recorder(const CMPIResult* result) { return *static_cast<RecordingResult*>(result->hdl); }

CMPIStatus returnInstance(const CMPIResult* result, const CMPIInstance* instance) {
  recorder(result).instances.push_back(instance);
  recorder(result).order.push_back("instance");
  return {CMIsNullObject(instance) ? CMPI_RC_ERR_INVALID_PARAMETER : CMPI_RC_OK, nullptr};
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
