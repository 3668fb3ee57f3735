// SPDX-License-Identifier: Apache-2.0
// ModifyInstance of the endpoint, the static settings and the remote access point, down to the instrumentation.
#include "cimom/broker/Handle.h"
#include "tests/support/composite/Samples.h"

namespace {

using namespace Testing;
using Calls = std::vector<std::string>;

class ModifyOperationTest : public CompositeTest {
 protected:
  ModifyOperationTest() { instrumentation().nodes = {{"eth0"}, {"eth1"}}; }

  CMPIStatus modify(const std::string& className, const CMPIObjectPath* path, const CMPIInstance* instance,
                    const CMPIBroker* unitBroker) {
    // OpenPegasus names what the client sent and then the rest of the class.
    const char* sent[] = {"IPv4Address", "SubnetMask", "Caption", "ElementName", nullptr};
    CMPIInstanceMI* mi = unitOf(className).createInstanceMI(unitBroker, nullptr, nullptr);
    return mi->ft->modifyInstance(mi, context(), result.result(), path, instance,
                                  personality().listsModifiedProperties ? sent : nullptr);
  }
  CMPIStatus modify(const std::string& className, const CMPIObjectPath* path, const CMPIInstance* instance) {
    return modify(className, path, instance, broker());
  }

  CMPIStatus modifyEndpoint(const CMPIObjectPath* path, const Properties& properties) {
    return modify(endpointClass, path, makeSent(endpointClass, properties));
  }
  CMPIStatus modifyStatic(const CMPIObjectPath* path, const Properties& properties) {
    return modify(staticClass, path, makeSent(staticClass, properties));
  }
  // An instance as it reaches a provider from a client: all that its class declares.
  CMPIInstance* makeSent(const std::string& className, const Properties& properties) {
    CMPIInstance* instance = makeInstance(requestNameSpace, className, properties);
    if (!personality().sendsDefaults) {
      auto& model = Cimom::ownModelOf<Cimom::Instance>(instance);
      model = model.withoutDefaults();
    }
    return instance;
  }
  CMPIObjectPath* endpointPath(const std::string& name) { return makePath(endpointClass, {{"Name", name}}); }
  CMPIObjectPath* staticPath(const std::string& id) { return makePath(staticClass, {{"InstanceID", id}}); }

  static std::string variable(const std::string& name, const std::string& value, int line, const std::string& file) {
    return "VARIABLE: '" + name + "' has Value '" + value + "' at line " + std::to_string(line) + " in " + file;
  }
  static std::string factoryVariable(const std::string& name, const std::string& value, int line) {
    return variable(name, value, line, "IPConfigObjectFactory");
  }
  // The lines of one function's own frame.
  static Calls linesOf(const std::string& function) {
    Calls lines;
    for (const LogLine& line : logLines()) {
      if (line.channel == Channel::Log && line.function == function) {
        lines.push_back(line.message);
      }
    }
    return lines;
  }

  const std::string endpointClass = Classes::endpoint;
  const std::string staticClass = Classes::staticSetting;
  const std::string remoteClass = Classes::remoteAccessPoint;
  const Properties addressAndMask = {{"IPv4Address", "192.0.2.7"}, {"SubnetMask", "255.255.255.0"}};
  RecordingResult result;
};

TEST_F(ModifyOperationTest, AnEndpointsAddressAndMaskReachTheNodeOfItsName) {
  const CMPIStatus answer = modifyEndpoint(endpointPath("eth1"), addressAndMask);
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_EQ(answer.msg, nullptr);
  EXPECT_EQ(result.order, Calls{"done"});
  EXPECT_EQ(instrumentation().nodes[1].values, (std::map<int, std::string>{{25, "192.0.2.7"}, {26, "255.255.255.0"}}));
  EXPECT_TRUE(instrumentation().nodes[0].values.empty());
  EXPECT_EQ(linesOf("modifyIPProtocolendptCMPIInstance"),
            (Calls{"ENTERING: modifyIPProtocolendptCMPIInstance() in IPConfigObjectFactory [Line: 458]",
                   factoryVariable("IpName", "eth1", 469), factoryVariable("Ipv4Address", "192.0.2.7", 476),
                   factoryVariable("Ipv4SubnetMask", "255.255.255.0", 483),
                   "EXITING: modifyIPProtocolendptCMPIInstance() in IPConfigObjectFactory [Line: 487]"}));
}

TEST_F(ModifyOperationTest, AStaticSettingsAddressAndMaskReachTheNodeInItsIdentifier) {
  const CMPIStatus answer = modifyStatic(staticPath("BMC:eth0"), addressAndMask);
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, Calls{"done"});
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{25, "192.0.2.7"}, {26, "255.255.255.0"}}));
  EXPECT_EQ(
      linesOf("modifyStaticIPCMPIInstance"),
      (Calls{"ENTERING: modifyStaticIPCMPIInstance() in IPConfigObjectFactory [Line: 408]",
             factoryVariable("Ipv4Address", "192.0.2.7", 431), factoryVariable("Ipv4SubnetMask", "255.255.255.0", 438),
             "EXITING: modifyStaticIPCMPIInstance() in IPConfigObjectFactory [Line: 444]"}));
}

