// SPDX-License-Identifier: Apache-2.0
#include "cimom/routing/AssociationCheck.h"

#include <algorithm>
#include <optional>
#include <string>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"
#include "cimom/routing/SameObject.h"

namespace Cimom {
namespace {

bool isGiven(const char* text) { return text && *text; }

bool admits(const char* role, const std::string& name) { return !isGiven(role) || sameName(role, name); }

std::vector<const PropertyDeclaration*> referencesOf(const ClassDefinition& association) {
  std::vector<const PropertyDeclaration*> references;
  for (const PropertyDeclaration& property : association.properties) {
    if (property.isReference()) {
      references.push_back(&property);
    }
  }
  return references;
}

// Whether `check` holds for a reference, taken as the source's, and another one, taken as the result's.
template <typename Check>
bool anyPair(const ClassDefinition& association, Check check) {
  const auto references = referencesOf(association);
  return std::ranges::any_of(references, [&](const PropertyDeclaration* source) {
    return std::ranges::any_of(
        references, [&](const PropertyDeclaration* result) { return source != result && check(*source, *result); });
  });
}

// The path of an answer: of an instance its own.
Shared<ObjectPath> pathOf(const Value& answer) {
  const auto* path = answer.shared<ObjectPath>();
  return path ? *path : answer.embedded()->path();
}

}  // namespace

const ClassDefinition* AssociationCheck::classOf(const ObjectPath& path) const {
  return operation_.core.classes.find(path.nameSpace.empty() ? operation_.path.nameSpace : path.nameSpace,
                                      path.className);
}

void AssociationCheck::requireClasses() const {
  const auto require = [&](const char* name, const char* kind) -> const ClassDefinition* {
    if (!isGiven(name)) {
      return nullptr;
    }
    const ClassDefinition* definition = operation_.core.classes.find(operation_.path.nameSpace, name);
    if (!definition) {
      throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, std::string("unknown ") + kind + " class \"" + name + "\"");
    }
    return definition;
  };
  const ClassDefinition* association = require(filter_.associationClass, "association");
  if (association && !association->isAssociation()) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "class " + association->name + " is not an association");
  }
  require(filter_.resultClass, "result");
}

bool AssociationCheck::canBeSource(const Reference& reference) const {
  return operation_.definition.isA(reference.referenceClass);
}

bool AssociationCheck::isAskedPair(const Reference& source, const Reference& result) const {
  return admits(filter_.role, source.name) && admits(filter_.resultRole, result.name);
}

bool AssociationCheck::canLead(const ClassDefinition& association) const {
  if (isGiven(filter_.associationClass) && !association.isA(filter_.associationClass)) {
    return false;
  }
  const ClassDefinition* resultClass =
      isGiven(filter_.resultClass) ? operation_.core.classes.find(operation_.path.nameSpace, filter_.resultClass)
                                   : nullptr;
  return anyPair(association, [&](const Reference& source, const Reference& result) {
    const ClassDefinition* end = operation_.core.classes.find(operation_.path.nameSpace, result.referenceClass);
    return canBeSource(source) && isAskedPair(source, result) &&
           (!resultClass || resultClass->isA(result.referenceClass) || !end || end->isA(resultClass->name));
  });
}

bool AssociationCheck::isReference(const Value& answer) const {
  const Shared<ObjectPath> path = pathOf(answer);
  const ClassDefinition* definition = classOf(*path);
  if (isGiven(filter_.associationClass) && definition && !definition->isA(filter_.associationClass)) {
    return false;
  }
  if (!isGiven(filter_.role)) {
    return true;
  }
  const Instance* instance = answer.embedded();
  const Value* end = instance ? instance->find(filter_.role) : path->keys.find(filter_.role);
  if (!end) {
    return !instance;
  }
  return end->path() && sameObject(*end->path(), operation_.path, operation_.path.nameSpace);
}

void AssociationCheck::filterAssociated(const ClassDefinition& association, std::vector<Value>& answers,
                                        const References& references) const {
  const bool hasRole = isGiven(filter_.role) || isGiven(filter_.resultRole);
  std::optional<std::vector<Value>> instances;
  const auto isLinked = [&](const ObjectPath& result) {
    if (!instances) {
      instances = references();
    }
    const std::string& here = operation_.path.nameSpace;
    const auto isEnd = [&](const Instance& instance, const Reference& reference, const ObjectPath& object) {
      const Value* end = instance.find(reference.name);
      return end && end->path() && sameObject(*end->path(), object, here);
    };
    return std::ranges::any_of(*instances, [&](const Value& one) {
      const Instance* instance = one.embedded();
      return instance && anyPair(instance->definition(), [&](const Reference& source, const Reference& far) {
               return isAskedPair(source, far) && isEnd(*instance, source, operation_.path) &&
                      isEnd(*instance, far, result);
             });
    });
  };
  std::erase_if(answers, [&](const Value& answer) {
    const Shared<ObjectPath> path = pathOf(answer);
    const ClassDefinition* definition = classOf(*path);
    const auto isOf = [&](const std::string& className) {
      return definition ? definition->isA(className) : sameName(path->className, className);
    };
    if (isGiven(filter_.resultClass) && !isOf(filter_.resultClass)) {
      return true;
    }
    if (!hasRole) {
      return false;
    }
    const auto canBePair = [&](const Reference& source, const Reference& result) {
      return canBeSource(source) && (!definition || definition->isA(result.referenceClass));
    };
    // The same two the other way round, which is not what is asked for: associations of a class with itself.
    const auto mayBeReversed = [&](const Reference& source, const Reference& result) {
      return canBePair(result, source) && !isAskedPair(result, source);
    };
    const bool canBe = anyPair(association, [&](const Reference& source, const Reference& result) {
      return canBePair(source, result) && isAskedPair(source, result);
    });
    const bool must = anyPair(association, [&](const Reference& source, const Reference& result) {
      return canBePair(source, result) && isAskedPair(source, result) && !mayBeReversed(source, result);
    });
    return !must && (!canBe || !isLinked(*path));
  });
}

}  // namespace Cimom
