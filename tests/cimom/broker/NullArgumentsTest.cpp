// SPDX-License-Identifier: Apache-2.0
// Every slot of every table, with a null in the place of an object, a name or a status: a code, never a crash.
#include <functional>

#include "cimom/broker/Handle.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

class NullArgumentsTest : public ManagedElementsFixture {
 protected:
  // A slot that reports through its result.
  void refused(const char* slot, const CMPIStatus& outcome) {
    EXPECT_TRUE(outcome.rc == CMPI_RC_ERR_INVALID_HANDLE || outcome.rc == CMPI_RC_ERR_INVALID_PARAMETER)
        << slot << ": " << outcome.rc;
  }

  // A slot that reports through a status pointer: called with one and with a null one.
  void refused(const char* slot, const std::function<void(CMPIStatus*)>& call) {
    CMPIStatus outcome = ok;
    call(&outcome);
    refused(slot, outcome);
    call(nullptr);
  }

  CMPIString emptyString = {nullptr, &Abi<Text>::table};
  CMPIInstance emptyInstance = {nullptr, &Abi<Instance>::table};
  CMPIObjectPath emptyPath = {nullptr, &Abi<ObjectPath>::table};
};

#define REFUSED(CALL) refused(#CALL, CALL)
#define REFUSED_BY_STATUS(CALL) refused(#CALL, [&](CMPIStatus* st) { CALL; })

TEST_F(NullArgumentsTest, InTheInstanceTable) {
  const auto& ft = Abi<Instance>::table;
  for (CMPIInstance* none : {static_cast<CMPIInstance*>(nullptr), &emptyInstance}) {
    REFUSED(ft.release(none));
    REFUSED_BY_STATUS(ft.clone(none, st));
    REFUSED_BY_STATUS(ft.getProperty(none, "Name", st));
    REFUSED_BY_STATUS(ft.getPropertyAt(none, 0, nullptr, st));
    REFUSED_BY_STATUS(ft.getPropertyCount(none, st));
    REFUSED(ft.setProperty(none, "Name", nullptr, CMPI_string));
    REFUSED_BY_STATUS(ft.getObjectPath(none, st));
    REFUSED(ft.setPropertyFilter(none, nullptr, nullptr));
    REFUSED(ft.setObjectPath(none, systemPath("one")));
    REFUSED(ft.setPropertyWithOrigin(none, "Name", nullptr, CMPI_string, nullptr));
  }
  CMPIInstance* instance = system("one");
  REFUSED_BY_STATUS(ft.getProperty(instance, nullptr, st));
  REFUSED(ft.setProperty(instance, nullptr, nullptr, CMPI_string));
  REFUSED(ft.setObjectPath(instance, nullptr));
  REFUSED(ft.setObjectPath(instance, &emptyPath));
  EXPECT_EQ(shownText(CMGetProperty(instance, "Name", nullptr).value.string), "one");
  CMGetPropertyAt(instance, 0, nullptr, nullptr);
}

