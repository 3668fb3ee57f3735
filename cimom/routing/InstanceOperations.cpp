// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <iterator>
#include <optional>

#include "cimom/routing/ProviderCall.h"
#include "cimom/routing/Router.h"

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

Value Router::getInstance(const Operation& operation, const char** properties) {
  if (Provider* provider = providerOf(providers_, operation)) {
    const auto path = lend(operation.path);
    CMPIInstanceMI* mi = provider->instanceMi(&operation.core.broker);
    std::vector<Value> found =
        callProvider(operation, *provider, mi, CMPI_instance, mi->ft->getInstance, &path, properties);
    if (!found.empty()) {
      return std::move(found.front());
    }
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

void Router::modifyInstance(const Operation& operation, const Instance& instance, const char** properties) {
  Provider& provider = writingProviderOf(providers_, operation);
  ObjectPath complete = operation.path;
  for (const auto& [name, value] : instance.path().keys) {
    if (!complete.keys.find(name)) {
      complete.keys.set(name, value);
    }
  }
  Instance modified = instance.withoutDefaults();
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
