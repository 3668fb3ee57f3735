// SPDX-License-Identifier: Apache-2.0
// The six classes of instances, read as a client reads them, compared with what the management processor holds.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>

#include "tests/hosts/HostProcesses.h"
#include "tests/hosts/HostTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/FactoryState.h"

namespace {

using namespace Testing;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

class HostInstancesTest : public HostTest {};

TEST_F(HostInstancesTest, RunInAsManyProcessesAsTheyAreRegisteredFor) {
  host().names("ein", "YRNx_MgmtHwComputerSystem");
  EXPECT_THAT(ObjectManager::providerProcesses(), SizeIs(host().processes()));
  EXPECT_EQ(ObjectManager::providerProcesses("composite") == ObjectManager::providerProcesses("underlying"),
            host().processes() == 1);
}

TEST_F(HostInstancesTest, AreEnumeratedWithEveryValue) {
  for (const ClassCase& row : classCases()) {
    const auto found = host().instances("ei", row.className);
    ASSERT_THAT(found, SizeIs(row.objects.size())) << row.className;
    for (std::size_t i = 0; i < found.size(); ++i) {
      EXPECT_EQ(canonical(objectOf(found[i].path)), canonical(row.objects[i]));
      EXPECT_EQ(found[i].values, row.values[i]) << row.objects[i];
    }
  }
}

TEST_F(HostInstancesTest, AreEnumeratedByName) {
  for (const ClassCase& row : classCases()) {
    EXPECT_EQ(canonical(host().names("ein", row.className)), canonical(row.objects));
  }
}

TEST_F(HostInstancesTest, AreGotByTheNamesThatWereEnumerated) {
  for (const ClassCase& row : classCases()) {
    const auto names = host().names("ein", row.className);
    ASSERT_THAT(names, SizeIs(row.values.size())) << row.className;
    for (std::size_t i = 0; i < names.size(); ++i) {
      EXPECT_EQ(host().get(names[i]), row.values[i]) << names[i];
    }
  }
}

TEST_F(HostInstancesTest, AreShownWithThePropertiesThatAreAskedFor) {
  for (const ClassCase& row : classCases()) {
    const auto& [name, value] = *row.values.front().begin();
    const auto found = host().instances("ei", row.className, name);
    ASSERT_THAT(found, SizeIs(row.objects.size())) << row.className;
    EXPECT_EQ(found.front().values.at(name), value);
    EXPECT_EQ(canonical(objectOf(found.front().path)), canonical(row.objects.front()));
  }
}

TEST_F(HostInstancesTest, ThatAreNotThereAreNotFound) {
  for (const ClassCase& row : classCases()) {
    std::string strange = row.objects.front();
    strange.replace(strange.find('"'), 1, "\"strange");
    EXPECT_THAT(host().failure("gi", strange), HasSubstr("(6) CIM_ERR_NOT_FOUND"));
  }
}

TEST_F(HostInstancesTest, AnswerForTheirSuperclasses) {
  const auto names = canonical(host().names("ein", "CIM_ComputerSystem"));
  EXPECT_THAT(names, testing::Contains(canonical(computerSystem())));
  EXPECT_THAT(host().names("ein", "CIM_SettingData"), SizeIs(8));
}

TEST_F(HostInstancesTest, OfTheUnderlyingClassesAreServedToo) {
  for (const char* underlying :
       {"YRNQV_SPComputerSystem", "YRNQV_IPProtocolEndpoint", "YRNQV_IPAssignmentSettingData",
        "YRNQV_StaticIPAssignmentSettingData", "YRNQV_DHCPSettingData", "YRNQV_IPRemoteServiceAccessPoint"}) {
    EXPECT_THAT(host().names("ein", underlying, "root/yrnse"), testing::Not(IsEmpty())) << underlying;
  }
  const auto settings = host().get(R"(YRNQV_StaticIPAssignmentSettingData.InstanceID="BMC:eth0")", "root/yrnse");
  EXPECT_EQ(settings.at("IPv4Address"), quoted("192.0.2.10"));
}

TEST_F(HostInstancesTest, AreTheSameForManyClientsAtOnce) {
  const auto expected = host().names("ein", "YRNx_MgmtHwClientAccess");
  ASSERT_THAT(expected, SizeIs(6));
  std::vector<std::unique_ptr<Process>> clients;
  for (int i = 0; i < 16; ++i) {
    clients.push_back(
        std::make_unique<Process>(std::vector<std::string>{"wbemcli", "ein", host().url("YRNx_MgmtHwClientAccess")}));
  }
  for (const auto& client : clients) {
    EXPECT_EQ(client->wait(), 0) << client->errors();
    std::vector<std::string> names = linesOf(client->output());
    for (std::string& name : names) {
      name = objectOf(name);
    }
    EXPECT_EQ(names, expected);
  }
}

}  // namespace