TEST_F(ModifyOperationTest, TheEntryIsFramedTracesBothPathsAndMarksNoExit) {
  modifyEndpoint(endpointPath("eth1"), {{"Name", "another"}, {"IPv4Address", "192.0.2.7"}});
  EXPECT_EQ(messages()[0], std::string(78, '='));
  EXPECT_EQ(messages()[1].find("ENTERING: IPProtocolendpt_ModifyInstance() in IPProtocolEndpointProvider [Line: "), 0u);
  const Calls own = linesOf("IPProtocolendpt_ModifyInstance");
  ASSERT_EQ(own.size(), 2u);
  EXPECT_EQ(own[0].find("VARIABLE: 'objstring' has Value '"), 0u);
  EXPECT_NE(own[0].find("eth1"), std::string::npos);
  EXPECT_NE(own[0].find("' at line 320 in IPProtocolEndpointProvider"), std::string::npos);
  EXPECT_EQ(own[1].find("VARIABLE: 'modifyobjstring' has Value '"), 0u);
  EXPECT_NE(own[1].find("another"), std::string::npos);
  EXPECT_NE(own[1].find("' at line 330 in IPProtocolEndpointProvider"), std::string::npos);
  EXPECT_TRUE(messagesWith("EXITING: IPProtocolendpt_ModifyInstance").empty());
  EXPECT_EQ(lineWith(own[0]).component, "Tarnwick.IPProtocolEndpointProvider");
}

TEST_F(ModifyOperationTest, WhatTheClientDidNotSendStaysAsItIs) {
  const CMPIInstance* instance = makeSent(endpointClass, {{"IPv4Address", "192.0.2.7"}});
  EXPECT_TRUE(CMIsNullValue(CMGetProperty(instance, "SubnetMask", &status)));
  EXPECT_EQ(hasProperty(instance, "EnabledState"), personality().sendsDefaults) << "which has a default";
  EXPECT_EQ(modify(endpointClass, endpointPath("eth0"), instance).rc, CMPI_RC_OK);
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{25, "192.0.2.7"}}));
}

TEST_F(ModifyOperationTest, ThePropertyListPlaysNoPart) {
  const char* none[] = {nullptr};
  const char* another[] = {"ElementName", nullptr};
  CMPIInstanceMI* mi = unitOf(endpointClass).createInstanceMI(broker(), nullptr, nullptr);
  for (const char** properties : {static_cast<const char**>(nullptr), none, another}) {
    instrumentation().nodes[0].values.clear();
    EXPECT_EQ(mi->ft
                  ->modifyInstance(mi, context(), result.result(), endpointPath("eth0"),
                                   makeSent(endpointClass, addressAndMask), properties)
                  .rc,
              CMPI_RC_OK);
    EXPECT_EQ(instrumentation().nodes[0].values.size(), 2u);
  }
}

TEST_F(ModifyOperationTest, AMissingPropertyIsNotWrittenAndItsCodeIsTheAnswerOnlyWhenReadLast) {
  CMPIInstance* instance = makeInstance(requestNameSpace, endpointClass, {{"IPv4Address", "192.0.2.7"}});
  // As object managers answer that know no such property.
  withProperty(instance, "SubnetMask", {CMPI_null, CMPI_nullValue | CMPI_notFound, {}}, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  const CMPIStatus answer = modify(endpointClass, endpointPath("eth0"), instance);
  EXPECT_EQ(answer.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  EXPECT_EQ(answer.msg, nullptr);
  EXPECT_EQ(result.order, Calls{"done"});
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{25, "192.0.2.7"}}));
}

