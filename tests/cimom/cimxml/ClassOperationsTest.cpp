// SPDX-License-Identifier: Apache-2.0
// The schema as clients read it.
#include "tests/cimom/cimxml/EndpointTest.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

class ClassOperationsTest : public EndpointTest {
 protected:
  std::string getClass(const std::string& name, const std::string& options = {}) const {
    return returned("GetClass", className(name) + options);
  }
};

std::string flag(const std::string& name, const std::string& value) {
  return parameter(name, "<VALUE>" + value + "</VALUE>");
}

const std::string everything = flag("LocalOnly", "FALSE");

TEST_F(ClassOperationsTest, GetClassShowsEveryTypeOfProperty) {
  const std::string thing = getClass("test_thing", flag("IncludeQualifiers", "FALSE"));
  EXPECT_THAT(
      thing,
      AllOf(
          HasSubstr("<CLASS NAME=\"TEST_Thing\">"),
          HasSubstr("<PROPERTY NAME=\"U64\" TYPE=\"uint64\" PROPAGATED=\"false\"></PROPERTY>"),
          HasSubstr("<PROPERTY NAME=\"WithDefault\" TYPE=\"uint16\" PROPAGATED=\"false\"><VALUE>5</VALUE></PROPERTY>"),
          HasSubstr("<PROPERTY.ARRAY NAME=\"Numbers\" TYPE=\"uint16\" ARRAYSIZE=\"3\" PROPAGATED=\"false\">"),
          Not(HasSubstr("<QUALIFIER"))));
  EXPECT_THAT(getClass("TEST_Link"), HasSubstr("<PROPERTY.REFERENCE NAME=\"Whole\" REFERENCECLASS=\"TEST_Thing\""));
}

TEST_F(ClassOperationsTest, GetClassShowsQualifiersWithTheirFlavors) {
  EXPECT_THAT(
      getClass("TEST_Thing"),
      AllOf(HasSubstr("<QUALIFIER NAME=\"Description\" TYPE=\"string\" OVERRIDABLE=\"true\" TOSUBCLASS=\"true\" "
                      "TRANSLATABLE=\"true\"><VALUE>A thing</VALUE></QUALIFIER>"),
            HasSubstr("<QUALIFIER NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\" TOSUBCLASS=\"true\" "
                      "TRANSLATABLE=\"false\"><VALUE>TRUE</VALUE></QUALIFIER>"),
            HasSubstr("<VALUE.ARRAY><VALUE>a</VALUE><VALUE>b</VALUE></VALUE.ARRAY>")));
}

TEST_F(ClassOperationsTest, GetClassShowsMethodsWithTheirParameters) {
  EXPECT_THAT(getClass("TEST_Thing"),
              AllOf(HasSubstr("<METHOD NAME=\"Reset\" TYPE=\"uint32\""),
                    HasSubstr("<PARAMETER NAME=\"Force\" TYPE=\"boolean\">"),
                    HasSubstr("<PARAMETER.ARRAY NAME=\"Names\" TYPE=\"string\">"),
                    HasSubstr("<PARAMETER.REFERENCE NAME=\"Other\" REFERENCECLASS=\"TEST_Thing\">")));
}

TEST_F(ClassOperationsTest, GetClassShowsWhatIsInheritedOnlyWhenAsked) {
  EXPECT_THAT(getClass("TEST_Part"), AllOf(HasSubstr("<CLASS NAME=\"TEST_Part\" SUPERCLASS=\"TEST_Thing\">"),
                                           HasSubstr("NAME=\"Extra\""), Not(HasSubstr("NAME=\"U64\""))));
  EXPECT_THAT(getClass("TEST_Part", everything + flag("IncludeClassOrigin", "TRUE")),
              AllOf(HasSubstr("NAME=\"U64\" TYPE=\"uint64\" CLASSORIGIN=\"TEST_Thing\" PROPAGATED=\"true\""),
                    HasSubstr("NAME=\"Extra\" TYPE=\"string\" CLASSORIGIN=\"TEST_Part\" PROPAGATED=\"false\"")));
}

