// SPDX-License-Identifier: Apache-2.0
// How the association operations of the two ordered members decide by "InstanceID" what belongs together.
#include "tests/providers/AssociationTest.h"

namespace {

using namespace Testing;

namespace Classes = Classes;

struct OrderedMember {
  const char* className;
  Navigation navigation;
  std::string kindWord;
};

class OrderedMemberNavigationTest : public AssociationTest, public ::testing::WithParamInterface<OrderedMember> {
 protected:
  OrderedMemberNavigationTest() { attach(modelOf(GetParam().className)); }

  const std::string& settingClass() const { return model().endB; }
  static std::string othersWord() { return GetParam().kindWord == "static" ? "dhcp" : "static"; }

  // The identifiers of what the operation associates with the source, in order.
  Strings associated(const CMPIObjectPath* source) {
    logLines().clear();
    const Answer answer = navigate(GetParam().navigation, source);
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(GetParam().navigation)));
    const bool fromSequence = classOf(source) == Classes::sequence;
    Strings identifiers;
    for (const CMPIInstance* instance : answer.instances) {
      identifiers.push_back(key(GetParam().navigation == Navigation::Associators
                                    ? pathOf(instance)
                                    : reference(instance, fromSequence ? "PartComponent" : "GroupComponent"),
                                "InstanceID"));
    }
    for (const CMPIObjectPath* path : answer.paths) {
      identifiers.push_back(key(GetParam().navigation == Navigation::AssociatorNames
                                    ? path
                                    : referenceKey(path, fromSequence ? "PartComponent" : "GroupComponent"),
                                "InstanceID"));
    }
    return identifiers;
  }
  Strings sequencesOf(const std::string& setting) { return associated(clientPath(settingClass(), setting)); }
  Strings settingsOf(const std::string& sequence) { return associated(clientPath(Classes::sequence, sequence)); }
};

TEST_P(OrderedMemberNavigationTest, ASettingBelongsToTheSequencesThatContainItAndTheKindWord) {
  add(Classes::sequence, Strings{"BMC:eth0:" + othersWord(), "BMC:eth0:" + GetParam().kindWord,
                                 "BMC:eth1:" + GetParam().kindWord, "BMC:eth0:none"});
  EXPECT_EQ(sequencesOf("BMC:eth0"), (Strings{"BMC:eth0:" + GetParam().kindWord}));
  EXPECT_EQ(sequencesOf("BMC:eth2"), Strings{});
}

TEST_P(OrderedMemberNavigationTest, SettingAndKindWordCountAnywhereInTheSequence) {
  add(Classes::sequence, Strings{"BMC:eth10:x" + GetParam().kindWord + "y", "BMC:" + GetParam().kindWord + ":eth1"});
  EXPECT_EQ(sequencesOf("BMC:eth1"), (Strings{"BMC:eth10:x" + GetParam().kindWord + "y"}));
  EXPECT_EQ(sequencesOf("eth1"),
            (Strings{"BMC:eth10:x" + GetParam().kindWord + "y", "BMC:" + GetParam().kindWord + ":eth1"}));
}

TEST_P(OrderedMemberNavigationTest, ContainmentHasRegardToCase) {
  add(Classes::sequence, Strings{"BMC:eth0:STATIC", "BMC:eth0:DHCP", "BMC:ETH0:" + GetParam().kindWord});
  EXPECT_EQ(sequencesOf("BMC:eth0"), Strings{});
  add(settingClass(), Strings{"BMC:ETH0"});
  EXPECT_EQ(settingsOf("BMC:eth0:" + GetParam().kindWord), Strings{});
}

TEST_P(OrderedMemberNavigationTest, ASequenceHasTheSettingsThatItContainsWhateverItsKind) {
  add(settingClass(), Strings{"BMC:eth0", "BMC:eth1", "BMC:eth"});
  for (const char* kind : {"static", "dhcp", "none"}) {
    EXPECT_EQ(settingsOf(std::string("BMC:eth0:") + kind), (Strings{"BMC:eth0", "BMC:eth"}));
  }
}

TEST_P(OrderedMemberNavigationTest, ASourceWithoutReadableIdentifierCountsAsEmpty) {
  add(Classes::sequence, Strings{"BMC:eth0:" + othersWord(), "BMC:eth1:" + GetParam().kindWord});
  add(settingClass(), Strings{"BMC:eth0"});
  CMPIData wrongType = {CMPI_uint16, CMPI_keyValue, {}};
  wrongType.value.uint16 = 7;
  const CMPIData nullValue = {CMPI_string, CMPI_keyValue | CMPI_nullValue, {}};
  const CMPIData nullString = {CMPI_string, CMPI_keyValue, {}};
  const auto sources = [&](const std::string& className) {
    return std::vector<const CMPIObjectPath*>{makePath(className), makePath(className, {{"InstanceID", ""}}),
                                              withKey(makePath(className), "InstanceID", wrongType),
                                              withKey(makePath(className), "InstanceID", nullValue),
                                              withKey(makePath(className), "InstanceID", nullString)};
  };
  for (const CMPIObjectPath* source : sources(settingClass())) {
    EXPECT_EQ(associated(source), (Strings{"BMC:eth1:" + GetParam().kindWord})) << "the empty text is in every text";
  }
  for (const CMPIObjectPath* source : sources(Classes::sequence)) {
    EXPECT_EQ(associated(source), Strings{});
  }
}

TEST_P(OrderedMemberNavigationTest, AFarInstanceWithoutReadableIdentifierIsSkipped) {
  const CMPIData nullValue = {CMPI_string, CMPI_goodValue | CMPI_nullValue, {}};
  const CMPIData nullString = {CMPI_string, CMPI_goodValue, {}};
  CMPIData wrongType = {CMPI_uint16, CMPI_goodValue, {}};
  wrongType.value.uint16 = 7;
  add(Classes::sequence, Strings{"BMC:eth0:" + GetParam().kindWord});
  add(settingClass(), Strings{"BMC:eth0"});
  for (const CMPIData& identifier : {nullValue, nullString, wrongType}) {
    faults.onNewInstance = [&](const std::string&, int, CMPIInstance* instance) {
      withProperty(instance, "InstanceID", identifier);
    };
    EXPECT_EQ(sequencesOf(""), Strings{});
    EXPECT_EQ(settingsOf("BMC:eth0:" + GetParam().kindWord), Strings{});
  }
}

// The word that each operation looks for. Of the eight, one asks for the other kind's word.
INSTANTIATE_TEST_SUITE_P(
    Eight, OrderedMemberNavigationTest,
    ::testing::Values(OrderedMember{Classes::staticOrderedMember, Navigation::Associators, "static"},
                      OrderedMember{Classes::staticOrderedMember, Navigation::AssociatorNames, "static"},
                      OrderedMember{Classes::staticOrderedMember, Navigation::References, "static"},
                      OrderedMember{Classes::staticOrderedMember, Navigation::ReferenceNames, "static"},
                      OrderedMember{Classes::dhcpOrderedMember, Navigation::Associators, "dhcp"},
                      OrderedMember{Classes::dhcpOrderedMember, Navigation::AssociatorNames, "dhcp"},
                      OrderedMember{Classes::dhcpOrderedMember, Navigation::References, "dhcp"},
                      OrderedMember{Classes::dhcpOrderedMember, Navigation::ReferenceNames, "static"}),
    [](const auto& parameter) { return parameter.param.className + ("_" + nameOf(parameter.param.navigation)); });

}  // namespace
