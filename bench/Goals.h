// SPDX-License-Identifier: Apache-2.0
// What is measured, and what it may cost: a row of the page's table each.
#pragma once

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Benchmark {

// What a measurement found, by the row's name.
using Figures = std::map<std::string, double>;

struct Row {
  const char* part;  // that measures it, as --only takes it
  const char* name;
  const char* what;
  const char* unit;
  std::optional<double> most = {};  // the goal; none: a figure to know
};

extern const std::vector<Row> rows;

// A goal is missed by what exceeds it by more than a tenth.
bool isMissed(const Row& row, double figure);

}  // namespace Benchmark
