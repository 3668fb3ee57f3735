// SPDX-License-Identifier: Apache-2.0
// The intrinsic methods, against the probe provider.
#include <cmpidt.h>

#include "tests/cimom/cimxml/EndpointTest.h"
#include "tests/support/broker/RecordingProvider.h"
#include "tests/support/probe/ProbeObjects.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::MatchesRegex;
using testing::Not;
using testing::StartsWith;

class OperationsTest : public EndpointTest {};

std::string propertyList(const std::vector<std::string>& names) {
  std::string values;
  for (const auto& name : names) {
    values += "<VALUE>" + name + "</VALUE>";
  }
  return parameter("PropertyList", "<VALUE.ARRAY>" + values + "</VALUE.ARRAY>");
}

std::string property(const std::string& name, const std::string& type, const std::string& text) {
  return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\">" + value(text) + "</PROPERTY>";
}

std::string modified(const std::string& name, const std::string& properties) {
  return parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + name + "<INSTANCE CLASSNAME=\"TEST_Thing\">" +
                                           properties + "</INSTANCE></VALUE.NAMEDINSTANCE>");
}

const std::string instanceOne = parameter("InstanceName", thingName());
const std::string objectOne = parameter("ObjectName", thingName());

constexpr const char* keysOfOne =
    "<KEYBINDING NAME=\"Name\"><KEYVALUE VALUETYPE=\"string\" TYPE=\"string\">thing</KEYVALUE></KEYBINDING>"
    "<KEYBINDING NAME=\"Number\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint16\">1</KEYVALUE></KEYBINDING>";

TEST_F(OperationsTest, EnumerateInstancesNamesEveryInstance) {
  const std::string result = returned("EnumerateInstances", className("TEST_Thing"));
  EXPECT_EQ(count(result, "<VALUE.NAMEDINSTANCE>"), 3);
  EXPECT_THAT(result, HasSubstr("<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"TEST_Thing\">" +
                                std::string(keysOfOne) + "</INSTANCENAME><INSTANCE CLASSNAME=\"TEST_Thing\">"));
}

TEST_F(OperationsTest, AnInstanceShowsEveryTypeOfProperty) {
  const std::string result = returned("GetInstance", instanceOne);
  for (const std::string& expected :
       {property("Flag", "boolean", "TRUE"), property("Letter", "char16", "\xE2\x82\xAC"),
        property("U64", "uint64", "18446744073709551615"), property("S8", "sint8", "-128"),
        property("R32", "real32", "1.5"), property("Moment", "datetime", "20260102030405.000000+060"),
        property("Text", "string", "&lt;plain&gt; &amp; &quot;quoted&quot; \xE2\x82\xAC"),
        property("WithDefault", "uint16", "5"), std::string("<PROPERTY NAME=\"Unset\" TYPE=\"string\"></PROPERTY>"),
        "<PROPERTY.ARRAY NAME=\"Numbers\" TYPE=\"uint16\"><VALUE.ARRAY>" + value("14") + value("15") +
            "</VALUE.ARRAY></PROPERTY.ARRAY>"}) {
    EXPECT_THAT(result, HasSubstr(expected));
  }
  EXPECT_THAT(result, StartsWith("<IRETURNVALUE><INSTANCE CLASSNAME=\"TEST_Thing\">"));
}

TEST_F(OperationsTest, AnArrayKeepsItsNulls) {
  EXPECT_THAT(returned("EnumerateInstances", className("TEST_Numbered")),
              HasSubstr("<VALUE.ARRAY>" + value("one") + "<VALUE.NULL></VALUE.NULL>" + value("") + "</VALUE.ARRAY>"));
}

TEST_F(OperationsTest, AReferenceIsAFullPath) {
  const std::string result = returned("EnumerateInstances", className("TEST_Link"));
  const std::string path =
      "<VALUE.REFERENCE><INSTANCEPATH><NAMESPACEPATH><HOST>server</HOST>" + nameSpacePath() + "</NAMESPACEPATH>";
  std::string expected = path;
  for (auto at = expected.find("/>"); at != std::string::npos; at = expected.find("/>")) {
    expected.replace(at, 2, "></NAMESPACE>");
  }
  EXPECT_THAT(result, HasSubstr("<KEYBINDING NAME=\"Whole\">" + expected));
  EXPECT_THAT(result, HasSubstr("<PROPERTY.REFERENCE NAME=\"Whole\">" + expected));
}

