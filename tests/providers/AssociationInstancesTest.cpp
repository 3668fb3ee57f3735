// SPDX-License-Identifier: Apache-2.0
// GetInstance, EnumInstances and EnumInstanceNames of the six association classes.
#include <algorithm>

#include "tests/providers/AssociationTest.h"

namespace {

using namespace Testing;

class AssociationInstancesTest : public AssociationTest, public ::testing::WithParamInterface<AssociationParameter> {
 protected:
  AssociationInstancesTest() { attach(*GetParam().model); }

  void addThreeOfEach() { addEnds(model().outerNames, model().innerNames); }
  CMPIObjectPath* classPath() { return makePath(model().className); }

  std::string pairOf(std::size_t outer, std::size_t inner) const {
    return homedReference(model().outer, model().outerNames[outer]) + " -> " +
           homedReference(model().inner, model().innerNames[inner]);
  }
  Strings allPairs() const {
    Strings pairs;
    for (std::size_t outer = 0; outer < 3; ++outer) {
      for (std::size_t inner = 0; inner < 3; ++inner) {
        pairs.push_back(pairOf(outer, inner));
      }
    }
    return pairs;
  }
  template <typename Objects>
  Strings pairsOf(const Objects& objects) const {
    Strings pairs;
    for (const auto* object : objects) {
      pairs.push_back(renderPair(object, model().propertyOfOuter, model().propertyOfInner));
    }
    return pairs;
  }

  // The path of the association of that number, from 0, as a client sends it back: with hosts of its own.
  CMPIObjectPath* clientPathOf(std::size_t number) {
    const Answer names = read(Reading::EnumInstanceNames, classPath());
    CMPIObjectPath* path = classPath();
    for (const std::string& key : {model().propertyOfOuter, model().propertyOfInner}) {
      const CMPIData data = CMGetKey(names.paths.at(number), key.c_str(), nullptr);
      CMSetHostname(data.value.ref, "client.example");
      CMAddKey(path, key.c_str(), &data.value.ref, CMPI_ref);
    }
    forget();
    return path;
  }
  void forget() {
    logLines().clear();
    faults.upCalls.clear();
    faults.instanceCalls.clear();
  }

