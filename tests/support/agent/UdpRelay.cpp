// SPDX-License-Identifier: Apache-2.0
#include "tests/support/agent/UdpRelay.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <stdexcept>

namespace Testing {
namespace {

sockaddr_in loopback(std::uint16_t port) {
  sockaddr_in address{};
  address.sin_family = AF_INET;
  address.sin_addr.s_addr = ::htonl(INADDR_LOOPBACK);
  address.sin_port = ::htons(port);
  return address;
}

}  // namespace

UdpRelay::UdpRelay(std::uint16_t destination)
    : client_(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0)),
      bmc_(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC, 0)),
      stop_(::eventfd(0, EFD_CLOEXEC)) {
  sockaddr_in here = loopback(0);
  sockaddr_in there = loopback(destination);
  socklen_t length = sizeof here;
  if (::bind(client_, reinterpret_cast<sockaddr*>(&here), sizeof here) != 0 ||
      ::getsockname(client_, reinterpret_cast<sockaddr*>(&here), &length) != 0 ||
      ::connect(bmc_, reinterpret_cast<sockaddr*>(&there), sizeof there) != 0) {
    throw std::runtime_error("no relay");
  }
  port_ = ::ntohs(here.sin_port);
  thread_ = std::thread([this] { relay(); });
}

UdpRelay::~UdpRelay() {
  ::eventfd_write(stop_, 1);
  thread_.join();
  for (const int descriptor : {client_, bmc_, stop_}) {
    ::close(descriptor);
  }
}

void UdpRelay::relay() {
  std::array<char, 2048> datagram;
  sockaddr_in peer{};
  socklen_t length = sizeof peer;
  std::array<pollfd, 3> sources = {{{client_, POLLIN, 0}, {bmc_, POLLIN, 0}, {stop_, POLLIN, 0}}};
  while (::poll(sources.data(), sources.size(), -1) > 0 && sources[2].revents == 0) {
    if (sources[0].revents != 0) {
      length = sizeof peer;
      const ssize_t size =
          ::recvfrom(client_, datagram.data(), datagram.size(), 0, reinterpret_cast<sockaddr*>(&peer), &length);
      ++requests_;
      const bool passes = passing_ > 0;
      if (passes && passing_ != unlimited) {
        --passing_;
      }
      if (passes && size > 0) {
        ::send(bmc_, datagram.data(), static_cast<std::size_t>(size), 0);
      }
    }
    if (sources[1].revents != 0) {
      const ssize_t size = ::recv(bmc_, datagram.data(), datagram.size(), 0);
      if (passing_ > 0 && size > 0) {
        ::sendto(client_, datagram.data(), static_cast<std::size_t>(size), 0, reinterpret_cast<sockaddr*>(&peer),
                 length);
      }
    }
  }
}

}  // namespace Testing
