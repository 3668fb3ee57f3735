// SPDX-License-Identifier: Apache-2.0
// An HTTP/1.1 server: any method, chunked bodies and replies, 100-continue, keep-alive, optionally TLS and basic
// authentication. One thread serves all connections, so that a slow client costs a descriptor; handlers run on others,
// so that a request which waits for slow hardware holds up no other.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <set>
#include <string>

#include "cimom/http/Listener.h"
#include "cimom/http/Message.h"
#include "ground/Names.h"

namespace Cimom::Http {

// What a request log says of a request.
struct RequestRecord {
  std::chrono::milliseconds duration;
  std::string client;
  std::string user;
  std::string subject;  // as the handler names it; else the method and the path
  unsigned status;      // of HTTP
};

struct ServerOptions {
  std::string address = "127.0.0.1";                  // numeric
  std::uint16_t port = 0;                             // 0: a free one
  std::size_t maxRequestSize = 4 << 20;               // bytes of a body; more is answered with 413
  std::size_t maxRequestMemory = 32 << 20;            // bytes of all bodies together; more is answered with 503
  unsigned maxConnections = 512;                      // further clients are answered with 503
  unsigned maxConnectionsPerAddress = 64;             // of IPv6: per network of 64 bits
  unsigned maxRequests = 64;                          // handlers at work at once; more is answered with 503
  std::chrono::seconds idleTimeout{60};               // a connection without traffic for so long is closed
  std::chrono::seconds requestTimeout{30};            // for a whole request, from the connection's or its own beginning
  std::chrono::seconds operationTimeout{60};          // for a handler, whose request is then answered without it
  std::set<std::string, Ground::NameLess> hostNames;  // under which the server may be asked, beside localhost
  std::string tlsCertificate;                         // PEM, chain included; with tlsKey: HTTPS instead of HTTP
  std::string tlsKey;                                 // PEM, unencrypted
  Authenticator authenticator;                        // none: everybody may
  FailureHandler failureHandler;                      // none: a 500 with the reason
  std::function<const std::string&()> threadEnd;      // asked on a thread that its handler has ended: by whom, or ""
  std::function<void(const std::string& line)> log;   // what an administrator should see; none: nobody
  std::function<void(const RequestRecord& record)> requestLog;  // every request, once it has been answered
};

class Server {
 public:
  // Listens and serves when it returns. Throws ServerError, also where other machines would reach a server without TLS
  // or without authentication.
  Server(ServerOptions options, Handler handler);

  // Waits for the handlers that are at work.
  ~Server();

  Server(const Server&) = delete;
  Server& operator=(const Server&) = delete;

  std::string endpoint() const;  // where it listens: "http://127.0.0.1:5988"
  std::uint16_t port() const;

  // Another certificate and key, for the connections that begin from now on. Throws ServerError, and keeps the old
  // ones.
  void useCertificate(const std::string& chain, const std::string& key);

  // Serves a connected stream socket, as if it had been accepted, and closes it.
  void adopt(int descriptor);

  // Takes no new connection or request (503), waits for the handlers that are at work, and then a moment for clients to
  // take their replies. Returns false if a handler is still at work after the grace period; it goes on.
  bool drain(std::chrono::milliseconds grace);

 private:
  struct State;
  std::unique_ptr<State> state_;
};

}  // namespace Cimom::Http
