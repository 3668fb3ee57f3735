// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/session/OperationThread.h"

#include <condition_variable>
#include <map>
#include <mutex>
#include <thread>

namespace QV::Ipmi {

struct OperationThread::Shared {
  std::mutex mutex;
  std::condition_variable changed;
  std::map<unsigned long, std::function<void()>> jobs;  // by number, which is their order
  unsigned long lastNumber = 0;
  bool ending = false;
  bool ended = false;
  std::chrono::milliseconds idleTime;
  std::function<void()> whenIdle;

  void serve();
  void runUnlocked(std::unique_lock<std::mutex>& lock, const std::function<void()>& job);
};

void OperationThread::Shared::runUnlocked(std::unique_lock<std::mutex>& lock, const std::function<void()>& job) {
  lock.unlock();
  job();
  lock.lock();
}

void OperationThread::Shared::serve() {
  std::unique_lock lock(mutex);
  const auto called = [this] { return ending || !jobs.empty(); };
  while (!ending) {
    if (!changed.wait_for(lock, idleTime, called)) {
      runUnlocked(lock, whenIdle);
      changed.wait(lock, called);
    }
    while (!ending && !jobs.empty()) {
      const auto job = jobs.extract(jobs.begin());
      runUnlocked(lock, job.mapped());
    }
  }
  runUnlocked(lock, whenIdle);
  ended = true;
  changed.notify_all();
}

OperationThread::OperationThread(std::chrono::milliseconds idleTime, std::function<void()> whenIdle)
    : shared_(std::make_shared<Shared>()) {
  shared_->idleTime = idleTime;
  shared_->whenIdle = std::move(whenIdle);
  std::thread([shared = shared_] { shared->serve(); }).detach();
}

OperationThread::~OperationThread() {
  std::unique_lock lock(shared_->mutex);
  shared_->ending = true;
  shared_->changed.notify_all();
  shared_->changed.wait_for(lock, longestEnd, [this] { return shared_->ended; });
}

unsigned long OperationThread::enqueue(std::function<void()> job) {
  const std::lock_guard lock(shared_->mutex);
  shared_->jobs.emplace(++shared_->lastNumber, std::move(job));
  shared_->changed.notify_all();
  return shared_->lastNumber;
}

bool OperationThread::withdraw(unsigned long number) {
  const std::lock_guard lock(shared_->mutex);
  return shared_->jobs.erase(number) != 0;
}

}  // namespace QV::Ipmi
