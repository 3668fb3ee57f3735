// SPDX-License-Identifier: Apache-2.0
// The six association classes of a simulated management processor in its factory state, walked with wbemcli from each
// end of each.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>

#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/client/FactoryState.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::ContainsRegex;
using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Key;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;
using testing::UnorderedElementsAreArray;

// A reference as wbemcli prints it, without host and namespace: "managed.example/root/cimv2Class.keys".
std::string referenceOf(const std::string& printed) {
  const std::string nameSpace = "root/cimv2";
  return printed.substr(printed.find(nameSpace) + nameSpace.size());
}

// The ends of an association, by the names of its references: "Class.First=a,Second=b".
using Ends = std::map<std::string, std::string>;

class CompositeAssociationTest : public testing::Test {
 protected:
  // From the values of an instance: those that hold a path.
  static Ends endsOf(const Printed& instance) {
    Ends ends;
    for (const auto& [name, value] : instance.values) {
      if (value.find("root/cimv2") != std::string::npos) {
        ends[name] = referenceOf(value);
      }
    }
    return ends;
  }

  // "Class.First=host/root/cimv2Class.keys,Second=host/root/cimv2Class.keys" as a client passes it on to wbemcli, which
  // does not take the references in the form in which it prints them.
  static std::string asArgument(const std::string& printed) {
    std::string argument = printed;
    for (std::size_t at; (at = argument.find("managed.example/root/cimv2")) != std::string::npos;) {
      argument.erase(at, std::string("managed.example/root/cimv2").size());
    }
    return argument;
  }

  static std::string scoped(const char* operation, const char* option, const std::string& className) {
    return std::string(operation) + ' ' + option + ' ' + className;
  }

  TemporaryDirectory directory_;
  CompositeStack stack_{simulatedProcessor(directory_.path() / "processor.json")};
};

TEST_F(CompositeAssociationTest, AnswersTheFarEndsOfEachEnd) {
  for (const View& view : views()) {
    SCOPED_TRACE(std::string(view.association) + " from " + view.source);
    EXPECT_EQ(stack_.names(scoped("ain", "-ac", view.association), view.source), view.far);
    Objects found;
    for (const Printed& instance : stack_.instances(scoped("ai", "-ac", view.association), view.source)) {
      found.push_back(objectOf(instance.path));
    }
    EXPECT_EQ(found, view.far);
  }
}

TEST_F(CompositeAssociationTest, NamesTheManagedSystemAsTheHostOfWhatItAnswers) {
  for (const View& view : views()) {
    EXPECT_THAT(stack_.paths(scoped("ain", "-ac", view.association), view.source),
                AllOf(Not(IsEmpty()), Each(StartsWith("managed.example/root/cimv2:"))));
  }
}

TEST_F(CompositeAssociationTest, NamesTheManagedSystemAlikeInAllThatItAnswers) {
  for (const char* operation : {"ri", "rin", "ai", "ain"}) {
    for (const std::string& source : {endpoint("eth0"), sequence("eth0:dhcp")}) {
      const std::string shown = stack_.wbemcli(std::string("-dx ") + operation, source).errors;
      const std::string answer = shown.substr(shown.find("SIMPLERSP"));
      EXPECT_THAT(answer, HasSubstr("<HOST>managed.example</HOST>")) << operation;
      EXPECT_THAT(answer, Not(ContainsRegex("<HOST>[^m]"))) << operation;
    }
  }
}

TEST_F(CompositeAssociationTest, AnswersWholeInstances) {
  for (const Printed& found : stack_.instances("ai", computerSystem())) {
    EXPECT_EQ(found.values, stack_.get(objectOf(found.path)));
  }
  for (const Printed& found : stack_.instances("ai", sequence("eth1:dhcp"))) {
    EXPECT_EQ(found.values, stack_.get(objectOf(found.path)));
  }
}

