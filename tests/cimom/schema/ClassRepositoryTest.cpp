// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>

#include "cimom/model/Errors.h"
#include "cimom/schema/ClassRepository.h"
#include "tests/support/broker/ManagedElements.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;

void load(ClassRepository& repository, std::string_view mof) { repository.add(MofReader().readText(mof, "text")); }

std::string complaint(ClassRepository& repository, std::string_view mof) {
  try {
    load(repository, mof);
  } catch (const ConfigurationError& error) {
    return error.what();
  }
  return {};
}

std::vector<std::string> namesOf(const std::vector<const ClassDefinition*>& classes) {
  std::vector<std::string> names;
  for (const ClassDefinition* one : classes) {
    names.push_back(one->name);
  }
  return names;
}

std::vector<std::string> propertiesOf(const ClassDefinition& definition) {
  std::vector<std::string> names;
  for (const auto& property : definition.properties) {
    names.push_back(property.name);
  }
  return names;
}

class ClassRepositoryTest : public testing::Test {
 protected:
  ClassRepository repository;
};

TEST_F(ClassRepositoryTest, FindsClassesWithoutRegardToCase) {
  load(repository, testSchema);
  ASSERT_NE(repository.find("tst_PROCESSOR"), nullptr);
  EXPECT_EQ(repository.find("tst_PROCESSOR")->name, "TST_Processor");
  EXPECT_EQ(repository.find("TST_Nothing"), nullptr);
}

TEST_F(ClassRepositoryTest, InheritsPropertiesKeysAndMethods) {
  load(repository, testSchema);
  const ClassDefinition& processor = *repository.find("TST_Processor");
  EXPECT_EQ(processor.properties.front().name, "Caption");
  EXPECT_EQ(processor.properties.back().name, "Vendor");
  EXPECT_EQ(processor.findProperty("caption")->originClass, "CIM_Element");
  EXPECT_TRUE(processor.findProperty("Name")->isKey());
  EXPECT_FALSE(processor.findProperty("Vendor")->isKey());
  EXPECT_NE(processor.findMethod("reset"), nullptr);
  EXPECT_TRUE(processor.isA("CIM_ELEMENT"));
  EXPECT_FALSE(repository.find("CIM_Element")->isA("TST_Processor"));
}

TEST_F(ClassRepositoryTest, InheritsQualifiersButTheRestrictedOnes) {
  load(repository, testSchema);
  EXPECT_TRUE(repository.find("TST_Hosted")->isAssociation());
  EXPECT_TRUE(isQualified(repository.find("CIM_Element")->qualifiers, "Abstract"));
  EXPECT_FALSE(isQualified(repository.find("CIM_System")->qualifiers, "Abstract"));
  EXPECT_EQ(findQualifier(repository.find("CIM_System")->qualifiers, "Version"), nullptr);
  EXPECT_EQ(findQualifier(repository.find("TST_Processor")->qualifiers, "Description")->value.toString(),
            "\"A system\"");
}

TEST_F(ClassRepositoryTest, RestrictedQualifiersStayWithTheFeatureThatHasThem) {
  load(repository, R"(
      Qualifier Local : string = null, Scope(any), Flavor(Restricted);
      Qualifier Common : string = null, Scope(any), Flavor(ToSubclass);
      class Base {
        [Local("l"), Common("c")] string Property;
        [Local("l"), Common("c"), Override("Method")] uint32 Method([Local("l"), Common("c")] string Parameter);
      };
      class Derived : Base {};
      class Overriding : Base {
        [Local("o")] string Property;
        uint32 Method([Local("o")] string Parameter);
      };)");
  const auto expectQualifiers = [](const Qualifiers& qualifiers, const std::map<std::string, bool>& expected) {
    std::map<std::string, bool> found;
    for (const Qualifier& qualifier : qualifiers) {
      found[qualifier.name + "=" + *qualifier.value.text()] = qualifier.propagated;
    }
    EXPECT_EQ(found, expected);
  };
  const ClassDefinition& base = *repository.find("Base");
  expectQualifiers(base.properties[0].qualifiers, {{"Local=l", false}, {"Common=c", false}});
  const ClassDefinition& derived = *repository.find("Derived");
  expectQualifiers(derived.properties[0].qualifiers, {{"Common=c", true}});
  expectQualifiers(derived.methods[0].qualifiers, {{"Common=c", true}});
  expectQualifiers(derived.methods[0].parameters[0].qualifiers, {{"Common=c", true}});
  const ClassDefinition& overriding = *repository.find("Overriding");
  expectQualifiers(overriding.properties[0].qualifiers, {{"Local=o", false}, {"Common=c", true}});
  expectQualifiers(overriding.methods[0].qualifiers, {{"Common=c", true}});
  expectQualifiers(overriding.methods[0].parameters[0].qualifiers, {{"Local=o", false}, {"Common=c", true}});
}

