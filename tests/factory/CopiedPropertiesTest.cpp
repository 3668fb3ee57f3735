// SPDX-License-Identifier: Apache-2.0
// What a composite instance of each class carries, property by property.
#include "tests/support/composite/Samples.h"

namespace {

using namespace Testing;

class CopiedPropertiesTest : public CompositeTest {
 protected:
  // The one composite made from one underlying instance with these properties on top of acceptable ones.
  const CMPIInstance* compose(const std::string& className, const Properties& properties) {
    const Sample& sample = sampleOf(className);
    Properties all = acceptable(sample, 1);
    all.insert(all.end(), properties.begin(), properties.end());
    addUnderlying(sample.underlying, all);
    CMPIInstanceMI* mi = unitOf(className).createInstanceMI(broker(), context(), nullptr);
    mi->ft->enumerateInstances(mi, context(), result_.result(), makePath(className), nullptr);
    EXPECT_EQ(result_.instances.size(), 1u);
    return result_.instances.front();
  }

  const std::vector<const CMPIInstance*>& composeAll(const std::string& className) {
    CMPIInstanceMI* mi = unitOf(className).createInstanceMI(broker(), context(), nullptr);
    status = mi->ft->enumerateInstances(mi, context(), result_.result(), makePath(className), nullptr);
    return result_.instances;
  }

