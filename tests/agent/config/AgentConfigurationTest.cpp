// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <sstream>

#include "Paths.h"
#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/config/AgentConfiguration.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;
using Destination = ChannelSettings::Destination;
using testing::HasSubstr;
using testing::StartsWith;

AgentConfiguration parse(const std::string& text) {
  std::istringstream stream(text);
  return parseAgentConfiguration(stream, "agent.ini");
}

std::string complaintAbout(const std::string& text) {
  return thrownBy([&] { parse(text); });
}

// Sets QV_AGENT_INI for one test.
class AgentIniVariable {
 public:
  explicit AgentIniVariable(const std::string& value) { ::setenv("QV_AGENT_INI", value.c_str(), 1); }
  ~AgentIniVariable() { ::unsetenv("QV_AGENT_INI"); }
};

TEST(AgentConfigurationTest, AnEmptyFileMeansTheDefaults) {
  const AgentConfiguration configuration = parse("");
  EXPECT_EQ(configuration.systemName, "");
  EXPECT_EQ(configuration.log.destination, Destination::Syslog);
  EXPECT_EQ(configuration.log.threshold, 6000);
  EXPECT_EQ(configuration.trace.destination, Destination::Off);
  EXPECT_EQ(configuration.trace.threshold, 4000);
  EXPECT_EQ(configuration.backEnd, "") << "a management processor is chosen, never assumed";
  EXPECT_TRUE(configuration.backEndSettings.empty());
  EXPECT_FALSE(configuration.publishesHost);
}

TEST(AgentConfigurationTest, EveryKeyIsTaken) {
  const AgentConfiguration configuration = parse(
      "[system]\nname = rack7.example\n"
      "[log]\ndestination = file\nfile = /l/log\nthreshold = 5000\nthreshold.Tarnwick.IPConfigProvider = 4000\n"
      "[trace]\ndestination = stderr\nfile = /l/trace\nthreshold = 1\nthreshold.A = 2\nthreshold.B = 0\n"
      "[host]\npublish = yes\n"
      "[processor]\nbackend = ipmi\nname = bmc7\ndescription = the one in rack 7\n"
      "[simulated]\nstate = /s/state.json\n"
      "[ipmi]\nhost = 192.0.2.10\nanything = at all\n");
  EXPECT_EQ(configuration.systemName, "rack7.example");
  EXPECT_EQ(configuration.log.destination, Destination::File);
  EXPECT_EQ(configuration.log.file, "/l/log");
  EXPECT_EQ(configuration.log.threshold, 5000);
  EXPECT_EQ(configuration.log.componentThresholds, (std::map<std::string, int>{{"Tarnwick.IPConfigProvider", 4000}}));
  EXPECT_EQ(configuration.trace.destination, Destination::Stderr);
  EXPECT_EQ(configuration.trace.file, "/l/trace");
  EXPECT_EQ(configuration.trace.threshold, 1);
  EXPECT_EQ(configuration.trace.componentThresholds, (std::map<std::string, int>{{"A", 2}, {"B", 0}}));
  EXPECT_TRUE(configuration.publishesHost);
  EXPECT_EQ(configuration.backEnd, "ipmi");
  EXPECT_EQ(configuration.processorName, "bmc7");
  EXPECT_EQ(configuration.processorDescription, "the one in rack 7");
  EXPECT_EQ(configuration.backEndSettings,
            (std::map<std::string, std::string>{{"host", "192.0.2.10"}, {"anything", "at all"}}));
}

TEST(AgentConfigurationTest, TheSampleIsAFileOfDefaults) {
  // Given the sample as it is shipped, and the same with every key put into force
  const std::string sample = readFile(SOURCE_DIR "/agent/agent.ini.sample");
  std::string inForce;
  std::istringstream lines(sample);
  for (std::string line; std::getline(lines, line);) {
    const bool commentedKey = line.starts_with(';') && line.find(" = ") != std::string::npos && line[1] != ' ';
    inForce += (commentedKey ? line.substr(1) : line) + '\n';
  }

  // Then both are accepted, and the keys that the sample shows with a value show the default
  EXPECT_NO_THROW(parse(sample));
  const AgentConfiguration shown = parse(inForce);
  const AgentConfiguration defaults;
  EXPECT_NE(inForce.find("\npublish = no\n"), std::string::npos);
  EXPECT_EQ(shown.log.destination, defaults.log.destination);
  EXPECT_EQ(shown.log.threshold, defaults.log.threshold);
  EXPECT_EQ(shown.trace.destination, defaults.trace.destination);
  EXPECT_EQ(shown.trace.threshold, defaults.trace.threshold);
  EXPECT_EQ(shown.publishesHost, defaults.publishesHost);
  EXPECT_EQ(shown.backEnd, "ipmi") << "an example, since there is no default";
  EXPECT_NE(inForce.find("\nstate = " + parseSimulatedSettings({}) + "\n"), std::string::npos);
}

