// SPDX-License-Identifier: Apache-2.0
#include "tests/support/system/Build.h"

namespace Testing {

const std::string& buildDirectory() {
  static const std::string directory = BINARY_DIR;
  return directory;
}

std::string built(const std::string& path) { return buildDirectory() + '/' + path; }

bool sanitized() {
#ifdef SANITIZED
  return true;
#else
  return false;
#endif
}

}  // namespace Testing
