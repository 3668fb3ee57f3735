// SPDX-License-Identifier: Apache-2.0
#include "agent/log/LogFile.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <ctime>

namespace TWLog {
namespace {

// A clock that costs no system call, to a few milliseconds.
std::chrono::nanoseconds now() {
  timespec time{};
  ::clock_gettime(CLOCK_MONOTONIC_COARSE, &time);
  return std::chrono::seconds(time.tv_sec) + std::chrono::nanoseconds(time.tv_nsec);
}

}  // namespace

int LogFile::append(std::string_view line) {
  const std::lock_guard lock(mutex_);
  if (const int error = openIfNeeded()) {
    return error;
  }
  while (!line.empty()) {
    const ssize_t written = ::write(file_.number(), line.data(), line.size());
    if (written < 0 && errno == EINTR) {
      continue;
    }
    if (written < 0) {
      return errno;
    }
    line.remove_prefix(static_cast<std::size_t>(written));
  }
  return 0;
}

bool LogFile::isCurrent() const {
  struct stat named {};
  return file_.isOpen() && ::stat(path_.c_str(), &named) == 0 && named.st_dev == device_ && named.st_ino == inode_;
}

int LogFile::openIfNeeded() {
  const auto present = now();
  if (file_.isOpen() && present - lookedAt_ < lookInterval) {
    return 0;
  }
  lookedAt_ = present;
  if (isCurrent()) {
    return 0;
  }
  // A FIFO without a reader would otherwise hold the object manager up for ever.
  file_ = Ground::Descriptor(path_, O_WRONLY | O_APPEND | O_CREAT | O_NOCTTY | O_NONBLOCK, 0640);
  struct stat opened {};
  if (!file_.isOpen() || ::fstat(file_.number(), &opened) != 0) {
    return errno;
  }
  device_ = opened.st_dev;
  inode_ = opened.st_ino;
  return 0;
}

}  // namespace TWLog
