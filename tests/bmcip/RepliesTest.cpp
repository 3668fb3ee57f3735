// SPDX-License-Identifier: Apache-2.0
// What is read of a reply's message, and how one that is none is refused.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Paths.h"
#include "bmcip/client/Operations.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace Bmcip;
using testing::HasSubstr;
using testing::SizeIs;

std::string reply(const std::string& content) {
  return "<?xml version=\"1.0\"?><CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\">"
         "<SIMPLERSP><IMETHODRESPONSE NAME=\"X\">" +
         content + "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
}

FailureKind failureOf(const std::string& message) {
  try {
    readInstances(message);
  } catch (const Failure& failure) {
    return failure.kind();
  }
  ADD_FAILURE() << "read: " << message;
  return FailureKind::Error;
}

TEST(RepliesTest, ReadsInstancesWithKeysAndValues) {
  const auto instances = readInstances(reply(
      "<IRETURNVALUE><VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"C\"><KEYBINDING NAME=\"Name\"><KEYVALUE>eth0"
      "</KEYVALUE></KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"C\"><PROPERTY NAME=\"mixedCase\" TYPE=\"string\">"
      "<VALUE>a &amp; b</VALUE></PROPERTY><PROPERTY NAME=\"None\" TYPE=\"string\"/><PROPERTY.ARRAY NAME=\"Many\" "
      "TYPE=\"uint16\"><VALUE.ARRAY><VALUE>14</VALUE><VALUE>28</VALUE></VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE>"
      "</VALUE.NAMEDINSTANCE></IRETURNVALUE>"));
  ASSERT_THAT(instances, SizeIs(1));
  EXPECT_EQ(keyOf(instances[0].path, "name"), "eth0");
  EXPECT_EQ(textOf(instances[0], "MixedCase"), "a & b");
  EXPECT_EQ(textOf(instances[0], "None"), "");
  EXPECT_EQ(textOf(instances[0], "Nowhere"), "");
  EXPECT_EQ(textOf(instances[0], "Many"), "14,28");
}

TEST(RepliesTest, TakesNothingAsNothing) {
  EXPECT_THAT(readInstances(reply("")), SizeIs(0));
  EXPECT_THAT(readInstances(reply("<IRETURNVALUE/>")), SizeIs(0));
  readNothing(reply(""));
  readNothing(reply("<IRETURNVALUE></IRETURNVALUE>"));
}

TEST(RepliesTest, SaysWhatAnErrorMeans) {
  const auto error = [](const std::string& code) {
    return reply("<ERROR CODE=\"" + code + "\" DESCRIPTION=\"because\"/>");
  };
  EXPECT_EQ(failureOf(error("1")), FailureKind::Error);
  EXPECT_EQ(failureOf(error("2")), FailureKind::Login);
  EXPECT_EQ(failureOf(error("3")), FailureKind::NotServed);
  EXPECT_EQ(failureOf(error("5")), FailureKind::NotServed);
  EXPECT_EQ(failureOf(error("4711")), FailureKind::Error);
  EXPECT_THAT(Testing::thrownBy([&] { readNothing(error("1")); }), HasSubstr("CIM status 1, failed: because"));
  EXPECT_THAT(Testing::thrownBy([] { readNothing(reply("<ERROR CODE=\"6\"/>")); }),
              HasSubstr("CIM status 6, not found"));
  EXPECT_THAT(Testing::thrownBy([] { readNothing(reply("<ERROR CODE=\"99\"/>")); }), HasSubstr("CIM status 99"));
}

TEST(RepliesTest, RefusesAValueWhereNoneIsExpected) {
  EXPECT_THAT(Testing::thrownBy([] { readNothing(reply("<IRETURNVALUE><VALUE>1</VALUE></IRETURNVALUE>")); }),
              HasSubstr("is not expected in this reply"));
}

TEST(RepliesTest, RefusesWhatIsNoReply) {
  const std::string instance =
      "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"C\"/><INSTANCE CLASSNAME=\"C\"/></VALUE.NAMEDINSTANCE>";
  for (const std::string& message :
       {std::string(), std::string("<html>Login</html>"), std::string("SSH-2.0"), reply("<IRETURNVALUE>"),
        reply("<IRETURNVALUE><CLASSNAME NAME=\"C\"/></IRETURNVALUE>"), reply("<OTHER/>"), reply("<ERROR/>"),
        reply("<IRETURNVALUE>" + instance + "</IRETURNVALUE>") + "more",
        reply("<IRETURNVALUE><VALUE.NAMEDINSTANCE/></IRETURNVALUE>"),
        std::string("<?xml version=\"1.0\"?><!DOCTYPE CIM [<!ENTITY a \"b\">]><CIM/>"),
        std::string("<CIM>") + std::string(100000, '<'), std::string("<CIM><MESSAGE/></CIM>")}) {
    EXPECT_EQ(failureOf(message), FailureKind::Malformed);
  }
}

