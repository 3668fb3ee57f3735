// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <thread>

#include "agent/backends/simulated/FileLock.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;
using namespace std::chrono_literals;

TEST(FileLockTest, IsTakenAgainOnceItIsLetGo) {
  const TemporaryDirectory directory;
  { const FileLock lock(directory / "lock", 0ms); }
  EXPECT_NO_THROW(FileLock(directory / "lock", 0ms));
}

TEST(FileLockTest, GivesUpOnAHolderThatDoesNotLetGo) {
  const TemporaryDirectory directory;
  const FileLock holder(directory / "lock", 0ms);
  EXPECT_EQ(thrownBy([&] { FileLock(directory / "lock", 20ms); }),
            "the lock " + (directory / "lock") + " is still held by another process after 20 ms");
}

TEST(FileLockTest, WaitsForAHolderThatLetsGo) {
  const TemporaryDirectory directory;
  auto holder = std::make_unique<FileLock>(directory / "lock", 0ms);
  bool waited = false;
  std::thread waiter([&] {
    const FileLock lock(directory / "lock", 10s);
    waited = true;
  });
  holder.reset();
  waiter.join();
  EXPECT_TRUE(waited);
}

TEST(FileLockTest, LetsOthersInWhereOneTakesItAgainAndAgain) {
  const TemporaryDirectory directory;
  std::atomic<bool> ends = false;
  auto first = std::make_unique<FileLock>(directory / "lock", 0ms);
  std::thread greedy([&] {
    while (!ends) {
      // Gone for no time at all, held for long.
      first.reset();
      first = std::make_unique<FileLock>(directory / "lock", 10s);
      std::this_thread::sleep_for(20ms);
    }
  });
  // Far fewer looks than it would take to come upon a moment when nobody has it.
  for (int i = 0; i < 5; ++i) {
    EXPECT_NO_THROW(FileLock(directory / "lock", 2s)) << i;
  }
  ends = true;
  greedy.join();
}

TEST(FileLockTest, TellsWhyItCannotBeOpened) {
  const TemporaryDirectory directory;
  EXPECT_EQ(thrownBy([&] { FileLock(directory / "none/lock", 0ms); }),
            "the lock " + (directory / "none/lock") + " cannot be opened: No such file or directory");
}

TEST(FileLockTest, FollowsNoSymbolicLink) {
  const TemporaryDirectory directory;
  std::filesystem::create_symlink(directory / "victim", directory / "lock");
  EXPECT_THAT(thrownBy([&] { FileLock(directory / "lock", 0ms); }), testing::HasSubstr("symbolic links"));
  EXPECT_FALSE(std::filesystem::exists(directory / "victim"));
}

}  // namespace
