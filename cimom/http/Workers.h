// SPDX-License-Identifier: Apache-2.0
// Threads that carry out what may take long, so that the thread of the connections never waits.
#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <list>
#include <mutex>
#include <thread>

namespace Cimom::Http {

class Workers {
 public:
  using Job = std::function<void()>;

  // At most `threads` jobs at once, started as they are needed, and `waiting` more in a queue. A job whose thread is
  // given up no longer counts, up to `threads` such jobs.
  Workers(std::size_t threads, std::size_t waiting);

  // Drops the jobs in the queue and waits for those that run, given up or not.
  ~Workers();

  Workers(const Workers&) = delete;
  Workers& operator=(const Workers&) = delete;

  // Returns false if there is no room, or no thread to be had. A job must not throw; it may end its thread, which is
  // replaced.
  bool run(Job job);

 private:
  struct Thread {
    std::thread thread;
    bool ended = false;
    bool givenUp = false;
    bool freed = false;
  };

 public:
  // The thread that carries out a job, as that job sees it.
  using Token = Thread*;
  static Token current();

  // No longer waits for the job that this thread carries out: another thread may be started in its place. The job must
  // not have ended.
  void giveUp(Token token);

  // The job that runs in this thread has only its last, short steps to do: another may be begun behind it. Whom these
  // steps tell that it is done finds its place free.
  void freePlace();

 private:
  struct Leaving;

  void work(Thread& self);
  bool mayStart() const;
  void start();
  void joinEnded();

  const std::size_t limit_;
  const std::size_t waiting_;
  std::mutex mutex_;
  std::condition_variable changed_;
  std::deque<Job> queue_;
  std::list<Thread> threads_;
  std::size_t idle_ = 0;
  std::size_t givenUp_ = 0;
  bool ending_ = false;
};

}  // namespace Cimom::Http
