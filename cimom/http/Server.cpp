// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Server.h"

#include <gnutls/gnutls.h>
#include <microhttpd.h>
#include <sys/resource.h>
#include <sys/socket.h>

#include <algorithm>
#include <charconv>
#include <exception>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "cimom/http/Acceptor.h"
#include "cimom/http/Authentication.h"
#include "cimom/http/Certificate.h"
#include "cimom/http/Connections.h"
#include "cimom/http/Dispatcher.h"
#include "cimom/http/Exchange.h"
#include "cimom/http/HostNames.h"
#include "cimom/http/InFlight.h"
#include "cimom/http/Reply.h"
#include "cimom/http/RequestHead.h"
#include "cimom/http/Timers.h"

namespace Cimom::Http {
namespace {

// A client that takes its reply more slowly holds it for too long.
constexpr std::size_t leastBytesPerSecond = 64 << 10;

// libmicrohttpd 0.9.75 locks itself up when a connection that is handed to it exceeds its own limit (it returns with
// its mutex held): the limits are those of Connections.
constexpr std::intptr_t beyondAllLimits = 1 << 30;

// TLS 1.2 at least, and no key exchange whose traffic can be read later with the server's key.
constexpr const char* priorities = "NORMAL:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2:-RSA:%SERVER_PRECEDENCE";

// Descriptors for what is no connection: files, providers, their sessions.
constexpr rlim_t otherDescriptors = 64;

MHD_Result collectHeader(void* headers, MHD_ValueKind, const char* name, const char* value) {
  try {
    static_cast<Headers*>(headers)->add(name, value ? value : "");
    return MHD_YES;
  } catch (const std::exception&) {
    return MHD_NO;
  }
}

using ConnectionPointer = std::shared_ptr<Connection>;

// The connection's own record; null if there was no memory for it.
const ConnectionPointer* recordOf(MHD_Connection* connection) {
  const auto* info = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
  return info ? static_cast<const ConnectionPointer*>(info->socket_context) : nullptr;
}

// The certificate for a handshake, as the connection holds it.
int retrieveCertificate(gnutls_session_t session, const gnutls_datum_t*, int, const gnutls_pk_algorithm_t*, int,
                        gnutls_pcert_st** chain, unsigned* length, gnutls_privkey_t* key) {
  const auto* connection = static_cast<const Connection*>(gnutls_session_get_ptr(session));
  if (!connection || !connection->certificate) {
    return -1;
  }
  *chain = connection->certificate->chain().data();
  *length = static_cast<unsigned>(connection->certificate->chain().size());
  *key = connection->certificate->key();
  return 0;
}

}  // namespace

struct Server::State {
  ServerOptions options;
  HostNames hostNames;
  MemoryBudget budget;
  InFlight inFlight;
  Suspensions suspensions;
  Timers timers;
  Connections connections;
  Authentication authentication;
  Dispatcher dispatcher;
  std::mutex certificateMutex;
  std::shared_ptr<Certificate> certificate;  // none: plain HTTP
  std::string endpoint;
  std::uint16_t port = 0;
  MHD_Daemon* daemon = nullptr;
  std::unique_ptr<Acceptor> acceptor;

  State(ServerOptions given, Handler handler)
      : options(std::move(given)),
        hostNames(options.hostNames),
        budget(options.maxRequestMemory),
        connections(options.maxConnections, options.maxConnectionsPerAddress, timers),
        authentication(options.authenticator, options.log, options.maxConnections, timers, suspensions),
        dispatcher({.handler = std::move(handler),
                    .failureHandler = options.failureHandler,
                    .threadEnd = options.threadEnd,
                    .timeLimit = options.operationTimeout,
                    .handlers = options.maxRequests,
                    .failures = options.maxConnections},
                   timers, suspensions, inFlight) {}

  ~State() {
    acceptor.reset();
    suspensions.end();
    if (daemon) {
      MHD_stop_daemon(daemon);
    }
    timers.stop();
  }

  State(const State&) = delete;
  State& operator=(const State&) = delete;

