// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/PasswordFile.h"

#include <crypt.h>

#include <cerrno>
#include <cstring>
#include <fstream>
#include <memory>

#include "cimom/http/Listener.h"

namespace Cimom::Http {
namespace {

bool sameInConstantTime(const std::string& left, const std::string& right) {
  unsigned difference = left.size() == right.size() ? 0 : 1;
  for (std::size_t i = 0; i < left.size() && i < right.size(); ++i) {
    difference |= static_cast<unsigned>(left[i]) ^ static_cast<unsigned>(right[i]);
  }
  return difference == 0;
}

}  // namespace

PasswordFile::PasswordFile(const std::filesystem::path& file) {
  std::ifstream stream(file);
  if (!stream) {
    throw ServerError(file.string() + ": " + std::strerror(errno));
  }
  std::string line;
  for (unsigned number = 1; std::getline(stream, line); ++number) {
    if (line.empty() || line[0] == '#') {
      continue;
    }
    const auto colon = line.find(':');
    const std::string hash = colon == std::string::npos ? "" : line.substr(colon + 1);
    if (colon == 0 || crypt_checksalt(hash.c_str()) == CRYPT_SALT_INVALID) {
      throw ServerError(file.string() + ":" + std::to_string(number) +
                        ": expected \"user:hash\" with a hash of crypt(5)");
    }
    if (!hashes_.emplace(line.substr(0, colon), hash).second) {
      throw ServerError(file.string() + ":" + std::to_string(number) + ": duplicate user \"" + line.substr(0, colon) +
                        "\"");
    }
  }
  if (hashes_.empty()) {
    throw ServerError(file.string() + ": contains no users");
  }
}

bool PasswordFile::accepts(const std::string& user, const std::string& password) const {
  const auto known = hashes_.find(user);
  const std::string& hash = (known == hashes_.end() ? hashes_.begin() : known)->second;
  const auto data = std::make_unique<crypt_data>();
  const char* computed = crypt_r(password.c_str(), hash.c_str(), data.get());
  return computed && sameInConstantTime(computed, hash) && known != hashes_.end();
}

}  // namespace Cimom::Http
