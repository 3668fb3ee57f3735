// SPDX-License-Identifier: Apache-2.0
// What the interop namespace holds of the object manager itself: the manager, its namespaces, and the profiles that the
// model follows in parts (DSP1033), with the associations between them and to what conforms.
#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "cimom/interop/Profiles.h"
#include "cimom/model/Instance.h"
#include "cimom/model/ObjectPath.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom {

inline constexpr const char* interopNamespace = "root/interop";

// What the model says of the program that it stands in.
struct InteropFacts {
  std::string host;
  std::string version;
  std::vector<Profile> profiles;
};

class InteropModel {
 public:
  // The paths of the instances of a class in a namespace, as its own provider names them; none where that fails.
  using NamesOf = std::function<std::vector<ObjectPath>(const std::string& nameSpace, const std::string& className)>;

  // An association's instance that leads from an object to another.
  struct Step {
    Instance association;
    ObjectPath farEnd;
  };

  InteropModel(const ClassRepository& classes, InteropFacts facts) : classes_(classes), facts_(std::move(facts)) {}

  // The classes that are declared of those that it has instances of; none if the first of them are missing.
  struct ServedClass {
    std::string name;
    bool isAssociation;
  };
  std::vector<ServedClass> servedClasses() const;

  // All instances of one of these classes.
  std::vector<Instance> instancesOf(const std::string& className, const NamesOf& namesOf) const;

  // The instances of an association class that have the object as one end, with their other end.
  std::vector<Step> stepsFrom(const ObjectPath& from, const std::string& association, const NamesOf& namesOf) const;

 private:
  struct Link {
    ObjectPath first;
    ObjectPath second;
  };
  using Instances = std::vector<Instance> (InteropModel::*)() const;
  using Links = std::vector<Link> (InteropModel::*)(const NamesOf&) const;

  // A class of objects and how its instances are made.
  struct ObjectRow {
    const char* className;
    Instances instances;
  };
  // An association class, the names of its two references, and what it links.
  struct AssociationRow {
    const char* className;
    const char* first;
    const char* second;
    Links links;
  };

  static const ObjectRow objects[3];
  static const AssociationRow associations[3];

  std::vector<Instance> objectManagers() const;
  std::vector<Instance> namespaces() const;
  std::vector<Instance> profiles() const;
  std::vector<Link> namespacesInManager(const NamesOf& namesOf) const;
  std::vector<Link> conformances(const NamesOf& namesOf) const;
  std::vector<Link> referencedProfiles(const NamesOf& namesOf) const;

  Instance make(const char* className, const NamedValues& properties) const;
  ObjectPath pathOfProfile(const Profile& profile) const;
  Instance linkOf(const AssociationRow& row, const Link& link) const;

  const ClassRepository& classes_;
  InteropFacts facts_;
};

}  // namespace Cimom
