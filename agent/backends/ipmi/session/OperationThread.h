// SPDX-License-Identifier: Apache-2.0
// The thread on which the processor is asked. libfreeipmi and the operating system's driver block for longer than a
// caller may wait; here it is the thread that stays behind, while the caller leaves at its deadline.
#pragma once

#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <type_traits>
#include <utility>
#include <variant>

#include "agent/backends/ipmi/session/Deadline.h"

namespace QV::Ipmi {

// The deadline passed before the operation ended.
class Overdue : public std::runtime_error {
 public:
  explicit Overdue(bool begun) : std::runtime_error("the operation's time is over"), begun_(begun) {}

  // Whether the operation is still under way; else it never began and never will.
  bool begun() const { return begun_; }

 private:
  bool begun_;
};

// Runs one operation after the other, in the order in which they came.
class OperationThread {
 public:
  // `whenIdle` runs on the thread once no operation came for the idle time, and when the thread ends.
  OperationThread(std::chrono::milliseconds idleTime, std::function<void()> whenIdle);

  // Waits for the operation that is under way, but not longer than `longestEnd`; a thread that is still blocked then
  // ends by itself. What operations and `whenIdle` use must therefore be theirs, not the caller's.
  ~OperationThread();
  OperationThread(const OperationThread&) = delete;
  OperationThread& operator=(const OperationThread&) = delete;

  // Runs the operation and returns what it returns; throws std::runtime_error with the text of what it throws. Throws
  // Overdue at the deadline, waiting for earlier operations included.
  template <typename Operation>
  auto run(Deadline deadline, Operation operation) {
    using Result = std::invoke_result_t<Operation>;
    constexpr bool returnsNothing = std::is_void_v<Result>;
    // A failure crosses as text, so that no exception object is shared between the threads.
    struct Outcome {
      std::optional<std::conditional_t<returnsNothing, std::monostate, Result>> value;
      std::string failure;
    };
    const auto task = std::make_shared<std::packaged_task<Outcome()>>([operation = std::move(operation)]() -> Outcome {
      try {
        if constexpr (returnsNothing) {
          operation();
          return {std::monostate{}, {}};
        } else {
          return {operation(), {}};
        }
      } catch (const std::exception& error) {
        return {std::nullopt, error.what()};
      }
    });
    std::future<Outcome> result = task->get_future();
    const auto number = enqueue([task] { (*task)(); });
    if (result.wait_until(deadline.time()) != std::future_status::ready) {
      throw Overdue(!withdraw(number));
    }
    Outcome outcome = result.get();
    if (!outcome.value) {
      throw std::runtime_error(outcome.failure);
    }
    if constexpr (!returnsNothing) {
      return std::move(*outcome.value);
    }
  }

  static constexpr std::chrono::seconds longestEnd{2};

 private:
  struct Shared;

  unsigned long enqueue(std::function<void()> job);
  // Whether the job had not begun; it is forgotten then.
  bool withdraw(unsigned long number);

  std::shared_ptr<Shared> shared_;
};

}  // namespace QV::Ipmi
