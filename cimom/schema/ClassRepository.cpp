// SPDX-License-Identifier: Apache-2.0
#include "cimom/schema/ClassRepository.h"

#include <algorithm>
#include <utility>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

[[noreturn]] void fail(const ClassDeclaration& declaration, const std::string& what) {
  throw ConfigurationError(declaration.own.declaredAt + ": class " + declaration.own.name + " " + what);
}

// Adds the qualifiers that a class or feature takes over from the one that it derives from or overrides; restricted
// ones stay with the class that has them.
void inheritQualifiers(Qualifiers& own, const Qualifiers& inherited) {
  for (const Qualifier& qualifier : inherited) {
    if (qualifier.toSubclass && !findQualifier(own, qualifier.name)) {
      own.push_back(qualifier);
      own.back().propagated = true;
    }
  }
}

Qualifiers inheritedQualifiers(const Qualifiers& qualifiers) {
  Qualifiers own;
  inheritQualifiers(own, qualifiers);
  return own;
}

// What a subclass takes over as it is.
PropertyDeclaration inherited(PropertyDeclaration property) {
  property.qualifiers = inheritedQualifiers(property.qualifiers);
  property.propagated = true;
  return property;
}

MethodDeclaration inherited(MethodDeclaration method) {
  method.qualifiers = inheritedQualifiers(method.qualifiers);
  for (PropertyDeclaration& parameter : method.parameters) {
    parameter.qualifiers = inheritedQualifiers(parameter.qualifiers);
  }
  method.propagated = true;
  return method;
}

// Takes the features of the superclass over, those in their place that the class overrides.
void inherit(ClassDefinition& resolved, const ClassDeclaration& declaration, const ClassDefinition& superclass) {
  inheritQualifiers(resolved.qualifiers, superclass.qualifiers);
  resolved.properties.clear();
  resolved.methods.clear();
  for (const PropertyDeclaration& property : superclass.properties) {
    resolved.properties.add(inherited(property));
  }
  for (const MethodDeclaration& method : superclass.methods) {
    resolved.methods.add(inherited(method));
  }
  for (PropertyDeclaration property : declaration.own.properties) {
    PropertyDeclaration* overridden = resolved.properties.find(property.name);
    if (!overridden) {
      resolved.properties.add(std::move(property));
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
    MethodDeclaration* overridden = resolved.methods.find(method.name);
    if (!overridden) {
      resolved.methods.add(std::move(method));
      continue;
    }
    inheritQualifiers(method.qualifiers, overridden->qualifiers);
    for (PropertyDeclaration& parameter : method.parameters) {
      if (const PropertyDeclaration* same = findNamed(overridden->parameters, parameter.name)) {
        inheritQualifiers(parameter.qualifiers, same->qualifiers);
      }
    }
    method.originClass = overridden->originClass;
    *overridden = std::move(method);
  }
}

// Builds the resolved form of a class from its superclass's.
ClassDefinition resolve(const ClassDeclaration& declaration, const ClassDefinition* superclass) {
  ClassDefinition resolved = declaration.own;
  resolved.superclass = superclass;
  if (superclass) {
    inherit(resolved, declaration, *superclass);
  }
  for (std::size_t index = 0; index < resolved.properties.size(); ++index) {
    if (resolved.properties[index].isKey()) {
      resolved.keys.push_back(index);
      resolved.keyNames.own().push_back(resolved.properties[index].name);
    }
  }
  return resolved;
}

using Classes = std::map<std::string, ClassDefinition, NameLess>;
using Declared = std::map<std::string_view, const ClassDeclaration*, NameLess>;

const ClassDefinition* findIn(const Classes& classes, std::string_view name) {
  const auto found = classes.find(name);
  return found == classes.end() ? nullptr : &found->second;
}

// Resolves classes against each other and, where they are not among themselves, against those that `known` finds.
template <typename Known>
Classes resolveAll(const Declared& declared, Known known) {
  Classes resolved;
  const auto lookUp = [&](std::string_view name) {
    const ClassDefinition* found = findIn(resolved, name);
    return found ? found : known(name);
  };
  for (const auto& [name, declaration] : declared) {
    // From the class up to the nearest ancestor that is resolved, then down again.
    std::vector<const ClassDeclaration*> pending;
    const ClassDeclaration* next = declaration;
    while (next && !findIn(resolved, next->own.name)) {
      if (std::ranges::find(pending, next) != pending.end()) {
        fail(*next, "is its own superclass");
      }
      pending.push_back(next);
      const auto superclass = declared.find(next->superclassName);
      if (superclass == declared.end() && !next->superclassName.empty() && !known(next->superclassName)) {
        fail(*next, "has the undeclared superclass " + next->superclassName);
      }
      next = superclass == declared.end() ? nullptr : superclass->second;
    }
    for (; !pending.empty(); pending.pop_back()) {
      const ClassDeclaration& one = *pending.back();
      const ClassDefinition* superclass = one.superclassName.empty() ? nullptr : lookUp(one.superclassName);
      resolved.emplace(one.own.name, resolve(one, superclass));
    }
  }
  return resolved;
}

}  // namespace

