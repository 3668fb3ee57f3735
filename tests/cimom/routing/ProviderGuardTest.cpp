// SPDX-License-Identifier: Apache-2.0
// What a provider may do without ending the object manager.
#include <pthread.h>

#include <chrono>
#include <thread>

#include "cimom/broker/ProviderFrame.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Cimom;
using namespace Testing;
using namespace std::chrono_literals;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

class ProviderGuardTest : public ManagedElementsFixture {
 protected:
  ProviderGuardTest() { probe->serve(manager, "TST_Processor", testNamespace); }

  CMPIContext* context() { return request.context(); }

  // Answers every call so.
  void answer(std::function<CMPIStatus(const CMPIContext*, const CMPIResult*)> answer) {
    probe->answer = [answer = std::move(answer)](const CMPIContext* given, const CMPIResult* result,
                                                 const CMPIObjectPath*,
                                                 const CMPIInstance*) { return answer(given, result); };
  }

  // The rc and the text of an enumeration of the class.
  std::string enumerated(const char* className = "TST_Processor") {
    CBEnumInstances(broker, context(), path(className), nullptr, &status);
    return std::to_string(status.rc) + ": " + (status.msg ? shownText(status.msg) : "");
  }

  // Registers a provider of TST_Other whose factory makes the other's MI after `act`.
  void serveOther(std::function<void(const CMPIBroker*, const CMPIContext*, CMPIStatus*)> act) {
    other->broker = broker;
    const std::shared_ptr<RecordingProvider> kept = other;
    manager.addProvider(
        {"TST_Other", "other", "", true, false, {testNamespace}, ""},
        [act = std::move(act), kept](const CMPIBroker* given, const CMPIContext* none, CMPIStatus* outcome) {
          act(given, none, outcome);
          return kept->instanceMi();
        },
        nullptr);
  }

  std::shared_ptr<RecordingProvider> probe = std::make_shared<RecordingProvider>();
  std::shared_ptr<RecordingProvider> other = std::make_shared<RecordingProvider>();
};

TEST_F(ProviderGuardTest, ExitThreadEndsTheCallAndNotTheThread) {
  answer([&](const CMPIContext*, const CMPIResult*) {
    broker->xft->exitThread(nullptr);
    return ok;
  });
  EXPECT_EQ(enumerated(), "1: provider TST_Processor tried to end the thread of its request");
  EXPECT_FALSE(ProviderFrame::isOnThisThread());
}

TEST_F(ProviderGuardTest, ExitThreadOfALowerProviderFailsTheUpCallOnly) {
  other->serve(manager, "TST_Other", testNamespace);
  other->answer = [&](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*) {
    broker->xft->exitThread(nullptr);
    return ok;
  };
  CMPIrc inner = CMPI_RC_OK;
  answer([&](const CMPIContext* given, const CMPIResult* result) {
    CMPIStatus lower = ok;
    CBEnumInstances(broker, given, path("TST_Other"), nullptr, &lower);
    inner = lower.rc;
    return CMReturnInstance(result, system("one"));
  });
  EXPECT_EQ(enumerated(), "0: ");
  EXPECT_EQ(inner, CMPI_RC_ERR_FAILED);
}

