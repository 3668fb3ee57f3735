// SPDX-License-Identifier: Apache-2.0
// A wire between a client and a BMC that counts what goes over it and can be cut.
#pragma once

#include <atomic>
#include <cstdint>
#include <thread>

namespace Testing {

// Relays datagrams between its own port and another of this machine, for one client at a time.
class UdpRelay {
 public:
  explicit UdpRelay(std::uint16_t destination);
  ~UdpRelay();
  UdpRelay(const UdpRelay&) = delete;
  UdpRelay& operator=(const UdpRelay&) = delete;

  std::uint16_t port() const { return port_; }

  // The client's datagrams since the counter was last reset.
  unsigned requests() const { return requests_; }
  void reset() { requests_ = 0; }

  // From the client's datagram of that number on, counted from now, nothing passes to the client; the datagram itself
  // still reaches the BMC. Until joined again.
  void cutAtRequest(unsigned number) { passing_ = number; }
  void join() { passing_ = unlimited; }

 private:
  static constexpr unsigned unlimited = ~0u;

  void relay();

  int client_;
  int bmc_;
  int stop_;
  std::uint16_t port_ = 0;
  std::atomic<unsigned> requests_ = 0;
  std::atomic<unsigned> passing_ = unlimited;
  std::thread thread_;
};

}  // namespace Testing
