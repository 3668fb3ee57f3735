// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <sys/socket.h>

#include <functional>
#include <thread>

#include "cimom/http/Listener.h"
#include "ground/Descriptor.h"

namespace Cimom::Http {

// Accepts the connections of a listener in a thread of its own. Where the process has no descriptor left for one, it is
// closed, so that its client learns of it and nobody waits for ever.
class Acceptor {
 public:
  // Takes the connected socket, and closes it.
  using Taker = std::function<void(int descriptor, const sockaddr_storage& peer, socklen_t size)>;

  Acceptor(Listener listener, Taker taker);
  ~Acceptor();
  Acceptor(const Acceptor&) = delete;
  Acceptor& operator=(const Acceptor&) = delete;

 private:
  void work();
  bool acceptOne();
  void shedOne();

  const Listener listener_;
  const Taker taker_;
  Ground::Descriptor wake_;
  Ground::Descriptor reserve_;
  std::thread thread_;
};

}  // namespace Cimom::Http
