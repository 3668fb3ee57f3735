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

// Every class that the object manager knows, resolved: inherited features, keys and defaults in place; and the
// declarations of the qualifiers, which count in every namespace. Names are found without regard to case.
//
// A class that stands under a `#pragma namespace` belongs to that namespace, which may have a class of a name that
// another namespace has too. All other classes are one schema, of which a namespace shows what somebody has asked to
// be shown there (a registration, mostly) and what that is made from: superclasses, the classes that references refer
// to, embedded classes.
class ClassRepository {
 public:
  // The class of that name as the namespace shows it, or null. The pointer stays good as long as the repository.
  const ClassDefinition* find(std::string_view nameSpace, std::string_view className) const;

  // The class of that name wherever it is, for objects that name no namespace: that of the one schema before that of
  // any namespace. Null if there is none.
  const ClassDefinition* find(std::string_view className) const;

  // All classes by name, of all namespaces and of none.
  std::vector<const ClassDefinition*> all() const;

  // The direct subclasses that the namespace shows, or all below if `deep` says so, by name; an empty name stands for
  // the root of all classes.
  std::vector<const ClassDefinition*> subclasses(std::string_view nameSpace, std::string_view className,
                                                 bool deep) const;

  // The declaration of a qualifier, the last one that was added; null if there is none.
  const QualifierDeclaration* findQualifierDeclaration(std::string_view name) const;
  // All of them, by name.
  std::vector<const QualifierDeclaration*> qualifierDeclarations() const;

  bool hasNamespace(std::string_view nameSpace) const;
  // All namespaces, by name.
  std::vector<std::string> namespaces() const;
  void addNamespace(std::string_view nameSpace);

  // Adds what was read from MOF; the order of the classes does not matter.
  // Throws ConfigurationError for a class that is there already, a superclass that nowhere is, a circle of
  //         superclasses or a property that changes the type of the one that it overrides; nothing is added then.
  void add(const MofDeclarations& declarations);

  // Makes the namespace known and has it show a class and what that is made from; one that is added later counts too.
  void show(std::string_view nameSpace, std::string_view className);
  // The same with every class of the one schema that is there so far.
  void showSchema(std::string_view nameSpace);

 private:
  using Classes = std::map<std::string, ClassDefinition, NameLess>;

  struct Namespace {
    Classes own;                            // that stand under its pragma
    ByName<const ClassDefinition*> shown;   // those, and what it shows of the schema
    std::set<std::string, NameLess> asked;  // to be shown
  };

  using Namespaces = std::map<std::string, Namespace, NameLess>;

  static void reveal(Namespace& nameSpace, const ClassDefinition& definition, const Classes& schema);
  static void revealAsked(Namespace& nameSpace, const Classes& schema);

  Classes schema_;
  std::map<std::string, QualifierDeclaration, NameLess> qualifiers_;
  Namespaces namespaces_;
};

}  // namespace Cimom
