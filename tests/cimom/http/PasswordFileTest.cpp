// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <time.h>

#include <utility>

#include "cimom/http/Listener.h"
#include "cimom/http/PasswordFile.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Cimom::Http;
using namespace Testing;

// Of "secret".
constexpr const char* hash = "$5$saltsalt$0IyaXrmV7.sGNS6tirgqHLqX/G.FBvgkYA.lpPdS5sA";

class PasswordFileTest : public testing::Test {
 protected:
  std::filesystem::path write(const std::string& content) const {
    const auto file = directory_.write("passwords", content);
    std::filesystem::permissions(file, ownerOnly);
    return file;
  }

  std::string errorOf(const std::string& content) const {
    try {
      PasswordFile passwords(write(content));
    } catch (const std::runtime_error& error) {
      return std::string(error.what()).substr(directory_.path().string().size() + 1);
    }
    return "none";
  }

  TemporaryDirectory directory_;
};

TEST_F(PasswordFileTest, AcceptsAUsersPasswordOnly) {
  const PasswordFile passwords(write("# operators\n\nadmin:" + std::string(hash) + "\n"));
  EXPECT_TRUE(passwords.accepts("admin", "secret"));
  EXPECT_FALSE(passwords.accepts("admin", "wrong"));
  EXPECT_FALSE(passwords.accepts("admin", ""));
  EXPECT_FALSE(passwords.accepts("nobody", "secret"));
  EXPECT_FALSE(passwords.accepts("", ""));
}

TEST_F(PasswordFileTest, TakesEveryMethodThatIsNotGuessedQuickly) {
  for (const char* line :
       {"$6$saltsalt$TVLlQcbpFVof5W3Yz4DTP6gRstiNuHwwTt6GLc1E5n0U0aDehy0S5knV8wiOQSpT0Y77vwPZN.Pq.H91p5hVO1",
        "$y$j9T$saltsaltsaltsalt$.Zt5W26jjocuW0wIHGgB6AJelofw6GEpOypHGyow2y5",
        "$gy$j9T$saltsaltsaltsalt$BBJRbPW2s14hnQwjOB5zpgb2NVqa6Gfb4kgKtS5Oda9",
        "$7$CU..../....saltsalt$NUwJnl2EzU4ACwYC9BDHKGDt.PCVFKyF6Hlr/CUA09D",
        "$2b$05$abcdefghijklmnopqrstuuOQiyCxlgf/oeuTqixKmWdcYUh4Hjl0a"}) {
    const PasswordFile passwords(write("admin:" + std::string(line) + "\noperator:" + hash + "\n"));
    EXPECT_TRUE(passwords.accepts("admin", "secret")) << line;
    EXPECT_FALSE(passwords.accepts("admin", "wrong")) << line;
    EXPECT_TRUE(passwords.accepts("operator", "secret")) << line;
    EXPECT_FALSE(passwords.accepts("nobody", "secret")) << line;
  }
}

TEST_F(PasswordFileTest, NamesAMalformedLine) {
  EXPECT_EQ(errorOf("# comment\nadmin\n"), "passwords:2: expected \"user:hash\" with a hash of crypt(5)");
  EXPECT_EQ(errorOf(":" + std::string(hash)), "passwords:1: expected \"user:hash\" with a hash of crypt(5)");
}

TEST_F(PasswordFileTest, RefusesWhatIsGuessedQuickly) {
  const std::string reason =
      "passwords:1: the password must be a hash of crypt(5) that is no longer guessed quickly, as openssl passwd -6 "
      "makes "
      "it; plain text, DES and $1$ are refused";
  for (const char* password :
       {"", "secret", "plain:text", "ab9eXamPleOfDe", "abWBY0TYnHxKI", "$1$saltsalt$qjXMvbEw8oaL.CzflDtaK/",
        "$3$$0f1e2d3c4b5a69788796a5b4c3d2e1f0", "*", "!"}) {
    EXPECT_EQ(errorOf("admin:" + std::string(password) + "\n"), reason) << password;
  }
}

TEST_F(PasswordFileTest, RefusesAHashThatIsCutOff) {
  EXPECT_EQ(errorOf("admin:" + std::string(hash, 40) + "\n"), "passwords:1: the hash is incomplete");
  EXPECT_EQ(errorOf("admin:$6$saltsalt$\n"), "passwords:1: the hash is incomplete");
}

TEST_F(PasswordFileTest, RefusesAFileThatOthersMayRead) {
  const auto file = write("admin:" + std::string(hash) + "\n");
  for (const auto more :
       {std::filesystem::perms::group_read, std::filesystem::perms::others_read, std::filesystem::perms::group_write}) {
    std::filesystem::permissions(file, ownerOnly | more);
    try {
      PasswordFile passwords(file);
      ADD_FAILURE() << "others may read it";
    } catch (const std::runtime_error& error) {
      EXPECT_EQ(std::string(error.what()), file.string() + ": is open to others than its owner: chmod 600 it");
    }
  }
}

// What a check costs must not say whether the user is there: as many computations for every user, of whatever costs the
// file mixes. The cheap hash takes a thousand rounds, the dear one four hundred thousand.
TEST_F(PasswordFileTest, TakesAsLongForEveryUser) {
  const PasswordFile passwords(
      write("cheap:$5$rounds=1000$saltsalt$eKLZU9t9OoPWrqOQsoTIKG0aYkZ5rGOoOQhiIvoSWX2\n"
            "dear:$5$rounds=400000$saltsalt$LgsCST3AaEJxNUDgK.21SdeTm/cI4NftmgMNCa620m/\n"));
  const auto cost = [&](const char* user) {
    timespec before{};
    timespec after{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &before);
    EXPECT_FALSE(passwords.accepts(user, "wrong"));
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &after);
    return static_cast<double>(after.tv_sec - before.tv_sec) +
           static_cast<double>(after.tv_nsec - before.tv_nsec) / 1e9;
  };
  const double dear = cost("dear");
  EXPECT_GT(cost("cheap"), dear / 2);
  EXPECT_GT(cost("nobody"), dear / 2);
  EXPECT_LT(cost("nobody"), dear * 2);
}

TEST_F(PasswordFileTest, RefusesADuplicateUser) {
  const std::string line = "admin:" + std::string(hash) + "\n";
  EXPECT_EQ(errorOf(line + line), "passwords:2: duplicate user \"admin\"");
}

TEST_F(PasswordFileTest, RefusesAFileWithoutUsers) { EXPECT_EQ(errorOf("# none\n"), "passwords: contains no users"); }

TEST_F(PasswordFileTest, NamesAFileThatIsNotThere) {
  EXPECT_THROW(PasswordFile(directory_.path() / "missing"), std::runtime_error);
}

TEST_F(PasswordFileTest, RefusesWhatIsNoFileWithoutWaitingForIt) {
  const auto fifo = directory_.path() / "fifo";
  ASSERT_EQ(mkfifo(fifo.c_str(), 0600), 0);
  for (const auto& [file, reason] :
       {std::pair(directory_.path(), "is a directory"), {fifo, "must be a regular file"}, {write(""), "is empty"}}) {
    try {
      PasswordFile passwords(file);
      ADD_FAILURE() << reason;
    } catch (const std::runtime_error& error) {
      EXPECT_EQ(error.what(), file.string() + ": " + reason);
    }
  }
}

}  // namespace
