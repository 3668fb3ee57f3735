// SPDX-License-Identifier: Apache-2.0
#include <fstream>
#include <iostream>

#include "bmcip/commands/Commands.h"
#include "bmcip/output/Drawing.h"
#include "bmcip/output/Json.h"

namespace Bmcip {

int model(Transport& transport, const Options& options) {
  const Graph graph = readGraph(transport, options.server);
  if (graph.nodes.empty()) {
    throw Failure(FailureKind::NotServed,
                  "the server answers, but shows no instance: the providers are not registered; see "
                  "compositeipconfig-register");
  }
  if (options.svgFile == "-") {
    std::cout << svgOf(graph);
  } else if (!options.svgFile.empty()) {
    const std::string svg = svgOf(graph);
    std::ofstream file(options.svgFile, std::ios::binary);
    if (!(file << svg << std::flush)) {
      throw std::runtime_error(options.svgFile + " cannot be written");
    }
  } else {
    std::cout << (options.json ? jsonOf(graph, options.server) + '\n' : treeOf(graph));
  }
  return 0;
}

}  // namespace Bmcip
