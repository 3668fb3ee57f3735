// SPDX-License-Identifier: Apache-2.0
// compositeipconfig-register in a tree of its own: what it refuses, and cimomd. tests/hosts has it register in sfcb and
// OpenPegasus.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

#include "Paths.h"
#include "tests/support/client/WbemClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

namespace fs = std::filesystem;

constexpr const char* cimomdIni = CONFIGURATION_DIR "/cimomd.ini";

class RegisterTest : public testing::Test {
 protected:
  RegisterTest() {
    fs::create_directories(programs());
    fs::create_directories((programs() / CLASSES_FROM_PROGRAM).lexically_normal().parent_path());
    fs::create_directories((programs() / PROVIDERS_FROM_PROGRAM).lexically_normal().parent_path());
    fs::copy_file(built("bin/compositeipconfig-register"), program());
    fs::create_symlink(built("bin/cimomd"), programs() / "cimomd");
    fs::create_directory_symlink(built("share"), programs() / CLASSES_FROM_PROGRAM);
    fs::create_directory_symlink(built("lib"), programs() / PROVIDERS_FROM_PROGRAM);
    tree_.write("agent.ini", "[processor]\nbackend = simulated\n[simulated]\nstate = " + (tree_ / "processor.json"));
  }

  Completed registerWith(std::vector<std::string> arguments) const {
    arguments.insert(arguments.begin(), program());
    return run(arguments);
  }

  static std::string refusal(const Completed& completed) {
    EXPECT_THAT(completed.output, IsEmpty());
    EXPECT_THAT(linesOf(completed.errors), ElementsAre(StartsWith("compositeipconfig-register: "))) << completed.errors;
    return completed.errors;
  }

  fs::path programs() const { return tree_.path() / "moved" / "sbin"; }
  std::string program() const { return programs() / "compositeipconfig-register"; }

  TemporaryDirectory tree_;
};

TEST_F(RegisterTest, ExplainsItself) {
  for (const char* option : {"-h", "--help"}) {
    const Completed help = registerWith({option});
    EXPECT_EQ(help.status, 0);
    EXPECT_THAT(help.output,
                StartsWith("usage: compositeipconfig-register -t sfcb|pegasus|cimomd [-n NAMESPACE] [-d]\n"));
    EXPECT_THAT(help.errors, IsEmpty());
  }
}

TEST_F(RegisterTest, RefusesABadCommandLineWithALine) {
  const std::vector<std::pair<std::vector<std::string>, const char*>> rows = {
      {{}, "-t must be given"},
      {{"-t"}, "-t needs a value"},
      {{"-t", "other"}, "unknown object manager other"},
      {{"-x"}, "unknown option -x"},
      {{"--delete"}, "unknown option --delete"},
      {{"-t", "sfcb", "more"}, "unexpected argument more"},
      {{"-t", "sfcb", "-n", "root cimv2"}, "must be a namespace such as root/cimv2"},
      {{"-t", "sfcb", "-n", "/root"}, "must be a namespace such as root/cimv2"},
      {{"-t", "sfcb", "-n", "root/../etc"}, "must be a namespace such as root/cimv2"},
      {{"-t", "cimomd", "-n", "root/yrnse"}, "root/yrnse is the underlying classes' own"}};
  for (const auto& [arguments, reason] : rows) {
    const Completed completed = registerWith(arguments);
    EXPECT_EQ(completed.status, 2);
    EXPECT_THAT(refusal(completed), HasSubstr(reason));
  }
}

// As root, on a machine of its own.
class RegisterAsRootTest : public RegisterTest {
 protected:
  void SetUp() override {
    const Completed completed = enter("true");
    if (completed.status != 0) {
      GTEST_SKIP() << completed.errors;
    }
  }

  Completed enter(const std::string& script) const {
    const std::string prelude = "rm -rf " CONFIGURATION_DIR "\ncd " + tree_.path().string() + "\nregister() { " +
                                program() + " \"$@\"; }\nini=" + cimomdIni + '\n';
    return run({SOURCE_DIR "/tests/hosts/private-machine", tree_.path().string(), "--", "sh", "-c", prelude + script});
  }
};

TEST_F(RegisterAsRootTest, RefusesEverybodyElse) {
  const Completed completed = enter("unshare --user " + program() + " -t cimomd");
  EXPECT_EQ(completed.status, 1);
  EXPECT_THAT(refusal(completed), EndsWith(": must be run as root\n"));
}

TEST_F(RegisterAsRootTest, RefusesObjectManagersThatAreNotThere) {
  fs::remove(programs() / "cimomd");
  EXPECT_THAT(refusal(enter("PATH=/usr/bin:/bin register -t sfcb")), HasSubstr("sfcbd is not there: install sfcb"));
  EXPECT_THAT(refusal(enter("PATH=/usr/bin:/bin register -t pegasus")), HasSubstr("cimserver is not there: install"));
  EXPECT_THAT(refusal(enter("register -t cimomd")), HasSubstr("cimomd is not there: install cimomd"));
  EXPECT_EQ(enter("register -t cimomd").status, 1);
}

