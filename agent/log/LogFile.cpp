// SPDX-License-Identifier: Apache-2.0
#include "agent/log/LogFile.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

namespace TWLog {

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

int LogFile::openIfNeeded() {
  struct stat opened {};
  struct stat named {};
  const bool current = file_.isOpen() && ::fstat(file_.number(), &opened) == 0 && ::stat(path_.c_str(), &named) == 0 &&
                       opened.st_dev == named.st_dev && opened.st_ino == named.st_ino;
  if (current) {
    return 0;
  }
  // A FIFO without a reader would otherwise hold the object manager up for ever.
  file_ = Ground::Descriptor(path_, O_WRONLY | O_APPEND | O_CREAT | O_NOCTTY | O_NONBLOCK, 0640);
  return file_.isOpen() ? 0 : errno;
}

}  // namespace TWLog
