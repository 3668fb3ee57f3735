// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/OpenEnumerations.h"

#include <sys/random.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <numeric>
#include <utility>

#include "cimom/cimxml/Errors.h"

namespace Cimom::CimXml {
namespace {

[[noreturn]] void refuseContext() {
  throw OperationError(
      cimInvalidEnumerationContext,
      "the enumeration context is unknown: it was read to its end, closed, timed out, is being read by "
      "another request or belongs to another kind of operation");
}

std::string newContext() {
  std::array<unsigned char, 16> random{};
  if (getrandom(random.data(), random.size(), 0) != static_cast<ssize_t>(random.size())) {
    throw OperationError(CMPI_RC_ERR_FAILED, "cannot make an enumeration context: no random numbers");
  }
  std::string name;
  for (const unsigned char byte : random) {
    constexpr std::string_view digits = "0123456789abcdef";
    name += {digits[byte >> 4U], digits[byte & 0xFU]};
  }
  return name;
}

}  // namespace

std::size_t OpenEnumeration::bytes() const {
  return std::accumulate(
      items.begin() + static_cast<std::ptrdiff_t>(next), items.end(), std::size_t{0},
      [](std::size_t sum, const std::string& text) { return sum + sizeof(std::string) + text.capacity(); });
}

std::string OpenEnumerations::add(OpenEnumeration enumeration) {
  std::string context = newContext();
  const std::size_t bytes = enumeration.bytes();
  const std::lock_guard lock(mutex_);
  dropExpired();
  const auto ofUser = static_cast<std::size_t>(std::ranges::count_if(
      entries_, [&](const auto& entry) { return entry.second.enumeration.user == enumeration.user; }));
  if (entries_.size() >= maxCount || ofUser >= maxCountOfUser || bytes > maxBytes - bytes_) {
    throw OperationError(cimServerLimitsExceeded,
                         "too many enumerations are open: read them to their end or close them");
  }
  insert(context, std::move(enumeration), bytes);
  return context;
}

OpenEnumeration OpenEnumerations::take(const std::string& context, std::string_view user, PulledItem item) {
  const std::lock_guard lock(mutex_);
  const auto entry = find(context, user);
  if (entry->second.enumeration.item != item) {
    refuseContext();
  }
  OpenEnumeration enumeration = std::move(entry->second.enumeration);
  erase(entry);
  return enumeration;
}

void OpenEnumerations::putBack(const std::string& context, OpenEnumeration enumeration) {
  const std::size_t bytes = enumeration.bytes();
  const std::lock_guard lock(mutex_);
  insert(context, std::move(enumeration), bytes);
}

std::size_t OpenEnumerations::count(const std::string& context, std::string_view user) {
  const std::lock_guard lock(mutex_);
  return find(context, user)->second.enumeration.left();
}

void OpenEnumerations::close(const std::string& context, std::string_view user) {
  const std::lock_guard lock(mutex_);
  erase(find(context, user));
}

void OpenEnumerations::insert(const std::string& context, OpenEnumeration enumeration, std::size_t bytes) {
  const auto expires = now_() + enumeration.timeout;
  entries_.emplace(context, Entry{std::move(enumeration), expires, bytes});
  bytes_ += bytes;
}

OpenEnumerations::Entries::iterator OpenEnumerations::find(const std::string& context, std::string_view user) {
  dropExpired();
  const auto entry = entries_.find(context);
  if (entry == entries_.end() || entry->second.enumeration.user != user) {
    refuseContext();
  }
  return entry;
}

void OpenEnumerations::erase(Entries::iterator entry) {
  bytes_ -= entry->second.bytes;
  entries_.erase(entry);
}

void OpenEnumerations::dropExpired() {
  const auto now = now_();
  for (auto entry = entries_.begin(); entry != entries_.end();) {
    const auto next = std::next(entry);
    if (entry->second.expires < now) {
      erase(entry);
    }
    entry = next;
  }
}

}  // namespace Cimom::CimXml
