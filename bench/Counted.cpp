// SPDX-License-Identifier: Apache-2.0
// What callgrind counts: instructions and allocations, the same on every machine of one word size and one C library.
#include <sys/syscall.h>

#include <algorithm>
#include <cstdlib>
#include <stdexcept>

#include "bench/Measurements.h"
#include "bench/Rounds.h"
#include "tests/agent/log/FrameLines.h"
#include "tests/support/client/Enumeration.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Callgrind.h"
#include "tests/support/system/SystemCalls.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Benchmark {
namespace {

using Testing::Cost;
using Testing::TemporaryDirectory;

// A simulated processor whose agent writes no line.
class Processor {
 public:
  explicit Processor(int interfaces)
      : environment_{
            {"QV_AGENT_INI", directory_.write("agent.ini", Testing::quietAgent(directory_.write(
                                                               "state.json", Testing::stateOf(interfaces))))}} {}

  const Testing::Environment& environment() const { return environment_; }

 private:
  const TemporaryDirectory directory_;
  const Testing::Environment environment_;
};

std::vector<std::string> command(const char* part, int interfaces) {
  return {Testing::built("bin/workload"), part, std::to_string(interfaces)};
}

// What the steps of a part of the program `workload` cost.
std::map<std::string, Cost> workload(const char* part, int interfaces) {
  return Testing::costsOf(command(part, interfaces), Processor(interfaces).environment(), std::chrono::minutes(5));
}

// The most memory that a part takes by itself, in KiB.
double peakOf(const char* part, int interfaces) {
  const auto completed = Testing::run(command(part, interfaces), Processor(interfaces).environment());
  if (completed.status != 0) {
    throw std::runtime_error(completed.errors);
  }
  return std::stod(completed.output);
}

constexpr int usual = 34;

}  // namespace

void measureTraceLines(Results& results) {
  const auto costs = workload("trace-lines", 1);
  const auto worst = [&](double Cost::*figure) {
    return std::max(costs.at("entering").*figure, costs.at("variable").*figure) / roundsOfAStep;
  };
  results.figures["line"] = worst(&Cost::instructions);
  results.figures["line allocations"] = worst(&Cost::allocations);
}

void measureLogLines(Results& results) {
  const TemporaryDirectory directory;
  const std::string ini = directory.write(
      "agent.ini", "[log]\ndestination = off\n[trace]\ndestination = file\nfile = " + (directory / "trace") + "\n");
  const auto costs =
      Testing::costsOf({Testing::built("bin/log_cost"), std::to_string(roundsOfAStep)}, {{"QV_AGENT_INI", ini}});
  results.figures["log line"] = costs.at("lines").instructions / roundsOfAStep;

  // A process reads its agent.ini with its first line: the traced one is a child, and this one sends none before.
  const auto calls = Testing::traced([&] {
                       ::setenv("QV_AGENT_INI", ini.c_str(), 1);
                       Testing::sendFrameLines(roundsOfAStep);
                     }).calls;
  results.figures["log line calls"] = static_cast<double>(calls.size()) / roundsOfAStep;
}

void measureCandidates(Results& results) {
  for (const auto& [step, cost] : workload("candidates", 1)) {
    results.figures[step] = cost.instructions / roundsOfAStep;
  }
}

void measureLibrary(Results& results) {
  const auto ratio = [](const std::map<std::string, Cost>& costs, const std::string& operation) {
    return costs.at("library " + operation).instructions / costs.at("minimal " + operation).instructions;
  };
  for (const int instances : {10, usual, 100, 1000}) {
    const auto costs = workload("enumerations", instances);
    results.size(instances).library = costs.at("library enumerate").instructions;
    results.size(instances).minimal = costs.at("minimal enumerate").instructions;
    if (instances == usual) {
      results.figures["enumerate"] = ratio(costs, "enumerate");
    }
  }
  const auto costs = workload("names-and-get", usual);
  results.figures["names"] = ratio(costs, "names");
  results.figures["get"] = ratio(costs, "get");
}

void measureAssociations(Results& results) {
  constexpr int interfaces = 10;
  constexpr int settings = 2 * interfaces;
  for (const auto& [step, cost] : workload("associations", interfaces)) {
    const int objects = step == "enumerate pairs" ? interfaces * settings : settings;
    results.figures[step] = cost.instructions / objects;
  }
  constexpr int many = 100;
  results.figures["memory of a pair"] = (peakOf("associations", many) - peakOf("associations", 1)) / (many * 2 * many);
}

void measureRequests(Results& results) {
  for (const int instances : {3, 10, usual, 100, 1000, 10000}) {
    const Cost cost = workload("request", instances).at("request");
    results.size(instances).request = cost.instructions;
    if (instances == usual) {
      results.figures["allocations"] = cost.allocations;
    }
  }
  const auto ofAnInstance = [&](int instances) { return results.size(instances).request / instances; };
  results.figures["growth"] = ofAnInstance(10000) / ofAnInstance(100);
}

}  // namespace Benchmark
