// Files as secrets are kept in.
#pragma once

#include <filesystem>
#include <string>

#include "tests/support/TemporaryDirectory.h"

namespace IpmiFixture {

constexpr auto ownerOnly = std::filesystem::perms::owner_read | std::filesystem::perms::owner_write;

// A file that only its owner can read and write.
inline void writePrivateFile(const std::string& path, const std::string& text) {
  Testing::writeFile(path, text);
  std::filesystem::permissions(path, ownerOnly);
}

}  // namespace IpmiFixture
