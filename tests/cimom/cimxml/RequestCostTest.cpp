// SPDX-License-Identifier: Apache-2.0
// What requests cost, the most costly ones and an enumeration: instructions as callgrind counts them, and memory.
// Neither depends on what else the machine does.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "tests/cimom/cimxml/CostlyRequests.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Callgrind.h"

namespace {

using namespace Testing;

constexpr std::size_t smallest = 16U << 10U;
constexpr std::size_t small = 64U << 10U;
constexpr std::size_t largest = 4U << 20U;

// What a processor does in 30 ms, roughly: 64 times as much for the largest request stays below two seconds.
constexpr double mostInstructionsOfSmall = 90e6;
// What a request costs, however small it is.
constexpr double instructionsOfAny = 0.25e6;
constexpr long mostKibOfSmall = 16L << 10U;
constexpr long mostKibOfLargest = 64L << 10U;

// An enumeration: beside what a request costs, so much for each instance. Both have room for what other compilers make.
constexpr double mostInstructionsOfRequest = 200e3;
constexpr double mostInstructionsOfInstance = 60e3;
constexpr double mostAllocationsOf34 = 1000;
constexpr double mostAllocationsOfInstance = 25;

// By how much one request raises the memory of a process of its own.
long peakKib(const std::string& name, std::size_t bytes) {
  const Completed completed = run({built("bin/request_cost"), std::to_string(bytes), name});
  EXPECT_EQ(completed.status, 0) << completed.errors;
  std::istringstream words(completed.output);
  int status = 0;
  long kib = -1;
  words >> status >> kib;
  return kib;
}

TEST(RequestCostTest, ProcessorTimeIsBoundedAndGrowsWithTheSize) {
  const auto ofSmallest = costsOf({built("bin/request_cost"), std::to_string(smallest)});
  const auto ofSmall = costsOf({built("bin/request_cost"), std::to_string(small)});
  for (const CostlyRequest& request : costlyRequests()) {
    SCOPED_TRACE(request.name);
    ASSERT_TRUE(ofSmallest.contains(request.name) && ofSmall.contains(request.name));
    std::cout << request.name << ": " << ofSmallest.at(request.name).instructions / 1e6 << " and "
              << ofSmall.at(request.name).instructions / 1e6 << " million instructions\n";
    EXPECT_LT(ofSmallest.at(request.name).instructions, mostInstructionsOfSmall * smallest / small);
    EXPECT_LT(ofSmall.at(request.name).instructions, mostInstructionsOfSmall);
    EXPECT_LT(ofSmall.at(request.name).instructions, instructionsOfAny + 5 * ofSmallest.at(request.name).instructions);
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

Cost enumerationOf(int instances) {
  return costsOf({built("bin/enumeration_cost"), std::to_string(instances)}).at("answer");
}

TEST(RequestCostTest, AnInstanceTakesFewInstructionsAndAllocations) {
  const Cost few = enumerationOf(34);
  const Cost many = enumerationOf(334);
  const double ofInstance = (many.instructions - few.instructions) / 300;
  const double ofRequest = few.instructions - 34 * ofInstance;
  std::cout << ofRequest << " instructions, and " << ofInstance << " for each instance; " << few.allocations << " and "
            << many.allocations << " allocations\n";
  EXPECT_GT(ofInstance, 0);
  EXPECT_LT(ofInstance, mostInstructionsOfInstance);
  EXPECT_LT(ofRequest, mostInstructionsOfRequest);
  EXPECT_GT(few.allocations, 0);
  EXPECT_LT(few.allocations, mostAllocationsOf34);
  EXPECT_LT((many.allocations - few.allocations) / 300, mostAllocationsOfInstance);
}

}  // namespace
