/* SPDX-License-Identifier: Apache-2.0 */
/*
 * CMPI 2.0 function tables: the binary interface between a CIM object manager and its providers.
 *
 * The order of the members is the interface. A newer object manager may hand out longer tables, so nothing here may
 * depend on the size of a table that somebody else made. Every function takes the object that it acts on as its first
 * argument; a CMPIStatus pointer may be null where the caller does not care.
 */
#ifndef CMPIFT_H_
#define CMPIFT_H_

#include <stddef.h>
#include <time.h>

#include "cmpidt.h"

#ifdef __cplusplus
extern "C" {
#endif

/* C before 2011 declares it only where POSIX is asked for. */
struct timespec;

struct _CMPIBroker {
  void* hdl;
  CMPIBrokerFT* bft;
  CMPIBrokerEncFT* eft;
  CMPIBrokerExtFT* xft;
  CMPIBrokerMemFT* mft;
};

/* Up-calls: what a provider asks of the object manager and, through it, of other providers. */
struct _CMPIBrokerFT {
  unsigned int brokerCapabilities;
  unsigned int brokerVersion;
  const char* brokerName;
  CMPIContext* (*prepareAttachThread)(const CMPIBroker*, const CMPIContext*);
  CMPIStatus (*attachThread)(const CMPIBroker*, const CMPIContext*);
  CMPIStatus (*detachThread)(const CMPIBroker*, const CMPIContext*);
  CMPIStatus (*deliverIndication)(const CMPIBroker*, const CMPIContext*, const char*, const CMPIInstance*);
  CMPIEnumeration* (*enumerateInstanceNames)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, CMPIStatus*);
  CMPIInstance* (*getInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**, CMPIStatus*);
  CMPIObjectPath* (*createInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const CMPIInstance*,
                                    CMPIStatus*);
  CMPIStatus (*modifyInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const CMPIInstance*,
                               const char**);
  CMPIStatus (*deleteInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*);
  CMPIEnumeration* (*execQuery)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*,
                                CMPIStatus*);
  CMPIEnumeration* (*enumerateInstances)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char**,
                                         CMPIStatus*);
  CMPIEnumeration* (*associators)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*,
                                  const char*, const char*, const char*, const char**, CMPIStatus*);
  CMPIEnumeration* (*associatorNames)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*,
                                      const char*, const char*, const char*, CMPIStatus*);
  CMPIEnumeration* (*references)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const char*,
                                 const char**, CMPIStatus*);
  CMPIEnumeration* (*referenceNames)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*,
                                     const char*, CMPIStatus*);
  CMPIData (*invokeMethod)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const CMPIArgs*,
                           CMPIArgs*, CMPIStatus*);
  CMPIStatus (*setProperty)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, const CMPIValue*,
                            CMPIType);
  CMPIData (*getProperty)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*, CMPIStatus*);
};