TEST_F(ModifyOperationTest, TheStatusIsThatOfTheLastReadAndNotOfItsConversion) {
  CMPIData mask = {CMPI_string, CMPI_goodValue, {}};
  mask.value.string = withCode(CMNewString(faults.real(), "255.255.255.0", nullptr), CMPI_RC_ERR_FAILED);
  for (const auto& [className, path] :
       {std::pair{endpointClass, endpointPath("eth0")}, std::pair{staticClass, staticPath("BMC:eth0")}}) {
    CMPIInstance* instance = makeInstance(requestNameSpace, className, {{"IPv4Address", "192.0.2.7"}});
    EXPECT_EQ(modify(className, path, withProperty(instance, "SubnetMask", mask)).rc, CMPI_RC_OK) << className;
    EXPECT_EQ(modify(className, path, withProperty(instance, "SubnetMask", mask, CMPI_RC_ERR_ACCESS_DENIED)).rc,
              CMPI_RC_ERR_ACCESS_DENIED)
        << className;
    EXPECT_EQ(instrumentation().nodes[0].values.at(26), "255.255.255.0") << className;
  }
}

TEST_F(ModifyOperationTest, AnEmptyAddressWithAMaskWritesTheMaskAlone) {
  modifyEndpoint(endpointPath("eth0"), {{"IPv4Address", ""}, {"SubnetMask", "255.0.0.0"}});
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{26, "255.0.0.0"}}));
}

TEST_F(ModifyOperationTest, ValuesAreNotCheckedHere) {
  EXPECT_EQ(modifyEndpoint(endpointPath("eth0"), {{"IPv4Address", "anything"}, {"SubnetMask", "at all"}}).rc,
            CMPI_RC_OK);
  EXPECT_EQ(instrumentation().nodes[0].values, (std::map<int, std::string>{{25, "anything"}, {26, "at all"}}));
}

TEST_F(ModifyOperationTest, AnEndpointWithoutANameKeyHasTheEmptyName) {
  EXPECT_EQ(modifyEndpoint(makePath(endpointClass, {{"SystemName", "sp1"}}), addressAndMask).rc, CMPI_RC_OK);
  EXPECT_EQ(linesOf("modifyIPProtocolendptCMPIInstance")[1], factoryVariable("IpName", "", 469));
  EXPECT_TRUE(instrumentation().nodes[0].values.empty());
  EXPECT_TRUE(instrumentation().nodes[1].values.empty());
}

TEST_F(ModifyOperationTest, AnUnknownInterfaceIsNoError) {
  EXPECT_EQ(modifyEndpoint(endpointPath("eth9"), addressAndMask).rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, Calls{"done"});
}

TEST_F(ModifyOperationTest, AnEndpointThatCouldNotBeWrittenEndsWithoutDoneAndWithTheStatusOfTheLastRead) {
  instrumentation().throwAt = "setProperty(25, 192.0.2.7)";
  EXPECT_EQ(modifyEndpoint(endpointPath("eth0"), addressAndMask).rc, CMPI_RC_OK);
  EXPECT_TRUE(result.order.empty());

  instrumentation() = {};
  EXPECT_EQ(modifyEndpoint(endpointPath("eth0"), addressAndMask).rc, CMPI_RC_OK);
  EXPECT_TRUE(result.order.empty()) << "no interface node at all";
}

TEST_F(ModifyOperationTest, StaticSettingsThatCouldNotBeWrittenEndAllTheSame) {
  instrumentation().throwAt = "construct";
  EXPECT_EQ(modifyStatic(staticPath("BMC:eth0"), addressAndMask).rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, Calls{"done"});
}

TEST_F(ModifyOperationTest, ATildeIsPartOfAnInterfacesName) {
  instrumentation().nodes = {{""}, {"eth~0"}};
  modifyStatic(staticPath("BMC:eth~0"), addressAndMask);
  EXPECT_EQ(instrumentation().nodes[1].values.size(), 2u);
}

TEST_F(ModifyOperationTest, AnIdentifierOfAnotherFormNamesTheEmptyInterface) {
  instrumentation().nodes = {{"eth0"}, {""}};
  for (const std::string id : {"BMC", "BMC:eth0:static", "", ":::"}) {
    instrumentation().nodes[1].values.clear();
    EXPECT_EQ(modifyStatic(staticPath(id), addressAndMask).rc, CMPI_RC_OK) << id;
    EXPECT_TRUE(instrumentation().nodes[0].values.empty()) << id;
    EXPECT_EQ(instrumentation().nodes[1].values.size(), 2u) << id;
  }
}

TEST_F(ModifyOperationTest, EmptyFieldsOfAnIdentifierVanish) {
  modifyStatic(staticPath(":BMC::eth0:"), addressAndMask);
  EXPECT_EQ(instrumentation().nodes[0].values.size(), 2u);
}

