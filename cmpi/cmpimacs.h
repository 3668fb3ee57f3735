/* SPDX-License-Identifier: Apache-2.0 */
/*
 * CMPI 2.0 convenience macros: each calls one slot on its first argument. Provider code goes through these and the MI
 * stubs, never through positional knowledge of a table.
 */
#ifndef CMPIMACS_H_
#define CMPIMACS_H_

#include "cmpift.h"

/* The broker's encapsulation table: makers, and the broker's log and trace */

#define CMNewInstance(b, path, rc) ((b)->eft->newInstance((b), (path), (rc)))
#define CMNewObjectPath(b, ns, className, rc) ((b)->eft->newObjectPath((b), (ns), (className), (rc)))
#define CMNewString(b, chars, rc) ((b)->eft->newString((b), (chars), (rc)))
#define CMNewArgs(b, rc) ((b)->eft->newArgs((b), (rc)))
#define CMNewArray(b, count, type, rc) ((b)->eft->newArray((b), (count), (type), (rc)))
#define CMNewDateTime(b, rc) ((b)->eft->newDateTime((b), (rc)))
#define CMNewDateTimeFromBinary(b, value, interval, rc) \
  ((b)->eft->newDateTimeFromBinary((b), (value), (interval), (rc)))
#define CMNewDateTimeFromChars(b, chars, rc) ((b)->eft->newDateTimeFromChars((b), (chars), (rc)))
#define CMNewSelectExp(b, query, lang, projection, rc) \
  ((b)->eft->newSelectExp((b), (query), (lang), (projection), (rc)))
#define CMClassPathIsA(b, path, className, rc) ((b)->eft->classPathIsA((b), (path), (className), (rc)))
#define CDToString(b, object, rc) ((b)->eft->toString((b), (object), (rc)))
#define CDIsOfType(b, object, type, rc) ((b)->eft->isOfType((b), (object), (type), (rc)))
#define CDGetType(b, object, rc) ((b)->eft->getType((b), (object), (rc)))
#define CMNewCMPIError(b, owner, id, message, severity, cause, code, rc) \
  ((b)->eft->newCMPIError((b), (owner), (id), (message), (severity), (cause), (code), (rc)))
#define CMLogMessage(b, severity, id, text, string) ((b)->eft->logMessage((b), (severity), (id), (text), (string)))
#define CMTraceMessage(b, level, component, text, string) ((b)->eft->trace((b), (level), (component), (text), (string)))

/*
 * Messages: the text of a message file, or the default text, with "$0" ... "$9" replaced by arguments. Both take what
 * the CMFmtArgs of their number makes of the arguments, each of which comes from the CMFmt of its type: CMGetMessage(b,
 * "id", "$0 of $1", rc, CMFmtArgs2(CMFmtUint(1), CMFmtChars("two"))).
 */

#define CMOpenMessageFile(b, file, handle) ((b)->eft->openMessageFile((b), (file), (handle)))
#define CMCloseMessageFile(b, handle) ((b)->eft->closeMessageFile((b), (handle)))
#define CMGetMessage(b, id, text, rc, arguments) ((b)->eft->getMessage((b), (id), (text), (rc), arguments))
#define CMGetMessage2(b, id, handle, text, rc, arguments) \
  ((b)->eft->getMessage2((b), (id), (handle), (text), (rc), arguments))

#define CMFmtBoolean(v) CMPI_boolean, ((int)(v))
#define CMFmtSint(v) CMPI_sint32, ((CMPISint32)(v))
#define CMFmtUint(v) CMPI_uint32, ((CMPIUint32)(v))
#define CMFmtSint64(v) CMPI_sint64, ((CMPISint64)(v))
#define CMFmtUint64(v) CMPI_uint64, ((CMPIUint64)(v))
#define CMFmtReal(v) CMPI_real64, ((double)(v))
#define CMFmtChars(v) CMPI_chars, ((const char*)(v))
#define CMFmtString(v) CMPI_string, ((const CMPIString*)(v))

