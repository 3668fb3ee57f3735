// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace Cimom {

// A profile that the instances of a class follow.
struct Profile {
  std::string name;
  std::string version;
  std::string description;
  std::string centralClass;             // whose instances conform
  std::vector<std::string> references;  // names of other profiles that this one builds upon
};

// Reads a *.profiles file, or every one of a directory: INI, a section for each profile, with the keys version,
// description, central-class and, as often as needed, references.
// Throws ConfigurationError that names file and line, and what is wrong: an unknown or duplicate key, one that is
//         missing, a duplicate profile or a reference to none of them.
std::vector<Profile> readProfiles(const std::filesystem::path& fileOrDirectory);

}  // namespace Cimom