TEST_F(ProviderGuardTest, AThreadThatAProviderEndsPastTheBrokerIsUnwoundAsAWhole) {
  if (sanitized()) {
    GTEST_SKIP() << "the address sanitizer does not follow the unwinding of a thread";
  }
  // Given a provider whose lower provider ends the thread, two up-calls below the request
  answer([&](const CMPIContext* given, const CMPIResult*) {
    CMPIStatus lower = ok;
    CBEnumInstances(broker, given, path("TST_Other"), nullptr, &lower);
    return lower;
  });
  other->serve(manager, "TST_Other", testNamespace);
  other->answer = [&](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*) -> CMPIStatus {
    pthread_exit(nullptr);
  };
  std::vector<std::string> log;
  manager.setLog([&](int, std::string_view, std::string_view text) { log.emplace_back(text); });
  // When a thread serves the request, then whoever runs it learns who has ended it while it is unwound
  bool isBack = false;
  std::string told;
  struct Worker {
    std::string& told;
    ~Worker() { told = ProviderFrame::endedBy(); }
  };
  std::thread([&] {
    const Worker worker{told};
    RequestScope scope(broker);
    CMPIStatus outcome = ok;
    CBEnumInstances(broker, scope.context(), CMNewObjectPath(broker, testNamespace, "TST_Processor", nullptr), nullptr,
                    &outcome);
    isBack = true;
  }).join();
  EXPECT_FALSE(isBack);
  EXPECT_EQ(told, "provider TST_Other ended the thread of its request");
  ASSERT_FALSE(log.empty());
  EXPECT_EQ(log.front(), "provider TST_Other ended its thread");
  // And other threads are served as before
  other->answer = nullptr;
  EXPECT_EQ(enumerated(), "0: ");
}

TEST_F(ProviderGuardTest, NobodyCancelsTheThreadOfARequest) {
  bool isBack = false;
  std::thread([&] {
    pthread_setcancelstate(PTHREAD_CANCEL_ENABLE, nullptr);
    RequestScope scope(broker);
    answer([&](const CMPIContext*, const CMPIResult*) {
      broker->xft->cancelThread(reinterpret_cast<CMPI_THREAD_TYPE>(pthread_self()));
      broker->xft->threadSleep(1);
      isBack = true;
      return ok;
    });
    CBEnumInstances(broker, scope.context(), CMNewObjectPath(broker, testNamespace, "TST_Processor", nullptr), nullptr,
                    nullptr);
    pthread_setcancelstate(PTHREAD_CANCEL_DISABLE, nullptr);
  }).join();
  EXPECT_TRUE(isBack);
}

TEST_F(ProviderGuardTest, AReturnCodeThatCmpiDoesNotHaveIsAFailureThatNamesIt) {
  answer([&](const CMPIContext*, const CMPIResult*) {
    return CMPIStatus{static_cast<CMPIrc>(18), CMNewString(broker, "odd", nullptr)};
  });
  EXPECT_EQ(enumerated(), "1: provider TST_Processor returned 18, which is no return code of CMPI: odd");
  for (const CMPIrc code : {CMPI_RC_ERR_METHOD_NOT_FOUND, CMPI_RC_DO_NOT_UNLOAD, CMPI_RC_ERR_INVALID_HANDLE,
                            CMPI_RC_ERROR_SYSTEM, CMPI_RC_ERROR}) {
    answer([&](const CMPIContext*, const CMPIResult*) { return CMPIStatus{code, nullptr}; });
    EXPECT_EQ(enumerated(), std::to_string(code) + ": ");
  }
}

