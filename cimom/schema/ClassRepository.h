// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <map>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "cimom/model/ClassDefinition.h"
#include "cimom/model/Names.h"
#include "cimom/schema/Mof.h"

namespace Cimom {

// Every class that the object manager knows, resolved: inherited features, keys and defaults in place. Names are
// found without regard to case.
//
// Every class is known in every namespace, and a namespace is known when a registration, a `#pragma namespace` or
// the loader of a schema names it. That is all that an object manager needs whose instances come from providers
// only: if a class has no provider, it has no instances.
class ClassRepository {
 public:
  // The class of that name, or null. The pointer stays good as long as the repository.
  const ClassDefinition* find(std::string_view className) const;

  // All classes, by name.
  std::vector<const ClassDefinition*> all() const;

  // The direct subclasses, or all below if `deep` says so; an empty name stands for the root of all classes.
  std::vector<const ClassDefinition*> subclasses(std::string_view className, bool deep) const;

  bool hasNamespace(std::string_view nameSpace) const;
  // All namespaces, by name.
  std::vector<std::string> namespaces() const;
  void addNamespace(std::string_view nameSpace);

  // Adds what was read from MOF; the order of the classes does not matter.
  // Throws ConfigurationError for a class that is there already, a superclass that nowhere is, a circle of
  //         superclasses or a property that changes the type of the one that it overrides; nothing is added then.
  void add(const MofDeclarations& declarations);

 private:
  using Classes = std::map<std::string, ClassDefinition, NameLess>;

  Classes classes_;
  std::set<std::string, NameLess> namespaces_;
};

}  // namespace Cimom
