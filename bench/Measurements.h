// SPDX-License-Identifier: Apache-2.0
// How the rows' figures come about. Each function measures one part and throws std::runtime_error where it cannot.
#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "bench/Goals.h"

namespace Benchmark {

// What one size costs, for the table of growth and the plot. A figure that was not measured is 0.
struct Size {
  int instances;
  double request = 0;       // instructions of a whole request of CIM-XML
  double library = 0;       // of the library's enumeration as an up-call
  double minimal = 0;       // of the minimal provider's
  double milliseconds = 0;  // the median of a request over HTTP, on the machine that measured
  double echo = 0;          // of an HTTP echo of the same bytes
};

struct Results {
  Figures figures;
  std::map<int, Size> sizes;
  std::vector<std::string> notes;  // what could not be measured, and why

  Size& size(int instances) {
    Size& size = sizes[instances];
    size.instances = instances;
    return size;
  }
};

// Counted by callgrind.
void measureTraceLines(Results& results);
void measureLogLines(Results& results);
void measureCandidates(Results& results);
void measureLibrary(Results& results);
void measureAssociations(Results& results);
void measureRequests(Results& results);

// A running cimomd, in turns with what stands beside it.
void measureEcho(Results& results);
void measureMemory(Results& results);
void measurePeers(Results& results);

// Counted on the wire.
void measureBmc(Results& results);

struct Part {
  std::string name;
  void (*measure)(Results& results);
};

const std::vector<Part>& parts();

}  // namespace Benchmark
