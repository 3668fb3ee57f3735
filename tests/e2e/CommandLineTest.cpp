// SPDX-License-Identifier: Apache-2.0
// cimomd's command line and configuration file: what it takes, and what it says of what it does not take.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Paths.h"
#include "tests/support/client/Cimomd.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

class CommandLineTest : public testing::Test {
 protected:
  static Completed cimomd(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), built("bin/cimomd"));
    return run(arguments);
  }

  // With all that it takes to serve, so that what follows is refused for what it is.
  static void expectFailure(const std::vector<std::string>& options, const std::string& mentioned) {
    std::vector<std::string> arguments = Cimomd::probeOptions();
    arguments.insert(arguments.end(), {"--config", "/dev/null", "--port", "0"});
    arguments.insert(arguments.end(), options.begin(), options.end());
    expectRefused(arguments, 1, mentioned);
  }

  static void expectRefused(const std::vector<std::string>& arguments, int status, const std::string& mentioned) {
    const Completed completed = cimomd(arguments);
    EXPECT_EQ(completed.status, status) << completed.errors;
    EXPECT_EQ(completed.output, "");
    EXPECT_THAT(completed.errors, AllOf(StartsWith("cimomd: "), HasSubstr(mentioned), EndsWith("\n")));
  }

  std::string file(const std::string& content) const { return directory_.write("cimomd.ini", content).string(); }

  TemporaryDirectory directory_;
};

TEST_F(CommandLineTest, ShowsHelpWithEveryOption) {
  const Completed completed = cimomd({"--help"});
  EXPECT_EQ(completed.status, 0);
  for (const char* option : {"--config",
                             "--address",
                             "--port",
                             "--schema",
                             "--registration",
                             "--provider-dir",
                             "--max-request-size",
                             "--max-request-memory",
                             "--max-requests",
                             "--max-connections",
                             "--max-connections-per-address",
                             "--idle-timeout",
                             "--request-timeout",
                             "--operation-timeout",
                             "--shutdown-timeout",
                             "--server-name",
                             "--tls-certificate",
                             "--tls-key",
                             "--password-file",
                             "--request-log",
                             "--trace",
                             "--user",
                             "--version"}) {
    EXPECT_THAT(completed.output, HasSubstr(option));
  }
}

TEST_F(CommandLineTest, ShowsTheVersion) { EXPECT_THAT(cimomd({"--version"}).output, StartsWith("cimomd ")); }

TEST_F(CommandLineTest, IsRefusedWithStatusTwo) {
  expectRefused({"--nonsense"}, 2, "--nonsense");
  expectRefused({"--port"}, 2, "--port");
  expectRefused({"--port", "65536"}, 2, "--port: must be a number from 0 to 65535, not \"65536\"");
  expectRefused({"--port", "http"}, 2, "--port: must be a number from 0 to 65535, not \"http\"");
  expectRefused({"--port", ""}, 2, "--port");
  expectRefused({"--port", "1", "--port", "2"}, 2, "--port: duplicate");
  expectRefused({"--max-request-size", "1"}, 2, "--max-request-size: must be a number from 1024");
  expectRefused({"--idle-timeout", "-1"}, 2, "--idle-timeout");
  expectRefused({"--tls-key", "key.pem"}, 2, "tls-certificate and tls-key must be given together");
  expectRefused({"stray"}, 2, "stray");
  expectRefused({"--config", "/nowhere/cimomd.ini"}, 2, "/nowhere/cimomd.ini: No such file or directory");
}

TEST_F(CommandLineTest, IsRefusedForWhatTheFileSays) {
  expectRefused({"--config", file("port = 0\nnonsense = 1\n")}, 2, "cimomd.ini:2: unknown key \"nonsense\"");
  expectRefused({"--config", file("; comment\n\nport = high\n")}, 2, "cimomd.ini:3: port: must be a number");
  expectRefused({"--config", file("port = 0\nport = 0\n")}, 2, "cimomd.ini:2: port: duplicate");
  expectRefused({"--config", file("[http]\nport = 0\n")}, 2,
                "cimomd.ini:2: there are no sections in this file, but \"port\" is in [http]");
  expectRefused({"--config", file("port\n")}, 2, "cimomd.ini:1: must be a [section] or a key = value");
  expectRefused({"--config", file("# " + std::string(5000, 'x') + "\n")}, 2, "cimomd.ini:1: the line is longer");
  expectRefused({"--config", directory_.path().string()}, 2, "is a directory");
}

