// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "cimom/cimxml/Request.h"
#include "cimom/http/Message.h"

namespace Cimom::CimXml {

// The CIM extension headers of a request (DSP0200, 6.3). With M-POST (RFC 2774) their names have a prefix of two
// digits, which the Man header declares; the reply's headers have the same.
class OperationHeaders {
 public:
  // Throws TransportError: unsupported-operation if this is not a method call, unsupported-protocol-version, and
  // 510 (Not Extended) if an M-POST demands another extension or none.
  explicit OperationHeaders(const Http::Request& request);

  // Throws TransportError header-mismatch if CIMMethod or CIMObject differ from what the message says.
  void requireMatch(const Request& message) const;

  // Adds what marks a reply as the response to a method call.
  void addTo(Http::Headers& reply) const;

 private:
  const std::string* find(const std::string& name) const;

  const Http::Headers& headers_;
  std::string prefix_;  // "73-", or nothing
};

}  // namespace Cimom::CimXml
