// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <functional>
#include <string>

#include "cimom/http/Exchange.h"
#include "cimom/http/InFlight.h"
#include "cimom/http/Message.h"
#include "cimom/http/Timers.h"
#include "cimom/http/Workers.h"

namespace Cimom::Http {

struct DispatcherOptions {
  Handler handler;
  FailureHandler failureHandler;                  // none: a 500 with the reason
  std::function<const std::string&()> threadEnd;  // asked on a thread that its handler has ended: by whom, or ""
  std::chrono::seconds timeLimit;                 // for a handler
  std::size_t handlers;                           // at work at once
  std::size_t failures;                           // that wait to be answered
};

// Has requests answered by the handler, each in a thread of its own, and in the handler's place where it does not
// answer in time, ends its thread, or there is no thread for it.
class Dispatcher {
 public:
  Dispatcher(DispatcherOptions options, Timers& timers, Suspensions& suspensions, InFlight& inFlight);

  // Lets the suspended exchange go on with its answer, once there is one. It has entered `inFlight`.
  void dispatch(const ExchangePointer& exchange);

 private:
  struct Answering;

  const std::string& whyEnded() const;
  void fail(const ExchangePointer& exchange, const std::string& why);
  void trimAfter(std::size_t bytes);

  const DispatcherOptions options_;
  const std::string noAnswer_;
  Timers& timers_;
  Suspensions& suspensions_;
  InFlight& inFlight_;
  std::atomic<bool> willTrim_ = false;
  Workers failures_;
  Workers workers_;  // waited for first: whose thread ends turns to the failures
};

}  // namespace Cimom::Http
