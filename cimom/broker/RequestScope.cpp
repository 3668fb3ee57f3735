// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/RequestScope.h"

#include "cimom/broker/Handle.h"

namespace Cimom {
namespace {

thread_local RequestScope* innermost = nullptr;

}  // namespace

RequestScope::RequestScope(const CMPIBroker* broker) : RequestScope(broker, false) {}

RequestScope::RequestScope(const CMPIBroker* broker, bool opened)
    : broker_(broker), outer_(innermost), opened_(opened) {
  innermost = this;
}

RequestScope::~RequestScope() {
  while (innermost != this) {
    delete innermost;
  }
  innermost = outer_;
}

CMPIContext* RequestScope::context() {
  if (!context_) {
    auto handle = std::make_unique<Handle<Context>>(Context{});
    context_ = handle.get();
    adopt(std::move(handle));
  }
  return context_;
}

RequestScope* RequestScope::current() { return innermost; }

const CMPIBroker* RequestScope::currentBroker() { return innermost ? innermost->broker_ : nullptr; }

void RequestScope::adopt(std::unique_ptr<Object> object) {
  object->inScope = true;
  objects_.push_back(std::move(object));
}

RequestScope* RequestScope::open(const CMPIBroker* broker) { return new RequestScope(broker, true); }

bool RequestScope::close(const RequestScope* opened) {
  const RequestScope* scope = innermost;
  while (scope && scope->opened_ && scope != opened) {
    scope = scope->outer_;
  }
  if (!scope || scope != opened || !scope->opened_) {
    return false;
  }
  delete scope;
  return true;
}

}  // namespace Cimom
