// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <string_view>

namespace Testing {

// A request message around a SIMPLEREQ's content.
inline std::string messageOf(const std::string& call) {
  return "<?xml version=\"1.0\" encoding=\"utf-8\"?><CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">"
         "<MESSAGE ID=\"4711\" PROTOCOLVERSION=\"1.0\"><SIMPLEREQ>" +
         call + "</SIMPLEREQ></MESSAGE></CIM>";
}

// The path of the namespace "root/<name>".
inline std::string nameSpacePath(const std::string& name = "test") {
  return "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"" + name + "\"/></LOCALNAMESPACEPATH>";
}

// An intrinsic method called in root/test.
inline std::string intrinsicCall(const std::string& method, const std::string& parameters) {
  return messageOf("<IMETHODCALL NAME=\"" + method + "\">" + nameSpacePath() + parameters + "</IMETHODCALL>");
}

inline std::string parameter(const std::string& name, const std::string& value) {
  return "<IPARAMVALUE NAME=\"" + name + "\">" + value + "</IPARAMVALUE>";
}

inline std::string value(const std::string& text) { return "<VALUE>" + text + "</VALUE>"; }

inline std::string className(const std::string& name) {
  return parameter("ClassName", "<CLASSNAME NAME=\"" + name + "\"/>");
}

inline std::string keyBinding(const std::string& name, const std::string& value,
                              const std::string& attributes = "VALUETYPE=\"string\"") {
  return "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE " + attributes + ">" + value + "</KEYVALUE></KEYBINDING>";
}

inline std::string instanceName(const std::string& name, const std::string& keys) {
  return "<INSTANCENAME CLASSNAME=\"" + name + "\">" + keys + "</INSTANCENAME>";
}

// How often the part stands in the text.
inline int count(std::string_view text, std::string_view part) {
  int found = 0;
  for (auto at = text.find(part); at != std::string_view::npos; at = text.find(part, at + 1)) {
    ++found;
  }
  return found;
}

}  // namespace Testing
