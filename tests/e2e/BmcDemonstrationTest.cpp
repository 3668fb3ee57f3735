// The demonstration against a simulated BMC that answers real IPMI.
#include <gmock/gmock.h>

#include "tests/e2e/DemonstrationFixture.h"

namespace {

using namespace Testing;
using testing::ContainsRegex;
using testing::HasSubstr;

TEST_F(DemonstrationTest, ShowsABmcAChangeAndTheModel) {
  const Completed completed = demonstrate({"--bmc"});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const std::string& shown = completed.output;
  EXPECT_THAT(shown, HasSubstr("a simulated BMC (ipmi_sim): its values are made up"));
  EXPECT_THAT(shown, ContainsRegex("before:\n.*\n  lan1 +192.0.2.10 +255.255.255.0 +DHCP\n"));
  EXPECT_THAT(shown, ContainsRegex("after:\n.*\n  lan1 +192.0.2.77 +255.255.255.128 +static\n"));
  EXPECT_THAT(shown, ContainsRegex("IPRemoteHostedAccessPoint: Gateway:lan1\n"));
  expectNothingLeft();
}

}  // namespace
