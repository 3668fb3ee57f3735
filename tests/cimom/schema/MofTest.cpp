// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cimom/model/Errors.h"
#include "cimom/model/Value.h"
#include "cimom/schema/Mof.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::SizeIs;

std::vector<ClassDeclaration> classesOf(std::string_view mof) { return MofReader().readText(mof, "text").classes; }

// The declaration of the one property of a class.
PropertyDeclaration propertyOf(const std::string& declaration) {
  return classesOf("class A { " + declaration + " };").at(0).own.properties.at(0);
}

std::vector<std::string> namesOf(const MofDeclarations& declarations) {
  std::vector<std::string> names;
  for (const auto& declaration : declarations.classes) {
    names.push_back(declaration.own.name);
  }
  return names;
}

TEST(MofTest, ATextWithoutDeclarationsIsEmpty) {
  EXPECT_THAT(classesOf(""), SizeIs(0));
  EXPECT_THAT(classesOf("\xEF\xBB\xBF// nothing\n/* at\n all */"), SizeIs(0));
}

TEST(MofTest, AClassHasANameAndASuperclass) {
  const auto classes = classesOf("class A {};\n\nCLASS B : A\n{\n};");
  ASSERT_THAT(classes, SizeIs(2));
  EXPECT_EQ(classes[0].superclassName, "");
  EXPECT_EQ(classes[1].own.name, "B");
  EXPECT_EQ(classes[1].superclassName, "A");
  EXPECT_EQ(classes[1].own.declaredAt, "text:3");
}

TEST(MofTest, PropertiesAreOfEveryType) {
  const struct {
    const char* declaration;
    CMPIType type;
  } rows[] = {{"boolean P;", CMPI_boolean},   {"char16 P;", CMPI_char16},     {"real32 P;", CMPI_real32},
              {"real64 P;", CMPI_real64},     {"uint8 P;", CMPI_uint8},       {"UINT16 P;", CMPI_uint16},
              {"uint32 P;", CMPI_uint32},     {"uint64 P;", CMPI_uint64},     {"sint8 P;", CMPI_sint8},
              {"sint16 P;", CMPI_sint16},     {"sint32 P;", CMPI_sint32},     {"sint64 P;", CMPI_sint64},
              {"string P;", CMPI_string},     {"datetime P;", CMPI_dateTime}, {"string P[];", CMPI_stringA},
              {"uint16 P[3];", CMPI_uint16A}, {"B REF P;", CMPI_ref},         {"B ref P = NULL;", CMPI_ref}};
  for (const auto& row : rows) {
    EXPECT_EQ(propertyOf(row.declaration).type, row.type) << row.declaration;
  }
  EXPECT_EQ(propertyOf("uint16 P[3];").arraySize, 3u);
  EXPECT_EQ(propertyOf("B REF P;").referenceClass, "B");
  EXPECT_EQ(propertyOf("B REF P;").originClass, "A");
}

TEST(MofTest, DefaultsAreValuesOfTheDeclaredType) {
  const struct {
    const char* declaration;
    CMPIType type;
    const char* value;
  } rows[] = {
      {"uint16 P = 5;", CMPI_uint16, "5"},
      {"uint8 P = 0xFf;", CMPI_uint8, "255"},
      {"uint8 P = 017;", CMPI_uint8, "15"},
      {"uint8 P = 1011b;", CMPI_uint8, "11"},
      {"uint64 P = 18446744073709551615;", CMPI_uint64, "18446744073709551615"},
      {"sint64 P = -9223372036854775808;", CMPI_sint64, "-9223372036854775808"},
      {"sint8 P = +7;", CMPI_sint8, "7"},
      {"real64 P = -1.5e+2;", CMPI_real64, "-150"},
      {"boolean P = TRUE;", CMPI_boolean, "TRUE"},
      {"boolean P = false;", CMPI_boolean, "FALSE"},
      {"char16 P = 'A';", CMPI_char16, "65"},
      {"char16 P = '\\x20AC';", CMPI_char16, "8364"},
      {"char16 P = '\xE2\x82\xAC';", CMPI_char16, "8364"},
      {"char16 P = '\xC3\xA9';", CMPI_char16, "233"},
      {"char16 P = '\\xE9';", CMPI_char16, "233"},
      {"string P = \"one \" /* and */ \"two\";", CMPI_string, "\"one two\""},
      {"string P = NULL;", CMPI_string, "NULL"},
      {"datetime P = \"00000001000000.000000:000\";", CMPI_dateTime, "\"00000001000000.000000:000\""},
      {"uint16 P[] = { 1, 2 };", CMPI_uint16A, "{1,2}"},
      {"string P[] = {};", CMPI_stringA, "{}"},
      {"string P[] = null;", CMPI_stringA, "NULL"},
      {"real64 P = .5;", CMPI_real64, "0.5"},
  };
  for (const auto& row : rows) {
    const Value value = propertyOf(row.declaration).defaultValue;
    EXPECT_EQ(value.type(), row.type) << row.declaration;
    EXPECT_EQ(value.toString(), row.value) << row.declaration;
  }
}

