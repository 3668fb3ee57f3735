// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Paths.h"
#include "cimom/interop/Profiles.h"
#include "cimom/model/Errors.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace Testing;
using namespace Cimom;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr const char* complete = "version = 1.0\ndescription = What it is.\ncentral-class = TEST_Thing\n";

class ProfilesTest : public testing::Test {
 protected:
  std::vector<Profile> read(const std::string& text) const {
    return readProfiles(directory_.write("test.profiles", text));
  }

  // What is said of a text, without the file's name.
  std::string refusalOf(const std::string& text) const {
    try {
      read(text);
      return "accepted";
    } catch (const ConfigurationError& error) {
      const std::string file = (directory_.path() / "test.profiles").string();
      const std::string what = error.what();
      return what.starts_with(file) ? what.substr(file.size()) : what;
    }
  }

  TemporaryDirectory directory_;
};

TEST_F(ProfilesTest, ReadsASectionForEachProfile) {
  const auto profiles = read(std::string("[One]\n") + complete + "references = Two\n[Two]\n" + complete);
  ASSERT_THAT(profiles, SizeIs(2));
  EXPECT_EQ(profiles[0].name, "One");
  EXPECT_EQ(profiles[0].version, "1.0");
  EXPECT_EQ(profiles[0].description, "What it is.");
  EXPECT_EQ(profiles[0].centralClass, "TEST_Thing");
  EXPECT_THAT(profiles[0].references, ElementsAre("Two"));
  EXPECT_THAT(profiles[1].references, IsEmpty());
}

TEST_F(ProfilesTest, ReadsEveryFileOfADirectory) {
  directory_.write("b.profiles", std::string("[Two]\n") + complete);
  directory_.write("a.profiles", std::string("[One]\n") + complete + "references = Two\n");
  directory_.write("other", "no profiles");
  EXPECT_THAT(readProfiles(directory_.path()), SizeIs(2));
}

TEST_F(ProfilesTest, HasNoneWhereNoFileIs) { EXPECT_THAT(readProfiles(directory_.path()), IsEmpty()); }

TEST_F(ProfilesTest, SaysWhereAndWhatIsWrong) {
  EXPECT_EQ(refusalOf("version = 1\n"), ":1: key version stands before the first [profile]");
  EXPECT_EQ(refusalOf("[One]\nversoin = 1\n"),
            ":2: unknown key versoin: must be version, description, central-class or references");
  EXPECT_EQ(refusalOf("[One]\nversion = 1\nversion = 2\n"), ":3: duplicate key version");
  EXPECT_EQ(refusalOf(std::string("[One]\n") + complete + "[Two]\n" + complete + "[One]\nversion = 2\n"),
            ":10: duplicate profile [One]");
  EXPECT_EQ(refusalOf("[One]\nversion = 1\ndescription = x\n"), ": profile [One] has no key central-class");
  EXPECT_EQ(refusalOf(std::string("[One]\n") + complete + "references = Three\n"),
            ": profile [One] references the unknown profile [Three]");
}

TEST_F(ProfilesTest, NamesAFileThatIsNotThere) {
  EXPECT_THROW(readProfiles(directory_.path() / "none.profiles"), ConfigurationError);
}

TEST_F(ProfilesTest, TheProductsOwnAreWellFormed) {
  EXPECT_THAT(readProfiles(SOURCE_DIR "/schema/CompositeIPConfig.profiles"), SizeIs(4));
}

}  // namespace