TEST_F(NullArgumentsTest, InTheObjectPathTable) {
  const auto& ft = Abi<ObjectPath>::table;
  for (CMPIObjectPath* none : {static_cast<CMPIObjectPath*>(nullptr), &emptyPath}) {
    REFUSED(ft.release(none));
    REFUSED_BY_STATUS(ft.clone(none, st));
    REFUSED(ft.setNameSpace(none, "a"));
    REFUSED_BY_STATUS(ft.getNameSpace(none, st));
    REFUSED(ft.setHostname(none, "a"));
    REFUSED_BY_STATUS(ft.getHostname(none, st));
    REFUSED(ft.setClassName(none, "a"));
    REFUSED_BY_STATUS(ft.getClassName(none, st));
    REFUSED(ft.addKey(none, "a", nullptr, CMPI_string));
    REFUSED_BY_STATUS(ft.getKey(none, "a", st));
    REFUSED_BY_STATUS(ft.getKeyAt(none, 0, nullptr, st));
    REFUSED_BY_STATUS(ft.getKeyCount(none, st));
    REFUSED(ft.setNameSpaceFromObjectPath(none, systemPath("one")));
    REFUSED(ft.setNameSpaceFromObjectPath(systemPath("one"), none));
    REFUSED(ft.setHostAndNameSpaceFromObjectPath(none, systemPath("one")));
    REFUSED(ft.setHostAndNameSpaceFromObjectPath(systemPath("one"), none));
    REFUSED_BY_STATUS(ft.getClassQualifier(none, "a", st));
    REFUSED_BY_STATUS(ft.getPropertyQualifier(none, "a", "a", st));
    REFUSED_BY_STATUS(ft.getMethodQualifier(none, "a", "a", st));
    REFUSED_BY_STATUS(ft.getParameterQualifier(none, "a", "a", "a", st));
    REFUSED_BY_STATUS(ft.toString(none, st));
  }
  CMPIObjectPath* path = systemPath("one");
  REFUSED(ft.setNameSpace(path, nullptr));
  REFUSED(ft.setHostname(path, nullptr));
  REFUSED(ft.setClassName(path, nullptr));
  REFUSED(ft.addKey(path, nullptr, nullptr, CMPI_string));
  REFUSED_BY_STATUS(ft.getKey(path, nullptr, st));
  REFUSED_BY_STATUS(ft.getClassQualifier(path, nullptr, st));
  REFUSED_BY_STATUS(ft.getPropertyQualifier(path, nullptr, nullptr, st));
  REFUSED_BY_STATUS(ft.getMethodQualifier(path, nullptr, nullptr, st));
  REFUSED_BY_STATUS(ft.getParameterQualifier(path, "Reset", nullptr, nullptr, st));
}

TEST_F(NullArgumentsTest, InTheTablesOfTheSmallerObjects) {
  const auto objects = [&]<typename Model>(Model*) {
    const auto& ft = Abi<Model>::table;
    REFUSED(ft.release(nullptr));
    REFUSED_BY_STATUS(ft.clone(nullptr, st));
  };
  objects(static_cast<Text*>(nullptr));
  objects(static_cast<Array*>(nullptr));
  objects(static_cast<Enumeration*>(nullptr));
  objects(static_cast<Args*>(nullptr));
  objects(static_cast<Context*>(nullptr));
  objects(static_cast<DateTime*>(nullptr));
  objects(static_cast<Result*>(nullptr));
  objects(static_cast<Error*>(nullptr));

  REFUSED_BY_STATUS(Abi<Text>::table.getCharPtr(nullptr, st));
  REFUSED_BY_STATUS(Abi<Text>::table.getCharPtr(&emptyString, st));
  REFUSED_BY_STATUS(Abi<Array>::table.getSize(nullptr, st));
  REFUSED_BY_STATUS(Abi<Array>::table.getSimpleType(nullptr, st));
  REFUSED_BY_STATUS(Abi<Array>::table.getElementAt(nullptr, 0, st));
  REFUSED(Abi<Array>::table.setElementAt(nullptr, 0, nullptr, CMPI_string));
  REFUSED_BY_STATUS(Abi<Enumeration>::table.getNext(nullptr, st));
  REFUSED_BY_STATUS(Abi<Enumeration>::table.hasNext(nullptr, st));
  REFUSED_BY_STATUS(Abi<Enumeration>::table.toArray(nullptr, st));
  REFUSED_BY_STATUS(Abi<DateTime>::table.getBinaryFormat(nullptr, st));
  REFUSED_BY_STATUS(Abi<DateTime>::table.getStringFormat(nullptr, st));
  REFUSED_BY_STATUS(Abi<DateTime>::table.isInterval(nullptr, st));
  REFUSED(Abi<Args>::table.addArg(nullptr, "a", nullptr, CMPI_string));
  REFUSED(Abi<Args>::table.addArg(CMNewArgs(broker, nullptr), nullptr, nullptr, CMPI_string));
  REFUSED_BY_STATUS(Abi<Args>::table.getArg(nullptr, "a", st));
  REFUSED_BY_STATUS(Abi<Args>::table.getArg(CMNewArgs(broker, nullptr), nullptr, st));
  REFUSED_BY_STATUS(Abi<Args>::table.getArgAt(nullptr, 0, nullptr, st));
  REFUSED_BY_STATUS(Abi<Args>::table.getArgCount(nullptr, st));
  REFUSED(Abi<Context>::table.addEntry(nullptr, "a", nullptr, CMPI_string));
  REFUSED(Abi<Context>::table.addEntry(request.context(), nullptr, nullptr, CMPI_string));
  REFUSED_BY_STATUS(Abi<Context>::table.getEntry(nullptr, "a", st));
  REFUSED_BY_STATUS(Abi<Context>::table.getEntry(request.context(), nullptr, st));
  REFUSED_BY_STATUS(Abi<Context>::table.getEntryAt(nullptr, 0, nullptr, st));
  REFUSED_BY_STATUS(Abi<Context>::table.getEntryCount(nullptr, st));
  REFUSED(Abi<Result>::table.returnData(nullptr, nullptr, CMPI_string));
  REFUSED(Abi<Result>::table.returnInstance(nullptr, nullptr));
  REFUSED(Abi<Result>::table.returnObjectPath(nullptr, nullptr));
  REFUSED(Abi<Result>::table.returnDone(nullptr));
  REFUSED(Abi<Result>::table.returnError(nullptr, nullptr));
}

