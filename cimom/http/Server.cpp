// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Server.h"

#include <microhttpd.h>
#include <unistd.h>

#include <charconv>
#include <condition_variable>
#include <exception>
#include <mutex>
#include <utility>
#include <vector>

namespace Cimom::Http {
namespace {

constexpr const char* realm = "cimom";

// One request on its way from the first header to the last byte of its reply.
struct Exchange {
  Request request;
  bool tooLarge = false;
  std::size_t dropped = 0;  // bytes of the body beyond the limit
  bool counted = false;     // among those that a drain waits for
};

// Counts the requests that are being answered.
class InFlight {
 public:
  // False once the server drains.
  bool enter() {
    const std::lock_guard lock(mutex_);
    if (draining_) {
      return false;
    }
    ++count_;
    return true;
  }

  void leave() {
    const std::lock_guard lock(mutex_);
    if (--count_ == 0) {
      idle_.notify_all();
    }
  }

  bool drain(std::chrono::milliseconds grace) {
    std::unique_lock lock(mutex_);
    draining_ = true;
    return idle_.wait_for(lock, grace, [this] { return count_ == 0; });
  }

 private:
  std::mutex mutex_;
  std::condition_variable idle_;
  std::size_t count_ = 0;
  bool draining_ = false;
};

MHD_Result collectHeader(void* headers, MHD_ValueKind, const char* name, const char* value) {
  static_cast<Headers*>(headers)->add(name, value ? value : "");
  return MHD_YES;
}

MHD_Result send(MHD_Connection* connection, const Response& response) {
  std::unique_ptr<MHD_Response, decltype(&MHD_destroy_response)> message(
      MHD_create_response_from_buffer(response.body.size(), const_cast<char*>(response.body.data()),
                                      MHD_RESPMEM_MUST_COPY),
      &MHD_destroy_response);
  if (!message) {
    return MHD_NO;
  }
  for (const auto& [name, value] : response.headers) {
    MHD_add_response_header(message.get(), name.c_str(), value.c_str());
  }
  return MHD_queue_response(connection, response.status, message.get());
}

MHD_Result refuse(MHD_Connection* connection, unsigned status, const char* reason) {
  Response response{status, {}, std::string(reason) + "\n"};
  response.headers.add("Content-Type", "text/plain; charset=\"utf-8\"");
  response.headers.add("Connection", "close");
  return send(connection, response);
}

MHD_Result refuseSize(MHD_Connection* connection) {
  return refuse(connection, MHD_HTTP_CONTENT_TOO_LARGE, "the request is too large");
}

MHD_Result challenge(MHD_Connection* connection) {
  Response response{MHD_HTTP_UNAUTHORIZED, {}, "authentication is required\n"};
  response.headers.add("Content-Type", "text/plain; charset=\"utf-8\"");
  response.headers.add("WWW-Authenticate", std::string("Basic realm=\"") + realm + "\"");
  return send(connection, response);
}

}  // namespace

struct Server::State {
  ServerOptions options;
  Handler handler;
  Listener listener;
  InFlight inFlight;
  MHD_Daemon* daemon = nullptr;

  State(ServerOptions given, Handler answer)
      : options(std::move(given)), handler(std::move(answer)), listener(options.address, options.port) {}

  // What the headers alone decide is decided before a byte of the body is asked for.
  MHD_Result begin(MHD_Connection* connection, Request& request) const {
    MHD_get_connection_values(connection, MHD_HEADER_KIND, &collectHeader, &request.headers);
    if (options.authenticator && !authenticated(connection, request)) {
      return challenge(connection);
    }
    const std::string* length = request.headers.find(MHD_HTTP_HEADER_CONTENT_LENGTH);
    std::size_t bytes = 0;
    if (length) {
      std::from_chars(length->data(), length->data() + length->size(), bytes);
    }
    return bytes <= options.maxRequestSize ? MHD_YES : refuseSize(connection);
  }

  bool authenticated(MHD_Connection* connection, Request& request) const {
    char* password = nullptr;
    char* user = MHD_basic_auth_get_username_password(connection, &password);
    const bool accepted = user && password && options.authenticator(user, password);
    if (accepted) {
      request.user = user;
    }
    MHD_free(user);
    MHD_free(password);
    return accepted;
  }

