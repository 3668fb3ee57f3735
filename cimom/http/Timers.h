// SPDX-License-Identifier: Apache-2.0
// Things to do at a time, by the monotonic clock.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <thread>
#include <utility>

namespace Cimom::Http {

class Timers {
 public:
  using Clock = std::chrono::steady_clock;
  using Task = std::function<void()>;  // short, and without an exception
  // Names what was scheduled; the default one names nothing.
  using Ticket = std::pair<Clock::time_point, std::uint64_t>;

  Timers();
  ~Timers();
  Timers(const Timers&) = delete;
  Timers& operator=(const Timers&) = delete;

  Ticket at(Clock::time_point time, Task task);

  // The task may be under way or done nevertheless.
  void cancel(const Ticket& ticket);

  // Drops what is still to be done, and waits for the task that is under way.
  void stop();

 private:
  void work();

  std::mutex mutex_;
  std::condition_variable changed_;
  std::map<Ticket, Task> tasks_;
  std::uint64_t next_ = 1;
  bool ending_ = false;
  std::thread thread_;
};

}  // namespace Cimom::Http
