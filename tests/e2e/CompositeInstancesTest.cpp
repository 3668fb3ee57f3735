// SPDX-License-Identifier: Apache-2.0
// The six composite classes of a simulated management processor in its factory state, read with wbemcli.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/client/FactoryState.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsSupersetOf;
using testing::Not;
using testing::SizeIs;

class Composite {
 public:
  TemporaryDirectory directory;
  CompositeStack stack{simulatedProcessor(directory.path() / "processor.json")};
};

class CompositeClassTest : public testing::TestWithParam<ClassCase> {
 protected:
  Composite composite_;
  const CompositeStack& stack_ = composite_.stack;
};

TEST_P(CompositeClassTest, EnumeratesItsInstancesWithEveryValue) {
  const std::vector<Printed> found = stack_.instances("ei", GetParam().className);
  ASSERT_THAT(found, SizeIs(GetParam().objects.size()));
  for (std::size_t i = 0; i < found.size(); ++i) {
    EXPECT_EQ(withoutHost(found[i].path), "root/cimv2:" + GetParam().objects[i]);
    EXPECT_EQ(found[i].values, GetParam().values[i]);
  }
}

TEST_P(CompositeClassTest, EnumeratesItsNamesInTheRequestsNamespace) {
  std::vector<std::string> expected;
  for (const std::string& object : GetParam().objects) {
    expected.push_back("root/cimv2:" + object);
  }
  std::vector<std::string> found = stack_.paths("ein", GetParam().className);
  for (std::string& path : found) {
    path = withoutHost(path);
  }
  EXPECT_EQ(found, expected);
}

TEST_P(CompositeClassTest, GetsEachInstanceByTheNameThatItEnumerated) {
  const std::vector<std::string> names = stack_.names("ein", GetParam().className);
  ASSERT_THAT(names, SizeIs(GetParam().values.size()));
  for (std::size_t i = 0; i < names.size(); ++i) {
    EXPECT_EQ(stack_.get(names[i]), GetParam().values[i]);
  }
}

TEST_P(CompositeClassTest, IsFoundInAnyLetterCase) {
  std::string shouted = GetParam().className;
  for (char& letter : shouted) {
    letter = static_cast<char>(std::toupper(static_cast<unsigned char>(letter)));
  }
  EXPECT_EQ(stack_.names("ein", shouted), GetParam().objects);
  EXPECT_THAT(stack_.instances("ei", shouted), SizeIs(GetParam().objects.size()));
}

TEST_P(CompositeClassTest, RefusesKeysThatMatchNothing) {
  std::string strange = GetParam().objects.front();
  strange.replace(strange.find('"'), 1, "\"strange");
  EXPECT_THAT(stack_.failure("gi", strange), HasSubstr("(6) CIM_ERR_NOT_FOUND"));
}

TEST_P(CompositeClassTest, KeepsEveryPropertyThatAnEnumerationNamesInAPropertyList) {
  const Values& all = GetParam().values.front();
  for (const auto& [name, value] : all) {
    const std::vector<Printed> found = stack_.instances("ei", GetParam().className, name);
    ASSERT_THAT(found, SizeIs(GetParam().objects.size()));
    EXPECT_THAT(found.front().names, ElementsAre(name));
    EXPECT_EQ(found.front().values, (Values{{name, value}}));
    EXPECT_EQ(objectOf(found.front().path), GetParam().objects.front());
  }
}

INSTANTIATE_TEST_SUITE_P(Every, CompositeClassTest, testing::ValuesIn(classCases()),
                         [](const auto& row) { return row.param.className; });

class CompositeInstancesTest : public testing::Test {
 protected:
  std::string namesUnder(const std::string& underlyingClass) const {
    return stack_.wbemcli("ein", underlyingClass, {}, "root/yrnse").output;
  }

  Composite composite_;
  const CompositeStack& stack_ = composite_.stack;
};

TEST_F(CompositeInstancesTest, LeaveOutWhatBelongsToTheHost) {
  // Every machine has a loopback interface, which the underlying provider tells of as the host's.
  EXPECT_THAT(namesUnder("YRNQV_IPProtocolEndpoint"),
              AllOf(HasSubstr(R"(SystemCreationClassName="YRNQV_ComputerSystem",SystemName="managed.example")"),
                    HasSubstr(R"(Name="lo")")));
  for (const char* settingClass : {"YRNQV_StaticIPAssignmentSettingData", "YRNQV_DHCPSettingData"}) {
    EXPECT_THAT(namesUnder(settingClass), AllOf(HasSubstr(R"("Host:lo")"), HasSubstr(R"("BMC:eth0")")));
  }
  EXPECT_THAT(namesUnder("YRNQV_IPAssignmentSettingData"), HasSubstr(R"("Host:lo:static")"));
  EXPECT_THAT(namesUnder("YRNQV_IPRemoteServiceAccessPoint"),
              HasSubstr(R"(SystemCreationClassName="YRNQV_ComputerSystem",SystemName="managed.example")"));

  for (const ClassCase& row : classCases()) {
    for (const std::string& name : stack_.names("ein", row.className)) {
      EXPECT_THAT(name, AllOf(Not(HasSubstr("\"lo\"")), Not(HasSubstr("Host:")), Not(HasSubstr("managed.example"))));
    }
  }
}

TEST_F(CompositeInstancesTest, ShowWithSeveralPropertiesWhatWasAskedInAnyLetterCase) {
  const auto found = stack_.instances("gi", endpoint("eth0"), "ipv4address,SUBNETMASK,ElementName");
  ASSERT_THAT(found, SizeIs(1));
  EXPECT_EQ(found[0].values, (Values{{"IPv4Address", R"("192.0.2.10")"},
                                     {"SubnetMask", R"("255.255.255.0")"},
                                     {"ElementName", R"("BMC IP endpoint eth0")"}}));
}

TEST_F(CompositeInstancesTest, AnswerForTheirSuperclasses) {
  std::vector<std::string> accessPoints = {endpoint("eth0"), endpoint("eth1"), remoteAccessPoint("Gateway:eth0"),
                                           remoteAccessPoint("DNS:1"), remoteAccessPoint("DNS:2")};
  EXPECT_THAT(stack_.names("ein", "CIM_ServiceAccessPoint"), testing::UnorderedElementsAreArray(accessPoints));
  EXPECT_THAT(stack_.instances("ei", "CIM_ServiceAccessPoint"), SizeIs(5));
  EXPECT_THAT(stack_.names("ein", "CIM_ComputerSystem"), ElementsAre(computerSystem()));
  EXPECT_THAT(stack_.names("ein", "CIM_SettingData"), SizeIs(8));
  accessPoints.push_back(computerSystem());
  EXPECT_THAT(stack_.names("ein", "CIM_ManagedElement"), IsSupersetOf(accessPoints));
}

TEST_F(CompositeInstancesTest, AreNotInAnUnknownClassOrNamespace) {
  EXPECT_THAT(stack_.failure("ei", "YRNx_MgmtHwNothing"), HasSubstr("(5) CIM_ERR_INVALID_CLASS"));
  EXPECT_THAT(stack_.failure("ein", "YRNx_MgmtHwNothing"), HasSubstr("(5) CIM_ERR_INVALID_CLASS"));
  EXPECT_THAT(stack_.failure("ei", Classes::computerSystem, {}, "root/nowhere"),
              HasSubstr("(3) CIM_ERR_INVALID_NAMESPACE"));
  EXPECT_EQ(stack_.names("ein", Classes::computerSystem), std::vector{computerSystem()});
}

}  // namespace