TEST_F(ClassOperationsTest, GetClassShowsWhatTheClassOverrides) {
  EXPECT_THAT(getClass("TEST_Part", flag("IncludeClassOrigin", "TRUE")),
              HasSubstr("NAME=\"WithDefault\" TYPE=\"uint16\" CLASSORIGIN=\"TEST_Thing\" PROPAGATED=\"false\""));
}

TEST_F(ClassOperationsTest, AnOverriddenKeyOrReferenceIsShownWithLocalOnlyAndKeepsItsQualifiers) {
  manager_.loadSchemaText(
      "class TEST_Base { [Key, Description(\"base\")] string Id; [Deprecated{\"No\"}] string Old; };\n"
      "class TEST_Derived : TEST_Base { [Override(\"Id\"), Description(\"derived\")] string Id; };\n"
      "class TEST_Last : TEST_Derived {};\n"
      "class TEST_Narrowed : TEST_Link { [Override(\"Whole\")] TEST_Part ref Whole; };",
      "root/test");
  EXPECT_THAT(
      getClass("TEST_Derived", flag("IncludeClassOrigin", "TRUE")),
      AllOf(HasSubstr("<PROPERTY NAME=\"Id\" TYPE=\"string\" CLASSORIGIN=\"TEST_Base\" PROPAGATED=\"false\">"
                      "<QUALIFIER NAME=\"Override\" TYPE=\"string\" OVERRIDABLE=\"true\" TOSUBCLASS=\"false\" "),
            HasSubstr("<QUALIFIER NAME=\"Key\" TYPE=\"boolean\" PROPAGATED=\"true\" OVERRIDABLE=\"false\" "),
            HasSubstr("<QUALIFIER NAME=\"Description\" TYPE=\"string\" OVERRIDABLE=\"true\" "),
            Not(HasSubstr("NAME=\"Old\""))));
  EXPECT_THAT(getClass("TEST_Narrowed"),
              AllOf(HasSubstr("NAME=\"Whole\" REFERENCECLASS=\"TEST_Part\" PROPAGATED=\"false\""),
                    HasSubstr("<QUALIFIER NAME=\"Association\" TYPE=\"boolean\" PROPAGATED=\"true\""),
                    Not(HasSubstr("NAME=\"Part\""))));
  EXPECT_THAT(getClass("TEST_Last", everything),
              AllOf(HasSubstr("<PROPERTY NAME=\"Id\" TYPE=\"string\" PROPAGATED=\"true\">"), HasSubstr("NAME=\"Key\""),
                    HasSubstr("<VALUE>derived</VALUE>"), HasSubstr("NAME=\"Old\""), Not(HasSubstr("Override")),
                    Not(HasSubstr("Deprecated"))))
      << "restricted qualifiers stay with the class that has them";
}

TEST_F(ClassOperationsTest, APropertyListTrimsTheClass) {
  EXPECT_THAT(
      getClass("TEST_Part", everything + parameter("PropertyList", "<VALUE.ARRAY><VALUE>u64</VALUE></VALUE.ARRAY>")),
      AllOf(HasSubstr("NAME=\"U64\""), Not(HasSubstr("NAME=\"Extra\""))));
}

TEST_F(ClassOperationsTest, AnEmptyPropertyListLeavesNoPropertyAndAnUnknownNameNoTrace) {
  EXPECT_THAT(getClass("TEST_Part", everything + parameter("PropertyList", "<VALUE.ARRAY></VALUE.ARRAY>")),
              AllOf(Not(HasSubstr("<PROPERTY")), HasSubstr("<METHOD NAME=\"Reset\"")));
  EXPECT_THAT(getClass("TEST_Part", parameter("PropertyList",
                                              "<VALUE.ARRAY><VALUE>Extra</VALUE><VALUE>None</VALUE>"
                                              "<VALUE>extra</VALUE></VALUE.ARRAY>")),
              HasSubstr("<PROPERTY NAME=\"Extra\""));
}