TEST_F(NullArgumentsTest, InTheErrorTable) {
  const auto& ft = Abi<Error>::table;
  REFUSED_BY_STATUS(ft.getErrorType(nullptr, st));
  REFUSED_BY_STATUS(ft.getOtherErrorType(nullptr, st));
  REFUSED_BY_STATUS(ft.getOwningEntity(nullptr, st));
  REFUSED_BY_STATUS(ft.getMessageID(nullptr, st));
  REFUSED_BY_STATUS(ft.getMessage(nullptr, st));
  REFUSED_BY_STATUS(ft.getPerceivedSeverity(nullptr, st));
  REFUSED_BY_STATUS(ft.getProbableCause(nullptr, st));
  REFUSED_BY_STATUS(ft.getProbableCauseDescription(nullptr, st));
  REFUSED_BY_STATUS(ft.getRecommendedActions(nullptr, st));
  REFUSED_BY_STATUS(ft.getErrorSource(nullptr, st));
  REFUSED_BY_STATUS(ft.getErrorSourceFormat(nullptr, st));
  REFUSED_BY_STATUS(ft.getOtherErrorSourceFormat(nullptr, st));
  REFUSED_BY_STATUS(ft.getCIMStatusCode(nullptr, st));
  REFUSED_BY_STATUS(ft.getCIMStatusCodeDescription(nullptr, st));
  REFUSED_BY_STATUS(ft.getMessageArguments(nullptr, st));
  REFUSED(ft.setErrorType(nullptr, static_cast<CMPIErrorType>(1)));
  REFUSED(ft.setErrorSourceFormat(nullptr, CMPIErrorSrcFormat{}));
  CMPIError* error = broker->eft->newCMPIError(broker, "o", "i", "m", CMPIErrorSeverity{}, CMPIErrorProbableCause{},
                                               CMPI_RC_OK, nullptr);
  for (CMPIError* any : {static_cast<CMPIError*>(nullptr), error}) {
    REFUSED(ft.setOtherErrorType(any, nullptr));
    REFUSED(ft.setProbableCauseDescription(any, nullptr));
    REFUSED(ft.setRecommendedActions(any, nullptr));
    REFUSED(ft.setErrorSource(any, nullptr));
    REFUSED(ft.setOtherErrorSourceFormat(any, nullptr));
    REFUSED(ft.setCIMStatusCodeDescription(any, nullptr));
    REFUSED(ft.setMessageArguments(any, nullptr));
  }
}

