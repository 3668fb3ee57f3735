// SPDX-License-Identifier: Apache-2.0
#include <algorithm>

#include "cimom/model/Types.h"
#include "cimom/routing/ProviderCall.h"
#include "cimom/routing/Router.h"

namespace Cimom {
namespace {

Provider& methodProviderOf(const ProviderRegistry& providers, const Operation& operation,
                           const MethodDeclaration& method) {
  for (const ClassDefinition* one = &operation.definition; one; one = one->superclass) {
    const auto& entries = providers.entries();
    const auto found = std::ranges::find_if(entries, [&](const ProviderRegistry::Entry& entry) {
      return entry.registration.method && sameName(entry.registration.className, one->name) &&
             entry.serves(operation.path.nameSpace);
    });
    if (found != entries.end()) {
      return *found->provider;
    }
  }
  throw StatusError(CMPI_RC_ERR_METHOD_NOT_AVAILABLE,
                    operation.definition.name + "." + method.name + " has no provider in " + operation.path.nameSpace);
}

// What the provider delivers, with the type that is declared for it.
Value declared(const Value& value, CMPIType type, const Operation& operation, const std::string& what) {
  std::optional<Value> typed = value.as(type);
  if (!typed) {
    throw StatusError(CMPI_RC_ERR_TYPE_MISMATCH, "the provider returned " + describeType(value.type()) + " as " + what +
                                                     ", which must be " + describeType(type));
  }
  completeNamespace(*typed, operation.path.nameSpace);
  return *std::move(typed);
}

}  // namespace

Value Router::invokeMethod(const Operation& operation, const MethodDeclaration& method, const NamedValues& in,
                           NamedValues& out) {
  Provider& provider = methodProviderOf(providers_, operation, method);
  CMPIMethodMI* mi = provider.methodMi(&operation.core.broker);
  const auto path = lend(operation.path);
  const auto given = lend(Args{in});
  auto returned = lend(Args{});
  std::vector<Value> results = callProvider(operation, provider, mi, CMPI_null, mi->ft->invokeMethod, &path,
                                            method.name.c_str(), &given, &returned);
  const std::string name = operation.definition.name + "." + method.name;
  for (const auto& [parameter, value] : returned.model.arguments) {
    if (const PropertyDeclaration* declaration = findNamed(method.parameters, parameter)) {
      out.set(declaration->name, declared(value, declaration->valueType(), operation, name + "." + declaration->name));
    }
  }
  const CMPIType type = valueType(method.returnType, method.qualifiers);
  return results.empty() ? Value::null(type) : declared(results.front(), type, operation, name);
}

}  // namespace Cimom