TEST_F(ClassOperationsTest, QualifiersAreAnsweredAsTheSchemaDeclaresThem) {
  const auto getQualifier = [this](const std::string& name) {
    return returned("GetQualifier", parameter("QualifierName", "<VALUE>" + name + "</VALUE>"));
  };
  EXPECT_EQ(
      getQualifier("key"),
      "<IRETURNVALUE><QUALIFIER.DECLARATION NAME=\"Key\" TYPE=\"boolean\" ISARRAY=\"false\" OVERRIDABLE=\"false\" "
      "TOSUBCLASS=\"true\" TRANSLATABLE=\"false\"><SCOPE CLASS=\"false\" ASSOCIATION=\"false\" REFERENCE=\"true\" "
      "PROPERTY=\"true\" METHOD=\"false\" PARAMETER=\"false\" INDICATION=\"false\"></SCOPE><VALUE>FALSE</VALUE>"
      "</QUALIFIER.DECLARATION></IRETURNVALUE>");
  EXPECT_THAT(getQualifier("Values"), AllOf(HasSubstr("TYPE=\"string\" ISARRAY=\"true\" OVERRIDABLE=\"true\""),
                                            HasSubstr("></SCOPE></QUALIFIER.DECLARATION>")));
  manager_.loadSchemaText("Qualifier Pair : uint8[2] = {1, 2}, Scope(property);", "root/test");
  EXPECT_THAT(getQualifier("Pair"), AllOf(HasSubstr("TYPE=\"uint8\" ISARRAY=\"true\" ARRAYSIZE=\"2\""),
                                          HasSubstr("<VALUE.ARRAY><VALUE>1</VALUE><VALUE>2</VALUE></VALUE.ARRAY>")));
  EXPECT_THAT(getQualifier("Description"),
              HasSubstr("TRANSLATABLE=\"true\"><SCOPE CLASS=\"true\" ASSOCIATION=\"true\" REFERENCE=\"true\" "
                        "PROPERTY=\"true\" METHOD=\"true\" PARAMETER=\"true\" INDICATION=\"true\">"));
  EXPECT_EQ(failed("GetQualifier", parameter("QualifierName", "<VALUE>Nothing</VALUE>")),
            "6: unknown qualifier \"Nothing\"");
  EXPECT_EQ(failed("GetQualifier", ""), "4: parameter QualifierName is missing");
  const std::string all = returned("EnumerateQualifiers", "");
  for (const char* name : {"Association", "Description", "Key", "Values"}) {
    EXPECT_THAT(all, HasSubstr("<QUALIFIER.DECLARATION NAME=\"" + std::string(name) + "\""));
  }
}

TEST_F(ClassOperationsTest, AClassShowsInItsNamespacesOnly) {
  manager_.loadSchemaText("#pragma namespace(\"root/other\")\nclass OTHER_Thing { [Key] string Name; };", "root/other");
  EXPECT_THAT(failed("GetClass", className("OTHER_Thing")), HasSubstr("6: unknown class \"OTHER_Thing\""));
  EXPECT_THAT(failed("EnumerateClassNames", className("OTHER_Thing")), HasSubstr("5: unknown class \"OTHER_Thing\""));
  EXPECT_THAT(failed("EnumerateInstances", className("OTHER_Thing")), HasSubstr("5: unknown class \"OTHER_Thing\""));
  EXPECT_THAT(returned("EnumerateClassNames", flag("DeepInheritance", "TRUE")), Not(HasSubstr("OTHER_Thing")));
}

TEST_F(ClassOperationsTest, EnumeratesTheClassesBelow) {
  const std::string all = flag("DeepInheritance", "TRUE");
  EXPECT_THAT(returned("EnumerateClassNames", ""),
              AllOf(HasSubstr("<CLASSNAME NAME=\"TEST_Thing\">"), Not(HasSubstr("TEST_Part"))));
  EXPECT_THAT(returned("EnumerateClassNames", all), HasSubstr("<CLASSNAME NAME=\"TEST_Part\">"));
  EXPECT_EQ(returned("EnumerateClassNames", className("TEST_Thing")),
            "<IRETURNVALUE><CLASSNAME NAME=\"TEST_Part\"></CLASSNAME></IRETURNVALUE>");
  EXPECT_THAT(returned("EnumerateClasses", className("TEST_Thing")), HasSubstr("<CLASS NAME=\"TEST_Part\""));
  EXPECT_EQ(returned("EnumerateClassNames", className("TEST_Part")), "<IRETURNVALUE></IRETURNVALUE>");
}

}  // namespace
