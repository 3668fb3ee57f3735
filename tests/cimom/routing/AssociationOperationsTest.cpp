// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

class AssociationOperationsTest : public ManagedElementsFixture {
 protected:
  AssociationOperationsTest() {
    manager.loadSchemaText("class TST_Alone { [Key] string Name; };", testNamespace);
    hosted->serve(manager, "TST_Hosted", testNamespace, true);
    peers->serve(manager, "TST_Peers", testNamespace, true);
  }

  CMPIEnumeration* associators(const CMPIObjectPath* source, const char* association, const char* resultClass = nullptr,
                               const char* role = nullptr, const char* resultRole = nullptr) {
    return CBAssociators(broker, request.context(), source, association, resultClass, role, resultRole, nullptr,
                         &status);
  }

  CMPIEnumeration* associatorNames(const CMPIObjectPath* source, const char* association,
                                   const char* resultClass = nullptr, const char* role = nullptr,
                                   const char* resultRole = nullptr) {
    return CBAssociatorNames(broker, request.context(), source, association, resultClass, role, resultRole, &status);
  }

  CMPIEnumeration* references(const CMPIObjectPath* source, const char* association) {
    return CBReferences(broker, request.context(), source, association, "Antecedent", nullptr, &status);
  }

  CMPIObjectPath* point(CMPIUint16 number, const char* className = "TST_Point") const {
    CMPIObjectPath* made = path(className);
    CMAddKey(made, "Number", &number, CMPI_uint16);
    return made;
  }

  CMPIInstance* peersOf(CMPIObjectPath* left, CMPIObjectPath* right) const {
    CMPIInstance* association = CMNewInstance(broker, path("TST_Peers"), nullptr);
    CMSetProperty(association, "Left", &left, CMPI_ref);
    CMSetProperty(association, "Right", &right, CMPI_ref);
    return association;
  }

  // Point 1 is left of 2 and right of 3, and the provider answers both whatever role is asked for.
  void answerBothPeers() {
    peers->answer = [this](const auto&, const CMPIResult* result, const auto&, const auto&) {
      const std::string operation = peers->calls.back().operation;
      for (CMPIInstance* association : {peersOf(point(1), point(2)), peersOf(point(3), point(1))}) {
        if (operation == "references") {
          CMReturnInstance(result, association);
        } else if (operation == "referenceNames") {
          CMReturnObjectPath(result, CMGetObjectPath(association, nullptr));
        }
      }
      for (const CMPIUint16 number : {2, 3}) {
        if (operation == "associators") {
          CMReturnInstance(result, CMNewInstance(broker, point(number), nullptr));
        } else if (operation == "associatorNames") {
          CMReturnObjectPath(result, point(number));
        }
      }
      return ok;
    };
  }

  std::shared_ptr<RecordingProvider> hosted = std::make_shared<RecordingProvider>();
  std::shared_ptr<RecordingProvider> peers = std::make_shared<RecordingProvider>();
};

TEST_F(AssociationOperationsTest, TheNamedAssociationAloneIsAskedWithAllThatTheClientSays) {
  associators(systemPath("one"), "tst_hosted", "CIM_Point", "Antecedent", "Dependent");

  EXPECT_EQ(status.rc, CMPI_RC_OK);
  ASSERT_THAT(hosted->calls, SizeIs(1));
  EXPECT_EQ(hosted->calls[0].path, "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\"");
  EXPECT_EQ(hosted->calls[0].associationClass, "TST_Hosted");
  EXPECT_EQ(hosted->calls[0].resultClass, "CIM_Point");
  EXPECT_EQ(hosted->calls[0].role, "Antecedent");
  EXPECT_EQ(hosted->calls[0].resultRole, "Dependent");
  EXPECT_THAT(peers->calls, IsEmpty());
}

TEST_F(AssociationOperationsTest, AnAssociationIsAskedOnlyForWhatCanBeOneOfItsEnds) {
  for (const char* association : {"TST_Peers", "tst_hosted"}) {
    EXPECT_NE(associators(path("TST_Alone"), association), nullptr);
  }
  EXPECT_NE(associators(systemPath("one"), "TST_Peers"), nullptr);
  EXPECT_THAT(peers->calls, IsEmpty());
  EXPECT_THAT(hosted->calls, IsEmpty());
}

