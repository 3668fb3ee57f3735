// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <mutex>

namespace Cimom::Http {

// Counts the handlers at work and the replies to be sent, for whoever waits for their end. For any thread.
class InFlight {
 public:
  // A request that is to be handled and replied to. Returns false once the server drains.
  bool enter();
  void handled();
  void replied();

  bool isDraining();

  // Takes no more, waits for the handlers, and then a moment for clients to take their replies. Returns false if a
  // handler is still at work after the grace period.
  bool drain(std::chrono::milliseconds grace);

 private:
  std::mutex mutex_;
  std::condition_variable changed_;
  std::size_t handlers_ = 0;
  std::size_t replies_ = 0;
  bool draining_ = false;
};

}  // namespace Cimom::Http