#define CMFmtArgs0() 0
#define CMFmtArgs1(v1) 1, v1
#define CMFmtArgs2(v1, v2) 2, v1, v2
#define CMFmtArgs3(v1, v2, v3) 3, v1, v2, v3
#define CMFmtArgs4(v1, v2, v3, v4) 4, v1, v2, v3, v4
#define CMFmtArgs5(v1, v2, v3, v4, v5) 5, v1, v2, v3, v4, v5
#define CMFmtArgs6(v1, v2, v3, v4, v5, v6) 6, v1, v2, v3, v4, v5, v6
#define CMFmtArgs7(v1, v2, v3, v4, v5, v6, v7) 7, v1, v2, v3, v4, v5, v6, v7
#define CMFmtArgs8(v1, v2, v3, v4, v5, v6, v7, v8) 8, v1, v2, v3, v4, v5, v6, v7, v8
#define CMFmtArgs9(v1, v2, v3, v4, v5, v6, v7, v8, v9) 9, v1, v2, v3, v4, v5, v6, v7, v8, v9
#define CMFmtArgs10(v1, v2, v3, v4, v5, v6, v7, v8, v9, v10) 10, v1, v2, v3, v4, v5, v6, v7, v8, v9, v10

/* The broker's up-call table */

#define CBBrokerVersion(b) ((b)->bft->brokerVersion)
#define CBBrokerName(b) ((b)->bft->brokerName)
#define CBBrokerCapabilities(b) ((b)->bft->brokerCapabilities)
#define CBGetBrokerCapabilities(b) CBBrokerCapabilities(b)
#define CBPrepareAttachThread(b, ctx) ((b)->bft->prepareAttachThread((b), (ctx)))
#define CBAttachThread(b, ctx) ((b)->bft->attachThread((b), (ctx)))
#define CBDetachThread(b, ctx) ((b)->bft->detachThread((b), (ctx)))
#define CBDeliverIndication(b, ctx, ns, inst) ((b)->bft->deliverIndication((b), (ctx), (ns), (inst)))
#define CBEnumInstanceNames(b, ctx, path, rc) ((b)->bft->enumerateInstanceNames((b), (ctx), (path), (rc)))
#define CBEnumInstances(b, ctx, path, properties, rc) \
  ((b)->bft->enumerateInstances((b), (ctx), (path), (properties), (rc)))
#define CBGetInstance(b, ctx, path, properties, rc) ((b)->bft->getInstance((b), (ctx), (path), (properties), (rc)))
#define CBCreateInstance(b, ctx, path, inst, rc) ((b)->bft->createInstance((b), (ctx), (path), (inst), (rc)))
#define CBModifyInstance(b, ctx, path, inst, properties) \
  ((b)->bft->modifyInstance((b), (ctx), (path), (inst), (properties)))
#define CBDeleteInstance(b, ctx, path) ((b)->bft->deleteInstance((b), (ctx), (path)))
#define CBExecQuery(b, ctx, path, query, lang, rc) ((b)->bft->execQuery((b), (ctx), (path), (query), (lang), (rc)))
#define CBAssociators(b, ctx, path, assocClass, resultClass, role, resultRole, properties, rc) \
  ((b)->bft->associators((b), (ctx), (path), (assocClass), (resultClass), (role), (resultRole), (properties), (rc)))
#define CBAssociatorNames(b, ctx, path, assocClass, resultClass, role, resultRole, rc) \
  ((b)->bft->associatorNames((b), (ctx), (path), (assocClass), (resultClass), (role), (resultRole), (rc)))
#define CBReferences(b, ctx, path, resultClass, role, properties, rc) \
  ((b)->bft->references((b), (ctx), (path), (resultClass), (role), (properties), (rc)))
#define CBReferenceNames(b, ctx, path, resultClass, role, rc) \
  ((b)->bft->referenceNames((b), (ctx), (path), (resultClass), (role), (rc)))
#define CBInvokeMethod(b, ctx, path, method, in, out, rc) \
  ((b)->bft->invokeMethod((b), (ctx), (path), (method), (in), (out), (rc)))