TEST_F(ModifyOperationTest, WithoutAnIdentifierNothingIsReadOrWritten) {
  constexpr CMPIData null = {CMPI_string, CMPI_keyValue | CMPI_nullValue, {}};
  const CMPIObjectPath* path = withKey(makePath(staticClass), "InstanceID", null, CMPI_RC_ERR_NOT_FOUND);
  const CMPIStatus answer = modifyStatic(path, addressAndMask);
  EXPECT_EQ(answer.rc, CMPI_RC_ERR_NOT_FOUND) << "the code of the key's read is the answer";
  EXPECT_EQ(answer.msg, nullptr);
  EXPECT_EQ(result.order, Calls{"done"});
  EXPECT_TRUE(instrumentation().calls.empty());
  EXPECT_EQ(linesOf("modifyStaticIPCMPIInstance"),
            (Calls{"ENTERING: modifyStaticIPCMPIInstance() in IPConfigObjectFactory [Line: 408]",
                   "EXITING: modifyStaticIPCMPIInstance() in IPConfigObjectFactory [Line: 444]"}));
}

TEST_F(ModifyOperationTest, AnIdentifierThatIsNotThereIsNullOrNamesTheEmptyInterface) {
  const CMPIStatus answer = modifyStatic(makePath(staticClass, {{"Other", "x"}}), addressAndMask);
  EXPECT_EQ(result.order, Calls{"done"});
  EXPECT_TRUE(instrumentation().nodes[0].values.empty());
  EXPECT_TRUE(instrumentation().nodes[1].values.empty());
  // sfcb says of a key that it was not found, and not that it is null, which is what the operation goes by.
  const bool isNull = (personality().absentState & CMPI_nullValue) != 0;
  EXPECT_EQ(answer.rc, isNull ? personality().absentKeyCode : CMPI_RC_OK);
  EXPECT_EQ(instrumentation().calls.empty(), isNull);
}

TEST_F(ModifyOperationTest, WronglyTypedValuesCountAsEmpty) {
  CMPIData number = {CMPI_uint32, CMPI_goodValue, {}};
  number.value.uint32 = 7;
  CMPIInstance* instance = withProperty(
      withProperty(makeInstance(requestNameSpace, endpointClass, {}), "IPv4Address", number), "SubnetMask", number);
  EXPECT_EQ(modify(endpointClass, endpointPath("eth0"), instance).rc, CMPI_RC_OK);
  EXPECT_TRUE(instrumentation().nodes[0].values.empty());
}

TEST_F(ModifyOperationTest, ARemoteAccessPointAcceptsAnythingAndChangesNothing) {
  const CMPIStatus answer = modify(remoteClass, makePath(remoteClass, {{"Name", "gateway"}}),
                                   makeInstance(requestNameSpace, remoteClass, {{"AccessInfo", "192.0.2.254"}}));
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_EQ(answer.msg, nullptr);
  EXPECT_EQ(result.order, Calls{"done"});
  EXPECT_TRUE(instrumentation().calls.empty());
  EXPECT_TRUE(faults.upCalls.empty());
  EXPECT_EQ(linesOf("modifyRemoteSAPCMPIInstance"),
            (Calls{"ENTERING: modifyRemoteSAPCMPIInstance() in IPConfigObjectFactory [Line: 310]",
                   "EXITING: modifyRemoteSAPCMPIInstance() in IPConfigObjectFactory [Line: 394]"}));
  EXPECT_EQ(linesOf("IPRemoteSAP_ModifyInstance").size(), 2u);
}

class NullInstanceTest : public ModifyOperationTest, public ::testing::WithParamInterface<const char*> {};

INSTANTIATE_TEST_SUITE_P(Three, NullInstanceTest,
                         ::testing::Values(Classes::endpoint, Classes::staticSetting, Classes::remoteAccessPoint));

TEST_P(NullInstanceTest, IsRefusedWithTheTextInTheLogOnly) {
  const Unit& unit = unitOf(GetParam());
  const std::string expected = "MESSAGE [File: " + unit.file + ", Line: 353]: Modify instance Passed is NULL";
  for (const CMPIInstance* instance :
       {static_cast<const CMPIInstance*>(nullptr), static_cast<const CMPIInstance*>(withoutHandle())}) {
    for (const CMPIBroker* unitBroker : {broker(), static_cast<const CMPIBroker*>(nullptr)}) {
      logLines().clear();
      faults.strings.clear();
      const CMPIStatus answer = modify(GetParam(), makePath(GetParam(), {{"Name", "x"}}), instance, unitBroker);
      EXPECT_EQ(answer.rc, CMPI_RC_ERR_FAILED);
      EXPECT_EQ(answer.msg, nullptr);
      EXPECT_EQ(messages().back(), expected);
      EXPECT_EQ(faults.strings.size(), unitBroker != nullptr ? 1u : 0u);
    }
  }
  EXPECT_EQ(result.done, 4);
  EXPECT_TRUE(instrumentation().calls.empty());
}

}  // namespace
