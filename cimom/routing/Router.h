// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <optional>
#include <vector>

#include "cimom/broker/Operation.h"
#include "cimom/providers/ProviderRegistry.h"

namespace Cimom {

// How far the router checks what DSP0200 lets a client expect but no provider is obliged to see to. In the comments
// below, what (exact) stands before is left out if it is bare, as other object managers do it.
enum class Strictness { Exact, Bare };

// Routes the operations of DSP0200 to the providers that are registered for the class and the namespace of their path.
class Router final : public OperationHandler {
 public:
  explicit Router(const CMPIBroker* broker) : providers_(broker) {}

  ProviderRegistry& providers() { return providers_; }

  // Not while a request is under way.
  void setStrictness(Strictness strictness) { strictness_ = strictness; }

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
  // all keys that the path or the instance has. (exact) A property that is not in the list is null, too, unless it is a
  // key; CMPI_RC_ERR_INVALID_PARAMETER for an instance of another class or with other keys than its path's,
  // CMPI_RC_ERR_NO_SUCH_PROPERTY for a list with a name that the class does not have, CMPI_RC_ERR_NOT_FOUND if the
  // provider's GetInstance does not find the instance.
  void modifyInstance(const Operation& operation, const Instance& instance, const char** properties) override;

  void deleteInstance(const Operation& operation) override;

  // Each association operation asks the provider of every association class at or below the one that the caller names,
  // or of every one, if one of its references can refer to the path's class, and passes it that class's name. The rest
  // of the filter goes to the provider as it came. CMPI_RC_ERR_INVALID_PARAMETER for an association class that the
  // namespace does not show. (exact) The references must be able to have the asked roles and the result class, and of
  // what the provider returns only what they admit is kept; CMPI_RC_ERR_INVALID_PARAMETER for a result class that the
  // namespace does not show, CMPI_RC_ERR_NOT_FOUND if the provider of the source does not find it. (bare) A class that
  // the caller names is asked whatever it can refer to.
  std::vector<Value> associators(const Operation& operation, const AssociationFilter& filter,
                                 const char** properties) override;
  std::vector<Value> associatorNames(const Operation& operation, const AssociationFilter& filter) override;
  std::vector<Value> references(const Operation& operation, const AssociationFilter& filter,
                                const char** properties) override;
  std::vector<Value> referenceNames(const Operation& operation, const AssociationFilter& filter) override;

  // The class's own provider of methods is called, or that of the nearest superclass which has one; what it returns
  // gets the declared type, and what it adds to the output arguments without a declaration is dropped.
  // CMPI_RC_ERR_METHOD_NOT_AVAILABLE without a provider.
  Value invokeMethod(const Operation& operation, const MethodDeclaration& method, const NamedValues& in,
                     NamedValues& out) override;

 private:
  // The first instance that the class's own provider returns; none if it returns none or the class has no provider.
  std::optional<Value> findInstance(const Operation& operation, const ObjectPath& named, const char** properties);
  // Throws StatusError CMPI_RC_ERR_NOT_FOUND if the class has a provider that supports GetInstance and does not find
  // the instance, and what else it reports.
  void requireThere(const Operation& operation, const ObjectPath& path);
  // Throws StatusError for what contradicts the path or the class, as modifyInstance says.
  void requireConsistent(const Operation& operation, const Instance& instance, const char** properties);

  template <typename Call, typename Keep>
  std::vector<Value> traverse(const Operation& operation, const AssociationFilter& filter, Call call, Keep keep);
  template <typename Call>
  std::vector<Value> traverseToObjects(const Operation& operation, const AssociationFilter& filter, Call call);
  template <typename Call>
  std::vector<Value> traverseToAssociations(const Operation& operation, const AssociationFilter& filter, Call call);

  ProviderRegistry providers_;
  Strictness strictness_ = Strictness::Exact;
};

}  // namespace Cimom
