// SPDX-License-Identifier: Apache-2.0
// The underlying provider as an object manager has it: the shared library behind its factory, loaded into a real
// broker, on the simulated processor.
#include <QV/Instrumentation.h>
#include <cmpimacs.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>
#include <vector>

#include "tests/support/agent/AgentEnvironment.h"
#include "tests/support/broker/BrokerFixture.h"

extern "C" CMPIInstanceMI* UnderlyingIPConfigProvider_Create_InstanceMI(const CMPIBroker*, const CMPIContext*,
                                                                        CMPIStatus*);

namespace {

using namespace QV;
using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Key;
using testing::Not;
using testing::Pair;

[[maybe_unused]] const auto* const environment = testing::AddGlobalTestEnvironment(&AgentEnvironment::instance());

constexpr const char* schema = R"(
  class YRNQV_SPComputerSystem {
    [key] string CreationClassName; [key] string Name;
    string Description; string NameFormat; uint16 Dedicated[];
  };
  class YRNQV_IPProtocolEndpoint {
    [key] string SystemCreationClassName; [key] string SystemName; [key] string CreationClassName; [key] string Name;
    string NameFormat; string ElementName; string IPv4Address; string IPv6Address; string SubnetMask;
    uint8 PrefixLength; uint16 AddressType; uint16 IPVersionSupport; uint16 ProtocolIFType; uint16 EnabledState;
    uint16 RequestedState; uint16 AddressOrigin;
  };
  class YRNQV_IPAssignmentSettingData { [key] string InstanceID; string ElementName; uint16 AddressOrigin; };
  class YRNQV_StaticIPAssignmentSettingData {
    [key] string InstanceID; string ElementName; uint16 AddressOrigin;
    string IPv4Address; string SubnetMask; string GatewayIPv4Address;
  };
  class YRNQV_DHCPSettingData { [key] string InstanceID; string ElementName; uint16 AddressOrigin; };
  class YRNQV_IPRemoteServiceAccessPoint {
    [key] string SystemCreationClassName; [key] string SystemName; [key] string CreationClassName; [key] string Name;
    string OtherAccessContext; string AccessInfo; uint16 AccessContext; uint16 InfoFormat;
  };
  class YRNQV_Stranger { [key] string InstanceID; };
)";

constexpr const char* classNames[] = {"YRNQV_SPComputerSystem",
                                      "YRNQV_IPProtocolEndpoint",
                                      "YRNQV_IPAssignmentSettingData",
                                      "YRNQV_StaticIPAssignmentSettingData",
                                      "YRNQV_DHCPSettingData",
                                      "YRNQV_IPRemoteServiceAccessPoint",
                                      "YRNQV_Stranger"};

std::string textOf(const CMPIData& data) {
  if (CMIsNullValue(data)) {
    return "null";
  }
  if (CMIsArray(data)) {
    std::string text;
    for (CMPICount index = 0; index < CMGetArrayCount(data.value.array, nullptr); ++index) {
      text += (text.empty() ? "" : ",") + textOf(CMGetArrayElementAt(data.value.array, index, nullptr));
    }
    return text;
  }
  if (data.type == CMPI_uint16) {
    return std::to_string(data.value.uint16);
  }
  if (data.type == CMPI_uint8) {
    return std::to_string(data.value.uint8);
  }
  return data.type == CMPI_string ? CMGetCharsPtr(data.value.string, nullptr) : "?";
}

// The properties that have a value.
using Properties = std::map<std::string, std::string>;

Properties propertiesOf(const CMPIInstance* instance) {
  Properties properties;
  for (CMPICount index = 0; index < CMGetPropertyCount(instance, nullptr); ++index) {
    CMPIString* name = nullptr;
    const CMPIData data = CMGetPropertyAt(instance, index, &name, nullptr);
    if (!CMIsNullValue(data)) {
      properties[CMGetCharsPtr(name, nullptr)] = textOf(data);
    }
  }
  return properties;
}