TEST_F(OperationsTest, EnumerateInstanceNamesNamesOnly) {
  const std::string result = returned("EnumerateInstanceNames", className("test_thing"));
  EXPECT_EQ(count(result, "<INSTANCENAME "), 3);
  EXPECT_THAT(result, Not(HasSubstr("<INSTANCE ")));
}

TEST_F(OperationsTest, APropertyListTrimsThePropertiesAndKeepsTheKeys) {
  const std::string result =
      returned("EnumerateInstances", className("TEST_Thing") + propertyList({"flag", "Nothing"}));
  EXPECT_EQ(count(result, "<PROPERTY"), 3);
  EXPECT_THAT(result, AllOf(HasSubstr("NAME=\"Flag\""), HasSubstr(keysOfOne)));
  EXPECT_EQ(count(returned("GetInstance", instanceOne + propertyList({})), "<PROPERTY"), 0);
}

TEST_F(OperationsTest, ShallowInheritanceHidesWhatASubclassAdds) {
  const std::string shallow = parameter("DeepInheritance", value("FALSE"));
  EXPECT_THAT(returned("EnumerateInstances", className("TEST_Thing")), HasSubstr("NAME=\"Extra\""));
  EXPECT_THAT(returned("EnumerateInstances", className("TEST_Thing") + shallow),
              AllOf(Not(HasSubstr("NAME=\"Extra\"")), HasSubstr("NAME=\"Flag\"")));
  EXPECT_EQ(count(returned("EnumerateInstances", className("TEST_Thing") + shallow + propertyList({"Extra", "U8"})),
                  "<PROPERTY"),
            3);
}

TEST_F(OperationsTest, ModifyInstanceReachesTheProvider) {
  EXPECT_EQ(returned("ModifyInstance", modified(thingName(), property("Text", "string", " changed "))), "");
  EXPECT_EQ(Probe::text(), "changed");
  EXPECT_EQ(returned("ModifyInstance", modified(thingName(), "<PROPERTY NAME=\"Text\" TYPE=\"string\"/>")), "");
  EXPECT_EQ(Probe::text(), "null");
}

TEST_F(OperationsTest, ModifyInstanceTakesEveryTypeOfProperty) {
  const std::string properties =
      property("Flag", "boolean", "false") + property("Letter", "char16", "x") + property("R64", "real64", "1e3") +
      property("Moment", "datetime", "20260102030405.000000+060") + property("S64", "sint64", "-1") +
      "<PROPERTY.ARRAY NAME=\"Texts\" TYPE=\"string\"><VALUE.ARRAY>" + value("a") +
      "<VALUE.NULL/></VALUE.ARRAY></PROPERTY.ARRAY>" + "<PROPERTY.ARRAY NAME=\"Numbers\" TYPE=\"uint16\"/>";
  EXPECT_EQ(returned("ModifyInstance", modified(thingName(), properties)), "");
}

TEST_F(OperationsTest, ModifyInstanceRefusesWhatContradictsItsPath) {
  const auto instanceOf = [](const std::string& className, const std::string& properties) {
    return parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + thingName() + "<INSTANCE CLASSNAME=\"" + className +
                                             "\">" + properties + "</INSTANCE></VALUE.NAMEDINSTANCE>");
  };
  const std::string text = property("Text", "string", "contradiction");
  EXPECT_EQ(failed("ModifyInstance", instanceOf("TEST_Part", text)),
            "4: an instance of TEST_Part cannot have a path of TEST_Thing");
  EXPECT_EQ(failed("ModifyInstance", instanceOf("TEST_Nowhere", text)),
            "4: an instance of TEST_Nowhere cannot have a path of TEST_Thing");
  EXPECT_EQ(failed("ModifyInstance", instanceOf("TEST_Thing", text + property("Number", "uint16", "2"))),
            "4: key Number of the instance is 2, that of its path 1");
  EXPECT_THAT(failed("ModifyInstance", modified(thingName("9"), text)), StartsWith("6: no instance "));
  EXPECT_EQ(failed("ModifyInstance", modified(thingName(), text) + propertyList({"Nothing"})),
            "12: class TEST_Thing has no property Nothing");
  EXPECT_NE(Probe::text(), "contradiction");
  EXPECT_EQ(returned("ModifyInstance", instanceOf("test_thing", text + property("Number", "uint16", "1") +
                                                                    property("Name", "string", "thing"))),
            "");
  EXPECT_EQ(Probe::text(), "contradiction");
  manager_.setStrictness(Cimom::Strictness::Bare);
  EXPECT_EQ(returned("ModifyInstance", instanceOf("TEST_Part", property("Text", "string", "bare"))), "");
  EXPECT_EQ(Probe::text(), "bare");
}