TEST_F(ClassRepositoryTest, AnOverridingPropertyTakesThePlaceAndTheQualifiersOfTheOther) {
  load(repository, R"(
      class Base { [Key, Description("base")] string Id = "b"; uint8 Other; string Kept = "k"; };
      class Derived : Base { [Description("derived")] string ID = "d"; string kept; uint8 Own; };)");
  const ClassDefinition& derived = *repository.find("Derived");
  EXPECT_THAT(propertiesOf(derived), ElementsAre("ID", "Other", "kept", "Own"));
  EXPECT_TRUE(derived.findProperty("id")->isKey());
  EXPECT_EQ(derived.findProperty("id")->originClass, "Base");
  EXPECT_EQ(derived.findProperty("id")->defaultValue.toString(), "\"d\"");
  EXPECT_EQ(derived.findProperty("Kept")->defaultValue.toString(), "\"k\"") << "no default of its own";
  EXPECT_EQ(findQualifier(derived.findProperty("id")->qualifiers, "Description")->value.toString(), "\"derived\"");
}

TEST_F(ClassRepositoryTest, AReferenceMayBeNarrowedToASubclass) {
  load(repository,
       std::string(testSchema) + "[Association] class TST_Own : CIM_Hosted { TST_Processor REF Antecedent; };");
  const PropertyDeclaration& narrowed = *repository.find("TST_Own")->findProperty("Antecedent");
  EXPECT_EQ(narrowed.referenceClass, "TST_Processor");
  EXPECT_TRUE(narrowed.isKey());
}

TEST_F(ClassRepositoryTest, TheOrderOfDeclarationsDoesNotMatter) {
  load(repository, "class C : B {}; class B : A {}; class A { string P; };");
  EXPECT_THAT(propertiesOf(*repository.find("C")), ElementsAre("P"));
}

TEST_F(ClassRepositoryTest, ClassesMayDeriveFromThoseLoadedBefore) {
  load(repository, "class A { string P; };");
  load(repository, "class B : a {};");
  EXPECT_EQ(repository.find("B")->superclass, repository.find("A"));
}

TEST_F(ClassRepositoryTest, ListsTheSubclassesThatTheNamespaceShows) {
  load(repository, std::string("#pragma namespace(\"root/all\")\n") + testSchema);
  EXPECT_THAT(namesOf(repository.subclasses("root/all", "cim_element", false)), ElementsAre("CIM_Point", "CIM_System"));
  EXPECT_THAT(namesOf(repository.subclasses("ROOT/ALL/", "CIM_Element", true)),
              ElementsAre("CIM_Point", "CIM_System", "TST_Other", "TST_Point", "TST_Processor"));
  EXPECT_THAT(namesOf(repository.subclasses("root/all", "", false)),
              ElementsAre("CIM_Element", "CIM_Hosted", "TST_Peers"));
  EXPECT_EQ(repository.subclasses("root/all", "", true).size(), repository.all().size());
  EXPECT_THAT(namesOf(repository.subclasses("root/all", "TST_Other", true)), ElementsAre());
  EXPECT_THAT(namesOf(repository.subclasses("root/none", "", true)), ElementsAre());
}

TEST_F(ClassRepositoryTest, ANamespaceShowsWhatIsAskedForAndWhatThatIsMadeFrom) {
  load(repository, std::string(testSchema) + R"(
      class TST_Made : TST_Other { [EmbeddedInstance("TST_Part")] string Part; uint32 Go(TST_Peers REF Peers[]); };
      class TST_Part {};)");
  repository.show("root/a", "tst_hosted");
  repository.show("root/b", "TST_Made");
  EXPECT_THAT(namesOf(repository.subclasses("root/a", "", true)),
              ElementsAre("CIM_Element", "CIM_Hosted", "CIM_Point", "CIM_System", "TST_Hosted"));
  EXPECT_THAT(namesOf(repository.subclasses("root/b", "", true)),
              ElementsAre("CIM_Element", "CIM_Point", "CIM_System", "TST_Made", "TST_Other", "TST_Part", "TST_Peers"));
  EXPECT_EQ(repository.find("root/a", "TST_Made"), nullptr);
  EXPECT_NE(repository.find("/ROOT/B", "tst_made"), nullptr);
  EXPECT_EQ(repository.find("root/none", "TST_Made"), nullptr);
}

