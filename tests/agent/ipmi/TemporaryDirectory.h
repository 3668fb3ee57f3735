// Files of a test's own.
#pragma once

#include <filesystem>
#include <string>

namespace IpmiFixture {

// Gone with the object.
class TemporaryDirectory {
 public:
  TemporaryDirectory();
  ~TemporaryDirectory();
  TemporaryDirectory(const TemporaryDirectory&) = delete;
  TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;
  const std::filesystem::path& path() const { return path_; }

 private:
  std::filesystem::path path_;
};

constexpr auto ownerOnly = std::filesystem::perms::owner_read | std::filesystem::perms::owner_write;

void writeFile(const std::filesystem::path& path, const std::string& content, std::filesystem::perms permissions);

}  // namespace IpmiFixture