TEST_F(ProviderGuardTest, ASubclassThatCannotBeEnumeratedHidesNoOther) {
  answer([&](const CMPIContext*, const CMPIResult* result) { return CMReturnInstance(result, system("one")); });
  other->serve(manager, "TST_Other", testNamespace);
  other->answer = [](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance*) {
    return CMPIStatus{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
  };
  EXPECT_THAT(pathsOf(CBEnumInstances(broker, context(), path("CIM_System"), nullptr, &status)), SizeIs(1));
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(enumerated("TST_Other"), "7: ") << "the class itself";
  probe->answer = other->answer;
  EXPECT_EQ(enumerated("CIM_System"), "7: ") << "nobody answers";
  answer([&](const CMPIContext*, const CMPIResult*) { return CMPIStatus{CMPI_RC_ERR_ACCESS_DENIED, nullptr}; });
  EXPECT_EQ(enumerated("CIM_System"), "2: ") << "any other failure is the operation's";
}

TEST_F(ProviderGuardTest, AfterTheDeadlineNoUpCallIsMade) {
  const RequestScope late(broker, std::chrono::steady_clock::now() - 1ms);
  EXPECT_EQ(enumerated(), "1: the time limit of the request is over, TST_Processor is not asked");
  EXPECT_THAT(probe->calls, IsEmpty());
  EXPECT_EQ(CBDeleteInstance(broker, context(), systemPath("one")).rc, CMPI_RC_ERR_FAILED);
}

TEST_F(ProviderGuardTest, TheDeadlineHoldsInScopesWithinAndInAttachedThreads) {
  const auto soon = std::chrono::steady_clock::now() + 20ms;
  RequestScope scope(broker, soon);
  const RequestScope within(broker, soon + 1h);
  EXPECT_EQ(RequestScope::currentDeadline(), soon);
  struct Shared {
    const CMPIBroker* broker;
    CMPIContext* context;
    CMPIrc before, after;
  } shared = {broker, CBPrepareAttachThread(broker, scope.context()), CMPI_RC_OK, CMPI_RC_OK};
  CMPI_THREAD_TYPE thread = broker->xft->newThread(
      [](void* given) -> void* {
        auto& all = *static_cast<Shared*>(given);
        CBAttachThread(all.broker, all.context);
        CMPIStatus outcome = ok;
        std::this_thread::sleep_for(30ms);
        const auto* path = CMNewObjectPath(all.broker, testNamespace, "TST_Processor", nullptr);
        CBEnumInstances(all.broker, all.context, path, nullptr, &outcome);
        all.after = outcome.rc;
        CBDetachThread(all.broker, all.context);
        return nullptr;
      },
      &shared, 0);
  broker->xft->joinThread(thread, nullptr);
  EXPECT_EQ(shared.after, CMPI_RC_ERR_FAILED);
}

TEST_F(ProviderGuardTest, AFactoryReachesOtherProviders) {
  serveOther([&](const CMPIBroker* given, const CMPIContext* none, CMPIStatus* outcome) {
    CBEnumInstances(given, none, CMNewObjectPath(given, testNamespace, "TST_Processor", nullptr), nullptr, outcome);
  });
  EXPECT_EQ(enumerated("TST_Other"), "0: ");
  EXPECT_THAT(probe->calls, SizeIs(1));
}

TEST_F(ProviderGuardTest, AFactoryThatAsksForItselfIsRefusedAndDoesNotHang) {
  CMPIStatus inner = ok;
  std::string told;
  serveOther([&](const CMPIBroker* given, const CMPIContext* none, CMPIStatus*) {
    CBEnumInstances(given, none, CMNewObjectPath(given, testNamespace, "TST_Other", nullptr), nullptr, &inner);
    told = shownText(inner.msg);
  });
  EXPECT_EQ(enumerated("TST_Other"), "0: ");
  EXPECT_EQ(inner.rc, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(told, "provider other is still being made by its factory");
}

TEST_F(ProviderGuardTest, AFactoryThatWaitsForAThreadWhichAsksForItDoesNotHang) {
  CMPIrc inner = CMPI_RC_OK;
  serveOther([&](const CMPIBroker* given, const CMPIContext*, CMPIStatus*) {
    std::thread([&] {
      RequestScope scope(given, std::chrono::steady_clock::now() + 50ms);
      CMPIStatus outcome = ok;
      CBEnumInstances(given, scope.context(), CMNewObjectPath(given, testNamespace, "TST_Other", nullptr), nullptr,
                      &outcome);
      inner = outcome.rc;
    }).join();
  });
  EXPECT_EQ(enumerated("TST_Other"), "0: ");
  EXPECT_EQ(inner, CMPI_RC_ERR_FAILED);
}

TEST_F(ProviderGuardTest, AThreadWaitsForTheFactoryOfAnother) {
  std::atomic<bool> isMaking = false;
  serveOther([&](const CMPIBroker*, const CMPIContext*, CMPIStatus*) {
    isMaking = true;
    std::this_thread::sleep_for(30ms);
  });
  CMPIStatus outcome = {CMPI_RC_ERROR, nullptr};
  std::thread first([&] {
    RequestScope scope(broker);
    CBEnumInstances(broker, scope.context(), CMNewObjectPath(broker, testNamespace, "TST_Other", nullptr), nullptr,
                    &outcome);
  });
  while (!isMaking) {
    std::this_thread::yield();
  }
  EXPECT_EQ(enumerated("TST_Other"), "0: ");
  first.join();
  EXPECT_EQ(outcome.rc, CMPI_RC_OK);
}

// What a manager logs while it cleans its one provider up.
class CleanUpTest : public testing::Test {
 protected:
  std::vector<std::string> cleanedUp(std::function<CMPIStatus()> cleanUp, std::chrono::milliseconds limit = 60s) {
    std::vector<std::string> log;
    {
      ObjectManager manager;
      manager.loadSchemaText(testSchema, testNamespace);
      manager.setLog([&](int, std::string_view component, std::string_view text) {
        log.push_back(std::string(component) + ": " + std::string(text));
      });
      manager.setProviderLimit(limit);
      probe->cleanUp = std::move(cleanUp);
      probe->serve(manager, "TST_Processor", testNamespace);
      RequestScope scope(manager.broker());
      CBEnumInstances(manager.broker(), scope.context(),
                      CMNewObjectPath(manager.broker(), testNamespace, "TST_Processor", nullptr), nullptr, nullptr);
    }
    return log;
  }

  std::shared_ptr<RecordingProvider> probe = std::make_shared<RecordingProvider>();
};

TEST_F(CleanUpTest, WhatThrowsIsLogged) {
  EXPECT_THAT(cleanedUp([]() -> CMPIStatus { throw std::runtime_error("too late"); }),
              ElementsAre("cimomd: the clean-up of provider TST_Processor failed with return code 1: the clean-up of "
                          "provider TST_Processor threw an exception: too late"));
  EXPECT_EQ(probe->cleanups, 1);
}

TEST_F(CleanUpTest, AProviderThatMustStayLoadedIsNoFailure) {
  EXPECT_THAT(cleanedUp([] { return CMPIStatus{CMPI_RC_NEVER_UNLOAD, nullptr}; }), IsEmpty());
}

TEST_F(CleanUpTest, AThreadThatItEndsIsLogged) {
  if (sanitized()) {
    GTEST_SKIP() << "the address sanitizer does not follow the unwinding of a thread";
  }
  EXPECT_THAT(cleanedUp([]() -> CMPIStatus { pthread_exit(nullptr); }),
              ElementsAre("cimomd: the clean-up of provider TST_Processor ended its thread"));
}

TEST_F(CleanUpTest, NobodyWaitsLongForWhatHangsAndItMayStillUseTheBroker) {
  if (sanitized()) {
    GTEST_SKIP() << "what is left to a clean-up that hangs is a leak";
  }
  // Given a clean-up that goes on until it is let go, and uses the broker then
  static std::atomic<bool> go;
  static std::atomic<CMPIrc> later;
  go = false;
  later = CMPI_RC_ERROR;
  const auto started = std::chrono::steady_clock::now();
  EXPECT_THAT(cleanedUp(
                  [probe = probe.get()] {
                    while (!go) {
                      std::this_thread::sleep_for(1ms);
                    }
                    CMPIStatus outcome = ok;
                    CMNewObjectPath(probe->broker, testNamespace, "TST_Processor", &outcome);
                    later = outcome.rc;
                    return ok;
                  },
                  50ms),
              ElementsAre("cimomd: the clean-up of provider TST_Processor has not ended after 50 ms; its library stays "
                          "loaded"));
  EXPECT_LT(std::chrono::steady_clock::now() - started, 30s);
  go = true;
  while (later == CMPI_RC_ERROR) {
    std::this_thread::sleep_for(1ms);
  }
  EXPECT_EQ(later, CMPI_RC_OK);
}

}  // namespace