/* Encapsulation: the makers of every object that a provider hands out, and the broker's own log and trace. */
struct _CMPIBrokerEncFT {
  int ftVersion;
  CMPIInstance* (*newInstance)(const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*);
  CMPIObjectPath* (*newObjectPath)(const CMPIBroker*, const char*, const char*, CMPIStatus*);
  CMPIArgs* (*newArgs)(const CMPIBroker*, CMPIStatus*);
  CMPIString* (*newString)(const CMPIBroker*, const char*, CMPIStatus*);
  CMPIArray* (*newArray)(const CMPIBroker*, CMPICount, CMPIType, CMPIStatus*);
  CMPIDateTime* (*newDateTime)(const CMPIBroker*, CMPIStatus*);
  CMPIDateTime* (*newDateTimeFromBinary)(const CMPIBroker*, CMPIUint64, CMPIBoolean, CMPIStatus*);
  CMPIDateTime* (*newDateTimeFromChars)(const CMPIBroker*, const char*, CMPIStatus*);
  CMPISelectExp* (*newSelectExp)(const CMPIBroker*, const char*, const char*, CMPIArray**, CMPIStatus*);
  CMPIBoolean (*classPathIsA)(const CMPIBroker*, const CMPIObjectPath*, const char*, CMPIStatus*);
  CMPIString* (*toString)(const CMPIBroker*, const void*, CMPIStatus*);
  CMPIBoolean (*isOfType)(const CMPIBroker*, const void*, const char*, CMPIStatus*);
  CMPIString* (*getType)(const CMPIBroker*, const void*, CMPIStatus*);
  CMPIString* (*getMessage)(const CMPIBroker*, const char*, const char*, CMPIStatus*, CMPICount, ...);
  CMPIStatus (*logMessage)(const CMPIBroker*, int, const char*, const char*, const CMPIString*);
  CMPIStatus (*trace)(const CMPIBroker*, int, const char*, const char*, const CMPIString*);
  CMPIError* (*newCMPIError)(const CMPIBroker*, const char*, const char*, const char*, const CMPIErrorSeverity,
                             const CMPIErrorProbableCause, const CMPIrc, CMPIStatus*);
  CMPIStatus (*openMessageFile)(const CMPIBroker*, const char*, CMPIMsgFileHandle*);
  CMPIStatus (*closeMessageFile)(const CMPIBroker*, const CMPIMsgFileHandle);
  CMPIString* (*getMessage2)(const CMPIBroker*, const char*, const CMPIMsgFileHandle, const char*, CMPIStatus*,
                             CMPICount, ...);
};

/* Operating-system services (threads, mutexes, conditions) as the object manager wants them used. */
struct _CMPIBrokerExtFT {
  int ftVersion;
  char* (*resolveFileName)(const char*);
  CMPI_THREAD_TYPE (*newThread)(CMPI_THREAD_RETURN(CMPI_THREAD_CDECL* start)(void*), void*, int);
  int (*joinThread)(CMPI_THREAD_TYPE, CMPI_THREAD_RETURN*);
  int (*exitThread)(CMPI_THREAD_RETURN);
  int (*cancelThread)(CMPI_THREAD_TYPE);
  int (*threadSleep)(CMPIUint32);
  int (*threadOnce)(int*, void (*init)(void));
  int (*createThreadKey)(CMPI_THREAD_KEY_TYPE*, void (*cleanup)(void*));
  int (*destroyThreadKey)(CMPI_THREAD_KEY_TYPE);
  void* (*getThreadSpecific)(CMPI_THREAD_KEY_TYPE);
  int (*setThreadSpecific)(CMPI_THREAD_KEY_TYPE, void*);
  CMPI_MUTEX_TYPE (*newMutex)(int);
  void (*destroyMutex)(CMPI_MUTEX_TYPE);
  void (*lockMutex)(CMPI_MUTEX_TYPE);
  void (*unlockMutex)(CMPI_MUTEX_TYPE);
  CMPI_COND_TYPE (*newCondition)(int);
  void (*destroyCondition)(CMPI_COND_TYPE);
  int (*condWait)(CMPI_COND_TYPE, CMPI_MUTEX_TYPE);
  int (*timedCondWait)(CMPI_COND_TYPE, CMPI_MUTEX_TYPE, struct timespec*);
  int (*signalCondition)(CMPI_COND_TYPE);
};

/* Memory management. An object manager may leave this table null. */
struct _CMPIBrokerMemFT {
  const int ftVersion;
  CMPIGcStat* (*mark)(const CMPIBroker*, CMPIStatus*);
  CMPIStatus (*release)(const CMPIBroker*, const CMPIGcStat*);
  void* (*cmpiMalloc)(const CMPIBroker*, size_t);
  void* (*cmpiCalloc)(const CMPIBroker*, size_t, size_t);
  void* (*cmpiRealloc)(const CMPIBroker*, void*, size_t);
  char* (*cmpiStrDup)(const CMPIBroker*, const char*);
  void (*cmpiFree)(const CMPIBroker*, void*);
  void (*freeInstance)(const CMPIBroker*, CMPIInstance*);
  void (*freeObjectPath)(const CMPIBroker*, CMPIObjectPath*);
  void (*freeArgs)(const CMPIBroker*, CMPIArgs*);
  void (*freeString)(const CMPIBroker*, CMPIString*);
  void (*freeArray)(const CMPIBroker*, CMPIArray*);
  void (*freeDateTime)(const CMPIBroker*, CMPIDateTime*);
  void (*freeSelectExp)(const CMPIBroker*, CMPISelectExp*);
};

