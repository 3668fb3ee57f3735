// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/Alterations.h"

#include <map>
#include <memory>
#include <utility>

namespace Testing {

namespace {

void set(CMPIStatus* status, CMPIrc rc) {
  if (status) {
    *status = {rc, nullptr};
  }
}

// Instances

struct InstanceAlteration {
  CMPIInstanceFT table;
  CMPIInstanceFT* original;
  std::map<std::string, std::pair<CMPIData, CMPIrc>> properties = {};
  CMPIObjectPath* path = nullptr;
  std::vector<std::string>* calls = nullptr;
  int* pathCount = nullptr;
};

std::map<const CMPIInstance*, std::unique_ptr<InstanceAlteration>>& instanceAlterations() {
  static std::map<const CMPIInstance*, std::unique_ptr<InstanceAlteration>> all;
  return all;
}

InstanceAlteration& alterationOf(CMPIInstance* instance) {
  std::unique_ptr<InstanceAlteration>& alteration = instanceAlterations()[instance];
  // An earlier instance may have had the same address.
  if (!alteration || instance->ft != &alteration->table) {
    alteration = std::make_unique<InstanceAlteration>(InstanceAlteration{*instance->ft, instance->ft});
    instance->ft = &alteration->table;
  }
  return *alteration;
}

CMPIData alteredProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status) {
  const InstanceAlteration& alteration = *instanceAlterations().at(instance);
  const auto found = alteration.properties.find(name);
  if (found == alteration.properties.end()) {
    return alteration.original->getProperty(instance, name, status);
  }
  set(status, found->second.second);
  return found->second.first;
}

CMPIObjectPath* alteredPath(const CMPIInstance* instance, CMPIStatus* status) {
  CMPIObjectPath* path = instanceAlterations().at(instance)->path;
  set(status, path ? CMPI_RC_OK : CMPI_RC_ERR_FAILED);
  return path;
}

CMPIObjectPath* countedPath(const CMPIInstance* instance, CMPIStatus* status) {
  const InstanceAlteration& alteration = *instanceAlterations().at(instance);
  ++*alteration.pathCount;
  return alteration.original->getObjectPath(instance, status);
}

CMPIStatus recordedSetProperty(const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type) {
  const InstanceAlteration& alteration = *instanceAlterations().at(instance);
  alteration.calls->push_back(std::string("setProperty(") + name + ")");
  return alteration.original->setProperty(instance, name, value, type);
}

std::string listed(const char** names) {
  std::string list;
  for (; names && *names; ++names) {
    list += (list.empty() ? "" : ", ") + std::string(*names);
  }
  return list;
}

CMPIStatus recordedSetPropertyFilter(CMPIInstance* instance, const char** properties, const char** keys) {
  const InstanceAlteration& alteration = *instanceAlterations().at(instance);
  alteration.calls->push_back("setPropertyFilter(" + (properties ? listed(properties) : "null") + "; " + listed(keys) +
                              ")");
  return alteration.original->setPropertyFilter(instance, properties, keys);
}

// Object paths

struct PathAlteration {
  CMPIObjectPathFT table;
  CMPIObjectPathFT* original;
  std::string name = {};
  CMPIData data = {};
  CMPIrc rc = CMPI_RC_OK;
  std::vector<std::string>* names = nullptr;
  CMPIString* text = nullptr;
};

std::map<const CMPIObjectPath*, std::unique_ptr<PathAlteration>>& pathAlterations() {
  static std::map<const CMPIObjectPath*, std::unique_ptr<PathAlteration>> all;
  return all;
}

PathAlteration& alterationOf(CMPIObjectPath* path) {
  std::unique_ptr<PathAlteration>& alteration = pathAlterations()[path];
  if (!alteration || path->ft != &alteration->table) {
    alteration = std::make_unique<PathAlteration>(PathAlteration{*path->ft, path->ft});
    path->ft = &alteration->table;
  }
  return *alteration;
}

CMPIData alteredKey(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  const PathAlteration& alteration = *pathAlterations().at(path);
  if (alteration.name != name) {
    return alteration.original->getKey(path, name, status);
  }
  set(status, alteration.rc);
  return alteration.data;
}

CMPIData recordedKey(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  const PathAlteration& alteration = *pathAlterations().at(path);
  alteration.names->push_back(name);
  return alteration.original->getKey(path, name, status);
}

CMPICount noKeys(const CMPIObjectPath*, CMPIStatus* status) {
  set(status, CMPI_RC_OK);
  return 0;
}

CMPICount quietKeyCount(const CMPIObjectPath* path, CMPIStatus*) {
  return pathAlterations().at(path)->original->getKeyCount(path, nullptr);
}

CMPIString* alteredText(const CMPIObjectPath* path, CMPIStatus* status) {
  CMPIString* text = pathAlterations().at(path)->text;
  set(status, text ? CMPI_RC_OK : CMPI_RC_ERR_FAILED);
  return text;
}

// Strings

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
  const char* characters = CMGetCharsPtr(coded.original, nullptr);
  set(status, coded.rc);
  return characters;
}

