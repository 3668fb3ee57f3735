// SPDX-License-Identifier: Apache-2.0
// Associators, AssociatorNames, References and ReferenceNames of the six providers, from either end, where the far end
// can be read.
#include "tests/providers/AssociationDirection.h"

namespace {

using namespace Testing;

using AssociationNavigationTest = AssociationDirectionTest;

TEST_P(AssociationNavigationTest, AssociatorsAnswerTheFarInstancesInTheirOrder) {
  const Answer answer = navigate(Navigation::Associators, source());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  Strings paths;
  for (const CMPIInstance* instance : answer.instances) {
    paths.push_back(render(pathOf(instance)));
  }
  EXPECT_EQ(paths, farPaths(homedInstance));
  EXPECT_EQ(answer.order, (Strings{"instance", "instance", "instance"}));
}

TEST_P(AssociationNavigationTest, AssociatorNamesAnswerTheirPaths) {
  const Answer answer = navigate(Navigation::AssociatorNames, source());
  EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
  Strings paths;
  for (const CMPIObjectPath* path : answer.paths) {
    paths.push_back(render(path));
  }
  EXPECT_EQ(paths, farPaths(homed));
  EXPECT_EQ(answer.order, (Strings{"path", "path", "path"}));
}

TEST_P(AssociationNavigationTest, AnAssociationThatTheClientDoesNotNameIsAnsweredWhereTheObjectManagerNamesIt) {
  // sfcb calls the provider once without the class, OpenPegasus once for each of its classes with the class's name.
  const bool named = personality().namesTheAssociation;
  const char* associationClass = named ? model().className.c_str() : nullptr;
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
  for (const CMPIInstance* instance : answer.instances) {
    pairs.push_back(renderPair(instance, referenceToSource(), referenceToFar()));
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
  for (const CMPIObjectPath* path : answer.paths) {
    EXPECT_EQ(classOf(path), model().className);
    EXPECT_EQ(nameSpaceOf(path), requestNameSpace);
    EXPECT_EQ(hostOf(path), systemName());
    pairs.push_back(renderPair(path, referenceToSource(), referenceToFar()));
  }
  // References name the ends of element setting data otherwise than its keys are named.
  const bool hasKeys = model().className != Classes::elementSettingData;
  EXPECT_EQ(pairs, hasKeys ? sourceTiedToFarNames() : Strings(3, "(none) -> (none)"));
}

TEST_P(AssociationNavigationTest, TheReferenceIsMadeFirstAndTheFarEndsPathIsTakenOnce) {
  for (const Navigation navigation : {Navigation::References, Navigation::ReferenceNames}) {
    SCOPED_TRACE(nameOf(navigation));
    int taken = 0;
    Strings takenBefore;  // how many far paths had been taken when each reference was made
    faults.onNewInstance = [&](const std::string& className, int, CMPIInstance* instance) {
      if (className == farClass()) {
        withPathsCounted(instance, taken);
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
    EXPECT_EQ(underlyingCalls(), (Strings{underlyingClassOf(farClass())}));
    const std::string filter = faults.instanceCalls[farClass()].at(1);
    EXPECT_TRUE(filter.starts_with("setPropertyFilter(null; ")) << filter;
  }
}

TEST_P(AssociationNavigationTest, IsFramedByTheProvidersMarkers) {
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    logLines().clear();
    navigate(navigation, source());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

TEST_P(AssociationNavigationTest, LeavesTheSourcePathAsItWas) {
  const CMPIObjectPath* path = source();
  const std::string before = text(CMObjectPathToString(path, nullptr));
  for (const Navigation navigation : navigations) {
    navigate(navigation, path);
    EXPECT_EQ(text(CMObjectPathToString(path, nullptr)), before);
    EXPECT_EQ(render(path), rendered(requestHost(), requestNameSpace, sourceClass(), sourceName()));
  }
}

TEST_P(AssociationNavigationTest, TheFarEndIsInTheNamespaceOfTheSource) {
  CMPIObjectPath* path = source();
  CMSetNameSpace(path, "root/other");
  const auto expected = [&](const std::string& host) {
    return rendered(host, "root/other", farClass(), farNames.front());
  };

  const Answer associators = navigate(Navigation::Associators, path);
  EXPECT_EQ(render(pathOf(associators.instances.at(0))), expected(hostOfInstance(systemName())));
  const Answer names = navigate(Navigation::AssociatorNames, path);
  EXPECT_EQ(render(names.paths.at(0)), expected(systemName()));
  const Answer references = navigate(Navigation::References, path);
  EXPECT_EQ(render(reference(references.instances.at(0), referenceToFar())), expected(hostOfReference(systemName())));
  EXPECT_EQ(nameSpaceOf(pathOf(references.instances.at(0))), "root/other");
  const Answer referenceNames = navigate(Navigation::ReferenceNames, path);
  EXPECT_EQ(nameSpaceOf(referenceNames.paths.at(0)), "root/other");
}

TEST_P(AssociationNavigationTest, AnEmptyFarEndAnswersNothing) {
  farNames.clear();
  for (const Navigation navigation : navigations) {
    SCOPED_TRACE(nameOf(navigation));
    logLines().clear();
    const Answer answer = navigate(navigation, source());
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

INSTANTIATE_DIRECTIONS(AssociationNavigationTest);

class ForeignAssociationTest : public AssociationTest {};

TEST_F(ForeignAssociationTest, AnEndThatTheProviderKnowsIsAnsweredOverAnotherAssociation) {
  attach(modelOf(Classes::hostedAccessPoint));
  add(Classes::endpoint, Strings{"eth0"});
  const CMPIObjectPath* source = clientPath(Classes::remoteAccessPoint, "gateway");
  EXPECT_EQ(navigate(Navigation::Associators, source, Classes::clientAccess).order, (Strings{"instance"}));
  EXPECT_EQ(navigate(Navigation::AssociatorNames, source, Classes::clientAccess).order, (Strings{"path"}));
}

TEST_F(ForeignAssociationTest, AnEndThatTheProviderDoesNotKnowAnswersNothingAndEndsInOrder) {
  attach(modelOf(Classes::hostedAccessPoint));
  add(Classes::sequence, Strings{"BMC:eth0:static"});
  const CMPIObjectPath* source = clientPath(Classes::endpoint, "eth0");
  for (const Navigation navigation : {Navigation::Associators, Navigation::AssociatorNames}) {
    logLines().clear();
    const Answer answer = navigate(navigation, source, Classes::elementSettingData);
    EXPECT_EQ(answer.status.rc, CMPI_RC_OK);
    EXPECT_TRUE(answer.order.empty());
    EXPECT_TRUE(faults.upCalls.empty());
    EXPECT_EQ(unitLines(), framed(unit().prefix + nameOf(navigation)));
  }
}

}  // namespace
