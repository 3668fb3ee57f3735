// SPDX-License-Identifier: Apache-2.0
// The campaign itself: what it counts, and what it survives.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <set>

#include "tests/faults/Campaign.h"

namespace {

using namespace Testing;
using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::SizeIs;
using ::testing::StartsWith;

const char* const aRequest = "IPProtocolEndpointProvider/EnumInstanceNames/all";

std::vector<Point> somePoints() {
  std::vector<Point> some = points(aRequest);
  some.resize(20);
  return some;
}

std::size_t counted(const Report& report, Verdict verdict) {
  std::size_t sum = 0;
  for (const auto& row : report.counts) {
    sum += row[static_cast<int>(verdict)];
  }
  return sum;
}

TEST(CampaignTest, GoesOnAfterAPointThatCrashesAndNamesIt) {
  const std::vector<Point> some = somePoints();
  const std::set<std::string> deadly = {some[0].name(), some[7].name(), some[8].name(), some[19].name()};
  const Report report = carryOut(some, 2, [&](const Point& point) {
    if (deadly.contains(point.name())) {
      std::abort();
    }
    return Finding{};
  });
  EXPECT_EQ(report.tried(), 20u);
  EXPECT_EQ(counted(report, Verdict::Crashed), 4u);
  EXPECT_EQ(counted(report, Verdict::Held), 16u);
  EXPECT_THAT(report.failures, SizeIs(4));
  for (const std::string& failure : report.failures) {
    EXPECT_THAT(failure, AllOf(StartsWith("crashed "), HasSubstr("Aborted")));
  }
}

TEST(CampaignTest, CountsWhatIsWrongAndWhatLeaksByTheKindOfFault) {
  const std::vector<Point> some = somePoints();
  const Report report = carryOut(some, 1, [&](const Point& point) -> Finding {
    if (point.name() == some[3].name()) {
      return {Verdict::Wrong, "another answer"};
    }
    return {point.name() == some[4].name() ? Verdict::Leaked : Verdict::Held, "a block"};
  });
  EXPECT_EQ(report.failed(), 2u);
  EXPECT_EQ(report.counts[static_cast<int>(some[3].fault)][static_cast<int>(Verdict::Wrong)], 1u);
  EXPECT_THAT(report.failures,
              ElementsAre("wrong " + some[3].name() + ": another answer", "leaked " + some[4].name() + ": a block"));
}

TEST(CampaignTest, AnEscapingExceptionIsACrash) {
  const Report report = carryOut({somePoints().front()}, 1, [](const Point&) -> Finding { throw 42; });
  EXPECT_EQ(counted(report, Verdict::Crashed), 1u);
}

TEST(CampaignTest, FindsAPointByItsName) {
  for (const Point& point : somePoints()) {
    const Point found = pointOf(point.name());
    EXPECT_EQ(found.key, point.key);
    EXPECT_EQ(found.fault, point.fault);
  }
  EXPECT_THROW(pointOf(std::string(aRequest) + "@1:no-such-fault"), std::invalid_argument);
  EXPECT_THROW(pointOf("nothing"), std::invalid_argument);
}

TEST(CampaignTest, AShareHasEveryKindOfFault) {
  std::set<Fault> all;
  std::set<Fault> shared;
  const std::vector<Point> every = points("EnumInstances/all");
  for (const Point& point : every) {
    all.insert(point.fault);
  }
  for (const Point& point : share(every, 53)) {
    shared.insert(point.fault);
  }
  EXPECT_EQ(shared, all);
}

TEST(CampaignTest, ThereAreManyPoints) { EXPECT_GT(points().size(), 10000u); }

}  // namespace
