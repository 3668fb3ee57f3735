// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "agent/backends/NamedProcessor.h"
#include "tests/agent/instrumentation/RecordingBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace QV;
using namespace Testing;

TEST(NamedProcessorTest, BearsTheGivenNames) {
  const TemporaryDirectory directory;
  NamedProcessor processor(std::make_shared<RecordingBackEnd>(directory / "state"), "bmc7", "in rack 7");
  EXPECT_EQ(processor.read().name, "bmc7");
  EXPECT_EQ(processor.read().description, "in rack 7");
  EXPECT_EQ(processor.read().interfaces, factoryConfiguration().interfaces);
}

TEST(NamedProcessorTest, KeepsItsOwnNamesWhereNoneIsGiven) {
  const TemporaryDirectory directory;
  NamedProcessor processor(std::make_shared<RecordingBackEnd>(directory / "state"), "", "");
  EXPECT_EQ(processor.read(), factoryConfiguration());
}

TEST(NamedProcessorTest, AsksForInterfaceNamesAlone) {
  const TemporaryDirectory directory;
  const auto inner = std::make_shared<RecordingBackEnd>(directory / "state");
  EXPECT_THAT(NamedProcessor(inner, "a", "b").interfaceNames(), testing::ElementsAre("eth0", "eth1"));
  EXPECT_EQ(inner->reads, 0u);
}

TEST(NamedProcessorTest, PassesChangesOn) {
  const TemporaryDirectory directory;
  const auto inner = std::make_shared<RecordingBackEnd>(directory / "state");
  NamedProcessor(inner, "a", "b").change("eth1", {ipv4("192.0.2.99"), {}});
  EXPECT_THAT(inner->changes, testing::ElementsAre("eth1 192.0.2.99 -"));
  EXPECT_EQ(inner->read().name, factoryConfiguration().name) << "the given name is not written to the processor";
}

}  // namespace
