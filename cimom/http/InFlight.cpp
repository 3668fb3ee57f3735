// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/InFlight.h"

#include <algorithm>

namespace Cimom::Http {
namespace {

// How long clients have to take their replies when the server ends.
constexpr std::chrono::milliseconds farewell{1000};

}  // namespace

bool InFlight::enter() {
  const std::lock_guard lock(mutex_);
  if (draining_) {
    return false;
  }
  ++handlers_;
  ++replies_;
  return true;
}

void InFlight::handled() {
  const std::lock_guard lock(mutex_);
  --handlers_;
  changed_.notify_all();
}

void InFlight::replied() {
  const std::lock_guard lock(mutex_);
  --replies_;
  changed_.notify_all();
}

bool InFlight::isDraining() {
  const std::lock_guard lock(mutex_);
  return draining_;
}

bool InFlight::drain(std::chrono::milliseconds grace) {
  const auto deadline = std::chrono::steady_clock::now() + grace;
  std::unique_lock lock(mutex_);
  draining_ = true;
  if (!changed_.wait_until(lock, deadline, [this] { return handlers_ == 0; })) {
    return false;
  }
  changed_.wait_until(lock, std::min(deadline, std::chrono::steady_clock::now() + farewell),
                      [this] { return replies_ == 0; });
  return true;
}

}  // namespace Cimom::Http
