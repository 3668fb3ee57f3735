// SPDX-License-Identifier: Apache-2.0
// Every call that the library makes fails once, in every way that it can: an evenly spread share of all points here,
// all of them with tools/faults.
#include <gtest/gtest.h>

#include <algorithm>
#include <iostream>
#include <set>

#include "tests/faults/Campaign.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;

const std::size_t shareOfPoints = sanitized() ? 151 : 29;

// Of all tests that ran, printed at their end.
class Sum : public ::testing::Environment {
 public:
  static Report& report() {
    static Report sum;
    return sum;
  }
  void TearDown() override {
    if (report().tried() > 0) {
      std::cout << report();
    }
  }
};

const ::testing::Environment* const sum = ::testing::AddGlobalTestEnvironment(new Sum);

class FaultsTest : public ::testing::TestWithParam<Unit> {
 protected:
  std::vector<const Request*> ownRequests() const {
    std::vector<const Request*> own;
    for (const Request& request : requests()) {
      if (request.unit->file == GetParam().file) {
        own.push_back(&request);
      }
    }
    return own;
  }
};

TEST_P(FaultsTest, WithoutAFaultEveryRequestIsAnsweredAsTheModelHasIt) {
  for (const Request* request : ownRequests()) {
    const RunResult product = run(Who::Product, *request);
    const RunResult model = run(Who::Model, *request);
    EXPECT_TRUE(product.violations.empty()) << request->name() << ": " << product.violations.front();
    EXPECT_EQ(product.leaked, 0) << request->name();
    const auto found = difference(product.outcome, model.outcome);
    EXPECT_FALSE(found) << request->name() << ": " << *found;
  }
}

TEST_P(FaultsTest, TheRequestsFindWhatIsThere) {
  for (const Request* request : ownRequests()) {
    const bool seeks = request->operation == Operation::GetInstance;
    const bool found = request->shape == "all" || request->shape.starts_with("from-one") ||
                       request->shape.starts_with("from-the-other") || request->shape.starts_with("with-filters") ||
                       (seeks && (request->shape == "there" || request->shape == "further-down"));
    const bool notFound = seeks && (request->shape == "not-there" || request->shape == "without-keys");
    const std::vector<std::string> answered = run(Who::Product, *request).outcome.answered;
    const auto objects = std::ranges::count_if(answered, [](const std::string& answer) { return answer != "done"; });
    if (found) {
      EXPECT_GT(objects, 0) << request->name();
    }
    if (notFound) {
      EXPECT_EQ(objects, 0) << request->name();
    }
  }
}

TEST_P(FaultsTest, TheModelMakesTheSameCalls) {
  for (const Request* request : ownRequests()) {
    std::set<CallKey> keys;
    for (const RecordedCall& call : record(Who::Model, *request)) {
      keys.insert(call.key);
    }
    for (const RecordedCall& call : record(Who::Product, *request)) {
      EXPECT_EQ(keys.erase(call.key), 1u) << request->name() << ": the model does not call " << call.text;
    }
    EXPECT_TRUE(keys.empty()) << request->name() << ": the model calls more";
  }
}

TEST_P(FaultsTest, HoldsWhateverCallFails) {
  const Report report = carryOut(share(points(GetParam().file + '/'), shareOfPoints), 1);
  Sum::report().add(report);
  constexpr std::size_t shown = 10;
  for (std::size_t i = 0; i < std::min(report.failures.size(), shown); ++i) {
    ADD_FAILURE() << report.failures[i];
  }
  EXPECT_EQ(report.failed(), 0u) << "of " << report.tried();
}

INSTANTIATE_TEST_SUITE_P(Twelve, FaultsTest, ::testing::ValuesIn(allUnits()),
                         [](const auto& unit) { return unit.param.file; });

}  // namespace
