// SPDX-License-Identifier: Apache-2.0
// The methods of a class, against the probe provider.
#include "cimom/cimxml/Document.h"
#include "tests/cimom/cimxml/EndpointTest.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

class MethodCallTest : public EndpointTest {
 protected:
  // The content of METHODRESPONSE; the user is who has authenticated.
  std::string called(const std::string& method, const std::string& arguments = {},
                     const std::string& klass = "TEST_Machine", const std::string& user = {}) const {
    Http::Request sent =
        request(method, messageOf("<METHODCALL NAME=\"" + method + "\"><LOCALINSTANCEPATH>" + nameSpacePath() +
                                  instanceName(klass, keyBinding("Name", "machine")) + "</LOCALINSTANCEPATH>" +
                                  arguments + "</METHODCALL>"));
    sent.headers = {};
    sent.headers.add("CIMOperation", "MethodCall");
    sent.headers.add("CIMMethod", method);
    sent.headers.add("CIMObject", "root/test:" + klass + ".Name=\"machine\"");
    sent.user = user;
    return contentOf(endpoint_.handle(sent), method);
  }

  // The status code and the description of a failed call: "5: …".
  std::string refused(const std::string& method, const std::string& arguments = {}) const {
    const CimXml::Document document(called(method, arguments));
    EXPECT_TRUE(document.root().is("ERROR"));
    return document.root().attribute("CODE").value_or("") + ": " +
           document.root().attribute("DESCRIPTION").value_or("");
  }
};

std::string argument(const std::string& name, const std::string& type, const std::string& content) {
  return "<PARAMVALUE NAME=\"" + name + "\"" + (type.empty() ? "" : " PARAMTYPE=\"" + type + "\"") + ">" + content +
         "</PARAMVALUE>";
}

std::string arrayOf(const std::vector<std::string>& texts) {
  std::string values;
  for (const std::string& text : texts) {
    values += value(text);
  }
  return "<VALUE.ARRAY>" + values + "</VALUE.ARRAY>";
}

std::string escaped(std::string text) {
  for (auto at = text.find('<'); at != std::string::npos; at = text.find('<')) {
    text.replace(at, 1, "&lt;");
  }
  return text;
}

const std::string numbered =
    "<INSTANCE CLASSNAME=\"TEST_Numbered\"><PROPERTY NAME=\"Id\" "
    "TYPE=\"sint32\"><VALUE>4</VALUE></PROPERTY></INSTANCE>";

TEST_F(MethodCallTest, EveryTypeOfArgumentReachesTheProviderAndComesBack) {
  const struct {
    const char* name;
    const char* type;
    std::string content;
    const char* arrived;  // the CMPI type
  } rows[] = {
      {"Flag", "boolean", value("TRUE"), "2"},
      {"Letter", "char16", value("x"), "3"},
      {"U8", "uint8", value("255"), "80"},
      {"U16", "uint16", value("65535"), "90"},
      {"U32", "uint32", value("4294967295"), "a0"},
      {"U64", "uint64", value("18446744073709551615"), "b0"},
      {"S8", "sint8", value("-128"), "c0"},
      {"S16", "sint16", value("-1"), "d0"},
      {"S32", "sint32", value("-2"), "e0"},
      {"S64", "sint64", value("-3"), "f0"},
      {"R32", "real32", value("1.5"), "8"},
      {"R64", "real64", value("-0.25"), "c"},
      {"Moment", "datetime", value("20260102030405.000000+060"), "1800"},
      {"Text", "string", value("a text"), "1600"},
      {"Flags", "boolean", arrayOf({"TRUE", "FALSE"}), "2002"},
      {"Numbers", "uint16", arrayOf({"1", "2"}), "2090"},
      {"Moments", "datetime", arrayOf({"20260102030405.000000+060"}), "3800"},
      {"Texts", "string", "<VALUE.ARRAY>" + value("a") + "<VALUE.NULL></VALUE.NULL></VALUE.ARRAY>", "3600"},
  };
  std::string all;
  std::string types;
  std::string back;
  for (const auto& row : rows) {
    all += argument(row.name, row.type, row.content);
    types += std::string(row.name) + ":" + row.arrived + " ";
    back += argument(row.name, row.type, row.content);
  }
  types.pop_back();
  EXPECT_EQ(called("Echo", all), "<RETURNVALUE PARAMTYPE=\"string\">" + value(types + " ") + "</RETURNVALUE>" + back);
  for (const auto& row : rows) {
    EXPECT_THAT(called("Echo", argument(row.name, "", row.content)),
                HasSubstr(argument(row.name, row.type, row.content)))
        << "the class alone says the type";
  }
}

