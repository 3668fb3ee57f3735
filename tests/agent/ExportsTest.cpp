// SPDX-License-Identifier: Apache-2.0
// What each library of the agent exports: its contract and nothing else, since object managers load providers into one
// name space.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>
#include <sstream>
#include <string>

#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"

namespace {

using namespace Testing;

std::set<std::string> exportsOf(const std::string& library) {
  const std::string text = run({"nm", "-DC", "--defined-only", library}).output;
  std::set<std::string> names;
  std::istringstream lines(text);
  std::string address;
  std::string kind;
  for (std::string name; lines >> address >> kind && std::getline(lines >> std::ws, name);) {
    names.insert(name.substr(0, name.find_first_of("([")));
  }
  return names;
}

TEST(ExportsTest, OfTheLogAreItsContract) {
  EXPECT_THAT(exportsOf(built("lib/libtwlog.so")),
              testing::UnorderedElementsAre("TWLog::TWMessageBuffer::TWMessageBuffer",
                                            "TWLog::TWMessageBuffer::~TWMessageBuffer",
                                            "TWLog::TWMessageBuffer::operator<<", "TWLog::str",
                                            "TWLog::TWLogger::logLevelMessage", "TWLog::TWLogger::traceLevelMessage"));
}

TEST(ExportsTest, OfTheHelpersAreTheirContract) {
  EXPECT_THAT(
      exportsOf(built("lib/libqvhelper.so")),
      testing::UnorderedElementsAre("QV::mapProperty", "QV::getSystemName", "QV::isObjPathsEqual", "QV::textEqual"));
}

TEST(ExportsTest, OfTheInstrumentationAreItsContractAndTheSharedBackEnd) {
  EXPECT_THAT(
      exportsOf(built("lib/libqvinstrumentation.so")),
      testing::UnorderedElementsAre("QV::Instrumentation::Instrumentation", "QV::Instrumentation::~Instrumentation",
                                    "QV::Instrumentation::selectNode", "QV::Instrumentation::operator bool",
                                    "QV::Instrumentation::getProperty", "QV::Instrumentation::operator++",
                                    "QV::Instrumentation::setProperty", "QV::sharedBackEnd"));
}

TEST(ExportsTest, OfTheUnderlyingProviderAreItsFactory) {
  EXPECT_THAT(exportsOf(built("lib/libunderlyingipconfigprovider.so")),
              testing::UnorderedElementsAre("UnderlyingIPConfigProvider_Create_InstanceMI"));
}

}  // namespace
