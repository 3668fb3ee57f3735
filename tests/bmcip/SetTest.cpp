// SPDX-License-Identifier: Apache-2.0
// A change, and the truth about it.
#include <gmock/gmock.h>

#include <filesystem>

#include "tests/bmcip/BmcipTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

class BmcipSetTest : public BmcipStackTest {};

TEST_F(BmcipSetTest, ChangesAndReadsBack) {
  const Completed changed = bmcip({"set", "eth0", "192.0.2.77/25"});
  EXPECT_EQ(changed.status, 0) << changed.errors;
  EXPECT_EQ(changed.output,
            "eth0    ADDRESS     MASK             ORIGIN\n"
            "before  192.0.2.10  255.255.255.0    static\n"
            "now     192.0.2.77  255.255.255.128  static\n"
            "applied: the management processor shows the new values\n");
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.77"));
}

TEST_F(BmcipSetTest, ChangesAddressOrMaskAlone) {
  EXPECT_EQ(bmcip({"set", "eth0", "--address", "192.0.2.78"}).status, 0);
  EXPECT_EQ(bmcip({"set", "eth0", "--mask", "255.255.255.128"}).status, 0);
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.78"));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("SubnetMask"), quoted("255.255.255.128"));
  EXPECT_EQ(bmcip({"set", "eth0", "192.0.2.79", "--mask", "255.255.255.0"}).status, 0);
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("SubnetMask"), quoted("255.255.255.0"));
}

TEST_F(BmcipSetTest, MakesALeasedAddressAStaticOne) {
  EXPECT_EQ(bmcip({"set", "eth1", "198.51.100.23/24"}).status, 0);
  EXPECT_EQ(stack_.get(endpoint("eth1")).at("AddressOrigin"), "3");
}

TEST_F(BmcipSetTest, SendsNothingWhereNothingIsToDo) {
  bmcip({"set", "eth0", "192.0.2.77/25"});
  const std::string before = state();
  const Completed again = bmcip({"set", "--json", "eth0", "192.0.2.77/25"});
  EXPECT_EQ(again.status, 0);
  EXPECT_THAT(again.output, AllOf(HasSubstr(R"("outcome":"unchanged","changed":false)")));
  EXPECT_EQ(state(), before);
}

TEST_F(BmcipSetTest, ShowsWhatItWouldSend) {
  const std::string before = stack_.get(endpoint("eth0")).at("IPv4Address");
  const Completed dry = bmcip({"set", "eth0", "192.0.2.77/25", "--dry-run"});
  EXPECT_EQ(dry.status, 0) << dry.errors;
  EXPECT_THAT(dry.output,
              AllOf(HasSubstr("wanted  192.0.2.77  255.255.255.128  static"), HasSubstr("ModifyInstance to " + url()),
                    HasSubstr("<VALUE>192.0.2.77</VALUE>"), HasSubstr("nothing was sent")));
  EXPECT_THAT(bmcip({"set", "eth0", "192.0.2.77/25", "--dry-run", "--json"}).output,
              HasSubstr(R"("outcome":"would-change","changed":true)"));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), before);
}

TEST_F(BmcipSetTest, RefusesMistakesBeforeAnythingIsSent) {
  const auto refused = [this](std::vector<std::string> arguments, const std::string& reason) {
    arguments.insert(arguments.begin(), "set");
    const Completed completed = bmcip(arguments);
    EXPECT_EQ(completed.status, 2) << reason;
    EXPECT_THAT(completed.output, IsEmpty());
    EXPECT_THAT(completed.errors, AllOf(StartsWith("bmcip: "), HasSubstr(reason)));
  };
  refused({"eth0", "127.0.0.1/8"}, "loopback");
  refused({"eth0", "192.0.2.77/33"}, "must be a number from 1 to 31");
  refused({"eth0", "192.0.2.0/24"}, "192.0.2.0");
  refused({"eth0", "192.0.2.255"}, "broadcast");
  refused({"eth9", "192.0.2.77/25"}, "it must be one of eth0, eth1");
  refused({"eth0", "192.0.2.77/25", "--mask", "255.255.255.0"}, "twice");
  refused({"eth0", "192.0.2.77/25", "--wait", "long"}, "--wait: ");
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
}

TEST_F(BmcipSetTest, SaysThatAChangeWasIgnored) {
  ASSERT_EQ(bmcip({"show"}).status, 0);
  // The agent cannot lock the state and refuses; the object manager says OK all the same.
  std::filesystem::remove(directory_ / "processor.json.lock");
  std::filesystem::create_directory(directory_ / "processor.json.lock");
  const Completed ignored = bmcip({"set", "eth0", "192.0.2.77/25", "--wait", "0.3"});
  EXPECT_EQ(ignored.status, 4);
  EXPECT_THAT(ignored.output, AllOf(HasSubstr("wanted  192.0.2.77"), HasSubstr("now     192.0.2.10")));
  EXPECT_THAT(ignored.errors, AllOf(StartsWith("bmcip: not applied: the object manager accepted the change"),
                                    HasSubstr("log of the management agent")));
  EXPECT_THAT(stack_.log(), HasSubstr("processor.json.lock cannot be opened"));
}

// What no real part can be made to do at will, with an object manager that replays.
class BmcipSetAnswersTest : public BmcipTest {
 protected:
  Completed set(std::vector<std::string> more = {}) {
    more.insert(more.begin(), {"set", "eth0", "192.0.2.77/25", "--url", server_.url(), "--wait", "0.3"});
    return bmcip(more);
  }