struct Fault {
  const char* text;
  const char* complaint;
};

class FaultyAgentIniTest : public testing::TestWithParam<Fault> {};

TEST_P(FaultyAgentIniTest, IsRefusedWithTheLineAndTheReason) {
  EXPECT_EQ(complaintAbout(GetParam().text), GetParam().complaint);
}

INSTANTIATE_TEST_SUITE_P(
    Each, FaultyAgentIniTest,
    testing::Values(
        Fault{"name = x\n", "agent.ini:1: the key 'name' stands before any section: move it below its [section]"},
        Fault{"[system]\nname = x\n[sytem]\nname = y\n",
              "agent.ini:4: there is no section [sytem]: must be one of system, log, trace, host, processor, "
              "simulated, ipmi"},
        Fault{"\n[system]\nnane = x\n", "agent.ini:3: [system] has no key 'nane': must be one of name"},
        Fault{"[system]\nname =\n", "agent.ini:2: [system] name = : must not be empty"},
        Fault{"[log]\nthreshold.=5\n",
              "agent.ini:2: [log] has no key 'threshold.': must be one of destination, file, threshold, "
              "threshold.COMPONENT"},
        Fault{"[log]\nthreshold = high\n",
              "agent.ini:2: [log] threshold = high: must be a number from 0 to 2147483647"},
        Fault{"[log]\nthreshold = -1\n", "agent.ini:2: [log] threshold = -1: must be a number from 0 to 2147483647"},
        Fault{"[trace]\nthreshold.A = 99999999999\n",
              "agent.ini:2: [trace] threshold.A = 99999999999: must be a number from 0 to 2147483647"},
        Fault{"[log]\ndestination = mail\n",
              "agent.ini:2: [log] destination = mail: must be one of off, syslog, stderr, file"},
        Fault{"[log]\nfile = log.txt\n", "agent.ini:2: [log] file = log.txt: must be an absolute path"},
        Fault{"[log]\ndestination = file\n", "agent.ini: [log] destination is file, but the key 'file' is missing"},
        Fault{"[trace]\ndestination = file\n", "agent.ini: [trace] destination is file, but the key 'file' is missing"},
        Fault{
            "[processor]\nbackend = ../magic\n",
            "agent.ini:2: [processor] backend = ../magic: must be the name of a back end, of letters, digits and '-'"},
        Fault{"[processor]\nbackend =\n",
              "agent.ini:2: [processor] backend = : must be the name of a back end, of letters, digits and '-'"},
        Fault{"[host]\npublish = maybe\n", "agent.ini:2: [host] publish = maybe: must be one of yes, no"},
        Fault{"[magic]\nwand = 1\n[processor]\nbackend = ipmi\n",
              "agent.ini:2: there is no section [magic]: must be one of system, log, trace, host, processor, "
              "simulated, ipmi"},
        Fault{"[system]\nname = a\nname = b\n", "agent.ini:3: [system] name: duplicate"},
        Fault{"[system]\njust words\n", "agent.ini:2: must be a [section] or a key = value"},
        Fault{"[system\nname = a\n", "agent.ini:1: must be a [section] or a key = value"}),
    [](const auto& fault) { return "fault" + std::to_string(fault.index); });

TEST(AgentConfigurationTest, TheFirstOfSeveralFaultsIsReported) {
  EXPECT_EQ(complaintAbout("[system]\nwords\n[nowhere]\na = b\n"), "agent.ini:2: must be a [section] or a key = value");
  EXPECT_THAT(complaintAbout("[nowhere]\na = b\nwords\n"), StartsWith("agent.ini:2: there is no section [nowhere]"));
}

TEST(AgentConfigurationTest, AnIndentedKeyIsAKeyAndNoContinuation) {
  const AgentConfiguration configuration = parse("[processor]\n  name = a\n\tdescription = b\n");
  EXPECT_EQ(configuration.processorName, "a");
  EXPECT_EQ(configuration.processorDescription, "b");
}

