// SPDX-License-Identifier: Apache-2.0
// A listening TCP socket.
#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>

namespace Cimom::Http {

// The server cannot be set up; the text names what failed and why.
class ServerError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

class Listener {
 public:
  // address: a numeric IPv4 or IPv6 address of this host; port 0 takes a free one. Throws ServerError.
  Listener(const std::string& address, std::uint16_t port);
  ~Listener();
  Listener(const Listener&) = delete;
  Listener& operator=(const Listener&) = delete;

  // A descriptor of the same socket, owned by the caller.
  int duplicate() const;

  // "127.0.0.1:5988", "[::1]:5988"; with the port that was taken.
  const std::string& endpoint() const { return endpoint_; }
  std::uint16_t port() const { return port_; }

  // Closes this descriptor of the socket.
  void close();

 private:
  int descriptor_ = -1;
  std::string endpoint_;
  std::uint16_t port_ = 0;
};

}  // namespace Cimom::Http
