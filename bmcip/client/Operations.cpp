// SPDX-License-Identifier: Apache-2.0
#include "bmcip/client/Operations.h"

#include <algorithm>
#include <functional>

#include "cimom/cimxml/Document.h"
#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/XmlWriter.h"
#include "ground/Names.h"

namespace Bmcip {
namespace {

using Cimom::CimXml::Document;
using Cimom::CimXml::Element;
using Cimom::CimXml::KeyValue;
using Cimom::CimXml::TransportError;
using Cimom::CimXml::XmlWriter;
using Ground::sameName;

// The number of CIM status codes (DSP0200) that have a name here.
constexpr const char* statusNames[] = {
    "",          "failed",       "access denied", "invalid namespace", "invalid parameter", "invalid class",
    "not found", "not supported"};

void writeNameSpace(XmlWriter& xml, const std::string& nameSpace) {
  const auto path = xml.element("LOCALNAMESPACEPATH");
  for (std::size_t begin = 0; begin <= nameSpace.size();) {
    const std::size_t end = std::min(nameSpace.find('/', begin), nameSpace.size());
    if (end > begin) {
      const auto part = xml.element("NAMESPACE", "NAME", nameSpace.substr(begin, end - begin));
    }
    begin = end + 1;
  }
}

// As it came: a key's types too, since an object manager knows its own best.
void writeName(XmlWriter& xml, const ObjectName& name) {
  const auto instanceName = xml.element("INSTANCENAME", "CLASSNAME", name.className);
  for (const auto& [key, value] : name.keys) {
    const auto binding = xml.element("KEYBINDING", "NAME", key);
    if (value.kind == KeyValue::Kind::Reference) {
      const auto reference = xml.element("VALUE.REFERENCE");
      const auto path = xml.element("LOCALINSTANCEPATH");
      writeNameSpace(xml, value.reference->nameSpace);
      writeName(xml, *value.reference);
      continue;
    }
    const bool isNumeric = value.kind == KeyValue::Kind::Numeric;
    const auto keyValue = xml.element("KEYVALUE", "VALUETYPE",
                                      isNumeric                               ? "numeric"
                                      : value.kind == KeyValue::Kind::Boolean ? "boolean"
                                                                              : "string");
    if (!value.type.empty()) {
      xml.attribute("TYPE", value.type);
    }
    xml.text(value.text);
  }
}

void writeInstance(XmlWriter& xml, const ObjectName& path, const TextValues& values) {
  const auto named = xml.element("VALUE.NAMEDINSTANCE");
  writeName(xml, path);
  const auto instance = xml.element("INSTANCE", "CLASSNAME", path.className);
  for (const auto& [name, value] : values) {
    const auto property = xml.element("PROPERTY", "NAME", name);
    xml.attribute("TYPE", "string");
    xml.textElement("VALUE", value);
  }
}

Call callOf(const std::string& method, const std::string& nameSpace,
            const std::function<void(XmlWriter&)>& writeParameters) {
  XmlWriter xml;
  {
    const auto cim = xml.element("CIM", "CIMVERSION", "2.0");
    xml.attribute("DTDVERSION", "2.0");
    const auto message = xml.element("MESSAGE", "ID", "1");
    xml.attribute("PROTOCOLVERSION", "1.0");
    const auto request = xml.element("SIMPLEREQ");
    const auto call = xml.element("IMETHODCALL", "NAME", method);
    writeNameSpace(xml, nameSpace);
    writeParameters(xml);
  }
  return {method, xml.take()};
}

void writeClass(XmlWriter& xml, const char* parameter, const std::string& className) {
  const auto value = xml.element("IPARAMVALUE", "NAME", parameter);
  const auto name = xml.element("CLASSNAME", "NAME", className);
}

Call callOfClass(const std::string& method, const std::string& nameSpace, const std::string& className) {
  return callOf(method, nameSpace, [&](XmlWriter& xml) { writeClass(xml, "ClassName", className); });
}

[[noreturn]] void fail(const Element& error) {
  const std::string code = error.requiredAttribute("CODE");
  std::string text = error.attribute("DESCRIPTION").value_or("");
  for (std::size_t status = 1; status < std::size(statusNames); ++status) {
    if (code == std::to_string(status)) {
      text = statusNames[status] + (text.empty() ? "" : ": " + text);
    }
  }
  text = "CIM status " + code + (text.empty() ? "" : ", " + text);
  if (code == "2") {
    throw Failure(FailureKind::Login, "this login may not do that (" + text + ")");
  }
  if (code == "3") {
    throw Failure(FailureKind::NotServed, "the server has no such namespace (" + text +
                                              "): name the one that the provider is registered in after the port, " +
                                              "https://host:5989/root/cimv2");
  }
  if (code == "5") {
    throw Failure(FailureKind::NotServed,
                  "the server has no such class (" + text +
                      "): the provider is not registered there; see compositeipconfig-register");
  }
  throw Failure(FailureKind::Error, "the server answers " + text);
}

// Hands every element that the reply returns to the visitor.
void readReply(std::string_view message, const std::function<void(const Element&)>& visit) {
  try {
    const Document document(message);
    const Element root = document.root();
    if (!root.is("CIM")) {
      root.refuse("must be CIM");
    }
    const Element response = root.only("MESSAGE").only("SIMPLERSP").only("IMETHODRESPONSE");
    for (auto child = response.first(); child; child = child->next()) {
      if (child->is("ERROR")) {
        fail(*child);
      }
      if (!child->is("IRETURNVALUE")) {
        child->refuse("is not allowed in IMETHODRESPONSE");
      }
      for (auto value = child->first(); value; value = value->next()) {
        visit(*value);
      }
    }
  } catch (const TransportError& error) {
    throw Failure(FailureKind::Malformed, std::string("the reply is not what CIM-XML knows: ") + error.what());
  }
}

}  // namespace

Call enumerateInstances(const std::string& nameSpace, const std::string& className) {
  return callOfClass("EnumerateInstances", nameSpace, className);
}

Call enumerateInstanceNames(const std::string& nameSpace, const std::string& className) {
  return callOfClass("EnumerateInstanceNames", nameSpace, className);
}

Call associatorNames(const std::string& nameSpace, const ObjectName& source, const std::string& association) {
  return callOf("AssociatorNames", nameSpace, [&](XmlWriter& xml) {
    {
      const auto parameter = xml.element("IPARAMVALUE", "NAME", "ObjectName");
      writeName(xml, source);
    }
    writeClass(xml, "AssocClass", association);
  });
}

Call modifyInstance(const std::string& nameSpace, const ObjectName& path, const TextValues& values) {
  return callOf("ModifyInstance", nameSpace, [&](XmlWriter& xml) {
    {
      const auto parameter = xml.element("IPARAMVALUE", "NAME", "ModifiedInstance");
      writeInstance(xml, path, values);
    }
    const auto parameter = xml.element("IPARAMVALUE", "NAME", "PropertyList");
    const auto list = xml.element("VALUE.ARRAY");
    for (const auto& [name, value] : values) {
      xml.textElement("VALUE", name);
    }
  });
}

std::vector<Instance> readInstances(std::string_view message) {
  std::vector<Instance> instances;
  readReply(message, [&](const Element& value) {
    if (!value.is("VALUE.NAMEDINSTANCE")) {
      value.refuse("must be VALUE.NAMEDINSTANCE");
    }
    instances.push_back(readInstanceElement(value));
  });
  return instances;
}

std::vector<ObjectName> readNames(std::string_view message) {
  std::vector<ObjectName> names;
  readReply(message, [&](const Element& value) {
    names.push_back(readNameElement(value.is("OBJECTPATH") ? value.only() : value));
  });
  return names;
}

void readNothing(std::string_view message) {
  readReply(message, [](const Element& value) { value.refuse("is not expected in this reply"); });
}

std::string textOf(const Instance& instance, std::string_view property) {
  for (const auto& [name, type, isArray, value] : instance.properties) {
    if (!sameName(name, property)) {
      continue;
    }
    if (const auto* text = std::get_if<std::string>(&value)) {
      return *text;
    }
    std::string joined;
    if (const auto* texts = std::get_if<Cimom::CimXml::Texts>(&value)) {
      for (const auto& element : *texts) {
        joined += (joined.empty() ? "" : ",") + element.value_or("");
      }
    }
    return joined;
  }
  return {};
}

std::string keyOf(const ObjectName& name, std::string_view key) {
  for (const auto& [bound, value] : name.keys) {
    if (sameName(bound, key)) {
      return value.text;
    }
  }
  return {};
}

std::string identityOf(const ObjectName& name) {
  std::vector<std::string> keys;
  for (const auto& [key, value] : name.keys) {
    std::string lower = key;
    std::ranges::transform(lower, lower.begin(), Ground::lowerCase);
    keys.push_back(lower + "=" + (value.reference ? identityOf(*value.reference) : value.text));
  }
  std::ranges::sort(keys);
  std::string identity = name.className;
  for (const std::string& key : keys) {
    identity += "," + key;
  }
  return identity;
}

}  // namespace Bmcip
