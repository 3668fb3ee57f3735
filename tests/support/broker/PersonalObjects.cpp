// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/PersonalObjects.h"

#include <cmpimacs.h>

#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>

#include "cimom/broker/Guard.h"
#include "tests/support/broker/Personality.h"

namespace Testing {

namespace {

using Cimom::Abi;
using Cimom::ClassDefinition;
using Cimom::Instance;
using Cimom::modelOf;
using Cimom::ObjectPath;
using Cimom::PropertyDeclaration;
using Cimom::Text;
using Cimom::Value;

// What of an instance the object manager itself has no room for.
struct Extras {
  std::map<std::string, Value, Cimom::NameLess> values;                         // under names or types that it refuses
  std::optional<std::set<std::string, Cimom::NameLess>> listed = std::nullopt;  // by the property filter
  std::unique_ptr<ClassDefinition> unknownClass = nullptr;
};

std::map<const CMPIInstance*, Extras>& allExtras() {
  static std::map<const CMPIInstance*, Extras> all;
  return all;
}

const Extras* extrasOf(const CMPIInstance* instance) {
  const auto found = allExtras().find(instance);
  return found == allExtras().end() ? nullptr : &found->second;
}

void set(CMPIStatus* status, CMPIrc code) {
  if (status) {
    *status = {code, nullptr};
  }
}

CMPIData absent(CMPIStatus* status, CMPIrc code) {
  set(status, code);
  return {CMPI_null, personality().absentState, {}};
}

// The data with its objects made personal.
CMPIData personalData(CMPIData data, bool marked) {
  data.state = static_cast<CMPIValueState>(marked ? data.state : data.state & ~CMPI_keyValue);
  switch (data.type) {
    case CMPI_string:
      data.value.string = CMIsNullValue(data) && personality().nullStringsAreObjects ? stringWithoutCharacters()
                                                                                     : personal(data.value.string);
      break;
    case CMPI_ref:
      data.value.ref = personal(data.value.ref);
      break;
    case CMPI_instance:
      data.value.inst = personal(data.value.inst);
      break;
    default:
      break;
  }
  return data;
}

void personalizeName(CMPIString** name) {
  if (name) {
    *name = personal(*name);
  }
}

// A value to be set: a reference without its host where references lose it.
class KeptValue {
 public:
  KeptValue(const CMPIValue* value, CMPIType type) : value_(value) {
    if (type == CMPI_ref && value && !CMIsNullObject(value->ref) && !personality().referencesKeepTheirHost) {
      path_.emplace(withoutHost(modelOf<ObjectPath>(value->ref)), true);
      reference_.ref = &*path_;
      value_ = &reference_;
    }
  }
  KeptValue(const KeptValue&) = delete;
  KeptValue& operator=(const KeptValue&) = delete;

  const CMPIValue* get() const { return value_; }