#define CBSetProperty(b, ctx, path, name, value, type) \
  ((b)->bft->setProperty((b), (ctx), (path), (name), (value), (type)))
#define CBGetProperty(b, ctx, path, name, rc) ((b)->bft->getProperty((b), (ctx), (path), (name), (rc)))

/* Any object */

#define CMClone(o, rc) ((o)->ft->clone((o), (rc)))
#define CMRelease(o) ((o)->ft->release((o)))
#define CMIsNullObject(o) ((o) == NULL || (o)->hdl == NULL)
#define CMIsNullValue(data) (((data).state & CMPI_nullValue) != 0)
#define CMIsKeyValue(data) (((data).state & CMPI_keyValue) != 0)
#define CMIsArray(data) (((data).type & CMPI_ARRAY) != 0)

/* Instance */

#define CMGetProperty(i, name, rc) ((i)->ft->getProperty((i), (name), (rc)))
#define CMGetPropertyAt(i, index, name, rc) ((i)->ft->getPropertyAt((i), (index), (name), (rc)))
#define CMSetProperty(i, name, value, type) ((i)->ft->setProperty((i), (name), (const CMPIValue*)(value), (type)))
#define CMGetPropertyCount(i, rc) ((i)->ft->getPropertyCount((i), (rc)))
#define CMGetObjectPath(i, rc) ((i)->ft->getObjectPath((i), (rc)))
#define CMSetObjectPath(i, path) ((i)->ft->setObjectPath((i), (path)))
#define CMSetPropertyFilter(i, properties, keys) ((i)->ft->setPropertyFilter((i), (properties), (keys)))
#define CMSetPropertyWithOrigin(i, name, value, type, origin) \
  ((i)->ft->setPropertyWithOrigin((i), (name), (const CMPIValue*)(value), (type), (origin)))

/* Object path */

#define CMSetHostname(p, host) ((p)->ft->setHostname((p), (host)))
#define CMGetHostname(p, rc) ((p)->ft->getHostname((p), (rc)))
#define CMSetNameSpace(p, ns) ((p)->ft->setNameSpace((p), (ns)))
#define CMGetNameSpace(p, rc) ((p)->ft->getNameSpace((p), (rc)))
#define CMSetClassName(p, className) ((p)->ft->setClassName((p), (className)))
#define CMGetClassName(p, rc) ((p)->ft->getClassName((p), (rc)))
#define CMAddKey(p, name, value, type) ((p)->ft->addKey((p), (name), (const CMPIValue*)(value), (type)))
#define CMGetKey(p, name, rc) ((p)->ft->getKey((p), (name), (rc)))
#define CMGetKeyAt(p, index, name, rc) ((p)->ft->getKeyAt((p), (index), (name), (rc)))
#define CMGetKeyCount(p, rc) ((p)->ft->getKeyCount((p), (rc)))
#define CMSetNameSpaceFromObjectPath(p, source) ((p)->ft->setNameSpaceFromObjectPath((p), (source)))
#define CMSetHostAndNameSpaceFromObjectPath(p, source) ((p)->ft->setHostAndNameSpaceFromObjectPath((p), (source)))
#define CMGetClassQualifier(p, qualifier, rc) ((p)->ft->getClassQualifier((p), (qualifier), (rc)))
#define CMGetPropertyQualifier(p, property, qualifier, rc) \
  ((p)->ft->getPropertyQualifier((p), (property), (qualifier), (rc)))
#define CMGetMethodQualifier(p, method, qualifier, rc) ((p)->ft->getMethodQualifier((p), (method), (qualifier), (rc)))
#define CMGetParameterQualifier(p, method, parameter, qualifier, rc) \
  ((p)->ft->getParameterQualifier((p), (method), (parameter), (qualifier), (rc)))
#define CMObjectPathToString(p, rc) ((p)->ft->toString((p), (rc)))

/* String */

