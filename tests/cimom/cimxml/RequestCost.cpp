// SPDX-License-Identifier: Apache-2.0
// request_cost BYTES [NAME]: has costly requests of about that size answered, all or one, and prints for each
// "HTTP-STATUS PEAK-KIB NAME", where the peak is by how much answering raised the most memory that the program ever
// had. Under callgrind the answer alone is counted, and a profile written for each.
#include <malloc.h>
#include <valgrind/callgrind.h>

#include <cstdlib>
#include <fstream>
#include <iostream>

#include "tests/cimom/cimxml/CostlyRequests.h"
#include "tests/cimom/cimxml/EndpointServer.h"

namespace {

// What the process has had in memory at most since it was last told to count anew.
long peakKib() {
  std::ifstream status("/proc/self/status");
  for (std::string word; status >> word;) {
    if (word == "VmHWM:") {
      long kib = 0;
      status >> kib;
      return kib;
    }
  }
  return 0;
}

// What was freed goes back to the system first, so that it is not taken again unseen.
void countAnew() {
  malloc_trim(0);
  std::ofstream("/proc/self/clear_refs") << "5";
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 2) {
    std::cerr << "usage: request_cost BYTES [NAME]\n";
    return 2;
  }
  const auto bytes = static_cast<std::size_t>(std::atol(argv[1]));
  const Testing::EndpointServer server;
  for (const Testing::CostlyRequest& costly : Testing::costlyRequests()) {
    if (argc > 2 && costly.name != argv[2]) {
      continue;
    }
    const auto request = Testing::EndpointServer::request(costly.method, costly.body(bytes));
    countAnew();
    const long before = peakKib();
    CALLGRIND_ZERO_STATS;
    const auto response = server.endpoint_.handle(request);
    CALLGRIND_DUMP_STATS_AT(costly.name.c_str());
    std::cout << response.status << ' ' << peakKib() - before << ' ' << costly.name << std::endl;
  }
  return 0;
}
