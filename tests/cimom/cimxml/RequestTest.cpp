// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/Request.h"
#include "tests/cimom/cimxml/Messages.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace Cimom::CimXml;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;

// The one parameter's value in a request.
template <typename Kind>
Kind valueOf(const std::string& xml) {
  return std::get<Kind>(readRequest(intrinsicCall("M", parameter("P", xml))).parameters.at(0).value);
}

ObjectName nameOf(const std::string& xml) { return valueOf<ObjectName>(xml); }

Property propertyOf(const std::string& xml) {
  return valueOf<Instance>("<INSTANCE CLASSNAME=\"C\">" + xml + "</INSTANCE>").properties.at(0);
}

TEST(RequestTest, ReadsWhatIsCalledWhere) {
  const Request request = readRequest(intrinsicCall("EnumerateInstances", className("CIM_Thing")));
  EXPECT_EQ(request.messageId, "4711");
  EXPECT_EQ(request.protocolVersion, "1.0");
  EXPECT_TRUE(request.isIntrinsic);
  EXPECT_EQ(request.method, "EnumerateInstances");
  EXPECT_EQ(request.nameSpace, "root/test");
  ASSERT_EQ(request.parameters.size(), 1u);
  EXPECT_EQ(request.parameters[0].name, "ClassName");
  EXPECT_EQ(std::get<ObjectName>(request.parameters[0].value).className, "CIM_Thing");
}

TEST(RequestTest, ReadsTheTargetOfAClassesMethod) {
  const Request request = readRequest(messageOf(
      "<METHODCALL NAME=\"Reset\"><LOCALINSTANCEPATH>" + nameSpacePath() + instanceName("C", keyBinding("K", "1")) +
      "</LOCALINSTANCEPATH><PARAMVALUE NAME=\"Force\" PARAMTYPE=\"boolean\"><VALUE>TRUE</VALUE></PARAMVALUE>"
      "</METHODCALL>"));
  EXPECT_FALSE(request.isIntrinsic);
  EXPECT_EQ(request.nameSpace, "root/test");
  EXPECT_EQ(request.target.className, "C");
  EXPECT_EQ(request.parameters.at(0).type, "boolean");
  EXPECT_EQ(std::get<std::string>(request.parameters.at(0).value), "TRUE");
}

TEST(RequestTest, TakesAParameterWithoutAValueForNone) {
  const Request request = readRequest(intrinsicCall("M", parameter("P", "")));
  EXPECT_TRUE(std::holds_alternative<std::monostate>(request.parameters.at(0).value));
}

TEST(RequestTest, ReadsATextWithoutOuterBlanks) {
  EXPECT_EQ(valueOf<std::string>("<VALUE>\n  a &lt; b&#x20AC;<![CDATA[ & c]]>\t</VALUE>"), "a < b€ & c");
}

TEST(RequestTest, SeesNoCommentAndNoInstruction) {
  EXPECT_EQ(valueOf<std::string>("<!-- a --><?b?><VALUE>x<!-- c -->y<?d?></VALUE>"), "xy");
}

TEST(RequestTest, ReadsAnArrayWithItsNulls) {
  EXPECT_THAT(valueOf<Texts>("<VALUE.ARRAY><VALUE>a</VALUE><VALUE.NULL/><VALUE/></VALUE.ARRAY>"),
              ElementsAre("a", std::nullopt, ""));
}

TEST(RequestTest, ReadsEveryKindOfKey) {
  const ObjectName name =
      nameOf(instanceName("C", keyBinding("S", "text") + keyBinding("B", "TRUE", "VALUETYPE=\"boolean\"") +
                                   keyBinding("N", "7", "VALUETYPE=\"numeric\" TYPE=\"uint16\"") +
                                   keyBinding("D", "plain", "") + "<KEYBINDING NAME=\"R\"><VALUE.REFERENCE>" +
                                   instanceName("Other", keyBinding("K", "1")) + "</VALUE.REFERENCE></KEYBINDING>"));
  ASSERT_EQ(name.keys.size(), 5u);
  EXPECT_EQ(name.keys[0].value.kind, KeyValue::Kind::String);
  EXPECT_EQ(name.keys[0].value.text, "text");
  EXPECT_EQ(name.keys[1].value.kind, KeyValue::Kind::Boolean);
  EXPECT_EQ(name.keys[2].value.kind, KeyValue::Kind::Numeric);
  EXPECT_EQ(name.keys[2].value.type, "uint16");
  EXPECT_EQ(name.keys[3].value.kind, KeyValue::Kind::String);
  EXPECT_EQ(name.keys[4].value.kind, KeyValue::Kind::Reference);
  EXPECT_EQ(name.keys[4].value.reference->className, "Other");
}

