// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/RequestHead.h"

#include <algorithm>
#include <vector>

namespace Cimom::Http {
namespace {

constexpr unsigned badRequest = 400;
constexpr unsigned misdirectedRequest = 421;
constexpr unsigned notImplemented = 501;

std::vector<std::string> all(const Headers& headers, std::string_view name) {
  std::vector<std::string> values;
  for (const auto& [field, value] : headers) {
    if (Ground::sameName(field, name)) {
      values.push_back(value);
    }
  }
  return values;
}

// RFC 9110, 5.6.2
bool isToken(std::string_view name) {
  static constexpr std::string_view marks = "!#$%&'*+-.^_`|~";
  return !name.empty() && std::ranges::all_of(name, [](char c) {
    return (c >= '0' && c <= '9') || (Ground::lowerCase(c) >= 'a' && Ground::lowerCase(c) <= 'z') ||
           marks.find(c) != std::string_view::npos;
  });
}

std::optional<Refusal> findFramingFault(bool isHttp11, const Headers& headers) {
  if (!std::all_of(headers.begin(), headers.end(), [](const auto& field) { return isToken(field.first); })) {
    return Refusal{badRequest, "a header field has a malformed name"};
  }
  const auto codings = all(headers, "Transfer-Encoding");
  const auto lengths = all(headers, "Content-Length");
  if (lengths.size() > 1) {
    return Refusal{badRequest, "the request has more than one Content-Length"};
  }
  if (codings.empty()) {
    return std::nullopt;
  }
  if (!lengths.empty()) {
    return Refusal{badRequest, "the request has both Content-Length and Transfer-Encoding"};
  }
  if (!isHttp11) {
    return Refusal{badRequest, "Transfer-Encoding needs HTTP/1.1"};
  }
  if (codings.size() > 1 || !Ground::sameName(codings.front(), "chunked")) {
    return Refusal{notImplemented, "the only transfer coding that is understood is chunked"};
  }
  return std::nullopt;
}

}  // namespace

std::optional<Refusal> findFault(std::string_view version, const Headers& headers, const HostNames& names,
                                 const Address& arrivedAt) {
  const bool isHttp11 = version != "HTTP/1.0";
  if (auto fault = findFramingFault(isHttp11, headers)) {
    return fault;
  }
  const auto hosts = all(headers, "Host");
  if (hosts.empty() && !isHttp11) {
    return std::nullopt;
  }
  if (hosts.size() != 1) {
    return Refusal{badRequest, hosts.empty() ? "the request has no Host" : "the request has more than one Host"};
  }
  if (!names.accepts(hosts.front(), arrivedAt)) {
    return Refusal{misdirectedRequest,
                   "this server is not the Host of the request: its configuration can name more (server-name)"};
  }
  return std::nullopt;
}

}  // namespace Cimom::Http
