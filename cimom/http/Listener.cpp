// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Listener.h"

#include <fcntl.h>
#include <netdb.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <utility>

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

bool listenOn(int descriptor, const addrinfo& address) {
  const int on = 1;
  return descriptor >= 0 && setsockopt(descriptor, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) == 0 &&
         bind(descriptor, address.ai_addr, address.ai_addrlen) == 0 && listen(descriptor, backlog) == 0;
}

}  // namespace

Listener::Listener(const std::string& address, std::uint16_t port) {
  const AddressList list = resolve(address, port);
  descriptor_ = socket(list->ai_family, list->ai_socktype | SOCK_NONBLOCK | SOCK_CLOEXEC, list->ai_protocol);
  if (!listenOn(descriptor_, *list)) {
    const int error = errno;
    close();
    throw ServerError("cannot listen on " + address + " port " + std::to_string(port) + ": " + std::strerror(error));
  }
  sockaddr_storage taken{};
  socklen_t size = sizeof taken;
  getsockname(descriptor_, reinterpret_cast<sockaddr*>(&taken), &size);
  // The port stands at the same place in both families' addresses.
  port_ = ntohs(reinterpret_cast<const sockaddr_in*>(&taken)->sin_port);
  endpoint_ = (taken.ss_family == AF_INET6 ? "[" + address + "]" : address) + ":" + std::to_string(port_);
}

Listener::~Listener() { close(); }

int Listener::duplicate() const { return fcntl(descriptor_, F_DUPFD_CLOEXEC, 0); }

void Listener::close() {
  if (descriptor_ >= 0) {
    ::close(std::exchange(descriptor_, -1));
  }
}

}  // namespace Cimom::Http
