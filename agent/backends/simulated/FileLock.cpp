// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/simulated/FileLock.h"

#include <sys/file.h>

#include <atomic>
#include <cerrno>
#include <cstring>
#include <stdexcept>
#include <thread>

namespace QV {
namespace {

using Clock = std::chrono::steady_clock;

constexpr std::chrono::milliseconds pollInterval{1};
// A process that writes without a pause lets others in: whoever waits looks at least once before it comes back.
constexpr std::chrono::milliseconds pause = 3 * pollInterval;

std::atomic<Clock::duration> lastLetGo{-pause};

}  // namespace

FileLock::FileLock(const std::string& path, std::chrono::milliseconds timeout)
    : file_(path, O_RDWR | O_CREAT | O_NOFOLLOW, 0660) {
  if (!file_.isOpen()) {
    throw std::runtime_error("the lock " + path + " cannot be opened: " + std::strerror(errno));
  }
  const auto deadline = Clock::now() + timeout;
  std::this_thread::sleep_until(Clock::time_point(lastLetGo) + pause);
  // flock alone would wait for ever on a holder that was stopped.
  while (::flock(file_.number(), LOCK_EX | LOCK_NB) != 0) {
    const int error = errno;
    const bool late = Clock::now() >= deadline;
    if (error != EINTR && (error != EWOULDBLOCK || late)) {
      throw std::runtime_error(
          "the lock " + path +
          (late ? " is still held by another process after " + std::to_string(timeout.count()) + " ms"
                : std::string(" failed: ") + std::strerror(error)));
    }
    std::this_thread::sleep_for(pollInterval);
  }
}

FileLock::~FileLock() { lastLetGo = Clock::now().time_since_epoch(); }

}  // namespace QV