Properties keysOf(const CMPIObjectPath* path) {
  Properties keys;
  for (CMPICount index = 0; index < CMGetKeyCount(path, nullptr); ++index) {
    CMPIString* name = nullptr;
    const CMPIData data = CMGetKeyAt(path, index, &name, nullptr);
    keys[CMGetCharsPtr(name, nullptr)] = textOf(data);
  }
  return keys;
}

class UnderlyingIPConfigProviderTest : public BrokerFixture {
 protected:
  UnderlyingIPConfigProviderTest() {
    AgentEnvironment::instance().reset();
    manager.loadSchemaText(schema, "root/yrnse");
    for (const char* name : classNames) {
      manager.addProvider({.className = name,
                           .provider = "UnderlyingIPConfigProvider",
                           .location = "",
                           .instance = true,
                           .association = false,
                           .namespaces = {"root/yrnse"},
                           .registeredAt = "here"},
                          UnderlyingIPConfigProvider_Create_InstanceMI, nullptr);
    }
  }

  CMPIObjectPath* path(const char* className) const {
    return CMNewObjectPath(broker, "root/yrnse", className, nullptr);
  }

  std::vector<Properties> enumerate(const char* className, std::vector<const char*> wanted = {}) {
    wanted.push_back(nullptr);
    CMPIEnumeration* instances = CBEnumInstances(broker, request.context(), path(className),
                                                 wanted.size() > 1 ? wanted.data() : nullptr, &status);
    std::vector<Properties> all;
    while (status.rc == CMPI_RC_OK && CMHasNext(instances, nullptr)) {
      all.push_back(propertiesOf(CMGetNext(instances, nullptr).value.inst));
    }
    return all;
  }

  std::vector<CMPIObjectPath*> enumerateNames(const char* className) {
    CMPIEnumeration* paths = CBEnumInstanceNames(broker, request.context(), path(className), &status);
    std::vector<CMPIObjectPath*> all;
    while (status.rc == CMPI_RC_OK && CMHasNext(paths, nullptr)) {
      all.push_back(CMGetNext(paths, nullptr).value.ref);
    }
    return all;
  }

  std::string message() const { return status.msg ? CMGetCharsPtr(status.msg, nullptr) : ""; }

  static std::string log() { return readFile(AgentEnvironment::instance().log()); }
  static std::string trace() { return readFile(AgentEnvironment::instance().trace()); }

  CMPIStatus status = {CMPI_RC_OK, nullptr};
};

TEST_F(UnderlyingIPConfigProviderTest, ServesTheProcessor) {
  EXPECT_THAT(enumerate("YRNQV_SPComputerSystem"),
              ElementsAre(Properties{{"CreationClassName", "YRNQV_SPComputerSystem"},
                                     {"Name", "BMC"},
                                     {"Description", "Simulated management processor"},
                                     {"NameFormat", "Other"},
                                     {"Dedicated", "14,28"}}));
}

TEST_F(UnderlyingIPConfigProviderTest, ServesTheEndpointsOfTheProcessorAndOfTheHost) {
  const auto all = enumerate("YRNQV_IPProtocolEndpoint");
  ASSERT_GE(all.size(), 2U);
  EXPECT_EQ(all[0], (Properties{{"SystemCreationClassName", "YRNQV_SPComputerSystem"},
                                {"SystemName", "BMC"},
                                {"CreationClassName", "YRNQV_IPProtocolEndpoint"},
                                {"Name", "eth0"},
                                {"NameFormat", "Interface name"},
                                {"ElementName", "BMC IP endpoint eth0"},
                                {"IPv4Address", "192.0.2.10"},
                                {"IPv6Address", "2001:db8::10"},
                                {"SubnetMask", "255.255.255.0"},
                                {"PrefixLength", "64"},
                                {"AddressType", "1"},
                                {"IPVersionSupport", "3"},
                                {"ProtocolIFType", "4098"},
                                {"EnabledState", "2"},
                                {"RequestedState", "12"},
                                {"AddressOrigin", "3"}}));
  EXPECT_THAT(all[1], AllOf(Contains(Pair("Name", "eth1")), Not(Contains(Key("IPv6Address"))),
                            Not(Contains(Key("PrefixLength")))))
      << "what the processor does not have stays null";
  for (std::size_t index = 2; index < all.size(); ++index) {
    EXPECT_THAT(all[index], AllOf(Contains(Pair("SystemCreationClassName", "YRNQV_ComputerSystem")),
                                  Contains(Pair("SystemName", "managed.example"))));
  }
}

