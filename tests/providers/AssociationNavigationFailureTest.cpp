// SPDX-License-Identifier: Apache-2.0
// The four association operations where the model has no far end, the far end cannot be read, or the broker cannot make
// what they ask for.
#include <algorithm>
#include <cctype>

#include "tests/providers/AssociationDirection.h"

namespace {

using namespace Testing;

bool isReference(Navigation navigation) {
  return navigation == Navigation::References || navigation == Navigation::ReferenceNames;
}

// ReferenceNames shares the text of References.
std::string nullMessage(Navigation navigation) {
  return "Object Path is NULL in " + std::string(isReference(navigation) ? "References" : nameOf(navigation)) + ".";
}

class AssociationNavigationFailureTest : public AssociationDirectionTest {
 protected:
  // Runs an operation that finds no far end: nothing is read or answered, and it breaks off with its message.
  void expectNoFarEnd(Navigation navigation, const CMPIObjectPath* path, const char* associationClass, CMPIrc rc) {
    SCOPED_TRACE(nameOf(navigation));
    logLines().clear();
    const Answer answer = navigate(navigation, path, associationClass);
    EXPECT_EQ(answer.status.rc, rc);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_TRUE(faults.upCalls.empty());
    EXPECT_EQ(unitLines(), brokenOff(unit().prefix + nameOf(navigation), nullMessage(navigation)));
    EXPECT_EQ(failureLevels(), (std::vector<int>{6000, 6000})) << "in the log and in the trace";
  }
  void expectNoFarEnd(Navigation navigation, const CMPIObjectPath* path, CMPIrc rc = CMPI_RC_OK) {
    expectNoFarEnd(navigation, path, model().className.c_str(), rc);
  }

  std::vector<int> failureLevels() const {
    std::vector<int> levels;
    for (const LogLine& line : logLines()) {
      if (line.component == unit().component && line.message.starts_with("MESSAGE ")) {
        levels.push_back(line.level);
      }
    }
    return levels;
  }

  // What a framed operation over the three far instances answers: "instance", "path" or "null" for each.
  Strings answered(Navigation navigation) {
    const Answer answer = navigate(navigation, source());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
    Strings result;
    for (const CMPIInstance* instance : answer.instances) {
      result.push_back(CMIsNullObject(instance) ? "null" : "instance");
    }
    for (const CMPIObjectPath* path : answer.paths) {
      result.push_back(CMIsNullObject(path) ? "null" : "path");
    }
    logLines().clear();
    return result;
  }

  static std::size_t usable(const Answer& answer) {
    return static_cast<std::size_t>(
        std::count_if(answer.instances.begin(), answer.instances.end(),
                      [](const CMPIInstance* instance) { return !CMIsNullObject(instance); }));
  }

  // How many of three there are where the object manager does not know the class.
  const std::size_t instancesOfUnknownClass = personality().unknownClass == UnknownClass::HasNoInstance ? 0 : 3;
  const std::size_t namesOfUnknownClass = personality().unknownClass == UnknownClass::HasKeylessPaths ? 3 : 0;

