// SPDX-License-Identifier: Apache-2.0
// The write to the instrumentation, with a stand-in that records every call and throws where a test wants it.
#include <gtest/gtest.h>

#include "factory/IPConfigObjectFactory.h"
#include "tests/support/agent/RecordingLog.h"
#include "tests/support/composite/ScriptedInstrumentation.h"

namespace {

using namespace Testing;
using QV::IPConfigComposite::IPConfigObjectFactory;
using Calls = std::vector<std::string>;

const std::string entering = "ENTERING: executeModifyInstance() in IPConfigObjectFactory [Line: 498]";
const std::string exiting = "EXITING: executeModifyInstance() in IPConfigObjectFactory [Line: 536]";

std::string variable(const std::string& value, int line) {
  return "VARIABLE: 'name' has Value '" + value + "' at line " + std::to_string(line) + " in IPConfigObjectFactory";
}

class ExecuteModifyTest : public ::testing::Test {
 protected:
  ExecuteModifyTest() {
    instrumentation() = {};
    instrumentation().nodes = {{"eth0"}, {"eth1"}};
    logLines().clear();
  }

  int execute(const std::string& name, const std::string& address, const std::string& mask) {
    return IPConfigObjectFactory().executeModifyInstance(name, address, mask);
  }
};

TEST_F(ExecuteModifyTest, WritesAddressThenMaskToTheNodeOfThatName) {
  EXPECT_EQ(execute("eth1", "10.0.0.1", "255.0.0.0"), 0);
  EXPECT_EQ(instrumentation().calls,
            (Calls{"construct", "selectNode(29)", "bool", "bool", "getProperty(108)", "++", "bool", "getProperty(108)",
                   "setProperty(25, 10.0.0.1)", "setProperty(26, 255.0.0.0)", "destroy"}));
  EXPECT_EQ(messages(),
            (Calls{entering, variable("eth0", 514), variable("eth1", 514), variable("eth1", 517), exiting}));
}

TEST_F(ExecuteModifyTest, AnEmptyValueLeavesThatSettingUnchanged) {
  EXPECT_EQ(execute("eth0", "", "255.0.0.0"), 0);
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{26, "255.0.0.0"}}));
  EXPECT_EQ(execute("eth1", "10.0.0.1", ""), 0);
  EXPECT_EQ(instrumentation().nodes[1].values, (std::map<int, std::string>{{25, "10.0.0.1"}}));
}

TEST_F(ExecuteModifyTest, WithNothingToWriteTheNodeIsStillLookedUp) {
  EXPECT_EQ(execute("eth0", "", ""), 0);
  EXPECT_EQ(instrumentation().calls,
            (Calls{"construct", "selectNode(29)", "bool", "bool", "getProperty(108)", "destroy"}));
  EXPECT_EQ(messages(), (Calls{entering, variable("eth0", 514), variable("eth0", 517), exiting}));
}

TEST_F(ExecuteModifyTest, ANameThatNoNodeBearsIsNoErrorAndWritesNothing) {
  EXPECT_EQ(execute("eth2", "10.0.0.1", "255.0.0.0"), 0);
  EXPECT_TRUE(instrumentation().nodes[0].values.empty());
  EXPECT_TRUE(instrumentation().nodes[1].values.empty());
  EXPECT_EQ(messages(), (Calls{entering, variable("eth0", 514), variable("eth1", 514), exiting}));
}

TEST_F(ExecuteModifyTest, NamesDifferByLetterCaseAndByLength) {
  for (const std::string name : {"ETH0", "eth", "eth00", ""}) {
    EXPECT_EQ(execute(name, "10.0.0.1", "255.0.0.0"), 0);
    EXPECT_TRUE(instrumentation().nodes[0].values.empty()) << name;
  }
}

TEST_F(ExecuteModifyTest, AnEmptyNameMatchesOnlyANodeWithoutOne) {
  instrumentation().nodes = {{"eth0"}, {""}};
  EXPECT_EQ(execute("", "10.0.0.1", ""), 0);
  EXPECT_TRUE(instrumentation().nodes[0].values.empty());
  EXPECT_EQ(instrumentation().nodes[1].values.size(), 1u);
}

