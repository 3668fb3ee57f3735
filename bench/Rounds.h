// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace Benchmark {

// How often the program `workload` carries out a step that is too short to be counted once.
inline constexpr int roundsOfAStep = 1000;

}  // namespace Benchmark
