#ifndef TESTS_CIMOM_SUPPORT_TEMPORARYDIRECTORY_H_
#define TESTS_CIMOM_SUPPORT_TEMPORARYDIRECTORY_H_

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Cimom::Test {

/// A fresh directory that goes with the test.
class TemporaryDirectory {
 public:
  TemporaryDirectory() {
    std::string name = (std::filesystem::temp_directory_path() / "cimom-test-XXXXXX").string();
    if (!mkdtemp(name.data())) throw std::runtime_error("no temporary directory");
    path_ = name;
  }
  ~TemporaryDirectory() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }
  TemporaryDirectory(const TemporaryDirectory&) = delete;
  TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

  const std::filesystem::path& path() const { return path_; }

  /// Writes a file below the directory and gives its path.
  std::filesystem::path write(const std::string& name, std::string_view text) const {
    const auto file = path_ / name;
    std::filesystem::create_directories(file.parent_path());
    std::ofstream(file) << text;
    return file;
  }

 private:
  std::filesystem::path path_;
};

}  // namespace Cimom::Test

#endif  // TESTS_CIMOM_SUPPORT_TEMPORARYDIRECTORY_H_