TEST_F(OperationsTest, AssociationsOfWhatIsNotThereOrOfUnknownClassesAreRefused) {
  for (const char* method : {"Associators", "AssociatorNames", "References", "ReferenceNames"}) {
    EXPECT_THAT(failed(method, parameter("ObjectName", thingName("9"))), StartsWith("6: no instance "));
  }
  const auto klass = [](const std::string& name, const std::string& value) {
    return parameter(name, "<CLASSNAME NAME=\"" + value + "\"/>");
  };
  EXPECT_EQ(failed("Associators", objectOne + klass("ResultClass", "TEST_Nowhere")),
            "4: unknown result class \"TEST_Nowhere\"");
  EXPECT_EQ(failed("References", objectOne + klass("ResultClass", "TEST_Thing")),
            "4: class TEST_Thing is not an association");
  EXPECT_EQ(returned("AssociatorNames", objectOne + parameter("Role", value("Part"))), "<IRETURNVALUE></IRETURNVALUE>");
  EXPECT_THAT(returned("AssociatorNames", objectOne + parameter("Role", value("whole"))), HasSubstr("TEST_Part"));
}

TEST_F(OperationsTest, ModifyInstanceNamesWhatDoesNotFitTheClass) {
  struct Case {
    std::string property;
    const char* expected;
  };
  const std::vector<Case> cases = {
      {property("Nothing", "string", "x"), "12: class TEST_Thing has no property Nothing"},
      {property("U8", "uint16", "1"), "13: property U8 must be of type uint8, not uint16"},
      {property("U8", "uint8", "256"), "13: property U8 must be of type uint8, not \"256\""},
      {property("Flag", "boolean", "maybe"), "13: property Flag must be of type boolean, not \"maybe\""},
      {property("Moment", "datetime", "today"), "13: property Moment must be of type datetime, not \"today\""},
      {"<PROPERTY.ARRAY NAME=\"U8\" TYPE=\"uint8\"/>", "13: property U8 must be of type uint8, not uint8[]"},
      {property("Numbers", "uint16", "1"), "13: property Numbers must be of type uint16[], not uint16"},
      {"<PROPERTY NAME=\"Numbers\">" + value("1") + "</PROPERTY>", "13: property Numbers must be of type uint16[]"},
      {"<PROPERTY.ARRAY NAME=\"Numbers\" TYPE=\"uint16\"><VALUE.ARRAY>" + value("1") + value("x") +
           "</VALUE.ARRAY></PROPERTY.ARRAY>",
       "13: element 1 of property Numbers must be of type uint16, not \"x\""}};
  for (const Case& refused : cases) {
    EXPECT_EQ(failed("ModifyInstance", modified(thingName(), refused.property)), refused.expected);
  }
}

TEST_F(OperationsTest, KeysTakeTheTypeOfTheirClass) {
  const auto get = [this](const std::string& name) { return returned("GetInstance", parameter("InstanceName", name)); };
  const std::string name = keyBinding("name", "thing");
  for (const char* attributes :
       {"VALUETYPE=\"numeric\"", "VALUETYPE=\"numeric\" TYPE=\"uint64\"", "", "TYPE=\"string\""}) {
    EXPECT_THAT(get(instanceName("test_thing", name + keyBinding("number", "1", attributes))), HasSubstr("<INSTANCE "));
  }
  EXPECT_THAT(get(instanceName("TEST_Numbered", "<KEYVALUE VALUETYPE=\"numeric\">-7</KEYVALUE>")),
              HasSubstr("<INSTANCE "));
}

