// SPDX-License-Identifier: Apache-2.0
// enumeration_cost INSTANCES: has EnumerateInstances of a class with so many instances answered. Under callgrind the
// answer alone is counted, and a profile written for it.
#include <valgrind/callgrind.h>

#include <cstdlib>
#include <iostream>

#include "tests/cimom/cimxml/EndpointServer.h"
#include "tests/support/probe/ProbeObjects.h"

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: enumeration_cost INSTANCES\n";
    return 2;
  }
  // The part is a thing, too.
  Probe::setThings(static_cast<CMPIUint16>(std::atoi(argv[1]) - 1));
  const Testing::EndpointServer server;
  const auto request = Testing::EndpointServer::request(
      "EnumerateInstances", Testing::intrinsicCall("EnumerateInstances", Testing::className("TEST_Thing")));
  server.endpoint_.handle(request);  // loads and makes what stays
  CALLGRIND_ZERO_STATS;
  server.endpoint_.handle(request);
  CALLGRIND_DUMP_STATS_AT("answer");
  return 0;
}
