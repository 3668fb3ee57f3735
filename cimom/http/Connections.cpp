// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Connections.h"

#include <sys/socket.h>

#include <algorithm>
#include <utility>

namespace Cimom::Http {
namespace {

// For a connection that only hears that there is no room.
constexpr std::chrono::seconds surplusTimeLimit{5};

Address ownAddress(int descriptor) {
  sockaddr_storage address{};
  socklen_t size = sizeof address;
  const bool known = getsockname(descriptor, reinterpret_cast<sockaddr*>(&address), &size) == 0;
  return known ? Address(reinterpret_cast<const sockaddr*>(&address)) : Address();
}

}  // namespace

void Connection::cut() {
  const std::lock_guard lock(mutex);
  if (descriptor >= 0) {
    ::shutdown(descriptor, SHUT_RDWR);
  }
}

std::shared_ptr<Connection> Connections::open(int descriptor, const sockaddr* peer, std::chrono::seconds timeLimit) {
  auto connection = std::make_shared<Connection>();
  connection->descriptor = descriptor;
  connection->peer = Address(peer);
  connection->arrivedAt = ownAddress(descriptor);
  connection->group = connection->peer.group();
  limit(connection, timeLimit);
  const auto ofAddress = perAddress_.find(connection->group);
  connection->isSurplus = count_ >= most_ || (ofAddress != perAddress_.end() && ofAddress->second >= mostPerAddress_);
  if (!connection->isSurplus) {
    ++perAddress_[connection->group];
    ++count_;
    return connection;
  }
  limit(connection, std::min(surplusTimeLimit, timeLimit));
  if (++surplusCount_ > surplus) {
    connection->cut();
  }
  return connection;
}

void Connections::close(Connection& connection) {
  unlimit(connection);
  {
    const std::lock_guard lock(connection.mutex);
    connection.descriptor = -1;
  }
  if (connection.isSurplus) {
    --surplusCount_;
  } else {
    --count_;
    const auto ofAddress = perAddress_.find(connection.group);
    if (--ofAddress->second == 0) {
      perAddress_.erase(ofAddress);
    }
  }
}

void Connections::limit(const std::shared_ptr<Connection>& connection, std::chrono::seconds time) {
  unlimit(*connection);
  connection->timeLimit = timers_.at(Timers::Clock::now() + time, [weak = std::weak_ptr(connection)] {
    if (const auto late = weak.lock()) {
      late->cut();
    }
  });
}

void Connections::unlimit(Connection& connection) { timers_.cancel(std::exchange(connection.timeLimit, {})); }

}  // namespace Cimom::Http