  void start() {
    Listener listener(options.address, options.port);
    requireProtection(listener);
    requireDescriptors();
    if (isTls()) {
      certificate = std::make_shared<Certificate>(options.tlsCertificate, options.tlsKey);
    }
    startDaemon();
    listener.listen();
    endpoint = std::string(isTls() ? "https://" : "http://") + listener.endpoint();
    port = listener.port();
    acceptor = std::make_unique<Acceptor>(
        std::move(listener), [this](int descriptor, const sockaddr_storage& peer, socklen_t size) {
          MHD_add_connection(daemon, descriptor, reinterpret_cast<const sockaddr*>(&peer), size);
        });
  }

  bool isTls() const { return !options.tlsCertificate.empty(); }

  // Whoever reaches the server may change what the providers let be changed.
  void requireProtection(const Listener& listener) const {
    if (listener.address().isLoopback() || (isTls() && authentication.isRequired())) {
      return;
    }
    throw ServerError("cannot listen on " + options.address + " port " + std::to_string(listener.port()) +
                      ": other machines reach it, so that tls-certificate, tls-key and password-file must be given; "
                      "without them only a loopback address can be, 127.0.0.1 or ::1");
  }

  // All connections, or none: a limit that cannot be kept would show on the worst day.
  void requireDescriptors() const {
    const rlim_t needed = options.maxConnections + Connections::surplus + otherDescriptors;
    rlimit limit{};
    if (getrlimit(RLIMIT_NOFILE, &limit) != 0 || limit.rlim_cur >= needed) {
      return;
    }
    limit.rlim_cur = std::min(needed, limit.rlim_max);
    if (limit.rlim_cur < needed || setrlimit(RLIMIT_NOFILE, &limit) != 0) {
      throw ServerError("max-connections " + std::to_string(options.maxConnections) + " needs " +
                        std::to_string(needed) + " open files, and the process may have " +
                        std::to_string(limit.rlim_cur) +
                        ": lower max-connections, or raise the limit (ulimit -n, LimitNOFILE= of systemd)");
    }
  }

  void startDaemon() {
    unsigned flags = MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_POLL | MHD_USE_NO_LISTEN_SOCKET |
                     MHD_ALLOW_SUSPEND_RESUME | MHD_USE_ITC;
    std::vector<MHD_OptionItem> settings = {
        {MHD_OPTION_CONNECTION_LIMIT, beyondAllLimits, nullptr},
        {MHD_OPTION_CONNECTION_TIMEOUT, static_cast<std::intptr_t>(options.idleTimeout.count()), nullptr},
        {MHD_OPTION_NOTIFY_CONNECTION, reinterpret_cast<std::intptr_t>(&State::onConnection), this},
        {MHD_OPTION_NOTIFY_COMPLETED, reinterpret_cast<std::intptr_t>(&State::onCompleted), this}};
    if (isTls()) {
      flags |= MHD_USE_TLS;
      settings.push_back({MHD_OPTION_HTTPS_CERT_CALLBACK, 0, reinterpret_cast<void*>(&retrieveCertificate)});
      settings.push_back({MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(priorities)});
    }
    settings.push_back({MHD_OPTION_END, 0, nullptr});
    daemon = MHD_start_daemon(flags, 0, nullptr, nullptr, &State::onRequest, this, MHD_OPTION_ARRAY, settings.data(),
                              MHD_OPTION_END);
    if (!daemon) {
      throw ServerError(isTls() ? "cannot start the HTTPS server" : "cannot start the HTTP server");
    }
  }

  // --- In the thread of the connections. What C calls lets no exception out.

  static void onConnection(void* self, MHD_Connection* connection, void** record, MHD_ConnectionNotificationCode what) {
    auto& state = *static_cast<State*>(self);
    if (what == MHD_CONNECTION_NOTIFY_STARTED) {
      state.opened(connection, record);
    } else if (*record) {
      const std::unique_ptr<ConnectionPointer> closed(static_cast<ConnectionPointer*>(std::exchange(*record, nullptr)));
      state.connections.close(**closed);
    }
  }

