// SPDX-License-Identifier: Apache-2.0
// CIM-XML requests over HTTP: many at once on one thread.
#pragma once

#include <chrono>
#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "bmcip/client/Failure.h"
#include "bmcip/client/Server.h"

namespace Bmcip {

// Who asks, whom it trusts, and how long it waits.
struct Access {
  std::string cacert;  // a PEM file; empty: the system's
  std::string user;
  std::string password;
  bool netrc = false;
  std::chrono::milliseconds connectTimeout = std::chrono::seconds(5);
  std::chrono::milliseconds timeout = std::chrono::seconds(30);  // of a request, with its connection
};

// An intrinsic method to call: its name, and the message.
struct Call {
  std::string method;
  std::string message;
};

struct Reply {
  std::optional<Failure> failure;  // then the rest is of no meaning
  std::string message;
  std::string peer;  // the numeric address that answered
};

// A process has one at a time. What a server sends is bounded, redirections and proxies are not followed.
class Transport {
 public:
  static constexpr std::size_t maxReply = 1 << 20;

  // Throws std::runtime_error if libcurl cannot be used.
  explicit Transport(Access access);
  ~Transport();
  Transport(const Transport&) = delete;
  Transport& operator=(const Transport&) = delete;

  // Starts a request; `done` is called from run(), and may start others.
  void send(const Server& server, const Call& call, std::function<void(Reply)> done);

  // Returns when nothing is in progress. `tick` is called now and then meanwhile.
  void run(const std::function<void()>& tick = {});

  // Sends one request and waits for its reply. Throws Failure.
  Reply ask(const Server& server, const Call& call);

 private:
  struct State;
  std::unique_ptr<State> state_;
};

}  // namespace Bmcip
