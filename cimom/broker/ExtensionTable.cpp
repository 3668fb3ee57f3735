// SPDX-License-Identifier: Apache-2.0
// Threads, mutexes and conditions, as providers reach them: POSIX threads, whose semantics the interface's are.
#include <pthread.h>
#include <string.h>

#include <cerrno>
#include <chrono>
#include <cstring>
#include <memory>
#include <new>
#include <string>
#include <thread>
#include <type_traits>

#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/ProviderFrame.h"

namespace Cimom {
namespace {

static_assert(std::is_same_v<pthread_once_t, int>, "the interface's once-control is an int");
static_assert(sizeof(pthread_t) == sizeof(CMPI_THREAD_TYPE), "a thread's id travels as a pointer");

pthread_mutex_t* mutexOf(CMPI_MUTEX_TYPE mutex) { return static_cast<pthread_mutex_t*>(mutex); }
pthread_cond_t* conditionOf(CMPI_COND_TYPE condition) { return static_cast<pthread_cond_t*>(condition); }
pthread_t threadOf(CMPI_THREAD_TYPE thread) { return reinterpret_cast<pthread_t>(thread); }

// The file name of a library as providers are looked for; the caller frees it.
char* resolveFileName(const char* name) {
  if (!name) {
    return nullptr;
  }
  const std::string file = std::string("lib") + name + ".so";
  return ::strdup(file.c_str());
}

CMPI_THREAD_TYPE newThread(CMPI_THREAD_RETURN(CMPI_THREAD_CDECL* start)(void*), void* parameter, int detached) {
  if (!start) {
    return nullptr;
  }
  pthread_attr_t attributes;
  pthread_attr_init(&attributes);
  pthread_attr_setdetachstate(&attributes, detached ? PTHREAD_CREATE_DETACHED : PTHREAD_CREATE_JOINABLE);
  pthread_t thread;
  const int error = pthread_create(&thread, &attributes, start, parameter);
  pthread_attr_destroy(&attributes);
  return error ? nullptr : reinterpret_cast<CMPI_THREAD_TYPE>(thread);
}

int joinThread(CMPI_THREAD_TYPE thread, CMPI_THREAD_RETURN* result) {
  return thread ? pthread_join(threadOf(thread), result) : EINVAL;
}

// A thread of the object manager's is not the provider's to end: on one, this ends the provider's call.
int exitThread(CMPI_THREAD_RETURN result) {
  if (ProviderFrame::isOnThisThread()) {
    throw ThreadExit();
  }
  pthread_exit(result);
}

int cancelThread(CMPI_THREAD_TYPE thread) { return thread ? pthread_cancel(threadOf(thread)) : EINVAL; }

int threadSleep(CMPIUint32 milliseconds) {
  std::this_thread::sleep_for(std::chrono::milliseconds(milliseconds));
  return 0;
}

int threadOnce(int* once, void (*initialise)()) { return once && initialise ? pthread_once(once, initialise) : EINVAL; }

// A provider may have been built with the headers whose key has four bytes, whatever the type has here.
static_assert(sizeof(pthread_key_t) == 4 && sizeof(CMPI_THREAD_KEY_TYPE) >= 4, "no more than four bytes are written");

int createThreadKey(CMPI_THREAD_KEY_TYPE* key, void (*cleanup)(void*)) {
  pthread_key_t made;
  if (!key) {
    return EINVAL;
  }
  const int error = pthread_key_create(&made, cleanup);
  if (!error) {
    std::memcpy(key, &made, sizeof made);
  }
  return error;
}

int destroyThreadKey(CMPI_THREAD_KEY_TYPE key) { return pthread_key_delete(static_cast<pthread_key_t>(key)); }

void* getThreadSpecific(CMPI_THREAD_KEY_TYPE key) { return pthread_getspecific(static_cast<pthread_key_t>(key)); }

int setThreadSpecific(CMPI_THREAD_KEY_TYPE key, void* value) {
  return pthread_setspecific(static_cast<pthread_key_t>(key), value);
}

// A mutex that its thread may lock again, if `recursive` says so.
CMPI_MUTEX_TYPE newMutex(int recursive) {
  auto mutex = std::unique_ptr<pthread_mutex_t>(new (std::nothrow) pthread_mutex_t);
  pthread_mutexattr_t attributes;
  if (!mutex || pthread_mutexattr_init(&attributes)) {
    return nullptr;
  }
  pthread_mutexattr_settype(&attributes, recursive ? PTHREAD_MUTEX_RECURSIVE : PTHREAD_MUTEX_DEFAULT);
  const int error = pthread_mutex_init(mutex.get(), &attributes);
  pthread_mutexattr_destroy(&attributes);
  return error ? nullptr : mutex.release();
}

void destroyMutex(CMPI_MUTEX_TYPE mutex) {
  if (!mutex) {
    return;
  }
  pthread_mutex_destroy(mutexOf(mutex));
  delete mutexOf(mutex);
}

void lockMutex(CMPI_MUTEX_TYPE mutex) {
  if (mutex) {
    pthread_mutex_lock(mutexOf(mutex));
  }
}

void unlockMutex(CMPI_MUTEX_TYPE mutex) {
  if (mutex) {
    pthread_mutex_unlock(mutexOf(mutex));
  }
}

CMPI_COND_TYPE newCondition(int) {
  auto condition = std::unique_ptr<pthread_cond_t>(new (std::nothrow) pthread_cond_t);
  if (!condition || pthread_cond_init(condition.get(), nullptr)) {
    return nullptr;
  }
  return condition.release();
}

void destroyCondition(CMPI_COND_TYPE condition) {
  if (!condition) {
    return;
  }
  pthread_cond_destroy(conditionOf(condition));
  delete conditionOf(condition);
}

int condWait(CMPI_COND_TYPE condition, CMPI_MUTEX_TYPE mutex) {
  return condition && mutex ? pthread_cond_wait(conditionOf(condition), mutexOf(mutex)) : EINVAL;
}

int timedCondWait(CMPI_COND_TYPE condition, CMPI_MUTEX_TYPE mutex, timespec* until) {
  return condition && mutex && until ? pthread_cond_timedwait(conditionOf(condition), mutexOf(mutex), until) : EINVAL;
}

int signalCondition(CMPI_COND_TYPE condition) {
  return condition ? pthread_cond_signal(conditionOf(condition)) : EINVAL;
}

}  // namespace

CMPIBrokerExtFT extensionTable = {
    .ftVersion = CMPICurrentVersion,
    .resolveFileName = resolveFileName,
    .newThread = newThread,
    .joinThread = joinThread,
    .exitThread = exitThread,
    .cancelThread = cancelThread,
    .threadSleep = threadSleep,
    .threadOnce = threadOnce,
    .createThreadKey = createThreadKey,
    .destroyThreadKey = destroyThreadKey,
    .getThreadSpecific = getThreadSpecific,
    .setThreadSpecific = setThreadSpecific,
    .newMutex = newMutex,
    .destroyMutex = destroyMutex,
    .lockMutex = lockMutex,
    .unlockMutex = unlockMutex,
    .newCondition = newCondition,
    .destroyCondition = destroyCondition,
    .condWait = condWait,
    .timedCondWait = timedCondWait,
    .signalCondition = signalCondition,
};

}  // namespace Cimom
