// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include "tests/bmcip/BmcipTest.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

class BmcipShowTest : public BmcipStackTest {};

TEST_F(BmcipShowTest, PrintsTables) {
  const Completed shown = bmcip({"show"});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_EQ(shown.output,
            "Management processor\n"
            "  NAME  ROLES                              DESCRIPTION\n"
            "  BMC   management, management controller  Simulated management processor\n"
            "\n"
            "IP interfaces\n"
            "  NAME  ADDRESS           MASK           ORIGIN  IPV6             STATE\n"
            "  eth0  192.0.2.10/24     255.255.255.0  static  2001:db8::10/64  enabled\n"
            "  eth1  198.51.100.23/24  255.255.255.0  DHCP    -                enabled\n"
            "\n"
            "Gateways\n"
            "  NAME          ADDRESS\n"
            "  Gateway:eth0  192.0.2.1\n"
            "\n"
            "DNS servers\n"
            "  NAME   ADDRESS\n"
            "  DNS:1  192.0.2.53\n"
            "  DNS:2  2001:db8::53\n");
  EXPECT_THAT(shown.errors, IsEmpty());
}

TEST_F(BmcipShowTest, PrintsJson) {
  const Completed shown = bmcip({"show", "--json"});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_EQ(
      shown.output,
      R"({"server":")" + url() +
          R"(","systems":[{"name":"BMC","description":"Simulated management processor",)"
          R"("roles":["management","management controller"]}],"interfaces":[{"name":"eth0","address":"192.0.2.10",)"
          R"("prefix":24,"mask":"255.255.255.0","origin":"static","ipv6":"2001:db8::10/64",)"
          R"("protocol":"IPv4 and IPv6","state":"enabled"},{"name":"eth1","address":"198.51.100.23","prefix":24,)"
          R"("mask":"255.255.255.0","origin":"DHCP","ipv6":null,"protocol":"IPv4","state":"enabled"}],)"
          R"("gateways":[{"name":"Gateway:eth0","address":"192.0.2.1"}],)"
          R"("dns":[{"name":"DNS:1","address":"192.0.2.53"},{"name":"DNS:2","address":"2001:db8::53"}]})"
          "\n");
}

TEST_F(BmcipShowTest, KeepsToItsSchema) {
  const std::string failed = bmcip({"show", "--json", "http://127.0.0.1:1"}).output;
  const std::string lines = bmcip({"show", "--json"}).output + failed +
                            bmcip({"set", "--json", "--dry-run", "eth0", "192.0.2.77/25"}).output +
                            bmcip({"set", "--json", "eth0", "192.0.2.77/25"}).output +
                            bmcip({"model", "--json"}).output;
  ASSERT_EQ(linesOf(lines).size(), 5U);
  expectSchemaOf(lines);
}

TEST_F(BmcipShowTest, IsColouredOnATerminalThatWantsIt) {
  const std::string command = built("bin/bmcip") + " show --url " + url();
  const auto onTerminal = [&](const std::string& noColour) {
    return run({"script", "-qec", command, "/dev/null"}, {{"TERM", "xterm"}, {"NO_COLOR", noColour}}).output;
  };
  EXPECT_THAT(onTerminal(""), HasSubstr("\033[1mIP interfaces\033[0m"));
  EXPECT_THAT(run({"script", "-qec", command, "/dev/null"}, {{"TERM", "dumb"}}).output, Not(HasSubstr("\033")));
  EXPECT_THAT(onTerminal("1"), AllOf(HasSubstr("IP interfaces"), Not(HasSubstr("\033"))));
  EXPECT_THAT(bmcip({"show"}).output, Not(HasSubstr("\033")));
}

TEST_F(BmcipShowTest, ExplainsItself) {
  const Completed help = bmcip({"--help"});
  EXPECT_EQ(help.status, 0);
  EXPECT_THAT(help.output, AllOf(HasSubstr("--credentials FILE"), HasSubstr("bmcip set eth0 192.0.2.77/25"),
                                 HasSubstr("--dry-run")));
  EXPECT_THAT(bmcip({"show", "--help"}).output, AllOf(HasSubstr("--hosts FILE"), Not(HasSubstr("--svg FILE"))));
  EXPECT_THAT(bmcip({"--version"}).output, StartsWith("bmcip "));
  for (const auto& mistake :
       std::vector<std::vector<std::string>>{{}, {"shw"}, {"show", "--jso"}, {"set"}, {"set", "eth0"}}) {
    const Completed refused = bmcip(mistake);
    EXPECT_EQ(refused.status, 2);
    EXPECT_THAT(refused.output, IsEmpty());
    EXPECT_THAT(refused.errors, StartsWith("bmcip: "));
  }
}

}  // namespace
