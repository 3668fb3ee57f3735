// SPDX-License-Identifier: Apache-2.0
#include "cimom/interop/InteropModel.h"

#include <algorithm>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"
#include "cimom/routing/SameObject.h"

namespace Cimom {
namespace {

constexpr const char* objectManagerClass = "CIM_ObjectManager";
constexpr const char* namespaceClass = "CIM_Namespace";
constexpr const char* profileClass = "CIM_RegisteredProfile";
constexpr const char* systemClass = "CIM_ComputerSystem";

constexpr CMPIUint16 other = 1;          // RegisteredOrganization
constexpr CMPIUint16 profileKind = 2;    // SpecificationType "Profile"
constexpr CMPIUint16 notAdvertised = 2;  // AdvertiseTypes
constexpr CMPIUint16 enabled = 2;        // EnabledState
constexpr CMPIUint16 unknown = 0;        // ClassInfo
constexpr const char* organization = "CompositeIPConfig";

Value uint16(CMPIUint16 number) {
  CMPIValue value{};
  value.uint16 = number;
  return Value::scalar(CMPI_uint16, value);
}

}  // namespace

const InteropModel::ObjectRow InteropModel::objects[3] = {{objectManagerClass, &InteropModel::objectManagers},
                                                          {namespaceClass, &InteropModel::namespaces},
                                                          {profileClass, &InteropModel::profiles}};

const InteropModel::AssociationRow InteropModel::associations[3] = {
    {"CIM_NamespaceInManager", "Antecedent", "Dependent", &InteropModel::namespacesInManager},
    {"CIM_ElementConformsToProfile", "ConformantStandard", "ManagedElement", &InteropModel::conformances},
    {"CIM_ReferencedProfile", "Antecedent", "Dependent", &InteropModel::referencedProfiles}};

std::vector<InteropModel::ServedClass> InteropModel::servedClasses() const {
  std::vector<ServedClass> served;
  if (!classes_.find(objectManagerClass) || !classes_.find(namespaceClass)) {
    return served;
  }
  const auto add = [&](const char* className, bool isAssociation) {
    if (classes_.find(className)) {
      served.push_back({className, isAssociation});
    }
  };
  for (const ObjectRow& row : objects) {
    add(row.className, false);
  }
  for (const AssociationRow& row : associations) {
    add(row.className, true);
  }
  return served;
}

Instance InteropModel::make(const char* className, const NamedValues& properties) const {
  const ClassDefinition* definition = classes_.find(className);
  if (!definition) {
    throw StatusError(CMPI_RC_ERR_INVALID_CLASS, std::string("unknown class \"") + className + "\"");
  }
  Instance instance(*definition, ObjectPath{{}, interopNamespace, className, {}});
  for (const auto& [name, value] : properties) {
    instance.set(name, value);
  }
  return instance;
}

std::vector<Instance> InteropModel::objectManagers() const {
  NamedValues properties;
  properties.set("SystemCreationClassName", Value::string(systemClass));
  properties.set("SystemName", Value::string(facts_.host));
  properties.set("CreationClassName", Value::string(objectManagerClass));
  properties.set("Name", Value::string("CompositeIPConfig:cimomd"));
  properties.set("ElementName", Value::string("cimomd"));
  // Clients take the version from the end of this text.
  properties.set("Description", Value::string("cimomd, an embedded CIM object manager, version " + facts_.version));
  properties.set("EnabledState", uint16(enabled));
  properties.set("Started", Value::boolean(true));
  properties.set("GatherStatisticalData", Value::boolean(false));
  return {make(objectManagerClass, properties)};
}

std::vector<Instance> InteropModel::namespaces() const {
  const ObjectPath manager = *objectManagers().front().path();
  std::vector<Instance> all;
  for (const std::string& name : classes_.namespaces()) {
    NamedValues properties;
    properties.set("SystemCreationClassName", *manager.keys.find("SystemCreationClassName"));
    properties.set("SystemName", *manager.keys.find("SystemName"));
    properties.set("ObjectManagerCreationClassName", *manager.keys.find("CreationClassName"));
    properties.set("ObjectManagerName", *manager.keys.find("Name"));
    properties.set("CreationClassName", Value::string(namespaceClass));
    properties.set("Name", Value::string(name));
    properties.set("ElementName", Value::string(name));
    properties.set("ClassInfo", uint16(unknown));
    all.push_back(make(namespaceClass, properties));
  }
  return all;
}

std::vector<Instance> InteropModel::profiles() const {
  std::vector<Instance> all;
  for (const Profile& profile : facts_.profiles) {
    NamedValues properties;
    properties.set("InstanceID", *pathOfProfile(profile).keys.find("InstanceID"));
    properties.set("ElementName", Value::string(profile.name));
    properties.set("Caption", Value::string(profile.name + " " + profile.version));
    properties.set("Description", Value::string(profile.description));
    properties.set("SpecificationType", uint16(profileKind));
    properties.set("RegisteredOrganization", uint16(other));
    properties.set("OtherRegisteredOrganization", Value::string(organization));
    properties.set("RegisteredName", Value::string(profile.name));
    properties.set("RegisteredVersion", Value::string(profile.version));
    properties.set("AdvertiseTypes", Value::array(Array{CMPI_uint16, {uint16(notAdvertised)}}));
    all.push_back(make(profileClass, properties));
  }
  return all;
}

ObjectPath InteropModel::pathOfProfile(const Profile& profile) const {
  ObjectPath path{{}, interopNamespace, profileClass, {}};
  path.keys.set("InstanceID", Value::string(std::string(organization) + ":" + profile.name + ":" + profile.version));
  return path;
}

std::vector<InteropModel::Link> InteropModel::namespacesInManager(const NamesOf&) const {
  const ObjectPath manager = *objectManagers().front().path();
  std::vector<Link> links;
  for (const Instance& one : namespaces()) {
    links.push_back({manager, *one.path()});
  }
  return links;
}

// Wherever the central class is served.
std::vector<InteropModel::Link> InteropModel::conformances(const NamesOf& namesOf) const {
  std::vector<Link> links;
  for (const Profile& profile : facts_.profiles) {
    for (const std::string& nameSpace : classes_.namespaces()) {
      for (ObjectPath& name : namesOf(nameSpace, profile.centralClass)) {
        links.push_back({pathOfProfile(profile), std::move(name)});
      }
    }
  }
  return links;
}

// The profile that is referenced is the antecedent.
std::vector<InteropModel::Link> InteropModel::referencedProfiles(const NamesOf&) const {
  std::vector<Link> links;
  for (const Profile& profile : facts_.profiles) {
    for (const Profile& referenced : facts_.profiles) {
      if (std::ranges::find(profile.references, referenced.name) != profile.references.end()) {
        links.push_back({pathOfProfile(referenced), pathOfProfile(profile)});
      }
    }
  }
  return links;
}

Instance InteropModel::linkOf(const AssociationRow& row, const Link& link) const {
  NamedValues ends;
  ends.set(row.first, Value::reference(link.first));
  ends.set(row.second, Value::reference(link.second));
  return make(row.className, ends);
}

std::vector<Instance> InteropModel::instancesOf(const std::string& className, const NamesOf& namesOf) const {
  for (const ObjectRow& row : objects) {
    if (sameName(row.className, className)) {
      return (this->*row.instances)();
    }
  }
  std::vector<Instance> all;
  for (const AssociationRow& row : associations) {
    if (sameName(row.className, className)) {
      for (const Link& link : (this->*row.links)(namesOf)) {
        all.push_back(linkOf(row, link));
      }
    }
  }
  return all;
}

std::vector<InteropModel::Step> InteropModel::stepsFrom(const ObjectPath& from, const std::string& association,
                                                        const NamesOf& namesOf) const {
  std::vector<Step> steps;
  for (const AssociationRow& row : associations) {
    if (!sameName(row.className, association)) {
      continue;
    }
    for (const Link& link : (this->*row.links)(namesOf)) {
      if (sameObject(from, link.first, interopNamespace)) {
        steps.push_back({linkOf(row, link), link.second});
      }
      if (sameObject(from, link.second, interopNamespace)) {
        steps.push_back({linkOf(row, link), link.first});
      }
    }
  }
  return steps;
}

}  // namespace Cimom
