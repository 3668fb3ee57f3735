#pragma once

#include <filesystem>

namespace Cimom {

// Where cimomd's files are installed: what it works with where neither its command line nor its configuration file says
// otherwise.
struct Installation {
  std::filesystem::path configurationFile;
  // These stand where they were installed beside the program, wherever that has been moved to.
  std::filesystem::path schema;
  std::filesystem::path registration;
  std::filesystem::path providerDirectory;
};

// The installation that the running program is part of.
Installation thisInstallation();

}  // namespace Cimom