TEST_F(NullArgumentsTest, InTheEncapsulationTable) {
  const auto& eft = *broker->eft;
  const CMPIBroker emptyBroker = {nullptr, broker->bft, broker->eft, broker->xft, broker->mft};
  for (const CMPIBroker* none : {static_cast<const CMPIBroker*>(nullptr), &emptyBroker}) {
    REFUSED_BY_STATUS(eft.newInstance(none, systemPath("one"), st));
    REFUSED_BY_STATUS(eft.newObjectPath(none, "a", "a", st));
    REFUSED_BY_STATUS(eft.newArgs(none, st));
    REFUSED_BY_STATUS(eft.newString(none, "a", st));
    REFUSED_BY_STATUS(eft.newArray(none, 1, CMPI_string, st));
    REFUSED_BY_STATUS(eft.newDateTime(none, st));
    REFUSED_BY_STATUS(eft.newDateTimeFromBinary(none, 0, 0, st));
    REFUSED_BY_STATUS(eft.newDateTimeFromChars(none, "a", st));
    REFUSED_BY_STATUS(eft.newSelectExp(none, "a", "a", nullptr, st));
    REFUSED_BY_STATUS(eft.classPathIsA(none, systemPath("one"), "a", st));
    REFUSED_BY_STATUS(eft.toString(none, systemPath("one"), st));
    REFUSED_BY_STATUS(eft.isOfType(none, systemPath("one"), "a", st));
    REFUSED_BY_STATUS(eft.getType(none, systemPath("one"), st));
    REFUSED_BY_STATUS(eft.getMessage(none, "a", "a", st, 0));
    REFUSED_BY_STATUS(eft.getMessage2(none, "a", nullptr, "a", st, 0));
    REFUSED_BY_STATUS(
        eft.newCMPIError(none, "a", "a", "a", CMPIErrorSeverity{}, CMPIErrorProbableCause{}, CMPI_RC_OK, st));
    REFUSED(eft.logMessage(none, Cmpi::Severity{}, "a", "a", nullptr));
    REFUSED(eft.trace(none, Cmpi::TraceLevel{}, "a", "a", nullptr));
    REFUSED(eft.openMessageFile(none, "a", nullptr));
    REFUSED(eft.closeMessageFile(none, nullptr));
  }
  REFUSED_BY_STATUS(eft.newInstance(broker, nullptr, st));
  REFUSED_BY_STATUS(eft.newInstance(broker, &emptyPath, st));
  REFUSED_BY_STATUS(eft.newObjectPath(broker, "a", nullptr, st));
  REFUSED_BY_STATUS(eft.newString(broker, nullptr, st));
  REFUSED_BY_STATUS(eft.newDateTimeFromChars(broker, nullptr, st));
  REFUSED_BY_STATUS(eft.classPathIsA(broker, nullptr, "a", st));
  REFUSED_BY_STATUS(eft.classPathIsA(broker, systemPath("one"), nullptr, st));
  REFUSED_BY_STATUS(eft.toString(broker, nullptr, st));
  REFUSED_BY_STATUS(eft.toString(broker, &emptyPath, st));
  REFUSED_BY_STATUS(eft.isOfType(broker, systemPath("one"), nullptr, st));
  REFUSED_BY_STATUS(eft.getType(broker, nullptr, st));
  REFUSED_BY_STATUS(eft.getMessage(broker, "a", nullptr, st, 0));
  REFUSED_BY_STATUS(eft.getMessage2(broker, "a", nullptr, nullptr, st, 0));
  REFUSED_BY_STATUS(eft.newCMPIError(broker, nullptr, nullptr, nullptr, CMPIErrorSeverity{}, CMPIErrorProbableCause{},
                                     CMPI_RC_OK, st));
  REFUSED(eft.logMessage(broker, Cmpi::Severity{}, nullptr, nullptr, nullptr));
  REFUSED(eft.trace(broker, Cmpi::TraceLevel{}, nullptr, nullptr, nullptr));
  EXPECT_NE(eft.newObjectPath(broker, nullptr, "Class", nullptr), nullptr) << "a path need not have a namespace";
}

