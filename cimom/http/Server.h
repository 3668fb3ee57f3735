// SPDX-License-Identifier: Apache-2.0
// An HTTP/1.1 server: any method, chunked bodies, 100-continue, keep-alive, optionally TLS and basic authentication.
// Every connection has a thread of its own, so that a request which waits for slow hardware holds up no other.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include "cimom/http/Listener.h"
#include "cimom/http/Message.h"

namespace Cimom::Http {

// Whether the password is that user's; called from several threads at once.
using Authenticator = std::function<bool(const std::string& user, const std::string& password)>;

struct ServerOptions {
  std::string address = "127.0.0.1";     // numeric
  std::uint16_t port = 0;                // 0: a free one
  std::size_t maxRequestSize = 4 << 20;  // bytes of a body; more is answered with 413
  unsigned maxConnections = 64;          // further clients wait in the listen queue or are closed
  std::chrono::seconds idleTimeout{60};  // a connection without traffic for so long is closed
  std::string tlsCertificate;            // PEM, chain included; with tlsKey: HTTPS instead of HTTP
  std::string tlsKey;                    // PEM, unencrypted
  Authenticator authenticator;           // none: everybody may
};

class Server {
 public:
  // Listens and serves when it returns. Throws ServerError.
  Server(ServerOptions options, Handler handler);

  // Waits for the requests that are being answered.
  ~Server();

  Server(const Server&) = delete;
  Server& operator=(const Server&) = delete;

  std::string endpoint() const;  // where it listens: "127.0.0.1:5988"
  std::uint16_t port() const;

  // Takes no new connection or request (503) and waits for those that are being answered until their replies are sent.
  // Returns false if some are still running after the grace period; they go on.
  bool drain(std::chrono::milliseconds grace);

 private:
  struct State;
  std::unique_ptr<State> state_;
};

}  // namespace Cimom::Http
