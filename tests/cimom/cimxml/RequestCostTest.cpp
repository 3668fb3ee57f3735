// SPDX-License-Identifier: Apache-2.0
// What requests cost, the most costly ones and an enumeration: instructions as callgrind counts them, and memory.
// Neither depends on what else the machine does.
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

// An enumeration: beside what a request costs, so much for each instance. Both have room for what other compilers make.
constexpr double mostInstructionsOfRequest = 200e3;
constexpr double mostInstructionsOfInstance = 64e3;
constexpr long mostAllocationsOf34 = 1000;
constexpr double mostAllocationsOfInstance = 25;

// The instructions that each request takes which a program has answered, by its name.
std::map<std::string, double> instructions(const std::string& program, std::size_t argument) {
  const TemporaryDirectory directory;
  const Completed completed = run({"valgrind", "--tool=callgrind", "--callgrind-out-file=" + (directory / "profile"),
                                   program, std::to_string(argument)},
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
  const auto ofSmall = instructions(REQUEST_COST, small);
  const auto ofMedium = instructions(REQUEST_COST, medium);
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

// How often an enumeration of so many instances allocates memory.
long allocations(std::size_t instances) {
  const Completed completed = run({ENUMERATION_COST, std::to_string(instances)});
  EXPECT_EQ(completed.status, 0) << completed.errors;
  return std::stol(completed.output);
}

TEST(RequestCostTest, AnInstanceTakesFewInstructions) {
  const double few = instructions(ENUMERATION_COST, 34)["answer"];
  const double many = instructions(ENUMERATION_COST, 334)["answer"];
  const double ofInstance = (many - few) / 300;
  const double ofRequest = few - 34 * ofInstance;
  std::cout << ofRequest << " instructions, and " << ofInstance << " for each instance\n";
  EXPECT_GT(ofInstance, 0);
  EXPECT_LT(ofInstance, mostInstructionsOfInstance);
  EXPECT_LT(ofRequest, mostInstructionsOfRequest);
}

TEST(RequestCostTest, AnInstanceTakesFewAllocations) {
  const long few = allocations(34);
  const long many = allocations(334);
  std::cout << few << " and " << many << " allocations\n";
  EXPECT_GT(few, 0);
  EXPECT_LT(few, mostAllocationsOf34);
  EXPECT_LT(static_cast<double>(many - few) / 300, mostAllocationsOfInstance);
}

}  // namespace
