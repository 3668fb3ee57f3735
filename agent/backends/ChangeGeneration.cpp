// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ChangeGeneration.h"

#include <sys/stat.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <optional>
#include <random>
#include <stdexcept>
#include <string>

#include "ground/Descriptor.h"

namespace QV {
namespace {

namespace fs = std::filesystem;
using Number = ChangeGeneration::Number;

[[noreturn]] void fail(const fs::path& path, const std::string& reason) {
  throw std::runtime_error(path.string() + ": " + reason);
}

[[noreturn]] void failWithErrno(const fs::path& path, const char* what) {
  fail(path, std::string(what) + ": " + std::strerror(errno));
}

constexpr mode_t ownerAndGroup = 0660;

// Without O_NONBLOCK a FIFO could hold the caller up for ever. It is opened for writing even if it is only read, so
// that a process which cannot tell the others of a change learns that before there is one.
Ground::Descriptor openFile(const fs::path& path) {
  constexpr int flags = O_RDWR | O_CREAT | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY;
  Ground::Descriptor file(path, flags, ownerAndGroup);
  if (!file.isOpen() && errno == ENOENT) {
    std::error_code failure;
    fs::create_directories(path.parent_path(), failure);
    if (failure) {
      fail(path.parent_path(), "cannot be created: " + failure.message());
    }
    return {path, flags, ownerAndGroup};
  }
  return file;
}

Ground::Descriptor openRegular(const fs::path& path) {
  Ground::Descriptor file = openFile(path);
  struct stat status {};
  if (!file.isOpen() || ::fstat(file.number(), &status) != 0) {
    failWithErrno(path, errno == ELOOP ? "is a symbolic link" : "cannot be opened");
  }
  if (!S_ISREG(status.st_mode)) {
    fail(path, "is not a regular file");
  }
  if (status.st_nlink > 1) {
    fail(path, "has another name too, a hard link: what would be written might be somebody else's file");
  }
  if (status.st_size == 0) {
    // The umask of its maker must not shut out the group's other users. Only its owner may do this, and need.
    ::fchmod(file.number(), ownerAndGroup);
  }
  return file;
}

// Nothing if the file is empty, which is how it comes into being. What has any other size belongs to somebody else.
std::optional<Number> read(const Ground::Descriptor& file, const fs::path& path) {
  std::array<unsigned char, sizeof(Number) + 1> bytes{};
  const ssize_t length = ::pread(file.number(), bytes.data(), bytes.size(), 0);
  if (length < 0) {
    failWithErrno(path, "cannot be read");
  }
  if (length == 0) {
    return std::nullopt;
  }
  if (length != sizeof(Number)) {
    fail(path, "is not a generation file: it must have " + std::to_string(sizeof(Number)) + " bytes");
  }
  Number number = 0;
  std::memcpy(&number, bytes.data(), sizeof number);
  return number;
}

// Drawn at random, not counted: two processes that renew it at once cannot meet at one number, and a file that was
// removed and made again does not start over at numbers that somebody has seen.
Number write(const Ground::Descriptor& file, const fs::path& path) {
  std::random_device random;
  const Number number = Number{random()} << 32 | random();
  const ssize_t length = ::pwrite(file.number(), &number, sizeof number, 0);
  if (length < 0) {
    failWithErrno(path, "cannot be written");
  }
  if (length != sizeof number) {
    fail(path, "cannot be written as a whole");
  }
  return number;
}

}  // namespace

Number ChangeGeneration::current() const {
  const Ground::Descriptor file = openRegular(file_);
  const auto number = read(file, file_);
  return number ? *number : write(file, file_);
}

void ChangeGeneration::renew() const {
  const Ground::Descriptor file = openRegular(file_);
  read(file, file_);
  write(file, file_);
}

}  // namespace QV
