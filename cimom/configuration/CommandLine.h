#pragma once

#include <optional>

#include "cimom/configuration/Configuration.h"

namespace Cimom {

// Reads cimomd's command line and the configuration file that it names; what stands on the command line replaces what
// the file says. Gives nothing when help or the version was asked for, and has been printed. Throws UsageError.
std::optional<Configuration> readCommandLine(int argc, const char* const* argv);

}  // namespace Cimom
