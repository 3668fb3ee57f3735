// SPDX-License-Identifier: Apache-2.0
// What is associated with what.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "bmcip/client/Transport.h"

namespace Bmcip {

struct Graph {
  // An instance: its class without the prefix that all have, and the key that tells it from others of its class.
  struct Node {
    std::string className;
    std::string name;
  };
  // Both ends are indices of nodes; from what hosts or has to what is hosted or belongs to it.
  struct Edge {
    std::string association;
    std::size_t source;
    std::size_t target;
  };

  std::vector<Node> nodes;
  std::vector<Edge> edges;
};

// Asks the server for the instances of the six classes and for what the six associations answer of them. Throws
// Failure.
Graph readGraph(Transport& transport, const Server& server);

}  // namespace Bmcip
