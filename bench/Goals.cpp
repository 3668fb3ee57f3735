// SPDX-License-Identifier: Apache-2.0
#include "bench/Goals.h"

namespace Benchmark {

const std::vector<Row> rows = {
    {"trace-lines", "line", "A line of the library's trace that both channels filter", "instructions", 1500},
    {"trace-lines", "line allocations", "Allocations of such a line: its two texts", "allocations", 2},
    {"log-lines", "log line", "A line that the agent writes to a file, each channel", "instructions", 2500},
    {"log-lines", "log line calls", "System calls of such a line", "calls", 1},
    {"candidates", "another", "A candidate that GetInstance compares and that is another one", "instructions", 1500},
    {"candidates", "the same", "The candidate that is the one asked for", "instructions"},
    {"library", "enumerate", "The library beside the minimal provider: EnumerateInstances", "times", 1.20},
    {"library", "names", "The library beside the minimal provider: EnumerateInstanceNames", "times", 1.20},
    {"library", "get", "The library beside the minimal provider: GetInstance of the last", "times", 1.20},
    {"associations", "associators", "Associators, for each object answered", "instructions"},
    {"associations", "associator names", "AssociatorNames, for each object answered", "instructions"},
    {"associations", "references", "References, for each object answered", "instructions"},
    {"associations", "reference names", "ReferenceNames, for each object answered", "instructions"},
    {"associations", "enumerate pairs", "EnumerateInstances of an association, for each pair", "instructions"},
    {"associations", "memory of a pair", "Memory of a pair meanwhile", "KiB"},
    {"requests", "allocations", "Allocations of one request of 34 instances", "allocations", 3000},
    {"requests", "growth", "An instance of 10,000 beside an instance of 100, instructions", "times", 1.20},
    {"echo", "echo 3", "cimomd beside an HTTP echo of the same bytes, processor time: 3 instances", "times", 12},
    {"echo", "echo 34", "cimomd beside an HTTP echo of the same bytes, processor time: 34 instances", "times", 40},
    {"echo", "echo 1000", "cimomd beside an HTTP echo of the same bytes, processor time: 1,000 instances", "times", 12},
    {"bmc", "write held", "A BMC's address and mask written and read back, in a held session", "round trips", 10},
    {"bmc", "write cold", "A BMC's address and mask written and read back, from cold", "round trips", 15},
    {"bmc", "read held", "A BMC read, in a held session", "round trips", 6},
    {"bmc", "read cold", "A BMC read, from cold: eleven, and three that show address and mask to be of one change",
     "round trips", 14},
    {"bmc", "burst", "Sessions opened for a burst of eight requests", "in all", 1},
    {"memory", "peak", "cimomd with 60 requests of 3 MiB at once, at most", "MiB", 300},
    {"memory", "kept", "What cimomd keeps of that afterwards", "MiB", 30},
    {"peers", "pegasus 3", "cimomd beside OpenPegasus, EnumerateInstances, median: 3 instances", "times", 0.25},
    {"peers", "pegasus 34", "cimomd beside OpenPegasus, EnumerateInstances, median: 34 instances", "times", 0.45},
    {"peers", "pegasus 1000", "cimomd beside OpenPegasus, EnumerateInstances, median: 1,000 instances", "times", 0.60},
    {"peers", "sfcb 3", "cimomd beside sfcb, EnumerateInstances, median: 3 instances", "times"},
    {"peers", "sfcb 34", "cimomd beside sfcb, EnumerateInstances, median: 34 instances", "times"},
    {"peers", "sfcb 1000", "cimomd beside sfcb, EnumerateInstances, median: 1,000 instances", "times"},
};

bool isMissed(const Row& row, double figure) {
  constexpr double tolerance = 1.1;
  return row.most && figure > *row.most * tolerance;
}

}  // namespace Benchmark
