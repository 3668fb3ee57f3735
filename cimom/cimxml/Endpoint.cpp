// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Endpoint.h"

#include <algorithm>
#include <array>

#include "cimom/cimxml/Errors.h"
#include "cimom/cimxml/OperationHeaders.h"
#include "cimom/cimxml/Operations.h"
#include "cimom/cimxml/Request.h"
#include "cimom/cimxml/XmlWriter.h"

namespace Cimom::CimXml {
namespace {

// What RFC 9110 calls the methods that a server may know and not allow; any other method is not implemented.
constexpr std::array<std::string_view, 6> otherMethods = {"GET", "HEAD", "PUT", "DELETE", "OPTIONS", "TRACE"};

// What an answer quotes of a request may be as long as the request.
constexpr std::size_t longestDescription = 4096;

std::string shortened(std::string_view text) {
  return text.size() <= longestDescription ? std::string(text)
                                           : std::string(text.substr(0, longestDescription)) + " ...";
}

Http::Response plain(unsigned status, std::string_view text) {
  Http::Response response{status, {}, shortened(text) + "\n"};
  response.headers.add("Content-Type", "text/plain; charset=\"utf-8\"");
  return response;
}

Http::Response refusedMethod(const std::string& method) {
  const bool isKnown = std::find(otherMethods.begin(), otherMethods.end(), method) != otherMethods.end();
  Http::Response response =
      plain(isKnown ? 405 : 501, "CIM operations must be sent with POST or M-POST, not " + method);
  response.headers.add("Allow", "POST, M-POST");
  return response;
}

// CIM/MESSAGE/SIMPLERSP and the response in it, whose content the function writes.
template <typename Content>
std::vector<std::string> responseMessage(const Request& request, Content content) {
  XmlWriter xml;
  {
    const auto root = xml.element("CIM", "CIMVERSION", "2.0");
    xml.attribute("DTDVERSION", "2.0");
    const auto message = xml.element("MESSAGE", "ID", request.messageId);
    xml.attribute("PROTOCOLVERSION", "1.0");
    const auto simple = xml.element("SIMPLERSP");
    const auto response =
        xml.element(request.isIntrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE", "NAME", request.method);
    content(xml);
  }
  return xml.takePieces();
}

std::vector<std::string> errorMessage(const Request& request, int code, const char* description) {
  return responseMessage(request, [&](XmlWriter& xml) {
    const auto error = xml.element("ERROR", "CODE", std::to_string(code));
    xml.attribute("DESCRIPTION", shortened(description));
  });
}

// For a request log: "GetInstance root/cimv2:CIM_Thing".
std::string subjectOf(const Request& request) {
  std::string className = request.target.className;
  for (const Parameter& parameter : request.parameters) {
    if (const auto* name = std::get_if<ObjectName>(&parameter.value); name && className.empty()) {
      className = name->className;
    } else if (const auto* instance = std::get_if<Instance>(&parameter.value); instance && className.empty()) {
      className = instance->path.className;
    }
  }
  return request.method + " " + request.nameSpace + (className.empty() ? "" : ":" + className);
}

}  // namespace

Endpoint::Answer Endpoint::errorAnswer(const Request& request, int code, const char* description) {
  return {errorMessage(request, code, description), code};
}

Endpoint::Endpoint(const CMPIBroker* broker, const ClassRepository& classes, std::string host)
    : broker_(broker), classes_(classes), host_(std::move(host)) {}

Http::Response Endpoint::handle(const Http::Request& request) const {
  return handle(request, [&](const Request& message) { return respond(message, request); });
}

Http::Response Endpoint::fail(const Http::Request& request, const std::string& why) const {
  return handle(request, [&](const Request& message) { return errorAnswer(message, CMPI_RC_ERR_FAILED, why.c_str()); });
}

Http::Response Endpoint::handle(const Http::Request& request, const Answering& answer) {
  if (request.path != "/cimom" && request.path != "/") {
    return plain(404, "CIM operations must be sent to /cimom");
  }
  if (request.method != "POST" && request.method != "M-POST") {
    return refusedMethod(request.method);
  }
  try {
    const OperationHeaders headers(request);
    const Request message = readRequest(request.body);
    headers.requireMatch(message);
    Http::Response response;
    Answer answered = answer(message);
    response.body = std::move(answered.body.front());
    answered.body.erase(answered.body.begin());
    response.more = std::move(answered.body);
    response.subject = subjectOf(message) + " " + std::to_string(answered.status);
    response.headers.add("Content-Type", "application/xml; charset=\"utf-8\"");
    headers.addTo(response.headers);
    return response;
  } catch (const TransportError& error) {
    Http::Response response = plain(error.httpStatus(), error.what());
    if (!error.cimError().empty()) {
      response.headers.add("CIMError", error.cimError());
    }
    return response;
  }
}

Endpoint::Answer Endpoint::respond(const Request& request, const Http::Request& message) const {
  try {
    const auto content = [&](XmlWriter& xml) {
      perform({broker_, classes_, host_, *openEnumerations_, message.user, message.deadline}, request, xml);
    };
    return {responseMessage(request, content), CMPI_RC_OK};
  } catch (const OperationError& error) {
    return errorAnswer(request, error.code(), error.what());
  }
}

}  // namespace Cimom::CimXml
