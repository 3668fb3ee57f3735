// SPDX-License-Identifier: Apache-2.0
// cimomd with the composite where something is missing, and what only a hand-made request can ask.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <future>

#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/client/HttpClient.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::SizeIs;

class CompositeServerTest : public testing::Test {
 protected:
  std::string processor() const { return simulatedProcessor(directory_.path() / "processor.json"); }

  TemporaryDirectory directory_;
};

class RawRequestTest : public CompositeServerTest {
 protected:
  // A GetInstance, ModifyInstance and the like, whose parameters are given as they stand in the message.
  std::string call(const std::string& method, const std::string& parameters) {
    HttpClient client(stack_.cimomd().port());
    return client
        .post("/cimom",
              "<?xml version=\"1.0\"?><CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" "
              "PROTOCOLVERSION=\"1.0\"><SIMPLEREQ><IMETHODCALL NAME=\"" +
                  method +
                  "\"><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"cimv2\"/></LOCALNAMESPACEPATH>" +
                  parameters + "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>",
              "Content-Type: application/xml; charset=\"utf-8\"\r\nCIMOperation: MethodCall\r\nCIMMethod: " + method +
                  "\r\nCIMObject: root%2Fcimv2\r\n")
        .body;
  }

  static std::string parameter(const std::string& name, const std::string& value) {
    return "<IPARAMVALUE NAME=\"" + name + "\">" + value + "</IPARAMVALUE>";
  }

  static std::string instanceName(const std::string& className, const std::string& keys) {
    return "<INSTANCENAME CLASSNAME=\"" + className + "\">" + keys + "</INSTANCENAME>";
  }

  static std::string key(const std::string& name, const std::string& value) {
    return "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE VALUETYPE=\"string\">" + value + "</KEYVALUE></KEYBINDING>";
  }

  static std::string property(const std::string& name, const std::string& value) {
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\"><VALUE>" + value + "</VALUE></PROPERTY>";
  }

  // ModifyInstance of eth0's static settings, without what a client that reads first would send back.
  std::string modifyStatic(const std::string& interface, const std::string& properties) {
    const std::string className = "YRNx_MgmtHwStaticIPAssignmentSettingData";
    return call(
        "ModifyInstance",
        parameter("ModifiedInstance",
                  "<VALUE.NAMEDINSTANCE>" + instanceName(className, key("InstanceID", "BMC:" + interface)) +
                      "<INSTANCE CLASSNAME=\"" + className + "\">" + properties + "</INSTANCE></VALUE.NAMEDINSTANCE>"));
  }

  explicit RawRequestTest(const std::vector<std::string>& options = {}) : stack_(processor(), 6000, options) {}

  CompositeStack stack_;
};

// The same where cimomd checks no more than other object managers do.
class BareRequestTest : public RawRequestTest {
 protected:
  BareRequestTest() : RawRequestTest(CompositeStack::bare()) {}
};

TEST_F(RawRequestTest, ToGetAnInstanceWithoutKeysFailsAsTheProviderSays) {
  for (const char* className : {"YRNx_MgmtHwComputerSystem", "YRNx_MgmtHwIPProtocolEndPoint",
                                "YRNx_MgmtHwIPAssignmentSettingSequence", "YRNx_MgmtHwStaticIPAssignmentSettingData",
                                "YRNx_MgmtHwDHCPAssignmentSettingData", "YRNx_MgmtHwRemoteServiceAccessPoint"}) {
    EXPECT_THAT(call("GetInstance", parameter("InstanceName", instanceName(className, ""))),
                AllOf(HasSubstr("<ERROR CODE=\"1\""), HasSubstr("At least one key should be passed")))
        << className;
  }
  // An association's provider finds nothing, and says why in the log.
  EXPECT_THAT(call("GetInstance", parameter("InstanceName", instanceName("YRNx_MgmtHwClientAccess", ""))),
              HasSubstr("<ERROR CODE=\"6\""));
  EXPECT_THAT(stack_.log(), HasSubstr("At least one key should be passed"));
}

TEST_F(RawRequestTest, WithSomeOfTheKeysFindsNothing) {
  EXPECT_THAT(call("GetInstance",
                   parameter("InstanceName", instanceName("YRNx_MgmtHwIPProtocolEndPoint", key("Name", "eth0")))),
              HasSubstr("<ERROR CODE=\"6\""));
}

TEST_F(RawRequestTest, ToModifyOneValueNeedsNoOther) {
  EXPECT_THAT(modifyStatic("eth0", property("SubnetMask", "255.255.0.0")), Not(HasSubstr("<ERROR")));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("SubnetMask"), quoted("255.255.0.0"));
  EXPECT_THAT(modifyStatic("eth0", property("IPv4Address", "192.0.2.77")), Not(HasSubstr("<ERROR")));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.77"));
}

