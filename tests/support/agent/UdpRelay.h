// SPDX-License-Identifier: Apache-2.0
// A wire between a client and a BMC that counts what goes over it, and can be cut and disturbed.
#pragma once

#include <netinet/in.h>

#include <array>
#include <atomic>
#include <cstdint>
#include <mutex>
#include <optional>
#include <thread>
#include <vector>

namespace Testing {

// Relays datagrams between its own port and another of this machine, for one client at a time.
class UdpRelay {
 public:
  // What may happen to one of the client's datagrams and to the BMC's next one, which is the answer.
  enum class Disturbance {
    RequestLost,
    RequestDoubled,
    RequestCut,  // to half its length
    AnswerLost,
    AnswerLate,  // it arrives after the client's next datagram
    AnswerDoubled,
    AnswerCut
  };

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

  // From the client's datagram of that number on, counted from now, the BMC gets none until joined again, and then all.
  void stallAtRequest(unsigned number);

  void join();

  // Once, to the client's datagram of that number, counted from now.
  void disturbRequest(unsigned number, Disturbance disturbance);
  // Nothing more is disturbed; whether something was.
  bool undisturb();

 private:
  static constexpr unsigned unlimited = ~0u;

  void relay();
  void takeRequest();
  void takeAnswer();
  bool stalls(std::size_t size);
  void sendRequest(std::size_t size) const;
  void sendAnswer(const std::vector<char>& answer) const;

  int client_;
  int bmc_;
  int stop_;
  std::uint16_t port_ = 0;
  std::atomic<unsigned> requests_ = 0;
  std::atomic<unsigned> passing_ = unlimited;

  std::mutex mutex_;
  unsigned untilDisturbed_ = 0;  // 0: nothing is to be disturbed
  Disturbance disturbance_ = Disturbance::RequestLost;
  bool disturbed_ = false;
  unsigned untilStalled_ = 0;  // 0: nothing stalls
  std::vector<std::vector<char>> stalled_;

  // The relay's thread alone.
  std::array<char, 2048> datagram_{};
  sockaddr_in peer_{};
  std::optional<Disturbance> answers_;
  std::vector<char> late_;

  std::thread thread_;
};

}  // namespace Testing
