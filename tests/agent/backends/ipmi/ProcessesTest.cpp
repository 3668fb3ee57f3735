// SPDX-License-Identifier: Apache-2.0
// Object managers run provider libraries in processes of their own: here the agent is in two, one that changes and one
// that reads, and each keeps its own look at the BMC.
#include <gmock/gmock.h>

#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/agent/UdpRelay.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/Process.h"

namespace {

using namespace Testing;

class IpmiProcessesTest : public testing::Test {
 protected:
  // The command of a process with the agent in it, which keeps a look at the BMC for as long as it may.
  std::vector<std::string> agentBehind(QV::BackEndSettings settings, const std::string& ini) const {
    settings["cache"] = "60";
    std::string text = "[log]\ndestination = stderr\n[processor]\nbackend = ipmi\n[ipmi]\n";
    for (const auto& [key, value] : settings) {
      text += key + " = " + value + '\n';
    }
    writeFile(directory / ini, text);
    return {"env", "QV_AGENT_INI=" + (directory / ini), built("bin/agent_client")};
  }

  static std::string ask(Process& process, const std::string& line) {
    process.writeLine(line);
    return process.readLine();
  }

  const TemporaryDirectory directory;
  const SimulatedBmc bmc;
  UdpRelay wire{bmc.port()};
  Process reader{agentBehind(bmc.patientSettings(wire.port()), "reader.ini")};
  Process writer{agentBehind(bmc.patientSettings(), "writer.ini")};
};

TEST_F(IpmiProcessesTest, SeeEachOthersChangesWithTheNextRead) {
  EXPECT_EQ(ask(reader, "read"), "lan1 192.0.2.10/255.255.255.0");
  EXPECT_EQ(wire.requests(), 14u);

  wire.reset();
  EXPECT_EQ(ask(writer, "change 192.0.2.77 255.255.255.128"), "done");
  EXPECT_EQ(ask(reader, "read"), "lan1 192.0.2.77/255.255.255.128");
  EXPECT_EQ(wire.requests(), 7u);

  EXPECT_EQ(ask(reader, "change 192.0.2.78 255.255.255.0"), "done");
  EXPECT_EQ(ask(writer, "read"), "lan1 192.0.2.78/255.255.255.0");
}

TEST_F(IpmiProcessesTest, AskTheBmcNoMoreThanOneDoesWhereNothingChanges) {
  EXPECT_EQ(ask(writer, "read"), ask(reader, "read"));

  wire.reset();
  bmc.ipmitool({"lan", "set", "1", "ipaddr", "192.0.2.44"});
  EXPECT_EQ(ask(writer, "read"), "lan1 192.0.2.10/255.255.255.0") << "a change that is not the agent's";
  EXPECT_EQ(ask(reader, "read"), "lan1 192.0.2.10/255.255.255.0");

  EXPECT_EQ(wire.requests(), 0u);
}

// Given a process whose change met a BMC that stalled with the lock taken, and nobody asks it for more: it has a last
// try when it ends.
TEST_F(IpmiProcessesTest, GiveALockBackWhenTheyEndOrSayThatTheyCouldNot) {
  auto impatient = bmc.settings();
  impatient["operation_timeout"] = "3";
  impatient["session_timeout"] = "0.6";
  for (const bool recovers : {true, false}) {
    Process stalled(agentBehind(impatient, "stalled.ini"));
    bmc.hook("set", "kill -STOP $SIMULATOR");
    EXPECT_THAT(ask(stalled, recovers ? "change 192.0.2.77 255.255.255.128" : "change 192.0.2.78 255.255.255.0"),
                testing::HasSubstr("unknown"));
    bmc.removeHook("set");
    const auto says = [&](const char* text) {
      return poll([&] { return stalled.errors().find(text) != std::string::npos; });
    };
    EXPECT_TRUE(says("may stay set"));

    if (recovers) {
      bmc.resume();
    }
    stalled.closeInput();
    EXPECT_EQ(stalled.wait(), 0);

    if (recovers) {
      EXPECT_EQ(bmc.witness("Set in Progress"), "Set Complete");
    } else {
      EXPECT_TRUE(says("a set-in-progress lock that may be ours cannot be given back"));
      bmc.resume();
    }
  }
}

TEST_F(IpmiProcessesTest, SeeAChangeWhoseProcessEndedAtOnceAfterIt) {
  EXPECT_EQ(ask(reader, "read"), "lan1 192.0.2.10/255.255.255.0");
  {
    Process passing(agentBehind(bmc.patientSettings(), "passing.ini"));
    EXPECT_EQ(ask(passing, "change 192.0.2.77 255.255.255.128"), "done");
  }
  EXPECT_EQ(ask(reader, "read"), "lan1 192.0.2.77/255.255.255.128");
}

}  // namespace
