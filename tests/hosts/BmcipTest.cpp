// SPDX-License-Identifier: Apache-2.0
// The installed bmcip, asking the object manager.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/hosts/HostTest.h"
#include "tests/support/client/CompositeObjects.h"

namespace {

using namespace Testing;
using testing::HasSubstr;
using testing::StartsWith;

class HostBmcipTest : public HostTest {
 protected:
  static Completed bmcip(const std::vector<std::string>& arguments) {
    std::vector<std::string> command = {INSTALL_PREFIX "/bin/bmcip", "--url",
                                        "http://127.0.0.1:" + std::to_string(host().port())};
    command.insert(command.end(), arguments.begin(), arguments.end());
    return run(command);
  }
};

TEST_F(HostBmcipTest, ShowsTheModel) {
  const Completed shown = bmcip({"show"});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_THAT(shown.output, HasSubstr("  eth0  192.0.2.10/24     255.255.255.0  static  2001:db8::10/64  enabled\n"));
  EXPECT_THAT(shown.output, HasSubstr("  DNS:2  2001:db8::53\n"));
  const Completed tree = bmcip({"model"});
  EXPECT_EQ(tree.status, 0) << tree.errors;
  EXPECT_THAT(tree.output,
              StartsWith("BMC\n├─ IPHostedAccessPoint\n│  ├─ eth0\n│  │  ├─ ClientAccess: Gateway:eth0, "));
}

TEST_F(HostBmcipTest, ChangesAnAddressAndReadsItBack) {
  const Completed changed = bmcip({"set", "eth0", "203.0.113.77/25"});
  EXPECT_EQ(changed.status, 0) << changed.output << changed.errors;
  EXPECT_EQ(host().get(endpoint("eth0")).at("IPv4Address"), quoted("203.0.113.77"));
  EXPECT_EQ(host().get(endpoint("eth0")).at("SubnetMask"), quoted("255.255.255.128"));
  EXPECT_EQ(bmcip({"set", "eth1", "--address", "198.51.100.99"}).status, 0);
}

TEST_F(HostBmcipTest, SaysWhatIsNotServed) {
  const std::string url = "http://127.0.0.1:" + std::to_string(host().port()) + "/root/nowhere";
  const Completed failed = run({INSTALL_PREFIX "/bin/bmcip", "show", "--url", url});
  EXPECT_EQ(failed.status, 14);
  EXPECT_THAT(failed.errors, HasSubstr("no such namespace"));
}

}  // namespace
