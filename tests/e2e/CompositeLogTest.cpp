// SPDX-License-Identifier: Apache-2.0
// What a request leaves in the management agent's log.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/CompositeStack.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;

class CompositeLogTest : public testing::Test {
 protected:
  static std::vector<std::string> having(const std::string& log, const std::string& part) {
    std::vector<std::string> lines;
    for (const std::string& line : linesOf(log)) {
      if (line.find(part) != std::string::npos) {
        lines.push_back(line);
      }
    }
    return lines;
  }

  std::string processor() const { return simulatedProcessor(directory_.path() / "processor.json"); }

  TemporaryDirectory directory_;
};

TEST_F(CompositeLogTest, FramesEveryOperationAtLevel4000) {
  const CompositeStack stack(processor(), 4000);
  stack.instances("ei", "YRNx_MgmtHwIPProtocolEndPoint");
  const std::string rule(78, '=');
  const auto frame = having(stack.log(), "4000 Tarnwick.IPProtocolEndpointProvider ");
  ASSERT_THAT(
      frame,
      ElementsAre(EndsWith(": " + rule),
                  EndsWith(": ENTERING: IPProtocolendpt_EnumInstances() in IPProtocolEndpointProvider [Line: 75]"),
                  EndsWith(": EXITING: IPProtocolendpt_EnumInstances() in IPProtocolEndpointProvider [Line: 114]"),
                  EndsWith(": " + rule)));
  const auto lines = linesOf(stack.log());
  EXPECT_EQ(lines.front(), frame.front());
  EXPECT_EQ(lines.back(), frame.back());
  // Between them, what the factory does for each of the two endpoints.
  EXPECT_THAT(having(stack.log(), "ENTERING: makeIPProtocolEndptInstance()"), testing::SizeIs(2));
}

TEST_F(CompositeLogTest, TheObjectManagerWritesWhatIsTracedToIt) {
  CompositeStack stack(processor(), 6000, {"--trace", "yes"});
  stack.instances("ei", "YRNx_MgmtHwComputerSystem");
  EXPECT_THAT(stack.cimomd().process().errors(),
              HasSubstr("trace: CompositeIPConfigProvider: ***Returning One IPConfig instance***\n"));
}

TEST_F(CompositeLogTest, TellsOfAChangeDownToTheInterface) {
  const CompositeStack stack(processor(), 4000);
  stack.modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  for (const char* line :
       {"VARIABLE: 'IpName' has Value 'eth0' at line 469", "VARIABLE: 'Ipv4Address' has Value '192.0.2.77' at line 476",
        "VARIABLE: 'Ipv4SubnetMask' has Value '255.255.255.0' at line 483",
        "EXITING: executeModifyInstance() in IPConfigObjectFactory [Line: 536]"}) {
    EXPECT_THAT(stack.log(), HasSubstr(line));
  }
}

TEST_F(CompositeLogTest, HoldsNothingOfARequestThatSucceedsAtLevel6000) {
  const CompositeStack stack(processor(), 6000);
  stack.instances("ei", "YRNx_MgmtHwIPProtocolEndPoint");
  stack.modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  EXPECT_EQ(stack.log(), "");
}

TEST_F(CompositeLogTest, NamesThePartThatFailsAtLevel6000) {
  const CompositeStack stack(processor(), 6000, CompositeStack::bare());
  stack.names("ain -ac YRNx_MgmtHwStaticIPOrderedMemberOfCollection", endpoint("eth0"));
  EXPECT_THAT(linesOf(stack.log()),
              ElementsAre(AllOf(HasSubstr(" 6000 Tarnwick.IPConfigStaticOrderedMembetOfCollProvider "),
                                EndsWith("Object Path is NULL in AssociatorNames."))));
}

TEST_F(CompositeLogTest, HoldsNothingOfAnAssociationThatTheSourceHasNoPartIn) {
  const CompositeStack stack(processor(), 6000);
  stack.names("ain -ac YRNx_MgmtHwStaticIPOrderedMemberOfCollection", endpoint("eth0"));
  EXPECT_EQ(stack.log(), "") << "the provider is not asked";
}

TEST_F(CompositeLogTest, ShowsLineFeedsOfAClientAsEscapes) {
  const CompositeStack stack(processor(), 6000);
  stack.modify(endpoint("eth0"), "IPv4Address=1\n2026 6000 Forged forged (forged:1): line");
  EXPECT_THAT(having(stack.log(), "Forged"), Contains(HasSubstr("'1\\n2026 6000 Forged")));
  for (const std::string& line : linesOf(stack.log())) {
    EXPECT_THAT(line, testing::ContainsRegex("^20[0-9-]+T[0-9:.]+Z "));
  }
}

}  // namespace
