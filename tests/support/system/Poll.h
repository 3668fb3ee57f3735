// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <chrono>
#include <thread>

namespace Testing {

// Asks until the condition holds; returns false when it does not within the time.
template <typename Condition>
bool poll(Condition condition, std::chrono::milliseconds patience = std::chrono::seconds(100)) {
  const auto deadline = std::chrono::steady_clock::now() + patience;
  while (!condition()) {
    if (std::chrono::steady_clock::now() > deadline) {
      return false;
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(2));
  }
  return true;
}

}  // namespace Testing
