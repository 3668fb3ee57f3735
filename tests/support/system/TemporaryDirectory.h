// SPDX-License-Identifier: Apache-2.0
// A fresh directory for one test, removed with all that is in it, and files in it.
#pragma once

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <string_view>
#include <system_error>

namespace Testing {

class TemporaryDirectory {
 public:
  TemporaryDirectory() {
    std::string name = (std::filesystem::temp_directory_path() / "ipconfig-test-XXXXXX").string();
    if (!::mkdtemp(name.data())) {
      throw std::system_error(errno, std::generic_category(), "mkdtemp " + name);
    }
    path_ = name;
  }
  ~TemporaryDirectory() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }
  TemporaryDirectory(const TemporaryDirectory&) = delete;
  TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

  const std::filesystem::path& path() const { return path_; }
  std::string operator/(const std::string& name) const { return (path_ / name).string(); }

  // Writes a file below the directory and returns its path.
  std::filesystem::path write(const std::string& name, std::string_view text) const {
    const std::filesystem::path file = path_ / name;
    std::filesystem::create_directories(file.parent_path());
    std::ofstream(file, std::ios::binary | std::ios::trunc) << text;
    return file;
  }

 private:
  std::filesystem::path path_;
};

inline void writeFile(const std::string& path, const std::string& text) {
  std::ofstream(path, std::ios::binary | std::ios::trunc) << text;
}

inline constexpr auto ownerOnly = std::filesystem::perms::owner_read | std::filesystem::perms::owner_write;

// A file that only its owner can read and write.
inline void writePrivateFile(const std::string& path, const std::string& text) {
  writeFile(path, text);
  std::filesystem::permissions(path, ownerOnly);
}

// The file's text; empty if there is no file.
inline std::string readFile(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), {}};
}

}  // namespace Testing