TEST_F(ClassRepositoryTest, ANamespaceShowsTheWholeSchemaAndNothingOfAnothers) {
  load(repository,
       "class A_One { [Key] string K; };\nclass A_Two { [Key] string K; };\n"
       "#pragma namespace(\"root/b\")\nclass B_Own { [Key] string K; };");
  for (const char* nameSpace : {"root/a", "/root/c"}) {
    repository.showSchema(nameSpace);
  }
  for (const char* nameSpace : {"root/a", "root/c"}) {
    EXPECT_THAT(namesOf(repository.subclasses(nameSpace, "", true)), ElementsAre("A_One", "A_Two")) << nameSpace;
  }
  EXPECT_THAT(namesOf(repository.subclasses("root/b", "", true)), ElementsAre("B_Own"));
}

TEST_F(ClassRepositoryTest, WhatIsAskedForMayBeDeclaredLater) {
  repository.show("root/a", "A");
  EXPECT_EQ(repository.find("root/a", "A"), nullptr);
  load(repository, "class A : B {}; class B {};");
  EXPECT_THAT(namesOf(repository.subclasses("root/a", "", true)), ElementsAre("A", "B"));
}

TEST_F(ClassRepositoryTest, APragmaGivesANamespaceClassesOfItsOwn) {
  load(repository, R"(
      class Common { string Text; };
      #pragma namespace("root/a")
      class One : Common {};
      class Same { uint8 A; };
      #pragma namespace("root/b")
      class Same { uint8 B; };
      class Common { string Other; };
      class Two : Common {};)");
  EXPECT_THAT(namesOf(repository.subclasses("root/a", "", true)), ElementsAre("Common", "One", "Same"));
  EXPECT_THAT(propertiesOf(*repository.find("root/a", "One")), ElementsAre("Text"));
  EXPECT_THAT(propertiesOf(*repository.find("root/a", "Same")), ElementsAre("A"));
  EXPECT_THAT(namesOf(repository.subclasses("root/b", "", true)), ElementsAre("Common", "Same", "Two"));
  EXPECT_THAT(propertiesOf(*repository.find("root/b", "Two")), ElementsAre("Other"));
  EXPECT_THAT(propertiesOf(*repository.find("root/b", "Same")), ElementsAre("B"));
  EXPECT_THAT(propertiesOf(*repository.find("Common")), ElementsAre("Text"));
  EXPECT_EQ(complaint(repository, "#pragma namespace(\"root/b\")\nclass same {};"),
            "text:2: class same is already declared at text:7");
  repository.show("root/c", "Same");
  EXPECT_EQ(repository.find("root/c", "Same"), nullptr) << "no class of the schema";
}

TEST_F(ClassRepositoryTest, ANamespacesOwnClassGoesBeforeTheSchemas) {
  load(repository, "class A { string P; };");
  repository.show("root/a", "A");
  load(repository, "#pragma namespace(\"root/a\")\nclass A { string Q; };");
  EXPECT_THAT(propertiesOf(*repository.find("root/a", "A")), ElementsAre("Q"));
}

TEST_F(ClassRepositoryTest, KnowsTheNamespacesThatSomebodyNamed) {
  repository.addNamespace("/root/a/");
  repository.addNamespace("");
  load(repository, "#pragma namespace(\"root/b\")");
  EXPECT_TRUE(repository.hasNamespace("ROOT/A"));
  EXPECT_TRUE(repository.hasNamespace("root/b"));
  EXPECT_FALSE(repository.hasNamespace(""));
  EXPECT_FALSE(repository.hasNamespace("root"));
  EXPECT_THAT(repository.namespaces(), ElementsAre("root/a", "root/b"));
}

TEST_F(ClassRepositoryTest, RefusesWhatCannotBeResolvedAndAddsNothing) {
  load(repository, "class Known {};");
  EXPECT_EQ(complaint(repository, "class New {};\nclass known {};"),
            "text:2: class known is already declared at text:1");
  EXPECT_EQ(complaint(repository, "class New {};\nclass NEW {};"), "text:2: class NEW is already declared at text:1");
  EXPECT_EQ(complaint(repository, "class New {};\nclass B : Missing {};"),
            "text:2: class B has the undeclared superclass Missing");
  EXPECT_THAT(complaint(repository, "class New {}; class A : B {}; class B : A {};"),
              HasSubstr("is its own superclass"));
  EXPECT_THAT(complaint(repository, "class Self : Self {};"), HasSubstr("is its own superclass"));
  EXPECT_EQ(complaint(repository, "class New { string P; };\nclass B : New { uint8 P; };"),
            "text:2: class B cannot change P of New from string to uint8");
  EXPECT_EQ(repository.find("New"), nullptr);
  EXPECT_THAT(namesOf(repository.all()), ElementsAre("Known"));
}

}  // namespace
