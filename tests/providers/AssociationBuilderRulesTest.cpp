// SPDX-License-Identifier: Apache-2.0
// What single builders do beside the pairing: the systems that cannot be had, the flags of element setting data, the
// markers of ordered members.
#include "tests/providers/AssociationTest.h"

namespace {

using namespace Testing;

namespace Classes = Classes;

class HostedAccessPointBuilderTest : public AssociationTest {};

TEST_F(HostedAccessPointBuilderTest, ABrokerOutOfMemoryForTheComputerSystemsIsAnEmptySuccess) {
  for (const char* className : {Classes::hostedAccessPoint, Classes::remoteHostedAccessPoint}) {
    attach(modelOf(className));
    addEnds({"bmc0"}, {"one"});
    faults.failNewArray = true;
    logLines().clear();
    std::vector<CMPIInstance*> out;
    EXPECT_EQ(build(out), 0);
    EXPECT_TRUE(out.empty());
    EXPECT_EQ(unitLines(), brokenOff(model().builderName, ""));
  }
}

class ElementSettingDataBuilderTest : public AssociationTest {
 protected:
  ElementSettingDataBuilderTest() {
    attach(modelOf(Classes::elementSettingData));
    addEnds({"eth0"}, {"BMC:eth0:static"});
  }

  // "IsDefault IsCurrent IsNext" of the instance for the sequence when its path is this one.
  std::string flagsFor(CMPIObjectPath* sequencePath) {
    faults.onNewInstance = [=](const std::string& className, int, CMPIInstance* instance) {
      if (className == Classes::sequence) {
        withPath(instance, sequencePath);
      }
    };
    std::vector<CMPIInstance*> out;
    EXPECT_EQ(build(out), 0);
    EXPECT_EQ(out.size(), 1U);
    return out.empty() ? "" : flagsOf(out.front());
  }
  std::string flagsFor(const std::string& identifier) {
    return flagsFor(makePath(Classes::sequence, {{"InstanceID", identifier}}));
  }
  static std::string flagsOf(const CMPIInstance* instance) {
    return std::to_string(number(instance, "IsDefault")) + " " + std::to_string(number(instance, "IsCurrent")) + " " +
           std::to_string(number(instance, "IsNext"));
  }
};

TEST_F(ElementSettingDataBuilderTest, MoreThanTwoFieldsAreNeitherDefaultNorCurrent) {
  EXPECT_EQ(flagsFor("BMC:eth0:static"), "2 2 3");
  EXPECT_EQ(flagsFor("a:b:c:d"), "2 2 3");
}

TEST_F(ElementSettingDataBuilderTest, UpToTwoFieldsAreDefaultAndCurrent) {
  EXPECT_EQ(flagsFor("BMC:eth0"), "1 1 3");
  EXPECT_EQ(flagsFor("BMC"), "1 1 3");
  EXPECT_EQ(flagsFor(""), "1 1 3");
}

TEST_F(ElementSettingDataBuilderTest, EmptyFieldsDoNotCount) {
  EXPECT_EQ(flagsFor("BMC::eth0:"), "1 1 3");
  EXPECT_EQ(flagsFor(":::"), "1 1 3");
}

TEST_F(ElementSettingDataBuilderTest, AnIdentifierThatCannotBeReadIsDefaultAndCurrent) {
  EXPECT_EQ(flagsFor(makePath(Classes::sequence)), "1 1 3");
  const CMPIData nullString = {CMPI_string, CMPI_keyValue, {}};
  EXPECT_EQ(flagsFor(withKey(makePath(Classes::sequence), "InstanceID", nullString)), "1 1 3");
  const CMPIData nullValue = {CMPI_string, CMPI_keyValue | CMPI_nullValue, {}};
  EXPECT_EQ(flagsFor(withKey(makePath(Classes::sequence), "InstanceID", nullValue)), "1 1 3");
}

TEST_F(ElementSettingDataBuilderTest, AnIdentifierThatWasReadWithAnErrorIsDefaultAndCurrentEvenWithAValueBesideIt) {
  CMPIData identifier = {CMPI_string, CMPI_keyValue, {}};
  identifier.value.string = CMNewString(faults.real(), "BMC:eth0:static", nullptr);
  const auto path = [&](CMPIrc rc) { return withKey(makePath(Classes::sequence), "InstanceID", identifier, rc); };
  EXPECT_EQ(flagsFor(path(CMPI_RC_OK)), "2 2 3");
  EXPECT_EQ(flagsFor(path(CMPI_RC_ERR_FAILED)), "1 1 3");
  identifier.value.string = withCode(identifier.value.string, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(flagsFor(path(CMPI_RC_OK)), "1 1 3");
}

TEST_F(ElementSettingDataBuilderTest, TheEndpointPlaysNoPart) {
  faults.upCallScripts.clear();
  addEnds({"eth0", "eth1"}, {"BMC:eth0:static"});
  std::vector<CMPIInstance*> out;
  EXPECT_EQ(build(out), 0);
  ASSERT_EQ(out.size(), 2U);
  EXPECT_EQ(flagsOf(out[0]), "2 2 3");
  EXPECT_EQ(flagsOf(out[1]), "2 2 3");
}

class OrderedMemberBuilderTest : public AssociationTest, public ::testing::WithParamInterface<const char*> {
 protected:
  OrderedMemberBuilderTest()
      : isStatic(GetParam() == std::string(Classes::staticOrderedMember)),
        marker(isStatic ? "static" : "dhcp"),
        othersMarker(isStatic ? "dhcp" : "static") {
    attach(modelOf(GetParam()));
  }

  // The group components of what is built, in order.
  Strings groups() {
    std::vector<CMPIInstance*> out;
    EXPECT_EQ(build(out), 0);
    Strings all;
    for (const CMPIInstance* instance : out) {
      all.push_back(render(reference(instance, "GroupComponent")));
    }
    return all;
  }
  static std::string sequence(const std::string& name) { return homedReference(Classes::sequence, name); }

  const bool isStatic;
  const std::string marker;
  const std::string othersMarker;
};

TEST_P(OrderedMemberBuilderTest, OnlySequencesWithTheMarkerHaveMembers) {
  addEnds({"BMC:eth0"}, {"BMC:eth0:" + othersMarker, "BMC:eth0:" + marker, "BMC:eth0:none"});
  EXPECT_EQ(groups(), (Strings{sequence("BMC:eth0:" + marker)}));
  EXPECT_EQ(unitLines(), framed(model().builderName));
}

TEST_P(OrderedMemberBuilderTest, TheMarkerCountsAnywhereAlsoInALongerWord) {
  addEnds({"BMC:eth0"}, {"BMC:my" + marker + "ally:x", "BMC:x:no-" + marker});
  EXPECT_EQ(groups(), (Strings{sequence("BMC:my" + marker + "ally:x"), sequence("BMC:x:no-" + marker)}));
}

TEST_P(OrderedMemberBuilderTest, TheMarkerIsSearchedWithRegardToCase) {
  addEnds({"BMC:eth0"},
          {isStatic ? "BMC:eth0:STATIC" : "BMC:eth0:DHCP", isStatic ? "BMC:eth0:Static" : "BMC:eth0:Dhcp"});
  EXPECT_EQ(groups(), Strings{});
}

TEST_P(OrderedMemberBuilderTest, ASettingIsAMemberWhateverItsOwnIdentifier) {
  addEnds({"BMC:eth0", "BMC:elsewhere"}, {"BMC:eth0:" + marker});
  EXPECT_EQ(groups(), (Strings{sequence("BMC:eth0:" + marker), sequence("BMC:eth0:" + marker)}));
}

TEST_P(OrderedMemberBuilderTest, ASettingsIdentifierIsReadOnceForEverySetting) {
  addEnds({"BMC:eth0", "BMC:eth1"}, {"BMC:eth0:" + marker});
  Strings read;
  faults.onNewInstance = [&](const std::string& className, int call, CMPIInstance* instance) {
    if (className == model().outer) {
      withPath(instance,
               withKeysRecorded(makePath(className, {{"InstanceID", "BMC:eth" + std::to_string(call)}}), read));
    }
  };
  EXPECT_EQ(groups(), (Strings{sequence("BMC:eth0:" + marker), sequence("BMC:eth0:" + marker)}));
  EXPECT_EQ(read, (Strings{"InstanceID", "InstanceID"}));
}

TEST_P(OrderedMemberBuilderTest, ASequenceWithoutReadableIdentifierHasNoMembers) {
  addEnds({"BMC:eth0"}, {"BMC:eth0:" + marker});
  faults.onNewInstance = [&](const std::string& className, int, CMPIInstance* instance) {
    if (className == Classes::sequence) {
      withPath(instance, makePath(Classes::sequence));
    }
  };
  EXPECT_EQ(groups(), Strings{});
}

TEST_P(OrderedMemberBuilderTest, NothingIsAskedOfTheBrokerForASequenceWithoutMarker) {
  addEnds({"BMC:eth0"}, {"BMC:eth0:" + othersMarker});
  faults.failNewObjectPath = [&](const std::string& className, int) { return className == model().className; };
  EXPECT_EQ(groups(), Strings{});
  EXPECT_EQ(unitLines(), framed(model().builderName));
}

INSTANTIATE_TEST_SUITE_P(Two, OrderedMemberBuilderTest,
                         ::testing::Values(Classes::staticOrderedMember, Classes::dhcpOrderedMember),
                         [](const auto& parameter) { return std::string(parameter.param); });

}  // namespace