TEST_F(CommandLineTest, FailsWithStatusOneForWhatItIsGiven) {
  expectFailure({"--schema", "/nowhere.mof"}, "/nowhere.mof");
  expectFailure({"--schema", directory_.write("bad.mof", "class {").string()}, "bad.mof:1");
  expectFailure({"--registration", "/nowhere.reg"}, "/nowhere.reg");
  expectFailure({"--registration", directory_.path().string()}, "contains no *.reg file");
  expectFailure({"--address", "localhost"}, "localhost");
  expectFailure({"--address", "192.0.2.1"}, "192.0.2.1");
  expectFailure({"--password-file", "/nowhere"}, "/nowhere");
  expectFailure({"--request-log", "/nowhere/requests"}, "request-log: /nowhere/requests: No such file or directory");
  expectFailure({"--tls-certificate", "/nowhere", "--tls-key", "/nowhere"}, "/nowhere");
}

TEST_F(CommandLineTest, IsRefusedWhereNothingIsInstalledBesideTheProgram) {
  // The build's program stands beside no classes and no providers.
  expectRefused({"--config", "/dev/null", "--port", "0"}, 2, "--schema: must be given, because ");
  expectRefused({"--config", "/dev/null", "--schema", SOURCE_DIR "/tests/support/probe/Probe.mof"}, 2,
                "--registration: must be given, because ");
  expectRefused({"--config", ""}, 2, "--config");
}

TEST_F(CommandLineTest, FailsForAProviderWithoutALibrary) {
  auto options = Cimomd::probeOptions();
  options.back() = directory_.path().string();
  options.insert(options.end(), {"--config", "/dev/null", "--port", "0"});
  expectRefused(options, 1, "cimomprobe");
}

TEST_F(CommandLineTest, FailsForAPortThatIsTaken) {
  const Cimomd first(Cimomd::probeOptions());
  std::vector<std::string> options = Cimomd::probeOptions();
  options.insert(options.end(), {"--config", "/dev/null", "--port", std::to_string(first.port())});
  expectRefused(options, 1, "Address already in use");
}

TEST_F(CommandLineTest, TakesItsOptionsFromTheFileRelativeToIt) {
  directory_.write("probe.mof", "#pragma namespace(\"root/test\")\nclass TEST_Local { };");
  const Cimomd cimomd(
      {"--config", file("schema = probe.mof\nregistration = " SOURCE_DIR "/tests/support/probe/Probe.reg\n"
                        "schema = " SOURCE_DIR "/tests/support/probe/Probe.mof\n"
                        "provider-dir = " +
                        built("lib") + " ; where the build puts it\n")});
  const std::string classes = cimomd.wbemcli({"ecn"}, "").output;
  EXPECT_THAT(classes, AllOf(HasSubstr("TEST_Local"), HasSubstr("TEST_Thing")));
}

TEST_F(CommandLineTest, TakesADirectoryOfRegistrations) {
  directory_.write("all/first.reg", readFile(SOURCE_DIR "/tests/support/probe/Probe.reg"));
  directory_.write("all/first.peg.mof", "what another object manager takes");
  const Cimomd cimomd({"--config", file("schema = " SOURCE_DIR "/tests/support/probe/Probe.mof\nregistration = all\n"
                                        "provider-dir = " +
                                        built("lib") + "\n")});
  EXPECT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
}

TEST_F(CommandLineTest, TakesIndentedKeysOfTheFile) {
  // Indentation means nothing: neither a second value of the key above nor a line that is passed over.
  expectRefused({"--config", file("address = 127.0.0.1\n  port = high\n")}, 2, "cimomd.ini:2: port: must be a number");
  expectRefused({"--config", file("port = 0\n  nonsense = 1\n")}, 2, "cimomd.ini:2: unknown key \"nonsense\"");
  const Cimomd cimomd({"--config", file("  schema = " SOURCE_DIR "/tests/support/probe/Probe.mof\n"
                                        "\tregistration = " SOURCE_DIR "/tests/support/probe/Probe.reg\n"
                                        "  provider-dir = " +
                                        built("lib") + "\n")});
  EXPECT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
}

TEST_F(CommandLineTest, WinsOverTheFile) {
  // The file's port could not be listened on.
  std::vector<std::string> options = Cimomd::probeOptions();
  options.insert(options.end(), {"--config", file("port = 1\naddress = 192.0.2.1\n"), "--address", "127.0.0.1"});
  EXPECT_NE(Cimomd(options).port(), 1);
}

}  // namespace
