// SPDX-License-Identifier: Apache-2.0
// The build that a test is part of. Tests may be compiled once and linked in several builds, so what differs between
// these is asked for when they run.
#pragma once

#include <string>

namespace Testing {

// The absolute path of the build directory, and that of what is in it: built("bin/cimomd").
const std::string& buildDirectory();
std::string built(const std::string& path);

// Whether a sanitizer watches what is tested.
bool sanitized();

}  // namespace Testing
