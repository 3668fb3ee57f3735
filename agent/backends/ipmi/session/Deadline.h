// SPDX-License-Identifier: Apache-2.0
// The moment by which an operation of the processor has ended, whatever the hardware does.
#pragma once

#include <chrono>
#include <compare>

namespace QV::Ipmi {

class Deadline {
 public:
  using Clock = std::chrono::steady_clock;

  explicit Deadline(std::chrono::milliseconds budget) : time_(Clock::now() + budget) {}

  Clock::time_point time() const { return time_; }
  bool passed() const { return Clock::now() >= time_; }
  // Whether what takes this long would end before it.
  bool leaves(Clock::duration needed) const { return Clock::now() + needed < time_; }
  auto operator<=>(const Deadline&) const = default;

 private:
  Clock::time_point time_;
};

}  // namespace QV::Ipmi
