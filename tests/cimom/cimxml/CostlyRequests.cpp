// SPDX-License-Identifier: Apache-2.0
#include "tests/cimom/cimxml/CostlyRequests.h"

#include <algorithm>
#include <functional>

#include "tests/cimom/cimxml/Messages.h"

namespace Testing {
namespace {

// Pieces one after the other, as many as fit; each is made of its number.
std::string repeated(std::size_t bytes, const std::function<std::string(std::size_t)>& piece) {
  std::string text;
  for (std::size_t number = 0; text.size() < bytes; ++number) {
    text += piece(number);
  }
  return text;
}

std::string repeated(std::size_t bytes, const std::string& piece) {
  return repeated(bytes, [&](std::size_t) { return piece; });
}

std::string getInstance(const std::string& keys) {
  return intrinsicCall("GetInstance", parameter("InstanceName", instanceName("TEST_Thing", keys)));
}

std::string enumerate(const std::string& parameters) {
  return intrinsicCall("EnumerateInstances", className("TEST_Thing") + parameters);
}

std::string nestedReferences(std::size_t bytes) {
  constexpr std::size_t levelBytes = 118;
  // The reader refuses what nests deeper than 256 elements.
  const std::size_t levels = std::min<std::size_t>(bytes / levelBytes, 60);
  std::string keys = keyBinding("Name", "x");
  for (std::size_t level = 0; level < levels; ++level) {
    keys = "<KEYBINDING NAME=\"Other\"><VALUE.REFERENCE>" + instanceName("TEST_Thing", keys) +
           "</VALUE.REFERENCE></KEYBINDING>";
  }
  return getInstance(keys);
}

std::string created(const std::string& properties) {
  return intrinsicCall("CreateInstance",
                       parameter("NewInstance", "<INSTANCE CLASSNAME=\"TEST_Thing\">" + properties + "</INSTANCE>"));
}

std::string modified(const std::string& properties) {
  return intrinsicCall(
      "ModifyInstance",
      parameter("ModifiedInstance",
                "<VALUE.NAMEDINSTANCE>" +
                    instanceName("TEST_Thing",
                                 keyBinding("Name", "thing") + keyBinding("Number", "1", "VALUETYPE=\"numeric\"")) +
                    "<INSTANCE CLASSNAME=\"TEST_Thing\">" + properties + "</INSTANCE></VALUE.NAMEDINSTANCE>"));
}

std::string array(const std::string& values) {
  return "<PROPERTY.ARRAY NAME=\"Texts\" TYPE=\"string\"><VALUE.ARRAY>" + values + "</VALUE.ARRAY></PROPERTY.ARRAY>";
}

std::string reset(const std::string& arguments) {
  return messageOf(
      "<METHODCALL NAME=\"Reset\"><LOCALINSTANCEPATH>" + nameSpacePath() +
      instanceName("TEST_Thing", keyBinding("Name", "thing") + keyBinding("Number", "1", "VALUETYPE=\"numeric\"")) +
      "</LOCALINSTANCEPATH>" + arguments + "</METHODCALL>");
}

}  // namespace

const std::vector<CostlyRequest>& costlyRequests() {
  static const std::vector<CostlyRequest> requests = {
      {"nested references", "GetInstance", nestedReferences},
      {"keys", "GetInstance",
       [](std::size_t bytes) {
         return getInstance(
             repeated(bytes, [](std::size_t number) { return keyBinding("K" + std::to_string(number), "x"); }));
       }},
      {"one long key", "GetInstance",
       [](std::size_t bytes) { return getInstance(keyBinding("Name", std::string(bytes, '"'))); }},
      {"attributes", "EnumerateInstances",
       [](std::size_t bytes) {
         const auto attribute = [](std::size_t number) { return " a" + std::to_string(number) + "=\"\""; };
         return enumerate("<IPARAMVALUE" + repeated(bytes, attribute) + "/>");
       }},
      {"unknown elements", "EnumerateInstances",
       [](std::size_t bytes) {
         return enumerate(repeated(bytes, [](std::size_t number) { return "<E" + std::to_string(number) + "/>"; }));
       }},
      {"empty elements", "EnumerateInstances", [](std::size_t bytes) { return enumerate(repeated(bytes, "<E/>")); }},
      {"names of properties", "EnumerateInstances",
       [](std::size_t bytes) {
         const auto value = [](std::size_t number) { return "<VALUE>P" + std::to_string(number) + "</VALUE>"; };
         return enumerate(parameter("PropertyList", "<VALUE.ARRAY>" + repeated(bytes, value) + "</VALUE.ARRAY>"));
       }},
      {"the same name of a property", "EnumerateInstances",
       [](std::size_t bytes) {
         return enumerate(
             parameter("PropertyList", "<VALUE.ARRAY>" + repeated(bytes, "<VALUE>Flag</VALUE>") + "</VALUE.ARRAY>"));
       }},
      {"parameters", "EnumerateInstances",
       [](std::size_t bytes) { return enumerate(repeated(bytes, parameter("LocalOnly", "<VALUE>TRUE</VALUE>"))); }},
      {"character references", "GetInstance",
       [](std::size_t bytes) { return getInstance(keyBinding("Name", repeated(bytes, "&#38;"))); }},
      {"comments", "EnumerateInstances", [](std::size_t bytes) { return enumerate(repeated(bytes, "<!---->")); }},
      {"processing instructions", "EnumerateInstances",
       [](std::size_t bytes) { return enumerate(repeated(bytes, "<?a?>")); }},
      {"sections of character data", "GetInstance",
       [](std::size_t bytes) { return getInstance(keyBinding("Name", repeated(bytes, "<![CDATA[]]>x"))); }},
      {"a name of a namespace", "EnumerateInstances",
       [](std::size_t bytes) {
         return messageOf("<IMETHODCALL NAME=\"EnumerateInstances\"><LOCALNAMESPACEPATH>" +
                          repeated(bytes, "<NAMESPACE NAME=\"a\"/>") + "</LOCALNAMESPACEPATH></IMETHODCALL>");
       }},
      {"properties", "CreateInstance",
       [](std::size_t bytes) {
         return created(repeated(bytes, "<PROPERTY NAME=\"Text\" TYPE=\"string\"><VALUE>x</VALUE></PROPERTY>"));
       }},
      {"an array of texts", "ModifyInstance",
       [](std::size_t bytes) { return modified(array(repeated(bytes, "<VALUE>x</VALUE>"))); }},
      {"as many texts as the limits allow", "ModifyInstance",
       [](std::size_t bytes) {
         return modified(array(repeated(bytes, "<VALUE>" + std::string(50, '"') + "</VALUE>")));
       }},
      {"as many comments as the limits allow", "EnumerateInstances",
       [](std::size_t bytes) { return enumerate(repeated(bytes, "<!--" + std::string(58, 'x') + "-->")); }},
      {"as many references as the limits allow", "Reset",
       [](std::size_t bytes) {
         const std::string name = instanceName(std::string(85, 'C'), "");
         return reset("<PARAMVALUE NAME=\"Other\" PARAMTYPE=\"reference\"><VALUE.REFARRAY>" +
                      repeated(bytes, "<VALUE.REFERENCE>" + name + "</VALUE.REFERENCE>") +
                      "</VALUE.REFARRAY></PARAMVALUE>");
       }},
      {"an array of nulls", "ModifyInstance",
       [](std::size_t bytes) { return modified(array(repeated(bytes, "<VALUE.NULL/>"))); }},
      {"a long text", "ModifyInstance",
       [](std::size_t bytes) {
         return modified("<PROPERTY NAME=\"Text\" TYPE=\"string\"><VALUE>" + std::string(bytes, 'x') +
                         "</VALUE></PROPERTY>");
       }},
      {"qualifiers", "ModifyInstance",
       [](std::size_t bytes) {
         return modified("<PROPERTY NAME=\"Text\" TYPE=\"string\">" +
                         repeated(bytes, "<QUALIFIER NAME=\"Q\" TYPE=\"string\"/>") + "<VALUE>x</VALUE></PROPERTY>");
       }},
      {"arguments", "Reset",
       [](std::size_t bytes) {
         return reset(
             repeated(bytes, "<PARAMVALUE NAME=\"Force\" PARAMTYPE=\"boolean\"><VALUE>TRUE</VALUE></PARAMVALUE>"));
       }},
      {"an argument of many texts", "Reset",
       [](std::size_t bytes) {
         return reset("<PARAMVALUE NAME=\"Names\" PARAMTYPE=\"string\"><VALUE.ARRAY>" +
                      repeated(bytes, "<VALUE>x</VALUE>") + "</VALUE.ARRAY></PARAMVALUE>");
       }},
      {"an array of references", "Reset", [](std::size_t bytes) {
         return reset("<PARAMVALUE NAME=\"Other\" PARAMTYPE=\"reference\"><VALUE.REFARRAY>" +
                      repeated(bytes, "<VALUE.REFERENCE>" + instanceName("TEST_Thing", "") + "</VALUE.REFERENCE>") +
                      "</VALUE.REFARRAY></PARAMVALUE>");
       }}};
  return requests;
}

}  // namespace Testing
