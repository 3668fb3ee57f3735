// SPDX-License-Identifier: Apache-2.0
// Which underlying instances belong to the management processor.
#include <ostream>

#include "factory/IPConfigObjectFactory.h"
#include "tests/support/composite/Samples.h"

namespace {

using namespace Testing;
using QV::IPConfigComposite::IPConfigObjectFactory;

class SelectionTest : public CompositeTest {
 protected:
  // How many composites of a class the underlying instances yield.
  std::size_t taken(const std::string& className) {
    CMPIInstanceMI* mi = unitOf(className).createInstanceMI(broker(), context(), nullptr);
    RecordingResult result;
    mi->ft->enumerateInstances(mi, context(), result.result(), makePath(className), nullptr);
    return result.instances.size();
  }

  std::size_t takenWithIdentifier(const std::string& className, const std::string& identifier) {
    faults.upCallScripts.clear();
    addUnderlying(sampleOf(className).underlying, {{"InstanceID", identifier}});
    return taken(className);
  }
};

class OwnedSelectionTest : public SelectionTest, public ::testing::WithParamInterface<const char*> {
 protected:
  const Sample& sample() const { return sampleOf(GetParam()); }
};

INSTANTIATE_TEST_SUITE_P(AccessPoints, OwnedSelectionTest,
                         ::testing::Values(Classes::endpoint, Classes::remoteAccessPoint));

TEST_P(OwnedSelectionTest, OnlyThoseOwnedByTheProcessorsClassAreTakenLetterCaseAndAll) {
  for (const std::string owner : {"CIM_UnitaryComputerSystem", "yrnqv_spcomputersystem", "YRNQV_SPComputerSystem2",
                                  "YRNQV_SPComputerSyste", ""}) {
    addUnderlying(sample().underlying, {{"SystemCreationClassName", owner}, {"Name", "other"}});
  }
  addUnderlying(sample().underlying, {{"Name", "without an owner"}});
  addUnderlying(sample().underlying, acceptable(sample(), 1));
  EXPECT_EQ(taken(GetParam()), 1u);
}

TEST_P(OwnedSelectionTest, AnOwnerOfAnotherTypeOrWithoutCharactersIsNone) {
  std::vector<CMPIData> owners = {{CMPI_uint16, CMPI_goodValue, {}}, {CMPI_chars, CMPI_goodValue, {}}};
  for (CMPIString* none : stringsWithoutCharacters()) {
    CMPIData owner = {CMPI_string, CMPI_goodValue, {}};
    owner.value.string = none;
    owners.push_back(owner);
  }
  for (const CMPIData& owner : owners) {
    withProperty(addUnderlying(sample().underlying, acceptable(sample(), 1)), "SystemCreationClassName", owner);
  }
  EXPECT_EQ(taken(GetParam()), 0u);
}

TEST_P(OwnedSelectionTest, AnOwnerMayComeAsBareCharacters) {
  std::string characters = "YRNQV_SPComputerSystem";
  CMPIData owner = {CMPI_chars, CMPI_goodValue, {}};
  owner.value.chars = characters.data();
  withProperty(addUnderlying(sample().underlying, acceptable(sample(), 1)), "SystemCreationClassName", owner);
  EXPECT_EQ(taken(GetParam()), 1u);
}

TEST_F(SelectionTest, EveryComputerSystemIsTaken) {
  addUnderlying("YRNQV_SPComputerSystem", {});
  addUnderlying("YRNQV_SPComputerSystem", {{"CreationClassName", "another"}, {"Name", "host"}});
  EXPECT_EQ(taken(Classes::computerSystem), 2u);
}

struct Identifier {
  const char* text;
  std::size_t asSequence, asSetting;
};

void PrintTo(const Identifier& identifier, std::ostream* stream) { *stream << identifier.text; }

class IdentifierTest : public SelectionTest, public ::testing::WithParamInterface<Identifier> {};

INSTANTIATE_TEST_SUITE_P(Forms, IdentifierTest,
                         ::testing::Values(Identifier{"BMC:a:b", 1, 0}, Identifier{"BMC:a", 0, 1},
                                           Identifier{"BMC:a~b", 0, 1}, Identifier{"BMC::a:", 0, 1},
                                           Identifier{":BMC:a", 0, 1}, Identifier{":BMC::a::b:", 1, 0},
                                           Identifier{"bmc:a", 0, 1}, Identifier{"Bmc:a:b", 1, 0},
                                           Identifier{"BMC", 0, 0}, Identifier{"BMC:a:b:c", 0, 0},
                                           Identifier{"Host1:a", 0, 0}, Identifier{"Host1:a:b", 0, 0},
                                           Identifier{"a:BMC", 0, 0}, Identifier{"BMCa:b", 0, 0}, Identifier{"", 0, 0},
                                           Identifier{":::", 0, 0}));

TEST_P(IdentifierTest, DecidesBetweenSequenceAndSetting) {
  EXPECT_EQ(takenWithIdentifier(Classes::sequence, GetParam().text), GetParam().asSequence);
  EXPECT_EQ(takenWithIdentifier(Classes::staticSetting, GetParam().text), GetParam().asSetting);
  EXPECT_EQ(takenWithIdentifier(Classes::dhcpSetting, GetParam().text), GetParam().asSetting);
}

TEST_F(SelectionTest, ASettingWithoutAnIdentifierIsLeftOut) {
  addUnderlying("YRNQV_IPAssignmentSettingData", {{"ElementName", "nameless"}});
  EXPECT_EQ(taken(Classes::sequence), 0u);
}

TEST_F(SelectionTest, AnIdentifierStaysAsItIs) {
  addUnderlying("YRNQV_StaticIPAssignmentSettingData", {{"InstanceID", "BMC::a:"}});
  CMPIInstanceMI* mi = unitOf(Classes::staticSetting).createInstanceMI(broker(), context(), nullptr);
  RecordingResult result;
  mi->ft->enumerateInstances(mi, context(), result.result(), makePath(Classes::staticSetting), nullptr);
  ASSERT_EQ(result.instances.size(), 1u);
  EXPECT_EQ(text(result.instances[0], "InstanceID"), "BMC::a:");
}

}  // namespace