template <CMPIrc rc>
const char* noCharacters(const CMPIString*, CMPIStatus* status) {
  set(status, rc);
  return nullptr;
}

}  // namespace

CMPIInstance* withProperty(CMPIInstance* instance, const std::string& name, CMPIData data, CMPIrc rc) {
  InstanceAlteration& alteration = alterationOf(instance);
  alteration.properties[name] = {data, rc};
  alteration.table.getProperty = alteredProperty;
  return instance;
}

CMPIInstance* withPath(CMPIInstance* instance, CMPIObjectPath* path) {
  InstanceAlteration& alteration = alterationOf(instance);
  alteration.path = path;
  alteration.table.getObjectPath = alteredPath;
  return instance;
}

CMPIInstance* withPathsCounted(CMPIInstance* instance, int& count) {
  InstanceAlteration& alteration = alterationOf(instance);
  alteration.pathCount = &count;
  alteration.table.getObjectPath = countedPath;
  return instance;
}

CMPIInstance* withCallsRecorded(CMPIInstance* instance, std::vector<std::string>& calls) {
  InstanceAlteration& alteration = alterationOf(instance);
  alteration.calls = &calls;
  alteration.table.setProperty = recordedSetProperty;
  alteration.table.setPropertyFilter = recordedSetPropertyFilter;
  return instance;
}

CMPIObjectPath* withKey(CMPIObjectPath* path, const std::string& name, CMPIData data, CMPIrc rc) {
  PathAlteration& alteration = alterationOf(path);
  alteration.name = name;
  alteration.data = data;
  alteration.rc = rc;
  alteration.table.getKey = alteredKey;
  return path;
}

CMPIObjectPath* countingNoKeys(CMPIObjectPath* path) {
  alterationOf(path).table.getKeyCount = noKeys;
  return path;
}

CMPIObjectPath* countingKeysQuietly(CMPIObjectPath* path) {
  alterationOf(path).table.getKeyCount = quietKeyCount;
  return path;
}

CMPIObjectPath* withKeysRecorded(CMPIObjectPath* path, std::vector<std::string>& names) {
  PathAlteration& alteration = alterationOf(path);
  alteration.names = &names;
  alteration.table.getKey = recordedKey;
  return path;
}

CMPIObjectPath* withText(CMPIObjectPath* path, PathText slot, CMPIString* string) {
  PathAlteration& alteration = alterationOf(path);
  alteration.text = string;
  alteration.table.*slot = alteredText;
  return path;
}

CMPIString* withCode(CMPIString* string, CMPIrc rc) {
  auto coded = std::make_unique<CodedString>(CodedString{*string, *string->ft, string, rc});
  coded->table.getCharPtr = codedCharacters;
  coded->base.ft = &coded->table;
  CMPIString* result = &coded->base;
  codedStrings()[result] = std::move(coded);
  return result;
}

CMPIInstance* withoutHandle() {
  static CMPIInstance instance = {nullptr, nullptr};
  return &instance;
}

CMPIObjectPath* pathWithoutHandle() {
  static CMPIObjectPath path = {nullptr, nullptr};
  return &path;
}

std::vector<CMPIString*> stringsWithoutCharacters() {
  static CMPIStringFT silent = {CMPICurrentVersion, nullptr, nullptr, noCharacters<CMPI_RC_OK>};
  static CMPIStringFT telling = {CMPICurrentVersion, nullptr, nullptr, noCharacters<CMPI_RC_ERR_INVALID_HANDLE>};
  static CMPIString strings[] = {{nullptr, &silent}, {&silent, &silent}, {&telling, &telling}};
  return {nullptr, &strings[0], &strings[1], &strings[2]};
}

}  // namespace Testing
