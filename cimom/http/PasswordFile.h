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
  // Throws ServerError "FILE:LINE: what is wrong", or "FILE: …" for a file that cannot be read.
  explicit PasswordFile(const std::filesystem::path& file);

  // Whether the password is that user's. Takes as long for a user that is not there.
  bool accepts(const std::string& user, const std::string& password) const;

 private:
  std::map<std::string, std::string> hashes_;
};

}  // namespace Cimom::Http
