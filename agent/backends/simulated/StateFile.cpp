// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/simulated/StateFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstring>
#include <ctime>
#include <stdexcept>
#include <string_view>
#include <tuple>

#include "agent/backends/simulated/FileLock.h"
#include "ground/Descriptor.h"

namespace QV {
namespace {

namespace fs = std::filesystem;

// An exchange with a processor ends within five seconds, a simulated one too.
constexpr std::chrono::milliseconds lockTimeout{4000};

[[noreturn]] void fail(const fs::path& path, const char* what) {
  throw std::runtime_error(path.string() + ": " + what + ": " + std::strerror(errno));
}

fs::path followLinks(fs::path path) {
  constexpr int mostLinks = 40;  // the kernel's own limit
  // A directory that may not be entered shows when the file is used, in words of ours.
  std::error_code hidden;
  for (int links = 0; fs::is_symlink(path, hidden); ++links) {
    if (links == mostLinks) {
      throw std::runtime_error(path.string() + ": too many symbolic links");
    }
    path = path.parent_path() / fs::read_symlink(path);
  }
  return path;
}

fs::path withSuffix(const fs::path& path, const char* suffix) { return path.string() + suffix; }

std::optional<std::string> readAll(const fs::path& path) {
  const Ground::Descriptor file(path, O_RDONLY);
  if (!file.isOpen()) {
    if (errno == ENOENT) {
      return std::nullopt;
    }
    fail(path, "cannot be opened");
  }
  std::string text;
  char block[4096];
  for (;;) {
    const ssize_t count = ::read(file.number(), block, sizeof block);
    if (count == 0) {
      return text;
    }
    if (count > 0) {
      text.append(block, static_cast<std::size_t>(count));
    } else if (errno != EINTR) {
      fail(path, "cannot be read");
    }
  }
}

void writeAll(const Ground::Descriptor& file, const fs::path& path, std::string_view text) {
  while (!text.empty()) {
    const ssize_t count = ::write(file.number(), text.data(), text.size());
    if (count > 0) {
      text.remove_prefix(static_cast<std::size_t>(count));
    } else if (errno != EINTR) {
      fail(path, "cannot be written");
    }
  }
}

// A writer without the right to give files away still keeps the state; only then does the owner change to it.
void keepModeAndOwner(const Ground::Descriptor& file, const fs::path& path, const struct stat& original) {
  if (::fchown(file.number(), original.st_uid, original.st_gid) != 0 && errno != EPERM) {
    fail(path, "cannot be given its owner");
  }
  if (::fchmod(file.number(), original.st_mode & 07777) != 0) {
    fail(path, "cannot be given its mode");
  }
}

// Called under the lock, so the new file's name can be fixed: one that is there is a killed writer's.
void replace(const fs::path& target, std::string_view text) {
  const fs::path fresh = withSuffix(target, ".new");
  ::unlink(fresh.c_str());
  try {
    const Ground::Descriptor file(fresh, O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW, 0640);
    if (!file.isOpen()) {
      fail(fresh, "cannot be created");
    }
    struct stat original {};
    if (::stat(target.c_str(), &original) == 0) {
      keepModeAndOwner(file, fresh, original);
    }
    writeAll(file, fresh, text);
    if (::fsync(file.number()) != 0) {
      fail(fresh, "cannot be brought to the disk");
    }
    if (::rename(fresh.c_str(), target.c_str()) != 0) {
      fail(target, "cannot be replaced");
    }
  } catch (...) {
    ::unlink(fresh.c_str());
    throw;
  }
  const Ground::Descriptor directory(target.parent_path(), O_RDONLY | O_DIRECTORY);
  if (!directory.isOpen() || ::fsync(directory.number()) != 0) {
    fail(target, "is replaced, but a power cut may bring the earlier one back: its name cannot be brought to the disk");
  }
}

fs::path lockOf(const fs::path& target) { return withSuffix(target, ".lock"); }

void makeDirectoryOf(const fs::path& target) {
  std::error_code failure;
  fs::create_directories(target.parent_path(), failure);
  if (failure) {
    throw std::runtime_error(target.parent_path().string() + ": cannot be created: " + failure.message());
  }
}

// The rights of this process, which may differ from those of who started it.
void requireAccess(const fs::path& path, int mode, const char* what) {
  if (::faccessat(AT_FDCWD, path.c_str(), mode, AT_EACCESS) != 0) {
    fail(path, what);
  }
}

}  // namespace

void StateFile::requireWritable() const {
  const fs::path target = followLinks(path_);
  makeDirectoryOf(target);
  requireAccess(target.parent_path(), W_OK | X_OK, "cannot be written");
  for (const auto& [file, mode, what] :
       {std::tuple(target, R_OK, "cannot be read"), std::tuple(lockOf(target), R_OK | W_OK, "cannot be opened")}) {
    std::error_code hidden;
    if (fs::exists(file, hidden)) {
      requireAccess(file, mode, what);
    }
  }
}

std::optional<std::string> StateFile::read() const { return readAll(followLinks(path_)); }

std::optional<StateFile::Version> StateFile::version() const {
  constexpr std::chrono::milliseconds coarse{50};
  const auto duration = [](const timespec& time) {
    return std::chrono::seconds(time.tv_sec) + std::chrono::nanoseconds(time.tv_nsec);
  };
  struct stat status {};
  timespec now{};
  if (::stat(path_.c_str(), &status) != 0 || ::clock_gettime(CLOCK_REALTIME_COARSE, &now) != 0) {
    return std::nullopt;
  }
  const Version version{status.st_dev, status.st_ino, status.st_size, duration(status.st_ctim)};
  return duration(now) - version.changedAt > coarse ? std::optional(version) : std::nullopt;
}

void StateFile::update(const std::function<std::string(const std::optional<std::string>&)>& edit) const {
  const fs::path target = followLinks(path_);
  makeDirectoryOf(target);
  const FileLock lock(lockOf(target), lockTimeout);
  const std::optional<std::string> current = readAll(target);
  // Those who find no file at the same time each come here: one of them writes it, for the others it is there.
  if (const std::string text = edit(current); text != current) {
    replace(target, text);
  }
}

}  // namespace QV
