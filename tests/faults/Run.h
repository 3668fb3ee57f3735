// SPDX-License-Identifier: Apache-2.0
// One request of the product, or of the model, in front of the same object manager, agent and underlying instances.
#pragma once

#include "tests/faults/Calls.h"
#include "tests/faults/Outcome.h"
#include "tests/faults/Requests.h"

namespace Testing {

struct RunResult {
  Outcome outcome;
  bool fired = false;                   // whether the call that was to fail was made
  long leaked = 0;                      // blocks that the library has not freed
  std::vector<std::string> violations;  // of what no run may do
};

enum class Who { Product, Model };

RunResult run(Who who, const Request& request, CallKey key = 0, Fault fault = Fault::None);

// Every call that the request makes.
std::vector<RecordedCall> record(Who who, const Request& request, RunResult* result = nullptr);

}  // namespace Testing
