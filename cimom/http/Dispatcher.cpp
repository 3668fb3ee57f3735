// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Dispatcher.h"

#include <malloc.h>

#include <algorithm>
#include <exception>
#include <memory>
#include <new>
#include <optional>
#include <utility>

#include "cimom/http/Guarded.h"
#include "cimom/http/Reply.h"

namespace Cimom::Http {
namespace {

const std::string threadEnded = "a provider ended the thread of its request";

// What a request of this size, or one with a reply of this size, has taken goes back to the system after a while: the
// allocator keeps what it was in small blocks for the thread that it served. Once for all that come meanwhile.
constexpr std::size_t largeBytes = 1 << 20;
constexpr std::chrono::seconds untilTrim{1};

}  // namespace

// Answers the request however its handler ends.
struct Dispatcher::Answering {
  Dispatcher& dispatcher;
  ExchangePointer exchange;
  std::optional<Response> response = {};

  ~Answering() {
    dispatcher.timers_.cancel(exchange->timeLimit);
    dispatcher.trimAfter(std::max(exchange->request.body.size(), response ? response->size() : 0));
    if (response) {
      exchange->endHandling();
      dispatcher.workers_.freePlace();
      dispatcher.suspensions_.resume(exchange, std::move(response));
    } else {
      // The provider has ended the thread, which another replaces.
      exchange->giveUpHandling(dispatcher.workers_);
      exchange->endHandling();
      dispatcher.fail(exchange, dispatcher.whyEnded());
    }
    dispatcher.inFlight_.handled();
  }
};

Dispatcher::Dispatcher(DispatcherOptions options, Timers& timers, Suspensions& suspensions, InFlight& inFlight)
    : options_(std::move(options)),
      noAnswer_("the provider did not answer within " + std::to_string(options_.timeLimit.count()) + " s"),
      timers_(timers),
      suspensions_(suspensions),
      inFlight_(inFlight),
      failures_(1, options_.failures),
      workers_(options_.handlers, 0) {}

void Dispatcher::dispatch(const ExchangePointer& exchange) {
  try {
    exchange->timeLimit = timers_.at(exchange->request.deadline, [this, weak = std::weak_ptr(exchange)] {
      if (const auto late = weak.lock(); late && late->giveUpHandling(workers_)) {
        fail(late, noAnswer_);
      }
    });
    if (workers_.run([this, exchange] {
          exchange->beginHandling(Workers::current());
          Answering answering{*this, exchange};
          answering.response = guarded([&] { return options_.handler(exchange->request); });
        })) {
      return;
    }
  } catch (const std::exception&) {
    // no memory: there is no room, then
  }
  timers_.cancel(exchange->timeLimit);
  inFlight_.handled();
  suspensions_.turnAway(exchange, "too many requests at once");
}

// Who has ended the thread that this is called on.
const std::string& Dispatcher::whyEnded() const {
  const std::string& reason = options_.threadEnd ? options_.threadEnd() : threadEnded;
  return reason.empty() ? threadEnded : reason;
}

// It takes no exception from the threads that call it.
void Dispatcher::fail(const ExchangePointer& exchange, const std::string& why) {
  try {
    if (options_.failureHandler && failures_.run([this, exchange, why] {
          suspensions_.resume(exchange, guarded([&] { return options_.failureHandler(exchange->request, why); }));
        })) {
      return;
    }
  } catch (const std::exception&) {
    // answered without the handler
  }
  try {
    suspensions_.resume(exchange, refusal(MHD_HTTP_INTERNAL_SERVER_ERROR, why));
  } catch (const std::exception&) {
    suspensions_.abandon(exchange);
  }
}

void Dispatcher::trimAfter(std::size_t bytes) {
  if (bytes < largeBytes || willTrim_.exchange(true)) {
    return;
  }
  try {
    timers_.at(std::chrono::steady_clock::now() + untilTrim, [this] {
      willTrim_ = false;
      malloc_trim(0);
    });
  } catch (const std::bad_alloc&) {
    willTrim_ = false;  // the next large request will do
  }
}

}  // namespace Cimom::Http
