// SPDX-License-Identifier: Apache-2.0
// What the six builders do when an end cannot be read or the broker cannot make what they ask for.
#include <algorithm>
#include <tuple>

#include "tests/providers/AssociationTest.h"

namespace {

using namespace Testing;

// The model, and whether what is unusable is a null pointer or an object without a handle.
using Parameter = std::tuple<AssociationParameter, bool>;

class AssociationBuilderFailureTest : public AssociationTest, public ::testing::WithParamInterface<Parameter> {
 protected:
  AssociationBuilderFailureTest() {
    attach(*std::get<0>(GetParam()).model);
    addEnds(model().outerNames, model().innerNames);  // three of each
  }

  static bool isNull() { return std::get<1>(GetParam()); }
  static CMPIInstance* unusableInstance() { return isNull() ? nullptr : withoutHandle(); }

  // Expects what the outcome says, with that many instances built where the builder ends or goes on.
  void expectOutcome(const Outcome& outcome, std::size_t builtAtEnd, std::size_t builtGoingOn) {
    const bool goesOn = outcome.course == Outcome::Course::GoesOn;
    std::vector<CMPIInstance*> out;
    EXPECT_EQ(build(out), outcome.result);
    EXPECT_EQ(out.size(), goesOn ? builtGoingOn : builtAtEnd);
    EXPECT_EQ(unitLines(), goesOn ? framed(model().builderName) : brokenOff(model().builderName, outcome.message));
    expectMessage(outcome);
  }

  void expectMessage(const Outcome& outcome) {
    int found = 0;
    for (const LogLine& line : logLines()) {
      if (line.component == unit().component && line.message.starts_with("MESSAGE ")) {
        ++found;
        EXPECT_EQ(line.level, 6000);
        EXPECT_EQ(line.function, model().builderName);
        EXPECT_EQ(line.file, unit().file);
        const int fixedLine = outcome.line != 0 ? outcome.line : line.line;
        EXPECT_EQ(line.line, fixedLine);
        EXPECT_EQ(line.message,
                  "MESSAGE [File: " + unit().file + ", Line: " + std::to_string(fixedLine) + "]: " + outcome.message);
      }
    }
    EXPECT_EQ(found, outcome.message.empty() ? 0 : 2) << "once in the log and once in the trace";
  }
};

TEST_P(AssociationBuilderFailureTest, TheOuterEndCannotBeRead) {
  refuseReading(model().outer, 1);
  expectOutcome(model().outerFails, 0, 0);
  EXPECT_TRUE(faults.upCalls.empty());
}

TEST_P(AssociationBuilderFailureTest, AnOuterInstanceIsUnusable) {
  spoil(model().outer, 2, unusableInstance());
  expectOutcome(model().outerIsUnusable, 3, 6);
  EXPECT_EQ(upCallsFor(underlyingClassOf(model().inner)),
            model().outerIsUnusable.course == Outcome::Course::GoesOn ? 2 : 1);
}

TEST_P(AssociationBuilderFailureTest, TheInnerEndCannotBeReadForTheSecondOuter) {
  refuseReading(model().inner, 2);
  expectOutcome(model().innerFails, 3, 6);
}

TEST_P(AssociationBuilderFailureTest, AnInnerInstanceIsUnusable) {
  spoil(model().inner, 2, unusableInstance());
  expectOutcome(model().innerIsUnusable, 1, 8);
}

TEST_P(AssociationBuilderFailureTest, ThePathOfAnAssociationCannotBeMade) {
  faults.unmadePath = isNull() ? nullptr : pathWithoutHandle();
  faults.failNewObjectPath = [&](const std::string& className, int call) {
    return className == model().className && call == 2;
  };
  expectOutcome(model().pathFails, 1, 8);
}

TEST_P(AssociationBuilderFailureTest, AnInstanceOfTheAssociationCannotBeMade) {
  spoil(model().className, 2, unusableInstance());
  std::vector<CMPIInstance*> out;
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(unitLines(), framed(model().builderName));
  if (model().appendsUnmadeInstance) {
    ASSERT_EQ(out.size(), 9U);
    EXPECT_EQ(out[1], unusableInstance());
  } else {
    EXPECT_EQ(out.size(), 8U);
    EXPECT_EQ(std::count(out.begin(), out.end(), unusableInstance()), 0);
  }
}

INSTANTIATE_TEST_SUITE_P(Six, AssociationBuilderFailureTest,
                         ::testing::Combine(::testing::ValuesIn(associationParameters()), ::testing::Bool()),
                         [](const auto& parameter) {
                           return std::get<0>(parameter.param).model->className +
                                  (std::get<1>(parameter.param) ? "_null" : "_withoutHandle");
                         });

}  // namespace