struct _CMPIContext {
  void* hdl;
  CMPIContextFT* ft;
};

/* The request's context: named entries such as the principal and the invocation flags. */
struct _CMPIContextFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIContext*);
  CMPIContext* (*clone)(const CMPIContext*, CMPIStatus*);
  CMPIData (*getEntry)(const CMPIContext*, const char*, CMPIStatus*);
  CMPIData (*getEntryAt)(const CMPIContext*, CMPICount, CMPIString**, CMPIStatus*);
  CMPICount (*getEntryCount)(const CMPIContext*, CMPIStatus*);
  CMPIStatus (*addEntry)(const CMPIContext*, const char*, const CMPIValue*, const CMPIType);
};

struct _CMPIResult {
  void* hdl;
  CMPIResultFT* ft;
};

/* Where a provider delivers what it found, one item at a time. */
struct _CMPIResultFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIResult*);
  CMPIResult* (*clone)(const CMPIResult*, CMPIStatus*);
  CMPIStatus (*returnData)(const CMPIResult*, const CMPIValue*, const CMPIType);
  CMPIStatus (*returnInstance)(const CMPIResult*, const CMPIInstance*);
  CMPIStatus (*returnObjectPath)(const CMPIResult*, const CMPIObjectPath*);
  CMPIStatus (*returnDone)(const CMPIResult*);
  CMPIStatus (*returnError)(const CMPIResult*, const CMPIError*);
};

struct _CMPIInstance {
  void* hdl;
  CMPIInstanceFT* ft;
};

/* An instance: a path and typed, named properties. */
struct _CMPIInstanceFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIInstance*);
  CMPIInstance* (*clone)(const CMPIInstance*, CMPIStatus*);
  CMPIData (*getProperty)(const CMPIInstance*, const char*, CMPIStatus*);
  CMPIData (*getPropertyAt)(const CMPIInstance*, CMPICount, CMPIString**, CMPIStatus*);
  CMPICount (*getPropertyCount)(const CMPIInstance*, CMPIStatus*);
  CMPIStatus (*setProperty)(const CMPIInstance*, const char*, const CMPIValue*, CMPIType);
  CMPIObjectPath* (*getObjectPath)(const CMPIInstance*, CMPIStatus*);
  CMPIStatus (*setPropertyFilter)(CMPIInstance*, const char**, const char**);
  CMPIStatus (*setObjectPath)(CMPIInstance*, const CMPIObjectPath*);
  CMPIStatus (*setPropertyWithOrigin)(const CMPIInstance*, const char*, const CMPIValue*, const CMPIType, const char*);
};

struct _CMPIObjectPath {
  void* hdl;
  CMPIObjectPathFT* ft;
};

/* An object path: host, namespace, class and keys. */
struct _CMPIObjectPathFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIObjectPath*);
  CMPIObjectPath* (*clone)(const CMPIObjectPath*, CMPIStatus*);
  CMPIStatus (*setNameSpace)(CMPIObjectPath*, const char*);
  CMPIString* (*getNameSpace)(const CMPIObjectPath*, CMPIStatus*);
  CMPIStatus (*setHostname)(CMPIObjectPath*, const char*);
  CMPIString* (*getHostname)(const CMPIObjectPath*, CMPIStatus*);
  CMPIStatus (*setClassName)(CMPIObjectPath*, const char*);
  CMPIString* (*getClassName)(const CMPIObjectPath*, CMPIStatus*);
  CMPIStatus (*addKey)(CMPIObjectPath*, const char*, const CMPIValue*, const CMPIType);
  CMPIData (*getKey)(const CMPIObjectPath*, const char*, CMPIStatus*);
  CMPIData (*getKeyAt)(const CMPIObjectPath*, CMPICount, CMPIString**, CMPIStatus*);
  CMPICount (*getKeyCount)(const CMPIObjectPath*, CMPIStatus*);
  CMPIStatus (*setNameSpaceFromObjectPath)(CMPIObjectPath*, const CMPIObjectPath*);
  CMPIStatus (*setHostAndNameSpaceFromObjectPath)(CMPIObjectPath*, const CMPIObjectPath*);
  CMPIData (*getClassQualifier)(const CMPIObjectPath*, const char*, CMPIStatus*);
  CMPIData (*getPropertyQualifier)(const CMPIObjectPath*, const char*, const char*, CMPIStatus*);
  CMPIData (*getMethodQualifier)(const CMPIObjectPath*, const char*, const char*, CMPIStatus*);
  CMPIData (*getParameterQualifier)(const CMPIObjectPath*, const char*, const char*, const char*, CMPIStatus*);
  CMPIString* (*toString)(const CMPIObjectPath*, CMPIStatus*);
};