  void opened(MHD_Connection* connection, void** record) {
    const int descriptor = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
    try {
      const auto* peer = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS);
      auto pointer = std::make_unique<ConnectionPointer>();
      *pointer = connections.open(descriptor, peer->client_addr, options.requestTimeout);
      if (const auto* session = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_GNUTLS_SESSION)) {
        const std::lock_guard lock(certificateMutex);
        (*pointer)->certificate = certificate;
        gnutls_session_set_ptr(static_cast<gnutls_session_t>(session->tls_session), pointer->get());
      }
      *record = pointer.release();
    } catch (const std::exception&) {
      ::shutdown(descriptor, SHUT_RDWR);
    }
  }

  static MHD_Result onRequest(void* self, MHD_Connection* connection, const char* path, const char* method,
                              const char* version, const char* data, std::size_t* size, void** handle) {
    try {
      auto& state = *static_cast<State*>(self);
      const ConnectionPointer* record = recordOf(connection);
      if (!record) {
        return MHD_NO;
      }
      if (*handle) {
        return state.proceed(connection, *record, *static_cast<ExchangePointer*>(*handle), data, *size);
      }
      auto exchange = std::make_shared<Exchange>(state.options.maxRequestSize, state.budget);
      exchange->request.method = method;
      exchange->request.path = path;
      exchange->request.client = (*record)->peer.text();
      exchange->isHttp11 = version != std::string_view("HTTP/1.0");
      *handle = new ExchangePointer(exchange);
      return state.begin(connection, *record, exchange, version);
    } catch (const std::exception&) {
      return MHD_NO;
    }
  }

  // What the headers alone decide is decided before a byte of the body is asked for.
  MHD_Result begin(MHD_Connection* connection, const ConnectionPointer& record, const ExchangePointer& exchange,
                   std::string_view version) {
    Headers& headers = exchange->request.headers;
    const int given = MHD_get_connection_values(connection, MHD_HEADER_KIND, nullptr, nullptr);
    MHD_get_connection_values(connection, MHD_HEADER_KIND, &collectHeader, &headers);
    if (std::distance(headers.begin(), headers.end()) != given) {
      return MHD_NO;
    }
    if (const auto fault = findFault(version, headers, hostNames, record->arrivedAt)) {
      return reply(connection, record, *exchange, refusal(fault->status, fault->reason));
    }
    if (record->isSurplus) {
      return reply(connection, record, *exchange, overload("too many connections"));
    }
    if (inFlight.isDraining()) {
      return reply(connection, record, *exchange, overload("the server is shutting down"));
    }
    if (authentication.isRequired()) {
      return login(connection, record, exchange);
    }
    return expectBody(connection, record, *exchange);
  }

  MHD_Result login(MHD_Connection* connection, const ConnectionPointer& record, const ExchangePointer& exchange) {
    if (auto answer = authentication.begin(connection, *exchange, record->group)) {
      return reply(connection, record, *exchange, std::move(*answer));
    }
    if (!suspensions.add(exchange, connection)) {
      return MHD_NO;
    }
    connections.unlimit(*record);
    authentication.check(exchange);
    return MHD_YES;
  }

  MHD_Result expectBody(MHD_Connection* connection, const ConnectionPointer& record, Exchange& exchange) {
    exchange.phase = Exchange::Phase::Body;
    const std::string* length = exchange.request.headers.find(MHD_HTTP_HEADER_CONTENT_LENGTH);
    std::size_t bytes = 0;
    if (length) {
      std::from_chars(length->data(), length->data() + length->size(), bytes);
    }
    return bytes <= options.maxRequestSize
               ? MHD_YES
               : reply(connection, record, exchange, refusal(MHD_HTTP_CONTENT_TOO_LARGE, "the request is too large"));
  }

  MHD_Result proceed(MHD_Connection* connection, const ConnectionPointer& record, const ExchangePointer& exchange,
                     const char* data, std::size_t& size) {
    if (exchange->isAbandoned()) {
      return MHD_NO;
    }
    switch (exchange->phase) {
      case Exchange::Phase::Login:
        if (auto response = exchange->takeResponse()) {
          return reply(connection, record, *exchange, std::move(*response));
        }
        connections.limit(record, options.requestTimeout);
        return expectBody(connection, record, *exchange);
      case Exchange::Phase::Body:
        if (size > 0) {
          const std::size_t taken = std::exchange(size, 0);
          return exchange->receive(data, taken) ? MHD_YES : MHD_NO;
        }
        return answer(connection, record, exchange);
      case Exchange::Phase::Answering:
        if (auto response = exchange->takeResponse()) {
          return reply(connection, record, *exchange, std::move(*response));
        }
        return MHD_NO;
      default:
        size = 0;  // the rest of a request that has been refused
        return MHD_YES;
    }
  }

  MHD_Result answer(MHD_Connection* connection, const ConnectionPointer& record, const ExchangePointer& exchange) {
    connections.unlimit(*record);
    if (const auto& fault = exchange->refusal()) {
      return reply(connection, record, *exchange,
                   fault->status == MHD_HTTP_SERVICE_UNAVAILABLE ? overload(fault->reason)
                                                                 : refusal(fault->status, fault->reason));
    }
    exchange->counted = inFlight.enter();
    if (!exchange->counted) {
      return reply(connection, record, *exchange, overload("the server is shutting down"));
    }
    exchange->phase = Exchange::Phase::Answering;
    exchange->request.deadline = std::chrono::steady_clock::now() + options.operationTimeout;
    if (!suspensions.add(exchange, connection)) {
      inFlight.handled();
      return MHD_NO;
    }
    dispatcher.dispatch(exchange);
    return MHD_YES;
  }

  MHD_Result reply(MHD_Connection* connection, const ConnectionPointer& record, Exchange& exchange, Response response) {
    exchange.phase = Exchange::Phase::Replied;
    exchange.status = response.status;
    exchange.subject = std::move(response.subject);
    const auto bytes = static_cast<std::chrono::seconds::rep>(response.size() / leastBytesPerSecond);
    connections.limit(record, options.requestTimeout + std::chrono::seconds(bytes));
    return send(connection, std::move(response), exchange.isHttp11);
  }

  static void onCompleted(void* self, MHD_Connection* connection, void** handle, MHD_RequestTerminationCode) {
    auto& state = *static_cast<State*>(self);
    const std::unique_ptr<ExchangePointer> exchange(static_cast<ExchangePointer*>(std::exchange(*handle, nullptr)));
    const ConnectionPointer* record = recordOf(connection);
    if (!exchange) {
      return;
    }
    state.record(**exchange);
    if ((*exchange)->counted) {
      state.inFlight.replied();
    }
    try {
      // How long the connection rests is the HTTP library's to see; the next request is whole by then.
      if (record) {
        state.connections.limit(*record, state.options.idleTimeout + state.options.requestTimeout);
      }
    } catch (const std::exception&) {
      (*record)->cut();
    }
  }

  void record(const Exchange& exchange) const {
    if (!options.requestLog || exchange.status == 0) {
      return;
    }
    try {
      const Request& request = exchange.request;
      options.requestLog(
          {std::chrono::duration_cast<std::chrono::milliseconds>(std::chrono::steady_clock::now() - exchange.begun),
           request.client, request.user,
           exchange.subject.empty() ? request.method + " " + request.path : exchange.subject, exchange.status});
    } catch (const std::exception&) {
      // a line is lost, and nothing else
    }
  }
};

Server::Server(ServerOptions options, Handler handler)
    : state_(std::make_unique<State>(std::move(options), std::move(handler))) {
  state_->start();
}

Server::~Server() = default;

std::string Server::endpoint() const { return state_->endpoint; }

std::uint16_t Server::port() const { return state_->port; }

void Server::useCertificate(const std::string& chain, const std::string& key) {
  auto replacement = std::make_shared<Certificate>(chain, key);
  const std::lock_guard lock(state_->certificateMutex);
  state_->certificate.swap(replacement);
}

void Server::adopt(int descriptor) {
  sockaddr_storage none{};
  MHD_add_connection(state_->daemon, descriptor, reinterpret_cast<const sockaddr*>(&none), sizeof none);
}

bool Server::drain(std::chrono::milliseconds grace) {
  state_->acceptor.reset();
  return state_->inFlight.drain(grace);
}

}  // namespace Cimom::Http