  RecordedServer server_{"sfcb"};
};

TEST_F(BmcipSetAnswersTest, SaysThatAChangeWasRefused) {
  server_.answer("ModifyInstance", "refused");
  const Completed refused = set();
  EXPECT_EQ(refused.status, 3);
  EXPECT_THAT(refused.errors, AllOf(StartsWith("bmcip: refused: "), HasSubstr("not supported")));
  EXPECT_THAT(refused.output, HasSubstr("now     192.0.2.10"));
}

TEST_F(BmcipSetAnswersTest, TakesAnErrorForARefusalAndNoAnswerForNone) {
  struct Row {
    const char* code;
    const char* outcome;
    const char* says;
  };
  for (const Row& row : {Row{"1", "refused", "CIM status 1, failed"}, Row{"2", "refused", "this login may not do that"},
                         Row{"3", "refused", "the server has no such namespace"}, Row{"", "ignored", "CODE"}}) {
    const std::size_t before = server_.requests().size();
    server_.alter([&, before](std::string& message) {
      if (server_.requests().size() == before + 4) {
        message =
            "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP>"
            "<IMETHODRESPONSE NAME=\"ModifyInstance\"><ERROR" +
            (*row.code ? " CODE=\"" + std::string(row.code) + "\"" : "") +
            "/></IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
      }
    });
    EXPECT_THAT(set({"--json"}).output, AllOf(HasSubstr("\"outcome\":\"" + std::string(row.outcome) + "\""),
                                              HasSubstr(row.says), HasSubstr(R"("after":{"address":"192.0.2.10",)")));
  }
}

TEST_F(BmcipSetAnswersTest, SaysThatTheInterfaceIsNotThereOrNoLonger) {
  server_.alter([this](std::string&) {
    if (server_.requests().size() == 4) {
      server_.answer("YRNx_MgmtHwIPProtocolEndPoint", "modified");
    }
  });
  const Completed gone = set({"--json"});
  EXPECT_EQ(gone.status, 6);
  EXPECT_THAT(gone.output, AllOf(HasSubstr(R"("outcome":"unknown","changed":false)"), HasSubstr(R"("after":null)"),
                                 HasSubstr("no longer shows the interface")));
  const Completed none = set();
  EXPECT_EQ(none.status, 2);
  EXPECT_THAT(none.errors, HasSubstr("there is no interface eth0: the management processor shows none"));
}

TEST_F(BmcipSetAnswersTest, SaysThatAChangeIsHalfThere) {
  server_.alter([this](std::string& message) {
    if (const auto found = message.find("192.0.2.10"); server_.requests().size() > 4 && found != std::string::npos) {
      message.replace(found, 10, "192.0.2.77");
    }
  });
  const Completed half = set();
  EXPECT_EQ(half.status, 5) << half.errors;
  EXPECT_THAT(half.errors, StartsWith("bmcip: half applied: "));
  EXPECT_THAT(half.output, HasSubstr("now     192.0.2.77  255.255.255.0 "));
}

TEST_F(BmcipSetAnswersTest, SaysThatNobodyKnows) {
  server_.alter([this](std::string& message) {
    if (server_.requests().size() > 4) {
      message = "<CIM/>";
    }
  });
  const Completed unknown = set();
  EXPECT_EQ(unknown.status, 6);
  EXPECT_THAT(unknown.errors, AllOf(StartsWith("bmcip: unknown: the change was sent"), HasSubstr("look again")));
  EXPECT_THAT(unknown.output, Not(HasSubstr("now")));
}

TEST_F(BmcipSetAnswersTest, TakesAChangeThatShowsForApplied) {
  server_.alter([this](std::string&) {
    if (server_.requests().size() == 4) {
      server_.answer("YRNx_MgmtHwIPProtocolEndPoint", "endpoints-modified");
    }
  });
  EXPECT_EQ(set().status, 0);
}

TEST_F(BmcipSetAnswersTest, AsksBeforeItCutsItsOwnConnection) {
  server_.alter([](std::string& message) {
    if (const auto found = message.find("192.0.2.10"); found != std::string::npos) {
      message.replace(found, 10, "127.0.0.1");
    }
  });
  const Completed unasked = set();
  EXPECT_EQ(unasked.status, 7);
  EXPECT_THAT(unasked.errors, AllOf(HasSubstr("127.0.0.1, the address of eth0"), HasSubstr("--yes")));
  EXPECT_EQ(server_.requests().size(), 3U);
  const std::string command = built("bin/bmcip") + " set eth0 192.0.2.77/25 --wait 0 --connect-timeout 0.2 --url ";
  const auto answering = [&](const std::string& answer) {
    return run({"sh", "-c", "echo " + answer + " | script -qec '" + command + server_.url() + "' /dev/null"}).output;
  };
  EXPECT_THAT(answering("n"), AllOf(HasSubstr("Change it? [y/N]"), HasSubstr("nothing was sent")));
  EXPECT_EQ(server_.requests().size(), 6U);
  // The read-back goes to the new address, which is nobody's here.
  EXPECT_THAT(answering("y"), HasSubstr("unknown: the change was sent"));
  EXPECT_EQ(server_.requests().size(), 10U);
  EXPECT_THAT(answering("Y"), HasSubstr("unknown: the change was sent"));
  EXPECT_THAT(answering("yes"), HasSubstr("unknown: the change was sent"));
  EXPECT_THAT(answering("yeah"), HasSubstr("nothing was sent"));
  EXPECT_EQ(set({"--yes", "--connect-timeout", "0.2"}).status, 6);
}

}  // namespace
