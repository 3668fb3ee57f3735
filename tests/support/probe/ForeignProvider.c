/* SPDX-License-Identifier: Apache-2.0 */
/* A provider in C with all that cmpimacs.h has, as somebody else would write it: every stub, and every macro once. */
#include <cmpimacs.h>
#include <cmpios.h>

static const CMPIBroker* broker;

/* Instances */

static CMPIStatus ForeignCleanup(CMPIInstanceMI* mi, const CMPIContext* context, CMPIBoolean terminating) {
  (void)mi, (void)context, (void)terminating;
  CMReturn(CMPI_RC_OK);
}

static CMPIStatus ForeignEnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                           const CMPIObjectPath* path) {
  (void)mi, (void)context;
  CMReturnObjectPath(result, path);
  return CMReturnDone(result);
}

static CMPIStatus ForeignEnumInstances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                       const CMPIObjectPath* path, const char** properties) {
  (void)mi, (void)context, (void)properties;
  CMReturnInstance(result, CMNewInstance(broker, path, NULL));
  return CMReturnDone(result);
}

static CMPIStatus ForeignGetInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path, const char** properties) {
  return ForeignEnumInstances(mi, context, result, path, properties);
}

static CMPIStatus ForeignCreateInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path, const CMPIInstance* instance) {
  (void)mi, (void)context, (void)path;
  CMReturnObjectPath(result, CMGetObjectPath(instance, NULL));
  return CMReturnDone(result);
}

static CMPIStatus ForeignModifyInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path, const CMPIInstance* instance,
                                        const char** properties) {
  (void)mi, (void)context, (void)result, (void)path, (void)instance, (void)properties;
  CMReturnWithChars(broker, CMPI_RC_ERR_NOT_SUPPORTED, "read only");
}

static CMPIStatus ForeignDeleteInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path) {
  (void)mi, (void)context, (void)result, (void)path;
  CMReturnWithString(CMPI_RC_ERR_NOT_SUPPORTED, CMNewString(broker, "read only", NULL));
}

