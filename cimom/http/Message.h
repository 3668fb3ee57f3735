// SPDX-License-Identifier: Apache-2.0
// The HTTP request and response as the handler of a server sees them.
#pragma once

#include <strings.h>

#include <chrono>
#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Cimom::Http {

// Header fields in their order; names are compared without regard to case (RFC 9110, 5.1).
class Headers {
 public:
  void add(std::string name, std::string value) { fields_.emplace_back(std::move(name), std::move(value)); }

  // The value of the first field of that name, or null.
  const std::string* find(std::string_view name) const {
    for (const auto& [field, value] : fields_) {
      if (field.size() == name.size() && strncasecmp(field.data(), name.data(), name.size()) == 0) {
        return &value;
      }
    }
    return nullptr;
  }

  auto begin() const { return fields_.begin(); }
  auto end() const { return fields_.end(); }

 private:
  std::vector<std::pair<std::string, std::string>> fields_;
};

struct Request {
  std::string method;
  std::string path;  // as sent, without the query
  Headers headers;
  std::string body;  // complete, decoded from any transfer coding
  std::string user;  // who has authenticated; empty if the server asks nobody

  // When the server answers in the handler's place: whatever the handler waits for need not be waited for longer.
  std::chrono::steady_clock::time_point deadline = std::chrono::steady_clock::time_point::max();

  std::string client = {};  // the address that it came from
};

struct Response {
  unsigned status = 200;
  Headers headers;
  std::string body;
  std::string subject = {};            // for the request log: what was asked, and how it ended
  std::vector<std::string> more = {};  // what follows the body, if it is so large that it comes in pieces

  // Of the body, with what follows it.
  std::size_t size() const {
    std::size_t bytes = body.size();
    for (const std::string& piece : more) {
      bytes += piece.size();
    }
    return bytes;
  }
};

// Answers one request; called from several threads at once. An exception becomes a 500.
using Handler = std::function<Response(const Request&)>;

// Answers in the place of a handler that has not, and perhaps still is at work on the same request: why.
using FailureHandler = std::function<Response(const Request&, const std::string& why)>;

// Whether the password is that user's; called from several threads at once.
using Authenticator = std::function<bool(const std::string& user, const std::string& password)>;

}  // namespace Cimom::Http
