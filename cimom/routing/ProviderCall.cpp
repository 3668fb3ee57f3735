// SPDX-License-Identifier: Apache-2.0
#include "cimom/routing/ProviderCall.h"

namespace Cimom {
namespace {

// Far more than any stack of providers needs, and far less than a thread's stack holds.
constexpr unsigned deepest = 32;

thread_local unsigned depth = 0;

}  // namespace

CallDepth::CallDepth() {
  if (depth == deepest) {
    throw StatusError(CMPI_RC_ERR_FAILED, "provider calls nest more than " + std::to_string(deepest) + " levels deep");
  }
  ++depth;
}

CallDepth::~CallDepth() { --depth; }

Context providerContext(const Operation& operation) {
  Context context = operation.context;
  if (!context.entries.find(CMPIInvocationFlags)) {
    context.entries.set(CMPIInvocationFlags, Value::uint32(0));
  }
  if (!context.entries.find(CMPIInitNameSpace)) {
    context.entries.set(CMPIInitNameSpace, Value::string(operation.path.nameSpace));
  }
  return context;
}

void completeNamespace(Value& item, const std::string& nameSpace) {
  if (const ObjectPath* path = item.path(); path && path->nameSpace.empty()) {
    item.own<ObjectPath>()->nameSpace = nameSpace;
  } else if (const Instance* instance = item.embedded()) {
    Shared<ObjectPath> own = instance->path();
    if (own->nameSpace.empty()) {
      own.own().nameSpace = nameSpace;
      item.own<Instance>()->setPath(std::move(own));
    }
  }
}

}  // namespace Cimom
