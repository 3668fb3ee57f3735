// SPDX-License-Identifier: Apache-2.0
// The instrumentation as its callers have it: the shared library behind its contract, on the simulated processor.
#include <QV/Instrumentation.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <thread>
#include <vector>

#include "tests/support/agent/AgentEnvironment.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;
using namespace NodeLexicon;
using testing::HasSubstr;
using testing::IsEmpty;

[[maybe_unused]] const auto* const environment = testing::AddGlobalTestEnvironment(&AgentEnvironment::instance());

class InstrumentationTest : public testing::Test {
 protected:
  void SetUp() override { AgentEnvironment::instance().reset(); }

  static std::string log() { return readFile(AgentEnvironment::instance().log()); }
  static std::string state() { return readFile(AgentEnvironment::instance().state()); }

  static std::string address() {
    Instrumentation reader;
    reader.selectNode(IpInterfaceNode);
    std::string value;
    return reader.getProperty(Ipv4Address, value) ? value : "unreadable";
  }
};

TEST_F(InstrumentationTest, WalksTheInterfaces) {
  Instrumentation instrumentation;
  EXPECT_FALSE(instrumentation);
  instrumentation.selectNode(IpInterfaceNode);
  std::vector<std::string> names;
  for (std::string name; instrumentation && instrumentation.getProperty(NodeName, name); ++instrumentation) {
    names.push_back(name);
  }
  EXPECT_THAT(names, testing::ElementsAre("eth0", "eth1"));
}

TEST_F(InstrumentationTest, SendsAWaitingAddressWhenItIsDestroyed) {
  {
    Instrumentation instrumentation;
    instrumentation.selectNode(IpInterfaceNode);
    std::string value = "192.0.2.99";
    EXPECT_TRUE(instrumentation.setProperty(Ipv4Address, value));
    EXPECT_EQ(address(), "192.0.2.10");
  }
  EXPECT_EQ(address(), "192.0.2.99");
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(InstrumentationTest, ThrowsLogsAndTracesARefusal) {
  Instrumentation instrumentation;
  instrumentation.selectNode(IpInterfaceNode);
  std::string value = "192.0.2.0256";
  const std::string refusal = thrownBy([&] { instrumentation.setProperty(Ipv4Address, value); });
  EXPECT_THAT(refusal, HasSubstr("interface eth0: the IPv4 address '192.0.2.0256' is not four decimal numbers"));
  for (const std::string& lines : {log(), readFile(AgentEnvironment::instance().trace())}) {
    EXPECT_THAT(lines, HasSubstr(" 6000 Tarnwick.Instrumentation setProperty (Instrumentation:"));
    EXPECT_THAT(lines, testing::EndsWith(refusal + '\n'));
  }
}

TEST_F(InstrumentationTest, LogsWhatItCannotThrowAnyMore) {
  {
    Instrumentation instrumentation;
    instrumentation.selectNode(IpInterfaceNode);
    std::string value = "192.0.2.255";
    instrumentation.setProperty(Ipv4Address, value);
  }
  EXPECT_EQ(address(), "192.0.2.10");
  EXPECT_THAT(log(), HasSubstr("6000 Tarnwick.Instrumentation"));
  EXPECT_THAT(log(), HasSubstr("its broadcast address; nothing was changed"));
}

TEST_F(InstrumentationTest, ThrowsAndLogsADamagedStateAndLeavesIt) {
  writeFile(AgentEnvironment::instance().state(), "{");
  Instrumentation instrumentation;
  EXPECT_THAT(thrownBy([&] { instrumentation.selectNode(IpInterfaceNode); }), HasSubstr("processor.json: "));
  EXPECT_THAT(log(), HasSubstr("processor.json: "));
  EXPECT_FALSE(instrumentation);
  EXPECT_EQ(state(), "{");
}

TEST_F(InstrumentationTest, ServesSeveralThreadsAtOnce) {
  {
    std::vector<std::jthread> threads;
    for (int thread = 1; thread <= 4; ++thread) {
      threads.emplace_back([thread] {
        for (int count = 0; count < 10; ++count) {
          Instrumentation instrumentation;
          instrumentation.selectNode(IpInterfaceNode);
          std::string value = "192.0.2." + std::to_string(10 * thread + count);
          instrumentation.setProperty(Ipv4Address, value);
        }
      });
    }
  }
  EXPECT_THAT(address(), testing::AnyOf("192.0.2.19", "192.0.2.29", "192.0.2.39", "192.0.2.49"));
  EXPECT_THAT(log(), IsEmpty());
}

}  // namespace
