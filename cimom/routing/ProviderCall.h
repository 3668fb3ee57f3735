// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <string>
#include <utility>

#include "cimom/broker/Handle.h"
#include "cimom/broker/Operation.h"
#include "cimom/providers/Provider.h"

namespace Cimom {

// Checks that calls which end in providers that call again do not nest without end, and counts one level of them.
class CallDepth {
 public:
  // Throws StatusError CMPI_RC_ERR_FAILED.
  CallDepth();
  ~CallDepth();
  CallDepth(const CallDepth&) = delete;
  CallDepth& operator=(const CallDepth&) = delete;
};

// The context that a provider gets: the caller's entries, and the invocation flags and the namespace of the request
// if the caller says nothing of them.
Context providerContext(const Operation& operation);

// Puts the operation's namespace into a delivered item that names none.
void completeNamespace(Value& item, const std::string& nameSpace);

// Calls one slot of a provider. The call has its own memory, of which only what was delivered lives on.
// `kind` is what the operation takes, CMPI_instance or CMPI_ref; `slot` the function of the MI's table; `arguments`
// what follows the MI, the context and the result. Throws StatusError with what the provider reports or throws;
// CMPI_RC_ERR_NOT_SUPPORTED if the slot is empty.
template <typename Mi, typename Slot, typename... Arguments>
std::vector<Value> callProvider(const Operation& operation, const Provider& provider, Mi* mi, CMPIType kind, Slot slot,
                                const Arguments&... arguments) {
  if (!slot) {
    throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "provider " + provider.name() + " does not support this operation");
  }
  const CallDepth depth;
  const RequestScope scope(&operation.core.broker);
  const auto context = lend(providerContext(operation));
  auto result = lend(Result{kind, {}, {}});
  runProvider("provider " + provider.name(), [&] { return slot(mi, &context, &result, arguments...); });
  if (const auto& error = result.model.error) {
    throw StatusError(error->statusCode == CMPI_RC_OK ? CMPI_RC_ERR_FAILED : error->statusCode,
                      error->message.value_or(""));
  }
  for (Value& item : result.model.items) {
    completeNamespace(item, operation.path.nameSpace);
  }
  return std::move(result.model.items);
}

}  // namespace Cimom
