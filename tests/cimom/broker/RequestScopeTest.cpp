#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

// Whether memory is freed, freed once and not used afterwards is what the address sanitizer's run of these tests says.
class RequestScopeTest : public testing::Test {
 protected:
  RequestScopeTest() { manager.loadSchemaText(testSchema, testNamespace); }

  ObjectManager manager;
  const CMPIBroker* broker = manager.broker();
};

TEST_F(RequestScopeTest, ScopesNest) {
  EXPECT_EQ(RequestScope::current(), nullptr);
  const RequestScope outer(broker);
  {
    const RequestScope inner(broker);
    EXPECT_EQ(RequestScope::current(), &inner);
    CMNewString(broker, "inner", nullptr);
  }
  EXPECT_EQ(RequestScope::current(), &outer);
}

TEST_F(RequestScopeTest, AnObjectOutsideAnyScopeBelongsToItsMaker) {
  CMPIString* string = CMNewString(broker, "free", nullptr);
  EXPECT_EQ(CMRelease(string).rc, CMPI_RC_OK);
}

TEST_F(RequestScopeTest, ReleasingAnObjectOfTheRequestDoesNoHarm) {
  const RequestScope scope(broker);
  CMPIString* string = CMNewString(broker, "scoped", nullptr);
  EXPECT_EQ(CMRelease(string).rc, CMPI_RC_OK);
  EXPECT_EQ(CMRelease(string).rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(string), "scoped");
}

TEST_F(RequestScopeTest, ACloneOutlivesItsRequest) {
  CMPIObjectPath* clone = nullptr;
  {
    const RequestScope scope(broker);
    CMPIObjectPath* path = CMNewObjectPath(broker, testNamespace, "TST_Processor", nullptr);
    CMAddKey(path, "Name", "one", CMPI_chars);
    clone = CMClone(path, nullptr);
  }
  {
    const RequestScope scope(broker);
    EXPECT_EQ(shownText(CMObjectPathToString(clone, nullptr)), "root/test:TST_Processor.Name=\"one\"");
  }
  EXPECT_EQ(CMRelease(clone).rc, CMPI_RC_OK);
}

TEST_F(RequestScopeTest, EveryKindOfObjectButAResultCanBeCloned) {
  const RequestScope scope(broker);
  const auto cloned = [&](auto* object) {
    auto* clone = CMClone(object, nullptr);
    ASSERT_NE(clone, nullptr);
    EXPECT_EQ(CMRelease(clone).rc, CMPI_RC_OK);
  };
  cloned(CMNewString(broker, "text", nullptr));
  cloned(CMNewArray(broker, 1, CMPI_string, nullptr));
  cloned(CMNewArgs(broker, nullptr));
  cloned(CMNewDateTime(broker, nullptr));
  cloned(RequestScope::current()->context());
  cloned(broker->eft->newCMPIError(broker, "o", "i", "m", CMPIErrorSeverity{}, CMPIErrorProbableCause{}, CMPI_RC_OK,
                                   nullptr));
}

TEST_F(RequestScopeTest, AMarkEndsWithItsReleaseAndTakesLaterMarksWithIt) {
  const RequestScope scope(broker);
  const CMPIGcStat* first = broker->mft->mark(broker, nullptr);
  const CMPIGcStat* second = broker->mft->mark(broker, nullptr);
  CMNewString(broker, "marked", nullptr);
  EXPECT_EQ(broker->mft->release(broker, first).rc, CMPI_RC_OK);
  EXPECT_EQ(RequestScope::current(), &scope);
  EXPECT_EQ(broker->mft->release(broker, second).rc, CMPI_RC_ERR_INVALID_HANDLE);
  EXPECT_EQ(broker->mft->release(broker, &scope).rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(RequestScopeTest, AMarkThatNobodyReleasesEndsWithTheRequest) {
  {
    const RequestScope scope(broker);
    broker->mft->mark(broker, nullptr);
    CMNewString(broker, "marked", nullptr);
  }
  EXPECT_EQ(RequestScope::current(), nullptr);
}

TEST_F(RequestScopeTest, PlainMemoryIsTheCallers) {
  const auto& mft = *broker->mft;
  char* text = mft.cmpiStrDup(broker, "text");
  text = static_cast<char*>(mft.cmpiRealloc(broker, text, 100));
  EXPECT_STREQ(text, "text");
  mft.cmpiFree(broker, text);
  auto* zeros = static_cast<char*>(mft.cmpiCalloc(broker, 4, 2));
  EXPECT_EQ(zeros[7], 0);
  mft.cmpiFree(broker, zeros);
  mft.cmpiFree(broker, mft.cmpiMalloc(broker, 8));
}

TEST_F(RequestScopeTest, ObjectsOutsideAnyScopeCanBeFreedThroughTheTable) {
  const auto& mft = *broker->mft;
  CMPIObjectPath* path = CMNewObjectPath(broker, testNamespace, "TST_Processor", nullptr);
  mft.freeInstance(broker, CMNewInstance(broker, path, nullptr));
  mft.freeObjectPath(broker, path);
  mft.freeArgs(broker, CMNewArgs(broker, nullptr));
  mft.freeString(broker, CMNewString(broker, "text", nullptr));
  mft.freeArray(broker, CMNewArray(broker, 1, CMPI_string, nullptr));
  mft.freeDateTime(broker, CMNewDateTime(broker, nullptr));
  mft.freeSelectExp(broker, nullptr);
}

TEST_F(RequestScopeTest, AnErrorOutsideAnyRequestHasNoMessageToLose) {
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  CMNewString(broker, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(status.msg, nullptr);
}

}  // namespace
