// SPDX-License-Identifier: Apache-2.0
// Where what a run delivers is kept: each answer as it is at the moment that it comes.
#pragma once

#include <cmpift.h>

#include <map>
#include <string>

#include "tests/faults/Outcome.h"

namespace Testing {

// Of the run that is under way.
struct Recording {
  Outcome* outcome = nullptr;
  std::map<const CMPIInstance*, std::string> filters = {};  // that were set
};

Recording& recording();

// The result that a request is given; its table is not interposed yet.
CMPIResult* recordingResult();

std::string textOf(const CMPIObjectPath* path);

// Keeps a property filter that was set.
void recordFilter(const CMPIInstance* instance, const char** properties, const char** keys);

}  // namespace Testing