TEST_F(UnderlyingIPConfigProviderTest, ServesTheSettings) {
  const auto idsOf = [this](const char* className) {
    std::vector<std::string> ids;
    for (Properties& properties : enumerate(className)) {
      const std::string id = properties["InstanceID"];
      if (id.starts_with("BMC:")) {
        ids.push_back(id);
      } else {
        EXPECT_TRUE(id.starts_with("Host:")) << id;
      }
    }
    return ids;
  };
  EXPECT_THAT(idsOf("YRNQV_IPAssignmentSettingData"),
              ElementsAre("BMC:eth0:static", "BMC:eth0:dhcp", "BMC:eth1:static", "BMC:eth1:dhcp"));
  EXPECT_THAT(idsOf("YRNQV_StaticIPAssignmentSettingData"), ElementsAre("BMC:eth0", "BMC:eth1"));
  EXPECT_THAT(idsOf("YRNQV_DHCPSettingData"), ElementsAre("BMC:eth0", "BMC:eth1"));
}

TEST_F(UnderlyingIPConfigProviderTest, ServesTheAccessPointsOfTheProcessorAndOfTheHost) {
  std::vector<std::string> own;
  int ofHost = 0;
  for (Properties& properties : enumerate("YRNQV_IPRemoteServiceAccessPoint")) {
    if (properties["SystemCreationClassName"] != "YRNQV_SPComputerSystem") {
      ++ofHost;
    } else {
      own.push_back(properties["Name"] + ' ' + properties["AccessContext"] + ' ' + properties["InfoFormat"] + ' ' +
                    properties["AccessInfo"]);
    }
  }
  EXPECT_THAT(own, ElementsAre("Gateway:eth0 2 3 192.0.2.1", "DNS:1 3 3 192.0.2.53", "DNS:2 3 4 2001:db8::53"));
  EXPECT_GT(ofHost, 0);
}

TEST_F(UnderlyingIPConfigProviderTest, NamesEveryInstanceByItsKeysAndFindsItByThem) {
  for (const char* className : classNames) {
    if (className == std::string("YRNQV_Stranger")) {
      continue;
    }
    const auto instances = enumerate(className);
    const auto paths = enumerateNames(className);
    ASSERT_EQ(paths.size(), instances.size()) << className;
    std::set<Properties> different;
    for (std::size_t index = 0; index < paths.size(); ++index) {
      const Properties keys = keysOf(paths[index]);
      EXPECT_TRUE(different.insert(keys).second) << className << ": two instances of one name";
      EXPECT_THAT(instances[index], testing::IsSupersetOf(keys));
      CMPIInstance* found = CBGetInstance(broker, request.context(), paths[index], nullptr, &status);
      ASSERT_EQ(status.rc, CMPI_RC_OK) << className;
      EXPECT_EQ(propertiesOf(found), instances[index]);
    }
  }
}

