// SPDX-License-Identifier: Apache-2.0
// hosts_test and private-machine themselves, without an object manager.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

#include "Paths.h"
#include "tests/hosts/Guide.h"
#include "tests/hosts/HostProcesses.h"
#include "tests/support/client/WbemClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

const std::string program = built("bin/hosts_test");
constexpr const char* privateMachine = SOURCE_DIR "/tests/hosts/private-machine";

TEST(HostsProgramTest, IsSkippedWithALineWhereNoObjectManagerIsGiven) {
  for (const auto& [name, variable] : {std::pair{"sfcb", "HOSTS_SFCB"}, std::pair{"openpegasus", "HOSTS_PEGASUS"}}) {
    const Completed completed = run({"env", "-u", variable, program, name});
    EXPECT_EQ(completed.status, 77);
    EXPECT_THAT(linesOf(completed.output + completed.errors),
                ElementsAre(AllOf(StartsWith("hosts_test: skipped: "), HasSubstr(variable))));
  }
}

TEST(HostsProgramTest, SaysInALineWhatAnInstallationLacks) {
  const TemporaryDirectory empty;
  const Completed completed = run({program, "sfcb"}, {{"HOSTS_SFCB", empty.path().string()}});
  EXPECT_EQ(completed.status, 1);
  EXPECT_THAT(linesOf(completed.output + completed.errors),
              ElementsAre(AllOf(StartsWith("hosts_test: HOSTS_SFCB: "), HasSubstr("sbin/sfcbd"), HasSubstr("prefix"))));
}

TEST(HostsProgramTest, RefusesAnObjectManagerThatItDoesNotKnow) {
  const Completed completed = run({program, "other"});
  EXPECT_EQ(completed.status, 1);
  EXPECT_THAT(completed.errors, HasSubstr("sfcb or openpegasus"));
  EXPECT_EQ(run({program}).status, 1);
}

class PrivateMachineTest : public testing::Test {
 protected:
  void SetUp() override {
    const Completed completed = enter("true");
    if (completed.status != 0) {
      GTEST_SKIP() << completed.errors;
    }
  }

  Completed enter(const std::string& script) const {
    return run({privateMachine, directory_.path().string(), "--", "sh", "-c", script});
  }

  TemporaryDirectory directory_;
};

TEST_F(PrivateMachineTest, KeepsToItselfWhatIsWrittenThere) {
  const std::string file = directory_.write("file", "before").string();
  const Completed completed = enter("echo after > " + file + "; cat " + file + "; echo > /etc/of-private-machine");
  EXPECT_EQ(completed.output, "after\n") << completed.errors;
  EXPECT_EQ(readFile(file), "before");
  EXPECT_FALSE(std::filesystem::exists("/etc/of-private-machine"));
}

TEST_F(PrivateMachineTest, EndsWithAllItsProcesses) {
  const std::string sleeper = (directory_.path() / "sleeper").string();
  std::filesystem::copy_file("/bin/sleep", sleeper);
  EXPECT_EQ(enter(sleeper + " 60 & echo started").output, "started\n");
  EXPECT_TRUE(poll([&] { return processesRunning({sleeper}).empty(); }));
}

TEST_F(PrivateMachineTest, EndsAsItsCommandEnds) {
  EXPECT_EQ(enter("exit 3").status, 3);
  EXPECT_EQ(enter("kill -9 $$").status, 137);
}

TEST(HostsGuideTest, GivesTheCommandsOfAStep) {
  EXPECT_THAT(Guide().commands("install"), StartsWith("cmake --install build/default\n"));
  EXPECT_THROW(Guide().commands("no such step"), std::runtime_error);
}

TEST(HostsGuideTest, ExplainsTheMessagesOfItsTables) {
  EXPECT_TRUE(Guide().explains("* wbemcli: Cim: (3) CIM_ERR_INVALID_NAMESPACE: root/yrnse"));
  EXPECT_FALSE(Guide().explains("all is well"));
}

}  // namespace