  // The size of a chunked body is known only once it has been read: what is beyond the limit is dropped, and a client
  // that goes on for as long again is cut off.
  MHD_Result receive(Exchange& exchange, const char* data, std::size_t& size) const {
    std::string& body = exchange.request.body;
    if (!exchange.tooLarge && size <= options.maxRequestSize - body.size()) {
      body.append(data, size);
    } else {
      exchange.tooLarge = true;
      exchange.dropped += size;
      body.clear();
    }
    size = 0;
    return exchange.dropped > 2 * options.maxRequestSize ? MHD_NO : MHD_YES;
  }

  MHD_Result answer(MHD_Connection* connection, Exchange& exchange) {
    if (exchange.tooLarge) {
      return refuseSize(connection);
    }
    exchange.counted = inFlight.enter();
    if (!exchange.counted) {
      return refuse(connection, MHD_HTTP_SERVICE_UNAVAILABLE, "the server is shutting down");
    }
    try {
      return send(connection, handler(exchange.request));
    } catch (const std::exception& error) {
      return refuse(connection, MHD_HTTP_INTERNAL_SERVER_ERROR, error.what());
    }
  }

  static MHD_Result onRequest(void* self, MHD_Connection* connection, const char* path, const char* method, const char*,
                              const char* data, std::size_t* size, void** handle) {
    auto& state = *static_cast<State*>(self);
    if (!*handle) {
      auto exchange = std::make_unique<Exchange>();
      exchange->request.method = method;
      exchange->request.path = path;
      *handle = exchange.get();
      return state.begin(connection, exchange.release()->request);
    }
    auto& exchange = *static_cast<Exchange*>(*handle);
    return *size > 0 ? state.receive(exchange, data, *size) : state.answer(connection, exchange);
  }

  static void onCompleted(void* self, MHD_Connection*, void** handle, MHD_RequestTerminationCode) {
    const std::unique_ptr<Exchange> exchange(static_cast<Exchange*>(std::exchange(*handle, nullptr)));
    if (exchange && exchange->counted) {
      static_cast<State*>(self)->inFlight.leave();
    }
  }

  void start() {
    unsigned flags = MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_THREAD_PER_CONNECTION | MHD_USE_POLL | MHD_USE_ITC;
    std::vector<MHD_OptionItem> settings = {
        {MHD_OPTION_LISTEN_SOCKET, listener.duplicate(), nullptr},
        {MHD_OPTION_CONNECTION_LIMIT, static_cast<std::intptr_t>(options.maxConnections), nullptr},
        {MHD_OPTION_CONNECTION_TIMEOUT, static_cast<std::intptr_t>(options.idleTimeout.count()), nullptr},
        {MHD_OPTION_NOTIFY_COMPLETED, reinterpret_cast<std::intptr_t>(&State::onCompleted), this}};
    if (!options.tlsCertificate.empty()) {
      flags |= MHD_USE_TLS;
      settings.push_back({MHD_OPTION_HTTPS_MEM_CERT, 0, options.tlsCertificate.data()});
      settings.push_back({MHD_OPTION_HTTPS_MEM_KEY, 0, options.tlsKey.data()});
    }
    settings.push_back({MHD_OPTION_END, 0, nullptr});
    daemon = MHD_start_daemon(flags, 0, nullptr, nullptr, &State::onRequest, this, MHD_OPTION_ARRAY, settings.data(),
                              MHD_OPTION_END);
    if (daemon) {
      return;
    }
    throw ServerError(options.tlsCertificate.empty() ? "cannot start the HTTP server"
                                                     : "cannot start the HTTPS server: certificate and key must be "
                                                       "unencrypted PEM and belong together");
  }
};

Server::Server(ServerOptions options, Handler handler)
    : state_(std::make_unique<State>(std::move(options), std::move(handler))) {
  state_->start();
}

Server::~Server() { MHD_stop_daemon(state_->daemon); }

std::string Server::endpoint() const { return state_->listener.endpoint(); }

std::uint16_t Server::port() const { return state_->listener.port(); }

bool Server::drain(std::chrono::milliseconds grace) {
  const int socket = MHD_quiesce_daemon(state_->daemon);
  if (socket >= 0) {
    ::close(socket);
  }
  state_->listener.close();
  return state_->inFlight.drain(grace);
}

}  // namespace Cimom::Http
