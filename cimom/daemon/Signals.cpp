// SPDX-License-Identifier: Apache-2.0
#include "cimom/daemon/Signals.h"

#include <pthread.h>

#include <cstdlib>
#include <iostream>
#include <thread>
#include <utility>

namespace Cimom {

// The thread lives as long as the program, and so must this object.
Signals::Signals() {
  sigemptyset(&signals_);
  for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
    sigaddset(&signals_, number);
  }
  pthread_sigmask(SIG_BLOCK, &signals_, nullptr);
  signal(SIGPIPE, SIG_IGN);
  std::thread([this] { work(); }).detach();
}

void Signals::serving() {
  const std::lock_guard lock(mutex_);
  phase_ = Phase::Serving;
}

Signals::Wish Signals::wait() {
  std::unique_lock lock(mutex_);
  changed_.wait(lock, [this] { return end_ || reload_; });
  if (end_) {
    return Wish::End;
  }
  reload_ = false;
  return Wish::Reload;
}

void Signals::work() {
  while (true) {
    int received = 0;
    if (sigwait(&signals_, &received) == 0) {
      take(received);
    }
  }
}

void Signals::take(int signal) {
  const std::lock_guard lock(mutex_);
  if (signal == SIGHUP) {
    reload_ = true;
  } else if (phase_ == Phase::Starting) {
    // Nothing is served, and no provider has been asked anything.
    std::_Exit(EXIT_SUCCESS);
  } else if (std::exchange(phase_, Phase::Ending) == Phase::Ending) {
    std::cerr << "cimomd: shutting down at once, without provider cleanup: a second signal" << std::endl;
    std::_Exit(EXIT_FAILURE);
  } else {
    end_ = true;
  }
  changed_.notify_all();
}

}  // namespace Cimom