TEST(MofTest, StringsUnderstandEscapes) {
  EXPECT_EQ(*propertyOf(R"(string P = "\b\t\n\f\r\"\'\\\x41\xE9\x20AC";)").defaultValue.text(),
            "\b\t\n\f\r\"'\\A\xC3\xA9\xE2\x82\xAC");
}

TEST(MofTest, QualifiersTakeTheDeclaredTypeDefaultAndFlavor) {
  const auto classes = classesOf(R"(
      Qualifier MaxLen : uint32 = null, Scope(property, method), Flavor(DisableOverride, Restricted);
      Qualifier Tone : string = "plain", Scope(any), Flavor(Translatable);
      class A {
        [MaxLen(64), Tone, Key, ValueMap{"0", "1..3"}, Override("x"): EnableOverride Restricted] string P;
      };)");
  const Qualifiers& qualifiers = classes.at(0).own.properties.at(0).qualifiers;
  const Qualifier* maxLen = findQualifier(qualifiers, "maxlen");
  EXPECT_EQ(maxLen->value.type(), CMPI_uint32);
  EXPECT_EQ(maxLen->value.toString(), "64");
  EXPECT_FALSE(maxLen->overridable);
  EXPECT_FALSE(maxLen->toSubclass);
  EXPECT_EQ(findQualifier(qualifiers, "Tone")->value.toString(), "\"plain\"");
  EXPECT_TRUE(findQualifier(qualifiers, "Tone")->translatable);
  EXPECT_TRUE(isQualified(qualifiers, "key"));
  EXPECT_EQ(findQualifier(qualifiers, "ValueMap")->value.toString(), "{\"0\",\"1..3\"}");
  EXPECT_FALSE(findQualifier(qualifiers, "Override")->toSubclass);
}

TEST(MofTest, QualifierDeclarationsAreKeptWhole) {
  const auto declarations = MofReader().readText(
      R"(Qualifier Tone : uint8[3] = {1, 2}, Scope(property, REFERENCE), Flavor(DisableOverride, Restricted);
         Qualifier Note : string, Scope(any);)",
      "text");
  ASSERT_THAT(declarations.qualifiers, SizeIs(2));
  const QualifierDeclaration& tone = declarations.qualifiers[0];
  EXPECT_EQ(tone.qualifier.name, "Tone");
  EXPECT_EQ(tone.qualifier.value.type(), CMPI_uint8A);
  EXPECT_EQ(tone.qualifier.value.toString(), "{1,2}");
  EXPECT_FALSE(tone.qualifier.overridable);
  EXPECT_FALSE(tone.qualifier.toSubclass);
  EXPECT_EQ(tone.arraySize, 3u);
  EXPECT_THAT(tone.scopes, ElementsAre("property", "REFERENCE"));
  EXPECT_EQ(declarations.qualifiers[1].qualifier.value.type(), CMPI_string);
  EXPECT_TRUE(declarations.qualifiers[1].qualifier.value.isNull());
}

TEST(MofTest, AKeyMayBeSaidNotToBeOne) {
  EXPECT_TRUE(propertyOf("[Key(true)] string P;").isKey());
  EXPECT_FALSE(propertyOf("[Key(false)] string P;").isKey());
}

TEST(MofTest, MethodsKeepTheirParameters) {
  const auto classes = classesOf(
      "class A { [Description(\"d\")] uint32 Go([In] string Where, [Out, In(false)] B REF What, uint8 How[]); "
      "boolean Stop(); };");
  const auto& methods = classes.at(0).own.methods;
  ASSERT_THAT(methods, SizeIs(2));
  EXPECT_EQ(methods[0].name, "Go");
  EXPECT_EQ(methods[0].returnType, CMPI_uint32);
  ASSERT_THAT(methods[0].parameters, SizeIs(3));
  EXPECT_EQ(methods[0].parameters[1].referenceClass, "B");
  EXPECT_EQ(methods[0].parameters[2].type, CMPI_uint8A);
  EXPECT_THAT(methods[1].parameters, SizeIs(0));
}

