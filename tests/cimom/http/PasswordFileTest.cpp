// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

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
  std::filesystem::path write(const std::string& content) const { return directory_.write("passwords", content); }

  std::string errorOf(const std::string& content) const {
    try {
      PasswordFile passwords(write(content));
    } catch (const ServerError& error) {
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

TEST_F(PasswordFileTest, NamesAMalformedLine) {
  EXPECT_EQ(errorOf("# comment\nadmin\n"), "passwords:2: expected \"user:hash\" with a hash of crypt(5)");
  EXPECT_EQ(errorOf("admin:plain:text\n"), "passwords:1: expected \"user:hash\" with a hash of crypt(5)");
  EXPECT_EQ(errorOf(":" + std::string(hash)), "passwords:1: expected \"user:hash\" with a hash of crypt(5)");
}

TEST_F(PasswordFileTest, RefusesADuplicateUser) {
  const std::string line = "admin:" + std::string(hash) + "\n";
  EXPECT_EQ(errorOf(line + line), "passwords:2: duplicate user \"admin\"");
}

TEST_F(PasswordFileTest, RefusesAFileWithoutUsers) { EXPECT_EQ(errorOf("# none\n"), "passwords: contains no users"); }

TEST_F(PasswordFileTest, NamesAFileThatIsNotThere) {
  EXPECT_THROW(PasswordFile(directory_.path() / "missing"), ServerError);
}

}  // namespace
