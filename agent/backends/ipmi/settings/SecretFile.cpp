// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/settings/SecretFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <stdexcept>
#include <system_error>

#include "ground/Descriptor.h"

namespace QV::Ipmi {
namespace {

[[noreturn]] void failWithErrno(const std::string& path) {
  throw std::runtime_error(path + " cannot be read: " + std::generic_category().message(errno));
}

}  // namespace

std::string readSecretFile(const std::string& path) {
  const Ground::Descriptor file(path, O_RDONLY | O_NONBLOCK);
  struct stat status {};
  if (!file.isOpen() || ::fstat(file.number(), &status) != 0) {
    failWithErrno(path);
  }
  if (!S_ISREG(status.st_mode)) {
    throw std::runtime_error(path + " must be a regular file");
  }
  if ((status.st_mode & (S_IRWXG | S_IRWXO)) != 0) {
    throw std::runtime_error(path + " is open to others than its owner: chmod 600 it");
  }
  // No secret of IPMI is longer than a fraction of this.
  std::array<char, 256> content;
  const ssize_t length = ::read(file.number(), content.data(), content.size());
  if (length < 0) {
    failWithErrno(path);
  }
  const std::string text(content.data(), static_cast<std::size_t>(length));
  const std::string line = text.substr(0, text.find_first_of("\r\n"));
  if (line.empty()) {
    throw std::runtime_error(path + " is empty: its first line must hold the secret");
  }
  return line;
}

}  // namespace QV::Ipmi
