#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

// tools/demonstrate in a build directory of its own, which lends it the built files.
class DemonstrationTest : public testing::Test {
 protected:
  DemonstrationTest();

  Completed demonstrate(const std::vector<std::string>& arguments) const;

  // The same, for a test that runs it in its own way.
  std::vector<std::string> command(const std::vector<std::string>& arguments) const;
  Environment environment() const;

  // That what it started has ended and what it wrote outside the build directory is gone.
  void expectNothingLeft() const;
  void expectNoProcessLeft() const;

  const std::filesystem::path& build() const { return directory_.path(); }

 private:
  std::filesystem::path temporary() const { return build() / "temporary files"; }

  TemporaryDirectory directory_;
};

}  // namespace Testing
