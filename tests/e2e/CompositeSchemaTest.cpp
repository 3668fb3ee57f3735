// SPDX-License-Identifier: Apache-2.0
// The classes as a client of cimomd sees them, and what they say of the instances.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cimom/schema/ClassRepository.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Pattern.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class CompositeSchemaTest : public testing::Test {
 protected:
  // The properties of a class whose Write qualifier is true, as GetClass shows them.
  std::vector<std::string> writable(const std::string& className) const {
    const std::string shown = stack_.wbemcli("-dx gc", className).errors;
    std::vector<std::string> names;
    const Pattern write("NAME=\"Write\"[^>]*><VALUE>TRUE");
    for (const Pattern::Match& property : Pattern("<PROPERTY[^ ]* NAME=\"(\\w+)\".*?</PROPERTY").all(shown)) {
      if (!write.first(property[0]).empty()) {
        names.push_back(property[1]);
      }
    }
    return names;
  }

  TemporaryDirectory directory_;
  const CompositeStack stack_{simulatedProcessor(directory_.path() / "processor.json")};
};

TEST_F(CompositeSchemaTest, ShowsAddressAndMaskAsWritable) {
  // EnabledDefault is the DMTF's.
  EXPECT_THAT(writable("YRNx_MgmtHwIPProtocolEndPoint"), ElementsAre("EnabledDefault", "IPv4Address", "SubnetMask"));
  EXPECT_THAT(writable("YRNx_MgmtHwStaticIPAssignmentSettingData"), ElementsAre("IPv4Address", "SubnetMask"));
  EXPECT_THAT(writable("CIM_IPProtocolEndpoint"), ElementsAre("EnabledDefault"));
  EXPECT_THAT(writable("CIM_StaticIPAssignmentSettingData"), Contains("GatewayIPv4Address"));
}

TEST_F(CompositeSchemaTest, ShowsEveryClassInItsOwnNamespaceOnly) {
  const auto classesIn = [&](const char* nameSpace) { return stack_.wbemcli("ecn", "", {}, nameSpace).output; };
  EXPECT_THAT(classesIn("root/cimv2"), AllOf(HasSubstr(":YRNx_MgmtHwClientAccess"), HasSubstr(":CIM_ComputerSystem"),
                                             HasSubstr(":CIM_OrderedComponent"), Not(HasSubstr("YRNQV_"))));
  EXPECT_THAT(classesIn("root/yrnse"), AllOf(HasSubstr(":YRNQV_SPComputerSystem"), HasSubstr(":CIM_ComputerSystem"),
                                             Not(HasSubstr("YRNx_")), Not(HasSubstr("CIM_OrderedComponent"))));
  EXPECT_THAT(stack_.failure("ei", "YRNQV_SPComputerSystem"), HasSubstr("(5) CIM_ERR_INVALID_CLASS"));
  EXPECT_THAT(stack_.failure("gc", "YRNQV_SPComputerSystem"), HasSubstr("(6) CIM_ERR_NOT_FOUND"));
}

// Whatever a client sees either stands in our class, with its meaning, or is what the schema gives by default.
TEST_F(CompositeSchemaTest, DeclaresEveryValueThatAnInstanceShows) {
  Cimom::ClassRepository repository;
  repository.add(Cimom::MofReader().readPath(built("share/cimomd")));
  for (const Cimom::ClassDefinition* definition : repository.all()) {
    if (!definition->name.starts_with("YRN")) {
      continue;
    }
    const char* nameSpace = definition->name.starts_with("YRNQV_") ? "root/yrnse" : "root/cimv2";
    const std::vector<Printed> instances = stack_.instances("ei", definition->name, {}, nameSpace);
    EXPECT_THAT(instances, Not(IsEmpty())) << definition->name;
    for (const Printed& instance : instances) {
      for (const auto& [name, value] : instance.values) {
        const Cimom::PropertyDeclaration* property = definition->findProperty(name);
        ASSERT_TRUE(property) << definition->name << '.' << name;
        EXPECT_TRUE(Cimom::findQualifier(property->qualifiers, "Description") ||
                    value == property->defaultValue.toString())
            << definition->name << '.' << name << " = " << value;
      }
    }
  }
}

}  // namespace
