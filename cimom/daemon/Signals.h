// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <signal.h>

#include <condition_variable>
#include <mutex>

namespace Cimom {

// The signals by which the program is run: SIGTERM and SIGINT end it, SIGHUP has it read its files again. They are
// taken by a thread of their own, so that they are heard whatever the others do.
class Signals {
 public:
  enum class Wish { End, Reload };

  // Threads that start later inherit the mask, so it is made before any. Until serving() the program ends at once, with
  // status 0.
  Signals();
  Signals(const Signals&) = delete;
  Signals& operator=(const Signals&) = delete;

  void serving();

  // The next wish. After the one to end, another signal to end ends the program at once, with status 1.
  Wish wait();

 private:
  void take(int signal);
  [[noreturn]] void work();

  enum class Phase { Starting, Serving, Ending };

  sigset_t signals_{};
  std::mutex mutex_;
  std::condition_variable changed_;
  Phase phase_ = Phase::Starting;
  bool end_ = false;
  bool reload_ = false;
};

}  // namespace Cimom
