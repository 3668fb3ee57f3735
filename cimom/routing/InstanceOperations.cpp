// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <iterator>
#include <optional>
#include <set>
#include <string_view>

#include "cimom/routing/ProviderCall.h"
#include "cimom/routing/Router.h"
#include "cimom/routing/SameObject.h"

namespace Cimom {
namespace {

using Entry = ProviderRegistry::Entry;

bool servesInstances(const Entry& entry, const Operation& operation) {
  return entry.registration.instance && entry.serves(operation.path.nameSpace);
}

// The provider of exactly the operation's class, or null.
Provider* providerOf(const ProviderRegistry& providers, const Operation& operation) {
  for (const Entry& entry : providers.entries()) {
    if (servesInstances(entry, operation) && sameName(entry.registration.className, operation.definition.name)) {
      return entry.provider;
    }
  }
  return nullptr;
}

Provider& writingProviderOf(const ProviderRegistry& providers, const Operation& operation) {
  if (Provider* provider = providerOf(providers, operation)) {
    return *provider;
  }
  throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED,
                    "class " + operation.definition.name + " has no provider in " + operation.path.nameSpace);
}

// Calls `call` with the provider and the path of every class at or below the operation's that has a provider. That one
// for a subclass does not support the operation is not the others' affair, unless there are none.
template <typename Call>
std::vector<Value> forEachClass(const ProviderRegistry& providers, const Operation& operation, Call call) {
  std::vector<Value> all;
  std::optional<StatusError> unsupported;
  bool isAnswered = false;
  for (const Entry& entry : providers.entries()) {
    const ClassDefinition* served = operation.core.classes.find(operation.path.nameSpace, entry.registration.className);
    if (!served || !servesInstances(entry, operation) || !served->isA(operation.definition.name)) {
      continue;
    }
    const auto path = lend(ObjectPath{operation.path.host, operation.path.nameSpace, served->name, {}});
    try {
      std::vector<Value> some = call(*entry.provider, entry.provider->instanceMi(&operation.core.broker), &path);
      std::ranges::move(some, std::back_inserter(all));
      isAnswered = true;
    } catch (const StatusError& error) {
      if (error.code() != CMPI_RC_ERR_NOT_SUPPORTED || served == &operation.definition) {
        throw;
      }
      unsupported = error;
    }
  }
  if (unsupported && !isAnswered) {
    throw StatusError(*unsupported);
  }
  return all;
}

// The instance, without defaults, as one of the class; what of another class's properties does not fit is left out.
Instance inClass(const ClassDefinition& definition, const Instance& given) {
  Instance bare = given.withoutDefaults();
  if (sameName(given.definition().name, definition.name)) {
    return bare;
  }
  Instance other = Instance(definition, ObjectPath()).withoutDefaults();
  for (std::size_t index = 0; index < bare.size(); ++index) {
    const PropertyDeclaration* property = definition.findProperty(given.definition().properties[index].name);
    if (property && property->type == given.definition().properties[index].type) {
      other.set(property->name, bare[index]);
    }
  }
  return other;
}

// Sets what a property list leaves out to null, but for the keys.
void dropUnlisted(Instance& instance, const char** properties) {
  if (!properties) {
    return;
  }
  std::set<std::string_view, NameLess> listed;
  for (; *properties; ++properties) {
    listed.insert(*properties);
  }
  for (const PropertyDeclaration& property : instance.definition().properties) {
    if (!property.isKey() && !listed.contains(property.name)) {
      instance.set(property.name, Value::null(property.type));
    }
  }
}

}  // namespace

std::vector<Value> Router::enumerateInstances(const Operation& operation, const char** properties) {
  return forEachClass(
      providers_, operation, [&](const Provider& provider, CMPIInstanceMI* mi, const CMPIObjectPath* path) {
        return callProvider(operation, provider, mi, CMPI_instance, mi->ft->enumerateInstances, path, properties);
      });
}

std::vector<Value> Router::enumerateInstanceNames(const Operation& operation) {
  return forEachClass(providers_, operation,
                      [&](const Provider& provider, CMPIInstanceMI* mi, const CMPIObjectPath* path) {
                        return callProvider(operation, provider, mi, CMPI_ref, mi->ft->enumerateInstanceNames, path);
                      });
}

