// SPDX-License-Identifier: Apache-2.0
#include "bench/Page.h"

#include <cmath>
#include <cstdio>

namespace Benchmark {
namespace {

std::string fixed(double figure, int digits) {
  char text[64];
  std::snprintf(text, sizeof text, "%.*f", digits, figure);
  return text;
}

std::string cell(double figure) { return figure > 0 ? shown(figure) : ""; }

std::string goalsOf(const Results& results) {
  std::string table = "| what | figure | goal | |\n|---|--:|--:|---|\n";
  for (const Row& row : rows) {
    const auto figure = results.figures.find(row.name);
    if (figure == results.figures.end()) {
      continue;
    }
    table += std::string("| ") + row.what + " | " + shown(figure->second) + ' ' + row.unit + " | " +
             (row.most ? "≤ " + shown(*row.most) : "") + " | " + (isMissed(row, figure->second) ? "**missed**" : "") +
             " |\n";
  }
  return table;
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
  std::string page =
      "# Performance\n"
      "\n"
      "Written by `tools/bench`, which measures all of it and fails where a goal is missed by more than a tenth. "
      "Instructions and\nallocations are counted by callgrind in the default build, round trips on the wire; they "
      "depend on no "
      "other load and on no\nclock. A ratio is of two programs that take turns in one run. Milliseconds are medians of "
      "the "
      "machine that measured, and\nfor comparison within their table alone.\n"
      "\n"
      "## Goals\n"
      "\n" +
      goalsOf(results) +
      "\n"
      "The minimal provider (`bench/MinimalProvider.cpp`) makes the same up-call, copies the same properties of 34 "
      "endpoints into new\ninstances and returns them, with no frame in a log, no helper, no selection and no check; "
      "what stands "
      "below both, the broker\nand the underlying provider, is counted with both. The echo is cimomd's own HTTP server "
      "with a handler that "
      "returns the same bytes.\n"
      "\n"
      "An association reads its inner end anew for each instance of the outer one "
      "([architecture](architecture.md)): enumerating one costs\nthe product of its ends. With 100 interfaces and "
      "their 200 "
      "settings that is 20,000 pairs.\n"
      "\n"
      "## Growth\n"
      "\n"
      "EnumerateInstances of the endpoints: a whole request of CIM-XML, and the up-call alone.\n"
      "\n" +
      growthOf(results) + "\n![Cost against size](performance.svg)\n";
  if (!results.notes.empty()) {
    page += "\n## Not measured\n\n";
    for (const std::string& note : results.notes) {
      page += "- " + note + '\n';
    }
  }
  return page;
}

}  // namespace Benchmark
