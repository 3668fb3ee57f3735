// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/PasswordFile.h"

#include <crypt.h>

#include <algorithm>
#include <array>
#include <memory>
#include <sstream>
#include <string_view>

#include "cimom/http/Listener.h"
#include "ground/FileContent.h"

namespace Cimom::Http {
namespace {

bool sameInConstantTime(const std::string& left, const std::string& right) {
  unsigned difference = left.size() == right.size() ? 0 : 1;
  for (std::size_t i = 0; i < left.size() && i < right.size(); ++i) {
    difference |= static_cast<unsigned>(left[i]) ^ static_cast<unsigned>(right[i]);
  }
  return difference == 0;
}

// yescrypt, scrypt, bcrypt and the SHA-2 family of crypt(5).
bool isStrong(const std::string& hash) {
  constexpr std::array<std::string_view, 8> methods = {"$y$", "$gy$", "$7$", "$2a$", "$2b$", "$2y$", "$6$", "$5$"};
  return crypt_checksalt(hash.c_str()) != CRYPT_SALT_INVALID &&
         std::ranges::any_of(methods, [&](std::string_view method) { return hash.starts_with(method); });
}

// Empty for a hash that is none.
std::string compute(const std::string& password, const std::string& hash) {
  const auto data = std::make_unique<crypt_data>();
  const char* computed = crypt_r(password.c_str(), hash.c_str(), data.get());
  return computed && *computed != '*' ? computed : "";
}

// What of a hash says how long it takes: method and cost, "$6$rounds=9999" of "$6$rounds=9999$salt$hash". bcrypt has
// salt and hash in one field, scrypt the cost in the first characters of the salt's.
std::string costOf(const std::string& hash) {
  constexpr std::size_t scryptCost = sizeof "$7$CU..../...." - 1;
  if (hash.starts_with("$7$")) {
    return hash.substr(0, scryptCost);
  }
  const auto last = hash.rfind('$');
  return hash.substr(0, hash.starts_with("$2") ? last : hash.rfind('$', last - 1));
}

}  // namespace

PasswordFile::PasswordFile(const std::filesystem::path& file) {
  std::istringstream stream(Ground::readSecretFile(file));
  std::string line;
  for (unsigned number = 1; std::getline(stream, line); ++number) {
    if (line.empty() || line[0] == '#') {
      continue;
    }
    const auto fail = [&](const std::string& reason) {
      throw ServerError(file.string() + ":" + std::to_string(number) + ": " + reason);
    };
    const auto colon = line.find(':');
    const std::string hash = colon == std::string::npos ? "" : line.substr(colon + 1);
    if (colon == 0 || colon == std::string::npos) {
      fail("expected \"user:hash\" with a hash of crypt(5)");
    }
    if (!isStrong(hash)) {
      fail(
          "the password must be a hash of crypt(5) that is no longer guessed quickly, as openssl passwd -6 makes it; "
          "plain text, DES and $1$ are refused");
    }
    if (compute("", hash).size() != hash.size()) {
      fail("the hash is incomplete");
    }
    if (!hashes_.emplace(line.substr(0, colon), hash).second) {
      fail("duplicate user \"" + line.substr(0, colon) + "\"");
    }
    costliness_.emplace(costOf(hash), hash);
  }
  if (hashes_.empty()) {
    throw ServerError(file.string() + ": contains no users");
  }
}

bool PasswordFile::accepts(const std::string& user, const std::string& password) const {
  const auto known = hashes_.find(user);
  bool accepted = false;
  // One computation of each cost, so that the time says nothing of the user.
  for (const auto& [cost, any] : costliness_) {
    const bool isUsers = known != hashes_.end() && costOf(known->second) == cost;
    const std::string& hash = isUsers ? known->second : any;
    const bool same = sameInConstantTime(compute(password, hash), hash);
    accepted = accepted || (isUsers && same);
  }
  return accepted;
}

}  // namespace Cimom::Http
