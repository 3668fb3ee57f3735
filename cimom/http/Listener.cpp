// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Listener.h"

#include <netdb.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include <cerrno>
#include <cstring>
#include <memory>

namespace Cimom::Http {
namespace {

constexpr int backlog = 128;

using AddressList = std::unique_ptr<addrinfo, decltype(&freeaddrinfo)>;

AddressList resolve(const std::string& address, std::uint16_t port) {
  addrinfo hints{};
  hints.ai_flags = AI_NUMERICHOST | AI_NUMERICSERV | AI_PASSIVE;
  hints.ai_socktype = SOCK_STREAM;
  addrinfo* list = nullptr;
  const int error = getaddrinfo(address.c_str(), std::to_string(port).c_str(), &hints, &list);
  if (error != 0) {
    throw ServerError("cannot listen on \"" + address + "\": must be a numeric IPv4 or IPv6 address (" +
                      gai_strerror(error) + ")");
  }
  return {list, &freeaddrinfo};
}

[[noreturn]] void fail(const std::string& address, std::uint16_t port) {
  throw ServerError("cannot listen on " + address + " port " + std::to_string(port) + ": " + std::strerror(errno));
}

}  // namespace

Listener::Listener(const std::string& address, std::uint16_t port) {
  const AddressList list = resolve(address, port);
  socket_ =
      Ground::Descriptor(socket(list->ai_family, list->ai_socktype | SOCK_NONBLOCK | SOCK_CLOEXEC, list->ai_protocol));
  const int on = 1;
  sockaddr_storage taken{};
  socklen_t size = sizeof taken;
  if (!socket_.isOpen() || setsockopt(descriptor(), SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) != 0 ||
      bind(descriptor(), list->ai_addr, list->ai_addrlen) != 0 ||
      getsockname(descriptor(), reinterpret_cast<sockaddr*>(&taken), &size) != 0) {
    fail(address, port);
  }
  bound_ = Address(reinterpret_cast<const sockaddr*>(&taken));
  // The port stands at the same place in both families' addresses.
  port_ = ntohs(reinterpret_cast<const sockaddr_in*>(&taken)->sin_port);
  endpoint_ = (taken.ss_family == AF_INET6 ? "[" + address + "]" : address) + ":" + std::to_string(port_);
}

void Listener::listen() {
  if (::listen(descriptor(), backlog) != 0) {
    fail(endpoint_.substr(0, endpoint_.rfind(':')), port_);
  }
}

}  // namespace Cimom::Http
