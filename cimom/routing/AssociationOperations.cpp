// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <iterator>

#include "cimom/routing/AssociationCheck.h"
#include "cimom/routing/ProviderCall.h"
#include "cimom/routing/Router.h"

namespace Cimom {
namespace {

// An association class that is asked for, the provider that answers for it, and the source.
struct Asked {
  const ClassDefinition& association;
  const Provider& provider;
  CMPIAssociationMI* mi;
  const CMPIObjectPath* path;

  const char* name() const { return association.name.c_str(); }
};

bool canRefer(const ClassDefinition& association, const ClassDefinition& source) {
  return std::ranges::any_of(association.properties, [&](const PropertyDeclaration& property) {
    return property.isReference() && source.isA(property.referenceClass);
  });
}

// Whether an association class is asked for where requests are not checked: the one that is named is, whatever it
// refers to.
bool isAskedUnchecked(const ClassDefinition& association, const Operation& operation, const char* named) {
  if (named && sameName(association.name, named)) {
    return true;
  }
  return (!named || association.isA(named)) && canRefer(association, operation.definition);
}

// Calls `call` for every association class that is asked for.
template <typename IsAsked, typename Call>
std::vector<Value> forEachAssociation(const ProviderRegistry& providers, const Operation& operation, IsAsked isAsked,
                                      Call call) {
  const auto path = lend(operation.path);
  std::vector<Value> all;
  for (const auto& entry : providers.entries()) {
    if (!entry.registration.association || !entry.serves(operation.path.nameSpace)) {
      continue;
    }
    const ClassDefinition* association =
        operation.core.classes.find(operation.path.nameSpace, entry.registration.className);
    if (!association || !isAsked(*association)) {
      continue;
    }
    std::vector<Value> some =
        call(Asked{*association, *entry.provider, entry.provider->associationMi(&operation.core.broker), &path});
    std::ranges::move(some, std::back_inserter(all));
  }
  return all;
}

}  // namespace

template <typename Call, typename Keep>
std::vector<Value> Router::traverse(const Operation& operation, const AssociationFilter& filter, Call call, Keep keep) {
  const char* named = filter.associationClass;
  if (strictness_ == Strictness::Bare) {
    if (named && !operation.core.classes.find(operation.path.nameSpace, named)) {
      throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string("unknown association class \"") + named + "\"");
    }
    return forEachAssociation(
        providers_, operation,
        [&](const ClassDefinition& association) { return isAskedUnchecked(association, operation, named); }, call);
  }
  const AssociationCheck check(operation, filter);
  check.requireClasses();
  requireThere(operation, operation.path);
  return forEachAssociation(
      providers_, operation, [&](const ClassDefinition& association) { return check.canLead(association); },
      [&](const Asked& asked) {
        std::vector<Value> answers = call(asked);
        keep(check, asked, answers);
        return answers;
      });
}

template <typename Call>
std::vector<Value> Router::traverseToObjects(const Operation& operation, const AssociationFilter& filter, Call call) {
  return traverse(operation, filter, call,
                  [&](const AssociationCheck& check, const Asked& asked, std::vector<Value>& answers) {
                    const char** allProperties = nullptr;
                    const char* anyRole = nullptr;
                    check.filterAssociated(asked.association, answers, [&] {
                      return callProvider(operation, asked.provider, asked.mi, CMPI_instance, asked.mi->ft->references,
                                          asked.path, asked.name(), anyRole, allProperties);
                    });
                  });
}

template <typename Call>
std::vector<Value> Router::traverseToAssociations(const Operation& operation, const AssociationFilter& filter,
                                                  Call call) {
  return traverse(operation, filter, call,
                  [](const AssociationCheck& check, const Asked&, std::vector<Value>& answers) {
                    std::erase_if(answers, [&](const Value& answer) { return !check.isReference(answer); });
                  });
}

std::vector<Value> Router::associators(const Operation& operation, const AssociationFilter& filter,
                                       const char** properties) {
  return traverseToObjects(operation, filter, [&](const Asked& asked) {
    return callProvider(operation, asked.provider, asked.mi, CMPI_instance, asked.mi->ft->associators, asked.path,
                        asked.name(), filter.resultClass, filter.role, filter.resultRole, properties);
  });
}

std::vector<Value> Router::associatorNames(const Operation& operation, const AssociationFilter& filter) {
  return traverseToObjects(operation, filter, [&](const Asked& asked) {
    return callProvider(operation, asked.provider, asked.mi, CMPI_ref, asked.mi->ft->associatorNames, asked.path,
                        asked.name(), filter.resultClass, filter.role, filter.resultRole);
  });
}

std::vector<Value> Router::references(const Operation& operation, const AssociationFilter& filter,
                                      const char** properties) {
  return traverseToAssociations(operation, filter, [&](const Asked& asked) {
    return callProvider(operation, asked.provider, asked.mi, CMPI_instance, asked.mi->ft->references, asked.path,
                        asked.name(), filter.role, properties);
  });
}

std::vector<Value> Router::referenceNames(const Operation& operation, const AssociationFilter& filter) {
  return traverseToAssociations(operation, filter, [&](const Asked& asked) {
    return callProvider(operation, asked.provider, asked.mi, CMPI_ref, asked.mi->ft->referenceNames, asked.path,
                        asked.name(), filter.role);
  });
}

}  // namespace Cimom
