// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include <csignal>

#include "tests/bmcip/BmcipTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using testing::ContainsRegex;
using testing::HasSubstr;

class BmcipWatchTest : public BmcipStackTest {};

TEST_F(BmcipWatchTest, TellsChangesAsTheyCome) {
  Process watching = start({"watch", "--interval", "0.1"});
  ASSERT_TRUE(poll([&] { return watching.errors().find("watching") != std::string::npos; })) << watching.errors();
  stack_.modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  EXPECT_TRUE(poll([&] { return watching.output().find("192.0.2.77") != std::string::npos; }));
  EXPECT_THAT(watching.output(),
              ContainsRegex("^[-0-9]+T[0-9:]+[+-][0-9:]+  eth0 address: 192.0.2.10 -> 192.0.2.77\n"));
  stack_.cimomd().stop();
  EXPECT_TRUE(poll([&] { return watching.output().find("server: answering -> ") != std::string::npos; }));
  EXPECT_TRUE(watching.isRunning());
  watching.signal(SIGINT);
  EXPECT_EQ(watching.wait(), 128 + SIGINT);
}

TEST_F(BmcipWatchTest, WritesJson) {
  Process watching = start({"watch", "--json", "--interval", "0.1"});
  ASSERT_TRUE(poll([&] { return watching.errors().find("watching") != std::string::npos; })) << watching.errors();
  stack_.modify(endpoint("eth0"), "IPv4Address=192.0.2.78");
  EXPECT_TRUE(poll([&] { return !watching.output().empty(); }));
  EXPECT_THAT(watching.output(), HasSubstr(R"("what":"eth0 address","before":"192.0.2.10","after":"192.0.2.78"})"));
}

TEST_F(BmcipWatchTest, FailsWhereThereIsNothingToWatch) {
  EXPECT_EQ(bmcip({"watch", "--url", "http://127.0.0.1:1"}).status, 10);
}

}  // namespace
