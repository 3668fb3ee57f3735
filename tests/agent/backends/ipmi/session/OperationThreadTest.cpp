// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include <atomic>
#include <future>
#include <vector>

#include "agent/backends/ipmi/session/OperationThread.h"

namespace {

using QV::Ipmi::Deadline;
using QV::Ipmi::OperationThread;
using QV::Ipmi::Overdue;
using namespace std::chrono_literals;

const auto never = 1h;
// Before long, and not before the operation has begun on a machine that stalls.
const auto soon = 300ms;
const auto nothing = [] {};

TEST(OperationThreadTest, GivesWhatTheOperationGivesAndThrowsWhatItThrows) {
  OperationThread thread(never, nothing);
  EXPECT_EQ(thread.run(Deadline(10s), [] { return 42; }), 42);
  EXPECT_THAT([&] { thread.run(Deadline(10s), []() -> int { throw std::out_of_range("too far"); }); },
              testing::ThrowsMessage<std::runtime_error>("too far"));
}

TEST(OperationThreadTest, LetsTheCallerGoAtTheDeadlineAndFinishesTheOperation) {
  const auto release = std::make_shared<std::promise<void>>();
  const auto ended = std::make_shared<std::promise<void>>();
  OperationThread thread(never, nothing);

  try {
    thread.run(Deadline(soon), [released = release->get_future().share(), ended] {
      released.wait();
      ended->set_value();
    });
    FAIL() << "the operation cannot have ended";
  } catch (const Overdue& late) {
    EXPECT_TRUE(late.begun());
  }

  release->set_value();
  EXPECT_EQ(ended->get_future().wait_for(10s), std::future_status::ready);
}

TEST(OperationThreadTest, NeverBeginsAnOperationWhoseCallerHasLeft) {
  const auto release = std::make_shared<std::promise<void>>();
  const auto begun = std::make_shared<std::atomic<bool>>(false);
  OperationThread thread(never, nothing);
  EXPECT_THROW(thread.run(Deadline(soon), [released = release->get_future().share()] { released.wait(); }), Overdue);

  try {
    thread.run(Deadline(soon), [begun] { *begun = true; });
    FAIL() << "the operation cannot have ended";
  } catch (const Overdue& late) {
    EXPECT_FALSE(late.begun());
  }

  release->set_value();
  thread.run(Deadline(10s), nothing);
  EXPECT_FALSE(*begun);
}

TEST(OperationThreadTest, RunsOneOperationAtATime) {
  OperationThread thread(never, nothing);
  const auto running = std::make_shared<std::atomic<int>>(0);
  const auto together = std::make_shared<std::atomic<int>>(0);
  std::vector<std::future<void>> callers;
  for (int caller = 0; caller < 8; ++caller) {
    callers.push_back(std::async(std::launch::async, [&] {
      for (int operation = 0; operation < 50; ++operation) {
        thread.run(Deadline(10s), [running, together] {
          if (++*running > 1) {
            ++*together;
          }
          --*running;
        });
      }
    }));
  }
  for (auto& caller : callers) {
    caller.get();
  }
  EXPECT_EQ(*together, 0);
}

TEST(OperationThreadTest, ActsOnceWhenIdleAndOnceWhenItEnds) {
  const auto idle = std::make_shared<std::atomic<int>>(0);
  {
    OperationThread thread(10ms, [idle] {
      ++*idle;
      idle->notify_all();
    });
    idle->wait(0);
    EXPECT_EQ(*idle, 1);
  }
  EXPECT_EQ(*idle, 2);
}

TEST(OperationThreadTest, ThatIsBlockedDoesNotHoldItsOwner) {
  const auto release = std::make_shared<std::promise<void>>();
  const auto idle = std::make_shared<std::promise<void>>();
  const auto start = std::chrono::steady_clock::now();
  {
    OperationThread thread(never, [idle] { idle->set_value(); });
    EXPECT_THROW(thread.run(Deadline(soon), [released = release->get_future().share()] { released.wait(); }), Overdue);
  }
  EXPECT_LT(std::chrono::steady_clock::now() - start, OperationThread::longestEnd + 20s);
  release->set_value();
  EXPECT_EQ(idle->get_future().wait_for(10s), std::future_status::ready) << "it cleans up when it can";
}

}  // namespace