TEST_F(CompositeAssociationTest, AnswersThroughEveryAssociationWhereNoneIsNamed) {
  std::map<std::string, Objects> everything;
  for (const View& view : views()) {
    Objects& far = everything[view.source];
    far.insert(far.end(), view.far.begin(), view.far.end());
  }
  for (const auto& [source, far] : everything) {
    SCOPED_TRACE(source);
    EXPECT_THAT(stack_.names("ain", source), UnorderedElementsAreArray(far));
    EXPECT_THAT(stack_.instances("ai", source), SizeIs(far.size()));
    EXPECT_THAT(stack_.names("rin", source), SizeIs(far.size()));
    EXPECT_THAT(stack_.instances("ri", source), SizeIs(far.size()));
  }
}

TEST_F(CompositeAssociationTest, ReferencesBothEnds) {
  for (const View& view : views()) {
    SCOPED_TRACE(std::string(view.association) + " from " + view.source);
    const auto found = stack_.instances(scoped("ri", "-arc", view.association), view.source);
    ASSERT_THAT(found, SizeIs(view.far.size()));
    const bool members = view.association == std::string(Classes::staticOrderedMember) ||
                         view.association == std::string(Classes::dhcpOrderedMember);
    for (std::size_t i = 0; i < found.size(); ++i) {
      const Ends ends = endsOf(found[i]);
      ASSERT_THAT(ends, ElementsAre(Key(members ? "GroupComponent" : "Antecedent"),
                                    Key(members ? "PartComponent" : "Dependent")));
      const std::set<std::string> both = {ends.begin()->second, ends.rbegin()->second};
      EXPECT_EQ(both, (std::set<std::string>{view.source, view.far[i]}));
    }
  }
}

TEST_F(CompositeAssociationTest, ReferencesEndsByTheNamesOfTheirRoles) {
  const auto ends = [&](const char* association, const std::string& source) {
    return endsOf(stack_.instances(scoped("ri", "-arc", association), source).front());
  };
  EXPECT_EQ(ends(Classes::hostedAccessPoint, endpoint("eth1")),
            (Ends{{"Antecedent", computerSystem()}, {"Dependent", endpoint("eth1")}}));
  EXPECT_EQ(ends(Classes::remoteHostedAccessPoint, remoteAccessPoint("DNS:1")),
            (Ends{{"Antecedent", computerSystem()}, {"Dependent", remoteAccessPoint("DNS:1")}}));
  EXPECT_EQ(ends(Classes::clientAccess, endpoint("eth1")),
            (Ends{{"Antecedent", remoteAccessPoint("Gateway:eth0")}, {"Dependent", endpoint("eth1")}}));
  EXPECT_EQ(ends(Classes::elementSettingData, endpoint("eth1")),
            (Ends{{"Antecedent", sequence("eth0:static")}, {"Dependent", endpoint("eth1")}}));
  EXPECT_EQ(ends(Classes::staticOrderedMember, sequence("eth1:dhcp")),
            (Ends{{"GroupComponent", sequence("eth1:dhcp")}, {"PartComponent", staticSetting("eth1")}}));
  EXPECT_EQ(ends(Classes::dhcpOrderedMember, dhcpSetting("eth1")),
            (Ends{{"GroupComponent", sequence("eth1:dhcp")}, {"PartComponent", dhcpSetting("eth1")}}));
}

TEST_F(CompositeAssociationTest, NamesItsReferencesByBothEnds) {
  for (const View& view : views()) {
    SCOPED_TRACE(std::string(view.association) + " from " + view.source);
    const Objects names = stack_.names(scoped("rin", "-arc", view.association), view.source);
    ASSERT_THAT(names, SizeIs(view.referenceNames.size()));
    for (std::size_t i = 0; i < names.size(); ++i) {
      EXPECT_THAT(names[i], StartsWith(std::string(view.association) + '.'));
      // The keys of this one are references that its References does not set, so its names have none.
      if (view.association == std::string(Classes::elementSettingData)) {
        continue;
      }
      EXPECT_THAT(names[i], AllOf(HasSubstr(view.source), HasSubstr(view.referenceNames[i])));
    }
  }
}

