// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/LoginDelay.h"

#include <algorithm>

namespace Cimom::Http {
namespace {

using namespace std::chrono_literals;

constexpr std::size_t mostRecords = 4096;
constexpr std::size_t longestUser = 128;
constexpr LoginDelay::Clock::duration longestDelay = 8s;
constexpr LoginDelay::Clock::duration longestWait = 20s;

// Somebody mistypes once or twice.
constexpr unsigned freeFailures = 2;
constexpr unsigned freeFailuresOfAddress = 20;

LoginDelay::Clock::duration growing(unsigned failures, unsigned free) {
  constexpr unsigned mostDoublings = 5;
  return failures <= free ? 0s
                          : std::min<LoginDelay::Clock::duration>(
                                longestDelay, 250ms * (1 << std::min(failures - free - 1, mostDoublings)));
}

LoginDelay::Clock::duration delayOfUser(unsigned failures) { return growing(failures, freeFailures); }
LoginDelay::Clock::duration delayOfAddress(unsigned failures) { return growing(failures, freeFailuresOfAddress) / 4; }

// An address has no blank.
std::string keyOf(const std::string& address, const std::string& user) {
  return address + " " + user.substr(0, longestUser);
}

}  // namespace

std::optional<LoginDelay::Clock::duration> LoginDelay::admit(const std::string& address, const std::string& user,
                                                             Clock::time_point now) {
  const std::lock_guard lock(mutex_);
  Record* ofUser = find(keyOf(address, user));
  Record* ofAddress = find(address);
  const auto time = std::max({now, ofUser ? ofUser->next : now, ofAddress ? ofAddress->next : now});
  if (time - now > longestWait) {
    return std::nullopt;
  }
  // Attempts side by side wait for one another.
  if (ofUser) {
    ofUser->next = time + delayOfUser(ofUser->failures);
  }
  if (ofAddress) {
    ofAddress->next = time + delayOfAddress(ofAddress->failures);
  }
  return time - now;
}

void LoginDelay::failed(const std::string& address, const std::string& user, Clock::time_point now) {
  const std::lock_guard lock(mutex_);
  count(keyOf(address, user), now, &delayOfUser);
  count(address, now, &delayOfAddress);
}

void LoginDelay::succeeded(const std::string& address, const std::string& user) {
  const std::lock_guard lock(mutex_);
  records_.erase(keyOf(address, user));
}

LoginDelay::Record* LoginDelay::find(const std::string& key) {
  const auto record = records_.find(key);
  return record == records_.end() ? nullptr : &record->second;
}

void LoginDelay::count(const std::string& key, Clock::time_point now, Clock::duration delay(unsigned failures)) {
  if (records_.size() >= mostRecords && !find(key)) {
    records_.erase(std::ranges::min_element(records_, {}, [](const auto& entry) { return entry.second.next; }));
  }
  Record& record = records_[key];
  ++record.failures;
  record.next = std::max(record.next, now + delay(record.failures));
}

}  // namespace Cimom::Http
