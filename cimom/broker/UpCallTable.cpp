// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Guard.h"
#include "cimom/broker/Operation.h"

namespace Cimom {
namespace {

const ClassDefinition& classFor(const BrokerCore& core, const ObjectPath& path) {
  core.requireNamespace(path.nameSpace);
  return core.requireClass(path.nameSpace, path.className);
}

// Runs an operation and hands its items out as an enumeration.
template <typename Run>
CMPIEnumeration* enumeration(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                             CMPIStatus* status, Run run) {
  return guarded(status, static_cast<CMPIEnumeration*>(nullptr), [&] {
    const Operation operation(broker, context, path);
    return make(Enumeration{run(*operation.core.operations, operation), 0});
  });
}

CMPIEnumeration* enumerateInstanceNames(const CMPIBroker* broker, const CMPIContext* context,
                                        const CMPIObjectPath* path, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [](OperationHandler& handler, const Operation& operation) {
    return handler.enumerateInstanceNames(operation);
  });
}

CMPIEnumeration* enumerateInstances(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                    const char** properties, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](OperationHandler& handler, const Operation& operation) {
    return handler.enumerateInstances(operation, properties);
  });
}

CMPIInstance* getInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                          const char** properties, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIInstance*>(nullptr), [&] {
    const Operation operation(broker, context, path);
    return toCmpi(operation.core.operations->getInstance(operation, properties)).value.inst;
  });
}

CMPIObjectPath* createInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                               const CMPIInstance* instance, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIObjectPath*>(nullptr), [&] {
    const Instance& model = *argumentOf<Instance>(instance);
    const Operation operation(broker, context, path);
    return toCmpi(operation.core.operations->createInstance(operation, model)).value.ref;
  });
}

CMPIStatus modifyInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                          const CMPIInstance* instance, const char** properties) {
  return guarded([&] {
    const Instance& model = *argumentOf<Instance>(instance);
    const Operation operation(broker, context, path);
    operation.core.operations->modifyInstance(operation, model, properties);
  });
}

CMPIStatus deleteInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path) {
  return guarded([&] {
    const Operation operation(broker, context, path);
    operation.core.operations->deleteInstance(operation);
  });
}

CMPIEnumeration* execQuery(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                           const char*, const char*, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [](OperationHandler&, const Operation&) -> std::vector<Value> {
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "queries are not supported");
  });
}

CMPIEnumeration* associators(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                             const char* associationClass, const char* resultClass, const char* role,
                             const char* resultRole, const char** properties, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](OperationHandler& handler, const Operation& operation) {
    return handler.associators(operation, {associationClass, resultClass, role, resultRole}, properties);
  });
}

CMPIEnumeration* associatorNames(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                 const char* associationClass, const char* resultClass, const char* role,
                                 const char* resultRole, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](OperationHandler& handler, const Operation& operation) {
    return handler.associatorNames(operation, {associationClass, resultClass, role, resultRole});
  });
}

CMPIEnumeration* references(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                            const char* resultClass, const char* role, const char** properties, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](OperationHandler& handler, const Operation& operation) {
    return handler.references(operation, {resultClass, nullptr, role, nullptr}, properties);
  });
}

CMPIEnumeration* referenceNames(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                const char* resultClass, const char* role, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](OperationHandler& handler, const Operation& operation) {
    return handler.referenceNames(operation, {resultClass, nullptr, role, nullptr});
  });
}

CMPIData invokeMethod(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                      const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const Operation operation(broker, context, path);
    const MethodDeclaration* declared = operation.definition.findMethod(required(method, "the method's name"));
    if (!declared) {
      throw StatusError(CMPI_RC_ERR_METHOD_NOT_FOUND, operation.definition.name + " has no method \"" + method + "\"");
    }
    NamedValues returned;
    const NamedValues given = in ? modelOf<Args>(in).arguments : NamedValues();
    const Value value = operation.core.operations->invokeMethod(operation, *declared, given, returned);
    for (const auto& [name, argument] : returned) {
      if (out) {
        ownModelOf<Args>(out).arguments.set(name, argument);
      }
    }
    return toCmpi(value);
  });
}

