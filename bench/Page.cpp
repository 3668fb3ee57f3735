// SPDX-License-Identifier: Apache-2.0
#include "bench/Page.h"

#include <cmath>
#include <cstdio>

namespace Benchmark {
namespace {

constexpr const char* introduction = R"(# Performance

Written by `tools/bench`, which measures all of it and fails where a goal is missed by more than a tenth. Instructions
and allocations are counted by callgrind in the default build, round trips on the wire; they depend on no other load and
on no clock. A ratio is of two programs that take turns in one run. Milliseconds are medians on the machine that measured
and stand for comparison within their table alone.

## Goals

)";

constexpr const char* remarks = R"(
The minimal provider (`bench/MinimalProvider.cpp`) makes the same up-call, copies the same properties of 34 endpoints into
new instances and returns them, with no frame in a log, no helper, no selection and no check. What stands below both, the
broker and the underlying provider, is counted with both. The echo is cimomd's own HTTP server with a handler that returns
the same bytes.

An association reads its inner end anew for each instance of the outer one ([architecture](architecture.md)): enumerating
one costs the product of its ends. With 100 interfaces and their 200 settings that is 20,000 pairs.
)";

constexpr const char* growth = R"(
## Growth

EnumerateInstances of the endpoints: a whole request of CIM-XML, and the up-call alone.

)";

std::string fixed(double figure, int digits) {
  char text[64];
  std::snprintf(text, sizeof text, "%.*f", digits, figure);
  return text;
}

std::string cell(double figure) { return figure > 0 ? shown(figure) : ""; }

const char* verdictOf(const Row& row, double figure) {
  if (isMissed(row, figure)) {
    return "**missed**";
  }
  return row.most && figure > *row.most ? "within a tenth" : "";
}

std::string goalsOf(const Results& results) {
  std::string table = "| what | figure | goal | |\n|---|--:|--:|---|\n";
  for (const Row& row : rows) {
    if (const auto figure = results.figures.find(row.name); figure != results.figures.end()) {
      table += std::string("| ") + row.what + " | " + shown(figure->second) + ' ' + row.unit + " | " +
               (row.most ? "≤ " + shown(*row.most) : "") + " | " + verdictOf(row, figure->second) + " |\n";
    }
  }
  return table;
}

// What of the library's distance from the minimal provider its frame alone is.
std::string shareOfLines(const Results& results) {
  constexpr int instances = 34;
  constexpr int linesOfAnInstance = 8;
  const auto line = results.figures.find("line");
  const auto size = results.sizes.find(instances);
  if (line == results.figures.end() || size == results.sizes.end() || size->second.minimal == 0) {
    return {};
  }
  const double share = linesOfAnInstance * line->second * instances / size->second.minimal;
  return "\nThe eight lines that each instance has in the log and in the trace cost " + shown(share) +
         " times what the minimal provider takes for it.\n";
}

std::string growthOf(const Results& results) {
  std::string table =
      "| instances | a request, instructions | an instance of it | the library alone, an instance | the minimal "
      "provider, an "
      "instance | a request, ms | an HTTP echo, ms |\n|--:|--:|--:|--:|--:|--:|--:|\n";
  for (const auto& [instances, size] : results.sizes) {
    table += "| " + shown(instances) + " | " + cell(size.request) + " | " + cell(size.request / instances) + " | " +
             cell(size.library / instances) + " | " + cell(size.minimal / instances) + " | " + cell(size.milliseconds) +
             " | " + cell(size.echo) + " |\n";
  }
  return table;
}

}  // namespace

std::string shown(double figure) {
  if (figure < 100) {
    std::string text = fixed(figure, 2);
    text.erase(text.find_last_not_of('0') + 1);
    return text.ends_with('.') ? text.substr(0, text.size() - 1) : text;
  }
  std::string text = fixed(std::round(figure), 0);
  for (auto at = static_cast<std::ptrdiff_t>(text.size()) - 3; at > 0; at -= 3) {
    text.insert(static_cast<std::size_t>(at), ",");
  }
  return text;
}

std::string pageOf(const Results& results) {
  std::string page = introduction + goalsOf(results) + remarks + shareOfLines(results) + growth + growthOf(results) +
                     "\n![Cost against size](performance.svg)\n";
  if (!results.notes.empty()) {
    page += "\n## Not measured\n\n";
    for (const std::string& note : results.notes) {
      page += "- " + note + '\n';
    }
  }
  return page;
}

}  // namespace Benchmark