TEST_F(OperationsTest, AKeyThatDoesNotFitItsClassIsNamed) {
  const auto get = [this](const std::string& name) { return failed("GetInstance", parameter("InstanceName", name)); };
  EXPECT_EQ(get(thingName("x")), "4: key Number must be of type uint16, not \"x\"");
  EXPECT_EQ(get(thingName("65536")), "4: key Number must be of type uint16, not \"65536\"");
  EXPECT_EQ(get(instanceName("TEST_Thing", "<KEYVALUE>1</KEYVALUE>")),
            "4: class TEST_Thing has more than one key, so each must be named");
  EXPECT_EQ(get(instanceName("TEST_Nowhere", "<KEYVALUE>1</KEYVALUE>")), "4: class TEST_Nowhere has no key");
  EXPECT_EQ(get(instanceName("TEST_Link", keyBinding("Whole", "x"))), "4: key Whole must be a reference");
  EXPECT_EQ(get(instanceName("TEST_Thing", "<KEYBINDING NAME=\"Name\"><VALUE.REFERENCE>" + thingName() +
                                               "</VALUE.REFERENCE></KEYBINDING>")),
            "4: key Name must not be a reference");
}

TEST_F(OperationsTest, AKeyThatNoClassDeclaresReachesTheBroker) {
  for (const char* attributes : {"VALUETYPE=\"numeric\"", "VALUETYPE=\"boolean\"", "VALUETYPE=\"string\""}) {
    for (const char* text : {"TRUE", "18446744073709551615", "-1", "0.5", "text"}) {
      EXPECT_THAT(failed("GetInstance",
                         parameter("InstanceName", instanceName("TEST_Nowhere", keyBinding("K", text, attributes)))),
                  testing::AnyOf(StartsWith("5: "), HasSubstr("4: key K must be of type boolean")));
    }
  }
}

TEST_F(OperationsTest, AnInstanceIsFoundByItsReferenceKeys) {
  const std::string names = returned("EnumerateInstanceNames", className("TEST_Link"));
  const auto begin = names.find("<INSTANCENAME CLASSNAME=\"TEST_Link\">");
  const auto end = names.find("</IRETURNVALUE>");
  EXPECT_THAT(returned("GetInstance", parameter("InstanceName", names.substr(begin, end - begin))),
              HasSubstr(property("Strength", "uint16", "9")));
}

TEST_F(OperationsTest, CreateInstanceReturnsItsName) {
  const std::string instance = "<INSTANCE CLASSNAME=\"TEST_Thing\">" + property("Name", "string", "thing") +
                               property("Number", "uint16", "1") + "</INSTANCE>";
  EXPECT_EQ(returned("CreateInstance", parameter("NewInstance", instance)),
            "<IRETURNVALUE><INSTANCENAME CLASSNAME=\"TEST_Thing\">" + std::string(keysOfOne) +
                "</INSTANCENAME></IRETURNVALUE>");
}

TEST_F(OperationsTest, DeleteInstanceReturnsNothing) { EXPECT_EQ(returned("DeleteInstance", instanceOne), ""); }

TEST_F(OperationsTest, AssociatorsHaveFullPaths) {
  EXPECT_THAT(returned("Associators", objectOne),
              StartsWith("<IRETURNVALUE><VALUE.OBJECTWITHPATH><INSTANCEPATH><NAMESPACEPATH><HOST>server</HOST>"));
  EXPECT_THAT(returned("AssociatorNames", objectOne),
              AllOf(StartsWith("<IRETURNVALUE><OBJECTPATH><INSTANCEPATH><NAMESPACEPATH>"),
                    HasSubstr("<INSTANCENAME CLASSNAME=\"TEST_Part\">")));
  EXPECT_THAT(returned("References", objectOne + propertyList({"Strength"})),
              AllOf(HasSubstr(property("Strength", "uint16", "9")), Not(HasSubstr("<PROPERTY.REFERENCE"))));
  EXPECT_THAT(returned("ReferenceNames", objectOne),
              AllOf(StartsWith("<IRETURNVALUE><OBJECTPATH>"), HasSubstr("CLASSNAME=\"TEST_Link\"")));
}

TEST_F(OperationsTest, AssociationTraversalFromAClassIsNotSupported) {
  EXPECT_THAT(failed("Associators", parameter("ObjectName", "<CLASSNAME NAME=\"TEST_Thing\"/>")), StartsWith("7: "));
}

TEST_F(OperationsTest, TheProvidersErrorReachesTheClient) {
  EXPECT_EQ(failed("EnumerateInstances", className("TEST_Failing")), "2: out of <order>");
}

TEST_F(OperationsTest, AnInstanceThatIsNotThereIsNotFound) {
  EXPECT_THAT(failed("GetInstance", parameter("InstanceName", thingName("9"))), StartsWith("6: "));
}

