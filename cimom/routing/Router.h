// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "cimom/broker/Operation.h"
#include "cimom/providers/ProviderRegistry.h"

namespace Cimom {

// Routes the operations of DSP0200 to the providers that are registered for the class and the namespace of their path.
class Router final : public OperationHandler {
 public:
  explicit Router(const CMPIBroker* broker) : providers_(broker) {}

  ProviderRegistry& providers() { return providers_; }

  // The instances of the class and its subclasses: one call for each that has a provider, with that class's name; none
  // if none has. One provider's failure is the operation's.
  std::vector<Value> enumerateInstances(const Operation& operation, const char** properties) override;
  std::vector<Value> enumerateInstanceNames(const Operation& operation) override;

  // The first instance that the class's own provider returns.
  // CMPI_RC_ERR_NOT_FOUND if it returns none, and if the class has no provider and so no instance.
  Value getInstance(const Operation& operation, const char** properties) override;

  // The path that the provider returns for the new instance, else the instance's own.
  // CMPI_RC_ERR_NOT_SUPPORTED if the class has no provider, as for the other two that write.
  Value createInstance(const Operation& operation, const Instance& instance) override;

  // The provider gets every property that the class declares, null if the caller did not set it, and a path with
  // all keys that the path or the instance has.
  void modifyInstance(const Operation& operation, const Instance& instance, const char** properties) override;

  void deleteInstance(const Operation& operation) override;

  // Each association operation asks the provider of every association class once and passes it that class's name,
  // whatever the caller named: a class that has a provider itself is asked alone; its registered subclasses, and
  // without any name every registered association, are asked if one of their references can refer to the path's
  // class. The rest of the filter goes to the provider as it came. Whether the source object exists is not checked.
  // CMPI_RC_ERR_INVALID_PARAMETER for an association class that the schema does not know.
  std::vector<Value> associators(const Operation& operation, const AssociationFilter& filter,
                                 const char** properties) override;
  std::vector<Value> associatorNames(const Operation& operation, const AssociationFilter& filter) override;
  std::vector<Value> references(const Operation& operation, const AssociationFilter& filter,
                                const char** properties) override;
  std::vector<Value> referenceNames(const Operation& operation, const AssociationFilter& filter) override;

  // The class's own provider of methods is called, or that of the nearest superclass which has one; what it returns gets
  // the declared type, and what it adds to the output arguments without a declaration is dropped.
  // CMPI_RC_ERR_METHOD_NOT_AVAILABLE without a provider.
  Value invokeMethod(const Operation& operation, const MethodDeclaration& method, const NamedValues& in,
                     NamedValues& out) override;

 private:
  ProviderRegistry providers_;
};

}  // namespace Cimom
