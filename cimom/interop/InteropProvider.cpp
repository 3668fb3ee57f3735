// SPDX-License-Identifier: Apache-2.0
#include "cimom/interop/InteropProvider.h"

#include <cmpimacs.h>

#include <algorithm>
#include <memory>
#include <utility>

#include "cimom/broker/Guard.h"
#include "cimom/broker/Handle.h"
#include "cimom/model/Instance.h"
#include "cimom/model/Names.h"
#include "cimom/routing/SameObject.h"

namespace Cimom {
namespace {

constexpr const char* interopNamespace = "root/interop";
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

class Catalogue {
 public:
  Catalogue(const ClassRepository& classes, InteropFacts facts) : classes_(classes), facts_(std::move(facts)) {}

  std::vector<ProviderRegistration> registrations() const;
  CMPIInstanceMI* instanceMi(const CMPIBroker* broker);
  CMPIAssociationMI* associationMi(const CMPIBroker* broker);

 private:
  struct Link {
    ObjectPath first;
    ObjectPath second;
  };
  using Instances = std::vector<Instance> (Catalogue::*)() const;
  using Links = std::vector<Link> (Catalogue::*)(const CMPIContext*) const;

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
  std::vector<Link> namespacesInManager(const CMPIContext* context) const;
  std::vector<Link> conformances(const CMPIContext* context) const;
  std::vector<Link> referencedProfiles(const CMPIContext* context) const;

  Instance make(const char* className, const NamedValues& properties) const;
  ObjectPath pathOfProfile(const Profile& profile) const;
  Instance linkOf(const AssociationRow& row, const Link& link) const;

  // All instances of one of the classes.
  std::vector<Instance> instancesOf(const CMPIObjectPath* path, const CMPIContext* context) const;
  // The instances of an association class that have the source as one end, with their other end.
  struct Step {
    Instance association;
    ObjectPath farEnd;
  };
  std::vector<Step> stepsFrom(const CMPIObjectPath* source, const char* association, const CMPIContext* context) const;
  // Returns an object of any provider; nothing if it has gone meanwhile.
  void returnObject(const CMPIContext* context, const CMPIResult* result, const ObjectPath& path) const;

  static const Catalogue& of(const CMPIInstanceMI* mi) { return *static_cast<const Catalogue*>(mi->hdl); }
  static const Catalogue& of(const CMPIAssociationMI* mi) { return *static_cast<const Catalogue*>(mi->hdl); }

