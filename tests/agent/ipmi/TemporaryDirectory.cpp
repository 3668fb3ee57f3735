#include "agent/ipmi/TemporaryDirectory.h"

#include <stdlib.h>

#include <fstream>
#include <stdexcept>

namespace IpmiFixture {

namespace fs = std::filesystem;

TemporaryDirectory::TemporaryDirectory() {
  std::string path = fs::temp_directory_path() / "ipmi-test-XXXXXX";
  if (!::mkdtemp(path.data())) throw std::runtime_error("no temporary directory");
  path_ = path;
}

TemporaryDirectory::~TemporaryDirectory() {
  std::error_code ignored;
  fs::remove_all(path_, ignored);
}

void writeFile(const fs::path& path, const std::string& content, fs::perms permissions) {
  std::ofstream(path) << content;
  fs::permissions(path, permissions);
}

}  // namespace IpmiFixture
