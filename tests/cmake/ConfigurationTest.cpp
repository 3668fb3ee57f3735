// SPDX-License-Identifier: Apache-2.0
// What the options of the build leave out, and what they refuse: each case configures the project anew and asks Ninja
// for the commands that a build would run, without running them.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "Paths.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace fs = std::filesystem;

class ConfigurationTest : public testing::Test {
 protected:
  // The outcome of a configuration without tests, under the options given; the output holds all that was said.
  Completed configure(const std::vector<std::string>& options) const {
    std::vector<std::string> command = {"cmake", "-S", SOURCE_DIR, "-B", build(), "-G", "Ninja", "-DBUILD_TESTING=OFF"};
    command.insert(command.end(), options.begin(), options.end());
    return runPatiently(command);
  }

  // A line for each.
  std::string commands() const { return runPatiently({"ninja", "-C", build(), "-t", "commands", "all"}).output; }

  // An installed agent: its headers and its libraries.
  std::string agent() const {
    fs::create_directories(directory_.path() / "agent");
    fs::create_directory_symlink(SOURCE_DIR "/agent/include", directory_.path() / "agent/include");
    fs::create_directory_symlink(built("lib"), directory_.path() / "agent/lib");
    return directory_ / "agent";
  }

  std::string build() const { return directory_ / "build"; }

  // That they make the library, and nothing of the object manager.
  static void expectNothingOfCimomd(const std::string& commands) {
    EXPECT_THAT(commands, AllOf(HasSubstr("-o lib/libcompositeipconfigprovider.so"),
                                Not(ContainsRegex("-o [^ ]*cimom|share/cimomd"))));
  }

 private:
  static Completed runPatiently(const std::vector<std::string>& command) {
    Process process(command);
    const int status = process.wait(std::chrono::seconds(100));
    return {status, process.output(), process.errors()};
  }

  const TemporaryDirectory directory_;
};

TEST_F(ConfigurationTest, BuildsCimomdWhereNothingElseIsSaid) {
  const Completed configured = configure({});
  ASSERT_EQ(configured.status, 0) << configured.errors;
  EXPECT_THAT(commands(), AllOf(HasSubstr("-o bin/cimomd"), HasSubstr("-o lib/libqvinstrumentation.so"),
                                HasSubstr("-o lib/libcompositeipconfigprovider.so")));
}

TEST_F(ConfigurationTest, BuildsNothingOfCimomdWhereItIsSwitchedOff) {
  const Completed configured = configure({"-DBUILD_CIMOMD=OFF"});
  ASSERT_EQ(configured.status, 0) << configured.errors;
  expectNothingOfCimomd(commands());
  EXPECT_THAT(commands(), HasSubstr("-o lib/libqvinstrumentation.so"));
}

TEST_F(ConfigurationTest, BuildsTheLibraryAloneAgainstAnotherAgent) {
  const Completed configured = configure({"-DBUILD_CIMOMD=OFF", "-DAGENT_ROOT=" + agent()});
  ASSERT_EQ(configured.status, 0) << configured.errors;
  expectNothingOfCimomd(commands());
  EXPECT_THAT(commands(), AllOf(Not(HasSubstr("-o ground/")), Not(HasSubstr("-o agent/"))));
}

TEST_F(ConfigurationTest, HasOnePlaceForTheConfigurationFilesWhateverThePrefix) {
  const Completed configured = configure({"-DBUILD_CIMOMD=OFF", "-DCMAKE_INSTALL_PREFIX=/opt/elsewhere"});
  ASSERT_EQ(configured.status, 0) << configured.errors;
  EXPECT_THAT(contentOf(fs::path(build()) / "build.ninja"),
              ContainsRegex("DEFINES = [^\n]*-DCONFIGURATION_DIR=[^ ]*/etc/compositeipconfig[^/]"));
}

TEST_F(ConfigurationTest, RefusesAConfigurationDirectoryThatIsNotAbsolute) {
  const Completed configured = configure({"-DCONFIGURATION_DIR=etc"});
  EXPECT_NE(configured.status, 0);
  EXPECT_THAT(configured.errors, HasSubstr("CONFIGURATION_DIR is etc: must be an absolute path"));
}

TEST_F(ConfigurationTest, RefusesADirectoryWithoutCmpiHeaders) {
  const Completed configured = configure({"-DCMPI_INCLUDE_DIR=" + build()});
  EXPECT_NE(configured.status, 0);
  EXPECT_THAT(configured.errors, HasSubstr("has no cmpidt.h: name the directory"));
}

}  // namespace
