// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <set>

#include "agent/backends/simulated/StateFile.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;
using testing::HasSubstr;

void replace(const std::string& path, const std::string& text) {
  StateFile(path).update([&](const auto&) { return text; });
}

mode_t modeOf(const std::string& path) {
  struct stat status {};
  EXPECT_EQ(::stat(path.c_str(), &status), 0);
  return status.st_mode & 07777;
}

std::set<std::string> namesIn(const TemporaryDirectory& directory) {
  std::set<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(directory.path())) {
    names.insert(entry.path().filename());
  }
  return names;
}

TEST(StateFileTest, HasNoTextBeforeItIsWritten) {
  const TemporaryDirectory directory;
  EXPECT_EQ(StateFile(directory / "state").read(), std::nullopt);
}

TEST(StateFileTest, IsReplacedByWhatTheEditMakesOfIt) {
  const TemporaryDirectory directory;
  const StateFile file(directory / "state");
  file.update([](const auto& current) { return current ? "no" : "one"; });
  file.update([](const auto& current) { return *current + " two"; });
  EXPECT_EQ(file.read(), "one two");
}

StateFile::Version versionOf(const StateFile& file) {
  EXPECT_TRUE(poll([&] { return file.version().has_value(); }));
  return file.version().value();
}

TEST(StateFileTest, HasNoVersionBeforeItIsWrittenAndJustAfter) {
  const TemporaryDirectory directory;
  const StateFile file(directory / "state");
  EXPECT_EQ(file.version(), std::nullopt);
  const auto start = std::chrono::steady_clock::now();
  replace(directory / "state", "one");
  versionOf(file);
  EXPECT_GT(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(40));
}

TEST(StateFileTest, KeepsItsVersionWhileItIsTheSame) {
  const TemporaryDirectory directory;
  replace(directory / "state", "one");
  const StateFile file(directory / "state");
  const auto version = versionOf(file);
  file.read();
  EXPECT_EQ(file.version(), version);
}

// Of the same length, and dressed up as of the same time.
TEST(StateFileTest, HasAnotherVersionHoweverItIsChanged) {
  const TemporaryDirectory directory;
  const std::string path = directory / "state";
  replace(path, "one");
  const StateFile file(path);
  const auto first = versionOf(file);
  const auto time = std::filesystem::last_write_time(path);

  writeFile(path, "two");
  std::filesystem::last_write_time(path, time);
  const auto second = versionOf(file);
  EXPECT_NE(second, first);

  replace(path, "six");
  std::filesystem::last_write_time(path, time);
  EXPECT_NE(versionOf(file), second);
}

TEST(StateFileTest, BehindALinkHasTheVersionOfItsTarget) {
  const TemporaryDirectory directory;
  replace(directory / "one", "x");
  replace(directory / "two", "x");
  std::filesystem::create_symlink("one", directory / "link");
  const StateFile file(directory / "link");
  const auto first = versionOf(file);
  std::filesystem::remove(directory / "link");
  std::filesystem::create_symlink("two", directory / "link");
  EXPECT_NE(versionOf(file), first);
}

TEST(StateFileTest, LeavesNothingBehindButItsLock) {
  const TemporaryDirectory directory;
  replace(directory / "state", "x");
  EXPECT_EQ(namesIn(directory), (std::set<std::string>{"state", "state.lock"}));
}

TEST(StateFileTest, MakesItsDirectory) {
  const TemporaryDirectory directory;
  replace(directory / "a/b/state", "x");
  EXPECT_EQ(readFile(directory / "a/b/state"), "x");
}

TEST(StateFileTest, StaysAsItIsWhereTheEditThrows) {
  const TemporaryDirectory directory;
  replace(directory / "state", "old");
  EXPECT_EQ(thrownBy([&] {
              StateFile(directory / "state").update([](const auto&) -> std::string { throw std::runtime_error("no"); });
            }),
            "no");
  EXPECT_EQ(readFile(directory / "state"), "old");
}

TEST(StateFileTest, IsNotReplacedByWhatItHolds) {
  const TemporaryDirectory directory;
  replace(directory / "state", "same");
  // Under another name as well, the file stays the same one for as long as nobody replaces it.
  std::filesystem::create_hard_link(directory / "state", directory / "witness");
  replace(directory / "state", "same");
  EXPECT_TRUE(std::filesystem::equivalent(directory / "state", directory / "witness"));
  replace(directory / "state", "another");
  EXPECT_FALSE(std::filesystem::equivalent(directory / "state", directory / "witness"));
}

TEST(StateFileTest, SweepsAwayWhatAKilledWriterLeft) {
  const TemporaryDirectory directory;
  writeFile(directory / "state", "old");
  writeFile(directory / "state.new", "ha");
  EXPECT_EQ(StateFile(directory / "state").read(), "old");
  replace(directory / "state", "new");
  EXPECT_EQ(readFile(directory / "state"), "new");
  EXPECT_EQ(namesIn(directory), (std::set<std::string>{"state", "state.lock"}));
}

