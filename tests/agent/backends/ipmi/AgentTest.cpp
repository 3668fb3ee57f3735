// SPDX-License-Identifier: Apache-2.0
// The agent as it is installed: agent.ini says ipmi, and the instrumentation loads the back end and shows the real BMC.
#include <QV/Instrumentation.h>
#include <gmock/gmock.h>

#include <cstdlib>

#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using QV::Instrumentation;
using QV::NodeLexicon::IpInterfaceNode;
using QV::NodeLexicon::Properties;

// agent.ini is read once in a process, so one BMC serves all tests here.
class IpmiAgentTest : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    directory = std::make_unique<TemporaryDirectory>();
    bmc = std::make_unique<SimulatedBmc>();
    std::string ini = "[log]\ndestination = file\nfile = " + log() + "\n[trace]\ndestination = file\nfile = " + log() +
                      "\n[processor]\nbackend = ipmi\n[ipmi]\n";
    for (const auto& [key, value] : bmc->settings()) {
      ini += key + " = " + value + '\n';
    }
    writeFile(*directory / "agent.ini", ini);
    ::setenv("QV_AGENT_INI", (*directory / "agent.ini").c_str(), 1);
  }
  static void TearDownTestSuite() {
    bmc.reset();
    directory.reset();
  }
  static std::string log() { return *directory / "agent.log"; }

  static std::string value(Instrumentation& instrumentation, Properties property) {
    std::string text;
    return instrumentation.getProperty(property, text) ? text : "(none)";
  }

  static inline std::unique_ptr<TemporaryDirectory> directory;
  static inline std::unique_ptr<SimulatedBmc> bmc;
};

TEST_F(IpmiAgentTest, ShowsAndChangesTheBmcsInterface) {
  {
    Instrumentation instrumentation;
    instrumentation.selectNode(IpInterfaceNode);
    ASSERT_TRUE(bool(instrumentation));
    EXPECT_EQ(value(instrumentation, Properties::NodeName), "lan1");
    EXPECT_EQ(value(instrumentation, Properties::Ipv4Address), "192.0.2.10");
    EXPECT_EQ(value(instrumentation, Properties::Ipv4SubnetMask), "255.255.255.0");

    std::string address = "192.0.2.77", mask = "255.255.255.128";
    EXPECT_TRUE(instrumentation.setProperty(Properties::Ipv4Address, address));
    EXPECT_TRUE(instrumentation.setProperty(Properties::Ipv4SubnetMask, mask));
  }

  EXPECT_EQ(bmc->witness("IP Address"), "192.0.2.77");
  EXPECT_EQ(bmc->witness("Subnet Mask"), "255.255.255.128");
  EXPECT_EQ(bmc->witness("IP Address Source"), "Static Address");
  EXPECT_THAT(readFile(log()), testing::HasSubstr("Tarnwick.Ipmi"));
  EXPECT_THAT(readFile(log()), testing::HasSubstr("round trips"));
  Instrumentation again;
  again.selectNode(IpInterfaceNode);
  EXPECT_EQ(value(again, Properties::Ipv4Address), "192.0.2.77");
}

TEST(IpmiBackEndLibraryTest, ExportsItsFactoryAlone) {
  const std::string symbols = run({"nm", "-D", "--defined-only", built("lib/libqvbmc-ipmi.so")}).output;
  EXPECT_THAT(symbols, testing::MatchesRegex("[0-9a-f]+ T qvCreateBackEnd\n"));
}

TEST(IpmiBackEndLibraryTest, IsNotLinkedByTheInstrumentation) {
  const std::string symbols = run({"readelf", "-d", built("lib/libqvinstrumentation.so")}).output;
  EXPECT_THAT(symbols, testing::AllOf(testing::HasSubstr("NEEDED"), testing::Not(testing::HasSubstr("freeipmi"))));
}

}  // namespace
