// SPDX-License-Identifier: Apache-2.0
#include "cimom/interop/InteropProvider.h"

#include <cmpimacs.h>

#include <memory>
#include <utility>

#include "cimom/broker/Guard.h"
#include "cimom/broker/Handle.h"
#include "cimom/routing/SameObject.h"

namespace Cimom {
namespace {

using Step = InteropModel::Step;

// The model as CMPI asks for it.
class InteropMethods {
 public:
  InteropMethods(const ClassRepository& classes, InteropFacts facts) : model_(classes, std::move(facts)) {}

  std::vector<ProviderRegistration> registrations() const;
  CMPIInstanceMI* instanceMi(const CMPIBroker* broker);
  CMPIAssociationMI* associationMi(const CMPIBroker* broker);

 private:
  InteropModel::NamesOf namesOf(const CMPIContext* context) const;
  std::vector<Instance> instancesOf(const CMPIObjectPath* path, const CMPIContext* context) const {
    return model_.instancesOf(modelOf<ObjectPath>(path).className, namesOf(context));
  }
  std::vector<Step> stepsFrom(const CMPIObjectPath* source, const char* association, const CMPIContext* context) const {
    return model_.stepsFrom(modelOf<ObjectPath>(source), association, namesOf(context));
  }
  // Returns an object of any provider; nothing if it has gone meanwhile.
  void returnObject(const CMPIContext* context, const CMPIResult* result, const ObjectPath& path) const;

  static const InteropMethods& of(const CMPIInstanceMI* mi) { return *static_cast<const InteropMethods*>(mi->hdl); }
  static const InteropMethods& of(const CMPIAssociationMI* mi) { return *static_cast<const InteropMethods*>(mi->hdl); }

  const InteropModel model_;
  const CMPIBroker* broker_ = nullptr;
  CMPIInstanceMI instanceMi_{};
  CMPIAssociationMI associationMi_{};
};

std::vector<ProviderRegistration> InteropMethods::registrations() const {
  std::vector<ProviderRegistration> all;
  for (const auto& [name, isAssociation] : model_.servedClasses()) {
    ProviderRegistration registration;
    registration.className = name;
    registration.provider = "Interop";
    registration.instance = true;
    registration.association = isAssociation;
    registration.namespaces = {interopNamespace};
    all.push_back(std::move(registration));
  }
  return all;
}

InteropModel::NamesOf InteropMethods::namesOf(const CMPIContext* context) const {
  return [this, context](const std::string& nameSpace, const std::string& className) {
    std::vector<ObjectPath> all;
    const auto path = lend(ObjectPath{{}, nameSpace, className, {}});
    const CMPIEnumeration* names = CBEnumInstanceNames(broker_, context, &path, nullptr);
    while (names && CMHasNext(names, nullptr)) {
      all.push_back(modelOf<ObjectPath>(CMGetNext(names, nullptr).value.ref));
    }
    return all;
  };
}

void InteropMethods::returnObject(const CMPIContext* context, const CMPIResult* result, const ObjectPath& path) const {
  const auto lent = lend(path);
  if (const CMPIInstance* instance = CBGetInstance(broker_, context, &lent, nullptr, nullptr)) {
    CMReturnInstance(result, instance);
  }
}

CMPIInstanceMI* InteropMethods::instanceMi(const CMPIBroker* broker) {
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
CMPIAssociationMI* InteropMethods::associationMi(const CMPIBroker* broker) {
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
  const auto methods = std::make_shared<InteropMethods>(classes, std::move(facts));
  return {
      methods->registrations(),
      [methods](const CMPIBroker* broker, const CMPIContext*, CMPIStatus*) { return methods->instanceMi(broker); },
      [methods](const CMPIBroker* broker, const CMPIContext*, CMPIStatus*) { return methods->associationMi(broker); }};
}

}  // namespace Cimom