TEST(RequestTest, ReadsALoneKeyValue) {
  const ObjectName name = nameOf(instanceName("C", "<KEYVALUE>x</KEYVALUE>"));
  ASSERT_EQ(name.keys.size(), 1u);
  EXPECT_EQ(name.keys[0].name, "");
  EXPECT_EQ(name.keys[0].value.text, "x");
}

TEST(RequestTest, ReadsEveryKindOfPath) {
  const std::string full = "<NAMESPACEPATH><HOST>h:5988</HOST>" + nameSpacePath("far") + "</NAMESPACEPATH>";
  const std::string instance = instanceName("C", keyBinding("K", "1"));
  const std::string klass = "<CLASSNAME NAME=\"C\"/>";
  struct Case {
    std::string xml, host, nameSpace;
    std::size_t keys;
  };
  const std::vector<Case> cases = {
      {klass, "", "", 0},
      {instance, "", "", 1},
      {"<LOCALCLASSPATH>" + nameSpacePath("far") + klass + "</LOCALCLASSPATH>", "", "root/far", 0},
      {"<LOCALINSTANCEPATH>" + nameSpacePath("far") + instance + "</LOCALINSTANCEPATH>", "", "root/far", 1},
      {"<CLASSPATH>" + full + klass + "</CLASSPATH>", "h:5988", "root/far", 0},
      {"<INSTANCEPATH>" + full + instance + "</INSTANCEPATH>", "h:5988", "root/far", 1}};
  for (const Case& expected : cases) {
    SCOPED_TRACE(expected.xml);
    for (const std::string& xml : {expected.xml, "<VALUE.REFERENCE>" + expected.xml + "</VALUE.REFERENCE>"}) {
      const ObjectName name = nameOf(xml);
      EXPECT_EQ(name.className, "C");
      EXPECT_EQ(name.host, expected.host);
      EXPECT_EQ(name.nameSpace, expected.nameSpace);
      EXPECT_EQ(name.keys.size(), expected.keys);
    }
  }
}

TEST(RequestTest, ReadsAnArrayOfReferencesWithItsNulls) {
  const auto references =
      valueOf<ObjectNames>("<VALUE.REFARRAY><VALUE.REFERENCE>" + instanceName("C", keyBinding("K", "1")) +
                           "</VALUE.REFERENCE><VALUE.NULL/><VALUE.REFERENCE><CLASSNAME NAME=\"D\"/></VALUE.REFERENCE>"
                           "</VALUE.REFARRAY>");
  ASSERT_EQ(references.size(), 3u);
  EXPECT_EQ(references[0]->keys.size(), 1u);
  EXPECT_FALSE(references[1]);
  EXPECT_EQ(references[2]->className, "D");
}

TEST(RequestTest, TakesDeclarationsOfClassesAndQualifiers) {
  EXPECT_EQ(valueOf<Declaration>("<CLASS NAME=\"C\" SUPERCLASS=\"B\"><QUALIFIER NAME=\"Q\" TYPE=\"boolean\"/>"
                                 "<PROPERTY NAME=\"P\" TYPE=\"string\"/><PROPERTY.ARRAY NAME=\"A\" TYPE=\"string\"/>"
                                 "<PROPERTY.REFERENCE NAME=\"R\" REFERENCECLASS=\"C\"/><METHOD NAME=\"M\"/></CLASS>")
                .name,
            "C");
  EXPECT_EQ(valueOf<Declaration>("<QUALIFIER.DECLARATION NAME=\"Q\" TYPE=\"string\"><SCOPE CLASS=\"true\"/>"
                                 "<VALUE>x</VALUE></QUALIFIER.DECLARATION>")
                .name,
            "Q");
}

