// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Timers.h"

namespace Cimom::Http {

Timers::Timers() : thread_([this] { work(); }) {}

Timers::~Timers() { stop(); }

void Timers::stop() {
  {
    const std::lock_guard lock(mutex_);
    ending_ = true;
  }
  changed_.notify_one();
  if (thread_.joinable()) {
    thread_.join();
  }
}

Timers::Ticket Timers::at(Clock::time_point time, Task task) {
  const std::lock_guard lock(mutex_);
  const Ticket ticket{time, next_++};
  const auto place = tasks_.emplace(ticket, std::move(task)).first;
  if (place == tasks_.begin()) {
    changed_.notify_one();
  }
  return ticket;
}

void Timers::cancel(const Ticket& ticket) {
  Task dropped;  // destroyed without the lock
  const std::lock_guard lock(mutex_);
  if (const auto place = tasks_.find(ticket); place != tasks_.end()) {
    dropped = std::move(place->second);
    tasks_.erase(place);
  }
}

void Timers::work() {
  std::unique_lock lock(mutex_);
  while (!ending_) {
    if (tasks_.empty()) {
      changed_.wait(lock);
      continue;
    }
    const auto first = tasks_.begin();
    if (const auto time = first->first.first; time > Clock::now()) {
      changed_.wait_until(lock, time);
      continue;
    }
    {
      const Task task = std::move(first->second);
      tasks_.erase(first);
      lock.unlock();
      task();
    }
    lock.lock();
  }
}

}  // namespace Cimom::Http
