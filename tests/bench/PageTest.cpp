// SPDX-License-Identifier: Apache-2.0
// The page that tools/bench writes, and when a goal counts as missed.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "bench/Page.h"
#include "tests/support/system/Pattern.h"

namespace {

using namespace Benchmark;
using testing::HasSubstr;
using testing::Not;
using Testing::Pattern;

Results measured() {
  Results results;
  for (const int instances : {10, 100, 1000}) {
    Size& size = results.size(instances);
    size.request = 300000.0 * instances;
    size.library = 140000.0 * instances;
    size.minimal = 120000.0 * instances;
    size.milliseconds = 0.07 * instances;
    size.echo = 0.004 * instances;
  }
  return results;
}

TEST(GoalsTest, AreMissedByMoreThanATenth) {
  const Row row{"part", "name", "what", "instructions", 100};
  EXPECT_FALSE(isMissed(row, 90));
  EXPECT_FALSE(isMissed(row, 109.9));
  EXPECT_TRUE(isMissed(row, 110.1));
  EXPECT_FALSE(isMissed({"part", "name", "what", "instructions"}, 1e9)) << "a figure without a goal";
}

TEST(GoalsTest, HaveANameEach) {
  std::set<std::string> names;
  for (const Row& row : rows) {
    EXPECT_TRUE(names.insert(row.name).second) << row.name;
  }
}

TEST(PageTest, ShowsFiguresAsTheyAreRead) {
  EXPECT_EQ(shown(0.05), "0.05");
  EXPECT_EQ(shown(1.2), "1.2");
  EXPECT_EQ(shown(2), "2");
  EXPECT_EQ(shown(99.5), "99.5");
  EXPECT_EQ(shown(100.4), "100");
  EXPECT_EQ(shown(999.6), "1,000");
  EXPECT_EQ(shown(2954758532), "2,954,758,532");
}

TEST(PageTest, SaysWhichGoalIsMissed) {
  Results results = measured();
  results.figures = {{"line", 2000}, {"log line", 2300}, {"another", 1600}, {"associators", 130000}};
  const std::string page = pageOf(results);
  EXPECT_THAT(page, HasSubstr("| 2,000 instructions | ≤ 1,500 | **missed** |\n"));
  EXPECT_THAT(page, HasSubstr("| 2,300 instructions | ≤ 2,500 |  |\n"));
  EXPECT_THAT(page, HasSubstr("| 1,600 instructions | ≤ 1,500 | within a tenth |\n"));
  EXPECT_THAT(page, HasSubstr("| 130,000 instructions |  |  |\n"));
}

TEST(PageTest, SaysWhatWasNotMeasured) {
  Results results = measured();
  EXPECT_THAT(pageOf(results), Not(HasSubstr("Not measured")));
  results.notes = {"sfcb: there is none"};
  EXPECT_THAT(pageOf(results), HasSubstr("## Not measured\n\n- sfcb: there is none\n"));
}

TEST(PageTest, SaysWhatTheLinesOfAnInstanceCostBesideTheMinimalProvider) {
  Results results = measured();
  EXPECT_THAT(pageOf(results), Not(HasSubstr("eight lines")));
  results.figures = {{"line", 1500}};
  results.size(34).minimal = 34 * 60000.0;
  EXPECT_THAT(pageOf(results),
              HasSubstr("The eight lines that each instance has in the log and in the trace cost 0.2 "));
}

TEST(PageTest, ShowsWhatAnInstanceCostsAtEachSize) {
  EXPECT_THAT(pageOf(measured()), HasSubstr("| 1,000 | 300,000,000 | 300,000 | 140,000 | 120,000 | 70 | 4 |\n"));
}

TEST(PlotTest, ShowsEachSeriesGrowingWithinThePicture) {
  const std::string plot = plotOf(measured());
  int series = 0;
  for (const Pattern::Match& polyline : Pattern("<polyline points=\"([^\"]*)\"").all(plot)) {
    ++series;
    std::vector<int> across;
    std::vector<int> down;
    for (const Pattern::Match& point : Pattern(R"((\d+),(\d+))").all(polyline[1])) {
      across.push_back(std::stoi(point[1]));
      down.push_back(std::stoi(point[2]));
    }
    ASSERT_EQ(across.size(), 3u);
    EXPECT_TRUE(std::ranges::is_sorted(across));
    EXPECT_TRUE(std::ranges::is_sorted(down, std::greater<>())) << "what costs more stands higher";
    // Both axes are logarithmic: ten times as much is as far again.
    EXPECT_NEAR(across[1] - across[0], across[2] - across[1], 1);
    EXPECT_NEAR(down[1] - down[0], down[2] - down[1], 1);
    EXPECT_GE(down.back(), 70);
    EXPECT_LE(down.front(), 370);
  }
  EXPECT_EQ(series, 5);
}

TEST(PlotTest, LeavesOutWhatWasNotMeasured) {
  Results results;
  results.size(10).request = 1000;
  EXPECT_NO_THROW(plotOf(results));
  EXPECT_NO_THROW(plotOf(Results{}));
}

}  // namespace
