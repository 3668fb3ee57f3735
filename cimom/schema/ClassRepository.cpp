// SPDX-License-Identifier: Apache-2.0
#include "cimom/schema/ClassRepository.h"

#include <algorithm>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

[[noreturn]] void fail(const ClassDeclaration& declaration, const std::string& what) {
  throw ConfigurationError(declaration.own.declaredAt + ": class " + declaration.own.name + " " + what);
}

// Adds the qualifiers that a feature takes over from the one that it overrides or inherits.
void inheritQualifiers(Qualifiers& own, const Qualifiers& inherited) {
  for (const Qualifier& qualifier : inherited) {
    if (qualifier.toSubclass && !findQualifier(own, qualifier.name)) {
      own.push_back(qualifier);
    }
  }
}

// Builds the resolved form of a class from its superclass's.
ClassDefinition resolve(const ClassDeclaration& declaration, const ClassDefinition* superclass) {
  ClassDefinition resolved = declaration.own;
  resolved.superclass = superclass;
  if (!superclass) {
    return resolved;
  }
  inheritQualifiers(resolved.qualifiers, superclass->qualifiers);
  resolved.properties = superclass->properties;
  resolved.methods = superclass->methods;
  for (PropertyDeclaration& property : resolved.properties) {
    property.propagated = true;
  }
  for (MethodDeclaration& method : resolved.methods) {
    method.propagated = true;
  }
  for (PropertyDeclaration property : declaration.own.properties) {
    PropertyDeclaration* overridden = findNamed(resolved.properties, property.name);
    if (!overridden) {
      resolved.properties.push_back(std::move(property));
      continue;
    }
    if (overridden->type != property.type) {
      fail(declaration, "cannot change " + property.name + " of " + overridden->originClass + " from " +
                            describeType(overridden->type) + " to " + describeType(property.type));
    }
    inheritQualifiers(property.qualifiers, overridden->qualifiers);
    if (property.defaultValue.isNull()) {
      property.defaultValue = overridden->defaultValue;
    }
    property.originClass = overridden->originClass;
    *overridden = std::move(property);
  }
  for (MethodDeclaration method : declaration.own.methods) {
    MethodDeclaration* overridden = findNamed(resolved.methods, method.name);
    if (!overridden) {
      resolved.methods.push_back(std::move(method));
      continue;
    }
    inheritQualifiers(method.qualifiers, overridden->qualifiers);
    method.originClass = overridden->originClass;
    *overridden = std::move(method);
  }
  return resolved;
}

}  // namespace

const ClassDefinition* ClassRepository::find(std::string_view className) const {
  const auto found = classes_.find(className);
  return found == classes_.end() ? nullptr : &found->second;
}

std::vector<const ClassDefinition*> ClassRepository::all() const {
  std::vector<const ClassDefinition*> result;
  for (const auto& [name, definition] : classes_) {
    result.push_back(&definition);
  }
  return result;
}

std::vector<const ClassDefinition*> ClassRepository::subclasses(std::string_view className, bool deep) const {
  std::vector<const ClassDefinition*> result;
  for (const auto& [name, definition] : classes_) {
    const bool direct = definition.superclass ? sameName(definition.superclass->name, className) : className.empty();
    const bool below = className.empty() || (definition.superclass && definition.superclass->isA(className));
    if (deep ? below : direct) {
      result.push_back(&definition);
    }
  }
  return result;
}

bool ClassRepository::hasNamespace(std::string_view nameSpace) const {
  return namespaces_.contains(bareNamespace(nameSpace));
}

std::vector<std::string> ClassRepository::namespaces() const { return {namespaces_.begin(), namespaces_.end()}; }

void ClassRepository::addNamespace(std::string_view nameSpace) {
  nameSpace = bareNamespace(nameSpace);
  if (!nameSpace.empty()) {
    namespaces_.emplace(nameSpace);
  }
}

void ClassRepository::add(const MofDeclarations& declarations) {
  std::map<std::string_view, const ClassDeclaration*, NameLess> declared;
  for (const ClassDeclaration& declaration : declarations.classes) {
    const ClassDefinition* known = find(declaration.own.name);
    if (known) {
      fail(declaration, "is already declared at " + known->declaredAt);
    }
    const auto [earlier, isNew] = declared.emplace(declaration.own.name, &declaration);
    if (!isNew) {
      fail(declaration, "is already declared at " + earlier->second->own.declaredAt);
    }
  }

  // The new classes are resolved beside the known ones and join them only when all is well. Map nodes keep their
  // address when they move, so superclass pointers stay good.
  Classes added;
  const auto lookUp = [&](std::string_view name) -> const ClassDefinition* {
    const auto found = added.find(name);
    return found == added.end() ? find(name) : &found->second;
  };
  for (const ClassDeclaration& declaration : declarations.classes) {
    // From the class up to the nearest ancestor that is resolved, then down again.
    std::vector<const ClassDeclaration*> pending;
    const ClassDeclaration* next = &declaration;
    while (next && !lookUp(next->own.name)) {
      if (std::ranges::find(pending, next) != pending.end()) {
        fail(*next, "is its own superclass");
      }
      pending.push_back(next);
      const auto superclass = declared.find(next->superclassName);
      if (superclass == declared.end() && !next->superclassName.empty() && !lookUp(next->superclassName)) {
        fail(*next, "has the undeclared superclass " + next->superclassName);
      }
      next = superclass == declared.end() ? nullptr : superclass->second;
    }
    for (; !pending.empty(); pending.pop_back()) {
      const ClassDeclaration& one = *pending.back();
      const ClassDefinition* superclass = one.superclassName.empty() ? nullptr : lookUp(one.superclassName);
      added.emplace(one.own.name, resolve(one, superclass));
    }
  }
  classes_.merge(added);
  for (const std::string& nameSpace : declarations.namespaces) {
    addNamespace(nameSpace);
  }
}

}  // namespace Cimom