  // The builder's lines within the operation's.
  Strings framedAround(Reading reading, const Strings& inner) const {
    Strings lines = framed(unit().prefix + nameOf(reading));
    lines.insert(lines.begin() + 2, inner.begin(), inner.end());
    return lines;
  }
  std::string filterOfAssociation() { return faults.instanceCalls[model().className].at(1); }
};

TEST_P(AssociationInstancesTest, EnumInstancesAnswersAllAndIsDone) {
  addThreeOfEach();
  const Answer answer = read(Reading::EnumInstances, classPath());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  EXPECT_EQ(pairsOf(answer.instances), allPairs());
  Strings order(9, "instance");
  order.push_back("done");
  EXPECT_EQ(answer.order, order);
}

TEST_P(AssociationInstancesTest, EnumInstanceNamesAnswersAllPathsAndIsDone) {
  addThreeOfEach();
  const Answer answer = read(Reading::EnumInstanceNames, classPath());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  EXPECT_EQ(pairsOf(answer.paths), allPairs());
  for (const CMPIObjectPath* path : answer.paths) {
    EXPECT_EQ(classOf(path), model().className);
    EXPECT_EQ(nameSpaceOf(path), requestNameSpace);
    // The path goes out as the instance has it.
    EXPECT_EQ(hostOf(path), hostOfInstance(systemName()));
    EXPECT_EQ(CMGetKeyCount(path, nullptr), 2U);
  }
  Strings order(9, "path");
  order.push_back("done");
  EXPECT_EQ(answer.order, order);
}

TEST_P(AssociationInstancesTest, GetInstanceAnswersTheOneThatTheClientNames) {
  addThreeOfEach();
  const Answer answer = read(Reading::GetInstance, clientPathOf(5));
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  EXPECT_EQ(pairsOf(answer.instances), (Strings{pairOf(1, 2)}));
  EXPECT_EQ(answer.order, (Strings{"instance", "done"}));
}

TEST_P(AssociationInstancesTest, GetInstanceAnswersTheFirstOfSeveralMatches) {
  addEnds({model().outerNames[0], model().outerNames[0]}, {model().innerNames[0]});
  const CMPIObjectPath* path = clientPathOf(1);
  std::vector<const CMPIInstance*> made;
  faults.onNewInstance = [&](const std::string& className, int, CMPIInstance* instance) {
    if (className == model().className) {
      made.push_back(instance);
    }
  };
  const Answer answer = read(Reading::GetInstance, path);
  EXPECT_EQ(answer.order, (Strings{"instance", "done"}));
  ASSERT_EQ(made.size(), 2U);
  EXPECT_EQ(answer.instances.front(), made.front());
}

TEST_P(AssociationInstancesTest, GetInstanceOfNoSuchAssociationIsNoErrorAndAnswersNothing) {
  addThreeOfEach();
  const CMPIObjectPath* path = clientPathOf(0);
  faults.upCallScripts.clear();
  addEnds({model().outerNames[1]}, {model().innerNames[1]});
  const Answer answer = read(Reading::GetInstance, path);
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  EXPECT_EQ(answer.order, (Strings{"done"}));
}

TEST_P(AssociationInstancesTest, GetInstanceIsFineUntilSomethingSaysOtherwise) {
  CMPIObjectPath* path = countingKeysQuietly(clientPath(model().outer, model().outerNames[0]));
  EXPECT_EQ(read(Reading::GetInstance, path).status.rc, CMPI_RC_OK);
}

TEST_P(AssociationInstancesTest, GetInstanceComparesTheNamespaceToo) {
  addEnds({model().outerNames[0]}, {model().innerNames[0]});
  const CMPIObjectPath* path = clientPathOf(0);
  CMPIObjectPath* candidate = clientPathOf(0);
  faults.onNewInstance = [&](const std::string& className, int, CMPIInstance* instance) {
    if (className == model().className) {
      withPath(instance, candidate);
    }
  };
  EXPECT_EQ(read(Reading::GetInstance, path).order, (Strings{"instance", "done"}));
  CMSetNameSpace(candidate, "root/other");
  EXPECT_EQ(read(Reading::GetInstance, path).order, (Strings{"done"}));
}

TEST_P(AssociationInstancesTest, GetInstanceWithoutKeysIsNoErrorSaysSoAndReadsNothing) {
  addThreeOfEach();
  const Answer answer = read(Reading::GetInstance, countingNoKeys(classPath()));
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  EXPECT_EQ(answer.status.msg, nullptr);
  EXPECT_EQ(answer.order, (Strings{"done"}));
  EXPECT_TRUE(faults.upCalls.empty());
  EXPECT_TRUE(faults.traces.empty());
  EXPECT_EQ(unitLines(), framedAround(Reading::GetInstance, {messageLine("At least one key should be passed")}));
  for (const LogLine& line : logLines()) {
    EXPECT_EQ(line.level, line.message.starts_with("MESSAGE ") ? 6000 : 4000) << line.message;
  }
}

TEST_P(AssociationInstancesTest, IsFramedByTheProvidersMarkersAroundTheBuilders) {
  addThreeOfEach();
  for (const Reading reading : readings) {
    SCOPED_TRACE(nameOf(reading));
    const CMPIObjectPath* path = clientPathOf(0);
    read(reading, path);
    EXPECT_EQ(unitLines(), framedAround(reading, framed(model().builderName)));
    EXPECT_EQ(faults.upCalls.size(), 4U);
  }
}

TEST_P(AssociationInstancesTest, ThePropertyListFiltersInstancesAndNotNames) {
  addEnds({model().outerNames[0]}, {model().innerNames[0]});
  const char* properties[] = {"Caption", nullptr};
  for (const Reading reading : readings) {
    SCOPED_TRACE(nameOf(reading));
    const CMPIObjectPath* path = clientPathOf(0);
    read(reading, path, properties);
    EXPECT_EQ(filterOfAssociation(), std::string("setPropertyFilter(") +
                                         (reading == Reading::EnumInstanceNames ? "null" : "Caption") + "; " +
                                         model().filterKeys + ")");
  }
}

TEST_P(AssociationInstancesTest, AnUnmadeInstanceIsAnsweredAsItIsAndHasNoName) {
  addThreeOfEach();
  for (CMPIInstance* unusable : {static_cast<CMPIInstance*>(nullptr), withoutHandle()}) {
    faults.unmadeInstance = unusable;
    faults.failNewInstance = [&](const std::string& className, int call) {
      return className == model().className && call % 9 == 2;  // the second of each nine
    };
    const Answer instances = read(Reading::EnumInstances, classPath());
    if (model().appendsUnmadeInstance) {
      ASSERT_EQ(instances.instances.size(), 9U);
      EXPECT_EQ(instances.instances[1], unusable);
    } else {
      EXPECT_EQ(instances.instances.size(), 8U);
      EXPECT_EQ(std::count(instances.instances.begin(), instances.instances.end(), unusable), 0);
    }
    const Answer names = read(Reading::EnumInstanceNames, classPath());
    EXPECT_EQ(names.paths.size(), 8U);
    EXPECT_EQ(std::count(names.paths.begin(), names.paths.end(), nullptr), 0);
    // GetInstance passes over it on its way to the last.
    EXPECT_EQ(read(Reading::GetInstance, clientPathOf(7)).order, (Strings{"instance", "done"}));
  }
}

TEST_P(AssociationInstancesTest, AnInstanceWithoutPathHasNoNameAndMatchesNothing) {
  addThreeOfEach();
  const CMPIObjectPath* path = clientPathOf(0);
  for (CMPIObjectPath* unusable : {static_cast<CMPIObjectPath*>(nullptr), pathWithoutHandle()}) {
    faults.onNewInstance = [this, unusable](const std::string& className, int, CMPIInstance* instance) {
      if (className == model().className) {
        withPath(instance, unusable);
      }
    };
    EXPECT_EQ(read(Reading::EnumInstances, classPath()).instances.size(), 9U);
    EXPECT_EQ(read(Reading::EnumInstanceNames, classPath()).order, (Strings{"done"}));
    EXPECT_EQ(read(Reading::GetInstance, path).order, (Strings{"done"}));
  }
}

TEST_P(AssociationInstancesTest, AFailedBuilderAnswersNothingAndIsDoneAllTheSame) {
  addThreeOfEach();
  const CMPIObjectPath* path = clientPathOf(0);
  for (const Reading reading : readings) {
    SCOPED_TRACE(nameOf(reading));
    forget();
    refuseReading(model().inner, 2);
    const Answer answer = read(reading, path);
    const Outcome& outcome = model().innerFails;
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    // Where the builder calls it a success, what it built so far is answered.
    Strings order(outcome.result != 0 ? 0 : (reading == Reading::GetInstance ? 1 : 3),
                  reading == Reading::EnumInstanceNames ? "path" : "instance");
    order.push_back("done");
    EXPECT_EQ(answer.order, order);
    EXPECT_EQ(unitLines(), framedAround(reading, brokenOff(model().builderName, outcome.message)));
  }
}

TEST_P(AssociationInstancesTest, AnOuterEndThatCannotBeReadAnswersNothingWithoutError) {
  addThreeOfEach();
  const CMPIObjectPath* path = clientPathOf(0);
  for (const Reading reading : readings) {
    SCOPED_TRACE(nameOf(reading));
    forget();
    refuseReading(model().outer, 1);
    const Answer answer = read(reading, path);
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_EQ(answer.order, (Strings{"done"}));
    EXPECT_EQ(unitLines(), framedAround(reading, brokenOff(model().builderName, model().outerFails.message)));
  }
}

TEST_P(AssociationInstancesTest, AnEnumerationThatTheBrokerRefusesAnswersNothingWithoutError) {
  addThreeOfEach();
  const CMPIObjectPath* path = clientPathOf(0);
  faults.upCallScripts[underlyingClassOf(model().outer)].status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  for (const Reading reading : readings) {
    SCOPED_TRACE(nameOf(reading));
    const Answer answer = read(reading, path);
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_EQ(answer.order, (Strings{"done"}));
  }
}

INSTANTIATE_TEST_SUITE_P(Six, AssociationInstancesTest, ::testing::ValuesIn(associationParameters()),
                         [](const auto& parameter) { return parameter.param.model->className; });

}  // namespace