TEST_F(OperationsTest, UnknownNamesHaveStatusesOfTheirOwn) {
  EXPECT_THAT(failed("EnumerateInstances", className("TEST_Nowhere")), StartsWith("5: "));
  EXPECT_EQ(failed("GetClass", className("TEST_Nowhere")), "6: unknown class \"TEST_Nowhere\"");
  EXPECT_EQ(failed("EnumerateClassNames", className("TEST_Nowhere")), "5: unknown class \"TEST_Nowhere\"");
  EXPECT_EQ(failed("Frobnicate", ""), "7: operation Frobnicate is not supported");
  EXPECT_EQ(returned("EnumerateInstances", className("TEST_Unserved")), "<IRETURNVALUE></IRETURNVALUE>");
}

TEST_F(OperationsTest, AnUnknownNamespaceIsNamedBeforeAnythingElse) {
  const auto refused = [this](const std::string& method, const std::string& parameters) {
    Cimom::Http::Request sent = request(method, messageOf("<IMETHODCALL NAME=\"" + method + "\">" +
                                                          nameSpacePath("nowhere") + parameters + "</IMETHODCALL>"));
    sent.headers = {};
    sent.headers.add("CIMOperation", "MethodCall");
    sent.headers.add("CIMMethod", method);
    sent.headers.add("CIMObject", "root/nowhere");
    return contentOf(endpoint_.handle(sent), method);
  };
  const std::pair<std::string, std::string> calls[] = {
      {"EnumerateInstances", className("TEST_Thing")},
      {"GetInstance", parameter("InstanceName", instanceName("TEST_Nowhere", "<KEYVALUE>1</KEYVALUE>"))},
      {"CreateInstance", parameter("NewInstance", "<INSTANCE CLASSNAME=\"TEST_Thing\"/>")},
      {"ModifyInstance", modified(thingName(), property("Text", "string", "x"))},
      {"Associators", objectOne},
      {"GetClass", ""},
      {"EnumerateClassNames", className("TEST_Nowhere")},
      {"EnumerateQualifiers", ""}};
  for (const auto& [method, parameters] : calls) {
    EXPECT_THAT(refused(method, parameters),
                StartsWith("<ERROR CODE=\"3\" DESCRIPTION=\"unknown namespace &quot;root/nowhere&quot;\">"))
        << method;
  }
}

TEST_F(OperationsTest, ChangesOfTheSchemaAndQueriesAreNotSupported) {
  const std::string klass =
      "<CLASS NAME=\"TEST_New\" SUPERCLASS=\"TEST_Thing\"><PROPERTY NAME=\"A\" TYPE=\"string\"/></CLASS>";
  const std::string qualifier = parameter("QualifierDeclaration",
                                          "<QUALIFIER.DECLARATION NAME=\"New\" TYPE=\"boolean\" ISARRAY=\"false\">"
                                          "<SCOPE CLASS=\"true\"/><VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>");
  const std::pair<std::string, std::string> calls[] = {
      {"CreateClass", parameter("NewClass", klass)},
      {"ModifyClass", parameter("ModifiedClass", klass)},
      {"DeleteClass", className("TEST_Thing")},
      {"SetQualifier", qualifier},
      {"DeleteQualifier", parameter("QualifierName", value("Key"))},
      {"ExecQuery", parameter("QueryLanguage", value("WQL")) + parameter("Query", value("SELECT * FROM TEST_Thing"))},
  };
  for (const auto& [method, parameters] : calls) {
    EXPECT_EQ(failed(method, parameters), "7: operation " + method + " is not supported");
  }
}

TEST_F(OperationsTest, AnErrorWithoutATextHasTheMeaningOfItsCode) {
  const auto provider = std::make_shared<RecordingProvider>();
  provider->serve(manager_, "TEST_Unserved", "root/test");
  const auto describe = [&](CMPIStatus status) {
    provider->answer = [status](const auto&...) { return status; };
    return failed("EnumerateInstances", className("TEST_Unserved"));
  };
  EXPECT_EQ(describe({CMPI_RC_ERR_ACCESS_DENIED, nullptr}), "2: access is denied");
  EXPECT_EQ(describe({CMPI_RC_ERR_FAILED, nullptr}), "1: the operation failed for a reason that is not known");
  EXPECT_EQ(describe({CMPI_RC_ERR_METHOD_NOT_FOUND, nullptr}), "17: the method does not exist");
  EXPECT_EQ(describe({CMPI_RC_ERROR_SYSTEM, nullptr}), "1: the operation failed with return code 100");
  CMPIString* empty = CMNewString(manager_.broker(), "", nullptr);
  EXPECT_EQ(describe({CMPI_RC_ERR_NOT_FOUND, empty}), "6: the object does not exist");
  CMRelease(empty);
}

