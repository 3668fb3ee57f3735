// SPDX-License-Identifier: Apache-2.0
// A listening TCP socket.
#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>

#include "cimom/http/Address.h"
#include "ground/Descriptor.h"

namespace Cimom::Http {

// The server cannot be set up; the text names what failed and why.
class ServerError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

class Listener {
 public:
  // Takes the address and the port, and does not listen yet.
  // address: a numeric IPv4 or IPv6 address of this host; port 0 takes a free one. Throws ServerError.
  Listener(const std::string& address, std::uint16_t port);

  // Throws ServerError.
  void listen();

  int descriptor() const { return socket_.number(); }

  // What was bound, whatever it was written as.
  const Address& address() const { return bound_; }
  // "127.0.0.1:5988", "[::1]:5988"; with the port that was taken.
  const std::string& endpoint() const { return endpoint_; }
  std::uint16_t port() const { return port_; }

 private:
  Ground::Descriptor socket_;
  Address bound_;
  std::string endpoint_;
  std::uint16_t port_ = 0;
};

}  // namespace Cimom::Http