TEST(MofTest, PragmasNameNamespacesAndOthersAreIgnored) {
  const auto declarations = MofReader().readText(
      "#pragma locale (\"en_US\")\n#pragma namespace(\"root/a\")\n#PRAGMA something(\"x\")", "text");
  EXPECT_THAT(declarations.namespaces, ElementsAre("root/a"));
}

TEST(MofTest, AClassIsOfTheNamespaceThatAPragmaBeforeItNames) {
  const auto classes =
      classesOf("class A {};\n#pragma namespace(\"root/a\")\nclass B {};\n#pragma namespace(\"root/b\")\nclass C {};");
  ASSERT_THAT(classes, SizeIs(3));
  EXPECT_EQ(classes[0].nameSpace, "");
  EXPECT_EQ(classes[1].nameSpace, "root/a");
  EXPECT_EQ(classes[2].nameSpace, "root/b");
}

TEST(MofFilesTest, ADirectoryIsReadWholeAndInOrder) {
  const TemporaryDirectory directory;
  directory.write("b.mof", "class B {};");
  directory.write("a.mof", "class A {};");
  directory.write("deep/c.mof", "class C {};");
  directory.write("notes.txt", "no MOF");
  EXPECT_THAT(namesOf(MofReader().readPath(directory.path())), ElementsAre("A", "B", "C"));
}

TEST(MofFilesTest, ANamespaceHoldsForWhatIsIncludedAndEndsWithItsFile) {
  const TemporaryDirectory directory;
  directory.write("a.mof", "#pragma namespace(\"root/a\")\n#pragma include(\"part/b.inc\")\nclass A {};");
  directory.write("part/b.inc", "class B {};\n#pragma namespace(\"root/b\")\n");
  directory.write("z.mof", "class Z {};");
  const auto classes = MofReader().readPath(directory.path()).classes;
  ASSERT_THAT(classes, SizeIs(3));
  EXPECT_EQ(classes[0].nameSpace, "root/a") << classes[0].own.name;
  EXPECT_EQ(classes[1].nameSpace, "root/a") << classes[1].own.name;
  EXPECT_EQ(classes[2].nameSpace, "") << classes[2].own.name;
}

TEST(MofFilesTest, AFileIsReadOnceForEachNamespace) {
  const TemporaryDirectory directory;
  directory.write("a.mof", "class A {};");
  const auto all =
      directory.write("all.mof",
                      "#pragma include(\"a.mof\")\n#pragma namespace(\"root/a\")\n"
                      "#pragma include(\"a.mof\")\n#pragma include(\"a.mof\")\n#pragma include(\"all.mof\")\n");
  const auto classes = MofReader().readPath(all).classes;
  ASSERT_THAT(classes, SizeIs(2));
  EXPECT_EQ(classes[0].nameSpace, "");
  EXPECT_EQ(classes[1].nameSpace, "root/a");
}

TEST(MofFilesTest, IncludesAreRelativeToTheirFileAndReadOnce) {
  const TemporaryDirectory directory;
  directory.write("qualifiers.mof", "Qualifier Tone : uint8 = 1, Scope(any);");
  directory.write("part/a.mof", "#pragma include(\"../qualifiers.mof\")\nclass A { [Tone(2)] string P; };");
  const auto all = directory.write(
      "all.mof",
      "#pragma include(\"qualifiers.mof\")\n#pragma include(\"part/a.mof\")\n#pragma include(\"all.mof\")\n"
      "#pragma include(\"part/../part/a.mof\")\nclass B {};");
  MofReader reader;
  const MofDeclarations declarations = reader.readPath(all);
  EXPECT_THAT(namesOf(declarations), ElementsAre("A", "B"));
  EXPECT_EQ(findQualifier(declarations.classes[0].own.properties[0].qualifiers, "Tone")->value.type(), CMPI_uint8);
  EXPECT_THAT(namesOf(reader.readPath(all)), SizeIs(0)) << "read already";
}

}  // namespace
