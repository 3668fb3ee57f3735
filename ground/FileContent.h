// SPDX-License-Identifier: Apache-2.0
// Files that are read whole, and those among them that hold secrets: these lie in files of their own, so that the
// configuration may be read by everybody.
#pragma once

#include <filesystem>
#include <string>

namespace Ground {

// The content of a regular file. Throws std::runtime_error "FILE: …" if it cannot be read or is empty.
std::string readFile(const std::filesystem::path& file);

// The same for a file with passwords or keys, which grants group and others nothing.
std::string readSecretFile(const std::filesystem::path& file);

// Throws as readSecretFile does; for a file that somebody else reads. It may be empty.
void requireSecretFile(const std::filesystem::path& file);

}  // namespace Ground