#define CMGetCharsPtr(s, rc) ((s)->ft->getCharPtr((s), (rc)))
/* Works only where the object manager keeps the C string in the handle: prefer CMGetCharsPtr. */
#define CMGetCharPtr(s) ((char*)(s)->hdl)

/* Array, enumeration, arguments, context, date-time */

#define CMGetArrayCount(a, rc) ((a)->ft->getSize((a), (rc)))
#define CMGetArrayType(a, rc) ((a)->ft->getSimpleType((a), (rc)))
#define CMGetArrayElementAt(a, index, rc) ((a)->ft->getElementAt((a), (index), (rc)))
#define CMSetArrayElementAt(a, index, value, type) \
  ((a)->ft->setElementAt((a), (index), (const CMPIValue*)(value), (type)))
#define CMGetNext(e, rc) ((e)->ft->getNext((e), (rc)))
#define CMHasNext(e, rc) ((e)->ft->hasNext((e), (rc)))
#define CMToArray(e, rc) ((e)->ft->toArray((e), (rc)))
#define CMAddArg(a, name, value, type) ((a)->ft->addArg((a), (name), (const CMPIValue*)(value), (type)))
#define CMGetArg(a, name, rc) ((a)->ft->getArg((a), (name), (rc)))
#define CMGetArgAt(a, index, name, rc) ((a)->ft->getArgAt((a), (index), (name), (rc)))
#define CMGetArgCount(a, rc) ((a)->ft->getArgCount((a), (rc)))
#define CMGetContextEntry(c, name, rc) ((c)->ft->getEntry((c), (name), (rc)))
#define CMGetContextEntryAt(c, index, name, rc) ((c)->ft->getEntryAt((c), (index), (name), (rc)))
#define CMGetContextEntryCount(c, rc) ((c)->ft->getEntryCount((c), (rc)))
#define CMAddContextEntry(c, name, value, type) ((c)->ft->addEntry((c), (name), (const CMPIValue*)(value), (type)))
#define CMGetStringFormat(d, rc) ((d)->ft->getStringFormat((d), (rc)))
#define CMGetBinaryFormat(d, rc) ((d)->ft->getBinaryFormat((d), (rc)))
#define CMIsInterval(d, rc) ((d)->ft->isInterval((d), (rc)))

/* Result */

#define CMReturnData(r, value, type) ((r)->ft->returnData((r), (const CMPIValue*)(value), (type)))
#define CMReturnInstance(r, inst) ((r)->ft->returnInstance((r), (inst)))
#define CMReturnObjectPath(r, path) ((r)->ft->returnObjectPath((r), (path)))
#define CMReturnDone(r) ((r)->ft->returnDone((r)))
#define CMReturnError(r, error) ((r)->ft->returnError((r), (error)))

/* Error: what it says, and what a provider adds to it */