// A provider may name its system in some paths and leave it to the object manager in others.
TEST_F(OperationsTest, OneSystemHasOneNameInAnAnswer) {
  const auto provider = std::make_shared<RecordingProvider>();
  manager_.loadSchemaText(
      "class TEST_Host { [Key] string Id; };\n"
      "[Association] class TEST_Pair { [Key] TEST_Host ref A; [Key] TEST_Host ref B; };",
      "root/test");
  provider->serve(manager_, "TEST_Pair", "root/test");
  const auto answerWith = [&](std::vector<std::string> hosts, const char* nameSpace) {
    provider->answer = [broker = manager_.broker(), hosts, nameSpace](const CMPIContext*, const CMPIResult* result,
                                                                      const CMPIObjectPath* asked,
                                                                      const CMPIInstance*) {
      CMPIInstance* pair = CMNewInstance(broker, asked, nullptr);
      for (std::size_t i = 0; i < hosts.size(); ++i) {
        CMPIObjectPath* end = CMNewObjectPath(broker, nameSpace, "TEST_Host", nullptr);
        CMAddKey(end, "Id", i == 0 ? "a" : "b", CMPI_chars);
        if (!hosts[i].empty()) {
          CMSetHostname(end, hosts[i].c_str());
        }
        CMSetProperty(pair, i == 0 ? "A" : "B", &end, CMPI_ref);
      }
      CMReturnInstance(result, pair);
      return ok;
    };
    return returned("EnumerateInstances", className("TEST_Pair"));
  };
  const std::string named = answerWith({"managed.example", ""}, "root/test");
  EXPECT_EQ(count(named, "<HOST>managed.example</HOST>"), 4);
  EXPECT_EQ(count(named, "<HOST>"), 4);
  EXPECT_EQ(count(answerWith({"", ""}, "root/test"), "<HOST>server</HOST>"), 4);
  EXPECT_EQ(count(answerWith({"one.example", "two.example"}, "root/test"), "<HOST>two.example</HOST>"), 2)
      << "what a provider says stands";
  EXPECT_EQ(count(answerWith({"far.example", ""}, "root/far"), "<HOST>server</HOST>"), 2)
      << "what is in another namespace says nothing of this one";
}

TEST_F(OperationsTest, ParametersAreCheckedByNameAndKind) {
  const std::string thing = className("TEST_Thing");
  EXPECT_EQ(failed("EnumerateInstances", ""), "4: parameter ClassName is missing");
  EXPECT_EQ(failed("EnumerateInstances", parameter("ClassName", "")), "4: parameter ClassName is missing");
  EXPECT_EQ(failed("EnumerateInstances", thing + thing), "4: parameter ClassName is a duplicate");
  EXPECT_EQ(failed("EnumerateInstances", thing + parameter("Odd", "")), "4: parameter Odd is unknown");
  EXPECT_EQ(failed("EnumerateInstances", parameter("ClassName", value("x"))),
            "4: parameter ClassName must be a class name");
  EXPECT_EQ(failed("EnumerateInstances", parameter("ClassName", thingName())),
            "4: parameter ClassName must be a class name");
  EXPECT_EQ(failed("EnumerateInstances", thing + parameter("DeepInheritance", value("maybe"))),
            "4: parameter DeepInheritance must be TRUE or FALSE");
  EXPECT_EQ(failed("EnumerateInstances", thing + parameter("PropertyList", value("x"))),
            "4: parameter PropertyList must be a list of names");
  std::string names;
  for (int i = 0; i < 4097; ++i) {
    names += value("Name");
  }
  EXPECT_EQ(failed("EnumerateInstances", thing + parameter("PropertyList", "<VALUE.ARRAY>" + names + "</VALUE.ARRAY>")),
            "4: parameter PropertyList must not have more than 4096 names");
  EXPECT_EQ(failed("GetInstance", ""), "4: parameter InstanceName is missing");
  EXPECT_EQ(failed("GetInstance", parameter("InstanceName", value("x"))),
            "4: parameter InstanceName must be an instance name");
  EXPECT_EQ(failed("ModifyInstance", ""), "4: parameter ModifiedInstance is missing");
  EXPECT_EQ(failed("ModifyInstance", parameter("ModifiedInstance", thingName())),
            "4: parameter ModifiedInstance must be an instance");
}