const ClassDefinition* ClassRepository::find(std::string_view nameSpace, std::string_view className) const {
  const auto place = namespaces_.find(bareNamespace(nameSpace));
  if (place == namespaces_.end()) {
    return nullptr;
  }
  const auto found = place->second.shown.find(className);
  return found == place->second.shown.end() ? nullptr : found->second;
}

const ClassDefinition* ClassRepository::find(std::string_view className) const {
  const ClassDefinition* found = findIn(schema_, className);
  for (auto place = namespaces_.begin(); !found && place != namespaces_.end(); ++place) {
    found = findIn(place->second.own, className);
  }
  return found;
}

std::vector<const ClassDefinition*> ClassRepository::all() const {
  std::vector<const ClassDefinition*> result;
  const auto append = [&](const Classes& classes) {
    for (const auto& [name, definition] : classes) {
      result.push_back(&definition);
    }
  };
  append(schema_);
  for (const auto& [name, place] : namespaces_) {
    append(place.own);
  }
  return result;
}

std::vector<const ClassDefinition*> ClassRepository::subclasses(std::string_view nameSpace, std::string_view className,
                                                                bool deep) const {
  std::vector<const ClassDefinition*> result;
  const auto place = namespaces_.find(bareNamespace(nameSpace));
  if (place == namespaces_.end()) {
    return result;
  }
  for (const auto& [name, definition] : place->second.shown) {
    const ClassDefinition* superclass = definition->superclass;
    const bool direct = superclass ? sameName(superclass->name, className) : className.empty();
    const bool below = className.empty() || (superclass && superclass->isA(className));
    if (deep ? below : direct) {
      result.push_back(definition);
    }
  }
  std::ranges::sort(result, NameLess(), &ClassDefinition::name);
  return result;
}

const QualifierDeclaration* ClassRepository::findQualifierDeclaration(std::string_view name) const {
  const auto found = qualifiers_.find(name);
  return found == qualifiers_.end() ? nullptr : &found->second;
}

std::vector<const QualifierDeclaration*> ClassRepository::qualifierDeclarations() const {
  std::vector<const QualifierDeclaration*> result;
  for (const auto& [name, declaration] : qualifiers_) {
    result.push_back(&declaration);
  }
  return result;
}

bool ClassRepository::hasNamespace(std::string_view nameSpace) const {
  return namespaces_.contains(bareNamespace(nameSpace));
}

std::vector<std::string> ClassRepository::namespaces() const {
  std::vector<std::string> names;
  for (const auto& [name, place] : namespaces_) {
    names.push_back(name);
  }
  return names;
}

void ClassRepository::addNamespace(std::string_view nameSpace) {
  nameSpace = bareNamespace(nameSpace);
  if (!nameSpace.empty()) {
    namespaces_.try_emplace(std::string(nameSpace));
  }
}

void ClassRepository::show(std::string_view nameSpace, std::string_view className) {
  addNamespace(nameSpace);
  const auto place = namespaces_.find(bareNamespace(nameSpace));
  if (place != namespaces_.end()) {
    place->second.asked.emplace(className);
    revealAsked(place->second, schema_);
  }
}

