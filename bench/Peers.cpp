// SPDX-License-Identifier: Apache-2.0
// cimomd beside the object managers that are installed on this machine, which hosts_test brings to serving the product.
#include <cstdio>
#include <sstream>
#include <stdexcept>

#include "bench/Measurements.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"

namespace Benchmark {
namespace {

struct Peer {
  const char* name;  // as hosts_test takes it
  const char* title;
  const char* row;  // what the names of its rows begin with
};

constexpr Peer peers[] = {{"openpegasus", "OpenPegasus", "pegasus"}, {"sfcb", "sfcb", "sfcb"}};

constexpr int skipped = 77;

// Takes lines such as "median of 34: 1.5 ms, cimomd 0.5 ms".
void takeMedians(Results& results, const Peer& peer, const std::string& output) {
  std::istringstream lines(output);
  for (std::string line; std::getline(lines, line);) {
    int instances = 0;
    double ofPeer = 0;
    double ofCimomd = 0;
    if (std::sscanf(line.c_str(), "median of %d: %lf ms, cimomd %lf ms", &instances, &ofPeer, &ofCimomd) == 3) {
      results.figures[std::string(peer.row) + ' ' + std::to_string(instances)] = ofCimomd / ofPeer;
    }
  }
}

}  // namespace

void measurePeers(Results& results) {
  for (const Peer& peer : peers) {
    // An object manager reads the agent.ini that it is installed with, not that of what is measured in this process.
    const auto completed = Testing::run({"env", "-u", "QV_AGENT_INI", Testing::built("bin/hosts_test"), peer.name,
                                         "--gtest_filter=EnumerationTimesTest.*"},
                                        {}, std::chrono::minutes(5));
    if (completed.status == skipped) {
      results.notes.push_back(std::string(peer.title) +
                              ": there is none on the machine that measured, or none was named");
      continue;
    }
    takeMedians(results, peer, completed.output);
    if (completed.status != 0) {
      throw std::runtime_error(std::string(peer.title) + ": " + completed.output + completed.errors);
    }
  }
}

}  // namespace Benchmark
