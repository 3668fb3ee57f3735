#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <thread>

#include "agent/backends/simulated/FileLock.h"
#include "tests/agent/support/Throws.h"
#include "tests/support/TemporaryDirectory.h"

namespace QV {
namespace {

using namespace std::chrono_literals;

TEST(FileLock, isTakenAgainOnceItIsLetGo) {
  const Testing::TemporaryDirectory directory;
  { const FileLock lock(directory / "lock", 0ms); }
  EXPECT_NO_THROW(FileLock(directory / "lock", 0ms));
}

TEST(FileLock, givesUpOnAHolderThatDoesNotLetGo) {
  const Testing::TemporaryDirectory directory;
  const FileLock holder(directory / "lock", 0ms);
  EXPECT_EQ(thrownBy([&] { FileLock(directory / "lock", 20ms); }),
            "the lock " + (directory / "lock") + " is still held by another process after 20 ms");
}

TEST(FileLock, waitsForAHolderThatLetsGo) {
  const Testing::TemporaryDirectory directory;
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

TEST(FileLock, tellsWhyItCannotBeOpened) {
  const Testing::TemporaryDirectory directory;
  EXPECT_EQ(thrownBy([&] { FileLock(directory / "none/lock", 0ms); }),
            "the lock " + (directory / "none/lock") + " cannot be opened: No such file or directory");
}

TEST(FileLock, followsNoSymbolicLink) {
  const Testing::TemporaryDirectory directory;
  std::filesystem::create_symlink(directory / "victim", directory / "lock");
  EXPECT_THAT(thrownBy([&] { FileLock(directory / "lock", 0ms); }), testing::HasSubstr("symbolic links"));
  EXPECT_FALSE(std::filesystem::exists(directory / "victim"));
}

}  // namespace
}  // namespace QV