TEST_F(RawRequestTest, ToModifyAnUnknownInterfaceIsRefused) {
  stack_.names("ein", "YRNx_MgmtHwComputerSystem");
  const std::string before = contentOf(directory_.path() / "processor.json");
  for (const char* interface : {"eth9", "eth0:static"}) {
    EXPECT_THAT(modifyStatic(interface, property("IPv4Address", "192.0.2.77")), HasSubstr("<ERROR CODE=\"6\""));
  }
  EXPECT_EQ(contentOf(directory_.path() / "processor.json"), before);
}

TEST_F(RawRequestTest, ToModifyUnderAnotherKeyIsRefused) {
  EXPECT_THAT(modifyStatic("eth0", property("InstanceID", "BMC:eth1") + property("IPv4Address", "192.0.2.77")),
              HasSubstr("<ERROR CODE=\"4\" DESCRIPTION=\"key InstanceID of the instance is &quot;BMC:eth1&quot;"));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  EXPECT_EQ(stack_.get(endpoint("eth1")).at("IPv4Address"), quoted("198.51.100.23"));
}

TEST_F(RawRequestTest, ToModifyChangesNothingThatThePropertyListDoesNotName) {
  const std::string className = "YRNx_MgmtHwStaticIPAssignmentSettingData";
  const auto modifyListed = [&](const std::string& listed) {
    return call("ModifyInstance",
                parameter("ModifiedInstance",
                          "<VALUE.NAMEDINSTANCE>" + instanceName(className, key("InstanceID", "BMC:eth0")) +
                              "<INSTANCE CLASSNAME=\"" + className + "\">" + property("IPv4Address", "192.0.2.77") +
                              property("SubnetMask", "255.255.0.0") + "</INSTANCE></VALUE.NAMEDINSTANCE>") +
                    parameter("PropertyList", "<VALUE.ARRAY><VALUE>" + listed + "</VALUE></VALUE.ARRAY>"));
  };
  EXPECT_THAT(modifyListed("Undeclared"), HasSubstr("<ERROR CODE=\"12\""));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  EXPECT_THAT(modifyListed("SubnetMask"), Not(HasSubstr("<ERROR")));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("SubnetMask"), quoted("255.255.0.0"));
}

TEST_F(RawRequestTest, ToModifyWhatCannotBeReadFails) {
  directory_.write("processor.json", "[]");
  EXPECT_THAT(modifyStatic("eth0", property("IPv4Address", "192.0.2.77")), HasSubstr("<ERROR CODE=\"1\""));
}

TEST_F(BareRequestTest, ToModifyWhatCannotBeReadIsAcceptedAllTheSame) {
  directory_.write("processor.json", "[]");
  EXPECT_THAT(modifyStatic("eth0", property("IPv4Address", "192.0.2.77")), Not(HasSubstr("<ERROR")));
  EXPECT_EQ(contentOf(directory_.path() / "processor.json"), "[]");
}

TEST_F(BareRequestTest, ToModifyAnUnknownInterfaceIsAcceptedWithoutEffect) {
  stack_.names("ein", "YRNx_MgmtHwComputerSystem");
  const std::string before = contentOf(directory_.path() / "processor.json");
  EXPECT_THAT(modifyStatic("eth9", property("IPv4Address", "192.0.2.77")), Not(HasSubstr("<ERROR")));
  EXPECT_THAT(modifyStatic("eth0:static", property("IPv4Address", "192.0.2.77")), Not(HasSubstr("<ERROR")));
  EXPECT_EQ(contentOf(directory_.path() / "processor.json"), before);
}

TEST_F(RawRequestTest, WithAnUndeclaredPropertyIsRefusedWhole) {
  EXPECT_THAT(modifyStatic("eth0", property("IPv4Address", "192.0.2.77") + property("Undeclared", "1")),
              AllOf(HasSubstr("<ERROR CODE=\"12\""), HasSubstr("Undeclared")));
  EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
}

