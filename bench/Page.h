// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "bench/Measurements.h"

namespace Benchmark {

// A figure as a reader wants it: whole and grouped by thousands where it is large, else with what distinguishes it.
std::string shown(double figure);

// docs/performance.md: the goals and what came of them, growth, what stands beside cimomd.
std::string pageOf(const Results& results);

// docs/performance.svg: cost against size, both axes logarithmic.
std::string plotOf(const Results& results);

}  // namespace Benchmark
