// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Exchange.h"

#include <exception>
#include <new>
#include <utility>

#include "cimom/http/Reply.h"

namespace Cimom::Http {
namespace {

// A request as small as most are is not refused for the sake of large ones.
constexpr std::size_t alwaysTaken = 64 << 10;

}  // namespace

bool MemoryBudget::take(std::size_t bytes) {
  const auto wanted = static_cast<std::ptrdiff_t>(bytes);
  if (left_.fetch_sub(wanted) >= wanted) {
    return true;
  }
  left_ += wanted;
  return false;
}

// The size of a chunked body is known only once it has been read: what is beyond the limit is dropped, and a client
// that goes on for as long again is cut off.
bool Exchange::receive(const char* data, std::size_t size) {
  std::string& body = request.body;
  if (!refusal_ && size > maxBody_ - body.size()) {
    refusal_ = Refusal{MHD_HTTP_CONTENT_TOO_LARGE, "the request is too large"};
  }
  if (!refusal_ && body.size() + size > alwaysTaken) {
    if (budget_.take(size)) {
      charged_ += size;
    } else {
      refusal_ = Refusal{MHD_HTTP_SERVICE_UNAVAILABLE, "too many large requests at once"};
    }
  }
  if (!refusal_) {
    body.append(data, size);
    return true;
  }
  std::string().swap(body);
  budget_.give(std::exchange(charged_, 0));
  dropped_ += size;
  return dropped_ <= 2 * maxBody_;
}

std::optional<Response> Exchange::takeResponse() {
  const std::lock_guard lock(mutex_);
  return std::exchange(response_, std::nullopt);
}

bool Exchange::isAbandoned() {
  const std::lock_guard lock(mutex_);
  return abandoned_;
}

void Exchange::suspend(MHD_Connection* connection) {
  const std::lock_guard lock(mutex_);
  MHD_suspend_connection(connection);
  suspended_ = connection;
}

void Exchange::resume(std::optional<Response> response) {
  const std::lock_guard lock(mutex_);
  if (suspended_) {
    response_ = std::move(response);
    MHD_resume_connection(std::exchange(suspended_, nullptr));
  }
}

void Exchange::abandon() {
  const std::lock_guard lock(mutex_);
  abandoned_ = true;
  if (suspended_) {
    MHD_resume_connection(std::exchange(suspended_, nullptr));
  }
}

void Exchange::beginHandling(Workers::Token worker) {
  const std::lock_guard lock(mutex_);
  worker_ = worker;
}

void Exchange::endHandling() {
  const std::lock_guard lock(mutex_);
  worker_ = nullptr;
  ended_ = true;
  if (!givenUp_) {
    std::string().swap(request.body);
    budget_.give(std::exchange(charged_, 0));
  }
}

bool Exchange::giveUpHandling(Workers& workers) {
  const std::lock_guard lock(mutex_);
  if (ended_) {
    return false;
  }
  givenUp_ = true;
  if (worker_) {
    workers.giveUp(worker_);
  }
  return true;
}

bool Suspensions::add(const ExchangePointer& exchange, MHD_Connection* connection) {
  const std::lock_guard lock(mutex_);
  if (ended_) {
    return false;
  }
  try {
    suspended_.insert(exchange);
  } catch (const std::bad_alloc&) {
    return false;
  }
  exchange->suspend(connection);
  return true;
}

void Suspensions::resume(const ExchangePointer& exchange, std::optional<Response> response) {
  const std::lock_guard lock(mutex_);
  suspended_.erase(exchange);
  exchange->resume(std::move(response));
}

void Suspensions::abandon(const ExchangePointer& exchange) {
  const std::lock_guard lock(mutex_);
  suspended_.erase(exchange);
  exchange->abandon();
}

void Suspensions::turnAway(const ExchangePointer& exchange, const char* reason) {
  try {
    resume(exchange, overload(reason));
  } catch (const std::exception&) {
    abandon(exchange);
  }
}

void Suspensions::end() {
  const std::lock_guard lock(mutex_);
  ended_ = true;
  for (const auto& exchange : suspended_) {
    exchange->abandon();
  }
  suspended_.clear();
}

}  // namespace Cimom::Http
