// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Authentication.h"

#include <chrono>
#include <exception>
#include <memory>
#include <utility>

#include "cimom/http/Guarded.h"
#include "cimom/http/Reply.h"
#include "ground/Printable.h"

namespace Cimom::Http {
namespace {

constexpr const char* basicChallenge = "Basic realm=\"cimom\"";

constexpr std::size_t checkers = 2;

Response challenge() {
  Response response{MHD_HTTP_UNAUTHORIZED, {}, "authentication is required\n"};
  response.headers.add("Content-Type", "text/plain; charset=\"utf-8\"");
  response.headers.add("WWW-Authenticate", basicChallenge);
  return response;
}

Response tooManyFailures() {
  Response response = refusal(MHD_HTTP_TOO_MANY_REQUESTS, "too many failed logins");
  response.headers.add("Retry-After", "10");
  return response;
}

struct Credentials {
  std::string user;
  std::string password;
};

void freeText(char* text) { MHD_free(text); }

std::optional<Credentials> credentialsOf(MHD_Connection* connection) {
  using Text = std::unique_ptr<char, decltype(&freeText)>;
  char* password = nullptr;
  const Text user(MHD_basic_auth_get_username_password(connection, &password), &freeText);
  const Text secret(password, &freeText);
  return user && secret ? std::optional(Credentials{user.get(), secret.get()}) : std::nullopt;
}

}  // namespace

Authentication::Authentication(Authenticator authenticator, std::function<void(const std::string& line)> log,
                               std::size_t waiting, Timers& timers, Suspensions& suspensions)
    : authenticator_(std::move(authenticator)),
      log_(std::move(log)),
      timers_(timers),
      suspensions_(suspensions),
      workers_(checkers, waiting) {}

std::optional<Response> Authentication::begin(MHD_Connection* connection, Exchange& exchange,
                                              const std::string& group) {
  auto credentials = credentialsOf(connection);
  if (!credentials) {
    return challenge();
  }
  const auto now = LoginDelay::Clock::now();
  const auto delay = delay_.admit(group, credentials->user, now);
  if (!delay) {
    return tooManyFailures();
  }
  exchange.phase = Exchange::Phase::Login;
  exchange.group = group;
  exchange.request.user = std::move(credentials->user);
  exchange.password = std::move(credentials->password);
  exchange.notBefore = now + *delay;
  return std::nullopt;
}

// Who has to wait costs no thread meanwhile.
void Authentication::check(const ExchangePointer& exchange) {
  try {
    if (exchange->notBefore <= LoginDelay::Clock::now()) {
      start(exchange);
    } else {
      timers_.at(exchange->notBefore, [this, exchange] { start(exchange); });
    }
  } catch (const std::exception&) {
    suspensions_.turnAway(exchange, "the server is out of memory");
  }
}

void Authentication::start(const ExchangePointer& exchange) {
  try {
    if (workers_.run([this, exchange] { decide(exchange); })) {
      return;
    }
  } catch (const std::exception&) {
    // no memory: there is no room, then
  }
  suspensions_.turnAway(exchange, "too many logins at once");
}

void Authentication::decide(const ExchangePointer& exchange) {
  std::optional<Response> response = guarded([&] {
    const std::string& user = exchange->request.user;
    if (authenticator_(user, exchange->password)) {
      delay_.succeeded(exchange->group, user);
      return Response{0, {}, {}};
    }
    delay_.failed(exchange->group, user, LoginDelay::Clock::now());
    if (log_) {
      log_("login failed: user \"" + Ground::printable(user) + "\" from " + exchange->request.client);
    }
    return challenge();
  });
  if (response->status == 0) {
    response.reset();
  }
  suspensions_.resume(exchange, std::move(response));
}

}  // namespace Cimom::Http
