// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <microhttpd.h>

#include <cstddef>
#include <functional>
#include <optional>
#include <string>

#include "cimom/http/Exchange.h"
#include "cimom/http/LoginDelay.h"
#include "cimom/http/Message.h"
#include "cimom/http/Timers.h"
#include "cimom/http/Workers.h"

namespace Cimom::Http {

// Finds out who asks (HTTP Basic, RFC 7617), and slows guesses down. Passwords are checked in threads of its own: that
// costs milliseconds on purpose.
class Authentication {
 public:
  // The log gets a line for each login that failed. `waiting` logins at most wait for their turn.
  Authentication(Authenticator authenticator, std::function<void(const std::string& line)> log, std::size_t waiting,
                 Timers& timers, Suspensions& suspensions);

  // Whether anybody has to log in.
  bool isRequired() const { return static_cast<bool>(authenticator_); }

  // Takes the credentials of a request from the connection, for an exchange whose client's addresses count as `group`.
  // Returns what is answered at once: to a client that gives none, and where too many logins failed.
  std::optional<Response> begin(MHD_Connection* connection, Exchange& exchange, const std::string& group);

  // Checks them, when the time has come, and then lets the suspended exchange go on: with a refusal, or without an
  // answer.
  void check(const ExchangePointer& exchange);

 private:
  void start(const ExchangePointer& exchange);
  void decide(const ExchangePointer& exchange);

  const Authenticator authenticator_;
  const std::function<void(const std::string& line)> log_;
  Timers& timers_;
  Suspensions& suspensions_;
  LoginDelay delay_;
  Workers workers_;
};

}  // namespace Cimom::Http
