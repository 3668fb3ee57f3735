#pragma once

#include <filesystem>

#include "cimom/configuration/Settings.h"

namespace Cimom {

// Reads an INI file of `key = value` lines without sections; comments begin with `;` or `#`. A key that may be given
// several times stands on several lines. A relative path in it is relative to the file's directory. Throws UsageError
// "FILE:LINE: what is wrong" for what is no setting, and "FILE: …" for a file that cannot be read.
GivenValues readConfigurationFile(const std::filesystem::path& file);

}  // namespace Cimom
