// SPDX-License-Identifier: Apache-2.0
// What code costs, counted by valgrind's callgrind: unlike time, it does not depend on what else the machine does.
#pragma once

#include <chrono>
#include <map>
#include <string>
#include <vector>

#include "tests/support/system/Process.h"

namespace Testing {

struct Cost {
  double instructions = 0;
  double allocations = 0;  // calls of malloc, calloc and realloc, operator new included
};

// Runs a program under callgrind. Returns what it cost between each CALLGRIND_ZERO_STATS and the
// CALLGRIND_DUMP_STATS_AT that followed, by the name that it was dumped at. Throws std::runtime_error with what the
// program said if it fails.
std::map<std::string, Cost> costsOf(const std::vector<std::string>& command, const Environment& environment = {},
                                    std::chrono::seconds patience = std::chrono::seconds(280));

}  // namespace Testing
