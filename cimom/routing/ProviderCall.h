#ifndef CIMOM_ROUTING_PROVIDERCALL_H_
#define CIMOM_ROUTING_PROVIDERCALL_H_

#include <cmpift.h>

#include <string>
#include <utility>

#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Handle.h"
#include "cimom/broker/ProviderGuard.h"

namespace Cimom {

/// One operation on its way to the providers: the object manager, the caller's context and the path that it is for.
struct Operation {
  /// @throws StatusError for a null broker, context or path, an unknown namespace or an unknown class
  Operation(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path);

  BrokerCore& core;
  const Context& context;
  const ObjectPath& path;
  const ClassDefinition& definition;  ///< of the path's class
};

/// Checks that calls which end in providers that call again do not nest without end, and counts one level of them.
class CallDepth {
 public:
  /// @throws StatusError CMPI_RC_ERR_FAILED
  CallDepth();
  ~CallDepth();
  CallDepth(const CallDepth&) = delete;
  CallDepth& operator=(const CallDepth&) = delete;
};

/// The context that a provider gets: the caller's entries, and the invocation flags and the namespace of the request
/// where the caller says nothing of them.
Context providerContext(const Operation& operation);

/// Puts the operation's namespace into a delivered item that names none.
void completeNamespace(Value& item, const std::string& nameSpace);

/// Calls one slot of a provider. The call has its own memory, of which only what was delivered lives on.
/// @param kind what the operation takes: CMPI_instance or CMPI_ref
/// @param slot the function of the MI's table
/// @param arguments what follows the MI, the context and the result
/// @throws StatusError with what the provider reports or throws; CMPI_RC_ERR_NOT_SUPPORTED where the slot is empty
template <class Mi, class Slot, class... Arguments>
std::vector<Value> callProvider(const Operation& operation, const Provider& provider, Mi* mi, CMPIType kind, Slot slot,
                                const Arguments&... arguments) {
  if (!slot) throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "provider " + provider.name() + " has no such operation");
  const CallDepth depth;
  const RequestScope scope(&operation.core.broker);
  const auto context = lend(providerContext(operation));
  auto result = lend(Result{kind, {}, {}});
  runProvider("provider " + provider.name(), [&] { return slot(mi, &context, &result, arguments...); });
  if (const auto& error = result.model.error) {
    throw StatusError(error->statusCode == CMPI_RC_OK ? CMPI_RC_ERR_FAILED : error->statusCode,
                      error->message.value_or(""));
  }
  for (Value& item : result.model.items) completeNamespace(item, operation.path.nameSpace);
  return std::move(result.model.items);
}

}  // namespace Cimom

#endif  // CIMOM_ROUTING_PROVIDERCALL_H_
