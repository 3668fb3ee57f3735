// SPDX-License-Identifier: Apache-2.0
// The demonstration that newcomers see first.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>

#include "Paths.h"
#include "tests/e2e/DemonstrationFixture.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

namespace fs = std::filesystem;

TEST_F(DemonstrationTest, ShowsTheSystemAChangeAndTheModel) {
  const Completed completed = demonstrate({});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const std::string& shown = completed.output;
  EXPECT_THAT(shown, ContainsRegex("BMC +management, management controller +Simulated management processor\n"));
  EXPECT_THAT(shown, HasSubstr("It is simulated: its values are made up"));
  EXPECT_THAT(shown,
              HasSubstr("before  192.0.2.10  255.255.255.0    static\nnow     192.0.2.77  255.255.255.128  static\n"
                        "applied: "));
  EXPECT_THAT(shown, HasSubstr("wanted  192.0.2.78  255.255.255.128  static\nnow     192.0.2.77  "));
  EXPECT_THAT(completed.errors, HasSubstr("bmcip: not applied: "));
  EXPECT_THAT(shown, HasSubstr("The agent's log:\n  the lock "));
  EXPECT_THAT(shown, HasSubstr("  or wbemcli ei -nl http://"));
  EXPECT_THAT(shown,
              ContainsRegex("\nBMC\n.* IPHostedAccessPoint\n.* eth0\n.* ClientAccess: Gateway:eth0, DNS:1, DNS:2\n"));
  if (run({"sh", "-c", "command -v dot"}).status == 0) {
    EXPECT_THAT(contentOf(build() / "model.svg"), HasSubstr("<svg "));
  }
  expectNothingLeft();
}

TEST_F(DemonstrationTest, LeavesNothingBehindWhereItFails) {
  fs::remove(build() / "share");
  const Completed completed = demonstrate({});
  EXPECT_NE(completed.status, 0);
  EXPECT_THAT(completed.errors, HasSubstr("share/cimomd"));
  expectNothingLeft();
}

TEST_F(DemonstrationTest, RefusesWhatItDoesNotKnow) {
  EXPECT_EQ(run({SOURCE_DIR "/tools/demonstrate", "--bcm"}).status, 2);
  EXPECT_EQ(run({SOURCE_DIR "/tools/demonstrate", "/nowhere"}).status, 2);
  const Completed help = run({SOURCE_DIR "/tools/demonstrate", "--help"});
  EXPECT_EQ(help.status, 0);
  EXPECT_THAT(help.output, StartsWith("usage: demonstrate [--bmc] [BUILD_DIR]\n"));
}

TEST_F(DemonstrationTest, IsColouredOnATerminalThatWantsIt) {
  std::string words;
  for (const std::string& word : command({})) {
    words += "'" + word + "' ";
  }
  Environment terminal = environment();
  terminal["TERM"] = "xterm";
  terminal["NO_COLOR"] = "";
  const std::string bold = "\033[1m";
  EXPECT_THAT(run({"script", "-qec", words, "/dev/null"}, terminal).output, HasSubstr(bold));
  terminal["NO_COLOR"] = "1";
  EXPECT_THAT(run({"script", "-qec", words, "/dev/null"}, terminal).output,
              AllOf(HasSubstr("What now"), Not(HasSubstr("\033"))));
  EXPECT_THAT(demonstrate({}).output, AllOf(HasSubstr("What now"), Not(HasSubstr("\033"))));
}

TEST_F(DemonstrationTest, EndsWithCommandsThatWork) {
  const Completed completed = demonstrate({});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const auto begin = completed.output.find("QV_AGENT_INI=");
  const auto end = completed.output.find("/bin/bmcip show\n", begin);
  ASSERT_NE(end, std::string::npos);
  std::string server = completed.output.substr(begin, completed.output.rfind('\n', end) - begin);
  Process cimomd({"bash", "-c", server + " --port 0"});
  EXPECT_TRUE(poll([&] { return cimomd.output().starts_with("listening on "); })) << cimomd.errors();
  cimomd.signal(SIGTERM);
  EXPECT_EQ(cimomd.wait(), 0);
}

TEST_F(DemonstrationTest, LeavesNoProcessBehindWhereItIsKilled) {
  Process process(command({}), environment());
  ASSERT_TRUE(poll([&] { return process.output().find("IP interfaces\n") != std::string::npos; }));
  process.signal(SIGKILL);
  process.wait();
  expectNoProcessLeft();
}

TEST(FirstCommandsTest, ExplainThemselvesAndRefuseWhatTheyDoNotKnow) {
  for (const std::string name : {"quickstart", "check"}) {
    const std::string program = SOURCE_DIR "/" + name;
    for (const char* option : {"-h", "--help"}) {
      const Completed help = run({program, option});
      EXPECT_EQ(help.status, 0);
      EXPECT_THAT(help.output, StartsWith("usage: ./" + name));
      EXPECT_THAT(help.errors, IsEmpty());
    }
    for (const char* last : {"--bcm", "build"}) {
      const Completed refused = run({program, last});
      EXPECT_EQ(refused.status, 2);
      EXPECT_THAT(refused.errors, AllOf(HasSubstr(last), HasSubstr("usage: ./" + name)));
      EXPECT_THAT(refused.output, IsEmpty());
    }
  }
}

}  // namespace