TEST_F(MethodCallTest, ReferencesAndArraysOfThemArePaths) {
  const std::string reference = "<VALUE.REFERENCE>" + thingName() + "</VALUE.REFERENCE>";
  const std::string result =
      called("Echo", argument("Thing", "reference", reference) +
                         argument("Things", "reference",
                                  "<VALUE.REFARRAY>" + reference + "<VALUE.NULL/>" + reference + "</VALUE.REFARRAY>"));
  EXPECT_THAT(result, HasSubstr("Thing:1100 Things:3100 "));
  EXPECT_THAT(result, HasSubstr("<PARAMVALUE NAME=\"Thing\" PARAMTYPE=\"reference\"><VALUE.REFERENCE><INSTANCEPATH>"));
  EXPECT_THAT(result,
              HasSubstr("<PARAMVALUE NAME=\"Things\" PARAMTYPE=\"reference\"><VALUE.REFARRAY><VALUE.REFERENCE>"));
  EXPECT_THAT(result, HasSubstr("</VALUE.REFERENCE><VALUE.NULL></VALUE.NULL><VALUE.REFERENCE>"));
  EXPECT_EQ(refused("Echo", argument("Things", "reference",
                                     "<VALUE.REFARRAY><VALUE.REFERENCE>" + thingName("x") +
                                         "</VALUE.REFERENCE></VALUE.REFARRAY>")),
            "4: key Number must be of type uint16, not \"x\"");
}

TEST_F(MethodCallTest, EmbeddedInstancesAreInstances) {
  const std::string result =
      called("Echo", argument("Inner", "string\" EmbeddedObject=\"instance", value(escaped(numbered))) +
                         argument("Inners", "string", arrayOf({"<![CDATA[" + numbered + "]]>"})));
  EXPECT_THAT(result, HasSubstr("Inner:1000 Inners:3000 "));
  EXPECT_THAT(result, HasSubstr("<PARAMVALUE NAME=\"Inner\" PARAMTYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>"
                                "&lt;INSTANCE CLASSNAME=&quot;TEST_Numbered&quot;&gt;"));
  EXPECT_THAT(result, HasSubstr("&lt;VALUE&gt;4&lt;/VALUE&gt;"));
  EXPECT_THAT(result, HasSubstr("<PARAMVALUE NAME=\"Inners\" PARAMTYPE=\"string\" EmbeddedObject=\"instance\">"
                                "<VALUE.ARRAY><VALUE>&lt;INSTANCE "));
  EXPECT_THAT(refused("Echo", argument("Inner", "string", value("plain"))),
              StartsWith("4: parameter Inner must be the text of an INSTANCE: "));
  EXPECT_EQ(refused("Echo", argument("Inner", "string", value(escaped("<INSTANCE CLASSNAME=\"TEST_Nowhere\"/>")))),
            "5: unknown class \"TEST_Nowhere\"");
}

TEST_F(MethodCallTest, InstancesWithinInstancesAreLimited) {
  std::string text = "<INSTANCE CLASSNAME=\"TEST_Machine\"/>";
  for (int level = 0; level < 17; ++level) {
    std::string inner;
    for (const char letter : text) {
      inner += letter == '<' ? "&lt;" : letter == '&' ? "&amp;" : std::string(1, letter);
    }
    text = "<INSTANCE CLASSNAME=\"TEST_Machine\"><PROPERTY NAME=\"Inner\" TYPE=\"string\"><VALUE>" + inner +
           "</VALUE></PROPERTY></INSTANCE>";
  }
  std::string outermost;
  for (const char letter : text) {
    outermost += letter == '<' ? "&lt;" : letter == '&' ? "&amp;" : std::string(1, letter);
  }
  EXPECT_EQ(refused("Echo", argument("Inner", "string", value(outermost))),
            "4: instances are embedded more than 16 levels deep");
}

TEST_F(MethodCallTest, ANullArgumentIsNull) {
  EXPECT_THAT(called("Echo", argument("Text", "string", "") + argument("Numbers", "uint16", "")),
              AllOf(HasSubstr("Text:1600 Numbers:2090 "), HasSubstr(argument("Text", "string", ""))));
}

