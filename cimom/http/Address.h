// SPDX-License-Identifier: Apache-2.0
// The address of one end of a connection, without its port.
#pragma once

#include <netinet/in.h>
#include <sys/socket.h>

#include <optional>
#include <string>

namespace Cimom::Http {

// An IPv4 address that travels as an IPv6 one (::ffff:192.0.2.1) is the IPv4 address.
class Address {
 public:
  Address() = default;  // none, as a connection that is not of IP has it
  explicit Address(const sockaddr* address);

  // From a numeric text, "192.0.2.1" or "2001:db8::1".
  static std::optional<Address> parse(const std::string& text);

  bool isLoopback() const;
  std::string text() const;  // empty for none

  // What a client can be expected to have one of: the address, of IPv6 its network of 64 bits.
  std::string group() const;

  bool operator==(const Address& other) const;

 private:
  void simplify();

  int family_ = AF_UNSPEC;
  in6_addr bytes_{};  // of IPv4 the first four
};

}  // namespace Cimom::Http
