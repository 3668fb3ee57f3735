// SPDX-License-Identifier: Apache-2.0
// What sfcb 1.3.18 and OpenPegasus 2.14.4 answered over HTTP with the product in them, each in its own spelling: both
// are read as cimomd is.
#include <gmock/gmock.h>

#include <string_view>

#include "tests/bmcip/BmcipTest.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

class RecordedRepliesTest : public BmcipTest, public testing::WithParamInterface<const char*> {
 protected:
  RecordedServer server_{GetParam()};
};

TEST_P(RecordedRepliesTest, AreShown) {
  const Completed shown = bmcip({"show", "--url", server_.url()});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_THAT(shown.output,
              AllOf(HasSubstr("  BMC   management, management controller  Simulated management processor\n"),
                    HasSubstr("  eth0  192.0.2.10/24     255.255.255.0  static  2001:db8::10/64  enabled\n"),
                    HasSubstr("  eth1  198.51.100.23/24  255.255.255.0  DHCP    -                enabled\n"),
                    HasSubstr("  Gateway:eth0  192.0.2.1\n"), HasSubstr("  DNS:2  2001:db8::53\n")));
}

// Of the kinds that no management processor here has.
TEST_P(RecordedRepliesTest, AreShownWhateverKindOfAccessPointTheyHave) {
  server_.alter([](std::string& message) {
    std::size_t place = 0;
    for (const char* other : {"", "NTP server", ""}) {
      place = message.find("\"OtherAccessContext\"", place + 1);
      if (place == std::string::npos) {
        return;  // the reply of another class
      }
      message.insert(message.find("</PROPERTY>", place), "<VALUE>" + std::string(other) + "</VALUE>");
    }
    place = 0;
    for (const char code : {'1', '1', '4'}) {
      place = message.find("\"AccessContext\"", place + 1);
      message[message.find("<VALUE>", place) + std::string_view("<VALUE>").size()] = code;
    }
  });
  const Completed shown = bmcip({"show", "--url", server_.url()});
  EXPECT_EQ(shown.status, 0) << shown.errors;
  EXPECT_THAT(shown.output, AllOf(HasSubstr("Other access points\n"
                                            "  NAME          ADDRESS       KIND\n"
                                            "  Gateway:eth0  192.0.2.1     other\n"
                                            "  DNS:1         192.0.2.53    NTP server\n"
                                            "  DNS:2         2001:db8::53  SNMP trap destination\n"),
                                  Not(HasSubstr("Gateways")), Not(HasSubstr("DNS servers"))));
}

TEST_P(RecordedRepliesTest, AreAChangeThatShows) {
  server_.alter([this](std::string&) {
    if (server_.requests().size() == 4) {
      server_.answer("YRNx_MgmtHwIPProtocolEndPoint", "endpoints-modified");
    }
  });
  const Completed changed = bmcip({"set", "eth0", "192.0.2.77/25", "--url", server_.url()});
  EXPECT_EQ(changed.status, 0) << changed.errors;
  EXPECT_THAT(server_.requests().at(3), HasSubstr("<VALUE>192.0.2.77</VALUE>"));
}

TEST_P(RecordedRepliesTest, SayWhatIsNotServed) {
  server_.answer("YRNx_MgmtHwComputerSystem", "no-class");
  const Completed noClass = bmcip({"show", "--url", server_.url()});
  EXPECT_EQ(noClass.status, 14);
  EXPECT_THAT(noClass.errors, AllOf(HasSubstr("no such class"), HasSubstr("compositeipconfig-register")));
  server_.answer("YRNx_MgmtHwComputerSystem", "no-namespace");
  const Completed noNameSpace = bmcip({"show", "--url", server_.url()});
  EXPECT_EQ(noNameSpace.status, 14);
  EXPECT_THAT(noNameSpace.errors, HasSubstr("no such namespace"));
  // The class is there, and nobody who knows its instances.
  server_.answer("YRNx_MgmtHwComputerSystem", "modified");
  EXPECT_EQ(bmcip({"show", "--url", server_.url()}).status, 0);
  server_.answer("YRNx_MgmtHwIPProtocolEndPoint", "modified");
  const Completed nothing = bmcip({"show", "--url", server_.url()});
  EXPECT_EQ(nothing.status, 14);
  EXPECT_THAT(nothing.errors, AllOf(HasSubstr("shows no management processor"), HasSubstr("root/yrnse")));
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, RecordedRepliesTest, testing::Values("sfcb", "openpegasus"),
                         [](const auto& row) { return std::string(row.param); });

}  // namespace
