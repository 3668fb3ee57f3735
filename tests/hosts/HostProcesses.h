// SPDX-License-Identifier: Apache-2.0
// The processes of this machine that a test looks at, by /proc.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

namespace Testing {

// Those that have a file mapped whose path holds the text: those that have loaded a library, say.
std::vector<pid_t> processesMapping(const std::string& part);

// Those that run one of the programs, given by their paths.
std::vector<pid_t> processesRunning(const std::vector<std::string>& programs);

}  // namespace Testing
