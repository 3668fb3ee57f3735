// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "cimom/cimxml/OpenEnumerations.h"
#include "cimom/cimxml/Request.h"
#include "cimom/http/Message.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom::CimXml {

// CIM operations over HTTP (DSP0200 1.4): takes POST and M-POST on /cimom and /. Anything else is answered
// with an HTTP status, the CIMError header that DSP0200 has for it and a line of plain text that says what is wrong.
class Endpoint {
 public:
  // `host` stands in paths that name no host.
  Endpoint(const CMPIBroker* broker, const ClassRepository& classes, std::string host);

  // May be called from several threads at once.
  Http::Response handle(const Http::Request& request) const;

  // What a client hears in the place of an answer that is not to be had: CIM status 1 with the reason.
  Http::Response fail(const Http::Request& request, const std::string& why) const;

 private:
  // The body of a response, in pieces, and its CIM status.
  struct Answer {
    std::vector<std::string> body;
    int status;
  };
  using Answering = std::function<Answer(const Request& request)>;

  static Http::Response handle(const Http::Request& request, const Answering& answer);
  static Answer errorAnswer(const Request& request, int code, const char* description);
  Answer respond(const Request& request, const Http::Request& message) const;

  const CMPIBroker* broker_;
  const ClassRepository& classes_;
  std::string host_;
  std::unique_ptr<OpenEnumerations> openEnumerations_ = std::make_unique<OpenEnumerations>();
};

}  // namespace Cimom::CimXml
