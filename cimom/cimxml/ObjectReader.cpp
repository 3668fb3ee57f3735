#include "cimom/cimxml/ObjectReader.h"

#include <algorithm>
#include <array>

namespace Cimom::CimXml {
namespace {

KeyValue readKeyValue(const Element& element) {
  KeyValue value;
  if (element.is("VALUE.REFERENCE")) {
    value.kind = KeyValue::Kind::Reference;
    value.reference = std::make_shared<ObjectName>(readObjectName(element.only()));
    return value;
  }
  if (!element.is("KEYVALUE")) element.refuse("is no value of a key");
  const std::string valueType = element.attribute("VALUETYPE").value_or("string");
  if (valueType == "boolean") {
    value.kind = KeyValue::Kind::Boolean;
  } else if (valueType == "numeric") {
    value.kind = KeyValue::Kind::Numeric;
  } else if (valueType != "string") {
    element.refuse("has the unknown VALUETYPE \"" + valueType + "\"");
  }
  value.type = element.attribute("TYPE").value_or("");
  value.text = element.text();
  return value;
}

ObjectName readInstanceName(const Element& element) {
  ObjectName name;
  name.className = element.requiredAttribute("CLASSNAME");
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("KEYBINDING")) {
      name.keys.push_back({child->requiredAttribute("NAME"), readKeyValue(child->only())});
    } else if (name.keys.empty() && !child->next()) {
      name.keys.push_back({"", readKeyValue(*child)});
    } else {
      child->refuse("does not belong beside other keys");
    }
  }
  return name;
}

ObjectName readName(const Element& element) {
  if (element.is("INSTANCENAME")) return readInstanceName(element);
  if (!element.is("CLASSNAME")) element.refuse("is no name of a class or an instance");
  ObjectName name;
  name.className = element.requiredAttribute("NAME");
  return name;
}

// LOCAL…PATH and …PATH: where the object lives, then its name.
ObjectName readPath(const Element& element) {
  const auto place = element.first();
  const auto local = place ? place->next() : std::nullopt;
  if (!local || local->next()) element.refuse("is no path of two parts");
  ObjectName name = readName(*local);
  if (place->is("LOCALNAMESPACEPATH")) {
    name.nameSpace = readLocalNameSpacePath(*place);
    return name;
  }
  const auto host = place->is("NAMESPACEPATH") ? place->first() : std::nullopt;
  const auto nameSpace = host && host->is("HOST") ? host->next() : std::nullopt;
  if (!nameSpace || !nameSpace->is("LOCALNAMESPACEPATH")) place->refuse("is no path of a namespace");
  name.host = host->text();
  name.nameSpace = readLocalNameSpacePath(*nameSpace);
  return name;
}

Property readProperty(const Element& element) {
  Property property;
  property.name = element.requiredAttribute("NAME");
  property.isArray = element.is("PROPERTY.ARRAY");
  const bool isReference = element.is("PROPERTY.REFERENCE");
  property.type = isReference ? "reference" : element.attribute("TYPE").value_or("");
  const std::string_view valueName = isReference ? "VALUE.REFERENCE" : property.isArray ? "VALUE.ARRAY" : "VALUE";
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("QUALIFIER")) continue;
    if (!child->is(valueName) || property.value.index() != 0)
      child->refuse("does not belong in a " + std::string(element.name()));
    if (isReference) {
      property.value = readObjectName(child->only());
    } else if (property.isArray) {
      property.value = readArray(*child);
    } else {
      property.value = child->text();
    }
  }
  return property;
}

bool isProperty(const Element& element) {
  return element.is("PROPERTY") || element.is("PROPERTY.ARRAY") || element.is("PROPERTY.REFERENCE");
}

Instance readPlainInstance(const Element& element) {
  Instance instance;
  instance.path.className = element.requiredAttribute("CLASSNAME");
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("QUALIFIER")) continue;
    if (!isProperty(*child)) child->refuse("is no property");
    instance.properties.push_back(readProperty(*child));
  }
  return instance;
}

}  // namespace

std::string readLocalNameSpacePath(const Element& element) {
  std::string path;
  for (auto child = element.first(); child; child = child->next()) {
    if (!child->is("NAMESPACE")) child->refuse("is no NAMESPACE");
    if (!path.empty()) path += '/';
    path += child->requiredAttribute("NAME");
  }
  if (path.empty()) element.refuse("names no namespace");
  return path;
}

bool isObjectName(const Element& element) {
  static constexpr std::array<std::string_view, 6> names = {"CLASSNAME",         "INSTANCENAME", "LOCALCLASSPATH",
                                                            "LOCALINSTANCEPATH", "CLASSPATH",    "INSTANCEPATH"};
  return std::find(names.begin(), names.end(), element.name()) != names.end();
}

ObjectName readObjectName(const Element& element) {
  if (!isObjectName(element)) element.refuse("is no name of a class or an instance");
  return element.is("CLASSNAME") || element.is("INSTANCENAME") ? readName(element) : readPath(element);
}

Texts readArray(const Element& element) {
  Texts texts;
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("VALUE")) {
      texts.emplace_back(child->text());
    } else if (child->is("VALUE.NULL")) {
      texts.emplace_back(std::nullopt);
    } else {
      child->refuse("is no element of an array");
    }
  }
  return texts;
}

bool isInstance(const Element& element) { return element.is("INSTANCE") || element.is("VALUE.NAMEDINSTANCE"); }

Instance readInstance(const Element& element) {
  if (element.is("INSTANCE")) return readPlainInstance(element);
  const auto name = element.first();
  const auto content = name ? name->next() : std::nullopt;
  if (!content || content->next() || !name->is("INSTANCENAME") || !content->is("INSTANCE"))
    element.refuse("is not an INSTANCENAME and an INSTANCE");
  Instance instance = readPlainInstance(*content);
  instance.path = readInstanceName(*name);
  return instance;
}

}  // namespace Cimom::CimXml
