// SPDX-License-Identifier: Apache-2.0
// Changes of a BMC that answers real IPMI, and one that refuses, stalls or takes half; ipmitool is the witness.
#include <gmock/gmock.h>

#include <optional>

#include "tests/bmcip/BmcipTest.h"
#include "tests/support/agent/SimulatedBmc.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;

class BmcipBmcTest : public BmcipTest {
 protected:
  BmcipBmcTest() {
    std::string processor = "[processor]\nbackend = ipmi\n[ipmi]\n";
    auto settings = bmc_.settings();
    settings["operation_timeout"] = "5";
    for (const auto& [key, value] : settings) {
      processor += key + " = " + value + '\n';
    }
    stack_.emplace(processor);
    environment_["BMCIP_URL"] = "http://127.0.0.1:" + std::to_string(stack_->port());
  }

  Completed set(const std::string& wait = "1") const { return bmcip({"set", "lan1", "192.0.2.77/25", "--wait", wait}); }

  SimulatedBmc bmc_;
  std::optional<CompositeStack> stack_;
};

TEST_F(BmcipBmcTest, ShowsAndChangesIt) {
  EXPECT_THAT(bmcip({"show"}).output, HasSubstr("  lan1  192.0.2.10/24  255.255.255.0  DHCP "));
  const Completed changed = set("10");
  EXPECT_EQ(changed.status, 0) << changed.errors;
  EXPECT_EQ(bmc_.witness("IP Address"), "192.0.2.77");
  EXPECT_EQ(bmc_.witness("Subnet Mask"), "255.255.255.128");
}

TEST_F(BmcipBmcTest, SaysThatItRefused) {
  bmc_.hook("check", "exit 1");
  const Completed refused = set();
  EXPECT_EQ(refused.status, 4) << refused.errors;
  EXPECT_THAT(refused.errors, StartsWith("bmcip: not applied: the object manager accepted the change"));
  EXPECT_EQ(bmc_.witness("IP Address"), "192.0.2.10");
  EXPECT_THAT(stack_->log(), HasSubstr("192.0.2.77"));
}

TEST_F(BmcipBmcTest, SaysThatItTookHalf) {
  bmc_.hook("set", "sed -i -e 's/^ip_addr=.*/ip_addr=192.0.2.77/' lan.state\nexit 1");
  const Completed half = set();
  EXPECT_EQ(half.status, 5) << half.output << half.errors << stack_->log();
  EXPECT_THAT(half.errors, StartsWith("bmcip: half applied: "));
}

TEST_F(BmcipBmcTest, SaysThatNobodyKnowsWhereItStalls) {
  bmc_.hook("set", "kill -STOP $SIMULATOR");
  const Completed unknown = set();
  EXPECT_EQ(unknown.status, 6) << unknown.output << unknown.errors;
  EXPECT_THAT(unknown.errors, AllOf(StartsWith("bmcip: unknown: the change was sent"), HasSubstr("look again")));
  bmc_.removeHook("set");
  bmc_.resume();
}

TEST_F(BmcipBmcTest, SaysWhyItCannotBeRead) {
  bmc_.kill();
  const Completed failed = bmcip({"show"});
  EXPECT_EQ(failed.status, 15);
  EXPECT_THAT(failed.errors, HasSubstr("127.0.0.1:" + std::to_string(bmc_.port())));
}

}  // namespace