  const ClassRepository& classes_;
  InteropFacts facts_;
  const CMPIBroker* broker_ = nullptr;
  CMPIInstanceMI instanceMi_{};
  CMPIAssociationMI associationMi_{};
};

const Catalogue::ObjectRow Catalogue::objects[3] = {{objectManagerClass, &Catalogue::objectManagers},
                                                    {namespaceClass, &Catalogue::namespaces},
                                                    {profileClass, &Catalogue::profiles}};

const Catalogue::AssociationRow Catalogue::associations[3] = {
    {"CIM_NamespaceInManager", "Antecedent", "Dependent", &Catalogue::namespacesInManager},
    {"CIM_ElementConformsToProfile", "ConformantStandard", "ManagedElement", &Catalogue::conformances},
    {"CIM_ReferencedProfile", "Antecedent", "Dependent", &Catalogue::referencedProfiles}};

std::vector<ProviderRegistration> Catalogue::registrations() const {
  std::vector<ProviderRegistration> all;
  const auto add = [&](const char* className, bool isAssociation) {
    if (!classes_.find(className)) {
      return;
    }
    ProviderRegistration registration;
    registration.className = className;
    registration.provider = "Interop";
    registration.instance = true;
    registration.association = isAssociation;
    registration.namespaces = {interopNamespace};
    all.push_back(std::move(registration));
  };
  if (!classes_.find(objectManagerClass) || !classes_.find(namespaceClass)) {
    return all;
  }
  for (const ObjectRow& row : objects) {
    add(row.className, false);
  }
  for (const AssociationRow& row : associations) {
    add(row.className, true);
  }
  return all;
}

Instance Catalogue::make(const char* className, const NamedValues& properties) const {
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

std::vector<Instance> Catalogue::objectManagers() const {
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

std::vector<Instance> Catalogue::namespaces() const {
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

std::vector<Instance> Catalogue::profiles() const {
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

ObjectPath Catalogue::pathOfProfile(const Profile& profile) const {
  ObjectPath path{{}, interopNamespace, profileClass, {}};
  path.keys.set("InstanceID", Value::string(std::string(organization) + ":" + profile.name + ":" + profile.version));
  return path;
}

std::vector<Catalogue::Link> Catalogue::namespacesInManager(const CMPIContext*) const {
  const ObjectPath manager = *objectManagers().front().path();
  std::vector<Link> links;
  for (const Instance& one : namespaces()) {
    links.push_back({manager, *one.path()});
  }
  return links;
}

// Wherever the central class is served. One that fails has no instances that conform.
std::vector<Catalogue::Link> Catalogue::conformances(const CMPIContext* context) const {
  std::vector<Link> links;
  for (const Profile& profile : facts_.profiles) {
    for (const std::string& nameSpace : classes_.namespaces()) {
      const auto central = lend(ObjectPath{{}, nameSpace, profile.centralClass, {}});
      const CMPIEnumeration* names = CBEnumInstanceNames(broker_, context, &central, nullptr);
      while (names && CMHasNext(names, nullptr)) {
        const CMPIData name = CMGetNext(names, nullptr);
        links.push_back({pathOfProfile(profile), modelOf<ObjectPath>(name.value.ref)});
      }
    }
  }
  return links;
}

// The profile that is referenced is the antecedent.
std::vector<Catalogue::Link> Catalogue::referencedProfiles(const CMPIContext*) const {
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

Instance Catalogue::linkOf(const AssociationRow& row, const Link& link) const {
  NamedValues ends;
  ends.set(row.first, Value::reference(link.first));
  ends.set(row.second, Value::reference(link.second));
  return make(row.className, ends);
}

std::vector<Instance> Catalogue::instancesOf(const CMPIObjectPath* path, const CMPIContext* context) const {
  const std::string& className = modelOf<ObjectPath>(path).className;
  for (const ObjectRow& row : objects) {
    if (sameName(row.className, className)) {
      return (this->*row.instances)();
    }
  }
  std::vector<Instance> all;
  for (const AssociationRow& row : associations) {
    if (sameName(row.className, className)) {
      for (const Link& link : (this->*row.links)(context)) {
        all.push_back(linkOf(row, link));
      }
    }
  }
  return all;
}

std::vector<Catalogue::Step> Catalogue::stepsFrom(const CMPIObjectPath* source, const char* association,
                                                  const CMPIContext* context) const {
  const ObjectPath& from = modelOf<ObjectPath>(source);
  std::vector<Step> steps;
  for (const AssociationRow& row : associations) {
    if (!sameName(row.className, association)) {
      continue;
    }
    for (const Link& link : (this->*row.links)(context)) {
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

void Catalogue::returnObject(const CMPIContext* context, const CMPIResult* result, const ObjectPath& path) const {
  const auto lent = lend(path);
  if (const CMPIInstance* instance = CBGetInstance(broker_, context, &lent, nullptr, nullptr)) {
    CMReturnInstance(result, instance);
  }
}

CMPIInstanceMI* Catalogue::instanceMi(const CMPIBroker* broker) {
  static CMPIInstanceMIFT table = {
      CMPICurrentVersion,
      CMPICurrentVersion,
      "Interop",
      [](CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
        return CMPIStatus{CMPI_RC_OK, nullptr};
      },
      [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path) {
        return guarded([&] {
          for (const Instance& instance : of(mi).instancesOf(path, context)) {
            const auto lent = lend(instance.path());
            CMReturnObjectPath(result, &lent);
          }
        });
      },
      [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path,
         const char**) {
        return guarded([&] {
          for (const Instance& instance : of(mi).instancesOf(path, context)) {
            const auto lent = lend(instance);
            CMReturnInstance(result, &lent);
          }
        });
      },
      [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path,
         const char**) {
        return guarded([&] {
          for (const Instance& instance : of(mi).instancesOf(path, context)) {
            if (sameObject(*instance.path(), modelOf<ObjectPath>(path), interopNamespace)) {
              const auto lent = lend(instance);
              CMReturnInstance(result, &lent);
            }
          }
        });
      },
      nullptr,
      nullptr,
      nullptr,
      nullptr};
  broker_ = broker;
  instanceMi_ = {this, &table};
  return &instanceMi_;
}

// Roles and result classes are the object manager's to filter by.
CMPIAssociationMI* Catalogue::associationMi(const CMPIBroker* broker) {
  static CMPIAssociationMIFT table = {
      CMPICurrentVersion,
      CMPICurrentVersion,
      "Interop",
      [](CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) {
        return CMPIStatus{CMPI_RC_OK, nullptr};
      },
      [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* source,
         const char* association, const char*, const char*, const char*, const char**) {
        return guarded([&] {
          for (const Step& step : of(mi).stepsFrom(source, association, context)) {
            of(mi).returnObject(context, result, step.farEnd);
          }
        });
      },
      [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* source,
         const char* association, const char*, const char*, const char*) {
        return guarded([&] {
          for (const Step& step : of(mi).stepsFrom(source, association, context)) {
            const auto lent = lend(step.farEnd);
            CMReturnObjectPath(result, &lent);
          }
        });
      },
      [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* source,
         const char* association, const char*, const char**) {
        return guarded([&] {
          for (const Step& step : of(mi).stepsFrom(source, association, context)) {
            const auto lent = lend(step.association);
            CMReturnInstance(result, &lent);
          }
        });
      },
      [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* source,
         const char* association, const char*) {
        return guarded([&] {
          for (const Step& step : of(mi).stepsFrom(source, association, context)) {
            const auto lent = lend(step.association.path());
            CMReturnObjectPath(result, &lent);
          }
        });
      }};
  broker_ = broker;
  associationMi_ = {this, &table};
  return &associationMi_;
}

}  // namespace

LinkedProvider interopProvider(const ClassRepository& classes, InteropFacts facts) {
  const auto catalogue = std::make_shared<Catalogue>(classes, std::move(facts));
  return {
      catalogue->registrations(),
      [catalogue](const CMPIBroker* broker, const CMPIContext*, CMPIStatus*) { return catalogue->instanceMi(broker); },
      [catalogue](const CMPIBroker* broker, const CMPIContext*, CMPIStatus*) {
        return catalogue->associationMi(broker);
      }};
}

}  // namespace Cimom
