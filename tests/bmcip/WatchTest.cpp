// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include <csignal>

#include "tests/bmcip/BmcipTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Pattern.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ContainsRegex;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

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

// A management processor on which something happens from look to look: what is altered in the recorded replies.
class BmcipWatchAnswersTest : public BmcipTest {
 protected:
  BmcipWatchAnswersTest() {
    server_.alter([this](std::string& message) { alter(message); });
  }

  // What is written until its reader has seen so many lines and goes away. Each look after the last that is scripted
  // changes something, so that the next line fails.
  Completed watchedBy(const std::string& reader, const std::string& options = "") {
    return run({"bash", "-c",
                "set -o pipefail; '" + built("bin/bmcip") + "' watch --config /dev/null --url " + server_.url() +
                    " --interval 0.1 " + options + " | " + reader});
  }

 private:
  void alter(std::string& message) {
    if (server_.requests().back().find("<CLASSNAME NAME=\"YRNx_MgmtHwComputerSystem\"") != std::string::npos) {
      ++looks_;
    }
    switch (looks_) {
      case 1:
        break;
      case 2:
        replace(message, "192.0.2.10<", "192.0.2.77<");
        break;
      case 3:
        replace(message, "eth1", "eth2");
        break;
      case 4:
        message = "<CIM/>";
        break;
      case 5:
        message = "<html/>";
        break;
      default:
        replace(message, "192.0.2.53<", "192.0.2." + std::to_string(looks_ % 2) + "<");
    }
  }

  static void replace(std::string& message, const std::string& from, const std::string& to) {
    for (auto place = message.find(from); place != std::string::npos; place = message.find(from, place + to.size())) {
      message.replace(place, from.size(), to);
    }
  }

  RecordedServer server_{"sfcb"};
  int looks_ = 0;
};

TEST_F(BmcipWatchAnswersTest, PrintsWhatChangesComesGoesAndFails) {
  const Completed watched = watchedBy("head -n 21");
  EXPECT_THAT(
      linesOf(Pattern("(^|\n)[-0-9]+T[0-9:]+[+-][0-9:]+  ").replaced(watched.output, "$1")),
      ElementsAre("eth0 address: 192.0.2.10 -> 192.0.2.77", "eth0 address: 192.0.2.77 -> 192.0.2.10",
                  "eth2 address: - -> 198.51.100.23", "eth2 mask: - -> 255.255.255.0", "eth2 origin: - -> DHCP",
                  "eth2 state: - -> enabled", "eth1 address: 198.51.100.23 -> -", "eth1 mask: 255.255.255.0 -> -",
                  "eth1 origin: DHCP -> -", "eth1 state: enabled -> -",
                  StartsWith("server: answering -> the reply is not what CIM-XML knows"),
                  AllOf(StartsWith("server: the reply is not what CIM-XML knows"), HasSubstr("must be CIM")),
                  AllOf(HasSubstr("must be CIM"), HasSubstr(" -> answering")), "eth1 address: - -> 198.51.100.23",
                  "eth1 mask: - -> 255.255.255.0", "eth1 origin: - -> DHCP", "eth1 state: - -> enabled",
                  "DNS server DNS:1: 192.0.2.53 -> 192.0.2.0", "eth2 address: 198.51.100.23 -> -",
                  "eth2 mask: 255.255.255.0 -> -", "eth2 origin: DHCP -> -"));
}

TEST_F(BmcipWatchAnswersTest, EndsWhenNobodyReadsAnyMore) {
  const Completed watched = watchedBy("head -n 1", "--json");
  EXPECT_EQ(watched.status, 1);
  EXPECT_THAT(watched.output, ContainsRegex(R"(^\{"time":"[-0-9]+T[0-9:]+[+-][0-9:]+","server":"http://[0-9.:]+",)"
                                            R"("what":"eth0 address","before":"192.0.2.10","after":"192.0.2.77"\})"));
  expectSchemaOf(watched.output);
}

TEST_F(BmcipWatchTest, FailsWhereThereIsNothingToWatch) {
  EXPECT_EQ(bmcip({"watch", "--url", "http://127.0.0.1:1"}).status, 10);
}

}  // namespace
