// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/SecretFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstring>

#include "cimom/http/Listener.h"
#include "ground/Descriptor.h"

namespace Cimom::Http {
namespace {

constexpr std::size_t blockSize = 4096;

[[noreturn]] void fail(const std::filesystem::path& file, const std::string& reason) {
  throw ServerError(file.string() + ": " + reason);
}

std::string read(const std::filesystem::path& file, mode_t refused) {
  const Ground::Descriptor descriptor(file, O_RDONLY | O_NONBLOCK);
  struct stat status {};
  if (!descriptor.isOpen() || ::fstat(descriptor.number(), &status) != 0) {
    fail(file, std::strerror(errno));
  }
  if (!S_ISREG(status.st_mode)) {
    fail(file, S_ISDIR(status.st_mode) ? "is a directory" : "must be a regular file");
  }
  if ((status.st_mode & refused) != 0) {
    fail(file, "is open to others than its owner: chmod 600 it");
  }
  std::string content;
  std::array<char, blockSize> block{};
  ssize_t size = 0;
  while ((size = ::read(descriptor.number(), block.data(), block.size())) > 0) {
    content.append(block.data(), static_cast<std::size_t>(size));
  }
  if (size < 0) {
    fail(file, std::strerror(errno));
  }
  if (content.empty()) {
    fail(file, "is empty");
  }
  return content;
}

}  // namespace

std::string readFile(const std::filesystem::path& file) { return read(file, 0); }

std::string readSecretFile(const std::filesystem::path& file) { return read(file, S_IRWXG | S_IRWXO); }

}  // namespace Cimom::Http