TEST(RepliesTest, ReadsNoFileForAnEntity) {
  EXPECT_EQ(failureOf("<?xml version=\"1.0\"?><!DOCTYPE CIM SYSTEM \"file:///etc/passwd\"><CIM>&a;</CIM>"),
            FailureKind::Malformed);
}

TEST(RepliesTest, TellsObjectsByTheirKeysWhateverTheirOrder) {
  const auto name = [](const std::string& keys) {
    return readNames(reply("<IRETURNVALUE><INSTANCENAME CLASSNAME=\"C\">" + keys + "</INSTANCENAME></IRETURNVALUE>"))
        .at(0);
  };
  const std::string a = "<KEYBINDING NAME=\"A\"><KEYVALUE>1</KEYVALUE></KEYBINDING>";
  const std::string b = "<KEYBINDING NAME=\"b\"><KEYVALUE>2</KEYVALUE></KEYBINDING>";
  EXPECT_EQ(identityOf(name(a + b)), identityOf(name(b + a)));
  EXPECT_NE(identityOf(name(a + b)), identityOf(name(a)));
}

TEST(RepliesTest, SendsANameBackAsItCame) {
  const std::string keys =
      "<KEYBINDING NAME=\"Flag\"><KEYVALUE VALUETYPE=\"boolean\">TRUE</KEYVALUE></KEYBINDING>"
      "<KEYBINDING NAME=\"Index\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint16\">7</KEYVALUE></KEYBINDING>"
      "<KEYBINDING NAME=\"Part\"><VALUE.REFERENCE><LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\">"
      "</NAMESPACE><NAMESPACE NAME=\"other\"></NAMESPACE></LOCALNAMESPACEPATH><INSTANCENAME "
      "CLASSNAME=\"D\"><KEYBINDING NAME=\"Name\">"
      "<KEYVALUE VALUETYPE=\"string\">a</KEYVALUE></KEYBINDING></INSTANCENAME></LOCALINSTANCEPATH></VALUE.REFERENCE>"
      "</KEYBINDING>";
  const std::string name = "<INSTANCENAME CLASSNAME=\"C\">" + keys + "</INSTANCENAME>";
  const ObjectName read = readNames(reply("<IRETURNVALUE>" + name + "</IRETURNVALUE>")).at(0);
  EXPECT_THAT(associatorNames("root/cimv2", read, "A").message, HasSubstr(name));
  EXPECT_EQ(identityOf(read), "C,flag=TRUE,index=7,part=D,name=a");
}

TEST(RepliesTest, ReadsTheNamesThatObjectManagersAnswer) {
  for (const std::string objectManager : {"sfcb", "openpegasus"}) {
    const std::string directory = SOURCE_DIR "/tests/bmcip/replies/" + objectManager;
    const auto associators = readNames(Testing::readFile(directory + "/associators.xml"));
    ASSERT_THAT(associators, SizeIs(2)) << objectManager;
    EXPECT_EQ(associators[1].host, "managed.example");
    EXPECT_EQ(identityOf(associators[1]),
              "YRNx_MgmtHwIPProtocolEndPoint,creationclassname=YRNx_MgmtHwIPProtocolEndPoint,name=eth1,"
              "systemcreationclassname=YRNx_MgmtHwComputerSystem,systemname=BMC");
    const auto names = readNames(Testing::readFile(directory + "/names.xml"));
    ASSERT_THAT(names, SizeIs(4)) << objectManager;
    EXPECT_EQ(keyOf(names[3], "InstanceID"), "BMC:eth1:dhcp");
  }
}

TEST(RepliesTest, WritesHostileNamesAsText) {
  const Call call = enumerateInstances("root/<a>&\"", "C\"/>");
  EXPECT_THAT(call.message, HasSubstr("<NAMESPACE NAME=\"&lt;a&gt;&amp;&quot;\">"));
  EXPECT_THAT(call.message, HasSubstr("<CLASSNAME NAME=\"C&quot;/&gt;\">"));
}

}  // namespace
