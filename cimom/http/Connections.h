// SPDX-License-Identifier: Apache-2.0
// The connections that are open: how many, from where, and how long each may take.
#pragma once

#include <chrono>
#include <map>
#include <memory>
#include <mutex>
#include <string>

#include "cimom/http/Address.h"
#include "cimom/http/Certificate.h"
#include "cimom/http/Timers.h"

namespace Cimom::Http {

struct Connection {
  Address peer;
  Address arrivedAt;
  // Beyond a limit: it is served for as long as it takes to say so.
  bool isSurplus = false;
  std::shared_ptr<Certificate> certificate;  // of TLS

  // Ends the traffic of the socket, whatever the connection is waiting for. Does nothing once it is closed.
  void cut();

  std::mutex mutex;
  int descriptor = -1;
  std::string group;
  Timers::Ticket timeLimit;
};

// For the thread of the connections alone, but for the limits of time that it sets.
class Connections {
 public:
  // So many connections beyond the limits hear that there is no room; further ones are cut.
  static constexpr unsigned surplus = 32;

  Connections(unsigned most, unsigned mostPerAddress, Timers& timers)
      : most_(most), mostPerAddress_(mostPerAddress), timers_(timers) {}

  std::shared_ptr<Connection> open(int descriptor, const sockaddr* peer, std::chrono::seconds timeLimit);
  void close(Connection& connection);

  // From now on; the limit before it is forgotten.
  void limit(const std::shared_ptr<Connection>& connection, std::chrono::seconds time);
  void unlimit(Connection& connection);

 private:
  const unsigned most_;
  const unsigned mostPerAddress_;
  Timers& timers_;
  unsigned count_ = 0;  // without the surplus
  unsigned surplusCount_ = 0;
  std::map<std::string, unsigned> perAddress_;
};

}  // namespace Cimom::Http