TEST(StateFileTest, DoesNotWriteThroughALinkPlantedUnderItsTemporaryName) {
  const TemporaryDirectory directory;
  writeFile(directory / "victim", "mine");
  std::filesystem::create_symlink(directory / "victim", directory / "state.new");
  replace(directory / "state", "new");
  EXPECT_EQ(readFile(directory / "victim"), "mine");
  EXPECT_EQ(readFile(directory / "state"), "new");
}

TEST(StateFileTest, IsMadeForItsOwnerAndGroup) {
  const TemporaryDirectory directory;
  replace(directory / "state", "x");
  EXPECT_EQ(modeOf(directory / "state") & 0137, 0U);
}

TEST(StateFileTest, KeepsItsMode) {
  const TemporaryDirectory directory;
  writeFile(directory / "state", "old");
  ASSERT_EQ(::chmod((directory / "state").c_str(), 0604), 0);
  replace(directory / "state", "new");
  EXPECT_EQ(modeOf(directory / "state"), 0604U);
}

TEST(StateFileTest, KeepsItsOwner) {
  if (::geteuid() != 0) {
    GTEST_SKIP() << "only root can give files away";
  }
  const TemporaryDirectory directory;
  writeFile(directory / "state", "old");
  ASSERT_EQ(::chown((directory / "state").c_str(), 1234, 4321), 0);
  replace(directory / "state", "new");
  struct stat status {};
  ASSERT_EQ(::stat((directory / "state").c_str(), &status), 0);
  EXPECT_EQ(status.st_uid, 1234U);
  EXPECT_EQ(status.st_gid, 4321U);
}

TEST(StateFileTest, IsReplacedByAWriterWhoCannotGiveFilesAway) {
  if (::geteuid() != 0) {
    GTEST_SKIP() << "only root can become another user";
  }
  // Given a file of one user, in a directory in which another may write
  const TemporaryDirectory directory;
  writeFile(directory / "state", "old");
  ASSERT_EQ(::chmod((directory / "state").c_str(), 0664), 0);
  ASSERT_EQ(::chmod(directory.path().c_str(), 0777), 0);

  // When the other changes it
  const auto change = [&] {
    if (::setgid(4321) != 0 || ::setuid(1234) != 0) {
      std::exit(2);
    }
    try {
      replace(directory / "state", "new");
    } catch (const std::exception& error) {
      std::fputs(error.what(), stderr);
      std::exit(1);
    }
    std::exit(0);
  };
  EXPECT_EXIT(change(), testing::ExitedWithCode(0), "");

  // Then the new text counts more than the old owner
  EXPECT_EQ(readFile(directory / "state"), "new");
  EXPECT_EQ(modeOf(directory / "state"), 0664U);
}

TEST(StateFileTest, BehindALinkIsReplacedAndTheLinkStays) {
  const TemporaryDirectory directory;
  std::filesystem::create_directory(directory / "real");
  writeFile(directory / "real/state", "old");
  std::filesystem::create_symlink("real/state", directory / "hop");
  std::filesystem::create_symlink(directory / "hop", directory / "link");
  replace(directory / "link", "new");
  EXPECT_TRUE(std::filesystem::is_symlink(directory / "link"));
  EXPECT_TRUE(std::filesystem::is_symlink(directory / "hop"));
  EXPECT_EQ(readFile(directory / "real/state"), "new");
  EXPECT_EQ(StateFile(directory / "link").read(), "new");
}

TEST(StateFileTest, BehindALinkToNothingIsMadeThere) {
  const TemporaryDirectory directory;
  std::filesystem::create_symlink("later/state", directory / "link");
  EXPECT_EQ(StateFile(directory / "link").read(), std::nullopt);
  replace(directory / "link", "new");
  EXPECT_EQ(readFile(directory / "later/state"), "new");
}

TEST(StateFileTest, BehindACircleOfLinksIsAnError) {
  const TemporaryDirectory directory;
  std::filesystem::create_symlink("b", directory / "a");
  std::filesystem::create_symlink("a", directory / "b");
  EXPECT_THAT(thrownBy([&] { StateFile(directory / "a").read(); }), HasSubstr("symbolic links"));
}

TEST(StateFileTest, ThatIsADirectoryIsAnError) {
  const TemporaryDirectory directory;
  std::filesystem::create_directory(directory / "state");
  EXPECT_THAT(thrownBy([&] { StateFile(directory / "state").read(); }), HasSubstr("state: cannot be read"));
}

TEST(StateFileTest, WhoseDirectoryCannotBeMadeIsAnError) {
  const TemporaryDirectory directory;
  writeFile(directory / "file", "x");
  EXPECT_THAT(thrownBy([&] { replace(directory / "file/state", "x"); }), HasSubstr("file: cannot be created"));
}

}  // namespace