void ClassRepository::showSchema(std::string_view nameSpace) {
  addNamespace(nameSpace);
  const auto place = namespaces_.find(bareNamespace(nameSpace));
  if (place != namespaces_.end()) {
    for (const auto& [name, definition] : schema_) {
      place->second.asked.insert(name);
    }
    revealAsked(place->second, schema_);
  }
}

void ClassRepository::reveal(Namespace& nameSpace, const ClassDefinition& definition, const Classes& schema) {
  if (!nameSpace.shown.emplace(definition.name, &definition).second) {
    return;
  }
  if (definition.superclass) {
    reveal(nameSpace, *definition.superclass, schema);
  }
  const auto revealNamed = [&](std::string_view name) {
    const ClassDefinition* own = findIn(nameSpace.own, name);
    if (const ClassDefinition* named = own ? own : findIn(schema, name)) {
      reveal(nameSpace, *named, schema);
    }
  };
  const auto revealNeeded = [&](const PropertyDeclaration& declaration) {
    revealNamed(declaration.referenceClass);
    const Qualifier* embedded = findQualifier(declaration.qualifiers, "EmbeddedInstance");
    if (const std::string* name = embedded ? embedded->value.text() : nullptr) {
      revealNamed(*name);
    }
  };
  std::ranges::for_each(definition.properties, revealNeeded);
  for (const MethodDeclaration& method : definition.methods) {
    std::ranges::for_each(method.parameters, revealNeeded);
  }
}

void ClassRepository::revealAsked(Namespace& nameSpace, const Classes& schema) {
  for (const auto& [name, definition] : nameSpace.own) {
    reveal(nameSpace, definition, schema);
  }
  for (const std::string& name : nameSpace.asked) {
    if (const ClassDefinition* definition = findIn(schema, name)) {
      reveal(nameSpace, *definition, schema);
    }
  }
}

void ClassRepository::add(const MofDeclarations& declarations) {
  const auto ownOf = [&](std::string_view nameSpace) -> const Classes& {
    static const Classes none;
    const auto place = namespaces_.find(nameSpace);
    return place == namespaces_.end() ? none : place->second.own;
  };
  std::map<std::string_view, Declared, NameLess> declared;  // by namespace, the schema under the empty name
  for (const ClassDeclaration& declaration : declarations.classes) {
    const std::string_view nameSpace = bareNamespace(declaration.nameSpace);
    const ClassDefinition* known = findIn(nameSpace.empty() ? schema_ : ownOf(nameSpace), declaration.own.name);
    if (known) {
      fail(declaration, "is already declared at " + known->declaredAt);
    }
    const auto [earlier, isNew] = declared[nameSpace].emplace(declaration.own.name, &declaration);
    if (!isNew) {
      fail(declaration, "is already declared at " + earlier->second->own.declaredAt);
    }
  }

  // The new classes are resolved beside the known ones and join them only when all is well. Map nodes keep their
  // address when they move, so superclass pointers stay good.
  Classes schema = resolveAll(declared[{}], [&](std::string_view className) { return findIn(schema_, className); });
  declared.erase(std::string_view());
  std::map<std::string_view, Classes, NameLess> own;
  for (const auto& [nameSpace, classes] : declared) {
    own[nameSpace] = resolveAll(classes, [&, here = nameSpace](std::string_view className) {
      for (const Classes* place : {&ownOf(here), &std::as_const(schema), &std::as_const(schema_)}) {
        if (const ClassDefinition* found = findIn(*place, className)) {
          return found;
        }
      }
      return static_cast<const ClassDefinition*>(nullptr);
    });
  }
  schema_.merge(schema);
  for (const QualifierDeclaration& declaration : declarations.qualifiers) {
    qualifiers_.insert_or_assign(declaration.qualifier.name, declaration);
  }
  for (const std::string& nameSpace : declarations.namespaces) {
    addNamespace(nameSpace);
  }
  for (auto& [nameSpace, classes] : own) {
    addNamespace(nameSpace);
    Namespace& place = namespaces_.find(nameSpace)->second;
    for (const auto& [className, definition] : classes) {
      place.shown.erase(className);  // the namespace's own class goes before the schema's of that name
    }
    place.own.merge(classes);
  }
  for (auto& [nameSpace, place] : namespaces_) {
    revealAsked(place, schema_);
  }
}

}  // namespace Cimom
