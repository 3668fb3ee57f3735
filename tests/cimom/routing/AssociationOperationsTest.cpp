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
    hosted->serve(manager, "TST_Hosted", testNamespace, true);
    peers->serve(manager, "TST_Peers", testNamespace, true);
  }

  CMPIEnumeration* associators(const CMPIObjectPath* source, const char* association) {
    return CBAssociators(broker, request.context(), source, association, "CIM_Point", "Antecedent", "Dependent",
                         nullptr, &status);
  }

  CMPIEnumeration* references(const CMPIObjectPath* source, const char* association) {
    return CBReferences(broker, request.context(), source, association, "Antecedent", nullptr, &status);
  }

  std::shared_ptr<RecordingProvider> hosted = std::make_shared<RecordingProvider>();
  std::shared_ptr<RecordingProvider> peers = std::make_shared<RecordingProvider>();
};

TEST_F(AssociationOperationsTest, TheNamedAssociationAloneIsAskedWithAllThatTheClientSays) {
  associators(systemPath("one"), "tst_hosted");

  EXPECT_EQ(status.rc, CMPI_RC_OK);
  ASSERT_THAT(hosted->calls, SizeIs(1));
  EXPECT_EQ(hosted->calls[0].path, "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\"");
  EXPECT_EQ(hosted->calls[0].associationClass, "TST_Hosted");
  EXPECT_EQ(hosted->calls[0].resultClass, "CIM_Point");
  EXPECT_EQ(hosted->calls[0].role, "Antecedent");
  EXPECT_EQ(hosted->calls[0].resultRole, "Dependent");
  EXPECT_THAT(peers->calls, IsEmpty());
}

TEST_F(AssociationOperationsTest, TheNamedAssociationIsAskedEvenWhereTheSourceFitsNoReference) {
  associators(systemPath("one"), "TST_Peers");
  EXPECT_THAT(peers->calls, SizeIs(1));
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