TEST_F(RawRequestTest, WithoutAUsableValueChangesNothing) {
  stack_.names("ein", "YRNx_MgmtHwComputerSystem");
  const std::string before = contentOf(directory_.path() / "processor.json");
  for (const std::string& value :
       {std::string("<PROPERTY NAME=\"IPv4Address\" TYPE=\"string\"></PROPERTY>"), property("IPv4Address", ""),
        std::string("<PROPERTY NAME=\"IPv4Address\" TYPE=\"uint16\"><VALUE>7</VALUE></PROPERTY>"),
        std::string("<PROPERTY.ARRAY NAME=\"IPv4Address\" TYPE=\"string\"><VALUE.ARRAY><VALUE>192.0.2.77</VALUE>"
                    "</VALUE.ARRAY></PROPERTY.ARRAY>"),
        property("IPv4Address", std::string(100'000, '1')), property("IPv4Address", "192.0.2.77&#x202e;")}) {
    modifyStatic("eth0", value);
    EXPECT_EQ(contentOf(directory_.path() / "processor.json"), before) << value.substr(0, 100);
    EXPECT_EQ(stack_.get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  }
}

// The classes of that library fail with the reason; what does not need it is served.
TEST_F(CompositeServerTest, ServesTheOthersWithoutTheLibraryOfAProvider) {
  for (const char* missing : {"libcompositeipconfigprovider.so", "libunderlyingipconfigprovider.so"}) {
    const TemporaryDirectory providers;
    for (const char* present : {"libcompositeipconfigprovider.so", "libunderlyingipconfigprovider.so"}) {
      if (std::string(present) != missing) {
        std::filesystem::create_symlink(built("lib/") + present, providers.path() / present);
      }
    }
    std::vector<std::string> options = CompositeStack::options();
    options.back() = providers.path().string();
    Cimomd cimomd(options, {{"QV_AGENT_INI", directory_.write("agent.ini", processor()).string()}});
    EXPECT_THAT(cimomd.process().errors(), HasSubstr(missing));
    const Completed failed = run({"wbemcli", "ein", cimomd.url("YRNx_MgmtHwComputerSystem", "root/cimv2")});
    EXPECT_NE(failed.status, 0);
    const Completed served = run({"wbemcli", "ein", cimomd.url("CIM_Namespace", "root/interop")});
    EXPECT_EQ(served.status, 0) << served.errors;
    EXPECT_EQ(cimomd.stop(), 0);
  }
}

TEST_F(CompositeServerTest, AnswersAnErrorWhereNoUnderlyingProviderIsRegistered) {
  const Cimomd cimomd({"--schema", built("share/cimomd"), "--registration", built("share/cimomd/CompositeIPConfig.reg"),
                       "--provider-dir", built("lib")},
                      {{"QV_AGENT_INI", directory_.write("agent.ini", "[log]\ndestination = off\n").string()}});
  const Completed completed = run({"wbemcli", "ei", cimomd.url("YRNx_MgmtHwIPProtocolEndPoint", "root/cimv2")});
  EXPECT_NE(completed.status, 0);
  EXPECT_THAT(completed.errors, HasSubstr("CIM_ERR_INVALID_NAMESPACE"));
}

TEST_F(CompositeServerTest, SaysWhatIsWrongWithTheAgentsConfiguration) {
  const auto ini = directory_.write("agent.ini", "[log]\ndestination = nowhere\n");
  const Cimomd cimomd(CompositeStack::options(), {{"QV_AGENT_INI", ini.string()}});
  const Completed completed = run({"wbemcli", "ei", cimomd.url("YRNx_MgmtHwIPProtocolEndPoint", "root/cimv2")});
  EXPECT_NE(completed.status, 0);
  EXPECT_THAT(completed.errors, HasSubstr("agent.ini:2"));
}

TEST_F(CompositeServerTest, InventsNoManagementProcessorWhereNoneIsChosen) {
  // What the requests are answered, and what the administrator finds.
  const auto answers = [](const Cimomd& cimomd, const std::string& sentence) {
    for (const char* className : {"YRNx_MgmtHwComputerSystem", "YRNx_MgmtHwIPProtocolEndPoint",
                                  "YRNx_MgmtHwIPAssignmentSettingSequence", "YRNx_MgmtHwRemoteServiceAccessPoint"}) {
      const Completed completed = run({"wbemcli", "ei", cimomd.url(className, "root/cimv2")});
      EXPECT_NE(completed.status, 0) << className;
      EXPECT_EQ(completed.output, "") << className;
      EXPECT_THAT(completed.errors, HasSubstr(sentence)) << className;
    }
  };
  {
    const std::string missing = directory_ / "none.ini";
    Cimomd cimomd(CompositeStack::options(), {{"QV_AGENT_INI", missing}});
    const std::string sentence = missing + ": cannot be opened: No such file or directory; create it and choose";
    answers(cimomd, sentence);
    EXPECT_THAT(cimomd.process().errors(), HasSubstr(sentence)) << "it shows at the start already";
  }
  const std::string log = directory_ / "agent.log";
  const auto ini = directory_.write("agent.ini", "[log]\ndestination = file\nfile = " + log + '\n');
  const Cimomd cimomd(CompositeStack::options(), {{"QV_AGENT_INI", ini.string()}});
  const std::string sentence = ini.string() + ": [processor] has no key 'backend'";
  EXPECT_THAT(contentOf(log), HasSubstr(sentence)) << "it shows at the start already";
  answers(cimomd, sentence);
}

TEST_F(CompositeServerTest, SaysAtItsStartThatTheStateCannotBeWritten) {
  const std::string log = directory_ / "agent.log";
  const auto ini = directory_.write(
      "agent.ini", "[log]\ndestination = file\nfile = " + log + '\n' + simulatedProcessor("/proc/none/processor.json"));
  const Cimomd cimomd(CompositeStack::options(), {{"QV_AGENT_INI", ini.string()}});
  EXPECT_THAT(contentOf(log), HasSubstr("/proc/none: cannot be created: "));
  EXPECT_THAT(contentOf(log), HasSubstr("name another file with state in [simulated] of agent.ini"));
}

TEST_F(CompositeServerTest, LogsOnceThatItsManagementProcessorIsSimulated) {
  const std::string log = directory_ / "agent.log";
  const auto ini = directory_.write("agent.ini", "[log]\ndestination = file\nfile = " + log + '\n' + processor());
  const Cimomd cimomd(CompositeStack::options(), {{"QV_AGENT_INI", ini.string()}});
  for (int i = 0; i < 3; ++i) {
    run({"wbemcli", "ei", cimomd.url("YRNx_MgmtHwIPProtocolEndPoint", "root/cimv2")});
  }
  EXPECT_THAT(linesOf(contentOf(log)),
              ElementsAre(AllOf(HasSubstr(" 6000 Tarnwick.SimulatedProcessor "), HasSubstr("its values are made up"))));
}

TEST_F(CompositeServerTest, ShowsNothingOfTheHostUnlessAgentIniAsksForIt) {
  const auto ini =
      directory_.write("agent.ini", "[log]\ndestination = off\n[system]\nname = managed.example\n" + processor());
  const Cimomd cimomd(CompositeStack::options(), {{"QV_AGENT_INI", ini.string()}});
  for (const char* className :
       {"YRNQV_IPProtocolEndpoint", "YRNQV_IPAssignmentSettingData", "YRNQV_StaticIPAssignmentSettingData",
        "YRNQV_DHCPSettingData", "YRNQV_IPRemoteServiceAccessPoint"}) {
    const Completed completed = run({"wbemcli", "ein", cimomd.url(className, "root/yrnse")});
    EXPECT_EQ(completed.status, 0) << completed.errors;
    EXPECT_THAT(completed.output, AllOf(HasSubstr("eth0"), Not(HasSubstr("\"lo\"")), Not(HasSubstr("Host:")),
                                        Not(HasSubstr("managed.example\","))))
        << className;
  }
}

TEST_F(CompositeServerTest, AnswersManyClientsAtOnceAlike) {
  const CompositeStack stack(processor());
  const std::vector<std::string> expected = stack.paths("ein", "YRNx_MgmtHwClientAccess");
  ASSERT_THAT(expected, SizeIs(6));
  std::vector<std::future<std::vector<std::string>>> clients;
  for (int i = 0; i < 16; ++i) {
    clients.push_back(std::async(std::launch::async, [&] { return stack.paths("ein", "YRNx_MgmtHwClientAccess"); }));
  }
  for (auto& client : clients) {
    EXPECT_EQ(client.get(), expected);
  }
}

TEST_F(CompositeServerTest, EndsCleanlyAfterRequests) {
  CompositeStack stack(processor());
  stack.instances("ei", "YRNx_MgmtHwIPElementSettingData");
  EXPECT_EQ(stack.cimomd().stop(), 0);
  EXPECT_EQ(stack.cimomd().process().errors(), "");
}

// A client that knows nothing but the address finds the server's namespaces, its profiles and what conforms to them.
TEST_F(RawRequestTest, TheInteropNamespaceLeadsToTheInstances) {
  std::vector<std::string> namespaces;
  for (const Printed& one : stack_.instances("ei", "CIM_Namespace", {}, "root/interop")) {
    namespaces.push_back(one.values.at("Name"));
  }
  EXPECT_THAT(namespaces, ElementsAre("\"root/cimv2\"", "\"root/interop\"", "\"root/yrnse\""));
  EXPECT_THAT(stack_.paths("ein", "CIM_RegisteredProfile", "root/interop"), SizeIs(4));
  const auto conforming = stack_.names(
      "ain", "CIM_RegisteredProfile.InstanceID=\"CompositeIPConfig:IP Interface (in part):1.0.0\"", "root/interop");
  for (const std::string& endpoint : stack_.names("ein", "YRNx_MgmtHwIPProtocolEndPoint")) {
    EXPECT_THAT(conforming, Contains(endpoint));
  }
}

}  // namespace
