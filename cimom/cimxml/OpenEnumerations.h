// SPDX-License-Identifier: Apache-2.0
// What clients have opened with the pulled operations and not read to its end (DSP0200, 5.3.2.24).
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

namespace Cimom::CimXml {

// Which of the pull operations an enumeration is read with.
enum class PulledItem { InstanceWithPath, InstancePath };

// The rest of a result: its items as XML, in order. A client that stays away for longer than `timeout` loses it.
struct OpenEnumeration {
  PulledItem item = PulledItem::InstanceWithPath;
  std::string user;  // who opened it; nobody else may read it
  std::vector<std::string> items;
  std::size_t next = 0;  // index of the first one that has not been sent
  std::chrono::seconds timeout{};

  std::size_t left() const { return items.size() - next; }
  std::size_t bytes() const;
};

// All open enumerations of a server. They are bounded in number and in bytes, and live as long as the server at most.
// May be used by several threads at once.
class OpenEnumerations {
 public:
  using Clock = std::function<std::chrono::steady_clock::time_point()>;

  static constexpr std::size_t maxCount = 256;
  static constexpr std::size_t maxCountOfUser = 64;
  static constexpr std::size_t maxBytes = std::size_t{64} << 20U;

  explicit OpenEnumerations(Clock now = &std::chrono::steady_clock::now) : now_(std::move(now)) {}

  // Keeps an enumeration and returns its context: a name that nobody can guess.
  // Throws OperationError CIM_ERR_SERVER_LIMITS_EXCEEDED if that is one too many; nothing else is lost then.
  std::string add(OpenEnumeration enumeration);

  // Takes an enumeration out, to be read from. While it is out, nobody else can read it.
  // Throws OperationError CIM_ERR_INVALID_ENUMERATION_CONTEXT for a context that is unknown, timed out, another user's
  // or, in that case left where it is, of another item.
  OpenEnumeration take(const std::string& context, std::string_view user, PulledItem item);

  // Puts one back under its context; its time starts anew.
  void putBack(const std::string& context, OpenEnumeration enumeration);

  // How many items an enumeration has left, whatever they are.
  // Throws as take() does.
  std::size_t count(const std::string& context, std::string_view user);

  // Forgets an enumeration, whatever its items are.
  // Throws as take() does.
  void close(const std::string& context, std::string_view user);

 private:
  struct Entry {
    OpenEnumeration enumeration;
    std::chrono::steady_clock::time_point expires;
    std::size_t bytes;
  };
  using Entries = std::map<std::string, Entry, std::less<>>;

  // With the lock held.
  void insert(const std::string& context, OpenEnumeration enumeration, std::size_t bytes);
  Entries::iterator find(const std::string& context, std::string_view user);
  void erase(Entries::iterator entry);
  void dropExpired();

  Clock now_;
  std::mutex mutex_;
  Entries entries_;
  std::size_t bytes_ = 0;
};

}  // namespace Cimom::CimXml
