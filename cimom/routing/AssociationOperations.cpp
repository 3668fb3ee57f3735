// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <iterator>

#include "cimom/routing/ProviderCall.h"
#include "cimom/routing/Router.h"

namespace Cimom {
namespace {

bool canRefer(const ClassDefinition& association, const ClassDefinition& source) {
  return std::ranges::any_of(association.properties, [&](const PropertyDeclaration& property) {
    return property.isReference() && source.isA(property.referenceClass);
  });
}

// Whether an association class is one that the caller asks for.
bool isAsked(const ClassDefinition& association, const Operation& operation, const char* named) {
  if (named && sameName(association.name, named)) {
    return true;
  }
  return (!named || association.isA(named)) && canRefer(association, operation.definition);
}

// Calls `call` with the provider, the path and the class's name for every association class that is asked for.
template <typename Call>
std::vector<Value> forEachAssociation(const ProviderRegistry& providers, const Operation& operation, const char* named,
                                      Call call) {
  if (named && !operation.core.classes.find(operation.path.nameSpace, named)) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string("unknown association class \"") + named + "\"");
  }
  const auto path = lend(operation.path);
  std::vector<Value> all;
  for (const auto& entry : providers.entries()) {
    const ClassDefinition* association =
        operation.core.classes.find(operation.path.nameSpace, entry.registration.className);
    if (!association || !entry.registration.association || !entry.serves(operation.path.nameSpace)) {
      continue;
    }
    if (!isAsked(*association, operation, named)) {
      continue;
    }
    CMPIAssociationMI* mi = entry.provider->associationMi(&operation.core.broker);
    std::vector<Value> some = call(*entry.provider, mi, &path, association->name.c_str());
    std::ranges::move(some, std::back_inserter(all));
  }
  return all;
}

}  // namespace

std::vector<Value> Router::associators(const Operation& operation, const AssociationFilter& filter,
                                       const char** properties) {
  return forEachAssociation(
      providers_, operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_instance, mi->ft->associators, path, association,
                            filter.resultClass, filter.role, filter.resultRole, properties);
      });
}

std::vector<Value> Router::associatorNames(const Operation& operation, const AssociationFilter& filter) {
  return forEachAssociation(
      providers_, operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_ref, mi->ft->associatorNames, path, association,
                            filter.resultClass, filter.role, filter.resultRole);
      });
}

std::vector<Value> Router::references(const Operation& operation, const AssociationFilter& filter,
                                      const char** properties) {
  return forEachAssociation(
      providers_, operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_instance, mi->ft->references, path, association, filter.role,
                            properties);
      });
}

std::vector<Value> Router::referenceNames(const Operation& operation, const AssociationFilter& filter) {
  return forEachAssociation(
      providers_, operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_ref, mi->ft->referenceNames, path, association, filter.role);
      });
}

}  // namespace Cimom
