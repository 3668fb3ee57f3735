/* SPDX-License-Identifier: Apache-2.0 */
/* CMPI 2.0: operating-system services, reached through the broker's extension table (CMPIBrokerExtFT). */
#ifndef CMPIOS_H_
#define CMPIOS_H_

#include "cmpift.h"

#define CMResolveFileName(b, file) ((b)->xft->resolveFileName((file)))
#define CMNewThread(b, start, parameter, detached) ((b)->xft->newThread((start), (parameter), (detached)))
#define CMJoinThread(b, thread, result) ((b)->xft->joinThread((thread), (result)))
#define CMExitThread(b, result) ((b)->xft->exitThread((result)))
#define CMCancelThread(b, thread) ((b)->xft->cancelThread((thread)))
#define CMThreadOnce(b, once, init) ((b)->xft->threadOnce((once), (init)))
#define CMCreateThreadKey(b, key, cleanup) ((b)->xft->createThreadKey((key), (cleanup)))
#define CMDestroyThreadKey(b, key) ((b)->xft->destroyThreadKey((key)))
#define CMGetThreadSpecific(b, key) ((b)->xft->getThreadSpecific((key)))
#define CMSetThreadSpecific(b, key, value) ((b)->xft->setThreadSpecific((key), (value)))
#define CMThreadSleep(b, milliseconds) ((b)->xft->threadSleep((milliseconds)))
#define CMNewMutex(b, options) ((b)->xft->newMutex((options)))
#define CMDestroyMutex(b, mutex) ((b)->xft->destroyMutex((mutex)))
#define CMLockMutex(b, mutex) ((b)->xft->lockMutex((mutex)))
#define CMUnlockMutex(b, mutex) ((b)->xft->unlockMutex((mutex)))
#define CMNewCondition(b, options) ((b)->xft->newCondition((options)))
#define CMDestroyCondition(b, condition) ((b)->xft->destroyCondition((condition)))
#define CMCondWait(b, condition, mutex) ((b)->xft->condWait((condition), (mutex)))
#define CMTimedCondWait(b, condition, mutex, wait) ((b)->xft->timedCondWait((condition), (mutex), (wait)))
#define CMSignalCondition(b, condition) ((b)->xft->signalCondition((condition)))

#endif /* CMPIOS_H_ */
