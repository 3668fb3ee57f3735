// SPDX-License-Identifier: Apache-2.0
#include "ground/FileContent.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <stdexcept>
#include <system_error>

#include "ground/Descriptor.h"

namespace Ground {
namespace {

constexpr std::size_t blockSize = 4096;
constexpr mode_t others = S_IRWXG | S_IRWXO;

[[noreturn]] void fail(const std::filesystem::path& file, const std::string& reason) {
  throw std::runtime_error(file.string() + ": " + reason);
}

[[noreturn]] void failWithErrno(const std::filesystem::path& file) {
  fail(file, "cannot be read: " + std::generic_category().message(errno));
}

// A file whose reader would have to wait for its writer is not waited for.
Descriptor open(const std::filesystem::path& file, mode_t refused) {
  Descriptor descriptor(file, O_RDONLY | O_NONBLOCK);
  struct stat status {};
  if (!descriptor.isOpen() || ::fstat(descriptor.number(), &status) != 0) {
    failWithErrno(file);
  }
  if (!S_ISREG(status.st_mode)) {
    fail(file, S_ISDIR(status.st_mode) ? "is a directory" : "must be a regular file");
  }
  if ((status.st_mode & refused) != 0) {
    fail(file, "is open to others than its owner: chmod 600 it");
  }
  return descriptor;
}

std::string read(const std::filesystem::path& file, mode_t refused) {
  const Descriptor descriptor = open(file, refused);
  std::string content;
  std::array<char, blockSize> block{};
  ssize_t size = 0;
  while ((size = ::read(descriptor.number(), block.data(), block.size())) > 0) {
    content.append(block.data(), static_cast<std::size_t>(size));
  }
  if (size < 0) {
    failWithErrno(file);
  }
  if (content.empty()) {
    fail(file, "is empty");
  }
  return content;
}

}  // namespace

std::string readFile(const std::filesystem::path& file) { return read(file, 0); }

std::string readSecretFile(const std::filesystem::path& file) { return read(file, others); }

void requireSecretFile(const std::filesystem::path& file) { open(file, others); }

}  // namespace Ground