TEST_F(NullArgumentsTest, InTheUpCallTable) {
  const auto& bft = *broker->bft;
  CMPIObjectPath* path = systemPath("one");
  CMPIInstance* instance = system("one");
  const auto* value = reinterpret_cast<const CMPIValue*>("a");
  struct Row {
    const CMPIBroker* broker;
    CMPIContext* context;
    CMPIObjectPath* path;
  };
  const Row rows[] = {{nullptr, request.context(), path},
                      {broker, nullptr, path},
                      {broker, request.context(), nullptr},
                      {broker, request.context(), &emptyPath}};
  for (const Row& row : rows) {
    REFUSED_BY_STATUS(bft.enumerateInstanceNames(row.broker, row.context, row.path, st));
    REFUSED_BY_STATUS(bft.enumerateInstances(row.broker, row.context, row.path, nullptr, st));
    REFUSED_BY_STATUS(bft.getInstance(row.broker, row.context, row.path, nullptr, st));
    REFUSED_BY_STATUS(bft.createInstance(row.broker, row.context, row.path, instance, st));
    REFUSED(bft.modifyInstance(row.broker, row.context, row.path, instance, nullptr));
    REFUSED(bft.deleteInstance(row.broker, row.context, row.path));
    REFUSED_BY_STATUS(bft.execQuery(row.broker, row.context, row.path, "a", "a", st));
    REFUSED_BY_STATUS(
        bft.associators(row.broker, row.context, row.path, nullptr, nullptr, nullptr, nullptr, nullptr, st));
    REFUSED_BY_STATUS(bft.associatorNames(row.broker, row.context, row.path, nullptr, nullptr, nullptr, nullptr, st));
    REFUSED_BY_STATUS(bft.references(row.broker, row.context, row.path, nullptr, nullptr, nullptr, st));
    REFUSED_BY_STATUS(bft.referenceNames(row.broker, row.context, row.path, nullptr, nullptr, st));
    REFUSED_BY_STATUS(bft.invokeMethod(row.broker, row.context, row.path, "a", nullptr, nullptr, st));
    REFUSED(bft.setProperty(row.broker, row.context, row.path, "Name", value, CMPI_chars));
    REFUSED_BY_STATUS(bft.getProperty(row.broker, row.context, row.path, "Name", st));
  }
  REFUSED_BY_STATUS(bft.createInstance(broker, request.context(), path, nullptr, st));
  REFUSED_BY_STATUS(bft.createInstance(broker, request.context(), path, &emptyInstance, st));
  REFUSED(bft.modifyInstance(broker, request.context(), path, nullptr, nullptr));
  REFUSED_BY_STATUS(bft.invokeMethod(broker, request.context(), path, nullptr, nullptr, nullptr, st));
  REFUSED(bft.setProperty(broker, request.context(), path, nullptr, value, CMPI_chars));
  REFUSED_BY_STATUS(bft.getProperty(broker, request.context(), path, nullptr, st));
  REFUSED(bft.deliverIndication(nullptr, request.context(), "a", instance));
  REFUSED(bft.attachThread(nullptr, request.context()));
  REFUSED(bft.attachThread(broker, nullptr));
  REFUSED(bft.detachThread(broker, nullptr));
  EXPECT_EQ(bft.prepareAttachThread(broker, nullptr), nullptr);
}

TEST_F(NullArgumentsTest, InTheMemoryTable) {
  const auto& mft = *broker->mft;
  REFUSED_BY_STATUS(mft.mark(nullptr, st));
  REFUSED(mft.release(broker, nullptr));
  EXPECT_EQ(mft.cmpiStrDup(broker, nullptr), nullptr);
  mft.cmpiFree(broker, nullptr);
  mft.freeInstance(broker, nullptr);
  mft.freeObjectPath(broker, nullptr);
  mft.freeArgs(broker, nullptr);
  mft.freeString(broker, nullptr);
  mft.freeArray(broker, nullptr);
  mft.freeDateTime(broker, nullptr);
}

}  // namespace
