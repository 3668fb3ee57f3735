// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <grp.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <functional>
#include <set>
#include <vector>

#include "agent/backends/ChangeGeneration.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::StartsWith;

// Runs the statements in a process of its own; whether they ran to their end.
bool inChild(const std::function<void()>& statements) {
  const pid_t child = ::fork();
  if (child == 0) {
    try {
      statements();
      ::_exit(0);
    } catch (const std::exception&) {
      ::_exit(1);
    }
  }
  int status = 0;
  return ::waitpid(child, &status, 0) == child && status == 0;
}

class ChangeGenerationTest : public testing::Test {
 protected:
  mode_t modeOfFile() const { return static_cast<mode_t>(fs::status(file).permissions()); }

  void expectRefusal(const std::string& reason) const {
    EXPECT_THAT(thrownBy([&] { generation.current(); }), AllOf(StartsWith(file + ": "), HasSubstr(reason)));
    EXPECT_THAT(thrownBy([&] { generation.renew(); }), AllOf(StartsWith(file + ": "), HasSubstr(reason)));
  }

  const TemporaryDirectory directory;
  const std::string file = directory / "generation";
  const ChangeGeneration generation{file};
};

TEST_F(ChangeGenerationTest, TouchesNothingBeforeItIsUsed) { EXPECT_TRUE(fs::is_empty(directory.path())); }

TEST_F(ChangeGenerationTest, IsOneForAllUntilItIsRenewed) {
  const auto first = generation.current();

  EXPECT_EQ(generation.current(), first);
  EXPECT_EQ(ChangeGeneration(file).current(), first);

  generation.renew();
  EXPECT_NE(generation.current(), first);
}

TEST_F(ChangeGenerationTest, RenewedByAnotherProcessIsAnother) {
  const auto first = generation.current();

  ASSERT_TRUE(inChild([&] { generation.renew(); }));

  EXPECT_NE(generation.current(), first);
}

TEST_F(ChangeGenerationTest, RenewedByManyProcessesAtOnceIsNotOneThatItWas) {
  constexpr int processes = 8;
  std::set<ChangeGeneration::Number> seen{generation.current()};
  for (int round = 0; round < 50; ++round) {
    std::vector<pid_t> children;
    for (int count = 0; count < processes; ++count) {
      children.push_back(::fork());
      if (children.back() == 0) {
        generation.renew();
        ::_exit(0);
      }
    }
    for (const pid_t child : children) {
      int status = -1;
      ::waitpid(child, &status, 0);
      ASSERT_EQ(status, 0);
    }
    EXPECT_TRUE(seen.insert(generation.current()).second);
  }
}

TEST_F(ChangeGenerationTest, OfARemovedFileIsAnother) {
  const auto first = generation.current();

  fs::remove(file);

  EXPECT_NE(generation.current(), first);
}

TEST_F(ChangeGenerationTest, OfAnEmptiedFileIsAnother) {
  const auto first = generation.current();

  fs::resize_file(file, 0);

  EXPECT_NE(generation.current(), first);
}

TEST_F(ChangeGenerationTest, CanBeRenewedBeforeItWasEverLookedAt) {
  generation.renew();
  EXPECT_EQ(fs::file_size(file), sizeof(ChangeGeneration::Number));
}

TEST_F(ChangeGenerationTest, MakesAMissingDirectory) {
  const ChangeGeneration deep(directory / "a/b/generation");
  EXPECT_EQ(deep.current(), deep.current());
}

TEST_F(ChangeGenerationTest, IsForItsOwnerAndGroupWhateverTheUmask) {
  ASSERT_TRUE(inChild([&] {
    ::umask(0077);
    generation.current();
  }));
  EXPECT_EQ(modeOfFile(), 0660U);
}

TEST_F(ChangeGenerationTest, KeepsTheModeThatAnAdministratorGaveIt) {
  generation.current();
  fs::permissions(file, fs::perms::owner_read | fs::perms::owner_write);

  generation.renew();

  EXPECT_EQ(modeOfFile(), 0600U);
}

