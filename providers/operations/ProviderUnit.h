// SPDX-License-Identifier: Apache-2.0
// The named operations that every unit gives its function tables: stubs, and one-line calls of the operations told
// once. Each unit states before them its `broker` and its row, `unit`.
#pragma once

#include <cmpimacs.h>

#include <atomic>

namespace QV::IPConfigComposite {

// What the factories of a unit set. An object manager may ask for the second MI while it is served by the first.
using UnitBroker = std::atomic<const CMPIBroker*>;

}  // namespace QV::IPConfigComposite

// The slots that no provider of this library carries out, and cleanup: nothing is held that needs releasing.
#define IPCONFIG_INSTANCE_STUBS(prefix)                                                                              \
  CMPIStatus prefix##Cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { CMReturn(CMPI_RC_OK); }             \
  CMPIStatus prefix##CreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,   \
                                    const CMPIInstance*) {                                                           \
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);                                                                             \
  }                                                                                                                  \
  CMPIStatus prefix##DeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*) { \
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);                                                                             \
  }                                                                                                                  \
  CMPIStatus prefix##ExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,        \
                               const char*, const char*) {                                                           \
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);                                                                             \
  }

#define IPCONFIG_MODIFY_STUB(prefix)                                                                               \
  CMPIStatus prefix##ModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, \
                                    const CMPIInstance*, const char**) {                                           \
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);                                                                           \
  }

// The operations of a unit that serves a composite class.
#define IPCONFIG_INSTANCE_OPERATIONS(prefix)                                                            \
  CMPIStatus prefix##GetInstance(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,       \
                                 const CMPIObjectPath* op, const char** properties) {                   \
    return getInstance({unit, broker, __func__}, ctx, rslt, op, properties);                            \
  }                                                                                                     \
  CMPIStatus prefix##EnumInstances(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,     \
                                   const CMPIObjectPath* op, const char** properties) {                 \
    return enumInstances({unit, broker, __func__}, ctx, rslt, op, properties);                          \
  }                                                                                                     \
  CMPIStatus prefix##EnumInstanceNames(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt, \
                                       const CMPIObjectPath* op) {                                      \
    return enumInstanceNames({unit, broker, __func__}, ctx, rslt, op);                                  \
  }                                                                                                     \
  IPCONFIG_INSTANCE_STUBS(prefix)

// ModifyInstance of a unit whose class accepts changes through the factory member `modify`.
#define IPCONFIG_MODIFY_OPERATION(prefix, modify)                                                                    \
  CMPIStatus prefix##ModifyInstance(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,                 \
                                    const CMPIObjectPath* cop, const CMPIInstance* ci, const char** properties) {    \
    return modifyInstance({unit, broker, __func__}, &IPConfigObjectFactory::modify, ctx, rslt, cop, ci, properties); \
  }

// The operations of a unit that serves an association class. `Result` is the builder's result type (compatibility 24).
#define IPCONFIG_ASSOCIATION_OPERATIONS(prefix, builderName, Result)                                                   \
  Result builderName(const CMPIObjectPath* ref, const char** properties, const CMPIContext* ctx,                       \
                     std::vector<CMPIInstance*>& out) {                                                                \
    return static_cast<Result>(buildAssociations(unit, broker, ref, properties, ctx, out));                            \
  }                                                                                                                    \
  namespace {                                                                                                          \
  int buildInstances(const CMPIObjectPath* ref, const char** properties, const CMPIContext* ctx,                       \
                     std::vector<CMPIInstance*>& out) {                                                                \
    return builderName(ref, properties, ctx, out);                                                                     \
  }                                                                                                                    \
  }                                                                                                                    \
  CMPIStatus prefix##Associators(CMPIAssociationMI*, const CMPIContext* ctx, const CMPIResult* rslt,                   \
                                 const CMPIObjectPath* op, const char* assocClass, const char* resultClass,            \
                                 const char*, const char*, const char**) {                                             \
    return associators({unit, broker, __func__}, ctx, rslt, op, assocClass, resultClass);                              \
  }                                                                                                                    \
  CMPIStatus prefix##AssociatorNames(CMPIAssociationMI*, const CMPIContext* ctx, const CMPIResult* rslt,               \
                                     const CMPIObjectPath* op, const char* assocClass, const char* resultClass,        \
                                     const char*, const char*) {                                                       \
    return associatorNames({unit, broker, __func__}, ctx, rslt, op, assocClass, resultClass);                          \
  }                                                                                                                    \
  CMPIStatus prefix##References(CMPIAssociationMI*, const CMPIContext* ctx, const CMPIResult* rslt,                    \
                                const CMPIObjectPath* op, const char*, const char*, const char**) {                    \
    return references({unit, broker, __func__}, ctx, rslt, op);                                                        \
  }                                                                                                                    \
  CMPIStatus prefix##ReferenceNames(CMPIAssociationMI*, const CMPIContext* ctx, const CMPIResult* rslt,                \
                                    const CMPIObjectPath* op, const char*, const char*) {                              \
    return referenceNames({unit, broker, __func__}, ctx, rslt, op);                                                    \
  }                                                                                                                    \
  CMPIStatus prefix##AssociationCleanup(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) { CMReturn(CMPI_RC_OK); } \
  CMPIStatus prefix##GetInstance(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,                      \
                                 const CMPIObjectPath* op, const char** properties) {                                  \
    return getAssociation({unit, broker, __func__}, buildInstances, ctx, rslt, op, properties);                        \
  }                                                                                                                    \
  CMPIStatus prefix##EnumInstances(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,                    \
                                   const CMPIObjectPath* op, const char** properties) {                                \
    return enumAssociations({unit, broker, __func__}, buildInstances, ctx, rslt, op, properties);                      \
  }                                                                                                                    \
  CMPIStatus prefix##EnumInstanceNames(CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt,                \
                                       const CMPIObjectPath* op) {                                                     \
    return enumAssociationNames({unit, broker, __func__}, buildInstances, ctx, rslt, op);                              \
  }                                                                                                                    \
  IPCONFIG_INSTANCE_STUBS(prefix)                                                                                      \
  IPCONFIG_MODIFY_STUB(prefix)
