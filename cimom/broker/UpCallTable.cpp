#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Guard.h"
#include "cimom/routing/AssociationOperations.h"
#include "cimom/routing/InstanceOperations.h"

namespace Cimom {
namespace {

/// Runs an operation and hands its items out as an enumeration.
template <class Run>
CMPIEnumeration* enumeration(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                             CMPIStatus* status, Run run) {
  return guarded(status, static_cast<CMPIEnumeration*>(nullptr), [&] {
    return make(Enumeration{run(Operation(broker, context, path)), 0});
  });
}

CMPIEnumeration* enumerateInstanceNamesSlot(const CMPIBroker* broker, const CMPIContext* context,
                                            const CMPIObjectPath* path, CMPIStatus* status) {
  return enumeration(broker, context, path, status, enumerateInstanceNames);
}

CMPIEnumeration* enumerateInstancesSlot(const CMPIBroker* broker, const CMPIContext* context,
                                        const CMPIObjectPath* path, const char** properties, CMPIStatus* status) {
  return enumeration(broker, context, path, status,
                     [&](const Operation& operation) { return enumerateInstances(operation, properties); });
}

CMPIInstance* getInstanceSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                              const char** properties, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIInstance*>(nullptr),
                 [&] { return getInstance(Operation(broker, context, path), properties).toCmpi().value.inst; });
}

CMPIObjectPath* createInstanceSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                   const CMPIInstance* instance, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIObjectPath*>(nullptr), [&] {
    const Instance& model = modelOf<Instance>(instance);
    return createInstance(Operation(broker, context, path), model).toCmpi().value.ref;
  });
}

CMPIStatus modifyInstanceSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                              const CMPIInstance* instance, const char** properties) {
  return guarded([&] {
    const Instance& model = modelOf<Instance>(instance);
    modifyInstance(Operation(broker, context, path), model, properties);
  });
}

CMPIStatus deleteInstanceSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path) {
  return guarded([&] { deleteInstance(Operation(broker, context, path)); });
}

CMPIEnumeration* execQuery(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                           const char*, const char*, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [](const Operation&) -> std::vector<Value> {
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "this object manager has no query language");
  });
}

CMPIEnumeration* associatorsSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                 const char* associationClass, const char* resultClass, const char* role,
                                 const char* resultRole, const char** properties, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](const Operation& operation) {
    return associators(operation, {associationClass, resultClass, role, resultRole}, properties);
  });
}

CMPIEnumeration* associatorNamesSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                     const char* associationClass, const char* resultClass, const char* role,
                                     const char* resultRole, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](const Operation& operation) {
    return associatorNames(operation, {associationClass, resultClass, role, resultRole});
  });
}

CMPIEnumeration* referencesSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                const char* resultClass, const char* role, const char** properties,
                                CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](const Operation& operation) {
    return references(operation, {resultClass, nullptr, role, nullptr}, properties);
  });
}

CMPIEnumeration* referenceNamesSlot(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                    const char* resultClass, const char* role, CMPIStatus* status) {
  return enumeration(broker, context, path, status, [&](const Operation& operation) {
    return referenceNames(operation, {resultClass, nullptr, role, nullptr});
  });
}

/// Method providers are not served: what a class declares is there but cannot be called.
CMPIData invokeMethod(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                      const char* method, const CMPIArgs*, CMPIArgs*, CMPIStatus* status) {
  return guarded(status, kNoData, [&]() -> CMPIData {
    const Operation operation(broker, context, path);
    const bool declared = operation.definition.findMethod(required(method, "the method's name"));
    throw StatusError(declared ? CMPI_RC_ERR_METHOD_NOT_AVAILABLE : CMPI_RC_ERR_METHOD_NOT_FOUND,
                      operation.definition.name + "." + method + (declared ? " has no provider" : " is not declared"));
  });
}

const PropertyDeclaration& requireProperty(const Operation& operation, const char* name) {
  const PropertyDeclaration* property = operation.definition.findProperty(required(name, "the property's name"));
  if (property) return *property;
  throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, operation.definition.name + " has no property \"" + name + "\"");
}

/// SetProperty is ModifyInstance of one property (DSP0200).
CMPIStatus setProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                       const char* name, const CMPIValue* value, CMPIType type) {
  return guarded([&] {
    const Operation operation(broker, context, path);
    const char* properties[] = {requireProperty(operation, name).name.c_str(), nullptr};
    Instance instance(operation.definition, operation.path);
    instance.set(name, Value::fromCmpi(value, type));
    modifyInstance(operation, instance, properties);
  });
}

CMPIData getProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path, const char* name,
                     CMPIStatus* status) {
  return guarded(status, kNoData, [&] {
    const Operation operation(broker, context, path);
    const char* properties[] = {requireProperty(operation, name).name.c_str(), nullptr};
    const Value instance = getInstance(operation, properties);
    const Value* value = instance.embedded()->find(name);
    return value ? value->toCmpi() : kNoData;
  });
}

CMPIStatus deliverIndication(const CMPIBroker* broker, const CMPIContext*, const char*, const CMPIInstance*) {
  return guarded([&] {
    coreOf(broker);
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "this object manager delivers no indications");
  });
}

/// A context that lives until the thread that it is for has detached.
CMPIContext* prepareAttachThread(const CMPIBroker*, const CMPIContext* context) {
  return clone<Context>(context, nullptr);
}

/// The memory of the thread that a provider has attached; null where it has not.
thread_local RequestScope* attached = nullptr;

CMPIStatus attachThread(const CMPIBroker* broker, const CMPIContext* context) {
  return guarded([&] {
    coreOf(broker);
    modelOf<Context>(context);
    if (attached) throw StatusError(CMPI_RC_ERR_FAILED, "the thread is attached already");
    attached = RequestScope::open(broker);
  });
}

CMPIStatus detachThread(const CMPIBroker* broker, const CMPIContext* context) {
  return guarded([&] {
    coreOf(broker);
    modelOf<Context>(context);
    if (!attached) throw StatusError(CMPI_RC_ERR_FAILED, "the thread is not attached");
    RequestScope::close(attached);
    attached = nullptr;
    release<Context>(const_cast<CMPIContext*>(context));
  });
}

}  // namespace

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
    .enumerateInstanceNames = enumerateInstanceNamesSlot,
    .getInstance = getInstanceSlot,
    .createInstance = createInstanceSlot,
    .modifyInstance = modifyInstanceSlot,
    .deleteInstance = deleteInstanceSlot,
    .execQuery = execQuery,
    .enumerateInstances = enumerateInstancesSlot,
    .associators = associatorsSlot,
    .associatorNames = associatorNamesSlot,
    .references = referencesSlot,
    .referenceNames = referenceNamesSlot,
    .invokeMethod = invokeMethod,
    .setProperty = setProperty,
    .getProperty = getProperty,
};

}  // namespace Cimom