std::optional<Value> Router::findInstance(const Operation& operation, const ObjectPath& named,
                                          const char** properties) {
  if (Provider* provider = providerOf(providers_, operation)) {
    const auto path = lend(named);
    CMPIInstanceMI* mi = provider->instanceMi(&operation.core.broker);
    std::vector<Value> found =
        callProvider(operation, *provider, mi, CMPI_instance, mi->ft->getInstance, &path, properties);
    if (!found.empty()) {
      return std::move(found.front());
    }
  }
  return std::nullopt;
}

Value Router::getInstance(const Operation& operation, const char** properties) {
  if (auto found = findInstance(operation, operation.path, properties)) {
    return *std::move(found);
  }
  throw StatusError(CMPI_RC_ERR_NOT_FOUND, "no instance " + operation.path.toString());
}

Value Router::createInstance(const Operation& operation, const Instance& instance) {
  Provider& provider = writingProviderOf(providers_, operation);
  const auto path = lend(operation.path);
  const auto created = lend(instance);
  CMPIInstanceMI* mi = provider.instanceMi(&operation.core.broker);
  std::vector<Value> paths = callProvider(operation, provider, mi, CMPI_ref, mi->ft->createInstance, &path, &created);
  return paths.empty() ? Value::reference(instance.path()) : std::move(paths.front());
}

void Router::requireThere(const Operation& operation, const ObjectPath& path) {
  if (!providerOf(providers_, operation)) {
    return;  // nobody to ask
  }
  try {
    if (findInstance(operation, path, nullptr)) {
      return;
    }
  } catch (const StatusError& error) {
    if (error.code() == CMPI_RC_ERR_NOT_SUPPORTED) {
      return;  // nobody who knows
    }
    throw;
  }
  throw StatusError(CMPI_RC_ERR_NOT_FOUND, "no instance " + path.toString());
}

void Router::requireConsistent(const Operation& operation, const Instance& instance, const char** properties) {
  const ClassDefinition& definition = operation.definition;
  if (!sameName(instance.definition().name, definition.name)) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER,
                      "an instance of " + instance.definition().name + " cannot have a path of " + definition.name);
  }
  const auto requireSame = [&](const std::string& name, const Value* value) {
    const Value* key = operation.path.keys.find(name);
    if (key && value && !key->isNull() && !value->isNull() && !sameKey(*key, *value, operation.path.nameSpace)) {
      throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "key " + name + " of the instance is " + value->toString() +
                                                           ", that of its path " + key->toString());
    }
  };
  const Instance sent = instance.withoutDefaults();
  for (const PropertyDeclaration& property : definition.properties) {
    if (property.isKey()) {
      requireSame(property.name, sent.find(property.name));
    }
  }
  const Shared<ObjectPath> own = instance.path();
  for (const auto& [name, value] : own->keys) {
    requireSame(name, &value);
  }
  for (; properties && *properties; ++properties) {
    if (!definition.findProperty(*properties)) {
      throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, "class " + definition.name + " has no property " + *properties);
    }
  }
}

void Router::modifyInstance(const Operation& operation, const Instance& instance, const char** properties) {
  Provider& provider = writingProviderOf(providers_, operation);
  if (strictness_ == Strictness::Exact) {
    requireConsistent(operation, instance, properties);
  }
  ObjectPath complete = operation.path;
  const Shared<ObjectPath> own = instance.path();
  for (const auto& [name, value] : own->keys) {
    if (!complete.keys.find(name)) {
      complete.keys.set(name, value);
    }
  }
  Instance modified = inClass(operation.definition, instance);
  if (strictness_ == Strictness::Exact) {
    requireThere(operation, complete);
    dropUnlisted(modified, properties);
  }
  modified.setPath(complete);
  const auto path = lend(std::move(complete));
  const auto whole = lend(std::move(modified));
  CMPIInstanceMI* mi = provider.instanceMi(&operation.core.broker);
  callProvider(operation, provider, mi, CMPI_null, mi->ft->modifyInstance, &path, &whole, properties);
}

void Router::deleteInstance(const Operation& operation) {
  Provider& provider = writingProviderOf(providers_, operation);
  const auto path = lend(operation.path);
  CMPIInstanceMI* mi = provider.instanceMi(&operation.core.broker);
  callProvider(operation, provider, mi, CMPI_null, mi->ft->deleteInstance, &path);
}

}  // namespace Cimom
