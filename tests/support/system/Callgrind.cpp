// SPDX-License-Identifier: Apache-2.0
#include "tests/support/system/Callgrind.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string_view>

#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

constexpr std::string_view allocators[] = {"malloc", "calloc", "realloc"};

// "(17) malloc" names a function and numbers it, "(17)" names it again.
std::string_view numberOf(std::string_view function) { return function.substr(0, function.find(')')); }

bool names(std::string_view function, std::string_view name) {
  const auto blank = function.find(") ");
  return blank != std::string_view::npos && function.substr(blank + 2) == name;
}

// Adds the cost that a profile of callgrind holds to that of the step that it was dumped at.
void addProfile(const std::filesystem::path& file, std::map<std::string, Cost>& costs) {
  constexpr std::string_view trigger = "desc: Trigger: Client Request: ";
  constexpr std::string_view totals = "totals: ";
  constexpr std::string_view function = "fn=";
  constexpr std::string_view called = "cfn=";
  constexpr std::string_view calls = "calls=";
  std::string step;
  Cost cost;
  std::map<std::string, bool, std::less<>> allocates;  // by the function's number
  bool allocation = false;
  const auto isAllocator = [&](std::string_view text) {
    const std::string number(numberOf(text));
    if (text.find(") ") != std::string_view::npos) {
      allocates[number] =
          std::ranges::any_of(allocators, [&](std::string_view allocator) { return names(text, allocator); });
    }
    return allocates[number];
  };
  std::ifstream lines(file);
  for (std::string line; std::getline(lines, line);) {
    const std::string_view text = line;
    if (text.starts_with(trigger)) {
      step = text.substr(trigger.size());
    } else if (text.starts_with(totals)) {
      cost.instructions = std::stod(line.substr(totals.size()));
    } else if (text.starts_with(function)) {
      isAllocator(text.substr(function.size()));
    } else if (text.starts_with(called)) {
      allocation = isAllocator(text.substr(called.size()));
    } else if (text.starts_with(calls) && allocation) {
      cost.allocations += std::stod(line.substr(calls.size()));
    }
  }
  if (!step.empty()) {
    costs[step] = cost;
  }
}

}  // namespace

std::map<std::string, Cost> costsOf(const std::vector<std::string>& command, const Environment& environment,
                                    std::chrono::seconds patience) {
  const TemporaryDirectory directory;
  std::vector<std::string> counted = {"valgrind", "--tool=callgrind",
                                      "--callgrind-out-file=" + (directory / "profile")};
  counted.insert(counted.end(), command.begin(), command.end());
  // What the loader looks up with a function's first call would be counted with it.
  Environment bound = environment;
  bound["LD_BIND_NOW"] = "1";
  const Completed completed = run(counted, bound, patience);
  if (completed.status != 0) {
    throw std::runtime_error(command.front() + " under callgrind ended with status " +
                             std::to_string(completed.status) + ": " + completed.output + completed.errors);
  }
  std::map<std::string, Cost> costs;
  for (const auto& profile : std::filesystem::directory_iterator(directory.path())) {
    addProfile(profile.path(), costs);
  }
  return costs;
}

}  // namespace Testing
