// SPDX-License-Identifier: Apache-2.0
// Requests that are made to cost: each repeats what costs until the body is about as large as is asked for.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace Testing {

struct CostlyRequest {
  std::string name;
  std::string method;
  std::string (*body)(std::size_t bytes);
};

const std::vector<CostlyRequest>& costlyRequests();

}  // namespace Testing