TEST_F(ChangeGenerationTest, IsSharedByTheUsersOfTheDirectorysGroup) {
  if (::geteuid() != 0) {
    GTEST_SKIP() << "only root can become two other users";
  }
  // Given a directory that hands its group on
  constexpr gid_t group = 54321;
  ASSERT_EQ(::chown(directory.path().c_str(), 0, group), 0);
  ASSERT_EQ(::chmod(directory.path().c_str(), 02770), 0);
  const auto as = [&](uid_t user, gid_t supplementary, const std::function<void()>& statements) {
    return inChild([&] {
      if (::setgroups(1, &supplementary) != 0 || ::setgid(user) != 0 || ::setuid(user) != 0) {
        throw std::runtime_error("cannot become another user");
      }
      statements();
    });
  };

  // When one of its users makes the file and another renews it
  ASSERT_TRUE(as(54322, group, [&] { generation.current(); }));
  const auto first = generation.current();
  ASSERT_TRUE(as(54323, group, [&] { generation.renew(); }));

  // Then it is another, and who is not of the group is refused
  EXPECT_NE(generation.current(), first);
  EXPECT_FALSE(as(54324, 54324, [&] { generation.current(); }));
}

TEST_F(ChangeGenerationTest, IsNotToldByAFileThatCanOnlyBeRead) {
  generation.current();
  fs::permissions(file, fs::perms::owner_read | fs::perms::group_read | fs::perms::others_read);
  fs::permissions(directory.path(), fs::perms::all);

  const bool used = inChild([&] {
    if (::geteuid() == 0 && ::setuid(54322) != 0) {
      ::_exit(0);
    }
    generation.current();
  });

  EXPECT_FALSE(used) << "who cannot renew it must learn so with the first look";
}

TEST_F(ChangeGenerationTest, RefusesASymbolicLink) {
  const std::string target = directory / "target";
  writeFile(target, "12345678");
  fs::create_symlink(target, file);

  expectRefusal("is a symbolic link");

  EXPECT_EQ(readFile(target), "12345678");
}

TEST_F(ChangeGenerationTest, RefusesAHardLink) {
  const std::string target = directory / "target";
  writeFile(target, "");
  fs::permissions(target, fs::perms::owner_read | fs::perms::owner_write);
  fs::create_hard_link(target, file);

  expectRefusal("a hard link");

  EXPECT_EQ(readFile(target), "");
  EXPECT_EQ(modeOfFile(), 0600U);
}

TEST_F(ChangeGenerationTest, RefusesAFifoWithoutWaitingForItsOtherEnd) {
  ASSERT_EQ(::mkfifo(file.c_str(), 0600), 0);
  expectRefusal("is not a regular file");
}

TEST_F(ChangeGenerationTest, RefusesADevice) {
  EXPECT_THAT(thrownBy([] { ChangeGeneration("/dev/null").current(); }), HasSubstr("/dev/null: is not a regular file"));
}

TEST_F(ChangeGenerationTest, RefusesADirectory) {
  fs::create_directory(file);
  expectRefusal("cannot be opened: Is a directory");
}

TEST_F(ChangeGenerationTest, RefusesAFileOfAnotherSizeAndLeavesIt) {
  for (const std::string content : {"1234567", "123456789", "the root of all evil"}) {
    writeFile(file, content);
    expectRefusal("is not a generation file: it must have 8 bytes");
    EXPECT_EQ(readFile(file), content);
  }
}

TEST_F(ChangeGenerationTest, TellsThatItsDirectoryCannotBeMade) {
  const ChangeGeneration nowhere("/proc/nowhere/generation");
  EXPECT_THAT(thrownBy([&] { nowhere.current(); }), StartsWith("/proc/nowhere: cannot be created: "));

  writeFile(directory / "blocked", "");
  const ChangeGeneration blocked(directory / "blocked/generation");
  EXPECT_THAT(thrownBy([&] { blocked.current(); }), HasSubstr("blocked/generation: cannot be opened: Not a directory"));
}

}  // namespace
