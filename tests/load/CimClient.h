// SPDX-License-Identifier: Apache-2.0
// A client under load: it keeps its connection, and knows an answer that says what is wrong from one that says nothing.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>

#include "tests/support/client/HttpClient.h"

namespace Testing {

struct Answer {
  // An error is told where the server says what is wrong: a status of CIM with a description, or of HTTP with a text.
  enum class Kind { Fine, ErrorTold, Untold };

  Kind kind = Kind::Untold;
  std::string status;  // the code of CIM, or "HTTP 503"; empty where all is fine
  std::string body;    // or what has gone wrong where there is none
};

class CimClient {
 public:
  explicit CimClient(std::uint16_t port) : port_(port) {}

  // An intrinsic method in a namespace root/<name>, with the content of its IMETHODCALL.
  Answer ask(const std::string& method, const std::string& parameters, const std::string& nameSpace = "cimv2");

  // Any body, as the message that calls the method.
  Answer send(const std::string& method, const std::string& object, const std::string& body);

  // Any bytes on a connection of their own, to the end of what the server says: a close without a word is an answer.
  Answer sendRaw(const std::string& bytes) const;

 private:
  const std::uint16_t port_;
  std::optional<HttpClient> connection_;
};

// What came of requests, by status; those that were not told in full.
class Tally {
 public:
  void add(const std::string& what, const Answer& answer);
  void add(const Tally& other);

  std::size_t requests() const { return requests_; }
  std::size_t errorsTold() const { return errorsTold_; }
  const std::map<std::string, std::size_t>& untold() const { return untold_; }
  std::string summary() const;

 private:
  std::size_t requests_ = 0;
  std::size_t errorsTold_ = 0;
  std::map<std::string, std::size_t> byStatus_;
  std::map<std::string, std::size_t> untold_;  // each kind of request, with the first that was said of it
};

}  // namespace Testing
