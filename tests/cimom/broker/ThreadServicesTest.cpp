// SPDX-License-Identifier: Apache-2.0
#include <atomic>
#include <cerrno>
#include <cstdlib>
#include <ctime>

#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Cimom;
using namespace Testing;

class ThreadServicesTest : public ManagedElementsFixture {
 protected:
  const CMPIBrokerExtFT& xft = *broker->xft;
};

void* doubled(void* number) {
  *static_cast<int*>(number) *= 2;
  return number;
}

TEST_F(ThreadServicesTest, AThreadRunsAndReturnsItsResult) {
  int number = 21;
  void* result = nullptr;
  CMPI_THREAD_TYPE thread = xft.newThread(doubled, &number, 0);
  EXPECT_EQ(xft.joinThread(thread, &result), 0);
  EXPECT_EQ(result, &number);
  EXPECT_EQ(number, 42);
}

TEST_F(ThreadServicesTest, AThreadMayEndEarly) {
  static const CMPIBrokerExtFT* services;
  services = &xft;
  void* result = nullptr;
  int number = 1;
  CMPI_THREAD_TYPE thread = xft.newThread(
      [](void* given) -> void* {
        services->exitThread(given);
        return nullptr;
      },
      &number, 0);
  EXPECT_EQ(xft.joinThread(thread, &result), 0);
  EXPECT_EQ(result, &number);
}

TEST_F(ThreadServicesTest, AThreadCanBeCancelled) {
  if (sanitized()) {
    GTEST_SKIP() << "the address sanitizer does not follow the unwinding of a cancelled thread";
  }
  static const CMPIBrokerExtFT* services;
  services = &xft;
  CMPI_THREAD_TYPE thread = xft.newThread(
      [](void*) -> void* {
        for (;;) {
          services->threadSleep(1000);
        }
      },
      nullptr, 0);
  EXPECT_EQ(xft.cancelThread(thread), 0);
  EXPECT_EQ(xft.joinThread(thread, nullptr), 0);
}

TEST_F(ThreadServicesTest, InitialisationRunsOnce) {
  static int runs = 0;
  int once = 0;
  for (int time = 0; time < 3; ++time) {
    EXPECT_EQ(xft.threadOnce(&once, [] { ++runs; }), 0);
  }
  EXPECT_EQ(runs, 1);
}

TEST_F(ThreadServicesTest, EachThreadHasItsOwnValueOfAKey) {
  CMPI_THREAD_KEY_TYPE key;
  int here = 0;
  ASSERT_EQ(xft.createThreadKey(&key, nullptr), 0);
  EXPECT_EQ(xft.setThreadSpecific(key, &here), 0);
  EXPECT_EQ(xft.getThreadSpecific(key), &here);
  EXPECT_EQ(xft.destroyThreadKey(key), 0);
}

TEST_F(ThreadServicesTest, OfAKeyNoMoreIsWrittenThanEveryProviderHasRoomFor) {
  // Given a key of four bytes, as most headers have it, and what lies behind it in the provider's memory
  struct {
    std::uint32_t key = 0;
    std::uint32_t behind = 0x12345678;
    std::uint32_t further = 0x12345678;
  } memory;
  ASSERT_EQ(xft.createThreadKey(reinterpret_cast<CMPI_THREAD_KEY_TYPE*>(&memory.key), nullptr), 0);
  EXPECT_EQ(memory.behind, 0x12345678U);
  EXPECT_EQ(memory.further, 0x12345678U);

  // And as it travels from a provider whose key has eight, with anything in the upper half
  const auto key = static_cast<CMPI_THREAD_KEY_TYPE>(0xabcdef0000000000U | memory.key);
  int here = 0;
  EXPECT_EQ(xft.setThreadSpecific(key, &here), 0);
  EXPECT_EQ(xft.getThreadSpecific(key), &here);
  EXPECT_EQ(xft.destroyThreadKey(key), 0);
}

