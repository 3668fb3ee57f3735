// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <map>
#include <string>

namespace Cimom::Http {

// Users and the hashes of their passwords: lines `user:hash` with a hash of crypt(5), as `openssl passwd -6` and
// `mkpasswd` make them. Empty lines and lines that begin with `#` mean nothing.
class PasswordFile {
 public:
  // Throws std::runtime_error "FILE:LINE: what is wrong", or "FILE: …" for a file that cannot be read or that others
  // than its owner can. A password that stands there as it is, and hashes that are guessed too quickly, are refused.
  explicit PasswordFile(const std::filesystem::path& file);

  // Whether the password is that user's. Takes as long for every user, also for one that is not there.
  bool accepts(const std::string& user, const std::string& password) const;

 private:
  std::map<std::string, std::string> hashes_;      // by user
  std::map<std::string, std::string> costliness_;  // a hash for each method and cost that there is
};

}  // namespace Cimom::Http
