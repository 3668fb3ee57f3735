// SPDX-License-Identifier: Apache-2.0
// All that can be seen of one request from outside.
#pragma once

#include <optional>
#include <string>
#include <vector>

namespace Testing {

struct Line {
  bool trace;  // else the log
  std::string function;
  std::string file;
  int number;  // of the location that the logger sees; any where 0
  std::string component;
  int level;
  std::string text;  // a number 0 in it stands for any
};

struct Outcome {
  std::string status;                    // code and message, or what was thrown
  std::vector<std::string> answered;     // instances, paths and the end, in order, as they were when they came
  std::vector<Line> lines;               // of log and trace
  std::vector<std::string> brokerTrace;  // "level component: text"
  std::vector<std::string> upCalls;
  std::vector<std::string> instrumentation;  // "construct", "setProperty(25, 192.0.2.7)" …
};

// How `outcome` differs from what is expected of it; nothing where it does not.
std::optional<std::string> difference(const Outcome& outcome, const Outcome& expected);

}  // namespace Testing
