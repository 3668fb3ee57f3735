#include "agent/log/LogFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

namespace TWLog {

LogFile::~LogFile() { close(); }

int LogFile::append(std::string_view line) {
  const std::lock_guard lock(mutex_);
  if (const int error = openIfNeeded()) {
    return error;
  }
  while (!line.empty()) {
    const ssize_t written = ::write(descriptor_, line.data(), line.size());
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
  const bool current = descriptor_ >= 0 && ::fstat(descriptor_, &opened) == 0 && ::stat(path_.c_str(), &named) == 0 &&
                       opened.st_dev == named.st_dev && opened.st_ino == named.st_ino;
  if (current) {
    return 0;
  }
  close();
  // A FIFO without a reader would otherwise hold the object manager up for ever.
  descriptor_ = ::open(path_.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NOCTTY | O_NONBLOCK, 0640);
  return descriptor_ < 0 ? errno : 0;
}

void LogFile::close() {
  if (descriptor_ >= 0) {
    ::close(descriptor_);
  }
  descriptor_ = -1;
}

}  // namespace TWLog