#define CMGetErrorType(e, rc) ((e)->ft->getErrorType((e), (rc)))
#define CMGetOtherErrorType(e, rc) ((e)->ft->getOtherErrorType((e), (rc)))
#define CMGetOwningEntity(e, rc) ((e)->ft->getOwningEntity((e), (rc)))
#define CMGetMessageID(e, rc) ((e)->ft->getMessageID((e), (rc)))
#define CMGetErrorMessage(e, rc) ((e)->ft->getMessage((e), (rc)))
#define CMGetPerceivedSeverity(e, rc) ((e)->ft->getPerceivedSeverity((e), (rc)))
#define CMGetProbableCause(e, rc) ((e)->ft->getProbableCause((e), (rc)))
#define CMGetProbableCauseDescription(e, rc) ((e)->ft->getProbableCauseDescription((e), (rc)))
#define CMGetRecommendedActions(e, rc) ((e)->ft->getRecommendedActions((e), (rc)))
#define CMGetErrorSource(e, rc) ((e)->ft->getErrorSource((e), (rc)))
#define CMGetErrorSourceFormat(e, rc) ((e)->ft->getErrorSourceFormat((e), (rc)))
#define CMGetOtherErrorSourceFormat(e, rc) ((e)->ft->getOtherErrorSourceFormat((e), (rc)))
#define CMGetCIMStatusCode(e, rc) ((e)->ft->getCIMStatusCode((e), (rc)))
#define CMGetCIMStatusCodeDescription(e, rc) ((e)->ft->getCIMStatusCodeDescription((e), (rc)))
#define CMGetMessageArguments(e, rc) ((e)->ft->getMessageArguments((e), (rc)))
#define CMSetErrorType(e, type) ((e)->ft->setErrorType((e), (type)))
#define CMSetOtherErrorType(e, text) ((e)->ft->setOtherErrorType((e), (text)))
#define CMSetProbableCauseDescription(e, text) ((e)->ft->setProbableCauseDescription((e), (text)))
#define CMSetRecommendedActions(e, array) ((e)->ft->setRecommendedActions((e), (array)))
#define CMSetErrorSource(e, text) ((e)->ft->setErrorSource((e), (text)))
#define CMSetErrorSourceFormat(e, format) ((e)->ft->setErrorSourceFormat((e), (format)))
#define CMSetOtherErrorSourceFormat(e, text) ((e)->ft->setOtherErrorSourceFormat((e), (text)))
#define CMSetCIMStatusCodeDescription(e, text) ((e)->ft->setCIMStatusCodeDescription((e), (text)))
#define CMSetMessageArguments(e, array) ((e)->ft->setMessageArguments((e), (array)))

/* Select expression, its normal forms (disjunctive and conjunctive), their terms and the comparisons in those */

#define CMEvaluateSelExp(s, inst, rc) ((s)->ft->evaluate((s), (inst), (rc)))
#define CMEvaluateSelExpUsingAccessor(s, accessor, parameter, rc) \
  ((s)->ft->evaluateUsingAccessor((s), (accessor), (parameter), (rc)))
#define CMGetSelExpString(s, rc) ((s)->ft->getString((s), (rc)))
#define CMGetDoc(s, rc) ((s)->ft->getDOC((s), (rc)))
#define CMGetCod(s, rc) ((s)->ft->getCOD((s), (rc)))
#define CMGetSubCondCountAndType(c, type, rc) ((c)->ft->getCountAndType((c), (type), (rc)))
#define CMGetSubCondAt(c, index, rc) ((c)->ft->getSubCondAt((c), (index), (rc)))
#define CMGetPredicateCount(s, rc) ((s)->ft->getCount((s), (rc)))
#define CMGetPredicateAt(s, index, rc) ((s)->ft->getPredicateAt((s), (index), (rc)))
#define CMGetPredicate(s, name, rc) ((s)->ft->getPredicate((s), (name), (rc)))
#define CMGetPredicateData(p, type, operation, left, right) \
  ((p)->ft->getData((p), (type), (operation), (left), (right)))
#define CMEvaluatePredicateUsingAccessor(p, accessor, parameter, rc) \
  ((p)->ft->evaluateUsingAccessor((p), (accessor), (parameter), (rc)))

/* Statuses */

/* Returns a status with a null message from the function. */
#define CMReturn(code)                       \
  do {                                       \
    CMPIStatus cmpiStatus_ = {(code), NULL}; \
    return cmpiStatus_;                      \
  } while (0)

#define CMReturnWithString(code, string)         \
  do {                                           \
    CMPIStatus cmpiStatus_ = {(code), (string)}; \
    return cmpiStatus_;                          \
  } while (0)

#define CMReturnWithChars(b, code, chars)                      \
  do {                                                         \
    CMPIStatus cmpiStatus_ = {(code), NULL};                   \
    cmpiStatus_.msg = (b)->eft->newString((b), (chars), NULL); \
    return cmpiStatus_;                                        \
  } while (0)

#define CMSetStatus(st, code) \
  do {                        \
    (st)->rc = (code);        \
    (st)->msg = NULL;         \
  } while (0)

#define CMSetStatusWithString(st, code, string) \
  do {                                          \
    (st)->rc = (code);                          \
    (st)->msg = (string);                       \
  } while (0)

