// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Acceptor.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <utility>

namespace Cimom::Http {
namespace {

// How long a shortage of descriptors or memory is left alone.
constexpr int shortageMilliseconds = 50;

constexpr const char* nothing = "/dev/null";

}  // namespace

Acceptor::Acceptor(Listener listener, Taker taker)
    : listener_(std::move(listener)),
      taker_(std::move(taker)),
      wake_(eventfd(0, EFD_CLOEXEC)),
      reserve_(nothing, O_RDONLY) {
  if (!wake_.isOpen() || !reserve_.isOpen()) {
    throw ServerError(std::string("cannot start the server: ") + std::strerror(errno));
  }
  thread_ = std::thread([this] { work(); });
}

Acceptor::~Acceptor() {
  const std::uint64_t one = 1;
  [[maybe_unused]] const auto written = ::write(wake_.number(), &one, sizeof one);
  thread_.join();
}

void Acceptor::work() {
  std::array<pollfd, 2> events{{{wake_.number(), POLLIN, 0}, {listener_.descriptor(), POLLIN, 0}}};
  while (true) {
    ::poll(events.data(), events.size(), -1);
    if (events[0].revents != 0) {
      return;
    }
    if (acceptOne()) {
      continue;
    }
    shedOne();
    if (::poll(events.data(), 1, shortageMilliseconds) > 0) {
      return;
    }
  }
}

// Returns false if there is a client, and no descriptor or memory for it.
bool Acceptor::acceptOne() {
  sockaddr_storage peer{};
  socklen_t size = sizeof peer;
  const int descriptor =
      accept4(listener_.descriptor(), reinterpret_cast<sockaddr*>(&peer), &size, SOCK_NONBLOCK | SOCK_CLOEXEC);
  if (descriptor >= 0) {
    taker_(descriptor, peer, size);
    return true;
  }
  return errno != EMFILE && errno != ENFILE && errno != ENOBUFS && errno != ENOMEM;
}

// Lends the reserve to one client, just to close its connection.
void Acceptor::shedOne() {
  reserve_ = Ground::Descriptor();
  { const Ground::Descriptor shed(accept4(listener_.descriptor(), nullptr, nullptr, SOCK_CLOEXEC)); }
  reserve_ = Ground::Descriptor(nothing, O_RDONLY);
}

}  // namespace Cimom::Http
