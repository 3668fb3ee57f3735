// Associators, AssociatorNames, References and ReferenceNames of the six providers, from either end, where the far end
// can be read.
#include "AssociationDirection.h"

namespace {

using Testing::Answer;
using Testing::Navigation;
using Testing::navigations;
using Testing::Strings;

using AssociationNavigationTest = Testing::AssociationDirectionTest;

TEST_P(AssociationNavigationTest, AssociatorsAnswerTheFarInstancesInTheirOrder) {
  const Answer answer = navigate(Navigation::Associators, source());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  Strings paths;
  for (const CMPIInstance* const instance : answer.instances) {
    paths.push_back(Testing::render(Testing::pathOf(instance)));
  }
  EXPECT_EQ(paths, farPaths(Testing::homedInstance));
  EXPECT_EQ(answer.order, (Strings{"instance", "instance", "instance"}));
}

TEST_P(AssociationNavigationTest, AssociatorNamesAnswerTheirPaths) {
  const Answer answer = navigate(Navigation::AssociatorNames, source());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  Strings paths;
  for (const CMPIObjectPath* const path : answer.paths) {
    paths.push_back(Testing::render(path));
  }
  EXPECT_EQ(paths, farPaths(Testing::homed));
  EXPECT_EQ(answer.order, (Strings{"path", "path", "path"}));
}

TEST_P(AssociationNavigationTest, AnAssociationThatTheClientDoesNotNameIsAnsweredWhereTheObjectManagerNamesIt) {
  // sfcb calls the provider once without the class, OpenPegasus once for each of its classes with the class's name.
  const bool named = Testing::personality().namesTheAssociation;
  const char* const associationClass = named ? model().className.c_str() : nullptr;
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    const Answer answer = navigate(navigation, source(), associationClass);
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    const bool asks = navigation == Navigation::Associators || navigation == Navigation::AssociatorNames;
    EXPECT_EQ(answer.order.size(), named || !asks ? 3U : 0U);
  }
}

TEST_P(AssociationNavigationTest, ReferencesTieTheSourceAsReceivedToEveryFarInstance) {
  const Answer answer = navigate(Navigation::References, source());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  Strings pairs;
  for (const CMPIInstance* const instance : answer.instances) {
    pairs.push_back(Testing::renderPair(instance, referenceToSource(), referenceToFar()));
  }
  EXPECT_EQ(pairs, sourceTiedToFarNames());
  EXPECT_EQ(answer.order, (Strings{"instance", "instance", "instance"}));
}

TEST_P(AssociationNavigationTest, ReferencesSetTheTwoReferencesAloneOnAKeylessPath) {
  farNames = {farNames.front()};
  navigate(Navigation::References, source());
  EXPECT_EQ(faults.instanceCalls[model().className],
            (Strings{"newInstance()", "setProperty(" + model().referenceToA + ")",
                     "setProperty(" + model().referenceToB + ")"}));
}

TEST_P(AssociationNavigationTest, ReferenceNamesAnswerThePathsOfTheReferencesAtHome) {
  const Answer answer = navigate(Navigation::ReferenceNames, source());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  EXPECT_EQ(answer.order, (Strings{"path", "path", "path"}));
  Strings pairs;
  for (const CMPIObjectPath* const path : answer.paths) {
    EXPECT_EQ(Testing::classOf(path), model().className);
    EXPECT_EQ(Testing::nameSpaceOf(path), Testing::requestNameSpace);
    EXPECT_EQ(Testing::hostOf(path), Testing::systemName());
    pairs.push_back(Testing::renderPair(path, referenceToSource(), referenceToFar()));
  }
  // References name the ends of element setting data otherwise than its keys are named.
  const bool hasKeys = model().className != Testing::Classes::elementSettingData;
  EXPECT_EQ(pairs, hasKeys ? sourceTiedToFarNames() : Strings(3, "(none) -> (none)"));
}

TEST_P(AssociationNavigationTest, TheReferenceIsMadeFirstAndTheFarEndsPathIsTakenOnce) {
  for (const Navigation navigation : {Navigation::References, Navigation::ReferenceNames}) {
    SCOPED_TRACE(nameOf(navigation));
    int taken = 0;
    Strings takenBefore;  // how many far paths had been taken when each reference was made
    faults.onNewInstance = [&](const std::string& className, int, CMPIInstance* instance) {
      if (className == farClass()) {
        Testing::withPathsCounted(instance, taken);
      } else {
        takenBefore.push_back(std::to_string(taken));
      }
    };
    navigate(navigation, source());
    EXPECT_EQ(takenBefore, (Strings{"0", "1", "2"}));
    EXPECT_EQ(taken, 3);
  }
}

