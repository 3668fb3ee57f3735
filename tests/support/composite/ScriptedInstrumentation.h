// SPDX-License-Identifier: Apache-2.0
// Stands in for the agent's instrumentation: nodes as a test scripts them, every call recorded in order, an exception
// at any of them on demand.
#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Testing {

struct ScriptedNode {
  std::optional<std::string> name;  // absent: it cannot be read
  std::map<int, std::string> values = {};
};

struct InstrumentationScript {
  std::vector<ScriptedNode> nodes;
  std::string throwAt;             // the call, as `calls` shows it, that throws
  std::vector<std::string> calls;  // "construct", "selectNode(29)", "bool", "getProperty(108)", "++",
                                   // "setProperty(25, 10.0.0.1)", "destroy"
};

// The script of the running test; a new instrumentation object starts at its first node.
InstrumentationScript& instrumentation();

}  // namespace Testing
