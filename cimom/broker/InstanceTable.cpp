// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

// A property's value as it is read; one that nobody set has the type that it would have.
CMPIData dataOf(const PropertyDeclaration& property, const Value& value) {
  CMPIData data = toCmpi(value, property.isKey() ? CMPI_keyValue : CMPI_goodValue);
  if (value.isNull()) {
    data.type = property.valueType();
  }
  return data;
}

CMPIData getProperty(const CMPIInstance* instance, const char* name, CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const Instance& model = modelOf<Instance>(instance);
    const Value* value = model.find(required(name, "the property's name"));
    if (!value) {
      throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, model.definition().name + " has no property \"" + name + "\"");
    }
    return dataOf(*model.definition().findProperty(name), *value);
  });
}

CMPIData getPropertyAt(const CMPIInstance* instance, CMPICount index, CMPIString** name, CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const Instance& model = modelOf<Instance>(instance);
    if (index >= model.size()) {
      throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY,
                        model.definition().name + " has no property at index " + std::to_string(index));
    }
    const PropertyDeclaration& property = model.definition().properties[index];
    const CMPIData data = dataOf(property, model[index]);
    if (name) {
      *name = makeCopy(property.name);
    }
    return data;
  });
}

CMPICount getPropertyCount(const CMPIInstance* instance, CMPIStatus* status) {
  return guarded(status, CMPICount(0), [&] { return static_cast<CMPICount>(modelOf<Instance>(instance).size()); });
}

CMPIStatus setProperty(const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type) {
  return guarded([&] {
    Instance& model = ownModelOf<Instance>(instance);
    model.set(required(name, "the property's name"), fromCmpi(value, type));
  });
}

// The class says where a property comes from; the origin that the caller names adds nothing to it.
CMPIStatus setPropertyWithOrigin(const CMPIInstance* instance, const char* name, const CMPIValue* value,
                                 const CMPIType type, const char*) {
  return setProperty(instance, name, value, type);
}

CMPIObjectPath* getObjectPath(const CMPIInstance* instance, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIObjectPath*>(nullptr),
                 [&] { return make(modelOf<Instance>(instance).path()); });
}

CMPIStatus setObjectPath(CMPIInstance* instance, const CMPIObjectPath* path) {
  return guarded([&] {
    Instance& model = ownModelOf<Instance>(instance);
    model.setPath(argumentOf<ObjectPath>(path));
  });
}

// The class knows its keys, so that the caller's list of them is not needed.
CMPIStatus setPropertyFilter(CMPIInstance* instance, const char** properties, const char**) {
  return guarded([&] {
    Instance& model = ownModelOf<Instance>(instance);
    if (!properties) {
      return;
    }
    std::vector<std::string> names;
    for (const char** name = properties; *name; ++name) {
      names.emplace_back(*name);
    }
    model.setFilter(names);
  });
}

}  // namespace

CMPIInstanceFT Abi<Instance>::table = {
    .ftVersion = CMPICurrentVersion,
    .release = release<Instance>,
    .clone = clone<Instance>,
    .getProperty = getProperty,
    .getPropertyAt = getPropertyAt,
    .getPropertyCount = getPropertyCount,
    .setProperty = setProperty,
    .getObjectPath = getObjectPath,
    .setPropertyFilter = setPropertyFilter,
    .setObjectPath = setObjectPath,
    .setPropertyWithOrigin = setPropertyWithOrigin,
};

}  // namespace Cimom
