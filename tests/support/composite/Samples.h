// SPDX-License-Identifier: Apache-2.0
// Underlying instances that the composite takes, for each of its six classes.
#pragma once

#include "tests/support/composite/CompositeTest.h"
#include "tests/support/composite/Units.h"

namespace Testing {

struct Sample {
  std::string className;   // the composite
  std::string underlying;  // its source
  std::string getAll;      // the names of the factory's members, as their trace lines show them
  std::string make;
  std::vector<std::string> keys;  // of the composite
};

const std::vector<Sample>& samples();
const Sample& sampleOf(const std::string& className);

// The properties of the n-th underlying instance (from 1) that the composite takes; each has other key values.
Properties acceptable(const Sample& sample, int n);

// The keys of the composite made from it, as a client's request names them.
std::vector<std::pair<std::string, std::string>> keysOf(const Sample& sample, int n);

}  // namespace Testing
