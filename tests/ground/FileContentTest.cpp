// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <sys/stat.h>

#include "ground/FileContent.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace Testing;
using Ground::readFile;
using Ground::readSecretFile;
using Ground::requireSecretFile;
using std::filesystem::perms;

class FileContentTest : public testing::Test {
 protected:
  const TemporaryDirectory directory_;
  const std::string file_ = directory_ / "file";
};

TEST_F(FileContentTest, IsAllThatAFileHolds) {
  const std::string text = std::string(10000, 'x') + '\0' + "end\n";
  writePrivateFile(file_, text);
  EXPECT_EQ(readFile(file_), text);
  EXPECT_EQ(readSecretFile(file_), text);
}

TEST_F(FileContentTest, OfASecretIsForItsOwnerAlone) {
  writePrivateFile(file_, "secret");
  for (const auto more : {perms::group_read, perms::others_read, perms::group_write, perms::others_exec}) {
    std::filesystem::permissions(file_, ownerOnly | more);
    const std::string reason = file_ + ": is open to others than its owner: chmod 600 it";
    EXPECT_EQ(thrownBy([&] { readSecretFile(file_); }), reason);
    EXPECT_EQ(thrownBy([&] { requireSecretFile(file_); }), reason);
    EXPECT_EQ(readFile(file_), "secret");
  }
}

TEST_F(FileContentTest, IsNotWaitedFor) {
  ASSERT_EQ(mkfifo(file_.c_str(), 0600), 0);
  EXPECT_EQ(thrownBy([&] { readFile(file_); }), file_ + ": must be a regular file");
}

TEST_F(FileContentTest, ThatCannotBeReadIsNamedWithTheReason) {
  const std::string directory = directory_.path();
  EXPECT_EQ(thrownBy([&] { readFile(directory); }), directory + ": is a directory");
  EXPECT_EQ(thrownBy([&] { readFile(file_); }), file_ + ": cannot be read: No such file or directory");
  EXPECT_EQ(thrownBy([&] { requireSecretFile(file_); }), file_ + ": cannot be read: No such file or directory");
}

TEST_F(FileContentTest, MayBeNothingOnlyWhereSomebodyElseReadsIt) {
  writePrivateFile(file_, "");
  EXPECT_EQ(thrownBy([&] { readFile(file_); }), file_ + ": is empty");
  EXPECT_EQ(thrownBy([&] { readSecretFile(file_); }), file_ + ": is empty");
  EXPECT_NO_THROW(requireSecretFile(file_));
}

}  // namespace
