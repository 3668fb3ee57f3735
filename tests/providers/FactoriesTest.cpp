// SPDX-License-Identifier: Apache-2.0
// The eighteen factories, their function tables, and the operations that no provider of the library carries out.
#include "tests/support/composite/CompositeTest.h"
#include "tests/support/composite/Units.h"

namespace {

using namespace Testing;

class FactoriesTest : public CompositeTest, public ::testing::WithParamInterface<Unit> {};

INSTANTIATE_TEST_SUITE_P(All, FactoriesTest, ::testing::ValuesIn(allUnits()), nameOf);

TEST_P(FactoriesTest, TheInstanceTableCarriesVersionNameAndAllOperations) {
  const CMPIInstanceMI* mi = GetParam().createInstanceMI(broker(), context(), &status);
  ASSERT_NE(mi, nullptr);
  EXPECT_EQ(mi->hdl, nullptr);
  EXPECT_EQ(mi->ft->ftVersion, 200);
  EXPECT_EQ(mi->ft->miVersion, 200);
  EXPECT_EQ(mi->ft->miName, "instance" + GetParam().provider);
  EXPECT_NE(mi->ft->cleanup, nullptr);
  EXPECT_NE(mi->ft->enumerateInstanceNames, nullptr);
  EXPECT_NE(mi->ft->enumerateInstances, nullptr);
  EXPECT_NE(mi->ft->getInstance, nullptr);
  EXPECT_NE(mi->ft->createInstance, nullptr);
  EXPECT_NE(mi->ft->modifyInstance, nullptr);
  EXPECT_NE(mi->ft->deleteInstance, nullptr);
  EXPECT_NE(mi->ft->execQuery, nullptr);
}

class AssociationFactoriesTest : public FactoriesTest {};

INSTANTIATE_TEST_SUITE_P(Six, AssociationFactoriesTest, ::testing::ValuesIn(associationUnits()), nameOf);

TEST_P(AssociationFactoriesTest, TheAssociationTableCarriesVersionNameAndAllOperations) {
  CMPIAssociationMI* mi = GetParam().createAssociationMI(broker(), context(), &status);
  ASSERT_NE(mi, nullptr);
  EXPECT_EQ(mi->hdl, nullptr);
  EXPECT_EQ(mi->ft->ftVersion, 200);
  EXPECT_EQ(mi->ft->miVersion, 200);
  EXPECT_EQ(mi->ft->miName, "association" + GetParam().provider);
  EXPECT_NE(mi->ft->associators, nullptr);
  EXPECT_NE(mi->ft->associatorNames, nullptr);
  EXPECT_NE(mi->ft->references, nullptr);
  EXPECT_NE(mi->ft->referenceNames, nullptr);
  for (const CMPIBoolean terminating : {0, 1}) {
    const CMPIStatus cleaned = mi->ft->cleanup(mi, context(), terminating);
    EXPECT_EQ(cleaned.rc, CMPI_RC_OK);
    EXPECT_EQ(cleaned.msg, nullptr);
  }
  EXPECT_EQ(mi, GetParam().createAssociationMI(broker(), context(), &status));
}

TEST_P(FactoriesTest, AFactoryAnswersTheSameObjectOnEveryCall) {
  const CMPIInstanceMI* first = GetParam().createInstanceMI(broker(), context(), &status);
  EXPECT_EQ(GetParam().createInstanceMI(faults.real(), context(), &status), first);
}

TEST_P(FactoriesTest, AFactoryTouchesNeitherContextNorStatusAndWritesNothing) {
  status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  EXPECT_NE(GetParam().createInstanceMI(broker(), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
  EXPECT_NE(GetParam().createInstanceMI(broker(), nullptr, nullptr), nullptr);
  if (GetParam().createAssociationMI != nullptr) {
    EXPECT_NE(GetParam().createAssociationMI(broker(), nullptr, nullptr), nullptr);
  }
  EXPECT_TRUE(logLines().empty());
  EXPECT_TRUE(faults.traces.empty());
}

TEST_P(FactoriesTest, OperationsThatNobodyCarriesOutAreNotSupportedAndSilent) {
  CMPIInstanceMI* mi = GetParam().createInstanceMI(broker(), context(), &status);
  const CMPIObjectPath* path = makePath(GetParam().className);
  RecordingResult result;
  std::vector<CMPIStatus> answers = {
      mi->ft->createInstance(mi, context(), result.result(), path, nullptr),
      mi->ft->deleteInstance(mi, context(), result.result(), path),
      mi->ft->execQuery(mi, context(), result.result(), path, "select * from X", "WQL"),
  };
  if (!GetParam().acceptsModify) {
    answers.push_back(mi->ft->modifyInstance(mi, context(), result.result(), path, nullptr, nullptr));
  }
  for (const CMPIStatus& answer : answers) {
    EXPECT_EQ(answer.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(answer.msg, nullptr);
  }
  EXPECT_TRUE(result.order.empty());
  EXPECT_TRUE(logLines().empty());
  EXPECT_TRUE(faults.traces.empty());
}

TEST_P(FactoriesTest, CleanupAlwaysAgreesToUnload) {
  CMPIInstanceMI* mi = GetParam().createInstanceMI(broker(), context(), &status);
  for (const CMPIBoolean terminating : {0, 1}) {
    const CMPIStatus cleaned = mi->ft->cleanup(mi, context(), terminating);
    EXPECT_EQ(cleaned.rc, CMPI_RC_OK);
    EXPECT_EQ(cleaned.msg, nullptr);
  }
  EXPECT_TRUE(logLines().empty());
}

TEST_P(AssociationFactoriesTest, TheLastBrokerOfAUnitServesBothOfItsInterfaces) {
  CMPIInstanceMI* mi = GetParam().createInstanceMI(faults.real(), context(), &status);
  GetParam().createAssociationMI(broker(), context(), &status);
  RecordingResult result;
  mi->ft->enumerateInstances(mi, context(), result.result(), makePath(GetParam().className), nullptr);
  EXPECT_FALSE(faults.upCalls.empty()) << "the instance side still uses the first broker";
}

TEST_F(CompositeTest, TwoUnitsNeverShareABroker) {
  const Unit& computerSystem = unitOf(Classes::computerSystem);
  CMPIInstanceMI* mi = computerSystem.createInstanceMI(broker(), context(), &status);
  for (const Unit& unit : allUnits()) {
    if (unit.provider != computerSystem.provider) {
      unit.createInstanceMI(nullptr, nullptr, nullptr);
    }
  }
  RecordingResult result;
  mi->ft->enumerateInstances(mi, context(), result.result(), makePath(computerSystem.className), nullptr);
  EXPECT_EQ(faults.upCalls.size(), 1u);
}

}  // namespace