TEST_F(UnderlyingIPConfigProviderTest, FindsNothingByKeysThatNoInstanceHas) {
  CMPIObjectPath* unknown = path("YRNQV_DHCPSettingData");
  CMAddKey(unknown, "InstanceID", "BMC:eth9", CMPI_chars);
  EXPECT_EQ(CBGetInstance(broker, request.context(), unknown, nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  CBGetInstance(broker, request.context(), path("YRNQV_DHCPSettingData"), nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND) << "a path without keys";
}

TEST_F(UnderlyingIPConfigProviderTest, ShowsNoMoreThanIsAskedForAndTheKeys) {
  EXPECT_THAT(
      enumerate("YRNQV_SPComputerSystem", {"Description"}),
      Each(testing::UnorderedElementsAre(Pair("CreationClassName", "YRNQV_SPComputerSystem"), Pair("Name", "BMC"),
                                         Pair("Description", "Simulated management processor"))));
}

TEST_F(UnderlyingIPConfigProviderTest, ShowsAtOnceWhatTheInstrumentationWrote) {
  {
    Instrumentation instrumentation;
    instrumentation.selectNode(NodeLexicon::IpInterfaceNode);
    ++instrumentation;
    std::string address = "198.51.100.77";
    instrumentation.setProperty(NodeLexicon::Ipv4Address, address);
  }
  EXPECT_THAT(enumerate("YRNQV_IPProtocolEndpoint").at(1),
              testing::IsSupersetOf(Properties{
                  {"IPv4Address", "198.51.100.77"}, {"SubnetMask", "255.255.255.0"}, {"AddressOrigin", "3"}}));
  EXPECT_THAT(enumerate("YRNQV_StaticIPAssignmentSettingData").at(1), Contains(Pair("IPv4Address", "198.51.100.77")));
}

TEST_F(UnderlyingIPConfigProviderTest, TellsWhyTheProcessorCannotBeReadAndLogsAndTracesIt) {
  writeFile(AgentEnvironment::instance().state(), "{");
  for (const char* className : classNames) {
    if (className == std::string("YRNQV_Stranger")) {
      continue;
    }
    enumerate(className);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED) << className;
    EXPECT_THAT(message(), HasSubstr(AgentEnvironment::instance().state() + ": "));
    enumerateNames(className);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED) << className;
    CBGetInstance(broker, request.context(), path(className), nullptr, &status);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED) << className;
  }
  for (const std::string& lines : {log(), trace()}) {
    EXPECT_THAT(lines, HasSubstr(" 6000 Tarnwick.UnderlyingIPConfigProvider serve (UnderlyingIPConfigProvider:"));
    EXPECT_THAT(lines, HasSubstr(AgentEnvironment::instance().state() + ": "));
  }
}

TEST_F(UnderlyingIPConfigProviderTest, RefusesAClassThatItDoesNotServe) {
  enumerate("YRNQV_Stranger");
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
  EXPECT_THAT(message(), HasSubstr("YRNQV_Stranger"));
}

TEST_F(UnderlyingIPConfigProviderTest, IsReadOnly) {
  CMPIObjectPath* name = enumerateNames("YRNQV_DHCPSettingData").at(0);
  CMPIInstance* instance = CMNewInstance(broker, name, nullptr);
  CBCreateInstance(broker, request.context(), name, instance, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
  EXPECT_EQ(CBModifyInstance(broker, request.context(), name, instance, nullptr).rc, CMPI_RC_ERR_NOT_SUPPORTED);
  EXPECT_EQ(CBDeleteInstance(broker, request.context(), name).rc, CMPI_RC_ERR_NOT_SUPPORTED);
  CBExecQuery(broker, request.context(), name, "SELECT * FROM YRNQV_DHCPSettingData", "WQL", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(UnderlyingIPConfigProviderTest, IsMadeAndCleanedUpAgainAndAgain) {
  for (int count = 0; count < 3; ++count) {
    CMPIStatus made{CMPI_RC_OK, nullptr};
    CMPIInstanceMI* provider = UnderlyingIPConfigProvider_Create_InstanceMI(broker, request.context(), &made);
    ASSERT_NE(provider, nullptr);
    EXPECT_STREQ(provider->ft->miName, "instanceUnderlyingIPConfigProvider");
    EXPECT_EQ(provider->ft->cleanup(provider, request.context(), 1).rc, CMPI_RC_OK);
  }
  EXPECT_THAT(enumerate("YRNQV_DHCPSettingData"), Not(IsEmpty()));
}

}  // namespace
