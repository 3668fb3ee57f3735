// SPDX-License-Identifier: Apache-2.0
// What the most costly requests cost: instructions as callgrind counts them, and memory. Neither depends on what else
// the machine does.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <sstream>
#include <string>

#include "tests/cimom/cimxml/CostlyRequests.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;

constexpr std::size_t small = 64U << 10U;
constexpr std::size_t medium = 256U << 10U;
constexpr std::size_t largest = 4U << 20U;

// What a processor does in 30 ms, roughly: 64 times as much for the largest request stays below two seconds.
constexpr double mostInstructions = 90e6;
constexpr long mostKibOfSmall = 16L << 10U;
constexpr long mostKibOfLargest = 64L << 10U;

// The instructions that each request takes, by its name.
std::map<std::string, double> instructions(std::size_t bytes) {
  const TemporaryDirectory directory;
  const Completed completed = run({"valgrind", "--tool=callgrind", "--callgrind-out-file=" + (directory / "profile"),
                                   REQUEST_COST, std::to_string(bytes)},
                                  {}, std::chrono::seconds(110));
  EXPECT_EQ(completed.status, 0) << completed.errors;
  std::map<std::string, double> counts;
  for (const auto& profile : std::filesystem::directory_iterator(directory.path())) {
    std::istringstream lines(readFile(profile.path()));
    constexpr std::string_view trigger = "desc: Trigger: Client Request: ";
    constexpr std::string_view totals = "totals: ";
    std::string name;
    for (std::string line; std::getline(lines, line);) {
      if (line.starts_with(trigger)) {
        name = line.substr(trigger.size());
      } else if (line.starts_with(totals) && !name.empty()) {
        counts[name] = std::stod(line.substr(totals.size()));
      }
    }
  }
  return counts;
}

// By how much one request raises the memory of a process of its own.
long peakKib(const std::string& name, std::size_t bytes) {
  const Completed completed = run({REQUEST_COST, std::to_string(bytes), name});
  EXPECT_EQ(completed.status, 0) << completed.errors;
  std::istringstream words(completed.output);
  int status = 0;
  long kib = -1;
  words >> status >> kib;
  return kib;
}

TEST(RequestCostTest, ProcessorTimeIsBoundedAndGrowsWithTheSize) {
  const auto ofSmall = instructions(small);
  const auto ofMedium = instructions(medium);
  for (const CostlyRequest& request : costlyRequests()) {
    SCOPED_TRACE(request.name);
    ASSERT_TRUE(ofSmall.contains(request.name) && ofMedium.contains(request.name));
    std::cout << request.name << ": " << ofSmall.at(request.name) / 1e6 << " and " << ofMedium.at(request.name) / 1e6
              << " million instructions\n";
    EXPECT_LT(ofSmall.at(request.name), mostInstructions);
    EXPECT_LT(ofMedium.at(request.name), mostInstructions * medium / small);
    EXPECT_LT(ofMedium.at(request.name), 1e6 + 5 * ofSmall.at(request.name));
  }
}

TEST(RequestCostTest, MemoryIsBounded) {
  for (const CostlyRequest& request : costlyRequests()) {
    SCOPED_TRACE(request.name);
    const long ofSmall = peakKib(request.name, small);
    const long ofLargest = peakKib(request.name, largest);
    std::cout << request.name << ": " << ofSmall << " and " << ofLargest << " KiB\n";
    EXPECT_GE(ofSmall, 0);
    EXPECT_LT(ofSmall, mostKibOfSmall);
    EXPECT_LT(ofLargest, mostKibOfLargest);
  }
}

}  // namespace
