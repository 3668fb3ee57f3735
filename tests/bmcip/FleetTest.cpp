// SPDX-License-Identifier: Apache-2.0
// Many servers at once.
#include <gmock/gmock.h>

#include <chrono>

#include "tests/bmcip/BmcipTest.h"
#include "tests/bmcip/RawServer.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

class BmcipFleetTest : public BmcipStackTest {};

TEST_F(BmcipFleetTest, PrintsALineAServerInTheirOrder) {
  const CompositeStack other(simulatedProcessor(directory_ / "other.json"));
  other.modify("YRNx_MgmtHwStaticIPAssignmentSettingData.InstanceID=\"BMC:eth0\"", "IPv4Address=192.0.2.20");
  const std::string otherUrl = "http://127.0.0.1:" + std::to_string(other.port());
  const Completed shown = bmcip({"show", otherUrl, url(), otherUrl});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  const std::vector<std::string> lines = linesOf(shown.output);
  ASSERT_THAT(lines, SizeIs(4));
  EXPECT_THAT(lines[0], AllOf(StartsWith("SERVER "), HasSubstr("  INTERFACES "), HasSubstr("  GATEWAYS ")));
  EXPECT_THAT(lines[1],
              AllOf(StartsWith(otherUrl + "  eth0=192.0.2.20/24:static,eth1=198.51.100.23/24:DHCP  192.0.2.1"),
                    HasSubstr("192.0.2.53,2001:db8::53")));
  EXPECT_THAT(lines[2], StartsWith(url() + "  eth0=192.0.2.10/24:static"));
  EXPECT_EQ(lines[3], lines[1]);
  EXPECT_THAT(shown.errors, IsEmpty());
}

TEST_F(BmcipFleetTest, ReadsServersFromAFileOrTheStandardInput) {
  const auto file = directory_.write("hosts", "# the fleet\n\n  " + url() + "  # first\n" + url() + "\r\n");
  EXPECT_THAT(linesOf(bmcip({"show", "--json", "--hosts", file.string()}).output), SizeIs(2));
  const Completed piped = run({"sh", "-c", built("bin/bmcip") + " show --json --hosts - <" + file.string()});
  EXPECT_THAT(linesOf(piped.output), SizeIs(2));
  const Completed broken = bmcip({"show", "--hosts", directory_.write("broken", "web1\nweb 2\n").string()});
  EXPECT_EQ(broken.status, 2);
  EXPECT_THAT(broken.errors, HasSubstr("broken:2: \"web 2\""));
  EXPECT_EQ(bmcip({"show", "--hosts", directory_ / "missing"}).status, 2);
  EXPECT_EQ(bmcip({"show", "--hosts", directory_.write("empty", "# nobody\n").string()}).status, 2);
}

TEST_F(BmcipFleetTest, LosesNoneWhereSomeHangRefuseOrBreakOff) {
  const RawServer hanging(RawServer::Manner::Hang);
  const RawServer breaking(RawServer::Manner::BreakOff);
  const std::vector<std::string> faulty = {hanging.url(), breaking.url(), "http://127.0.0.1:1", "nowhere.invalid"};
  std::string hosts;
  for (int i = 0; i < 40; ++i) {
    hosts += (i % 10 == 3 ? faulty[static_cast<std::size_t>(i) / 10] : url()) + "\n";
  }
  const auto file = directory_.write("hosts", hosts);
  const auto begin = std::chrono::steady_clock::now();
  const Completed shown = bmcip({"show", "--json", "--timeout", "5", "--parallel", "8", "--hosts", file.string()});
  EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(60));
  EXPECT_EQ(shown.status, 11) << "the hanging one is the worst";
  const std::vector<std::string> lines = linesOf(shown.output);
  ASSERT_THAT(lines, SizeIs(40));
  for (std::size_t i = 0; i < lines.size(); ++i) {
    EXPECT_THAT(lines[i], i % 10 == 3 ? HasSubstr(R"("error":{"kind":)") : HasSubstr(R"("interfaces":[{)")) << i;
    EXPECT_THAT(lines[i], StartsWith(R"({"server":")" + (i % 10 == 3 ? faulty[i / 10] : url()) + "\"")) << i;
  }
  EXPECT_THAT(shown.errors,
              StartsWith("bmcip: 4 of 40 servers failed:\n  " + hanging.url() + ": no answer within 5.0 s"));
  EXPECT_THAT(shown.errors,
              AllOf(HasSubstr("broke the connection off"), HasSubstr("  nowhere.invalid: not reachable")));
}

TEST_F(BmcipFleetTest, NamesWhatFailedInItsRow) {
  const Completed shown = bmcip({"show", "http://127.0.0.1:1", url()});
  EXPECT_EQ(shown.status, 10);
  const std::vector<std::string> lines = linesOf(shown.output);
  ASSERT_THAT(lines, SizeIs(3));
  EXPECT_THAT(lines[1], ContainsRegex("^http://127.0.0.1:1 +failed:unreachable +- +-$"));
  EXPECT_THAT(lines[2], StartsWith(url() + "  eth0="));
  EXPECT_THAT(shown.errors, StartsWith("bmcip: 1 of 2 servers failed:\n  http://127.0.0.1:1: not reachable"));
}

TEST_F(BmcipFleetTest, AsksMoreAtOnceThanTheUsualLimitOfDescriptors) {
  std::string servers;
  for (int i = 0; i < 40; ++i) {
    servers += url() + "\n";
  }
  const auto file = directory_.write("hosts", servers);
  const Completed shown = run(
      {"sh", "-c",
       "ulimit -Sn 24; '" + built("bin/bmcip") + "' show --config /dev/null --parallel 40 --hosts " + file.string()});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_THAT(linesOf(shown.output), SizeIs(41));
}

TEST_F(BmcipFleetTest, ShowsHowFarItIsOnATerminalOnly) {
  const std::string command = built("bin/bmcip") + " show " + url() + " " + url();
  const auto onTerminal = [](const std::string& shown) {
    return run({"script", "-qec", shown, "/dev/null"}, {{"TERM", "xterm"}}).output;
  };
  EXPECT_THAT(onTerminal(command), AllOf(HasSubstr("2/2 servers"), Not(HasSubstr("failed"))));
  EXPECT_THAT(onTerminal(command + " http://127.0.0.1:1"), HasSubstr("3/3 servers, 1 failed"));
  EXPECT_THAT(run({"sh", "-c", command + " 2>&1"}).output, Not(HasSubstr("servers")));
}

}  // namespace