TEST(AgentConfigurationTest, TheSectionOfTheChosenBackEndIsPassedOnWhereverItStands) {
  const AgentConfiguration configuration = parse("[magic]\nwand = 1\n[processor]\nbackend = magic\n[ipmi]\nhost = a\n");
  EXPECT_EQ(configuration.backEnd, "magic");
  EXPECT_EQ(configuration.backEndSettings, (std::map<std::string, std::string>{{"wand", "1"}}));
}

TEST(AgentConfigurationTest, CommentsBlankLinesAndCarriageReturnsMeanNothing) {
  const AgentConfiguration configuration = parse("; a\r\n# b\r\n\r\n[processor]\r\nname = a;b ; a comment\r\n");
  EXPECT_EQ(configuration.processorName, "a;b");
}

TEST(AgentConfigurationTest, TheLongestLineIsTakenWholeAndALongerOneRefused) {
  const std::string key = "[system]\nname = ";
  const std::string longest(198 - 7, 'x');
  EXPECT_EQ(parse(key + longest + '\n').systemName, longest);
  EXPECT_EQ(complaintAbout(key + longest + "x\n"), "agent.ini:2: the line is longer than 198 characters");
}

TEST(AgentConfigurationTest, ANullCharacterIsRefused) {
  EXPECT_EQ(complaintAbout(std::string("[system]\nname = a\0b\n", 20)),
            "agent.ini:2: the line contains a null character");
}

TEST(AgentConfigurationTest, TheFileThatTheVariableNamesIsRead) {
  const TemporaryDirectory directory;
  writeFile(directory / "a.ini", "[system]\nname = chosen\n");
  const AgentIniVariable variable(directory / "a.ini");
  EXPECT_EQ(readAgentConfiguration().systemName, "chosen");
}

TEST(AgentConfigurationTest, AFileThatTheVariableNamesAndThatIsMissingIsAnError) {
  const TemporaryDirectory directory;
  const AgentIniVariable variable(directory / "none.ini");
  EXPECT_EQ(thrownBy(readAgentConfiguration),
            directory / "none.ini" +
                ": cannot be opened: No such file or directory; create it and choose the management processor there: "
                "[processor] with backend = ipmi for a BMC, or backend = simulated for made-up values");
}

TEST(AgentConfigurationTest, AFileThatThisUserMayNotReadIsAnError) {
  const TemporaryDirectory directory;
  writeFile(directory / "a.ini", "");
  std::filesystem::permissions(directory / "a.ini", std::filesystem::perms::none);
  const AgentIniVariable variable(directory / "a.ini");
  // Even root is held by permissions once it is somebody else.
  const auto readAsSomebodyElse = [] {
    const bool somebodyElse = ::geteuid() != 0 || ::seteuid(65534) == 0;
    std::fputs(somebodyElse ? thrownBy(readAgentConfiguration).c_str() : "still root", stderr);
    std::_Exit(0);  // without what sanitizers do at the end, which is the former user's right
  };
  std::filesystem::permissions(directory.path(), std::filesystem::perms::all);
  EXPECT_EXIT(readAsSomebodyElse(), testing::ExitedWithCode(0),
              "a.ini: cannot be opened: Permission denied; let the object manager's user read it$");
}

TEST(AgentConfigurationTest, IsLookedForInOnePlaceWhateverTheInstallPrefix) {
  EXPECT_EQ(agentConfigurationFile(), CONFIGURATION_DIR "/agent.ini");
  const AgentIniVariable variable("/elsewhere/agent.ini");
  EXPECT_EQ(agentConfigurationFile(), "/elsewhere/agent.ini");
}

TEST(AgentConfigurationTest, ADirectoryInPlaceOfTheFileIsAnError) {
  const TemporaryDirectory directory;
  const AgentIniVariable variable(directory.path().string());
  EXPECT_THAT(thrownBy(readAgentConfiguration), HasSubstr(directory.path().string() + ": cannot be read"));
}

TEST(AgentConfigurationTest, AFaultNamesTheFile) {
  const TemporaryDirectory directory;
  writeFile(directory / "a.ini", "[x]\ny = z\n");
  const AgentIniVariable variable(directory / "a.ini");
  EXPECT_THAT(thrownBy(readAgentConfiguration), StartsWith(directory / "a.ini" + ":2: there is no section [x]"));
}

}  // namespace