static CMPIStatus ForeignExecQuery(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* path, const char* query, const char* language) {
  (void)mi, (void)context, (void)result, (void)path, (void)query, (void)language;
  CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

/* Methods */

/* Every macro that acts on an error, a message and a thread's key; the name of what fails, or null. */
static const char* misfit(void) {
  CMPIStatus rc = {CMPI_RC_OK, NULL};
  CMPIMsgFileHandle file = NULL;
  CMPI_THREAD_KEY_TYPE key;
  CMPIArray* texts = CMNewArray(broker, 1, CMPI_string, &rc);
  CMPIError* error = CMNewCMPIError(broker, "owner", "id", "text", (CMPIErrorSeverity)3, (CMPIErrorProbableCause)4,
                                    CMPI_RC_ERR_FAILED, &rc);
  if (CMOpenMessageFile(broker, "none", &file).rc != CMPI_RC_ERR_NOT_FOUND) {
    return "CMOpenMessageFile";
  }
  if (CMIsNullObject(CMGetMessage2(broker, "id", file, "$0", &rc, CMFmtArgs1(CMFmtSint(-1))))) {
    return "CMGetMessage2";
  }
  if (CMCloseMessageFile(broker, file).rc != CMPI_RC_ERR_INVALID_HANDLE) {
    return "CMCloseMessageFile";
  }
  CMSetErrorType(error, (CMPIErrorType)2);
  CMSetOtherErrorType(error, "type");
  CMSetProbableCauseDescription(error, "cause");
  CMSetRecommendedActions(error, texts);
  CMSetErrorSource(error, "source");
  CMSetErrorSourceFormat(error, (CMPIErrorSrcFormat)1);
  CMSetOtherErrorSourceFormat(error, "format");
  CMSetCIMStatusCodeDescription(error, "status");
  CMSetMessageArguments(error, texts);
  if (CMGetErrorType(error, &rc) != (CMPIErrorType)2 || CMGetPerceivedSeverity(error, &rc) != (CMPIErrorSeverity)3 ||
      CMGetProbableCause(error, &rc) != (CMPIErrorProbableCause)4 ||
      CMGetErrorSourceFormat(error, &rc) != (CMPIErrorSrcFormat)1 ||
      CMGetCIMStatusCode(error, &rc) != CMPI_RC_ERR_FAILED || CMIsNullObject(CMGetOtherErrorType(error, &rc)) ||
      CMIsNullObject(CMGetOwningEntity(error, &rc)) || CMIsNullObject(CMGetMessageID(error, &rc)) ||
      CMIsNullObject(CMGetErrorMessage(error, &rc)) || CMIsNullObject(CMGetProbableCauseDescription(error, &rc)) ||
      CMIsNullObject(CMGetRecommendedActions(error, &rc)) || CMIsNullObject(CMGetErrorSource(error, &rc)) ||
      CMIsNullObject(CMGetOtherErrorSourceFormat(error, &rc)) ||
      CMIsNullObject(CMGetCIMStatusCodeDescription(error, &rc)) || CMIsNullObject(CMGetMessageArguments(error, &rc))) {
    return "an error's macro";
  }
  if (CMCreateThreadKey(broker, &key, NULL) != 0 || CMSetThreadSpecific(broker, key, &file) != 0 ||
      CMGetThreadSpecific(broker, key) != &file || CMDestroyThreadKey(broker, key) != 0) {
    return "a thread key's macro";
  }
  return NULL;
}

static CMPIStatus ForeignMethodCleanup(CMPIMethodMI* mi, const CMPIContext* context, CMPIBoolean terminating) {
  (void)mi, (void)context, (void)terminating;
  CMReturn(CMPI_RC_OK);
}

static CMPIStatus ForeignInvokeMethod(CMPIMethodMI* mi, const CMPIContext* context, const CMPIResult* result,
                                      const CMPIObjectPath* path, const char* method, const CMPIArgs* in,
                                      CMPIArgs* out) {
  CMPIUint32 count = CMGetArgCount(in, NULL);
  const char* wrong = misfit();
  (void)mi, (void)context, (void)path, (void)out;
  if (wrong) {
    CMReturnWithString(CMPI_RC_ERR_FAILED, CMGetMessage(broker, "id", "$0: $1 does not fit", NULL,
                                                        CMFmtArgs2(CMFmtChars(method), CMFmtChars(wrong))));
  }
  CMReturnData(result, &count, CMPI_uint32);
  return CMReturnDone(result);
}

/* Associations, properties and indications: no more than their stubs ask for. */

#define REFUSED \
  { CMReturn(CMPI_RC_ERR_NOT_SUPPORTED); }
#define COMMON const CMPIContext *c, const CMPIResult *r, const CMPIObjectPath *p

static CMPIStatus ForeignAssociationCleanup(CMPIAssociationMI* m, const CMPIContext* c, CMPIBoolean t) {
  (void)m, (void)c, (void)t;
  CMReturn(CMPI_RC_OK);
}
static CMPIStatus ForeignAssociators(CMPIAssociationMI* m, COMMON, const char* a, const char* b, const char* d,
                                     const char* e, const char** l) {
  (void)m, (void)c, (void)r, (void)p, (void)a, (void)b, (void)d, (void)e, (void)l;
  REFUSED
}
static CMPIStatus ForeignAssociatorNames(CMPIAssociationMI* m, COMMON, const char* a, const char* b, const char* d,
                                         const char* e) {
  (void)m, (void)c, (void)r, (void)p, (void)a, (void)b, (void)d, (void)e;
  REFUSED
}
static CMPIStatus ForeignReferences(CMPIAssociationMI* m, COMMON, const char* a, const char* b, const char** l) {
  (void)m, (void)c, (void)r, (void)p, (void)a, (void)b, (void)l;
  REFUSED
}
static CMPIStatus ForeignReferenceNames(CMPIAssociationMI* m, COMMON, const char* a, const char* b) {
  (void)m, (void)c, (void)r, (void)p, (void)a, (void)b;
  REFUSED
}

static CMPIStatus ForeignPropertyCleanup(CMPIPropertyMI* m, const CMPIContext* c, CMPIBoolean t) {
  (void)m, (void)c, (void)t;
  CMReturn(CMPI_RC_OK);
}
static CMPIStatus ForeignSetProperty(CMPIPropertyMI* m, COMMON, const char* n, const CMPIData d) {
  (void)m, (void)c, (void)r, (void)p, (void)n, (void)d;
  REFUSED
}
static CMPIStatus ForeignGetProperty(CMPIPropertyMI* m, COMMON, const char* n) {
  (void)m, (void)c, (void)r, (void)p, (void)n;
  REFUSED
}

#define FILTER const CMPIContext *c, const CMPISelectExp *s, const char *n, const CMPIObjectPath *p

static CMPIStatus ForeignIndicationCleanup(CMPIIndicationMI* m, const CMPIContext* c, CMPIBoolean t) {
  (void)m, (void)c, (void)t;
  CMReturn(CMPI_RC_OK);
}
/* What a filter is asked for, by the macros of select expressions. */
static CMPIStatus ForeignAuthorizeFilter(CMPIIndicationMI* m, FILTER, const char* owner) {
  CMPIStatus rc = {CMPI_RC_OK, NULL};
  int type = 0;
  CMPISelectCond* normal = CMGetDoc(s, &rc);
  CMPISubCond* term = CMGetSubCondAt(normal ? normal : CMGetCod(s, &rc), 0, &rc);
  CMPIPredicate* predicate = CMGetPredicateAt(term, 0, &rc);
  (void)m, (void)c, (void)n, (void)p, (void)owner;
  CMGetSelExpString(s, &rc);
  CMEvaluateSelExp(s, NULL, &rc);
  CMEvaluateSelExpUsingAccessor(s, NULL, NULL, &rc);
  CMGetSubCondCountAndType(normal, &type, &rc);
  CMGetPredicateCount(term, &rc);
  CMGetPredicate(term, "Name", &rc);
  CMGetPredicateData(predicate, NULL, NULL, NULL, NULL);
  CMEvaluatePredicateUsingAccessor(predicate, NULL, NULL, &rc);
  CMSetStatus(&rc, CMPI_RC_OK);
  return rc;
}
static CMPIStatus ForeignMustPoll(CMPIIndicationMI* m, FILTER) {
  (void)m, (void)c, (void)s, (void)n, (void)p;
  REFUSED
}
static CMPIStatus ForeignActivateFilter(CMPIIndicationMI* m, FILTER, CMPIBoolean first) {
  (void)m, (void)c, (void)s, (void)n, (void)p, (void)first;
  REFUSED
}
static CMPIStatus ForeignDeActivateFilter(CMPIIndicationMI* m, FILTER, CMPIBoolean last) {
  (void)m, (void)c, (void)s, (void)n, (void)p, (void)last;
  REFUSED
}
static CMPIStatus ForeignEnableIndications(CMPIIndicationMI* m, const CMPIContext* c) {
  (void)m, (void)c;
  REFUSED
}
static CMPIStatus ForeignDisableIndications(CMPIIndicationMI* m, const CMPIContext* c) {
  (void)m, (void)c;
  REFUSED
}

CMInstanceMIStub(Foreign, ForeignProvider, broker, CMNoHook)
CMAssociationMIStub(Foreign, ForeignProvider, broker, CMNoHook)
CMMethodMIStub(Foreign, ForeignProvider, broker, CMNoHook)
CMPropertyMIStub(Foreign, ForeignProvider, broker, CMNoHook)
CMIndicationMIStub(Foreign, ForeignProvider, broker, CMNoHook)
