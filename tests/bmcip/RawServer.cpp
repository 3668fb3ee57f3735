// SPDX-License-Identifier: Apache-2.0
#include "tests/bmcip/RawServer.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <stdexcept>
#include <vector>

namespace Testing {
namespace {

constexpr int turn = 20;  // milliseconds

bool say(int connection, const std::string& text) {
  return ::send(connection, text.data(), text.size(), MSG_NOSIGNAL | MSG_DONTWAIT) > 0;
}

}  // namespace

RawServer::RawServer(Manner manner) : manner_(manner), listener_(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
  sockaddr_in address{};
  address.sin_family = AF_INET;
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  socklen_t size = sizeof address;
  auto* general = reinterpret_cast<sockaddr*>(&address);
  if (bind(listener_, general, size) != 0 || listen(listener_, 512) != 0 ||
      getsockname(listener_, general, &size) != 0) {
    throw std::runtime_error("a test's server cannot listen");
  }
  port_ = ntohs(address.sin_port);
  thread_ = std::thread([this] { serve(); });
}

RawServer::~RawServer() {
  ends_ = true;
  thread_.join();
  close(listener_);
}

void RawServer::serve() {
  std::vector<pollfd> open = {{listener_, POLLIN, 0}};
  while (!ends_) {
    poll(open.data(), open.size(), turn);
    if ((open[0].revents & POLLIN) != 0) {
      open.push_back({accept4(listener_, nullptr, nullptr, SOCK_CLOEXEC), POLLIN, 0});
      ++connections_;
      continue;
    }
    for (std::size_t i = 1; i < open.size(); ++i) {
      char buffer[65536];
      const bool hasAsked = (open[i].revents & POLLIN) != 0;
      const ssize_t size = hasAsked ? recv(open[i].fd, buffer, sizeof buffer, MSG_DONTWAIT) : 1;
      if (size > 0 && hasAsked) {
        open[i].events = 0;
        answer(open[i].fd);
      } else if (open[i].events == 0 && manner_ == Manner::Drip) {
        say(open[i].fd, "x");
      } else if (open[i].events == 0 && (manner_ == Manner::Flood || manner_ == Manner::Headers)) {
        say(open[i].fd, (manner_ == Manner::Headers ? "X-More: " : "") + std::string(32000, 'x') + "\r\n");
      }
      if (size <= 0 || (open[i].revents & (POLLHUP | POLLERR)) != 0 ||
          (manner_ == Manner::BreakOff && open[i].events == 0)) {
        close(open[i].fd);
        open.erase(open.begin() + static_cast<std::ptrdiff_t>(i));
        --i;
      }
    }
  }
  for (std::size_t i = 1; i < open.size(); ++i) {
    close(open[i].fd);
  }
}

void RawServer::answer(int connection) const {
  const std::string head = "HTTP/1.1 200 OK\r\nContent-Type: application/xml\r\n";
  switch (manner_) {
    case Manner::Hang:
      break;
    case Manner::BreakOff:
      say(connection, head + "Content-Length: 100000\r\n\r\n<CIM");
      break;
    case Manner::Drip:
    case Manner::Flood:
      say(connection, head + "Connection: close\r\n\r\n<CIM");
      break;
    case Manner::Headers:
      say(connection, head);
      break;
    case Manner::Redirect:
      say(connection, "HTTP/1.1 302 Found\r\nLocation: " + url() + "/elsewhere\r\nContent-Length: 0\r\n\r\n");
      break;
    case Manner::Babble:
      say(connection, "SSH-2.0-babble\r\n");
      break;
  }
}

}  // namespace Testing
