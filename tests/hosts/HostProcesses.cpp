// SPDX-License-Identifier: Apache-2.0
#include "tests/hosts/HostProcesses.h"

#include <algorithm>
#include <filesystem>
#include <functional>

#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

namespace fs = std::filesystem;

std::vector<pid_t> processesThat(const std::function<bool(const fs::path& directory)>& condition) {
  std::vector<pid_t> found;
  for (const auto& entry : fs::directory_iterator("/proc")) {
    const std::string name = entry.path().filename().string();
    if (name.find_first_not_of("0123456789") != std::string::npos) {
      continue;
    }
    if (condition(entry.path())) {
      found.push_back(std::stoi(name));
    }
  }
  std::sort(found.begin(), found.end());
  return found;
}

}  // namespace

std::vector<pid_t> processesMapping(const std::string& part) {
  return processesThat([&](const fs::path& directory) {
    return readFile((directory / "maps").string()).find(part) != std::string::npos;
  });
}

std::vector<pid_t> processesRunning(const std::vector<std::string>& programs) {
  return processesThat([&](const fs::path& directory) {
    std::error_code ended;
    const std::string program = fs::read_symlink(directory / "exe", ended).string();
    return std::find(programs.begin(), programs.end(), program) != programs.end();
  });
}

}  // namespace Testing