TEST_F(ExecuteModifyTest, OfSeveralNodesWithOneNameTheFirstIsWritten) {
  instrumentation().nodes = {{"eth0"}, {"eth0"}};
  EXPECT_EQ(execute("eth0", "10.0.0.1", ""), 0);
  EXPECT_EQ(instrumentation().nodes[0].values.size(), 1u);
  EXPECT_TRUE(instrumentation().nodes[1].values.empty());
}

TEST_F(ExecuteModifyTest, TheWalkDoesNotAdvanceItselfPastANodeWhoseNameCannotBeRead) {
  instrumentation().nodes = {{std::nullopt}, {"eth1"}};
  EXPECT_EQ(execute("eth1", "10.0.0.1", ""), 0);
  EXPECT_EQ(instrumentation().calls, (Calls{"construct", "selectNode(29)", "bool", "bool", "getProperty(108)", "bool",
                                            "getProperty(108)", "setProperty(25, 10.0.0.1)", "destroy"}));
}

TEST_F(ExecuteModifyTest, WithoutAnInterfaceNodeTheResultIs1) {
  instrumentation().nodes.clear();
  EXPECT_EQ(execute("eth0", "10.0.0.1", "255.0.0.0"), 1);
  EXPECT_EQ(instrumentation().calls, (Calls{"construct", "selectNode(29)", "bool", "destroy"}));
  EXPECT_EQ(messages(), (Calls{entering, exiting}));
}

TEST_F(ExecuteModifyTest, ValuesAreHandedOnAsTheyAre) {
  EXPECT_EQ(execute("eth0", "no address", "no mask"), 0);
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{25, "no address"}, {26, "no mask"}}));
}

TEST_F(ExecuteModifyTest, TheInstrumentationIsGoneBeforeTheExitIsReported) {
  execute("eth0", "10.0.0.1", "");
  EXPECT_EQ(instrumentation().calls.back(), "destroy");
  EXPECT_EQ(messages().back(), exiting);
}

class ExecuteModifyThrowsTest : public ExecuteModifyTest, public ::testing::WithParamInterface<const char*> {};

TEST_P(ExecuteModifyThrowsTest, IsCaughtAndReportedWithoutAnExitLine) {
  instrumentation().throwAt = GetParam();
  EXPECT_EQ(execute("eth1", "10.0.0.1", "255.0.0.0"), 1);
  const LogLine last = logLines().back();
  EXPECT_EQ(last.message, "MESSAGE [File: IPConfigObjectFactory, Line: 533]: Caught Exception : ");
  EXPECT_EQ(last.channel, Channel::Trace);
  EXPECT_EQ(last.level, 6000);
  EXPECT_EQ(lineWith(last.message).level, 6000);
  EXPECT_TRUE(messagesWith("EXITING").empty());
  if (std::string(GetParam()) != "construct") {
    EXPECT_EQ(instrumentation().calls.back(), "destroy");
  }
}

INSTANTIATE_TEST_SUITE_P(AtEveryCall, ExecuteModifyThrowsTest,
                         ::testing::Values("construct", "selectNode(29)", "bool", "getProperty(108)", "++",
                                           "setProperty(25, 10.0.0.1)", "setProperty(26, 255.0.0.0)"));

TEST_F(ExecuteModifyTest, AnAddressWrittenBeforeTheExceptionStaysWritten) {
  instrumentation().throwAt = "setProperty(26, 255.0.0.0)";
  EXPECT_EQ(execute("eth0", "10.0.0.1", "255.0.0.0"), 1);
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{25, "10.0.0.1"}}));
}

TEST_F(ExecuteModifyTest, TheRemoteAccessPointsWriterReportsItsEntryAndNothingElse) {
  IPConfigObjectFactory().executeSAPModifyInstance(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
  EXPECT_EQ(messages(), Calls{"ENTERING: executeSAPModifyInstance() in IPConfigObjectFactory [Line: 550]"});
  EXPECT_EQ(messages(Channel::Trace), messages());
  EXPECT_TRUE(instrumentation().calls.empty());
}

}  // namespace
