// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "bmcip/model/Graph.h"

namespace Bmcip {

// What grows from the computer systems, an association a branch, with the names of the instances.
std::string treeOf(const Graph& graph);

// For Graphviz: every instance a node, every association an edge; instances of a class in a column, in their order.
std::string dotOf(const Graph& graph);

// The same as a picture, which Graphviz' program dot draws. Throws std::runtime_error if that is not there or fails.
std::string svgOf(const Graph& graph);

}  // namespace Bmcip