TEST_P(AssociationNavigationTest, ReadsTheFarEndOnceWithoutFilterAndNeverCallsReturnDone) {
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    faults.upCalls.clear();
    faults.instanceCalls.clear();
    const Answer answer = navigate(navigation, source());
    EXPECT_EQ(answer.order.size(), 3U);
    EXPECT_EQ(underlyingCalls(), (Strings{Testing::underlyingClassOf(farClass())}));
    const std::string filter = faults.instanceCalls[farClass()].at(1);
    EXPECT_TRUE(filter.starts_with("setPropertyFilter(null; ")) << filter;
  }
}

TEST_P(AssociationNavigationTest, IsFramedByTheProvidersMarkers) {
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    Testing::logLines().clear();
    navigate(navigation, source());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

TEST_P(AssociationNavigationTest, LeavesTheSourcePathAsItWas) {
  const CMPIObjectPath* const path = source();
  const std::string before = Testing::text(CMObjectPathToString(path, nullptr));
  for (const Navigation navigation : navigations) {
    navigate(navigation, path);
    EXPECT_EQ(Testing::text(CMObjectPathToString(path, nullptr)), before);
    EXPECT_EQ(Testing::render(path),
              Testing::rendered(Testing::requestHost(), Testing::requestNameSpace, sourceClass(), sourceName()));
  }
}

TEST_P(AssociationNavigationTest, TheFarEndIsInTheNamespaceOfTheSource) {
  CMPIObjectPath* const path = source();
  CMSetNameSpace(path, "root/other");
  const auto expected = [&](const std::string& host) {
    return Testing::rendered(host, "root/other", farClass(), farNames.front());
  };

  const Answer associators = navigate(Navigation::Associators, path);
  EXPECT_EQ(Testing::render(Testing::pathOf(associators.instances.at(0))),
            expected(Testing::hostOfInstance(Testing::systemName())));
  const Answer names = navigate(Navigation::AssociatorNames, path);
  EXPECT_EQ(Testing::render(names.paths.at(0)), expected(Testing::systemName()));
  const Answer references = navigate(Navigation::References, path);
  EXPECT_EQ(Testing::render(Testing::reference(references.instances.at(0), referenceToFar())),
            expected(Testing::hostOfReference(Testing::systemName())));
  EXPECT_EQ(Testing::nameSpaceOf(Testing::pathOf(references.instances.at(0))), "root/other");
  const Answer referenceNames = navigate(Navigation::ReferenceNames, path);
  EXPECT_EQ(Testing::nameSpaceOf(referenceNames.paths.at(0)), "root/other");
}

TEST_P(AssociationNavigationTest, AnEmptyFarEndAnswersNothing) {
  farNames.clear();
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    Testing::logLines().clear();
    const Answer answer = navigate(navigation, source());
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

INSTANTIATE_DIRECTIONS(AssociationNavigationTest);

class ForeignAssociationTest : public Testing::AssociationTest {};

TEST_F(ForeignAssociationTest, AnEndThatTheProviderKnowsIsAnsweredOverAnotherAssociation) {
  attach(Testing::modelOf(Testing::Classes::hostedAccessPoint));
  add(Testing::Classes::endpoint, Strings{"eth0"});
  const CMPIObjectPath* const source = clientPath(Testing::Classes::remoteAccessPoint, "gateway");
  EXPECT_EQ(navigate(Navigation::Associators, source, Testing::Classes::clientAccess).order, (Strings{"instance"}));
  EXPECT_EQ(navigate(Navigation::AssociatorNames, source, Testing::Classes::clientAccess).order, (Strings{"path"}));
}

TEST_F(ForeignAssociationTest, AnEndThatTheProviderDoesNotKnowAnswersNothingAndEndsInOrder) {
  attach(Testing::modelOf(Testing::Classes::hostedAccessPoint));
  add(Testing::Classes::sequence, Strings{"BMC:eth0:static"});
  const CMPIObjectPath* const source = clientPath(Testing::Classes::endpoint, "eth0");
  for (const Navigation navigation : {Navigation::Associators, Navigation::AssociatorNames}) {
    Testing::logLines().clear();
    const Answer answer = navigate(navigation, source, Testing::Classes::elementSettingData);
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_TRUE(faults.upCalls.empty());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

}  // namespace
