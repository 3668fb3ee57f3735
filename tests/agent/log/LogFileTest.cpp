// SPDX-License-Identifier: Apache-2.0
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <sstream>
#include <thread>
#include <vector>

#include "agent/log/LogFile.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace TWLog;
using namespace Testing;

TEST(LogFileTest, IsMadeForItsOwnerAndGroup) {
  const TemporaryDirectory directory;
  LogFile file(directory / "log");
  EXPECT_EQ(file.append("one\n"), 0);
  struct stat status {};
  ASSERT_EQ(::stat((directory / "log").c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 0137, 0U) << "no more than rw-r-----";
  EXPECT_EQ(readFile(directory / "log"), "one\n");
}

TEST(LogFileTest, KeepsWhatIsThere) {
  const TemporaryDirectory directory;
  writeFile(directory / "log", "before\n");
  LogFile(directory / "log").append("after\n");
  EXPECT_EQ(readFile(directory / "log"), "before\nafter\n");
}

TEST(LogFileTest, FollowsARotationThatRenamesIt) {
  const TemporaryDirectory directory;
  LogFile file(directory / "log");
  file.append("old\n");
  std::filesystem::rename(directory / "log", directory / "log.1");

  int appended = 1;
  const auto start = std::chrono::steady_clock::now();
  EXPECT_TRUE(poll([&] {
    file.append("new\n");
    ++appended;
    return std::filesystem::exists(directory / "log");
  }));
  EXPECT_LT(std::chrono::steady_clock::now() - start, LogFile::lookInterval + std::chrono::seconds(10));

  const std::string lines = readFile(directory / "log.1") + readFile(directory / "log");
  EXPECT_EQ(std::ranges::count(lines, '\n'), appended) << "no line is lost";
  EXPECT_TRUE(lines.starts_with("old\nnew\n"));
  EXPECT_EQ(readFile(directory / "log"), "new\n");
}

TEST(LogFileTest, IsLookedForWithTheFirstLineAfterAPause) {
  const TemporaryDirectory directory;
  LogFile file(directory / "log");
  file.append("old\n");
  std::filesystem::rename(directory / "log", directory / "log.1");
  const auto end = std::chrono::steady_clock::now() + 2 * LogFile::lookInterval;
  poll([&] { return std::chrono::steady_clock::now() > end; });

  file.append("new\n");

  EXPECT_EQ(readFile(directory / "log.1"), "old\n");
  EXPECT_EQ(readFile(directory / "log"), "new\n");
}

TEST(LogFileTest, FollowsARotationThatTruncatesIt) {
  const TemporaryDirectory directory;
  LogFile file(directory / "log");
  file.append("old\n");
  std::filesystem::resize_file(directory / "log", 0);
  file.append("new\n");
  EXPECT_EQ(readFile(directory / "log"), "new\n");
}

TEST(LogFileTest, TellsWhyItCannotBeOpenedAndTriesAgainWithTheNextLine) {
  const TemporaryDirectory directory;
  LogFile file(directory / "later/log");
  EXPECT_EQ(file.append("lost\n"), ENOENT);
  std::filesystem::create_directory(directory / "later");
  EXPECT_EQ(file.append("kept\n"), 0);
  EXPECT_EQ(readFile(directory / "later/log"), "kept\n");
}

TEST(LogFileTest, TellsThatTheDiskIsFull) { EXPECT_EQ(LogFile("/dev/full").append("x\n"), ENOSPC); }

TEST(LogFileTest, DoesNotWaitForTheReaderOfAFifo) {
  const TemporaryDirectory directory;
  ASSERT_EQ(::mkfifo((directory / "log").c_str(), 0600), 0);
  EXPECT_EQ(LogFile(directory / "log").append("x\n"), ENXIO);
}

TEST(LogFileTest, IsNotInheritedByPrograms) {
  const TemporaryDirectory directory;
  LogFile file(directory / "log");
  file.append("x\n");
  int open = 0;
  for (const auto& entry : std::filesystem::directory_iterator("/proc/self/fd")) {
    std::error_code ignored;
    if (std::filesystem::read_symlink(entry.path(), ignored) != directory / "log") {
      continue;
    }
    ++open;
    EXPECT_NE(::fcntl(std::stoi(entry.path().filename()), F_GETFD) & FD_CLOEXEC, 0);
  }
  EXPECT_EQ(open, 1);
}

TEST(LogFileTest, KeepsTheLinesOfSeveralThreadsAndWritersWhole) {
  // Given two writers of one file, as two processes have them, with two threads each
  const TemporaryDirectory directory;
  LogFile first(directory / "log");
  LogFile second(directory / "log");
  constexpr int lines = 500;
  const auto write = [&](LogFile& file, char mark) {
    for (int count = 0; count < lines; ++count) {
      file.append(std::string(200, mark) + '\n');
    }
  };

  // When all of them write at once
  {
    std::vector<std::jthread> threads;
    threads.emplace_back([&] { write(first, 'a'); });
    threads.emplace_back([&] { write(first, 'b'); });
    threads.emplace_back([&] { write(second, 'c'); });
    threads.emplace_back([&] { write(second, 'd'); });
  }

  // Then every line is there, and is of one writer
  std::istringstream text(readFile(directory / "log"));
  int count = 0;
  for (std::string line; std::getline(text, line); ++count) {
    ASSERT_EQ(line, std::string(200, line.at(0)));
  }
  EXPECT_EQ(count, 4 * lines);
}

}  // namespace
