// SPDX-License-Identifier: Apache-2.0
// What the six builders make when nothing goes wrong: pairs, order, properties, paths, up-calls and the frame.
#include "tests/providers/AssociationTest.h"

namespace {

using namespace Testing;

class AssociationBuilderTest : public AssociationTest, public ::testing::WithParamInterface<AssociationParameter> {
 protected:
  AssociationBuilderTest() { attach(*GetParam().model); }

  // "outer -> inner" of every instance.
  Strings pairs() const {
    Strings all;
    for (const CMPIInstance* instance : out) {
      all.push_back(renderPair(instance, model().propertyOfOuter, model().propertyOfInner));
    }
    return all;
  }
  std::string pairOf(std::size_t outer, std::size_t inner) const {
    return homedReference(model().outer, model().outerNames[outer]) + " -> " +
           homedReference(model().inner, model().innerNames[inner]);
  }
  // The first `outers` and `inners` of the model's names.
  void addEnds(std::size_t outers, std::size_t inners) {
    add(model().outer, Strings(model().outerNames.begin(), model().outerNames.begin() + static_cast<long>(outers)));
    add(model().inner, Strings(model().innerNames.begin(), model().innerNames.begin() + static_cast<long>(inners)));
  }

  std::vector<CMPIInstance*> out;
};

TEST_P(AssociationBuilderTest, PairsEveryOuterWithEveryInnerOuterByOuter) {
  addEnds(2, 3);
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(pairs(), (Strings{pairOf(0, 0), pairOf(0, 1), pairOf(0, 2), pairOf(1, 0), pairOf(1, 1), pairOf(1, 2)}));
}

TEST_P(AssociationBuilderTest, AppendsToWhatIsThere) {
  addEnds(1, 1);
  CMPIInstance* earlier = withoutHandle();
  out = {earlier};
  EXPECT_EQ(build(out), 0);
  ASSERT_EQ(out.size(), 2U);
  EXPECT_EQ(out[0], earlier);
}

TEST_P(AssociationBuilderTest, FiltersAndFillsEveryInstanceInTheFixedOrder) {
  addEnds(1, 1);
  EXPECT_EQ(build(out), 0);
  Strings expected = {"newInstance(" + model().keysOfPath + ")", "setPropertyFilter(null; " + model().filterKeys + ")"};
  for (const std::string& property : model().propertiesSet) {
    expected.push_back("setProperty(" + property + ")");
  }
  EXPECT_EQ(faults.instanceCalls[model().className], expected);
}

TEST_P(AssociationBuilderTest, TheClientsPropertyListFiltersTheAssociationAndNotItsEnds) {
  addEnds(1, 1);
  const char* properties[] = {"Caption", "IsNext", nullptr};
  EXPECT_EQ(build(out, properties), 0);
  EXPECT_EQ(faults.instanceCalls[model().className].at(1),
            "setPropertyFilter(Caption, IsNext; " + model().filterKeys + ")");
  for (const std::string& end : {model().outer, model().inner}) {
    const std::string filter = faults.instanceCalls[end].at(1);
    EXPECT_TRUE(filter.starts_with("setPropertyFilter(null; ")) << filter;
  }
  EXPECT_EQ(pairs(), (Strings{pairOf(0, 0)}));
}

TEST_P(AssociationBuilderTest, EveryPathHasTheRequestsNamespaceAndTheSystemsName) {
  addEnds(1, 1);
  CMPIObjectPath* request = makePath(model().className);
  CMSetNameSpace(request, "root/other");
  CMSetHostname(request, "client.example");
  EXPECT_EQ(model().build(request, nullptr, context(), out), 0);
  ASSERT_EQ(out.size(), 1U);
  const auto rehomed = [](const std::string& className, const std::string& name) {
    return rendered(hostOfReference(systemName()), "root/other", className, name);
  };
  EXPECT_EQ(renderPair(out[0], model().propertyOfOuter, model().propertyOfInner),
            rehomed(model().outer, model().outerNames[0]) + " -> " + rehomed(model().inner, model().innerNames[0]));
  const CMPIObjectPath* path = pathOf(out[0]);
  EXPECT_EQ(classOf(path), model().className);
  EXPECT_EQ(nameSpaceOf(path), "root/other");
  EXPECT_EQ(hostOf(path), hostOfInstance(systemName()));
}

TEST_P(AssociationBuilderTest, ThePathsOfTheInstancesHaveTheReferencesAsKeys) {
  addEnds(1, 1);
  EXPECT_EQ(build(out), 0);
  ASSERT_EQ(out.size(), 1U);
  const CMPIObjectPath* path = pathOf(out[0]);
  EXPECT_EQ(CMGetKeyCount(path, nullptr), 2U);
  EXPECT_EQ(renderPair(path, model().propertyOfOuter, model().propertyOfInner), pairOf(0, 0));
}

TEST_P(AssociationBuilderTest, ReadsTheOuterEndOnceAndTheInnerEndAfreshForEveryOuter) {
  addEnds(2, 1);
  // What appears while the builder runs is seen by the next outer instance.
  faults.onUpCall = [&](const UpCall&) {
    if (faults.upCalls.size() == 3) {
      AssociationTest::add(model().inner, model().innerNames[1]);
    }
  };
  EXPECT_EQ(build(out), 0);
  const std::string outer = underlyingClassOf(model().outer);
  const std::string inner = underlyingClassOf(model().inner);
  EXPECT_EQ(underlyingCalls(), (Strings{outer, inner, inner}));
  EXPECT_EQ(pairs(), (Strings{pairOf(0, 0), pairOf(1, 0), pairOf(1, 1)}));
}

TEST_P(AssociationBuilderTest, WithoutOuterInstancesNothingIsBuiltAndTheInnerEndIsNotRead) {
  addEnds(0, 2);
  EXPECT_EQ(build(out), 0);
  EXPECT_TRUE(out.empty());
  EXPECT_EQ(underlyingCalls(), (Strings{underlyingClassOf(model().outer)}));
  EXPECT_EQ(unitLines(), framed(model().builderName));
}

TEST_P(AssociationBuilderTest, WithoutInnerInstancesNothingIsBuilt) {
  addEnds(2, 0);
  EXPECT_EQ(build(out), 0);
  EXPECT_TRUE(out.empty());
  EXPECT_EQ(faults.upCalls.size(), 3U);
  EXPECT_EQ(unitLines(), framed(model().builderName));
}

TEST_P(AssociationBuilderTest, AnEnumerationThatTheBrokerRefusesYieldsAnEmptyEnd) {
  addEnds(2, 2);
  faults.upCallScripts[underlyingClassOf(model().inner)].status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(faults.upCalls.size(), 3U);
  faults.upCallScripts[underlyingClassOf(model().outer)].status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(faults.upCalls.size(), 4U);
  EXPECT_TRUE(out.empty());
}

TEST_P(AssociationBuilderTest, IsFramedByItsMarkersAtTheirSourceLines) {
  addEnds(1, 1);
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(unitLines(), framed(model().builderName));
  for (const LogLine& line : logLines()) {
    if (line.component == unit().component) {
      EXPECT_EQ(line.level, 4000) << line.message;
    }
  }
  if (model().entryLine != 0) {
    const std::string location = model().builderName + "() in " + unit().file + " [Line: ";
    lineWith("ENTERING: " + location + std::to_string(model().entryLine) + "]");
    lineWith("EXITING: " + location + std::to_string(model().exitLine) + "]");
  }
}

TEST_P(AssociationBuilderTest, EndsWithoutPathAreSkipped) {
  addEnds(3, 3);
  faults.onNewInstance = [&](const std::string& className, int call, CMPIInstance* instance) {
    if ((className == model().outer || className == model().inner) && call <= 2) {
      withPath(instance, call == 1 ? nullptr : pathWithoutHandle());
    }
  };
  EXPECT_EQ(build(out), 0);
  // The first two outers do not count; of the inners read for the third one, the first two do not.
  EXPECT_EQ(pairs(), (Strings{pairOf(2, 2)}));
  EXPECT_EQ(unitLines(), framed(model().builderName));
}

INSTANTIATE_TEST_SUITE_P(Six, AssociationBuilderTest, ::testing::ValuesIn(associationParameters()),
                         [](const auto& parameter) { return parameter.param.model->className; });

}  // namespace
