// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <cstdint>
#include <string>
#include <thread>

namespace Testing {

// A server that is none: on every connection it reads the request and then does one thing.
class RawServer {
 public:
  enum class Manner {
    Hang,      // says nothing
    BreakOff,  // closes in the middle of an answer
    Drip,      // sends a byte now and then
    Flood,     // sends a body without an end
    Headers,   // sends headers without an end
    Redirect,  // names another place
    Babble,    // speaks no HTTP
  };

  explicit RawServer(Manner manner);
  ~RawServer();
  RawServer(const RawServer&) = delete;
  RawServer& operator=(const RawServer&) = delete;

  std::string url() const { return "http://127.0.0.1:" + std::to_string(port_); }
  unsigned connections() const { return connections_; }

 private:
  void serve();
  void answer(int connection) const;

  const Manner manner_;
  int listener_;
  std::uint16_t port_ = 0;
  std::atomic<bool> ends_ = false;
  std::atomic<unsigned> connections_ = 0;
  std::thread thread_;
};

}  // namespace Testing