 private:
  const CMPIValue* value_;
  CMPIValue reference_ = {};
  std::optional<Cimom::Handle<ObjectPath>> path_;
};

// Strings

const char* getCharPtr(const CMPIString* string, CMPIStatus* status) {
  const char* characters = Abi<Text>::table.getCharPtr(string, personality().charactersSetStatus ? status : nullptr);
  personalize(personality().charactersSetStatus ? status : nullptr);
  return characters;
}

CMPIStringFT& stringTable() {
  static CMPIStringFT table = [] {
    CMPIStringFT own = Abi<Text>::table;
    own.ftVersion = personality().tableVersion;
    own.getCharPtr = getCharPtr;
    return own;
  }();
  return table;
}

// Object paths

template <auto slot>
CMPIString* getText(const CMPIObjectPath* path, CMPIStatus* status) {
  CMPIString* text = (Abi<ObjectPath>::table.*slot)(path, status);
  personalize(status);
  const bool unset = text && !*static_cast<const char*>(text->hdl);
  return unset && personality().unsetTextsAreNull ? stringWithoutCharacters() : personal(text);
}

CMPIStatus addKey(CMPIObjectPath* path, const char* name, const CMPIValue* value, const CMPIType type) {
  const KeptValue kept(value, type);
  CMPIStatus status = Abi<ObjectPath>::table.addKey(path, name, kept.get(), type);
  personalize(&status);
  return status;
}

bool isUnset(const CMPIData& key) { return CMIsNullValue(key) && personality().countsUnsetKeys; }

CMPIData getKey(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  CMPIStatus outcome = {CMPI_RC_OK, nullptr};
  const CMPIData key = Abi<ObjectPath>::table.getKey(path, name, &outcome);
  if (outcome.rc == CMPI_RC_ERR_NO_SUCH_PROPERTY || isUnset(key)) {
    return absent(status, personality().absentKeyCode);
  }
  set(status, outcome.rc);
  return personalData(key, personality().marksKeysOfPaths);
}

CMPIData getKeyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* status) {
  CMPIStatus outcome = {CMPI_RC_OK, nullptr};
  const CMPIData key = Abi<ObjectPath>::table.getKeyAt(path, index, name, &outcome);
  if (outcome.rc != CMPI_RC_OK) {
    return absent(status, outcome.rc);
  }
  personalizeName(name);
  if (isUnset(key)) {
    return absent(status, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  }
  set(status, CMPI_RC_OK);
  return personalData(key, personality().marksKeysOfPaths);
}

CMPIObjectPathFT& pathTable() {
  static CMPIObjectPathFT table = [] {
    CMPIObjectPathFT own = Abi<ObjectPath>::table;
    own.ftVersion = personality().tableVersion;
    own.getNameSpace = getText<&CMPIObjectPathFT::getNameSpace>;
    own.getHostname = getText<&CMPIObjectPathFT::getHostname>;
    own.getClassName = getText<&CMPIObjectPathFT::getClassName>;
    own.toString = getText<&CMPIObjectPathFT::toString>;
    own.addKey = addKey;
    own.getKey = getKey;
    own.getKeyAt = getKeyAt;
    return own;
  }();
  return table;
}

// Instances

const PropertyDeclaration* declarationOf(const CMPIInstance* instance, const char* name) {
  return modelOf<Instance>(instance).definition().findProperty(name);
}

// Whether a filter of the object manager's own kind leaves the property out.
bool isLeftOut(const Extras* extras, const char* name, const PropertyDeclaration* declaration) {
  return extras && extras->listed && !extras->listed->contains(name) && !(declaration && declaration->isKey());
}

CMPIData getProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status) {
  if (const Extras* extras = extrasOf(instance)) {
    const auto found = extras->values.find(name);
    if (found != extras->values.end()) {
      set(status, CMPI_RC_OK);
      return personalData(Cimom::toCmpi(found->second), false);
    }
    if (isLeftOut(extras, name, declarationOf(instance, name))) {
      return absent(status, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    }
  }
  CMPIStatus outcome = {CMPI_RC_OK, nullptr};
  const CMPIData data = Abi<Instance>::table.getProperty(instance, name, &outcome);
  if (outcome.rc != CMPI_RC_OK) {
    return absent(status, outcome.rc);
  }
  set(status, CMPI_RC_OK);
  return personalData(data, personality().marksKeyProperties);
}

CMPIData getPropertyAt(const CMPIInstance* instance, CMPICount index, CMPIString** name, CMPIStatus* status) {
  const CMPIData data = Abi<Instance>::table.getPropertyAt(instance, index, name, status);
  personalize(status);
  personalizeName(name);
  return personalData(data, personality().marksKeyProperties);
}

bool isInteger(CMPIType type) { return type >= CMPI_uint8 && type <= CMPI_sint64; }

// Whether the value is kept beside the object manager's own instance, which would drop or refuse it.
bool isKeptAside(const Extras* extras, const PropertyDeclaration* declaration, CMPIType type) {
  if (!declaration) {
    return personality().keepsUndeclared || (extras && extras->unknownClass);
  }
  return personality().takesIntegersOfAnyType && declaration->type != type && isInteger(declaration->type) &&
         isInteger(type);
}

CMPIStatus setProperty(const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type) {
  const PropertyDeclaration* declaration = declarationOf(instance, name);
  if (isLeftOut(extrasOf(instance), name, declaration)) {
    return {CMPI_RC_OK, nullptr};
  }
  const KeptValue kept(value, type);
  if (isKeptAside(extrasOf(instance), declaration, type)) {
    allExtras()[instance].values.insert_or_assign(name, Cimom::fromCmpi(kept.get(), type));
    return {CMPI_RC_OK, nullptr};
  }
  const CMPIStatus status = Abi<Instance>::table.setProperty(instance, name, kept.get(), type);
  if (status.rc == CMPI_RC_ERR_TYPE_MISMATCH) {
    return {personality().wrongTypeCode, nullptr};
  }
  if (extrasOf(instance)) {
    allExtras()[instance].values.erase(name);
  }
  return {status.rc, nullptr};
}

CMPIStatus setPropertyWithOrigin(const CMPIInstance* instance, const char* name, const CMPIValue* value,
                                 const CMPIType type, const char*) {
  return setProperty(instance, name, value, type);
}

CMPIObjectPath* getObjectPath(const CMPIInstance* instance, CMPIStatus* status) {
  const Extras* extras = extrasOf(instance);
  if (extras && extras->unknownClass && personality().unknownClass == UnknownClass::HasNoInstancePath) {
    set(status, CMPI_RC_ERR_INVALID_CLASS);
    return nullptr;
  }
  CMPIObjectPath* path = Abi<Instance>::table.getObjectPath(instance, status);
  personalize(status);
  if (!path) {
    return nullptr;
  }
  const Instance& model = modelOf<Instance>(instance);
  auto& keyed = Cimom::ownModelOf<ObjectPath>(path);
  if (!personality().keysOfThePathWin) {
    keyed.keys = {};
    for (const PropertyDeclaration& property : model.definition().properties) {
      if (property.isKey()) {
        keyed.keys.set(property.name, *model.find(property.name));
      }
    }
  }
  if (personality().pathsShowUnsetKeys) {
    addUnsetKeys(keyed, model.definition());
  }
  return personal(path);
}

CMPIStatus setPropertyFilter(CMPIInstance* instance, const char** properties, const char** keys) {
  if (!personality().filterDropsOthers) {
    return {CMPI_RC_OK, nullptr};
  }
  if (properties && personality().keepsUndeclared) {
    auto& listed = allExtras()[instance].listed.emplace();
    for (const char** name = properties; *name; ++name) {
      listed.insert(*name);
    }
  }
  return Abi<Instance>::table.setPropertyFilter(instance, properties, keys);
}

CMPIInstanceFT& instanceTable() {
  static CMPIInstanceFT table = [] {
    CMPIInstanceFT own = Abi<Instance>::table;
    own.ftVersion = personality().tableVersion;
    own.getProperty = getProperty;
    own.getPropertyAt = getPropertyAt;
    own.setProperty = setProperty;
    own.getObjectPath = getObjectPath;
    own.setPropertyFilter = setPropertyFilter;
    own.setPropertyWithOrigin = personality().hasCmpi2Slots ? setPropertyWithOrigin : nullptr;
    return own;
  }();
  return table;
}

template <typename Model>
typename Abi<Model>::Type* withTable(typename Abi<Model>::Type* object, decltype(Abi<Model>::table)& table) {
  if (object && object->ft == &Abi<Model>::table) {
    object->ft = &table;
  }
  return object;
}

}  // namespace

CMPIString* personal(CMPIString* string) { return withTable<Text>(string, stringTable()); }
CMPIObjectPath* personal(CMPIObjectPath* path) { return withTable<ObjectPath>(path, pathTable()); }
CMPIInstance* personal(CMPIInstance* instance) { return withTable<Instance>(instance, instanceTable()); }

void personalize(CMPIStatus* status) {
  if (status) {
    status->msg = personal(status->msg);
  }
}

CMPIString* stringWithoutCharacters() {
  static CMPIString string = {nullptr, &stringTable()};
  return &string;
}

ObjectPath withoutHost(const ObjectPath& path) {
  ObjectPath bare = path;
  bare.host.clear();
  return bare;
}

void addUnsetKeys(ObjectPath& path, const ClassDefinition& definition) {
  for (const PropertyDeclaration& property : definition.properties) {
    if (property.isKey() && !path.keys.find(property.name)) {
      path.keys.set(property.name, Value::null(property.type));
    }
  }
}

CMPIInstance* instanceOfUnknownClass(const ObjectPath& path) {
  auto definition = std::make_unique<ClassDefinition>();
  definition->name = path.className;
  CMPIInstance* instance = personal(Cimom::make(Instance(*definition, path)));
  allExtras()[instance].unknownClass = std::move(definition);
  keepUndeclaredKeys(instance, path);
  return instance;
}

void keepUndeclaredKeys(const CMPIInstance* instance, const ObjectPath& path) {
  for (const auto& [name, value] : path.keys) {
    if (personality().keepsUndeclared && !declarationOf(instance, name.c_str())) {
      allExtras()[instance].values.insert_or_assign(name, value);
    }
  }
}

void forgetInstances() { allExtras().clear(); }

}  // namespace Testing
