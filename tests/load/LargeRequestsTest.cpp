// SPDX-License-Identifier: Apache-2.0
// What many large requests at once take of the memory of an object manager, and what of it they leave behind.
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <iostream>
#include <string>
#include <thread>
#include <vector>

#include "tests/cimom/cimxml/CostlyRequests.h"
#include "tests/load/CimClient.h"
#include "tests/support/client/Cimomd.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Footprint.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;

constexpr std::size_t clients = 60;
constexpr std::size_t bytes = 3U << 20U;
const long mostKib = sanitized() ? 4L << 20U : 300L << 10U;
const long mostKibLeft = sanitized() ? mostKib : 30L << 10U;

class LargeRequestsTest : public testing::TestWithParam<const char*> {};

TEST_P(LargeRequestsTest, LeaveTheMemoryToTheSystem) {
  const auto& all = costlyRequests();
  const auto costly = std::ranges::find(all, GetParam(), &CostlyRequest::name);
  ASSERT_NE(costly, all.end());
  const std::string body = costly->body(bytes);
  Cimomd cimomd(Cimomd::probeOptions());
  const pid_t process = cimomd.process().id();

  std::atomic<int> answered = 0;
  std::vector<std::thread> threads;
  for (std::size_t client = 0; client < clients; ++client) {
    threads.emplace_back([&] {
      const Answer answer = CimClient(cimomd.port()).send(costly->method, "root%2Ftest", body);
      answered += answer.kind == Answer::Kind::Untold || answer.status.starts_with("HTTP") ? 0 : 1;
    });
  }
  std::ranges::for_each(threads, [](std::thread& thread) { thread.join(); });

  EXPECT_GT(answered, 0);
  EXPECT_LE(peakResidentKib(process), mostKib);
  poll([&] { return residentKib(process) <= mostKibLeft; });
  EXPECT_LE(residentKib(process), mostKibLeft);
  std::cout << answered << " of " << clients << " answered, " << peakResidentKib(process) << " KiB at most, "
            << residentKib(process) << " KiB left" << std::endl;
}

INSTANTIATE_TEST_SUITE_P(OfEachKind, LargeRequestsTest,
                         testing::Values("a long text", "as many texts as the limits allow", "one long key"),
                         [](const auto& kind) {
                           std::string name = kind.param;
                           std::erase(name, ' ');
                           return name;
                         });

}  // namespace