class CompositeAssociationClassTest : public CompositeAssociationTest, public testing::WithParamInterface<Enumeration> {
 protected:
  static std::string pathOf(const std::pair<std::string, std::string>& ends) {
    const Enumeration& row = GetParam();
    return std::string(row.association) + '.' + row.first + "=managed.example/root/cimv2" + ends.first + ',' +
           row.second + "=managed.example/root/cimv2" + ends.second;
  }

  static void expectEnds(const Printed& instance, const std::pair<std::string, std::string>& ends) {
    EXPECT_EQ(endsOf(instance), (Ends{{GetParam().first, ends.first}, {GetParam().second, ends.second}}));
  }
};

TEST_P(CompositeAssociationClassTest, EnumeratesItsPairs) {
  const auto found = stack_.instances("ei", GetParam().association);
  const auto& pairs = GetParam().pairs;
  ASSERT_THAT(found, SizeIs(pairs.size()));
  for (std::size_t i = 0; i < pairs.size(); ++i) {
    EXPECT_EQ(objectOf(found[i].path), pathOf(pairs[i]));
    expectEnds(found[i], pairs[i]);
  }
}

TEST_P(CompositeAssociationClassTest, EnumeratesItsNames) {
  Objects expected;
  for (const auto& pair : GetParam().pairs) {
    expected.push_back(pathOf(pair));
  }
  EXPECT_EQ(stack_.names("ein", GetParam().association), expected);
}

TEST_P(CompositeAssociationClassTest, GetsEachInstanceByTheNameThatItEnumerated) {
  const Objects names = stack_.names("ein", GetParam().association);
  ASSERT_THAT(names, SizeIs(GetParam().pairs.size()));
  for (std::size_t i = 0; i < names.size(); ++i) {
    const auto found = stack_.instances("gi", asArgument(names[i]));
    ASSERT_THAT(found, SizeIs(1));
    expectEnds(found.front(), GetParam().pairs[i]);
  }
}

TEST_P(CompositeAssociationClassTest, DoesNotFindAPairThatIsNone) {
  std::string strange = asArgument(stack_.names("ein", GetParam().association).front());
  strange.replace(strange.find("\"BMC"), 4, "\"Strange");
  EXPECT_THAT(stack_.failure("gi", strange), HasSubstr("(6) CIM_ERR_NOT_FOUND"));
}

INSTANTIATE_TEST_SUITE_P(Every, CompositeAssociationClassTest, testing::ValuesIn(enumerations()),
                         [](const auto& row) { return row.param.association; });

TEST_F(CompositeAssociationTest, OfSequencesToEndpointsSaysHowTheyRelate) {
  for (const Printed& instance : stack_.instances("ei", Classes::elementSettingData)) {
    EXPECT_EQ(instance.values.at("IsDefault"), "2");
    EXPECT_EQ(instance.values.at("IsCurrent"), "2");
    EXPECT_EQ(instance.values.at("IsNext"), "3");
  }
  for (const Printed& instance :
       stack_.instances(scoped("ri", "-arc", Classes::elementSettingData), endpoint("eth0"))) {
    EXPECT_THAT(instance.values, Not(Contains(Key("IsNext"))));
  }
}

TEST_F(CompositeAssociationTest, AnswersForItsSuperclass) {
  EXPECT_THAT(stack_.names("ein", "CIM_HostedAccessPoint"), SizeIs(5));
  EXPECT_THAT(stack_.names("ain -ac CIM_HostedAccessPoint", computerSystem()), SizeIs(5));
  EXPECT_THAT(stack_.names("ain -ac CIM_Component", sequence("eth0:dhcp")),
              ElementsAre(staticSetting("eth0"), dhcpSetting("eth0")));
}

