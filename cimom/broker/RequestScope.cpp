// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/RequestScope.h"

#include <algorithm>

#include "cimom/broker/Handle.h"

namespace Cimom {
namespace {

thread_local RequestScope* innermost = nullptr;

Deadline earlier(const Deadline& one, const Deadline& other) {
  return one && other ? std::min(*one, *other) : one ? one : other;
}

}  // namespace

RequestScope::RequestScope(const CMPIBroker* broker, Deadline deadline) : RequestScope(broker, deadline, false) {}

RequestScope::RequestScope(const CMPIBroker* broker, Deadline deadline, bool opened)
    : broker_(broker), outer_(innermost), deadline_(earlier(deadline, currentDeadline())), opened_(opened) {
  innermost = this;
}

RequestScope::~RequestScope() {
  while (innermost != this) {
    delete innermost;
  }
  innermost = outer_;
  while (last_) {
    std::exchange(last_, last_->before)->~Object();
  }
}

CMPIContext* RequestScope::context() {
  if (!context_) {
    context_ = make<Handle<Context>>(Context{{}, deadline_});
  }
  return context_;
}

RequestScope* RequestScope::current() { return innermost; }

const CMPIBroker* RequestScope::currentBroker() { return innermost ? innermost->broker_ : nullptr; }

Deadline RequestScope::currentDeadline() { return innermost ? innermost->deadline_ : std::nullopt; }

RequestScope* RequestScope::open(const CMPIBroker* broker, Deadline deadline) {
  return new RequestScope(broker, deadline, true);
}

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
