// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Request.h"

#include <algorithm>
#include <array>

#include "cimom/cimxml/Document.h"
#include "cimom/cimxml/Errors.h"

namespace Cimom::CimXml {
namespace {

// Keys are told apart by comparing each with those before it.
constexpr std::size_t maxKeys = 256;

ObjectName readObjectName(const Element& element);

// NAMESPACE elements in a LOCALNAMESPACEPATH, as "root/cimv2".
std::string readLocalNameSpacePath(const Element& element) {
  std::string path;
  for (auto child = element.first(); child; child = child->next()) {
    if (!child->is("NAMESPACE")) {
      child->refuse("must be NAMESPACE");
    }
    if (!path.empty()) {
      path += '/';
    }
    path += child->requiredAttribute("NAME");
  }
  if (path.empty()) {
    element.refuse("must name a namespace");
  }
  return path;
}

KeyValue readKeyValue(const Element& element) {
  KeyValue value;
  if (element.is("VALUE.REFERENCE")) {
    value.kind = KeyValue::Kind::Reference;
    value.reference = std::make_shared<ObjectName>(readObjectName(element.only()));
    return value;
  }
  if (!element.is("KEYVALUE")) {
    element.refuse("is not a key value");
  }
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
      child->refuse("must not stand beside other keys");
    }
    if (name.keys.size() > maxKeys) {
      element.refuse("has more than " + std::to_string(maxKeys) + " keys");
    }
  }
  return name;
}

ObjectName readName(const Element& element) {
  if (element.is("INSTANCENAME")) {
    return readInstanceName(element);
  }
  if (!element.is("CLASSNAME")) {
    element.refuse("is not a class or instance name");
  }
  ObjectName name;
  name.className = element.requiredAttribute("NAME");
  return name;
}

// LOCAL…PATH and …PATH: where the object lives, then its name.
ObjectName readPath(const Element& element) {
  const auto place = element.first();
  const auto local = place ? place->next() : std::nullopt;
  if (!local || local->next()) {
    element.refuse("must contain a namespace path and a name");
  }
  ObjectName name = readName(*local);
  if (place->is("LOCALNAMESPACEPATH")) {
    name.nameSpace = readLocalNameSpacePath(*place);
    return name;
  }
  const auto host = place->is("NAMESPACEPATH") ? place->first() : std::nullopt;
  const auto nameSpace = host && host->is("HOST") ? host->next() : std::nullopt;
  if (!nameSpace || !nameSpace->is("LOCALNAMESPACEPATH")) {
    place->refuse("is not a namespace path");
  }
  name.host = host->text();
  name.nameSpace = readLocalNameSpacePath(*nameSpace);
  return name;
}

// CLASSNAME, INSTANCENAME, LOCALCLASSPATH, LOCALINSTANCEPATH, CLASSPATH, INSTANCEPATH.
bool isObjectName(const Element& element) {
  static constexpr std::array<std::string_view, 6> names = {"CLASSNAME",         "INSTANCENAME", "LOCALCLASSPATH",
                                                            "LOCALINSTANCEPATH", "CLASSPATH",    "INSTANCEPATH"};
  return std::find(names.begin(), names.end(), element.name()) != names.end();
}

ObjectName readObjectName(const Element& element) {
  if (!isObjectName(element)) {
    element.refuse("is not a class or instance name");
  }
  return element.is("CLASSNAME") || element.is("INSTANCENAME") ? readName(element) : readPath(element);
}

// VALUE.ARRAY.
Texts readArray(const Element& element) {
  Texts texts;
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("VALUE")) {
      texts.emplace_back(child->text());
    } else if (child->is("VALUE.NULL")) {
      texts.emplace_back(std::nullopt);
    } else {
      child->refuse("is not an array element");
    }
  }
  return texts;
}

// VALUE.REFARRAY.
ObjectNames readReferences(const Element& element) {
  ObjectNames names;
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("VALUE.REFERENCE")) {
      names.emplace_back(readObjectName(child->only()));
    } else if (child->is("VALUE.NULL")) {
      names.emplace_back(std::nullopt);
    } else {
      child->refuse("is not a reference");
    }
  }
  return names;
}

Property readProperty(const Element& element) {
  Property property;
  property.name = element.requiredAttribute("NAME");
  property.isArray = element.is("PROPERTY.ARRAY");
  const bool isReference = element.is("PROPERTY.REFERENCE");
  property.type = isReference ? "reference" : element.attribute("TYPE").value_or("");
  const std::string_view valueName = isReference ? "VALUE.REFERENCE" : property.isArray ? "VALUE.ARRAY" : "VALUE";
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("QUALIFIER")) {
      continue;
    }
    if (!child->is(valueName) || property.value.index() != 0) {
      child->refuse("is not allowed in " + std::string(element.name()));
    }
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
  instance.className = element.requiredAttribute("CLASSNAME");
  instance.path.className = instance.className;
  for (auto child = element.first(); child; child = child->next()) {
    if (child->is("QUALIFIER")) {
      continue;
    }
    if (!isProperty(*child)) {
      child->refuse("is not a property");
    }
    instance.properties.push_back(readProperty(*child));
  }
  return instance;
}

// INSTANCE, VALUE.NAMEDINSTANCE.
bool isInstance(const Element& element) { return element.is("INSTANCE") || element.is("VALUE.NAMEDINSTANCE"); }

