// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Workers.h"

#include <algorithm>
#include <exception>
#include <utility>

namespace Cimom::Http {
namespace {

thread_local void* currentThread = nullptr;

}  // namespace

// Leaves the books in order however a thread ends: a provider may end it with pthread_exit.
struct Workers::Leaving {
  Workers& workers;
  Thread& self;

  ~Leaving() {
    const std::lock_guard lock(workers.mutex_);
    self.ended = true;
    if (self.givenUp) {
      --workers.givenUp_;
    }
    // What was queued behind this thread must not wait for the next request.
    if (!workers.ending_ && !workers.queue_.empty() && workers.idle_ == 0) {
      workers.start();
    }
  }
};

Workers::Workers(std::size_t threads, std::size_t waiting) : limit_(threads), waiting_(waiting) {}

Workers::~Workers() {
  {
    const std::lock_guard lock(mutex_);
    ending_ = true;
    queue_.clear();
  }
  changed_.notify_all();
  for (Thread& thread : threads_) {
    thread.thread.join();
  }
}

bool Workers::run(Job job) {
  const std::lock_guard lock(mutex_);
  joinEnded();
  if (ending_) {
    return false;
  }
  const auto taken = [this] { return idle_ <= queue_.size(); };
  if (taken() && mayStart()) {
    start();
  }
  if (threads_.empty() || (taken() && queue_.size() - idle_ >= waiting_)) {
    return false;
  }
  queue_.push_back(std::move(job));
  changed_.notify_one();
  return true;
}

Workers::Token Workers::current() { return static_cast<Token>(currentThread); }

void Workers::giveUp(Token token) {
  const std::lock_guard lock(mutex_);
  if (!token->givenUp) {
    token->givenUp = true;
    ++givenUp_;
  }
}

void Workers::freePlace() {
  const std::lock_guard lock(mutex_);
  Thread& self = *current();
  if (!self.givenUp && !std::exchange(self.freed, true)) {
    ++idle_;
  }
}

bool Workers::mayStart() const {
  const auto running =
      static_cast<std::size_t>(std::ranges::count_if(threads_, [](const Thread& thread) { return !thread.ended; }));
  return running < limit_ + std::min(givenUp_, limit_);
}

void Workers::start() {
  std::list<Thread> added;
  try {
    Thread& thread = added.emplace_back();
    thread.thread = std::thread([this, &thread] { work(thread); });
  } catch (const std::exception&) {
    return;  // no memory or no thread: those that there are do what they can
  }
  threads_.splice(threads_.end(), added);
  ++idle_;
}

void Workers::joinEnded() {
  for (auto thread = threads_.begin(); thread != threads_.end();) {
    if (thread->ended) {
      thread->thread.join();
      thread = threads_.erase(thread);
    } else {
      ++thread;
    }
  }
}

void Workers::work(Thread& self) {
  currentThread = &self;
  const Leaving leaving{*this, self};
  std::unique_lock lock(mutex_);
  while (true) {
    changed_.wait(lock, [this] { return ending_ || !queue_.empty(); });
    if (queue_.empty()) {
      break;
    }
    --idle_;
    Job job = std::move(queue_.front());
    queue_.pop_front();
    lock.unlock();
    job();
    job = nullptr;
    lock.lock();
    if (self.givenUp) {
      break;
    }
    if (!std::exchange(self.freed, false)) {
      ++idle_;
    }
  }
  // A thread that waits no longer is idle no longer.
  if (!self.givenUp) {
    --idle_;
  }
}

}  // namespace Cimom::Http
