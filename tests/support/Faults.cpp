#include "Faults.h"

#include <memory>

#include "Personality.h"

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
  if (status != nullptr) {
    *status = {rc, nullptr};
  }
}

CMPIBoolean hasNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  set(status, CMPI_RC_OK);
  return scripted(enumeration).position < scripted(enumeration).items.size();
}

CMPIData getNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  if (!hasNext(enumeration, status)) {
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
  const char* const characters = string == nullptr ? nullptr : CMGetCharsPtr(string, nullptr);
  return characters == nullptr ? "" : characters;
}

// What a test has replaced in the table of one instance.
struct Alteration {
  CMPIInstanceFT table;
  CMPIInstanceFT* original;
  std::map<std::string, std::pair<CMPIData, CMPIrc>> properties;
  CMPIObjectPath* path = nullptr;
  std::vector<std::string>* calls = nullptr;
  int* pathCount = nullptr;
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

CMPIStatus recordedSetProperty(const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type) {
  const Alteration& alteration = *alterations().at(instance);
  alteration.calls->push_back(std::string("setProperty(") + name + ")");
  return alteration.original->setProperty(instance, name, value, type);
}

std::string listed(const char** names) {
  std::string list;
  for (; names != nullptr && *names != nullptr; ++names) {
    list += (list.empty() ? "" : ", ") + std::string(*names);
  }
  return list;
}

CMPIStatus recordedSetPropertyFilter(CMPIInstance* instance, const char** properties, const char** keys) {
  const Alteration& alteration = *alterations().at(instance);
  alteration.calls->push_back("setPropertyFilter(" + (properties == nullptr ? "null" : listed(properties)) + "; " +
                              listed(keys) + ")");
  return alteration.original->setPropertyFilter(instance, properties, keys);
}

void recordCalls(CMPIInstance* instance, std::vector<std::string>& calls) {
  Alteration& alteration = alterationOf(instance);
  alteration.calls = &calls;
  alteration.table.setProperty = recordedSetProperty;
  alteration.table.setPropertyFilter = recordedSetPropertyFilter;
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

CMPIObjectPath* alteredPath(const CMPIInstance* instance, CMPIStatus* status) {
  CMPIObjectPath* const path = alterations().at(instance)->path;
  set(status, path == nullptr ? CMPI_RC_ERR_FAILED : CMPI_RC_OK);
  return path;
}

CMPIObjectPath* countedPath(const CMPIInstance* instance, CMPIStatus* status) {
  const Alteration& alteration = *alterations().at(instance);
  ++*alteration.pathCount;
  return alteration.original->getObjectPath(instance, status);
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
  const UpCall call = path == nullptr ? UpCall{"", "", properties != nullptr}
                                      : UpCall{text(CMGetNameSpace(path, nullptr)), text(CMGetClassName(path, nullptr)),
                                               properties != nullptr};
  current->upCalls.push_back(call);
  if (current->onUpCall) {
    current->onUpCall(call);
  }
  const UpCallScript& script = current->upCallScripts[call.className];
  if (status != nullptr) {
    *status = script.status;
  }
  if (script.nullEnumeration || (script.status.rc != CMPI_RC_OK && personality().failedUpCallIsNull)) {
    return nullptr;
  }
  auto enumeration = std::make_unique<ScriptedEnumeration>();
  enumeration->base = {enumeration.get(), &enumerationTable()};
  for (CMPIInstance* const instance : script.instances) {
    CMPIData item = {CMPI_instance, personality().itemState, {}};
    item.value.inst = instance;
    enumeration->items.push_back(item);
  }
  enumeration->items.insert(enumeration->items.end(), script.items.begin(), script.items.end());
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
  CMPIInstance* const instance = CMNewInstance(current->real(), path, status);
  if (instance != nullptr) {
    std::vector<std::string>& calls = current->instanceCalls[className];
    calls.push_back("newInstance(" + keysOf(path) + ")");
    recordCalls(instance, calls);
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

CMPIStatus FaultyBroker::trace(const CMPIBroker*, int level, const char* component, const char* message,
                               const CMPIString* string) {
  current->traces.push_back({level, component, string == nullptr ? message : "unexpected string"});
  return {personality().traceCode, nullptr};
}

CMPIInstance* withProperty(CMPIInstance* instance, const std::string& name, CMPIData data, CMPIrc rc) {
  Alteration& alteration = alterationOf(instance);
  alteration.properties[name] = {data, rc};
  alteration.table.getProperty = alteredProperty;
  return instance;
}

CMPIInstance* withPath(CMPIInstance* instance, CMPIObjectPath* path) {
  Alteration& alteration = alterationOf(instance);
  alteration.path = path;
  alteration.table.getObjectPath = alteredPath;
  return instance;
}

CMPIInstance* withPathsCounted(CMPIInstance* instance, int& count) {
  Alteration& alteration = alterationOf(instance);
  alteration.pathCount = &count;
  alteration.table.getObjectPath = countedPath;
  return instance;
}

CMPIInstance* withoutPath(CMPIInstance* instance) { return withPath(instance, nullptr); }

CMPIInstance* withoutHandle() {
  static CMPIInstance instance = {nullptr, nullptr};
  return &instance;
}

CMPIObjectPath* pathWithoutHandle() {
  static CMPIObjectPath path = {nullptr, nullptr};
  return &path;
}

namespace {

struct KeyAlteration {
  CMPIObjectPathFT table;
  CMPIObjectPathFT* original;
  std::string name;
  CMPIData data;
  CMPIrc rc;
  std::vector<std::string>* names = nullptr;
};

std::map<const CMPIObjectPath*, std::unique_ptr<KeyAlteration>>& keyAlterations() {
  static std::map<const CMPIObjectPath*, std::unique_ptr<KeyAlteration>> all;
  return all;
}

CMPIData alteredKey(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  const KeyAlteration& alteration = *keyAlterations().at(path);
  if (alteration.name != name) {
    return alteration.original->getKey(path, name, status);
  }
  set(status, alteration.rc);
  return alteration.data;
}

CMPIData recordedKey(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  const KeyAlteration& alteration = *keyAlterations().at(path);
  alteration.names->push_back(name);
  return alteration.original->getKey(path, name, status);
}

CMPIObjectPath* withAlteration(CMPIObjectPath* path, KeyAlteration alteration) {
  auto owned = std::make_unique<KeyAlteration>(std::move(alteration));
  path->ft = &owned->table;
  keyAlterations()[path] = std::move(owned);
  return path;
}

CMPIObjectPath* withGetKey(CMPIObjectPath* path, KeyAlteration alteration,
                           CMPIData (*getKey)(const CMPIObjectPath*, const char*, CMPIStatus*)) {
  alteration.table.getKey = getKey;
  return withAlteration(path, std::move(alteration));
}

struct CodedString {
  CMPIString base;
  CMPIStringFT table;
  CMPIString* original;
  CMPIrc rc;
};

std::map<const CMPIString*, std::unique_ptr<CodedString>>& codedStrings() {
  static std::map<const CMPIString*, std::unique_ptr<CodedString>> all;
  return all;
}

const char* codedCharacters(const CMPIString* string, CMPIStatus* status) {
  const CodedString& coded = *codedStrings().at(string);
  const char* const characters = CMGetCharsPtr(coded.original, nullptr);
  set(status, coded.rc);
  return characters;
}

}  // namespace

CMPIString* withCode(CMPIString* string, CMPIrc rc) {
  auto coded = std::make_unique<CodedString>(CodedString{*string, *string->ft, string, rc});
  coded->table.getCharPtr = codedCharacters;
  coded->base.ft = &coded->table;
  CMPIString* const result = &coded->base;
  codedStrings()[result] = std::move(coded);
  return result;
}

CMPIObjectPath* withKey(CMPIObjectPath* path, const std::string& name, CMPIData data, CMPIrc rc) {
  return withGetKey(path, {*path->ft, path->ft, name, data, rc}, alteredKey);
}

CMPIObjectPath* countingNoKeys(CMPIObjectPath* path) {
  KeyAlteration alteration = {*path->ft, path->ft, {}, {}, CMPI_RC_OK};
  alteration.table.getKeyCount = [](const CMPIObjectPath*, CMPIStatus* status) -> CMPICount {
    set(status, CMPI_RC_OK);
    return 0;
  };
  return withAlteration(path, std::move(alteration));
}

CMPIObjectPath* withKeysRecorded(CMPIObjectPath* path, std::vector<std::string>& names) {
  return withGetKey(path, {*path->ft, path->ft, {}, {}, CMPI_RC_OK, &names}, recordedKey);
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
