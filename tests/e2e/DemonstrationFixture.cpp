// SPDX-License-Identifier: Apache-2.0
#include "tests/e2e/DemonstrationFixture.h"

#include "Paths.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"

namespace Testing {
namespace {

namespace fs = std::filesystem;

// The command lines of the processes whose environment names the directory: what was started with it, and all that
// these have started.
std::vector<std::string> processesOf(const fs::path& directory) {
  std::vector<std::string> found;
  for (const auto& entry : fs::directory_iterator("/proc")) {
    if (entry.path().filename().string().find_first_not_of("0123456789") != std::string::npos) {
      continue;
    }
    if (contentOf(entry.path() / "environ").find(directory.string()) != std::string::npos) {
      found.push_back(contentOf(entry.path() / "cmdline"));
    }
  }
  return found;
}

}  // namespace

DemonstrationTest::DemonstrationTest() {
  for (const char* part : {"bin", "lib", "share"}) {
    fs::create_directory_symlink(built(part), build() / part);
  }
  fs::create_directory(temporary());
}

std::vector<std::string> DemonstrationTest::command(const std::vector<std::string>& arguments) const {
  std::vector<std::string> command = {SOURCE_DIR "/tools/demonstrate"};
  command.insert(command.end(), arguments.begin(), arguments.end());
  command.push_back(build().string());
  return command;
}

Environment DemonstrationTest::environment() const { return {{"TMPDIR", temporary().string()}}; }

Completed DemonstrationTest::demonstrate(const std::vector<std::string>& arguments) const {
  return run(command(arguments), environment());
}

void DemonstrationTest::expectNothingLeft() const {
  EXPECT_TRUE(fs::is_empty(temporary()));
  expectNoProcessLeft();
}

void DemonstrationTest::expectNoProcessLeft() const {
  // What was told to end may be on its way out.
  poll([this] { return processesOf(temporary()).empty(); }, std::chrono::seconds(5));
  EXPECT_EQ(processesOf(temporary()), std::vector<std::string>());
}

}  // namespace Testing
