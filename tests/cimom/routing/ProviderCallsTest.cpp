// SPDX-License-Identifier: Apache-2.0
#include <stdexcept>

#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::SizeIs;

class ProviderCallsTest : public ManagedElementsFixture {
 protected:
  ProviderCallsTest() { probe->serve(manager, "TST_Processor", testNamespace); }

  CMPIContext* context() { return request.context(); }

  std::shared_ptr<RecordingProvider> probe = std::make_shared<RecordingProvider>();
};

TEST_F(ProviderCallsTest, AnEmptySlotOfAProviderIsNotSupported) {
  static CMPIInstanceMIFT empty = {CMPICurrentVersion,
                                   CMPICurrentVersion,
                                   "instanceEmpty",
                                   nullptr,
                                   nullptr,
                                   nullptr,
                                   nullptr,
                                   nullptr,
                                   nullptr,
                                   nullptr,
                                   nullptr};
  static CMPIInstanceMI mi = {&empty, &empty};
  manager.addProvider(
      {"TST_Other", "empty", "", true, false, {testNamespace}, ""},
      [](const CMPIBroker*, const CMPIContext*, CMPIStatus*) { return &mi; }, nullptr);
  EXPECT_EQ(CBGetInstance(broker, context(), systemPath("one", "TST_Other"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(ProviderCallsTest, TheProviderGetsTheRequestsContext) {
  CMAddContextEntry(context(), CMPIPrincipal, "alice", CMPI_chars);
  probe->answer = [&](const CMPIContext* given, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*) {
    EXPECT_EQ(shownText(CMGetContextEntry(given, CMPIPrincipal, nullptr).value.string), "alice");
    EXPECT_EQ(shownText(CMGetContextEntry(given, CMPIInitNameSpace, nullptr).value.string), testNamespace);
    const CMPIData flags = CMGetContextEntry(given, CMPIInvocationFlags, &status);
    EXPECT_EQ(flags.type, CMPI_uint32);
    EXPECT_EQ(flags.value.uint32, 0u);
    return ok;
  };
  CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status);
  EXPECT_THAT(probe->calls, SizeIs(1));
  EXPECT_EQ(CMGetContextEntryCount(context(), nullptr), 1u) << "the caller's context stays its own";
}

TEST_F(ProviderCallsTest, AnInstanceWithoutANamespaceIsOfTheRequests) {
  probe->answer = [&](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIInstance* instance = CMNewInstance(broker, systemPath("one"), nullptr);
    CMPIObjectPath* nowhere = systemPath("one");
    CMSetNameSpace(nowhere, "");
    CMSetObjectPath(instance, nowhere);
    CMReturnInstance(result, instance);
    return ok;
  };
  EXPECT_THAT(pathsOf(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status)),
              ElementsAre(HasSubstr(std::string(testNamespace) + ":TST_Processor")));
}

TEST_F(ProviderCallsTest, AResultTakesNoNullAndCannotBeCloned) {
  probe->answer = [&](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIValue none = {};
    EXPECT_EQ(CMReturnData(result, &none, CMPI_string).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    CMPIStatus cloned = ok;
    EXPECT_EQ(result->ft->clone(result, &cloned), nullptr);
    EXPECT_EQ(cloned.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return ok;
  };
  EXPECT_THAT(pathsOf(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status)), SizeIs(0));
  EXPECT_THAT(probe->calls, SizeIs(1));
}

TEST_F(ProviderCallsTest, AProviderReachesAnotherThroughUpCalls) {
  std::shared_ptr<RecordingProvider> lower = std::make_shared<RecordingProvider>();
  lower->serve(manager, "TST_Other", "root/lower");
  lower->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMReturnInstance(result, system("low", "TST_Other"));
    return ok;
  };
  probe->answer = [&](const CMPIContext* given, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIEnumeration* found = CBEnumInstances(probe->broker, given, path("TST_Other", "root/lower"), nullptr, nullptr);
    while (CMHasNext(found, nullptr)) {
      const CMPIInstance* one = CMGetNext(found, nullptr).value.inst;
      const CMPIData below = CMGetProperty(one, "Name", nullptr);
      CMReturnInstance(result, system(CMGetCharsPtr(below.value.string, nullptr)));
    }
    return ok;
  };
  EXPECT_THAT(pathsOf(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status)),
              ElementsAre("root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"low\""));
}

TEST_F(ProviderCallsTest, UpCallsWithoutEndAreCutOff) {
  probe->answer = [&](const CMPIContext* given, const CMPIResult*, const CMPIObjectPath* asked, const CMPIInstance*) {
    CMPIStatus inner = ok;
    CBEnumInstances(probe->broker, given, asked, nullptr, &inner);
    return inner;
  };
  EXPECT_EQ(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
  EXPECT_THAT(shownText(status.msg), HasSubstr("nest more than 32 levels deep"));
}

TEST_F(ProviderCallsTest, AFailingFactoryIsReportedAndTriedAgain) {
  int tries = 0;
  manager.addProvider(
      {"TST_Other", "late", "", true, false, {testNamespace}, ""},
      [&](const CMPIBroker*, const CMPIContext*, CMPIStatus*) -> CMPIInstanceMI* {
        ++tries;
        return nullptr;
      },
      nullptr);
  for (int expected = 1; expected <= 2; ++expected) {
    EXPECT_EQ(CBGetInstance(broker, context(), systemPath("one", "TST_Other"), nullptr, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(shownText(status.msg), HasSubstr("late_Create_InstanceMI"));
    EXPECT_EQ(tries, expected);
  }
}

TEST_F(ProviderCallsTest, AnExceptionOfTheProviderFailsTheRequestOnly) {
  probe->answer = [](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*) -> CMPIStatus {
    throw std::out_of_range("vector::_M_range_check");
  };
  EXPECT_EQ(CBGetInstance(broker, context(), systemPath("one"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
  EXPECT_THAT(shownText(status.msg), HasSubstr("vector::_M_range_check"));

  probe->answer = [](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*) -> CMPIStatus {
    throw 7;
  };
  EXPECT_EQ(CBGetInstance(broker, context(), systemPath("one"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(ProviderCallsTest, NullsReturnedToTheResultAreRefusedAndLoseNothing) {
  CMPIStatus instanceStatus = ok;
  CMPIStatus pathStatus = ok;
  probe->answer = [&](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    instanceStatus = CMReturnInstance(result, nullptr);
    CMReturnInstance(result, system("one"));
    pathStatus = CMReturnObjectPath(result, systemPath("one"));
    return ok;
  };

  CMPIEnumeration* found = CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status);

  EXPECT_EQ(instanceStatus.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(pathStatus.rc, CMPI_RC_ERR_NOT_SUPPORTED) << "a path where instances are asked for";
  EXPECT_THAT(pathsOf(found), SizeIs(1));
}

TEST_F(ProviderCallsTest, ReturnDoneMakesNoDifferenceHoweverOftenItIsCalled) {
  for (int times = 0; times < 3; ++times) {
    probe->answer = [&](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
      CMReturnInstance(result, system("one"));
      for (int time = 0; time < times; ++time) {
        EXPECT_EQ(CMReturnDone(result).rc, CMPI_RC_OK);
      }
      return ok;
    };
    EXPECT_THAT(pathsOf(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status)), SizeIs(1));
  }
}

TEST(ProviderLifeTest, TheFactoryIsCalledOnceAndCleanupOncePerInterface) {
  std::shared_ptr<RecordingProvider> probe = std::make_shared<RecordingProvider>();
  {
    ObjectManager manager;
    manager.loadSchemaText(testSchema, testNamespace);
    probe->serve(manager, "TST_Hosted", testNamespace, true);
    EXPECT_EQ(probe->factoryCalls, 0) << "providers are made when they are needed";
    const RequestScope scope(manager.broker());
    const auto* path = CMNewObjectPath(manager.broker(), testNamespace, "TST_Hosted", nullptr);
    const auto* source = CMNewObjectPath(manager.broker(), testNamespace, "CIM_System", nullptr);
    for (int round = 0; round < 3; ++round) {
      CBEnumInstances(manager.broker(), RequestScope::current()->context(), path, nullptr, nullptr);
      CBReferenceNames(manager.broker(), RequestScope::current()->context(), source, nullptr, nullptr, nullptr);
    }
    EXPECT_EQ(probe->calls.size(), 6u);
    EXPECT_EQ(probe->factoryCalls, 2);
    EXPECT_EQ(probe->cleanups, 0);
  }
  EXPECT_EQ(probe->cleanups, 2);
}

TEST_F(ProviderCallsTest, WhatIsReturnedStaysAsItWasWhateverTheProviderDoesToItsOwn) {
  CMPIInstance* kept = nullptr;
  probe->answer = [&](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* asked, const CMPIInstance*) {
    CMPIInstance* instance = CMNewInstance(broker, asked, nullptr);
    CMSetProperty(instance, "Caption", "returned", CMPI_chars);
    kept = CMClone(instance, nullptr);
    CMReturnInstance(result, kept);
    CMReturnInstance(result, instance);
    CMSetProperty(kept, "Caption", "changed", CMPI_chars);
    CMSetProperty(instance, "Caption", "changed", CMPI_chars);
    return ok;
  };
  CMPIEnumeration* found = CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, nullptr);
  CMSetProperty(kept, "Caption", "changed again", CMPI_chars);
  for (int item = 0; item < 2; ++item) {
    const CMPIInstance* returned = CMGetNext(found, &status).value.inst;
    ASSERT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(shownText(CMGetProperty(returned, "Caption", nullptr).value.string), "returned");
    CMSetProperty(returned, "Caption", "the client's", CMPI_chars);
  }
  EXPECT_EQ(shownText(CMGetProperty(kept, "Caption", nullptr).value.string), "changed again");
  EXPECT_EQ(CMRelease(kept).rc, CMPI_RC_OK);
}

}  // namespace
