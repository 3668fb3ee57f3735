// SPDX-License-Identifier: Apache-2.0
// The six associations, walked from either end.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>

#include "tests/hosts/HostTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/FactoryState.h"

namespace {

using namespace Testing;
using testing::Each;
using testing::Eq;
using testing::HasSubstr;
using testing::SizeIs;
using testing::StartsWith;
using testing::UnorderedElementsAreArray;

using Ends = std::map<std::string, std::string>;

class HostAssociationsTest : public HostTest {
 protected:
  static std::string scoped(const char* operation, const char* option, const std::string& className) {
    return std::string(operation) + ' ' + option + ' ' + className;
  }

  // The values that are paths, by the names of the references.
  static Ends endsOf(const Printed& instance) {
    Ends ends;
    for (const auto& [name, value] : instance.values) {
      if (value.find("root/cimv2") != std::string::npos) {
        ends[name] = canonical(value);
      }
    }
    return ends;
  }

  static Objects objectsOf(const std::vector<Printed>& instances) {
    Objects objects;
    for (const Printed& instance : instances) {
      objects.push_back(canonical(objectOf(instance.path)));
    }
    return objects;
  }
};

TEST_F(HostAssociationsTest, AnswerTheFarEndsOfEachEnd) {
  for (const View& view : views()) {
    SCOPED_TRACE(std::string(view.association) + " from " + view.source);
    const Objects far = canonical(view.far);
    EXPECT_EQ(canonical(host().names(scoped("ain", "-ac", view.association), view.source)), far);
    EXPECT_EQ(objectsOf(host().instances(scoped("ai", "-ac", view.association), view.source)), far);
  }
}

TEST_F(HostAssociationsTest, AnswerWholeInstances) {
  for (const std::string& source : {computerSystem(), sequence("eth1:dhcp")}) {
    for (const View& view : views()) {
      if (view.source != source) {
        continue;
      }
      for (const Printed& found : host().instances(scoped("ai", "-ac", view.association), source)) {
        EXPECT_EQ(found.values, host().get(objectOf(found.path)));
      }
    }
  }
}

TEST_F(HostAssociationsTest, ReferToBothEnds) {
  for (const View& view : views()) {
    SCOPED_TRACE(std::string(view.association) + " from " + view.source);
    const auto found = host().instances(scoped("ri", "-arc", view.association), view.source);
    ASSERT_THAT(found, SizeIs(view.far.size()));
    const bool members = view.association == std::string(Classes::staticOrderedMember) ||
                         view.association == std::string(Classes::dhcpOrderedMember);
    const std::vector<std::string> roles = members ? std::vector<std::string>{"GroupComponent", "PartComponent"}
                                                   : std::vector<std::string>{"Antecedent", "Dependent"};
    for (std::size_t i = 0; i < found.size(); ++i) {
      const Ends ends = endsOf(found[i]);
      ASSERT_THAT(ends, testing::ElementsAre(testing::Key(roles[0]), testing::Key(roles[1])));
      const std::set<std::string> both = {ends.at(roles[0]), ends.at(roles[1])};
      EXPECT_EQ(both, (std::set<std::string>{canonical(view.source), canonical(view.far[i])}));
    }
  }
}

TEST_F(HostAssociationsTest, NameTheirReferencesByBothEnds) {
  for (const View& view : views()) {
    SCOPED_TRACE(std::string(view.association) + " from " + view.source);
    const Objects names = canonical(host().names(scoped("rin", "-arc", view.association), view.source));
    ASSERT_THAT(names, SizeIs(view.referenceNames.size()));
    EXPECT_THAT(names, Each(StartsWith(std::string(view.association) + '.')));
    // This class has no keys.
    if (view.association == std::string(Classes::elementSettingData)) {
      continue;
    }
    for (std::size_t i = 0; i < names.size(); ++i) {
      EXPECT_THAT(names[i],
                  testing::AllOf(HasSubstr(canonical(view.source)), HasSubstr(canonical(view.referenceNames[i]))));
    }
  }
}

TEST_F(HostAssociationsTest, WithoutAClassReferToEverythingThatAnEndIsRelatedTo) {
  std::map<std::string, std::size_t> related;
  for (const View& view : views()) {
    related[view.source] += view.far.size();
  }
  for (const auto& [source, count] : related) {
    SCOPED_TRACE(source);
    EXPECT_THAT(host().names("rin", source), SizeIs(count));
    EXPECT_THAT(host().instances("ri", source), SizeIs(count));
  }
}

TEST_F(HostAssociationsTest, WithoutAClassAnswerAllFarEndsOrNone) {
  std::map<std::string, Objects> everything;
  for (const View& view : views()) {
    Objects& far = everything[view.source];
    for (const std::string& object : view.far) {
      far.push_back(canonical(object));
    }
  }
  for (const auto& [source, far] : everything) {
    SCOPED_TRACE(source);
    const Objects found = host().answersWithoutAClass() ? far : Objects{};
    EXPECT_THAT(canonical(host().names("ain", source)), UnorderedElementsAreArray(found));
    EXPECT_THAT(objectsOf(host().instances("ai", source)), UnorderedElementsAreArray(found));
  }
}

TEST_F(HostAssociationsTest, EnumerateTheirPairs) {
  for (const Enumeration& row : enumerations()) {
    const auto found = host().instances("ei", row.association);
    ASSERT_THAT(found, SizeIs(row.pairs.size())) << row.association;
    for (std::size_t i = 0; i < found.size(); ++i) {
      const auto& [first, second] = row.pairs[i];
      EXPECT_EQ(endsOf(found[i]), (Ends{{row.first, canonical(first)}, {row.second, canonical(second)}}));
    }
  }
}

TEST_F(HostAssociationsTest, EnumerateTheirNames) {
  for (const Enumeration& row : enumerations()) {
    const Objects names = canonical(host().names("ein", row.association));
    ASSERT_THAT(names, SizeIs(row.pairs.size())) << row.association;
    if (row.association == std::string(Classes::elementSettingData)) {
      continue;
    }
    for (std::size_t i = 0; i < names.size(); ++i) {
      const auto& [first, second] = row.pairs[i];
      EXPECT_EQ(names[i], std::string(row.association) + '.' + row.first + '=' + canonical(first) + ',' + row.second +
                              '=' + canonical(second));
    }
  }
}

TEST_F(HostAssociationsTest, AreGotByTheNamesThatWereEnumerated) {
  for (const Enumeration& row : enumerations()) {
    // Without keys it cannot be asked for.
    if (row.association == std::string(Classes::elementSettingData)) {
      continue;
    }
    for (const auto& [first, second] : row.pairs) {
      const std::string name =
          std::string(row.association) + '.' + row.first + '=' + first + ',' + row.second + '=' + second;
      const auto found = host().instances("gi", name);
      ASSERT_THAT(found, SizeIs(1)) << name;
      EXPECT_EQ(endsOf(found.front()), (Ends{{row.first, canonical(first)}, {row.second, canonical(second)}}));
    }
  }
}

TEST_F(HostAssociationsTest, OfSequencesSayHowTheyRelate) {
  for (const Printed& instance : host().instances("ei", Classes::elementSettingData)) {
    EXPECT_THAT(instance.values.at("IsDefault"), Eq("2"));
    EXPECT_THAT(instance.values.at("IsCurrent"), Eq("2"));
    EXPECT_THAT(instance.values.at("IsNext"), Eq("3"));
  }
}

}  // namespace
