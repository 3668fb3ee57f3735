// SPDX-License-Identifier: Apache-2.0
// Passwords and keys lie in files of their own, so that the configuration may be read by everybody.
#pragma once

#include <string>

namespace QV::Ipmi {

// The first line of a file that only its owner can read. Throws std::runtime_error, naming the file, if it cannot be
// read, is no regular file, grants group or others anything, or its first line is empty.
std::string readSecretFile(const std::string& path);

}  // namespace QV::Ipmi