TEST_F(RegisterAsRootTest, RefusesATreeWithoutClassesOrProviders) {
  fs::remove(programs() / PROVIDERS_FROM_PROGRAM);
  EXPECT_THAT(refusal(enter("register -t cimomd")), HasSubstr(": install the "));
  fs::remove(programs() / CLASSES_FROM_PROGRAM);
  EXPECT_THAT(refusal(enter("register -t cimomd")), HasSubstr(": install the "));
}

TEST_F(RegisterAsRootTest, FindsTheProvidersOfTheArchitectureThatIsThere) {
  fs::remove(programs() / PROVIDERS_FROM_PROGRAM);
  const fs::path others = programs().parent_path() / "lib/another-architecture/cmpi";
  fs::create_directories(others.parent_path());
  fs::create_directory_symlink(built("lib"), others);
  EXPECT_THAT(enter("register -t cimomd; cat $ini").output, HasSubstr("provider-dir = " + others.string() + '\n'));
}

TEST_F(RegisterAsRootTest, WritesWhatOthersCanRead) {
  const Completed completed = enter("umask 077; register -t cimomd -n root/other; stat -c %a " CONFIGURATION_DIR
                                    "/*.ini " CONFIGURATION_DIR "/*.reg");
  EXPECT_THAT(completed.output, EndsWith("644\n644\n")) << completed.errors;
}

TEST_F(RegisterAsRootTest, HasCimomdServeTheClassesInANamespaceOfChoice) {
  const Completed completed =
      enter("register -t cimomd -n root/other\nregister -t cimomd\nexport QV_AGENT_INI=" + (tree_ / "agent.ini") +
            "\n" + programs().string() + "/cimomd --config $ini --port 0 > output &\n" +
            "until grep -q listening output; do kill -0 $! || exit 1; sleep 0.05; done\n"
            "wbemcli ein $(sed 's/.* //' output)/root/other:YRNx_MgmtHwIPProtocolEndPoint");
  EXPECT_EQ(completed.status, 0) << completed.errors;
  EXPECT_THAT(completed.output, HasSubstr("/root/other:YRNx_MgmtHwIPProtocolEndPoint.Name=\"eth1\""));
}

TEST_F(RegisterAsRootTest, LeavesCimomdIniAsItWas) {
  const Completed completed =
      enter("mkdir -p " CONFIGURATION_DIR
            "\nprintf 'port = 4711\\n; mine\\n' > $ini; chmod 640 $ini\n"
            "cp -p $ini before; register -t cimomd; cp -p $ini once; register -t cimomd; cmp $ini once\n"
            "grep -c ^registration $ini; stat -c %a $ini\n"
            "register -t cimomd -d; cmp $ini before; register -t cimomd -d; ls -A " CONFIGURATION_DIR);
  EXPECT_EQ(completed.status, 0);
  EXPECT_THAT(completed.errors, IsEmpty());
  const auto lines = linesOf(completed.output);
  EXPECT_THAT(lines, AllOf(Contains("2"), Contains("640"),
                           Contains(HasSubstr("names no registration now: cimomd takes what is installed")),
                           Contains(HasSubstr("not registered in " + std::string(cimomdIni)))));
  EXPECT_EQ(lines.back(), "cimomd.ini");
}

TEST_F(RegisterAsRootTest, LeavesNothingWhereThereWasNothing) {
  const Completed completed = enter("register -t cimomd -n root/other; register -t cimomd -d; ls -A " CONFIGURATION_DIR
                                    " | grep cimomd\\|IPConfig");
  EXPECT_EQ(completed.status, 1) << completed.output;
  EXPECT_THAT(completed.output, HasSubstr("removed " + std::string(cimomdIni)));
}

TEST_F(RegisterAsRootTest, RefusesANamespaceBesideTheOneThatIsRegistered) {
  const Completed completed = enter(
      "register -t cimomd > log; cp $ini before; register -t cimomd -n root/other; "
      "status=$?; cmp $ini before; exit $status");
  EXPECT_EQ(completed.status, 1);
  EXPECT_THAT(refusal(completed), HasSubstr("cimomd has the composite classes in root/cimv2, not in root/other"));
}

TEST_F(RegisterAsRootTest, RefusesWhatIsRegisteredByHand) {
  const std::string classes = fs::path(programs() / CLASSES_FROM_PROGRAM).lexically_normal();
  const Completed completed = enter("mkdir -p " CONFIGURATION_DIR "\nprintf 'port = 0\\nschema = " + classes +
                                    "/cimomd\\n' > $ini; register -t cimomd");
  EXPECT_EQ(completed.status, 1);
  EXPECT_THAT(refusal(completed), HasSubstr(std::string(cimomdIni) + ":2: "));
}

}  // namespace