TEST_F(ThreadServicesTest, AConditionWakesWhoWaitsForIt) {
  struct Shared {
    const CMPIBrokerExtFT* xft;
    CMPI_MUTEX_TYPE mutex;
    CMPI_COND_TYPE condition;
    bool ready;
  } shared = {&xft, xft.newMutex(0), xft.newCondition(0), false};

  xft.lockMutex(shared.mutex);
  CMPI_THREAD_TYPE thread = xft.newThread(
      [](void* given) -> void* {
        auto& all = *static_cast<Shared*>(given);
        all.xft->lockMutex(all.mutex);
        all.ready = true;
        all.xft->signalCondition(all.condition);
        all.xft->unlockMutex(all.mutex);
        return nullptr;
      },
      &shared, 0);
  while (!shared.ready) {
    ASSERT_EQ(xft.condWait(shared.condition, shared.mutex), 0);
  }
  xft.unlockMutex(shared.mutex);
  EXPECT_EQ(xft.joinThread(thread, nullptr), 0);

  xft.lockMutex(shared.mutex);
  timespec past = {1, 0};
  EXPECT_EQ(xft.timedCondWait(shared.condition, shared.mutex, &past), ETIMEDOUT);
  xft.unlockMutex(shared.mutex);
  xft.destroyCondition(shared.condition);
  xft.destroyMutex(shared.mutex);
}

TEST_F(ThreadServicesTest, ARecursiveMutexCanBeLockedTwice) {
  CMPI_MUTEX_TYPE mutex = xft.newMutex(1);
  xft.lockMutex(mutex);
  xft.lockMutex(mutex);
  xft.unlockMutex(mutex);
  xft.unlockMutex(mutex);
  xft.destroyMutex(mutex);
}

TEST_F(ThreadServicesTest, ALibrarysFileNameIsResolved) {
  char* name = xft.resolveFileName("probe");
  EXPECT_STREQ(name, "libprobe.so");
  std::free(name);
}

TEST_F(ThreadServicesTest, NullsAreRefused) {
  EXPECT_EQ(xft.resolveFileName(nullptr), nullptr);
  EXPECT_EQ(xft.newThread(nullptr, nullptr, 0), nullptr);
  EXPECT_EQ(xft.joinThread(nullptr, nullptr), EINVAL);
  EXPECT_EQ(xft.cancelThread(nullptr), EINVAL);
  EXPECT_EQ(xft.threadOnce(nullptr, nullptr), EINVAL);
  EXPECT_EQ(xft.createThreadKey(nullptr, nullptr), EINVAL);
  EXPECT_EQ(xft.condWait(nullptr, nullptr), EINVAL);
  EXPECT_EQ(xft.timedCondWait(nullptr, nullptr, nullptr), EINVAL);
  EXPECT_EQ(xft.signalCondition(nullptr), EINVAL);
  xft.lockMutex(nullptr);
  xft.unlockMutex(nullptr);
  xft.destroyMutex(nullptr);
  xft.destroyCondition(nullptr);
}

TEST_F(ThreadServicesTest, AnAttachedThreadMakesUpCallsWithMemoryOfItsOwn) {
  struct Shared {
    const CMPIBroker* broker;
    CMPIContext* context;
    CMPIStatus attached, detached, tooOften;
    std::string principal;
  } shared = {broker, nullptr, ok, ok, ok, {}};
  CMAddContextEntry(request.context(), CMPIPrincipal, "alice", CMPI_chars);
  shared.context = CBPrepareAttachThread(broker, request.context());
  ASSERT_NE(shared.context, nullptr);

  CMPI_THREAD_TYPE thread = xft.newThread(
      [](void* given) -> void* {
        auto& all = *static_cast<Shared*>(given);
        all.attached = CBAttachThread(all.broker, all.context);
        all.tooOften = {CBAttachThread(all.broker, all.context).rc, nullptr};
        all.principal = shownText(CMGetContextEntry(all.context, CMPIPrincipal, nullptr).value.string);
        CMNewString(all.broker, "goes with the thread", nullptr);
        all.detached = CBDetachThread(all.broker, all.context);
        return nullptr;
      },
      &shared, 0);
  ASSERT_EQ(xft.joinThread(thread, nullptr), 0);

  EXPECT_EQ(shared.attached.rc, CMPI_RC_OK);
  EXPECT_EQ(shared.tooOften.rc, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(shared.detached.rc, CMPI_RC_OK);
  EXPECT_EQ(shared.principal, "alice");
  EXPECT_EQ(CBDetachThread(broker, request.context()).rc, CMPI_RC_ERR_FAILED) << "this thread is not attached";
}

}  // namespace
