// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <string>

namespace Cimom::Http {

// The content of a file. Throws ServerError "FILE: …" if it cannot be read or is empty.
std::string readFile(const std::filesystem::path& file);

// The same for a file with passwords or keys, which group and others must not be able to read or write.
std::string readSecretFile(const std::filesystem::path& file);

}  // namespace Cimom::Http