Instance readInstance(const Element& element) {
  if (element.is("INSTANCE")) {
    return readPlainInstance(element);
  }
  const auto name = element.first();
  const auto content = name ? name->next() : std::nullopt;
  if (!content || content->next() || !name->is("INSTANCENAME") || !content->is("INSTANCE")) {
    element.refuse("must contain an INSTANCENAME and an INSTANCE");
  }
  Instance instance = readPlainInstance(*content);
  instance.path = readInstanceName(*name);
  return instance;
}

// CLASS and QUALIFIER.DECLARATION.
bool isDeclaration(const Element& element) { return element.is("CLASS") || element.is("QUALIFIER.DECLARATION"); }

Declaration readDeclaration(const Element& element) {
  Declaration declaration{element.requiredAttribute("NAME")};
  const bool isClass = element.is("CLASS");
  for (auto child = element.first(); child; child = child->next()) {
    if (isClass && isProperty(*child)) {
      readProperty(*child);
    } else if (isClass ? !child->is("QUALIFIER") && !child->is("METHOD")
                       : !child->is("SCOPE") && !child->is("VALUE") && !child->is("VALUE.ARRAY")) {
      child->refuse("is not allowed in " + std::string(element.name()));
    }
  }
  return declaration;
}

// Minor versions add; a major version that this server does not know may mean anything.
void requireMajorVersion(const Element& element, std::string_view attribute, char major, const char* cimError) {
  const std::string version = element.requiredAttribute(attribute);
  if (version.size() > 1 && version[0] == major && version[1] == '.') {
    return;
  }
  throw TransportError(501, cimError, std::string(attribute) + " must be " + major + ".x, not \"" + version + "\"");
}

// IPARAMVALUE and PARAMVALUE: nothing or one value.
Parameter readParameter(const Element& element) {
  Parameter parameter;
  parameter.name = element.requiredAttribute("NAME");
  parameter.type = element.attribute("PARAMTYPE").value_or("");
  if (!element.first()) {
    return parameter;
  }
  const Element value = element.only();
  if (value.is("VALUE")) {
    parameter.value = value.text();
  } else if (value.is("VALUE.ARRAY")) {
    parameter.value = readArray(value);
  } else if (value.is("VALUE.REFERENCE")) {
    parameter.value = readObjectName(value.only());
  } else if (value.is("VALUE.REFARRAY")) {
    parameter.value = readReferences(value);
  } else if (isDeclaration(value)) {
    parameter.value = readDeclaration(value);
  } else if (isObjectName(value)) {
    parameter.value = readObjectName(value);
  } else if (isInstance(value)) {
    parameter.value = readInstance(value);
  } else {
    value.refuse("is not a value for the parameter \"" + parameter.name + "\"");
  }
  return parameter;
}

// The parameters follow what says where the call goes.
void readParameters(std::optional<Element> element, std::string_view elementName, Request& request) {
  for (; element; element = element->next()) {
    if (!element->is(elementName)) {
      element->refuse("must be " + std::string(elementName));
    }
    request.parameters.push_back(readParameter(*element));
  }
}

void readIntrinsicCall(const Element& call, Request& request) {
  const auto nameSpace = call.first();
  if (!nameSpace || !nameSpace->is("LOCALNAMESPACEPATH")) {
    call.refuse("must begin with LOCALNAMESPACEPATH");
  }
  request.nameSpace = readLocalNameSpacePath(*nameSpace);
  readParameters(nameSpace->next(), "IPARAMVALUE", request);
}

void readExtrinsicCall(const Element& call, Request& request) {
  const auto target = call.first();
  if (!target || !(target->is("LOCALCLASSPATH") || target->is("LOCALINSTANCEPATH"))) {
    call.refuse("must begin with LOCALCLASSPATH or LOCALINSTANCEPATH");
  }
  request.isIntrinsic = false;
  request.target = readObjectName(*target);
  request.nameSpace = request.target.nameSpace;
  readParameters(target->next(), "PARAMVALUE", request);
}

}  // namespace

Instance readEmbeddedInstance(std::string_view xml) {
  const Document document(xml);
  const Element root = document.root();
  if (!root.is("INSTANCE")) {
    root.refuse("is not an instance");
  }
  return readPlainInstance(root);
}

ObjectName readNameElement(const Element& element) { return readObjectName(element); }

Instance readInstanceElement(const Element& element) { return readInstance(element); }

Request readRequest(std::string_view xml) {
  const Document document(xml);
  const Element root = document.root();
  if (!root.is("CIM")) {
    root.refuse("must be CIM");
  }
  requireMajorVersion(root, "CIMVERSION", '2', "unsupported-cim-version");
  requireMajorVersion(root, "DTDVERSION", '2', "unsupported-dtd-version");
  const Element message = root.only("MESSAGE");
  Request request;
  request.messageId = message.requiredAttribute("ID");
  request.protocolVersion = message.requiredAttribute("PROTOCOLVERSION");
  requireMajorVersion(message, "PROTOCOLVERSION", '1', "unsupported-protocol-version");
  if (message.only().is("MULTIREQ")) {
    throw TransportError(501, "multiple-requests-unsupported", "only one request per message is supported");
  }
  const Element call = message.only("SIMPLEREQ").only();
  request.method = call.requiredAttribute("NAME");
  if (call.is("IMETHODCALL")) {
    readIntrinsicCall(call, request);
  } else if (call.is("METHODCALL")) {
    readExtrinsicCall(call, request);
  } else {
    call.refuse("is not a method call");
  }
  return request;
}

}  // namespace Cimom::CimXml
