#include "cimom/routing/AssociationOperations.h"

#include <algorithm>
#include <iterator>

namespace Cimom {
namespace {

bool canRefer(const ClassDefinition& association, const ClassDefinition& source) {
  return std::ranges::any_of(association.properties, [&](const PropertyDeclaration& property) {
    return property.isReference() && source.isA(property.referenceClass);
  });
}

/// Whether an association class is one that the caller asks for.
bool isAsked(const ClassDefinition& association, const Operation& operation, const char* named) {
  if (named && sameName(association.name, named)) return true;
  return (!named || association.isA(named)) && canRefer(association, operation.definition);
}

/// Calls `call` with the provider, the path and the class's name for every association class that is asked for.
template <class Call>
std::vector<Value> forEachAssociation(const Operation& operation, const char* named, Call call) {
  if (named && !operation.core.classes.find(named)) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string("no association class \"") + named + "\"");
  }
  const auto path = lend(operation.path);
  std::vector<Value> all;
  for (const auto& entry : operation.core.providers.entries()) {
    const ClassDefinition* association = operation.core.classes.find(entry.registration.className);
    if (!association || !entry.registration.association || !entry.serves(operation.path.nameSpace)) continue;
    if (!isAsked(*association, operation, named)) continue;
    CMPIAssociationMI* mi = entry.provider->associationMi(&operation.core.broker);
    std::vector<Value> some = call(*entry.provider, mi, &path, association->name.c_str());
    std::ranges::move(some, std::back_inserter(all));
  }
  return all;
}

}  // namespace

std::vector<Value> associators(const Operation& operation, const AssociationFilter& filter, const char** properties) {
  return forEachAssociation(
      operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_instance, mi->ft->associators, path, association,
                            filter.resultClass, filter.role, filter.resultRole, properties);
      });
}

std::vector<Value> associatorNames(const Operation& operation, const AssociationFilter& filter) {
  return forEachAssociation(
      operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_ref, mi->ft->associatorNames, path, association,
                            filter.resultClass, filter.role, filter.resultRole);
      });
}

std::vector<Value> references(const Operation& operation, const AssociationFilter& filter, const char** properties) {
  return forEachAssociation(
      operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_instance, mi->ft->references, path, association, filter.role,
                            properties);
      });
}

std::vector<Value> referenceNames(const Operation& operation, const AssociationFilter& filter) {
  return forEachAssociation(
      operation, filter.associationClass,
      [&](const Provider& provider, CMPIAssociationMI* mi, const CMPIObjectPath* path, const char* association) {
        return callProvider(operation, provider, mi, CMPI_ref, mi->ft->referenceNames, path, association, filter.role);
      });
}

}  // namespace Cimom