struct _CMPIString {
  void* hdl;
  CMPIStringFT* ft;
};

/* A string in the object manager's encoding (UTF-8). */
struct _CMPIStringFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIString*);
  CMPIString* (*clone)(const CMPIString*, CMPIStatus*);
  const char* (*getCharPtr)(const CMPIString*, CMPIStatus*);
};

struct _CMPIArray {
  void* hdl;
  CMPIArrayFT* ft;
};

/* A fixed-size array of one simple type. */
struct _CMPIArrayFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIArray*);
  CMPIArray* (*clone)(const CMPIArray*, CMPIStatus*);
  CMPICount (*getSize)(const CMPIArray*, CMPIStatus*);
  CMPIType (*getSimpleType)(const CMPIArray*, CMPIStatus*);
  CMPIData (*getElementAt)(const CMPIArray*, CMPICount, CMPIStatus*);
  CMPIStatus (*setElementAt)(CMPIArray*, CMPICount, const CMPIValue*, CMPIType);
};

struct _CMPIEnumeration {
  void* hdl;
  CMPIEnumerationFT* ft;
};

/* A forward walk over the results of an up-call. */
struct _CMPIEnumerationFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIEnumeration*);
  CMPIEnumeration* (*clone)(const CMPIEnumeration*, CMPIStatus*);
  CMPIData (*getNext)(const CMPIEnumeration*, CMPIStatus*);
  CMPIBoolean (*hasNext)(const CMPIEnumeration*, CMPIStatus*);
  CMPIArray* (*toArray)(const CMPIEnumeration*, CMPIStatus*);
};

struct _CMPIArgs {
  void* hdl;
  CMPIArgsFT* ft;
};

/* The named arguments of an extrinsic method. */
struct _CMPIArgsFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIArgs*);
  CMPIArgs* (*clone)(const CMPIArgs*, CMPIStatus*);
  CMPIStatus (*addArg)(const CMPIArgs*, const char*, const CMPIValue*, const CMPIType);
  CMPIData (*getArg)(const CMPIArgs*, const char*, CMPIStatus*);
  CMPIData (*getArgAt)(const CMPIArgs*, CMPICount, CMPIString**, CMPIStatus*);
  CMPICount (*getArgCount)(const CMPIArgs*, CMPIStatus*);
};

struct _CMPIDateTime {
  void* hdl;
  CMPIDateTimeFT* ft;
};

/* A time stamp or an interval; the binary form counts microseconds. */
struct _CMPIDateTimeFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIDateTime*);
  CMPIDateTime* (*clone)(const CMPIDateTime*, CMPIStatus*);
  CMPIUint64 (*getBinaryFormat)(const CMPIDateTime*, CMPIStatus*);
  CMPIString* (*getStringFormat)(const CMPIDateTime*, CMPIStatus*);
  CMPIBoolean (*isInterval)(const CMPIDateTime*, CMPIStatus*);
};

struct _CMPISelectExp {
  void* hdl;
  CMPISelectExpFT* ft;
};

