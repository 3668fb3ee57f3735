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

  Completed demonstrate(std::vector<std::string> arguments) const;

  // That what it started has ended and what it wrote outside the build directory is gone.
  void expectNothingLeft() const;

  const std::filesystem::path& build() const { return directory_.path(); }

 private:
  std::filesystem::path temporary() const { return build() / "temporary"; }

  TemporaryDirectory directory_;
};

}  // namespace Testing
