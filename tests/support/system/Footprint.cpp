// SPDX-License-Identifier: Apache-2.0
#include "tests/support/system/Footprint.h"

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <sstream>
#include <utility>

#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

std::string entryOf(pid_t process, const char* name) { return "/proc/" + std::to_string(process) + '/' + name; }

long kibOf(pid_t process, const char* row) {
  std::istringstream status(readFile(entryOf(process, "status")));
  for (std::string word; status >> word;) {
    long size = 0;
    if (word == row && status >> size) {
      return size;
    }
  }
  return 0;
}

std::vector<std::string> openNow(pid_t process) {
  std::vector<std::string> targets;
  std::error_code gone;  // one that is closed while this looks
  for (const auto& entry : std::filesystem::directory_iterator(entryOf(process, "fd"), gone)) {
    const std::string target = std::filesystem::read_symlink(entry.path(), gone).string();
    // "socket:[4711]": which one it is does not matter.
    targets.push_back(target.substr(0, target.find(":[")));
  }
  std::ranges::sort(targets);
  return targets;
}

}  // namespace

long residentKib(pid_t process) { return kibOf(process, "VmRSS:"); }

long peakResidentKib(pid_t process) { return kibOf(process, "VmHWM:"); }

std::vector<std::string> descriptorsOf(pid_t process) {
  // UndefinedBehaviorSanitizer opens a pipe for a moment, to see whether memory can be read: what holds still is meant.
  using Clock = std::chrono::steady_clock;
  std::vector<std::string> open = openNow(process);
  Clock::time_point since = Clock::now();
  poll(
      [&] {
        if (std::vector<std::string> now = openNow(process); now != open) {
          open = std::move(now);
          since = Clock::now();
        }
        return Clock::now() - since > std::chrono::milliseconds(200);
      },
      std::chrono::seconds(10));
  return open;
}

std::size_t configured(const char* variable, std::size_t otherwise) {
  const char* text = std::getenv(variable);
  return text ? std::stoul(text) : otherwise;
}

}  // namespace Testing