TEST(RequestTest, ReadsANamedInstance) {
  const auto instance = valueOf<Instance>("<VALUE.NAMEDINSTANCE>" + instanceName("C", keyBinding("K", "1")) +
                                          "<INSTANCE CLASSNAME=\"C\"><QUALIFIER NAME=\"Q\" TYPE=\"boolean\"/>"
                                          "<PROPERTY NAME=\"A\" TYPE=\"string\"><VALUE>x</VALUE></PROPERTY></INSTANCE>"
                                          "</VALUE.NAMEDINSTANCE>");
  EXPECT_EQ(instance.path.className, "C");
  EXPECT_EQ(instance.className, "C");
  EXPECT_EQ(instance.path.keys.size(), 1u);
  ASSERT_EQ(instance.properties.size(), 1u);
  EXPECT_EQ(instance.properties[0].name, "A");
}

TEST(RequestTest, ReadsEveryKindOfProperty) {
  const Property scalar = propertyOf("<PROPERTY NAME=\"A\" TYPE=\"uint8\"><VALUE>1</VALUE></PROPERTY>");
  EXPECT_EQ(scalar.type, "uint8");
  EXPECT_EQ(std::get<std::string>(scalar.value), "1");
  const Property array = propertyOf("<PROPERTY.ARRAY NAME=\"A\" TYPE=\"uint8\"><VALUE.ARRAY/></PROPERTY.ARRAY>");
  EXPECT_TRUE(array.isArray);
  EXPECT_TRUE(std::get<Texts>(array.value).empty());
  const Property reference = propertyOf(
      "<PROPERTY.REFERENCE NAME=\"A\"><VALUE.REFERENCE><CLASSNAME NAME=\"X\"/>"
      "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
  EXPECT_EQ(reference.type, "reference");
  EXPECT_EQ(std::get<ObjectName>(reference.value).className, "X");
  const Property qualified = propertyOf(
      "<PROPERTY NAME=\"A\" TYPE=\"uint8\"><QUALIFIER NAME=\"Q\" TYPE=\"boolean\"/><VALUE>1</VALUE></PROPERTY>");
  EXPECT_EQ(std::get<std::string>(qualified.value), "1");
  const Property null = propertyOf("<PROPERTY NAME=\"A\" TYPE=\"uint8\"/>");
  EXPECT_TRUE(std::holds_alternative<std::monostate>(null.value));
}

TEST(RequestTest, TakesADocumentTypeWithoutFetchingIt) {
  std::string message = intrinsicCall("M", "");
  message.insert(message.find("<CIM "), "<!DOCTYPE CIM SYSTEM \"http://localhost:1/cim.dtd\">");
  EXPECT_EQ(readRequest(message).method, "M");
}

TEST(RequestTest, ReadsUtf8WithItsMark) { EXPECT_EQ(readRequest("\xEF\xBB\xBF" + intrinsicCall("M", "")).method, "M"); }

TEST(RequestTest, ReadsAnEmbeddedInstanceAndNothingElse) {
  EXPECT_EQ(readEmbeddedInstance("<INSTANCE CLASSNAME=\"C\"/>").className, "C");
  EXPECT_THAT(thrownBy([] { readEmbeddedInstance("<CLASS NAME=\"C\"/>"); }), HasSubstr("is not an instance"));
}

TEST(RequestTest, ReadsUtf16) {
  std::u16string text = u"\uFEFF<?xml version=\"1.0\" encoding=\"utf-16\"?>";
  const std::string message = intrinsicCall("M", parameter("P", "<VALUE>x</VALUE>"));
  for (const char letter : message.substr(message.find("<CIM"))) {
    text += static_cast<char16_t>(letter);
  }
  const Request request = readRequest({reinterpret_cast<const char*>(text.data()), text.size() * sizeof(char16_t)});
  EXPECT_EQ(std::get<std::string>(request.parameters.at(0).value), "x");
}

std::string repeated(const std::string& text, int times) {
  std::string all;
  for (int i = 0; i < times; ++i) {
    all += text;
  }
  return all;
}

// With these attributes of one element, each of another name.
std::string withAttributes(int count, const std::string& separator = "=") {
  std::string attributes;
  for (int i = 0; i < count; ++i) {
    attributes += " a" + std::to_string(i) + separator + "'1'";
  }
  return intrinsicCall("M", parameter("P", "<VALUE" + attributes + ">x</VALUE>"));
}

std::string withValues(int count) {
  return intrinsicCall("M", parameter("P", "<VALUE.ARRAY>" + repeated("<VALUE/>", count) + "</VALUE.ARRAY>"));
}

TEST(RequestTest, TakesAsMuchAsTheLimitsAllow) {
  EXPECT_EQ(readRequest(withAttributes(32)).method, "M");
  EXPECT_EQ(std::get<Texts>(readRequest(withValues(65'000)).parameters.at(0).value).size(), 65'000U);
  EXPECT_EQ(nameOf(instanceName("C", repeated(keyBinding("K", "1"), 256))).keys.size(), 256U);
}

TEST(RequestTest, CountsNothingInCommentsAndCharacterData) {
  const std::string markup = repeated("<a b='1' c=\"2\" d='3'>", 30'000);
  EXPECT_EQ(valueOf<std::string>("<VALUE><!--" + markup + "--><![CDATA[" + markup + "]]></VALUE>"), markup);
  EXPECT_EQ(valueOf<std::string>("<VALUE a='" + repeated("=>", 100) + "'>x</VALUE>"), "x");
}

std::string wide(const std::string& message) {
  std::string text = "\xFE\xFF";
  for (const char letter : message) {
    text += '\0';
    text += letter;
  }
  return text;
}

// Made when it is sent: some are large, and ctest runs each case in a process of its own that lists them all.
using Message = std::function<std::string()>;

// A message that is refused, and how.
struct Refusal {
  Refusal(const char* caseName, std::string text, unsigned httpStatus, const char* error, const char* words)
      : Refusal(
            caseName, [text = std::move(text)] { return text; }, httpStatus, error, words) {}
  Refusal(const char* caseName, Message made, unsigned httpStatus, const char* error, const char* words)
      : name(caseName), message(std::move(made)), status(httpStatus), cimError(error), mentions(words) {}

  const char* name;
  Message message;
  unsigned status;
  const char* cimError;
  const char* mentions;
};

void PrintTo(const Refusal& refusal, std::ostream* stream) { *stream << refusal.name; }

class RefusedRequestTest : public testing::TestWithParam<Refusal> {};

TEST_P(RefusedRequestTest, IsAnsweredWithTheWordForIt) {
  try {
    readRequest(GetParam().message());
    FAIL() << "the message was taken";
  } catch (const TransportError& error) {
    EXPECT_EQ(error.httpStatus(), GetParam().status);
    EXPECT_EQ(error.cimError(), GetParam().cimError);
    EXPECT_THAT(error.what(), HasSubstr(GetParam().mentions));
  }
}

std::string replaced(std::string text, const std::string& what, const std::string& by) {
  return text.replace(text.find(what), what.size(), by);
}

std::string withDocumentType(const std::string& subset, const std::string& value) {
  std::string message = intrinsicCall("M", parameter("P", "<VALUE>" + value + "</VALUE>"));
  return message.insert(message.find("<CIM "), "<!DOCTYPE CIM [" + subset + "]>");
}

std::string nested(int depth) {
  std::string name = instanceName("C", keyBinding("K", "1"));
  for (int i = 0; i < depth; ++i) {
    name = instanceName("C", "<KEYBINDING NAME=\"K\"><VALUE.REFERENCE>" + name + "</VALUE.REFERENCE></KEYBINDING>");
  }
  return intrinsicCall("M", parameter("P", name));
}

const std::string good = intrinsicCall("M", "");

constexpr const char* notWellFormed = "request-not-well-formed";
constexpr const char* notValid = "request-not-valid";

INSTANTIATE_TEST_SUITE_P(
    TooCostly, RefusedRequestTest,
    testing::Values(
        Refusal{"Attributes", withAttributes(33), 400, notValid, "line 1: more than 32 attributes"},
        Refusal{"AttributesInLines", replaced(withAttributes(40), " a1=", "\n a1="), 400, notValid, "line 2: "},
        Refusal{"SpacedAttributes", [] { return withAttributes(70'000, " \n= "); }, 400, notValid,
                "more than 32 attributes"},
        Refusal{"AttributesInUtf16", wide(replaced(withAttributes(33), "utf-8", "utf-16")), 400, notValid,
                "more than 32 attributes"},
        Refusal{"Elements", [] { return withValues(70'000); }, 400, notValid, "more than 65536 elements"},
        Refusal{"Comments", [] { return intrinsicCall("M", repeated("<!---->", 66'000)); }, 400, notValid,
                "more than 65536 elements, comments and the like"},
        Refusal{"Instructions", [] { return intrinsicCall("M", repeated("<?a?>", 66'000)); }, 400, notValid,
                "more than 65536"},
        Refusal{"CharacterData", [] { return intrinsicCall("M", repeated("<![CDATA[]]>", 66'000)); }, 400, notValid,
                "more than 65536"},
        Refusal{"ElementNames",
                [] {
                  std::string elements;
                  for (int i = 0; i < 70; ++i) {
                    elements += "<E" + std::to_string(i) + "/>";
                  }
                  return intrinsicCall("M", elements);
                },
                400, notValid, "more than 64 different elements"},
        Refusal{"Keys", intrinsicCall("M", parameter("P", instanceName("C", repeated(keyBinding("K", "1"), 257)))), 400,
                notValid, "has more than 256 keys"}),
    [](const auto& test) { return test.param.name; });

INSTANTIATE_TEST_SUITE_P(
    NotWellFormed, RefusedRequestTest,
    testing::Values(
        Refusal{"Empty", "", 400, notWellFormed, ""}, Refusal{"Text", "hello", 400, notWellFormed, "line 1"},
        Refusal{"CutOff", good.substr(0, good.size() / 2), 400, notWellFormed, "line 1"},
        Refusal{"WrongEnd", replaced(good, "</SIMPLEREQ>", "</MESSAGE>"), 400, notWellFormed, "SIMPLEREQ"},
        Refusal{"NoUtf8", replaced(good, "4711", "\xFF\xFE"), 400, notWellFormed, ""},
        Refusal{"ControlCharacter", replaced(good, "4711", "\x01"), 400, notWellFormed, ""},
        Refusal{"NulByte", replaced(good, "4711", std::string(1, '\0')), 400, notWellFormed, ""},
        Refusal{"UnknownEncoding", replaced(good, "utf-8", "ebcdic-nowhere"), 400, notWellFormed, ""},
        Refusal{"AttributeTwice", replaced(good, "ID=", "ID=\"1\" ID="), 400, notWellFormed, "ID"},
        Refusal{"UndeclaredEntity", intrinsicCall("M", parameter("P", "<VALUE>&x;</VALUE>")), 400, notWellFormed, "x"},
        Refusal{"Entity", withDocumentType("<!ENTITY x \"y\">", "&x;"), 400, notWellFormed, "declares entities"},
        Refusal{"ExternalEntity", withDocumentType("<!ENTITY x SYSTEM \"file:///etc/hostname\">", "&x;"), 400,
                notWellFormed, "declares entities"},
        Refusal{"ParameterEntity", withDocumentType("<!ENTITY % x SYSTEM \"file:///etc/hostname\"> %x;", ""), 400,
                notWellFormed, "declares entities"},
        Refusal{"EntityBomb",
                withDocumentType("<!ENTITY a \"aaaaaaaaaa\"><!ENTITY b \"&a;&a;&a;&a;&a;&a;&a;&a;\">"
                                 "<!ENTITY c \"&b;&b;&b;&b;&b;&b;&b;&b;\">",
                                 "&c;"),
                400, notWellFormed, "declares entities"},
        Refusal{"DefaultAttributes", withDocumentType("<!ATTLIST VALUE a CDATA '1'>", ""), 400, notWellFormed,
                "declares entities or attributes"},
        Refusal{"HiddenMarkup", replaced(good, "utf-8", "UTF-7"), 400, notWellFormed, "must be UTF-8 or UTF-16"},
        Refusal{"AnotherMarkup", "\x4C\x6F\xA7\x94\x93", 400, notWellFormed, "must begin with <"},
        Refusal{"TagInAnAttribute", replaced(good, "\"4711\"", "\"<x a='1'>\""), 400, notWellFormed,
                "not allowed in a tag"},
        Refusal{"TooDeep", nested(200), 400, notWellFormed, "256"}),
    [](const auto& test) { return test.param.name; });

INSTANTIATE_TEST_SUITE_P(
    NotValid, RefusedRequestTest,
    testing::Values(
        Refusal{"OtherRoot", "<HTML/>", 400, notValid, "HTML"},
        Refusal{"NoVersion", "<CIM/>", 400, notValid, "CIMVERSION"},
        Refusal{"NoMessage", "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"/>", 400, notValid, "is empty"},
        Refusal{"NoMessageId", replaced(good, "ID=\"4711\" ", ""), 400, notValid, "ID"},
        Refusal{"Declaration", replaced(replaced(good, "<MESSAGE", "<DECLARATION"), "</MESSAGE>", "</DECLARATION>"),
                400, notValid, "MESSAGE"},
        Refusal{"TwoMessages", replaced(good, "</CIM>", "<MESSAGE/></CIM>"), 400, notValid, "MESSAGE"},
        Refusal{"NoCall", messageOf(""), 400, notValid, "SIMPLEREQ is empty"},
        Refusal{"Response", messageOf("<IMETHODRESPONSE NAME=\"M\"/>"), 400, notValid, "IMETHODRESPONSE"},
        Refusal{"NoMethod", messageOf("<IMETHODCALL>" + nameSpacePath() + "</IMETHODCALL>"), 400, notValid, "NAME"},
        Refusal{"NoNamespace", messageOf("<IMETHODCALL NAME=\"M\"/>"), 400, notValid, "LOCALNAMESPACEPATH"},
        Refusal{"EmptyNamespace", messageOf("<IMETHODCALL NAME=\"M\"><LOCALNAMESPACEPATH/></IMETHODCALL>"), 400,
                notValid, "namespace"},
        Refusal{"NoTarget", messageOf("<METHODCALL NAME=\"M\"/>"), 400, notValid, "LOCALCLASSPATH"},
        Refusal{"OtherParameter", intrinsicCall("M", "<PARAMVALUE NAME=\"P\"/>"), 400, notValid, "IPARAMVALUE"},
        Refusal{"NamelessParameter", intrinsicCall("M", "<IPARAMVALUE/>"), 400, notValid, "NAME"},
        Refusal{"UnknownValue", intrinsicCall("M", parameter("P", "<THING/>")), 400, notValid, "THING"},
        Refusal{"TwoValues", intrinsicCall("M", parameter("P", "<VALUE/><VALUE/>")), 400, notValid, "VALUE"},
        Refusal{"ElementInText", intrinsicCall("M", parameter("P", "<VALUE><B/></VALUE>")), 400, notValid, "B"},
        Refusal{"EntityOfAnotherDtd",
                replaced(intrinsicCall("M", parameter("P", "<VALUE>&x;</VALUE>")), "<CIM ",
                         "<!DOCTYPE CIM SYSTEM \"http://localhost:1/cim.dtd\"><CIM "),
                400, notValid, "x"},
        Refusal{"ArrayOfThings", intrinsicCall("M", parameter("P", "<VALUE.ARRAY><B/></VALUE.ARRAY>")), 400, notValid,
                "B"},
        Refusal{"ClasslessName", intrinsicCall("M", parameter("P", "<INSTANCENAME/>")), 400, notValid, "CLASSNAME"},
        Refusal{"NamelessKey",
                intrinsicCall("M", parameter("P", instanceName("C", "<KEYBINDING><KEYVALUE/></KEYBINDING>"))), 400,
                notValid, "NAME"},
        Refusal{"ValuelessKey", intrinsicCall("M", parameter("P", instanceName("C", "<KEYBINDING NAME=\"K\"/>"))), 400,
                notValid, "KEYBINDING"},
        Refusal{"OddKeyType",
                intrinsicCall("M", parameter("P", instanceName("C", keyBinding("K", "1", "VALUETYPE=\"odd\"")))), 400,
                notValid, "odd"},
        Refusal{"TwoLoneKeys",
                intrinsicCall("M", parameter("P", instanceName("C", "<KEYVALUE>1</KEYVALUE><KEYVALUE>2</KEYVALUE>"))),
                400, notValid, "KEYVALUE"},
        Refusal{"StrangeInNamespace",
                messageOf("<IMETHODCALL NAME=\"M\"><LOCALNAMESPACEPATH><THING/></LOCALNAMESPACEPATH></IMETHODCALL>"),
                400, notValid, "THING must be NAMESPACE"},
        Refusal{"ParameterBeforeNamespace",
                messageOf("<IMETHODCALL NAME=\"M\"><IPARAMVALUE NAME=\"P\"/></IMETHODCALL>"), 400, notValid,
                "must begin with LOCALNAMESPACEPATH"},
        Refusal{"ParameterBeforeTarget", messageOf("<METHODCALL NAME=\"M\"><PARAMVALUE NAME=\"P\"/></METHODCALL>"), 400,
                notValid, "must begin with LOCALCLASSPATH or LOCALINSTANCEPATH"},
        Refusal{"StrangeKey",
                intrinsicCall("M", parameter("P", instanceName("C", "<KEYBINDING NAME=\"K\"><VALUE/></KEYBINDING>"))),
                400, notValid, "VALUE is not a key value"},
        Refusal{"LoneKeyAfterAnother",
                intrinsicCall("M", parameter("P", instanceName("C", keyBinding("K", "1") + "<KEYVALUE>1</KEYVALUE>"))),
                400, notValid, "KEYVALUE must not stand beside other keys"},
        Refusal{"StrangeReference", intrinsicCall("M", parameter("P", "<VALUE.REFERENCE><VALUE/></VALUE.REFERENCE>")),
                400, notValid, "VALUE is not a class or instance name"},
        Refusal{"EmptyPath", intrinsicCall("M", parameter("P", "<INSTANCEPATH/>")), 400, notValid,
                "INSTANCEPATH must contain a namespace path and a name"},
        Refusal{
            "PathOfThree",
            intrinsicCall("M", parameter("P", "<LOCALCLASSPATH>" + nameSpacePath() +
                                                  "<CLASSNAME NAME=\"C\"/><CLASSNAME NAME=\"C\"/></LOCALCLASSPATH>")),
            400, notValid, "LOCALCLASSPATH must contain a namespace path and a name"},
        Refusal{"StrangeInPath",
                intrinsicCall("M", parameter("P", "<LOCALCLASSPATH>" + nameSpacePath() + "<THING/></LOCALCLASSPATH>")),
                400, notValid, "THING is not a class or instance name"},
        Refusal{"StrangePlace",
                intrinsicCall("M", parameter("P", "<CLASSPATH><THING/><CLASSNAME NAME=\"C\"/></CLASSPATH>")), 400,
                notValid, "THING is not a namespace path"},
        Refusal{"EmptyPlace",
                intrinsicCall("M", parameter("P", "<CLASSPATH><NAMESPACEPATH/><CLASSNAME NAME=\"C\"/></CLASSPATH>")),
                400, notValid, "NAMESPACEPATH is not a namespace path"},
        Refusal{"PlaceOfAHostAlone",
                intrinsicCall(
                    "M",
                    parameter(
                        "P",
                        "<CLASSPATH><NAMESPACEPATH><HOST>h</HOST></NAMESPACEPATH><CLASSNAME NAME=\"C\"/></CLASSPATH>")),
                400, notValid, "NAMESPACEPATH is not a namespace path"},
        Refusal{"StrangeAfterTheHost",
                intrinsicCall("M", parameter("P",
                                             "<CLASSPATH><NAMESPACEPATH><HOST>h</HOST><THING/></"
                                             "NAMESPACEPATH><CLASSNAME NAME=\"C\"/></CLASSPATH>")),
                400, notValid, "NAMESPACEPATH is not a namespace path"},
        Refusal{"EmptyNamedInstance", intrinsicCall("M", parameter("P", "<VALUE.NAMEDINSTANCE/>")), 400, notValid,
                "must contain an INSTANCENAME and an INSTANCE"},
        Refusal{"NamedInstanceOfThree",
                intrinsicCall(
                    "M",
                    parameter("P", "<VALUE.NAMEDINSTANCE>" + instanceName("C", "") +
                                       "<INSTANCE CLASSNAME=\"C\"/><INSTANCE CLASSNAME=\"C\"/></VALUE.NAMEDINSTANCE>")),
                400, notValid, "must contain an INSTANCENAME and an INSTANCE"},
        Refusal{"NamedInstanceOfTwoNames",
                intrinsicCall("M", parameter("P", "<VALUE.NAMEDINSTANCE>" + instanceName("C", "") +
                                                      instanceName("C", "") + "</VALUE.NAMEDINSTANCE>")),
                400, notValid, "must contain an INSTANCENAME and an INSTANCE"},
        Refusal{"NamedInstanceTheOtherWayRound",
                intrinsicCall("M", parameter("P", "<VALUE.NAMEDINSTANCE><INSTANCE CLASSNAME=\"C\"/>" +
                                                      instanceName("C", "") + "</VALUE.NAMEDINSTANCE>")),
                400, notValid, "must contain an INSTANCENAME and an INSTANCE"},
        Refusal{"ArrayInAProperty",
                intrinsicCall("M", parameter("P",
                                             "<INSTANCE CLASSNAME=\"C\"><PROPERTY NAME=\"A\" "
                                             "TYPE=\"string\"><VALUE.ARRAY/></PROPERTY></INSTANCE>")),
                400, notValid, "VALUE.ARRAY is not allowed in PROPERTY"},
        Refusal{"NamelessClass", intrinsicCall("M", parameter("P", "<CLASS/>")), 400, notValid, "NAME"},
        Refusal{"StrangeInClass", intrinsicCall("M", parameter("P", "<CLASS NAME=\"C\"><VALUE/></CLASS>")), 400,
                notValid, "VALUE is not allowed in CLASS"},
        Refusal{
            "StrangeInQualifier",
            intrinsicCall("M", parameter("P", "<QUALIFIER.DECLARATION NAME=\"C\"><METHOD/></QUALIFIER.DECLARATION>")),
            400, notValid, "METHOD is not allowed in QUALIFIER.DECLARATION"},
        Refusal{"StrangeInReferences", intrinsicCall("M", parameter("P", "<VALUE.REFARRAY><VALUE/></VALUE.REFARRAY>")),
                400, notValid, "VALUE is not a reference"},
        Refusal{"HalfAPath", intrinsicCall("M", parameter("P", "<INSTANCEPATH><CLASSNAME NAME=\"C\"/></INSTANCEPATH>")),
                400, notValid, "INSTANCEPATH"},
        Refusal{"HostlessPath",
                intrinsicCall("M", parameter("P", "<CLASSPATH><NAMESPACEPATH>" + nameSpacePath() +
                                                      "</NAMESPACEPATH><CLASSNAME NAME=\"C\"/></CLASSPATH>")),
                400, notValid, "NAMESPACEPATH"},
        Refusal{"HalfANamedInstance",
                intrinsicCall("M",
                              parameter("P", "<VALUE.NAMEDINSTANCE><INSTANCE CLASSNAME=\"C\"/></VALUE.NAMEDINSTANCE>")),
                400, notValid, "VALUE.NAMEDINSTANCE"},
        Refusal{"NamelessProperty",
                intrinsicCall("M", parameter("P", "<INSTANCE CLASSNAME=\"C\"><PROPERTY/></INSTANCE>")), 400, notValid,
                "NAME"},
        Refusal{"TwoPropertyValues",
                intrinsicCall("M", parameter("P",
                                             "<INSTANCE CLASSNAME=\"C\"><PROPERTY NAME=\"A\" TYPE=\"string\">"
                                             "<VALUE/><VALUE/></PROPERTY></INSTANCE>")),
                400, notValid, "VALUE"},
        Refusal{"NoProperty", intrinsicCall("M", parameter("P", "<INSTANCE CLASSNAME=\"C\"><B/></INSTANCE>")), 400,
                notValid, "B"}),
    [](const auto& test) { return test.param.name; });

INSTANTIATE_TEST_SUITE_P(
    NotSupported, RefusedRequestTest,
    testing::Values(Refusal{"SeveralRequests",
                            replaced(replaced(good, "<SIMPLEREQ>", "<MULTIREQ><SIMPLEREQ>"), "</SIMPLEREQ>",
                                     "</SIMPLEREQ></MULTIREQ>"),
                            501, "multiple-requests-unsupported", "one request"},
                    Refusal{"CimVersion", replaced(good, "CIMVERSION=\"2.0\"", "CIMVERSION=\"3.0\""), 501,
                            "unsupported-cim-version", "3.0"},
                    Refusal{"DtdVersion", replaced(good, "DTDVERSION=\"2.0\"", "DTDVERSION=\"1.0\""), 501,
                            "unsupported-dtd-version", "1.0"},
                    Refusal{"HalfAVersion", replaced(good, "CIMVERSION=\"2.0\"", "CIMVERSION=\"2\""), 501,
                            "unsupported-cim-version", "must be 2.x"},
                    Refusal{"ProtocolVersion", replaced(good, "PROTOCOLVERSION=\"1.0\"", "PROTOCOLVERSION=\"10.0\""),
                            501, "unsupported-protocol-version", "10.0"}),
    [](const auto& test) { return test.param.name; });

}  // namespace