/* A query or filter expression. */
struct _CMPISelectExpFT {
  int ftVersion;
  CMPIStatus (*release)(CMPISelectExp*);
  CMPISelectExp* (*clone)(const CMPISelectExp*, CMPIStatus*);
  CMPIBoolean (*evaluate)(const CMPISelectExp*, const CMPIInstance*, CMPIStatus*);
  CMPIString* (*getString)(const CMPISelectExp*, CMPIStatus*);
  CMPISelectCond* (*getDOC)(const CMPISelectExp*, CMPIStatus*);
  CMPISelectCond* (*getCOD)(const CMPISelectExp*, CMPIStatus*);
  CMPIBoolean (*evaluateUsingAccessor)(const CMPISelectExp*, CMPIAccessor*, void*, CMPIStatus*);
};

struct _CMPISelectCond {
  void* hdl;
  CMPISelectCondFT* ft;
};

/* A select expression in disjunctive or conjunctive normal form. */
struct _CMPISelectCondFT {
  int ftVersion;
  CMPIStatus (*release)(CMPISelectCond*);
  CMPISelectCond* (*clone)(const CMPISelectCond*, CMPIStatus*);
  CMPICount (*getCountAndType)(const CMPISelectCond*, int*, CMPIStatus*);
  CMPISubCond* (*getSubCondAt)(const CMPISelectCond*, CMPICount, CMPIStatus*);
};

struct _CMPISubCond {
  void* hdl;
  CMPISubCondFT* ft;
};

/* One term of a normal form. */
struct _CMPISubCondFT {
  int ftVersion;
  CMPIStatus (*release)(CMPISubCond*);
  CMPISubCond* (*clone)(const CMPISubCond*, CMPIStatus*);
  CMPICount (*getCount)(const CMPISubCond*, CMPIStatus*);
  CMPIPredicate* (*getPredicateAt)(const CMPISubCond*, CMPICount, CMPIStatus*);
  CMPIPredicate* (*getPredicate)(const CMPISubCond*, const char*, CMPIStatus*);
};

struct _CMPIPredicate {
  void* hdl;
  CMPIPredicateFT* ft;
};

/* One comparison within a term. */
struct _CMPIPredicateFT {
  int ftVersion;
  CMPIStatus (*release)(CMPIPredicate*);
  CMPIPredicate* (*clone)(const CMPIPredicate*, CMPIStatus*);
  CMPIStatus (*getData)(const CMPIPredicate*, CMPIType*, CMPIPredOp*, CMPIString**, CMPIString**);
  CMPIBoolean (*evaluateUsingAccessor)(const CMPIPredicate*, CMPIAccessor*, void*, CMPIStatus*);
};

struct _CMPIError {
  void* hdl;
  CMPIErrorFT* ft;
};

/* A CIM_Error in the making. */
struct _CMPIErrorFT {
  CMPISint32 ftVersion;
  CMPIStatus (*release)(CMPIError*);
  CMPIError* (*clone)(const CMPIError*, CMPIStatus*);
  CMPIErrorType (*getErrorType)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getOtherErrorType)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getOwningEntity)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getMessageID)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getMessage)(const CMPIError*, CMPIStatus*);
  CMPIErrorSeverity (*getPerceivedSeverity)(const CMPIError*, CMPIStatus*);
  CMPIErrorProbableCause (*getProbableCause)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getProbableCauseDescription)(const CMPIError*, CMPIStatus*);
  CMPIArray* (*getRecommendedActions)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getErrorSource)(const CMPIError*, CMPIStatus*);
  CMPIErrorSrcFormat (*getErrorSourceFormat)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getOtherErrorSourceFormat)(const CMPIError*, CMPIStatus*);
  CMPIrc (*getCIMStatusCode)(const CMPIError*, CMPIStatus*);
  CMPIString* (*getCIMStatusCodeDescription)(const CMPIError*, CMPIStatus*);
  CMPIArray* (*getMessageArguments)(const CMPIError*, CMPIStatus*);
  CMPIStatus (*setErrorType)(CMPIError*, const CMPIErrorType);
  CMPIStatus (*setOtherErrorType)(CMPIError*, const char*);
  CMPIStatus (*setProbableCauseDescription)(CMPIError*, const char*);
  CMPIStatus (*setRecommendedActions)(CMPIError*, const CMPIArray*);
  CMPIStatus (*setErrorSource)(CMPIError*, const char*);
  CMPIStatus (*setErrorSourceFormat)(CMPIError*, const CMPIErrorSrcFormat);
  CMPIStatus (*setOtherErrorSourceFormat)(CMPIError*, const char*);
  CMPIStatus (*setCIMStatusCodeDescription)(CMPIError*, const char*);
  CMPIStatus (*setMessageArguments)(CMPIError*, CMPIArray*);
};