TEST_F(OperationsTest, GetPropertyAndSetPropertyGoToTheBroker) {
  EXPECT_THAT(returned("GetProperty", instanceOne + parameter("PropertyName", value("U8"))), HasSubstr(value("255")));
  EXPECT_THAT(failed("GetProperty", instanceOne + parameter("PropertyName", value("Nothing"))), StartsWith("12: "));
  EXPECT_EQ(returned("SetProperty",
                     instanceOne + parameter("PropertyName", value("Text")) + parameter("NewValue", value("set"))),
            "");
  EXPECT_EQ(Probe::text(), "set");
  EXPECT_EQ(failed("SetProperty", instanceOne + parameter("PropertyName", value("Text")) +
                                      parameter("NewValue", "<INSTANCE CLASSNAME=\"TEST_Thing\"/>")),
            "13: parameter NewValue must be a value of the property's type");
  EXPECT_EQ(Probe::text(), "set");
  const std::string nobodys =
      instanceName("TEST_Nowhere", keyBinding("Number", "1", "VALUETYPE=\"numeric\" TYPE=\"uint16\"") +
                                       "<KEYBINDING NAME=\"Part\"><VALUE.REFERENCE>" + thingName() +
                                       "</VALUE.REFERENCE></KEYBINDING>");
  EXPECT_EQ(failed("SetProperty", parameter("InstanceName", nobodys) + parameter("PropertyName", value("Text")) +
                                      parameter("NewValue", value("set"))),
            "5: unknown class \"TEST_Nowhere\"");
}

TEST_F(OperationsTest, MethodsOfAClassHaveStatusesOfTheirOwn) {
  const auto call = [this](const std::string& method, const std::string& klass, const std::string& nameSpace,
                           const std::string& arguments = {}) {
    Cimom::Http::Request sent = request(
        method, messageOf("<METHODCALL NAME=\"" + method + "\"><LOCALCLASSPATH>" + nameSpacePath(nameSpace) +
                          "<CLASSNAME NAME=\"" + klass + "\"/></LOCALCLASSPATH>" + arguments + "</METHODCALL>"));
    sent.headers = {};
    sent.headers.add("CIMOperation", "MethodCall");
    sent.headers.add("CIMMethod", method);
    sent.headers.add("CIMObject", "root/" + nameSpace + ":" + klass);
    return endpoint_.handle(sent).body;
  };
  EXPECT_THAT(call("Reset", "TEST_Part", "test"),
              AllOf(HasSubstr("<METHODRESPONSE NAME=\"Reset\">"), HasSubstr("<ERROR CODE=\"16\"")));
  EXPECT_THAT(call("Nothing", "TEST_Part", "test"), HasSubstr("<ERROR CODE=\"17\""));
  EXPECT_THAT(call("Reset", "TEST_Nowhere", "test"), HasSubstr("<ERROR CODE=\"5\""));
  EXPECT_THAT(call("Reset", "TEST_Part", "nowhere"), HasSubstr("<ERROR CODE=\"3\""));
  const std::string others = "<PARAMVALUE NAME=\"Others\"><VALUE.REFARRAY><VALUE.REFERENCE>" + thingName() +
                             "</VALUE.REFERENCE><VALUE.NULL/></VALUE.REFARRAY></PARAMVALUE>";
  EXPECT_THAT(call("Nothing", "TEST_Part", "test", others), HasSubstr("<ERROR CODE=\"17\""));
}

TEST_F(OperationsTest, AnErrorQuotesOnlyTheBeginningOfALongName) {
  const std::string name = instanceName(
      "TEST_Thing", keyBinding("Name", std::string(100'000, 'x')) + keyBinding("Number", "1", "VALUETYPE=\"numeric\""));
  const std::string description = failed("GetInstance", parameter("InstanceName", name));
  EXPECT_THAT(description, AllOf(StartsWith("6: "), HasSubstr("xxxx"), testing::EndsWith("x ...")));
  EXPECT_LT(description.size(), 4200U);
}

}  // namespace