TEST_F(CompositeAssociationTest, IsFoundInAnyLetterCase) {
  EXPECT_EQ(stack_.names("ain -ac yrnx_mgmthwiphostedaccesspoint", endpoint("eth0")), Objects{computerSystem()});
}

TEST_F(CompositeAssociationTest, AnswersNothingForAnObjectThatHasNoPartInIt) {
  EXPECT_THAT(stack_.names(scoped("ain", "-ac", Classes::staticOrderedMember), endpoint("eth0")), IsEmpty());
  EXPECT_THAT(stack_.names(scoped("rin", "-arc", Classes::hostedAccessPoint), dhcpSetting("eth0")), IsEmpty());
}

TEST_F(CompositeAssociationTest, AnswersNothingForAnObjectThatIsNotThere) {
  for (const char* operation : {"ain", "ai", "rin", "ri"}) {
    EXPECT_THAT(stack_.failure(operation, staticSetting("eth9")), HasSubstr("(6) CIM_ERR_NOT_FOUND")) << operation;
  }
  const CompositeStack bare(simulatedProcessor(directory_.path() / "processor.json"), 6000, CompositeStack::bare());
  EXPECT_THAT(bare.names(scoped("ain", "-ac", Classes::staticOrderedMember), staticSetting("eth9")), IsEmpty());
}

TEST_F(CompositeAssociationTest, AnswersByRoleAndResultClass) {
  const Objects endpoints = {endpoint("eth0"), endpoint("eth1")};
  EXPECT_EQ(stack_.names("ain -arc YRNx_MgmtHwIPProtocolEndPoint", computerSystem()), endpoints);
  EXPECT_THAT(stack_.names("ain -arc CIM_ServiceAccessPoint -ar Antecedent", computerSystem()), SizeIs(5));
  EXPECT_THAT(stack_.names("ain -ar Dependent", computerSystem()), IsEmpty());
  EXPECT_EQ(stack_.names("ain -arr Antecedent -arc CIM_System", endpoint("eth0")), Objects{computerSystem()});
  EXPECT_THAT(stack_.instances("ai -arr SettingData", endpoint("eth0")), SizeIs(4));
  EXPECT_THAT(stack_.instances("ri -ar Antecedent", computerSystem()), SizeIs(5));
  EXPECT_THAT(stack_.names("rin -ar Dependent", computerSystem()), IsEmpty());
  EXPECT_THAT(stack_.failure("ain -arc YRNx_MgmtHwNothing", computerSystem()),
              HasSubstr("(4) CIM_ERR_INVALID_PARAMETER: unknown result class \"YRNx_MgmtHwNothing\""));
}

// The library consults neither roles nor the result class, and names the ends of one association in References as none
// of its instances does.
TEST_F(CompositeAssociationTest, IsTheLibrarysOwnWhereNothingIsChecked) {
  const CompositeStack bare(simulatedProcessor(directory_.path() / "processor.json"), 6000, CompositeStack::bare());
  EXPECT_THAT(bare.names("ain -ar Nothing -arc CIM_Nothing", computerSystem()), SizeIs(5));
  const std::string byRole = scoped("ri", "-arc", Classes::elementSettingData) + " -ar ";
  EXPECT_THAT(bare.instances(byRole + "ManagedElement", endpoint("eth0")), SizeIs(4));
  EXPECT_THAT(stack_.instances(byRole + "ManagedElement", endpoint("eth0")), IsEmpty());
  EXPECT_THAT(stack_.instances(byRole + "Dependent", endpoint("eth0")), SizeIs(4));
}

TEST_F(CompositeAssociationTest, OfAnUnknownClassIsAnError) {
  EXPECT_THAT(stack_.failure("ain -ac YRNx_MgmtHwNothing", endpoint("eth0")),
              HasSubstr("(4) CIM_ERR_INVALID_PARAMETER: unknown association class \"YRNx_MgmtHwNothing\""));
}

}  // namespace