  RecordingResult result_;
};

TEST_F(CopiedPropertiesTest, AnEndpointCarriesItsFourteen) {
  const CMPIInstance* endpoint = compose(Classes::endpoint, {{"NameFormat", "Other"},
                                                             {"ElementName", "Port 1"},
                                                             {"IPv4Address", "192.0.2.1"},
                                                             {"IPv6Address", "2001:db8::1"},
                                                             {"SubnetMask", "255.255.255.0"},
                                                             {"PrefixLength", CMPIUint8(64)},
                                                             {"AddressType", CMPIUint16(1)},
                                                             {"IPVersionSupport", CMPIUint16(3)},
                                                             {"ProtocolIFType", CMPIUint16(4098)},
                                                             {"EnabledState", CMPIUint16(2)},
                                                             {"RequestedState", CMPIUint16(11)},
                                                             {"AddressOrigin", CMPIUint16(4)},
                                                             {"Caption", "not copied"}});
  EXPECT_EQ(text(endpoint, "Name"), "point1");
  EXPECT_EQ(text(endpoint, "SystemName"), "sp1");
  EXPECT_EQ(text(endpoint, "NameFormat"), "Other");
  EXPECT_EQ(text(endpoint, "ElementName"), "Port 1");
  EXPECT_EQ(text(endpoint, "IPv4Address"), "192.0.2.1");
  EXPECT_EQ(text(endpoint, "IPv6Address"), "2001:db8::1");
  EXPECT_EQ(text(endpoint, "SubnetMask"), "255.255.255.0");
  EXPECT_EQ(number(endpoint, "PrefixLength"), 64);
  EXPECT_EQ(number(endpoint, "AddressType"), 1);
  EXPECT_EQ(number(endpoint, "IPVersionSupport"), 3);
  EXPECT_EQ(number(endpoint, "ProtocolIFType"), 4098);
  EXPECT_EQ(number(endpoint, "EnabledState"), 2);
  EXPECT_EQ(number(endpoint, "RequestedState"), 11);
  EXPECT_EQ(number(endpoint, "AddressOrigin"), 4);
  EXPECT_EQ(text(endpoint, "CreationClassName"), Classes::endpoint);
  EXPECT_EQ(text(endpoint, "SystemCreationClassName"), Classes::computerSystem);
  EXPECT_FALSE(hasProperty(endpoint, "Caption"));
}

TEST_F(CopiedPropertiesTest, ARemoteAccessPointKeepsItsPathsClassAndShowsAnotherInItsProperty) {
  const CMPIInstance* point = compose(Classes::remoteAccessPoint, {{"OtherAccessContext", "other"},
                                                                   {"AccessInfo", "192.0.2.254"},
                                                                   {"AccessContext", CMPIUint16(2)},
                                                                   {"InfoFormat", CMPIUint16(3)},
                                                                   {"ElementName", "not copied"}});
  EXPECT_EQ(text(point, "OtherAccessContext"), "other");
  EXPECT_EQ(text(point, "AccessInfo"), "192.0.2.254");
  EXPECT_EQ(number(point, "AccessContext"), 2);
  EXPECT_EQ(number(point, "InfoFormat"), 3);
  EXPECT_FALSE(hasProperty(point, "ElementName"));
  EXPECT_EQ(text(point, "SystemCreationClassName"), Classes::computerSystem);
  EXPECT_EQ(text(point, "CreationClassName"), "YRNx_RemoteAccessPoint");
  EXPECT_EQ(classOf(pathOf(point)), Classes::remoteAccessPoint);
  EXPECT_EQ(key(pathOf(point), "CreationClassName"), "YRNx_RemoteAccessPoint");
}

TEST_F(CopiedPropertiesTest, ASettingCarriesItsThreeAndOnlyTheDhcpSettingACaption) {
  for (const std::string className : {Classes::sequence, Classes::staticSetting, Classes::dhcpSetting}) {
    result_.instances.clear();
    const CMPIInstance* setting = compose(className, {{"Caption", "underlying"}, {"Description", "not copied"}});
    EXPECT_EQ(text(setting, "InstanceID"), keysOf(sampleOf(className), 1).front().second);
    EXPECT_EQ(text(setting, "ElementName"), "setting 1");
    EXPECT_EQ(number(setting, "AddressOrigin"), 3);
    EXPECT_FALSE(hasProperty(setting, "Description"));
    if (className == Classes::dhcpSetting) {
      EXPECT_EQ(text(setting, "Caption"), "DNS Configuration Setting");
    } else {
      EXPECT_FALSE(hasProperty(setting, "Caption"));
    }
  }
}

TEST_F(CopiedPropertiesTest, AComputerSystemCarriesItsDedicationAndItsPosition) {
  addUnderlying("YRNQV_SPComputerSystem", acceptable(sampleOf(Classes::computerSystem), 1));
  addUnderlying("YRNQV_SPComputerSystem", acceptable(sampleOf(Classes::computerSystem), 2));
  ASSERT_EQ(composeAll(Classes::computerSystem).size(), 2u);
  for (int n = 1; n <= 2; ++n) {
    const CMPIInstance* system = result_.instances[n - 1];
    EXPECT_EQ(text(system, "Name"), "sp" + std::to_string(n));
    EXPECT_EQ(text(system, "Description"), "processor " + std::to_string(n));
    EXPECT_EQ(text(system, "NameFormat"), "Other");
    EXPECT_EQ(number(system, "Index"), n);
    const CMPIData dedicated = CMGetProperty(system, "Dedicated", nullptr);
    ASSERT_EQ(dedicated.type, CMPI_uint16A);
    ASSERT_EQ(CMGetArrayCount(dedicated.value.array, nullptr), 2u);
    EXPECT_EQ(CMGetArrayElementAt(dedicated.value.array, 0, nullptr).value.uint16, 14);
    EXPECT_EQ(CMGetArrayElementAt(dedicated.value.array, 1, nullptr).value.uint16, 28);
  }
}

TEST_F(CopiedPropertiesTest, EachComputerSystemIsAnnouncedStepByStep) {
  compose(Classes::computerSystem, {});
  std::vector<std::string> told;
  for (const std::string& message : messagesWith("MESSAGE [File: IPConfigObjectFactory")) {
    told.push_back(message.substr(message.find("]: ") + 3));
  }
  const std::vector<std::string> expected = {
      "Calling CMNewObjectPath",  "Calling CMSetNameSpace",   "Calling CMSetHostname", "Calling CMNewInstance",
      " CMGetProperty Dedicated", " CMSetProperty Dedicated", " CMSetProperty Index",  " Insatance done"};
  EXPECT_EQ(told, expected);
  EXPECT_EQ(faults.traces, (std::vector<BrokerTrace>{
                               {CMPI_LEV_INFO, "CompositeIPConfigProvider", "***Returning One IPConfig instance***"}}));
}

TEST_F(CopiedPropertiesTest, AComputerSystemWithoutADedicationStillHasItsPosition) {
  addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp1"}});
  CMPIData withoutArray = {CMPI_uint16A, CMPI_goodValue, {}};
  withoutArray.value.array = nullptr;
  withProperty(addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp2"}}), "Dedicated", withoutArray);
  CMPIData notAnArray = {CMPI_uint16, CMPI_goodValue, {}};
  withProperty(addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp3"}}), "Dedicated", notAnArray);
  CMPIArray handleless = {nullptr, nullptr};
  CMPIData withoutHandle = {CMPI_uint16A, CMPI_goodValue, {}};
  withoutHandle.value.array = &handleless;
  withProperty(addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp4"}}), "Dedicated", withoutHandle);
  ASSERT_EQ(composeAll(Classes::computerSystem).size(), 4u);
  for (int n = 1; n <= 4; ++n) {
    EXPECT_FALSE(hasProperty(result_.instances[n - 1], "Dedicated")) << n;
    EXPECT_EQ(number(result_.instances[n - 1], "Index"), n);
  }
  for (const std::string& message : messages()) {
    EXPECT_EQ(message.find(" CMSetProperty Dedicated"), std::string::npos);
  }
}

TEST_F(CopiedPropertiesTest, ABrokerWithoutMemoryForAnArrayEndsTheReadingOfComputerSystems) {
  addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp1"}});
  addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp2"}});
  faults.failNewArray = true;
  EXPECT_TRUE(composeAll(Classes::computerSystem).empty());
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(text(status.msg), "Create Array for Property Dedicated failed.");
  EXPECT_EQ(faults.traces, (std::vector<BrokerTrace>{{CMPI_LEV_WARNING, "CompositeIPConfigProvider",
                                                      "Create Array for Property Dedicated failed."}}));
  EXPECT_TRUE(messagesWith("EXITING: getAll").empty());
  EXPECT_EQ(result_.done, 0);
}

TEST_F(CopiedPropertiesTest, AnUnsetUnderlyingPropertyStaysUnset) {
  const CMPIInstance* endpoint = compose(Classes::endpoint, {});
  for (const char* name : {"IPv4Address", "IPv6Address", "SubnetMask", "PrefixLength", "ElementName"}) {
    EXPECT_FALSE(hasProperty(endpoint, name)) << name;
  }
}

TEST_F(CopiedPropertiesTest, ANumberThatDoesNotFitItsTypeStaysUnset) {
  const Sample& sample = sampleOf(Classes::endpoint);
  CMPIData big = {CMPI_uint32, CMPI_goodValue, {}};
  big.value.uint32 = 300;
  withProperty(addUnderlying(sample.underlying, acceptable(sample, 1)), "PrefixLength", big);
  ASSERT_EQ(composeAll(Classes::endpoint).size(), 1u);
  EXPECT_FALSE(hasProperty(result_.instances[0], "PrefixLength"));
}

}  // namespace