const PropertyDeclaration& requireProperty(const Operation& operation, const char* name) {
  const PropertyDeclaration* property = operation.definition.findProperty(required(name, "the property's name"));
  if (property) {
    return *property;
  }
  throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, operation.definition.name + " has no property \"" + name + "\"");
}

// SetProperty is ModifyInstance of one property (DSP0200).
CMPIStatus setProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                       const char* name, const CMPIValue* value, CMPIType type) {
  return guarded([&] {
    const Operation operation(broker, context, path);
    const char* properties[] = {requireProperty(operation, name).name.c_str(), nullptr};
    Instance instance(operation.definition, operation.path);
    instance.set(name, fromCmpi(value, type));
    operation.core.operations->modifyInstance(operation, instance, properties);
  });
}

CMPIData getProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path, const char* name,
                     CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const Operation operation(broker, context, path);
    const char* properties[] = {requireProperty(operation, name).name.c_str(), nullptr};
    const Value instance = operation.core.operations->getInstance(operation, properties);
    const Value* value = instance.embedded()->find(name);
    return value ? toCmpi(*value) : noData;
  });
}

CMPIStatus deliverIndication(const CMPIBroker* broker, const CMPIContext*, const char*, const CMPIInstance*) {
  return guarded([&] {
    coreOf(broker);
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "indications are not supported");
  });
}

// A context that lives until the thread that it is for has detached.
CMPIContext* prepareAttachThread(const CMPIBroker*, const CMPIContext* context) {
  return clone<Context>(context, nullptr);
}

// The memory of the thread that a provider has attached; null if it has not.
thread_local RequestScope* attached = nullptr;

CMPIStatus attachThread(const CMPIBroker* broker, const CMPIContext* context) {
  return guarded([&] {
    coreOf(broker);
    const Deadline deadline = modelOf<Context>(context).deadline;
    if (attached) {
      throw StatusError(CMPI_RC_ERR_FAILED, "the thread is already attached");
    }
    attached = RequestScope::open(broker, deadline);
  });
}

CMPIStatus detachThread(const CMPIBroker* broker, const CMPIContext* context) {
  return guarded([&] {
    coreOf(broker);
    modelOf<Context>(context);
    if (!attached) {
      throw StatusError(CMPI_RC_ERR_FAILED, "the thread is not attached");
    }
    RequestScope::close(attached);
    attached = nullptr;
    release<Context>(const_cast<CMPIContext*>(context));
  });
}

}  // namespace

Operation::Operation(const CMPIBroker* broker, const CMPIContext* callerContext, const CMPIObjectPath* requested)
    : core(coreOf(broker)),
      context(modelOf<Context>(callerContext)),
      path(modelOf<ObjectPath>(requested)),
      definition(classFor(core, path)) {
  const Deadline deadline = RequestScope::currentDeadline();
  if (deadline && std::chrono::steady_clock::now() >= *deadline) {
    throw StatusError(CMPI_RC_ERR_FAILED, "the time limit of the request is over, " + path.className + " is not asked");
  }
}

CMPIBrokerFT upCallTable = {
    .brokerCapabilities = CMPI_MB_InstanceManipulation | CMPI_MB_AssociationTraversal | CMPI_MB_BasicQualifierSupport |
                          CMPI_MB_OSEncapsulationSupport | CMPI_MB_Supports_MemEnhancements |
                          CMPI_MB_Supports_Extended_Error,
    .brokerVersion = CMPIVersion200,
    .brokerName = "cimomd",
    .prepareAttachThread = prepareAttachThread,
    .attachThread = attachThread,
    .detachThread = detachThread,
    .deliverIndication = deliverIndication,
    .enumerateInstanceNames = enumerateInstanceNames,
    .getInstance = getInstance,
    .createInstance = createInstance,
    .modifyInstance = modifyInstance,
    .deleteInstance = deleteInstance,
    .execQuery = execQuery,
    .enumerateInstances = enumerateInstances,
    .associators = associators,
    .associatorNames = associatorNames,
    .references = references,
    .referenceNames = referenceNames,
    .invokeMethod = invokeMethod,
    .setProperty = setProperty,
    .getProperty = getProperty,
};

}  // namespace Cimom
