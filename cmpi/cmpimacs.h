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
#define CMLogMessage(b, severity, id, text, string) ((b)->eft->logMessage((b), (severity), (id), (text), (string)))
#define CMTraceMessage(b, level, component, text, string) ((b)->eft->trace((b), (level), (component), (text), (string)))

/* The broker's up-call table */

#define CBBrokerVersion(b) ((b)->bft->brokerVersion)
#define CBBrokerName(b) ((b)->bft->brokerName)
#define CBBrokerCapabilities(b) ((b)->bft->brokerCapabilities)
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

#define CMInstanceMIStub(prefix, provider, brokerVariable, hook)                                             \
  static CMPIInstanceMIFT instMIFT__ = {                                                                     \
      CMPICurrentVersion,        CMPICurrentVersion,     "instance" #provider, prefix##Cleanup,              \
      prefix##EnumInstanceNames, prefix##EnumInstances,  prefix##GetInstance,  prefix##CreateInstance,       \
      prefix##ModifyInstance,    prefix##DeleteInstance, prefix##ExecQuery,                                  \
  };                                                                                                         \
  CMPI_EXTERN_C CMPIInstanceMI* provider##_Create_InstanceMI(const CMPIBroker* brkr, const CMPIContext* ctx, \
                                                             CMPIStatus* rc) {                               \
    static CMPIInstanceMI mi = {NULL, &instMIFT__};                                                          \
    (void)ctx;                                                                                               \
    (void)rc;                                                                                                \
    brokerVariable = brkr;                                                                                   \
    hook;                                                                                                    \
    return &mi;                                                                                              \
  }

#define CMAssociationMIStub(prefix, provider, brokerVariable, hook)                                                \
  static CMPIAssociationMIFT assocMIFT__ = {                                                                       \
      CMPICurrentVersion,  CMPICurrentVersion,      "association" #provider, prefix##AssociationCleanup,           \
      prefix##Associators, prefix##AssociatorNames, prefix##References,      prefix##ReferenceNames,               \
  };                                                                                                               \
  CMPI_EXTERN_C CMPIAssociationMI* provider##_Create_AssociationMI(const CMPIBroker* brkr, const CMPIContext* ctx, \
                                                                   CMPIStatus* rc) {                               \
    static CMPIAssociationMI mi = {NULL, &assocMIFT__};                                                            \
    (void)ctx;                                                                                                     \
    (void)rc;                                                                                                      \
    brokerVariable = brkr;                                                                                         \
    hook;                                                                                                          \
    return &mi;                                                                                                    \
  }

#endif /* CMPIMACS_H_ */
