// SPDX-License-Identifier: Apache-2.0
// In front of the agent's libraries: the helper as it is, a log and an instrumentation that record. Every call can
// fail.
#pragma once

#include <optional>
#include <string>
#include <vector>

namespace Testing {

// The names of the instrumentation's nodes; absent: it cannot be read.
std::vector<std::optional<std::string>>& nodeNames();

}  // namespace Testing
