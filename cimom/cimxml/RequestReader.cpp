#include "cimom/cimxml/RequestReader.h"

#include "cimom/cimxml/Document.h"
#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/ObjectReader.h"

namespace Cimom::CimXml {
namespace {

// Minor versions add; a major version that this server does not know may mean anything.
void requireMajorVersion(const Element& element, std::string_view attribute, char major, const char* cimError) {
  const std::string version = element.requiredAttribute(attribute);
  if (version.size() > 1 && version[0] == major && version[1] == '.') return;
  throw TransportError(501, cimError,
                       std::string(attribute) + " is \"" + version + "\", this server speaks " + major + ".x");
}

// IPARAMVALUE and PARAMVALUE: nothing or one value.
Parameter readParameter(const Element& element) {
  Parameter parameter;
  parameter.name = element.requiredAttribute("NAME");
  parameter.type = element.attribute("PARAMTYPE").value_or("");
  if (!element.first()) return parameter;
  const Element value = element.only();
  if (value.is("VALUE")) {
    parameter.value = value.text();
  } else if (value.is("VALUE.ARRAY")) {
    parameter.value = readArray(value);
  } else if (value.is("VALUE.REFERENCE")) {
    parameter.value = readObjectName(value.only());
  } else if (isObjectName(value)) {
    parameter.value = readObjectName(value);
  } else if (isInstance(value)) {
    parameter.value = readInstance(value);
  } else {
    value.refuse("is no value of the parameter \"" + parameter.name + "\"");
  }
  return parameter;
}

// The parameters follow what says where the call goes.
void readParameters(std::optional<Element> element, std::string_view elementName, Request& request) {
  for (; element; element = element->next()) {
    if (!element->is(elementName)) element->refuse("is no " + std::string(elementName));
    request.parameters.push_back(readParameter(*element));
  }
}

void readIntrinsicCall(const Element& call, Request& request) {
  const auto nameSpace = call.first();
  if (!nameSpace || !nameSpace->is("LOCALNAMESPACEPATH")) call.refuse("does not begin with LOCALNAMESPACEPATH");
  request.nameSpace = readLocalNameSpacePath(*nameSpace);
  readParameters(nameSpace->next(), "IPARAMVALUE", request);
}

void readExtrinsicCall(const Element& call, Request& request) {
  const auto target = call.first();
  if (!target || !(target->is("LOCALCLASSPATH") || target->is("LOCALINSTANCEPATH")))
    call.refuse("does not begin with LOCALCLASSPATH or LOCALINSTANCEPATH");
  request.isIntrinsic = false;
  request.target = readObjectName(*target);
  request.nameSpace = request.target.nameSpace;
  readParameters(target->next(), "PARAMVALUE", request);
}

}  // namespace

Request readRequest(std::string_view xml) {
  const Document document(xml);
  const Element root = document.root();
  if (!root.is("CIM")) root.refuse("is the root where CIM belongs");
  requireMajorVersion(root, "CIMVERSION", '2', "unsupported-cim-version");
  requireMajorVersion(root, "DTDVERSION", '2', "unsupported-dtd-version");
  const Element message = root.only("MESSAGE");
  Request request;
  request.messageId = message.requiredAttribute("ID");
  request.protocolVersion = message.requiredAttribute("PROTOCOLVERSION");
  requireMajorVersion(message, "PROTOCOLVERSION", '1', "unsupported-protocol-version");
  if (message.only().is("MULTIREQ"))
    throw TransportError(501, "multiple-requests-unsupported", "this server takes one request in a message");
  const Element call = message.only("SIMPLEREQ").only();
  request.method = call.requiredAttribute("NAME");
  if (call.is("IMETHODCALL")) {
    readIntrinsicCall(call, request);
  } else if (call.is("METHODCALL")) {
    readExtrinsicCall(call, request);
  } else {
    call.refuse("is no call of a method");
  }
  return request;
}

}  // namespace Cimom::CimXml
