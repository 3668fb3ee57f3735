// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/RecordingProvider.h"

namespace Testing {

using namespace Cimom;

struct RecordingProvider::Slots {
  static std::string shown(const char* text) { return text ? text : "(null)"; }

  static CMPIStatus record(const void* handle, Call call, const CMPIContext* context, const CMPIResult* result,
                           const CMPIObjectPath* path, const CMPIInstance* instance, const char** properties) {
    auto& probe = *static_cast<RecordingProvider*>(const_cast<void*>(handle));
    call.path = shownText(CMObjectPathToString(path, nullptr));
    call.hasProperties = properties != nullptr;
    for (; properties && *properties; ++properties) {
      call.properties.emplace_back(*properties);
    }
    {
      const std::lock_guard lock(probe.mutex_);
      probe.calls.push_back(std::move(call));
    }
    return probe.answer ? probe.answer(context, result, path, instance) : ok;
  }

  static Call named(const char* operation) {
    Call call;
    call.operation = operation;
    return call;
  }

  static CMPIStatus cleanup(CMPIInstanceMI* mi, const CMPIContext*, CMPIBoolean) {
    return static_cast<RecordingProvider*>(const_cast<void*>(mi->hdl))->cleaned();
  }
  static CMPIStatus enumerateInstanceNames(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                           const CMPIObjectPath* path) {
    return record(mi->hdl, named("enumerateInstanceNames"), context, result, path, nullptr, nullptr);
  }
  static CMPIStatus enumerateInstances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                       const CMPIObjectPath* path, const char** properties) {
    return record(mi->hdl, named("enumerateInstances"), context, result, path, nullptr, properties);
  }
  static CMPIStatus getInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                const CMPIObjectPath* path, const char** properties) {
    return record(mi->hdl, named("getInstance"), context, result, path, nullptr, properties);
  }
  static CMPIStatus createInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* path, const CMPIInstance* instance) {
    return record(mi->hdl, named("createInstance"), context, result, path, instance, nullptr);
  }
  static CMPIStatus modifyInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* path, const CMPIInstance* instance, const char** properties) {
    return record(mi->hdl, named("modifyInstance"), context, result, path, instance, properties);
  }
  static CMPIStatus deleteInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* path) {
    return record(mi->hdl, named("deleteInstance"), context, result, path, nullptr, nullptr);
  }

  static CMPIStatus associationCleanup(CMPIAssociationMI* mi, const CMPIContext*, CMPIBoolean) {
    return static_cast<RecordingProvider*>(mi->hdl)->cleaned();
  }
  static CMPIStatus associators(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                const CMPIObjectPath* path, const char* association, const char* resultClass,
                                const char* role, const char* resultRole, const char** properties) {
    Call call{"associators", {}, shown(association), shown(resultClass), shown(role), shown(resultRole), {}, false};
    return record(mi->hdl, std::move(call), context, result, path, nullptr, properties);
  }
  static CMPIStatus associatorNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                    const CMPIObjectPath* path, const char* association, const char* resultClass,
                                    const char* role, const char* resultRole) {
    Call call{"associatorNames", {}, shown(association), shown(resultClass), shown(role), shown(resultRole), {}, false};
    return record(mi->hdl, std::move(call), context, result, path, nullptr, nullptr);
  }
  static CMPIStatus references(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                               const CMPIObjectPath* path, const char* resultClass, const char* role,
                               const char** properties) {
    Call call{"references", {}, {}, shown(resultClass), shown(role), {}, {}, false};
    return record(mi->hdl, std::move(call), context, result, path, nullptr, properties);
  }
  static CMPIStatus referenceNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* path, const char* resultClass, const char* role) {
    Call call{"referenceNames", {}, {}, shown(resultClass), shown(role), {}, {}, false};
    return record(mi->hdl, std::move(call), context, result, path, nullptr, nullptr);
  }

  static inline CMPIInstanceMIFT instanceTable = {
      CMPICurrentVersion,     CMPICurrentVersion, "instanceProbe", cleanup,
      enumerateInstanceNames, enumerateInstances, getInstance,     createInstance,
      modifyInstance,         deleteInstance,     nullptr,
  };
  static inline CMPIAssociationMIFT associationTable = {
      CMPICurrentVersion, CMPICurrentVersion, "associationProbe", associationCleanup,
      associators,        associatorNames,    references,         referenceNames,
  };
};

RecordingProvider::RecordingProvider()
    : instanceMi_{this, &Slots::instanceTable}, associationMi_{this, &Slots::associationTable} {}

CMPIStatus RecordingProvider::cleaned() {
  ++cleanups;
  return cleanUp ? cleanUp() : ok;
}

void RecordingProvider::serve(ObjectManager& manager, const std::string& className, const std::string& nameSpace,
                              bool association) {
  const ProviderRegistration registration{className, className, "", true, association, {nameSpace}, ""};
  manager.addProvider(
      registration,
      [self = shared_from_this()](const CMPIBroker* given, const CMPIContext*, CMPIStatus*) {
        ++self->factoryCalls;
        self->broker = given;
        return &self->instanceMi_;
      },
      [self = shared_from_this()](const CMPIBroker* given, const CMPIContext*, CMPIStatus*) {
        ++self->factoryCalls;
        self->broker = given;
        return &self->associationMi_;
      });
}

std::string shownText(const CMPIString* string) {
  const char* characters = string ? CMGetCharsPtr(string, nullptr) : nullptr;
  return characters ? characters : "(null)";
}

std::vector<std::string> pathsOf(CMPIEnumeration* enumeration) {
  std::vector<std::string> paths;
  while (enumeration && CMHasNext(enumeration, nullptr)) {
    const CMPIData item = CMGetNext(enumeration, nullptr);
    const CMPIObjectPath* path = item.type == CMPI_ref ? item.value.ref : CMGetObjectPath(item.value.inst, nullptr);
    paths.push_back(shownText(CMObjectPathToString(path, nullptr)));
  }
  return paths;
}

}  // namespace Testing
