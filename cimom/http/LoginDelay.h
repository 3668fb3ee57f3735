// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <chrono>
#include <cstddef>
#include <map>
#include <mutex>
#include <optional>
#include <string>

namespace Cimom::Http {

// Slows guesses of passwords down: after each failure the next attempt of that user from that address waits for longer,
// and a little any attempt from that address. What is known of others is not touched. Of the addresses and users that
// failed, a limited number is kept.
class LoginDelay {
 public:
  using Clock = std::chrono::steady_clock;

  // How long an attempt that comes now waits before the password is looked at; none: too many are waiting.
  std::optional<Clock::duration> admit(const std::string& address, const std::string& user, Clock::time_point now);

  void failed(const std::string& address, const std::string& user, Clock::time_point now);
  void succeeded(const std::string& address, const std::string& user);

 private:
  struct Record {
    unsigned failures = 0;
    Clock::time_point next;  // no attempt before
  };

  Record* find(const std::string& key);
  void count(const std::string& key, Clock::time_point now, Clock::duration delay(unsigned failures));

  std::mutex mutex_;
  std::map<std::string, Record> records_;
};

}  // namespace Cimom::Http
