// SPDX-License-Identifier: Apache-2.0
// One request on its way from the first header to the last byte of its reply.
#pragma once

#include <microhttpd.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>

#include "cimom/http/Message.h"
#include "cimom/http/RequestHead.h"
#include "cimom/http/Timers.h"
#include "cimom/http/Workers.h"

namespace Cimom::Http {

// The bytes of bodies that all requests together may hold.
class MemoryBudget {
 public:
  explicit MemoryBudget(std::size_t bytes) : left_(static_cast<std::ptrdiff_t>(bytes)) {}

  bool take(std::size_t bytes);
  void give(std::size_t bytes) { left_ += static_cast<std::ptrdiff_t>(bytes); }

 private:
  std::atomic<std::ptrdiff_t> left_;
};

// It is shared between the connection and whoever works on the answer: what comes late finds it still there.
class Exchange {
 public:
  enum class Phase { Head, Login, Body, Answering, Replied };

  Exchange(std::size_t maxBody, MemoryBudget& budget) : maxBody_(maxBody), budget_(budget) {}
  ~Exchange() { budget_.give(charged_); }
  Exchange(const Exchange&) = delete;
  Exchange& operator=(const Exchange&) = delete;

  // For the thread of the connections.
  Request request;
  Phase phase = Phase::Head;
  bool isHttp11 = true;
  bool counted = false;  // among the replies that a drain waits for
  std::chrono::steady_clock::time_point begun = std::chrono::steady_clock::now();
  std::string group;     // of addresses, and
  std::string password;  // while they are checked, which is
  std::chrono::steady_clock::time_point notBefore;
  unsigned status = 0;  // of the reply
  std::string subject;  // of the request log
  Timers::Ticket timeLimit;

  // Takes a part of the body. Returns false for a client that goes on although its request is refused.
  bool receive(const char* data, std::size_t size);
  // Why the body is not looked at, once it is there.
  const std::optional<Refusal>& refusal() const { return refusal_; }
  // The response, once the connection has been resumed; none: it may go on, or it is abandoned.
  std::optional<Response> takeResponse();
  bool isAbandoned();

  void suspend(MHD_Connection* connection);

  // For any thread. Lets the connection go on, with a response or without, unless somebody has done so already.
  void resume(std::optional<Response> response);
  void abandon();

  // The handler's thread, and its end. The body is freed then, unless somebody else may be reading it.
  void beginHandling(Workers::Token worker);
  void endHandling();
  // Gives the handler's thread up. Returns false if the handler has ended.
  bool giveUpHandling(Workers& workers);

 private:
  const std::size_t maxBody_;
  MemoryBudget& budget_;
  std::size_t charged_ = 0;
  std::size_t dropped_ = 0;  // bytes of the body that are not kept
  std::optional<Refusal> refusal_;

  std::mutex mutex_;
  MHD_Connection* suspended_ = nullptr;
  std::optional<Response> response_;
  bool abandoned_ = false;
  bool givenUp_ = false;
  Workers::Token worker_ = nullptr;
  bool ended_ = false;
};

using ExchangePointer = std::shared_ptr<Exchange>;

// The exchanges whose connections are suspended: the HTTP library must not be stopped while there is one.
class Suspensions {
 public:
  // Suspends the connection of an exchange. Returns false if the server ends, or has no memory.
  bool add(const ExchangePointer& exchange, MHD_Connection* connection);
  // Lets it go on, unless somebody has done so already: with a response, without one, or to its end.
  void resume(const ExchangePointer& exchange, std::optional<Response> response);
  void abandon(const ExchangePointer& exchange);
  // With the answer that there is no room for it now; to its end where there is no memory for that.
  void turnAway(const ExchangePointer& exchange, const char* reason);
  // Lets all connections go on without an answer, and takes no more.
  void end();

 private:
  std::mutex mutex_;
  std::set<ExchangePointer> suspended_;
  bool ended_ = false;
};

}  // namespace Cimom::Http
