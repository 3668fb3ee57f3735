// SPDX-License-Identifier: Apache-2.0
// What comes in through the up-call table, and who carries it out.
#pragma once

#include <cmpidt.h>

#include <vector>

#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Models.h"
#include "cimom/model/ClassDefinition.h"
#include "cimom/model/Instance.h"
#include "cimom/model/ObjectPath.h"
#include "cimom/model/Value.h"

namespace Cimom {

// One operation on its way to the providers: the object manager, the caller's context and the path that it is for.
struct Operation {
  // Throws StatusError for a null broker, context or path, an unknown namespace or an unknown class,
  //         and after the deadline of the request.
  Operation(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path);

  BrokerCore& core;
  const Context& context;
  const ObjectPath& path;
  const ClassDefinition& definition;  // of the path's class
};

// What narrows an association operation down (DSP0200); each may be null.
struct AssociationFilter {
  const char* associationClass;
  const char* resultClass;
  const char* role;
  const char* resultRole;
};

// The operations of DSP0200 on an operation's path. A property list is CMPI's: null for all, else ended by a null
// pointer. All throw StatusError, and may be called from several threads at once.
class OperationHandler {
 public:
  virtual ~OperationHandler() = default;

  virtual std::vector<Value> enumerateInstances(const Operation& operation, const char** properties) = 0;
  virtual std::vector<Value> enumerateInstanceNames(const Operation& operation) = 0;
  virtual Value getInstance(const Operation& operation, const char** properties) = 0;
  // Returns the path of the new instance.
  virtual Value createInstance(const Operation& operation, const Instance& instance) = 0;
  virtual void modifyInstance(const Operation& operation, const Instance& instance, const char** properties) = 0;
  virtual void deleteInstance(const Operation& operation) = 0;

  virtual std::vector<Value> associators(const Operation& operation, const AssociationFilter& filter,
                                         const char** properties) = 0;
  virtual std::vector<Value> associatorNames(const Operation& operation, const AssociationFilter& filter) = 0;
  // References and their names: the association class is what CMPI calls the result class of these operations.
  virtual std::vector<Value> references(const Operation& operation, const AssociationFilter& filter,
                                        const char** properties) = 0;
  virtual std::vector<Value> referenceNames(const Operation& operation, const AssociationFilter& filter) = 0;

  // What a method of the operation's class returns; its output arguments are added to `out`.
  virtual Value invokeMethod(const Operation& operation, const MethodDeclaration& method, const NamedValues& in,
                             NamedValues& out) = 0;
};

}  // namespace Cimom