TEST_F(MethodCallTest, AnArgumentThatDoesNotFitItsDeclarationIsNamed) {
  const struct {
    std::string arguments;
    const char* expected;
  } rows[] = {
      {argument("Nothing", "string", value("x")), "4: method Echo has no parameter Nothing"},
      {argument("U8", "", value("1")) + argument("u8", "", value("1")), "4: parameter u8 is a duplicate"},
      {argument("U8", "uint16", value("1")), "4: parameter U8 must be of type uint8, not uint16"},
      {argument("U8", "uint8", value("256")), "4: parameter U8 must be of type uint8, not \"256\""},
      {argument("U8", "uint8", arrayOf({"1"})), "4: parameter U8 must be of type uint8, not uint8[]"},
      {argument("Numbers", "uint16", value("1")), "4: parameter Numbers must be of type uint16[], not uint16"},
      {argument("Numbers", "uint16", arrayOf({"1", "x"})),
       "4: element 1 of parameter Numbers must be of type uint16, not \"x\""},
      {argument("Thing", "", value("x")), "4: parameter Thing must be of type reference"},
      {argument("Text", "", thingName()), "4: parameter Text must be of type string"},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(refused("Echo", row.arguments), row.expected);
  }
}

TEST_F(MethodCallTest, ASubclassIsServedByItsSuperclassesProvider) {
  EXPECT_THAT(called("Silent", {}, "TEST_Engine"), "");
}

TEST_F(MethodCallTest, TheProviderKnowsWhoAsks) {
  EXPECT_THAT(called("Caller", {}, "TEST_Machine", "alice"), HasSubstr(value("alice")));
}

TEST_F(MethodCallTest, WhatAProviderReturnsGetsItsDeclaredType) {
  EXPECT_EQ(called("Odd"), "<RETURNVALUE PARAMTYPE=\"uint8\">" + value("7") + "</RETURNVALUE>" +
                               argument("Wide", "uint64", value("7")));
  EXPECT_EQ(refused("Wrong"), "13: the provider returned string as TEST_Machine.Wrong, which must be uint32");
}

TEST_F(MethodCallTest, AMethodThatIsNotThereHasAStatusOfItsOwn) {
  EXPECT_EQ(refused("Nothing"), "17: class TEST_Machine has no method Nothing");
  EXPECT_EQ(refused("Unimplemented"), "16: not today");
}

TEST_F(MethodCallTest, AnInstanceShowsWhatItEmbeds) {
  const std::string result = returned("EnumerateInstances", className("TEST_Machine"));
  EXPECT_THAT(result, HasSubstr("<PROPERTY NAME=\"Inner\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>"
                                "&lt;INSTANCE CLASSNAME=&quot;TEST_Numbered&quot;&gt;"));
  EXPECT_THAT(result, HasSubstr("<PROPERTY.ARRAY NAME=\"Inners\" TYPE=\"string\" EmbeddedObject=\"instance\">"
                                "<VALUE.ARRAY><VALUE>&lt;INSTANCE "));
  EXPECT_THAT(result, HasSubstr("</VALUE><VALUE.NULL></VALUE.NULL></VALUE.ARRAY>"));
}

// DSP0201: the attribute follows the qualifier of the declaration, not the value.
TEST_F(MethodCallTest, WhatMayEmbedAnyObjectSaysSo) {
  const std::string result =
      called("Copy", argument("Object", "string\" EmbeddedObject=\"object", value(escaped(numbered))));
  EXPECT_THAT(result, StartsWith("<RETURNVALUE PARAMTYPE=\"string\" EmbeddedObject=\"object\"><VALUE>&lt;INSTANCE "));
  EXPECT_THAT(result, HasSubstr("<PARAMVALUE NAME=\"Object\" PARAMTYPE=\"string\" EmbeddedObject=\"object\">"));
  EXPECT_THAT(returned("EnumerateInstances", className("TEST_Machine")),
              HasSubstr("<PROPERTY NAME=\"Anything\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>&lt;INSTANCE "));
}

TEST_F(MethodCallTest, AnInstanceThatIsEmbeddedIsTaken) {
  const std::string given = "<INSTANCE CLASSNAME=\"TEST_Machine\"><PROPERTY NAME=\"Name\" TYPE=\"string\">" +
                            value("machine") +
                            "</PROPERTY><PROPERTY NAME=\"Inner\" TYPE=\"string\" "
                            "EmbeddedObject=\"instance\">" +
                            value(escaped(numbered)) + "</PROPERTY></INSTANCE>";
  EXPECT_THAT(returned("CreateInstance", parameter("NewInstance", given)), HasSubstr("CLASSNAME=\"TEST_Machine\""));
}

}  // namespace
