// SPDX-License-Identifier: Apache-2.0
// In front of the agent's libraries: the helper as it is, a log and an instrumentation that record. Every call can
// fail.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tests/faults/Outcome.h"

namespace Testing {

struct Agent {
  std::vector<std::optional<std::string>> nodes;  // their names; absent: it cannot be read
  Outcome* record = nullptr;
};

Agent& agent();

}  // namespace Testing