#define CMSetStatusWithChars(b, st, code, chars)         \
  do {                                                   \
    (st)->rc = (code);                                   \
    (st)->msg = (b)->eft->newString((b), (chars), NULL); \
  } while (0)

/*
 * MI stubs. Each defines the provider's static function table, its slots filled with prefix + operation, and the
 * exported factory <provider>_Create_<kind>MI, which stores the broker, runs the hook and returns its static MI.
 */

#define CMNoHook

/* What the factories have in common: KIND is Instance, Association, Method, Property or Indication. */
#define CMPI_MI_FACTORY_(kind, provider, table, brokerVariable, hook)                                        \
  CMPI_EXTERN_C CMPI##kind##MI* provider##_Create_##kind##MI(const CMPIBroker* brkr, const CMPIContext* ctx, \
                                                             CMPIStatus* rc) {                               \
    static CMPI##kind##MI mi = {NULL, &table};                                                               \
    (void)ctx;                                                                                               \
    (void)rc;                                                                                                \
    brokerVariable = brkr;                                                                                   \
    hook;                                                                                                    \
    return &mi;                                                                                              \
  }

#define CMInstanceMIStub(prefix, provider, brokerVariable, hook)                                       \
  static CMPIInstanceMIFT instMIFT__ = {                                                               \
      CMPICurrentVersion,        CMPICurrentVersion,     "instance" #provider, prefix##Cleanup,        \
      prefix##EnumInstanceNames, prefix##EnumInstances,  prefix##GetInstance,  prefix##CreateInstance, \
      prefix##ModifyInstance,    prefix##DeleteInstance, prefix##ExecQuery,                            \
  };                                                                                                   \
  CMPI_MI_FACTORY_(Instance, provider, instMIFT__, brokerVariable, hook)

#define CMAssociationMIStub(prefix, provider, brokerVariable, hook)                                      \
  static CMPIAssociationMIFT assocMIFT__ = {                                                             \
      CMPICurrentVersion,  CMPICurrentVersion,      "association" #provider, prefix##AssociationCleanup, \
      prefix##Associators, prefix##AssociatorNames, prefix##References,      prefix##ReferenceNames,     \
  };                                                                                                     \
  CMPI_MI_FACTORY_(Association, provider, assocMIFT__, brokerVariable, hook)

#define CMMethodMIStub(prefix, provider, brokerVariable, hook)                                                 \
  static CMPIMethodMIFT methMIFT__ = {                                                                         \
      CMPICurrentVersion, CMPICurrentVersion, "method" #provider, prefix##MethodCleanup, prefix##InvokeMethod, \
  };                                                                                                           \
  CMPI_MI_FACTORY_(Method, provider, methMIFT__, brokerVariable, hook)

/* The slot for a property with its origin stays empty. */
#define CMPropertyMIStub(prefix, provider, brokerVariable, hook) \
  static CMPIPropertyMIFT propMIFT__ = {                         \
      CMPICurrentVersion,                                        \
      CMPICurrentVersion,                                        \
      "property" #provider,                                      \
      prefix##PropertyCleanup,                                   \
      prefix##SetProperty,                                       \
      prefix##GetProperty,                                       \
      NULL,                                                      \
  };                                                             \
  CMPI_MI_FACTORY_(Property, provider, propMIFT__, brokerVariable, hook)

#define CMIndicationMIStub(prefix, provider, brokerVariable, hook)                                              \
  static CMPIIndicationMIFT indMIFT__ = {                                                                       \
      CMPICurrentVersion,        CMPICurrentVersion,         "indication" #provider, prefix##IndicationCleanup, \
      prefix##AuthorizeFilter,   prefix##MustPoll,           prefix##ActivateFilter, prefix##DeActivateFilter,  \
      prefix##EnableIndications, prefix##DisableIndications,                                                    \
  };                                                                                                            \
  CMPI_MI_FACTORY_(Indication, provider, indMIFT__, brokerVariable, hook)

#endif /* CMPIMACS_H_ */