TEST_F(AssociationOperationsTest, AnAssociationIsAskedOnlyInRolesAndForClassesThatItHas) {
  EXPECT_NE(associators(systemPath("one"), "TST_Hosted", nullptr, "Dependent"), nullptr) << "a system is no dependent";
  EXPECT_NE(associators(systemPath("one"), "TST_Hosted", nullptr, "Nothing"), nullptr);
  EXPECT_NE(associators(systemPath("one"), "TST_Hosted", nullptr, nullptr, "Antecedent"), nullptr);
  EXPECT_NE(associators(systemPath("one"), "TST_Hosted", "CIM_System"), nullptr);
  EXPECT_NE(CBReferences(broker, request.context(), systemPath("one"), nullptr, "Dependent", nullptr, &status),
            nullptr);
  EXPECT_THAT(hosted->calls, IsEmpty());
  associators(systemPath("one"), "TST_Hosted", "CIM_Element", "antecedent", "dependent");
  associators(systemPath("one"), "TST_Hosted", "TST_Point");
  EXPECT_THAT(hosted->calls, SizeIs(2));
}

TEST_F(AssociationOperationsTest, WithoutChecksTheNamedAssociationIsAskedWhateverTheFilterSays) {
  manager.setStrictness(Strictness::Bare);
  EXPECT_NE(associators(systemPath("one"), "TST_Peers", "TST_Nothing", "Nothing"), nullptr);
  EXPECT_THAT(peers->calls, SizeIs(1));
  answerBothPeers();
  EXPECT_THAT(pathsOf(associatorNames(point(1), "TST_Peers", "CIM_System", "Left")), SizeIs(2));
  EXPECT_THAT(pathsOf(CBReferences(broker, request.context(), point(1), nullptr, "Left", nullptr, &status)), SizeIs(2));
  EXPECT_EQ(associators(systemPath("one"), "TST_Nowhere"), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(AssociationOperationsTest, RolesTellTheTwoDirectionsOfAnAssociationApart) {
  answerBothPeers();
  const std::string two = "root/test:TST_Point.Number=2";
  const std::string three = "root/test:TST_Point.Number=3";
  EXPECT_THAT(pathsOf(associators(point(1), "TST_Peers")), ElementsAre(two, three));
  EXPECT_THAT(pathsOf(associators(point(1), "TST_Peers", nullptr, "left")), ElementsAre(two));
  EXPECT_THAT(pathsOf(associators(point(1), "TST_Peers", nullptr, nullptr, "Left")), ElementsAre(three));
  EXPECT_THAT(pathsOf(associatorNames(point(1), "TST_Peers", nullptr, "Right", "Left")), ElementsAre(three));
  EXPECT_THAT(pathsOf(associatorNames(point(1), "TST_Peers", nullptr, "Left", "Left")), IsEmpty());
}

TEST_F(AssociationOperationsTest, ReferencesAreThoseInWhichTheSourceHasTheRole) {
  answerBothPeers();
  const auto found = [&](const char* role) {
    const auto instances =
        pathsOf(CBReferences(broker, request.context(), point(1), "TST_Peers", role, nullptr, &status));
    EXPECT_EQ(pathsOf(CBReferenceNames(broker, request.context(), point(1), "TST_Peers", role, &status)), instances);
    return instances;
  };
  EXPECT_THAT(found(nullptr), SizeIs(2));
  EXPECT_THAT(found("Left"), ElementsAre(HasSubstr("Right=\"root/test:TST_Point.Number=2\"")));
  EXPECT_THAT(found("Right"), ElementsAre(HasSubstr("Left=\"root/test:TST_Point.Number=3\"")));
}

// A path says only what is a key: what it does not say of a role, the provider knows.
TEST_F(AssociationOperationsTest, AReferenceNameWithoutTheRoleIsTakenAnInstanceIsNot) {
  peers->answer = [this](const auto&, const CMPIResult* result, const auto&, const auto&) {
    if (peers->calls.back().operation == "referenceNames") {
      CMReturnObjectPath(result, path("TST_Peers"));
    } else {
      CMReturnInstance(result, CMNewInstance(broker, path("TST_Peers"), nullptr));
    }
    return ok;
  };
  EXPECT_THAT(pathsOf(CBReferenceNames(broker, request.context(), point(1), nullptr, "Left", &status)), SizeIs(1));
  EXPECT_THAT(pathsOf(CBReferences(broker, request.context(), point(1), nullptr, "Left", nullptr, &status)), IsEmpty());
}

TEST_F(AssociationOperationsTest, ResultsAreOfTheAskedClass) {
  hosted->answer = [this](const auto&, const CMPIResult* result, const auto&, const auto&) {
    for (CMPIObjectPath* found : {point(1, "CIM_Point"), point(2)}) {
      if (hosted->calls.back().operation == "associators") {
        CMReturnInstance(result, CMNewInstance(broker, found, nullptr));
      } else {
        CMReturnObjectPath(result, found);
      }
    }
    return ok;
  };
  for (const char* resultClass : {"CIM_Element", "cim_point"}) {
    EXPECT_THAT(pathsOf(associators(systemPath("one"), nullptr, resultClass)), SizeIs(2));
    EXPECT_THAT(pathsOf(associatorNames(systemPath("one"), nullptr, resultClass)), SizeIs(2));
  }
  EXPECT_THAT(pathsOf(associators(systemPath("one"), nullptr, "TST_Point")),
              ElementsAre("root/test:TST_Point.Number=2"));
  EXPECT_THAT(pathsOf(associatorNames(systemPath("one"), nullptr, "TST_Point")),
              ElementsAre("root/test:TST_Point.Number=2"));
}

TEST_F(AssociationOperationsTest, ASourceThatIsNotThereFindsNothing) {
  std::shared_ptr<RecordingProvider> systems = std::make_shared<RecordingProvider>();
  systems->serve(manager, "TST_Processor", testNamespace);
  EXPECT_EQ(associators(systemPath("gone"), nullptr), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  EXPECT_EQ(references(systemPath("gone"), "TST_Hosted"), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  EXPECT_THAT(hosted->calls, IsEmpty());
  ASSERT_THAT(systems->calls, SizeIs(2));
  EXPECT_EQ(systems->calls[0].operation, "getInstance");

  systems->answer = [this](const auto&, const CMPIResult* result, const auto&, const auto&) {
    CMReturnInstance(result, system("one"));
    return ok;
  };
  EXPECT_NE(associators(systemPath("one"), nullptr), nullptr);
  EXPECT_THAT(hosted->calls, SizeIs(1));
  systems->answer = [](const auto&...) { return CMPIStatus{CMPI_RC_ERR_NOT_SUPPORTED, nullptr}; };
  EXPECT_NE(associators(systemPath("one"), nullptr), nullptr) << "the provider cannot say";
  EXPECT_THAT(hosted->calls, SizeIs(2));

  manager.setStrictness(Strictness::Bare);
  systems->calls.clear();
  EXPECT_NE(associators(systemPath("gone"), nullptr), nullptr);
  EXPECT_THAT(systems->calls, IsEmpty());
  EXPECT_THAT(hosted->calls, SizeIs(3));
}

TEST_F(AssociationOperationsTest, ASuperclassStandsForTheRegisteredSubclasses) {
  associators(systemPath("one"), "CIM_Hosted");
  ASSERT_THAT(hosted->calls, SizeIs(1));
  EXPECT_EQ(hosted->calls[0].associationClass, "TST_Hosted") << "the concrete class is filled in";
  EXPECT_THAT(peers->calls, IsEmpty());
}

TEST_F(AssociationOperationsTest, WithoutAClassEveryAssociationThatFitsTheSourceIsAskedOnce) {
  associators(systemPath("one"), nullptr);
  ASSERT_THAT(hosted->calls, SizeIs(1));
  EXPECT_EQ(hosted->calls[0].associationClass, "TST_Hosted");
  EXPECT_THAT(peers->calls, IsEmpty()) << "a system is no end of TST_Peers";

  associators(path("TST_Point"), nullptr);
  EXPECT_THAT(hosted->calls, SizeIs(2));
  ASSERT_THAT(peers->calls, SizeIs(1)) << "both references fit, and still one call";
  EXPECT_EQ(peers->calls[0].associationClass, "TST_Peers");
}

TEST_F(AssociationOperationsTest, ReferencesGetTheAssociationClassAsResultClass) {
  references(systemPath("one"), nullptr);
  references(systemPath("one"), "CIM_Hosted");
  CBReferenceNames(broker, request.context(), systemPath("one"), nullptr, nullptr, &status);
  ASSERT_THAT(hosted->calls, SizeIs(3));
  for (const Call& call : hosted->calls) {
    EXPECT_EQ(call.resultClass, "TST_Hosted");
  }
  EXPECT_EQ(hosted->calls[0].role, "Antecedent");
  EXPECT_EQ(hosted->calls[2].operation, "referenceNames");
}

TEST_F(AssociationOperationsTest, AssociatorNamesReachTheProvider) {
  hosted->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIObjectPath* far = systemPath("far");
    CMSetHostname(far, "host");
    CMReturnObjectPath(result, far);
    return ok;
  };
  CMPIEnumeration* found =
      CBAssociatorNames(broker, request.context(), systemPath("one"), nullptr, nullptr, nullptr, nullptr, &status);
  EXPECT_THAT(pathsOf(found),
              ElementsAre("//host/root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"far\""));
}

TEST_F(AssociationOperationsTest, AnUnknownAssociationClassIsAWrongParameter) {
  EXPECT_EQ(associators(systemPath("one"), "TST_Nothing"), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_THAT(shownText(status.msg), HasSubstr("TST_Nothing"));
  EXPECT_EQ(associators(systemPath("one"), "TST_Point"), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(shownText(status.msg), "class TST_Point is not an association");
  EXPECT_EQ(associators(systemPath("one"), nullptr, "TST_Nothing"), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(shownText(status.msg), "unknown result class \"TST_Nothing\"");
}

TEST_F(AssociationOperationsTest, AnUnknownSourceClassOrNamespaceIsRefused) {
  EXPECT_EQ(associators(path("TST_Nothing"), nullptr), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
  EXPECT_EQ(associators(path("TST_Point", "root/nowhere"), nullptr), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_NAMESPACE);
}

TEST_F(AssociationOperationsTest, OneProvidersFailureIsTheOperations) {
  peers->answer = [this](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                         const CMPIInstance*) -> CMPIStatus {
    CMReturnWithChars(broker, CMPI_RC_ERR_FAILED, "broken");
  };
  EXPECT_EQ(associators(path("TST_Point"), nullptr), nullptr);
  EXPECT_EQ(shownText(status.msg), "broken");
}

TEST_F(AssociationOperationsTest, AnAssociationInstanceMadeOnAKeylessPathGetsItsReferencesAsKeys) {
  CMPIObjectPath* system = systemPath("one");
  CMPIObjectPath* point = path("TST_Point");
  const CMPIUint16 number = 4;
  CMAddKey(point, "Number", &number, CMPI_uint16);
  hosted->answer = [&](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIInstance* association = CMNewInstance(broker, path("TST_Hosted"), nullptr);
    CMSetProperty(association, "Antecedent", &system, CMPI_ref);
    CMSetProperty(association, "Dependent", &point, CMPI_ref);
    CMReturnInstance(result, association);
    return ok;
  };
  EXPECT_THAT(pathsOf(references(system, nullptr)),
              ElementsAre("root/test:TST_Hosted.Antecedent=\"root/test:TST_Processor.CreationClassName="
                          "\\\"TST_Processor\\\",Name=\\\"one\\\"\",Dependent=\"root/test:TST_Point.Number=4\""));
  EXPECT_THAT(pathsOf(CBEnumInstances(broker, request.context(), path("CIM_Hosted"), nullptr, &status)), SizeIs(1));
}

TEST_F(AssociationOperationsTest, AnAssociationThatIsRegisteredForInstancesOnlyIsNotTraversed) {
  std::shared_ptr<RecordingProvider> quiet = std::make_shared<RecordingProvider>();
  ObjectManager other;
  other.loadSchemaText(testSchema, testNamespace);
  quiet->serve(other, "TST_Hosted", testNamespace, false);
  const RequestScope scope(other.broker());
  const auto* source = CMNewObjectPath(other.broker(), testNamespace, "TST_Processor", nullptr);
  EXPECT_NE(
      CBReferences(other.broker(), RequestScope::current()->context(), source, "TST_Hosted", nullptr, nullptr, &status),
      nullptr);
  EXPECT_THAT(quiet->calls, IsEmpty());
}

}  // namespace
