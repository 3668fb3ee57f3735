#ifndef CIMOM_ROUTING_INSTANCEOPERATIONS_H_
#define CIMOM_ROUTING_INSTANCEOPERATIONS_H_

#include "cimom/routing/ProviderCall.h"

namespace Cimom {

/// The instance operations of DSP0200, each routed to the providers that are registered for the class and the
/// namespace of the operation's path. A property list is CMPI's: null for all, else ended by a null pointer. All throw
/// StatusError.

/// The instances of the class and its subclasses: one call for each that has a provider, with that class's name; none
/// where none has. One provider's failure is the operation's.
std::vector<Value> enumerateInstances(const Operation& operation, const char** properties);
std::vector<Value> enumerateInstanceNames(const Operation& operation);

/// The first instance that the class's own provider returns.
/// CMPI_RC_ERR_NOT_FOUND where it returns none, and where the class has no provider and so no instance.
Value getInstance(const Operation& operation, const char** properties);

/// The path that the provider returns for the new instance, else the instance's own.
/// CMPI_RC_ERR_NOT_SUPPORTED where the class has no provider, as for the other two that write.
Value createInstance(const Operation& operation, const Instance& instance);

/// The provider gets every property that the class declares, null where the caller did not set it, and a path with
/// all keys that the path or the instance has.
void modifyInstance(const Operation& operation, const Instance& instance, const char** properties);

void deleteInstance(const Operation& operation);

}  // namespace Cimom

#endif  // CIMOM_ROUTING_INSTANCEOPERATIONS_H_