  void spoilFar(CMPIInstance* unusable) {
    // Every reading counts on from the one before: the second of each three.
    faults.unmadeInstance = unusable;
    faults.failNewInstance = [this](const std::string& className, int call) {
      return className == farClass() && call % 3 == 2;
    };
  }
};

TEST_P(AssociationNavigationFailureTest, ASourceOutsideTheModelIsNoErrorAndAnswersNothing) {
  for (const Navigation navigation : navigations) {
    expectNoFarEnd(navigation, makePath("CIM_ManagedElement", {{"InstanceID", "BMC:eth0"}}));
  }
}

TEST_P(AssociationNavigationFailureTest, AnAssociationOutsideTheModelIsNoErrorAndAnswersNothing) {
  for (const char* associationClass : {"CIM_Dependency", "", static_cast<const char*>(nullptr)}) {
    expectNoFarEnd(Navigation::Associators, source(), associationClass, CMPI_RC_OK);
    expectNoFarEnd(Navigation::AssociatorNames, source(), associationClass, CMPI_RC_OK);
  }
}

TEST_P(AssociationNavigationFailureTest, ATargetPathThatTheBrokerCannotMakeBreaksOff) {
  for (CMPIObjectPath* unusable : {static_cast<CMPIObjectPath*>(nullptr), pathWithoutHandle()}) {
    faults.unmadePath = unusable;
    faults.failNewObjectPath = [this](const std::string& className, int) { return className == farClass(); };
    for (const Navigation navigation : navigations) {
      // What the references' status tells of is the association's path, which is made next.
      const CMPIrc rc = isReference(navigation) ? CMPI_RC_OK : CMPI_RC_ERR_FAILED;
      expectNoFarEnd(navigation, source(), rc);
    }
  }
}

TEST_P(AssociationNavigationFailureTest, TheTargetsClassIsComparedToTheLetter) {
  std::string lowerCase = farClass();
  std::transform(lowerCase.begin(), lowerCase.end(), lowerCase.begin(),
                 [](unsigned char c) { return std::tolower(c); });
  faults.unmadePath = makePath(lowerCase);
  faults.failNewObjectPath = [this](const std::string& className, int) { return className == farClass(); };
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    logLines().clear();
    EXPECT_TRUE(navigate(navigation, source()).order.empty());
    EXPECT_TRUE(faults.upCalls.empty());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

TEST_P(AssociationNavigationFailureTest, AFarEndThatCannotBeReadEndsWithoutExitMarker) {
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    logLines().clear();
    refuseReading(farClass(), 1);
    const Answer answer = navigate(navigation, source());
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_EQ(unitLines(), brokenOff(unit().prefix + nameOf(navigation), ""));
  }
}

TEST_P(AssociationNavigationFailureTest, AnEnumerationThatTheBrokerRefusesLeavesItsStatus) {
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    logLines().clear();
    const CMPIObjectPath* path = source();
    faults.upCallScripts[underlyingClassOf(farClass())].status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    const Answer answer = navigate(navigation, path);
    EXPECT_EQ(answer.status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

TEST_P(AssociationNavigationFailureTest, AFarInstanceThatCouldNotBeMadeIsAnsweredAsItIsAndHasNoName) {
  for (CMPIInstance* unusable : {static_cast<CMPIInstance*>(nullptr), withoutHandle()}) {
    spoilFar(unusable);
    // Without an "InstanceID" nothing is associated where the identifiers decide.
    const bool skips = model().pairsByIdentifier;
    EXPECT_EQ(answered(Navigation::Associators),
              skips ? (Strings{"instance", "instance"}) : (Strings{"instance", "null", "instance"}));
    EXPECT_EQ(answered(Navigation::AssociatorNames), (Strings{"path", "path"}));
    EXPECT_EQ(answered(Navigation::References),
              skips ? (Strings{"instance", "instance"}) : (Strings{"instance", "instance", "instance"}));
    EXPECT_EQ(answered(Navigation::ReferenceNames), (Strings{"path", "path"}));
  }
}

TEST_P(AssociationNavigationFailureTest, AReferenceToAnUnmadeFarInstanceHasItsSourceAlone) {
  if (model().pairsByIdentifier) {
    return;  // told above: it is skipped
  }
  spoilFar(nullptr);
  const Answer answer = navigate(Navigation::References, source());
  ASSERT_EQ(answer.instances.size(), 3U);
  const CMPIInstance* reference = answer.instances[1];
  EXPECT_EQ(render(Testing::reference(reference, referenceToSource())), sourceReference());
  EXPECT_EQ(Testing::reference(reference, referenceToFar()), nullptr);
}

TEST_P(AssociationNavigationFailureTest, AFarInstanceWithoutPathHasNoName) {
  for (CMPIObjectPath* unusable : {static_cast<CMPIObjectPath*>(nullptr), pathWithoutHandle()}) {
    faults.onNewInstance = [this, unusable](const std::string& className, int call, CMPIInstance* instance) {
      if (className == farClass() && call % 3 == 2) {
        withPath(instance, unusable);
      }
    };
    EXPECT_EQ(answered(Navigation::Associators), (Strings{"instance", "instance", "instance"}));
    EXPECT_EQ(answered(Navigation::AssociatorNames), (Strings{"path", "path"}));
    EXPECT_EQ(answered(Navigation::ReferenceNames), (Strings{"path", "path"}));
  }
}

TEST_P(AssociationNavigationFailureTest, AReferenceThatCouldNotBeMadeIsAnsweredAsItIsAndHasNoName) {
  for (CMPIInstance* unusable : {static_cast<CMPIInstance*>(nullptr), withoutHandle()}) {
    faults.unmadeInstance = unusable;
    faults.failNewInstance = [this](const std::string& className, int call) {
      return className == model().className && call % 3 == 2;
    };
    EXPECT_EQ(answered(Navigation::References), (Strings{"instance", "null", "instance"}));
    EXPECT_EQ(answered(Navigation::ReferenceNames), (Strings{"path", "path"}));
  }
}

TEST_P(AssociationNavigationFailureTest, WithoutAPathForTheAssociationNoReferenceIsMade) {
  faults.failNewObjectPath = [this](const std::string& className, int) { return className == model().className; };
  EXPECT_EQ(answered(Navigation::References), (Strings{"null", "null", "null"}));
  EXPECT_EQ(answered(Navigation::ReferenceNames), Strings{});
}

TEST_P(AssociationNavigationFailureTest, AFarEndOfAClassThatTheObjectManagerDoesNotKnowIsAnsweredAsFarAsItCanBeMade) {
  const CMPIObjectPath* path = source();
  faults.forgetClass(farClass());
  EXPECT_EQ(usable(navigate(Navigation::Associators, path)), instancesOfUnknownClass);
  EXPECT_EQ(navigate(Navigation::AssociatorNames, path).order.size(), namesOfUnknownClass);
  EXPECT_EQ(navigate(Navigation::ReferenceNames, path).order.size(), namesOfUnknownClass);
  for (const CMPIInstance* reference : navigate(Navigation::References, path).instances) {
    EXPECT_EQ(Testing::reference(reference, referenceToFar()) != nullptr, namesOfUnknownClass > 0);
  }
}

TEST_P(AssociationNavigationFailureTest, AnAssociationThatTheObjectManagerDoesNotKnowIsAnsweredAsFarAsItCanBeMade) {
  const CMPIObjectPath* path = source();
  faults.forgetClass(model().className);
  EXPECT_EQ(usable(navigate(Navigation::Associators, path)), 3U);
  EXPECT_EQ(navigate(Navigation::AssociatorNames, path).paths.size(), 3U);
  EXPECT_EQ(usable(navigate(Navigation::References, path)), instancesOfUnknownClass);
  EXPECT_EQ(navigate(Navigation::ReferenceNames, path).order.size(), namesOfUnknownClass);
}

INSTANTIATE_DIRECTIONS(AssociationNavigationFailureTest);

}  // namespace