struct _CMPIInstanceMI {
  const void* hdl;
  CMPIInstanceMIFT* ft;
};

/* What an instance provider answers. */
struct _CMPIInstanceMIFT {
  int ftVersion;
  int miVersion;
  const char* miName;
  CMPIStatus (*cleanup)(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean);
  CMPIStatus (*enumerateInstanceNames)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*);
  CMPIStatus (*enumerateInstances)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                   const char**);
  CMPIStatus (*getInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                            const char**);
  CMPIStatus (*createInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const CMPIInstance*);
  CMPIStatus (*modifyInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const CMPIInstance*, const char**);
  CMPIStatus (*deleteInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*);
  CMPIStatus (*execQuery)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*,
                          const char*);
};

struct _CMPIAssociationMI {
  void* hdl;
  CMPIAssociationMIFT* ft;
};

/* What an association provider answers. */
struct _CMPIAssociationMIFT {
  int ftVersion;
  const CMPISint32 miVersion;
  const char* miName;
  CMPIStatus (*cleanup)(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean);
  CMPIStatus (*associators)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                            const char*, const char*, const char*, const char*, const char**);
  CMPIStatus (*associatorNames)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                const char*, const char*, const char*, const char*);
  CMPIStatus (*references)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                           const char*, const char*, const char**);
  CMPIStatus (*referenceNames)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const char*, const char*);
};

struct _CMPIMethodMI {
  void* hdl;
  CMPIMethodMIFT* ft;
};

/* What a method provider answers. */
struct _CMPIMethodMIFT {
  int ftVersion;
  int miVersion;
  const char* miName;
  CMPIStatus (*cleanup)(CMPIMethodMI*, const CMPIContext*, CMPIBoolean);
  CMPIStatus (*invokeMethod)(CMPIMethodMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*,
                             const CMPIArgs*, CMPIArgs*);
};

struct _CMPIPropertyMI {
  void* hdl;
  CMPIPropertyMIFT* ft;
};

/* What a property provider answers. */
struct _CMPIPropertyMIFT {
  int ftVersion;
  int miVersion;
  const char* miName;
  CMPIStatus (*cleanup)(CMPIPropertyMI*, const CMPIContext*, CMPIBoolean);
  CMPIStatus (*setProperty)(CMPIPropertyMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*,
                            const CMPIData);
  CMPIStatus (*getProperty)(CMPIPropertyMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char*);
  CMPIStatus (*setPropertyWithOrigin)(CMPIPropertyMI*, const CMPIContext*, const CMPIResult*, CMPIObjectPath*,
                                      const char*, const CMPIData, const char*);
};

struct _CMPIIndicationMI {
  void* hdl;
  CMPIIndicationMIFT* ft;
};

/* What an indication provider answers. */
struct _CMPIIndicationMIFT {
  int ftVersion;
  int miVersion;
  const char* miName;
  CMPIStatus (*cleanup)(CMPIIndicationMI*, const CMPIContext*, CMPIBoolean);
  CMPIStatus (*authorizeFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char*,
                                const CMPIObjectPath*, const char*);
  CMPIStatus (*mustPoll)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char*,
                         const CMPIObjectPath*);
  CMPIStatus (*activateFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char*,
                               const CMPIObjectPath*, CMPIBoolean);
  CMPIStatus (*deActivateFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char*,
                                 const CMPIObjectPath*, CMPIBoolean);
  CMPIStatus (*enableIndications)(CMPIIndicationMI*, const CMPIContext*);
  CMPIStatus (*disableIndications)(CMPIIndicationMI*, const CMPIContext*);
};

#ifdef __cplusplus
}
#endif

#endif /* CMPIFT_H_ */
