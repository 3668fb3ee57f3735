// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/OperationHeaders.h"

#include <charconv>
#include <string_view>

#include "cimom/cimxml/Errors.h"
#include "cimom/model/Names.h"

namespace Cimom::CimXml {
namespace {

constexpr std::string_view extension = "http://www.dmtf.org/cim/mapping/http/v1.0";
constexpr unsigned notExtended = 510;

// Man: http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=73
std::string prefixOf(const Http::Request& request) {
  if (request.method != "M-POST") {
    return {};
  }
  const std::string* declaration = request.headers.find("Man");
  if (!declaration || declaration->find(extension) == std::string::npos) {
    throw TransportError(notExtended, "",
                         "the Man header of an M-POST must name the extension " + std::string(extension));
  }
  const auto marker = declaration->find("ns=");
  const auto digits = marker == std::string::npos ? std::string() : declaration->substr(marker + 3, 2);
  if (digits.size() != 2 || digits.find_first_not_of("0123456789") != std::string::npos) {
    throw TransportError(notExtended, "", "the Man header must contain ns= and two digits");
  }
  return digits + "-";
}

// %XX as its byte; anything else stays.
std::string unescape(std::string_view text) {
  std::string result;
  for (std::size_t i = 0; i < text.size(); ++i) {
    unsigned char byte = 0;
    const char* digits = text.data() + i + 1;
    const bool isEscape =
        text[i] == '%' && text.size() - i > 2 && std::from_chars(digits, digits + 2, byte, 16).ptr == digits + 2;
    result += isEscape ? static_cast<char>(byte) : text[i];
    if (isEscape) {
      i += 2;
    }
  }
  return result;
}

// Of "root/cimv2:Class.Key=…", as the header of a class's method has it, the namespace.
std::string nameSpaceOf(const std::string& object, bool isIntrinsic) {
  const std::string plain = unescape(object);
  return std::string(bareNamespace(isIntrinsic ? plain : plain.substr(0, plain.find(':'))));
}

}  // namespace

OperationHeaders::OperationHeaders(const Http::Request& request)
    : headers_(request.headers), prefix_(prefixOf(request)) {
  const std::string* operation = find("CIMOperation");
  if (!operation || !sameName(*operation, "MethodCall")) {
    throw TransportError(
        400, "unsupported-operation",
        operation ? "the CIMOperation header must be MethodCall" : "the CIMOperation header is missing");
  }
  const std::string* version = find("CIMProtocolVersion");
  if (version && !version->starts_with("1.")) {
    throw TransportError(501, "unsupported-protocol-version", "CIMProtocolVersion must be 1.x, not " + *version);
  }
  if (find("CIMBatch")) {
    throw TransportError(501, "multiple-requests-unsupported", "only one request per message is supported");
  }
}

const std::string* OperationHeaders::find(const std::string& name) const { return headers_.find(prefix_ + name); }

void OperationHeaders::requireMatch(const Request& message) const {
  const auto refuse = [](const std::string& what) { throw TransportError(400, "header-mismatch", what); };
  const std::string* method = find("CIMMethod");
  if (!method) {
    return refuse("the CIMMethod header is missing");
  }
  if (!sameName(unescape(*method), message.method)) {
    refuse("the CIMMethod header is " + *method + ", but the message calls " + message.method);
  }
  const std::string* object = find("CIMObject");
  if (!object) {
    return refuse("the CIMObject header is missing");
  }
  if (!sameName(nameSpaceOf(*object, message.isIntrinsic), message.nameSpace)) {
    refuse("the CIMObject header names " + *object + ", but the message names " + message.nameSpace);
  }
}

void OperationHeaders::addTo(Http::Headers& reply) const {
  if (!prefix_.empty()) {
    reply.add("Ext", "");
    reply.add("Cache-Control", "no-cache");
    reply.add("Man", std::string(extension) + " ; ns=" + prefix_.substr(0, 2));
  }
  reply.add(prefix_ + "CIMOperation", "MethodResponse");
}

}  // namespace Cimom::CimXml
