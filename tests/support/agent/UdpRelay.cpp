// SPDX-License-Identifier: Apache-2.0
#include "tests/support/agent/UdpRelay.h"

#include <arpa/inet.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <unistd.h>

#include <stdexcept>
#include <utility>

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

void UdpRelay::disturbRequest(unsigned number, Disturbance disturbance) {
  const std::lock_guard lock(mutex_);
  untilDisturbed_ = number;
  disturbance_ = disturbance;
  disturbed_ = false;
}

bool UdpRelay::undisturb() {
  const std::lock_guard lock(mutex_);
  untilDisturbed_ = 0;
  return disturbed_;
}

void UdpRelay::stallAtRequest(unsigned number) {
  const std::lock_guard lock(mutex_);
  untilStalled_ = number;
}

void UdpRelay::join() {
  passing_ = unlimited;
  const std::lock_guard lock(mutex_);
  untilStalled_ = 0;
  for (const auto& datagram : std::exchange(stalled_, {})) {
    ::send(bmc_, datagram.data(), datagram.size(), 0);
  }
}

bool UdpRelay::stalls(std::size_t size) {
  const std::lock_guard lock(mutex_);
  if (untilStalled_ > 1) {
    --untilStalled_;
    return false;
  }
  if (untilStalled_ == 1) {
    stalled_.emplace_back(datagram_.data(), datagram_.data() + size);
  }
  return untilStalled_ == 1;
}

void UdpRelay::sendRequest(std::size_t size) const { ::send(bmc_, datagram_.data(), size, 0); }

void UdpRelay::sendAnswer(const std::vector<char>& answer) const {
  ::sendto(client_, answer.data(), answer.size(), 0, reinterpret_cast<const sockaddr*>(&peer_), sizeof peer_);
}

void UdpRelay::takeRequest() {
  socklen_t length = sizeof peer_;
  const ssize_t received =
      ::recvfrom(client_, datagram_.data(), datagram_.size(), 0, reinterpret_cast<sockaddr*>(&peer_), &length);
  ++requests_;
  std::optional<Disturbance> disturbance;
  {
    const std::lock_guard lock(mutex_);
    if (untilDisturbed_ > 0 && --untilDisturbed_ == 0) {
      disturbed_ = true;
      disturbance = answers_ = disturbance_;
    }
  }
  const bool passes = passing_ > 0;
  if (passes && passing_ != unlimited) {
    --passing_;
  }
  if (!passes || received <= 0) {
    return;
  }
  const auto size = static_cast<std::size_t>(received);
  if (disturbance == Disturbance::RequestLost || stalls(size)) {
    return;
  }
  sendRequest(disturbance == Disturbance::RequestCut ? size / 2 : size);
  if (disturbance == Disturbance::RequestDoubled) {
    sendRequest(size);
  }
  if (!late_.empty()) {
    sendAnswer(std::exchange(late_, {}));
  }
}

void UdpRelay::takeAnswer() {
  const ssize_t size = ::recv(bmc_, datagram_.data(), datagram_.size(), 0);
  if (passing_ == 0 || size <= 0) {
    return;
  }
  std::vector<char> answer(datagram_.data(), datagram_.data() + size);
  const auto disturbance = std::exchange(answers_, std::nullopt);
  if (disturbance == Disturbance::AnswerLost) {
    return;
  }
  if (disturbance == Disturbance::AnswerLate) {
    late_ = std::move(answer);
    return;
  }
  if (disturbance == Disturbance::AnswerCut) {
    answer.resize(answer.size() / 2);
  }
  sendAnswer(answer);
  if (disturbance == Disturbance::AnswerDoubled) {
    sendAnswer(answer);
  }
}

void UdpRelay::relay() {
  std::array<pollfd, 3> sources = {{{client_, POLLIN, 0}, {bmc_, POLLIN, 0}, {stop_, POLLIN, 0}}};
  while (::poll(sources.data(), sources.size(), -1) > 0 && sources[2].revents == 0) {
    if (sources[0].revents != 0) {
      takeRequest();
    }
    if (sources[1].revents != 0) {
      takeAnswer();
    }
  }
}

}  // namespace Testing
