/* CMPI convenience macros: thin spellings of function-table calls, plus the
 * stub macros that define a provider's MI tables and factory entries. */
#ifndef _CMPIMACS_H_
#define _CMPIMACS_H_

#include "cmpift.h"

/* Status and return helpers.  The CMSetStatus* forms don't check for NULL:
 * callers that may get rc == NULL must test it first. */
#define CMReturn(rc_)                                                                              \
  do { CMPIStatus stat_; stat_.rc = (CMPIrc)(rc_); stat_.msg = NULL; return stat_; } while (0)
#define CMReturnWithString(rc_, str)                                                               \
  do { CMPIStatus stat_; stat_.rc = (CMPIrc)(rc_); stat_.msg = (str); return stat_; } while (0)
#define CMReturnWithChars(mb, rc_, chars)                                                          \
  do {                                                                                             \
    CMPIStatus stat_;                                                                              \
    stat_.rc = (CMPIrc)(rc_);                                                                      \
    stat_.msg = (mb)->eft->newString((mb), (chars), NULL);                                         \
    return stat_;                                                                                  \
  } while (0)
#define CMSetStatus(st, rcp)                                                                       \
  do { (st)->rc = (CMPIrc)(rcp); (st)->msg = NULL; } while (0)
#define CMSetStatusWithString(st, rcp, string)                                                     \
  do { (st)->rc = (CMPIrc)(rcp); (st)->msg = (string); } while (0)
#define CMSetStatusWithChars(mb, st, rcp, chars)                                                   \
  do {                                                                                             \
    (st)->rc = (CMPIrc)(rcp);                                                                      \
    (st)->msg = (mb)->eft->newString((mb), (chars), NULL);                                         \
  } while (0)

/* Tests; the CMPIData argument must be a plain lvalue. */
#define CMIsNullObject(obj) ((obj) == NULL || *((void**)(obj)) == NULL)
#define CMIsNullValue(val) ((val.state) & CMPI_nullValue)
#define CMIsKeyValue(val) ((val.state) & CMPI_keyValue)
#define CMIsArray(val) ((val.type) & CMPI_ARRAY)

/* Any encapsulated object */
#define CMClone(obj, rc) ((obj)->ft->clone((obj), (rc)))
#define CMRelease(obj) ((obj)->ft->release((obj)))

/* Factories */
#define CMNewInstance(mb, op, rc) ((mb)->eft->newInstance((mb), (op), (rc)))
#define CMNewObjectPath(mb, ns, cn, rc) ((mb)->eft->newObjectPath((mb), (ns), (cn), (rc)))
#define CMNewString(mb, data, rc) ((mb)->eft->newString((mb), (data), (rc)))
#define CMNewArgs(mb, rc) ((mb)->eft->newArgs((mb), (rc)))
#define CMNewArray(mb, max, type, rc) ((mb)->eft->newArray((mb), (max), (type), (rc)))
#define CMNewDateTime(mb, rc) ((mb)->eft->newDateTime((mb), (rc)))
#define CMNewDateTimeFromBinary(mb, binTime, interval, rc)                                         \
  ((mb)->eft->newDateTimeFromBinary((mb), (binTime), (interval), (rc)))
#define CMNewDateTimeFromChars(mb, utcTime, rc)                                                    \
  ((mb)->eft->newDateTimeFromChars((mb), (utcTime), (rc)))
#define CMNewSelectExp(mb, query, lang, projection, st)                                            \
  ((mb)->eft->newSelectExp((mb), (query), (lang), (projection), (st)))
#define CMClassPathIsA(mb, op, type, rc) ((mb)->eft->classPathIsA((mb), (op), (type), (rc)))

/* Debugging helpers */
#define CDToString(mb, object, rc) ((mb)->eft->toString((mb), (void*)(object), (rc)))
#define CDIsOfType(mb, object, type, rc) ((mb)->eft->isOfType((mb), (void*)(object), (type), (rc)))
#define CDGetType(mb, object, rc) ((mb)->eft->getType((mb), (void*)(object), (rc)))

/* Messages, logging and tracing.  getMessage takes a count and then
 * (type, value) pairs; prefer the 64-bit and chars forms, whose sizes match
 * what the broker reads. */
#define CMFmtSint(v) CMPI_sint32, ((long int)(v))
#define CMFmtUint(v) CMPI_uint32, ((unsigned long int)(v))
#define CMFmtSint64(v) CMPI_sint64, ((long long int)(v))
#define CMFmtUint64(v) CMPI_uint64, ((unsigned long long int)(v))
#define CMFmtReal(v) CMPI_real64, ((double)(v))
#define CMFmtBoolean(v) CMPI_boolean, ((int)(v))
#define CMFmtChars(v) CMPI_chars, ((char*)(v))
#define CMFmtString(v) CMPI_string, ((CMPIString*)(v))
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
#define CMFmtArgs10(v1, v2, v3, v4, v5, v6, v7, v8, v9, v10)                                       \
  10, v1, v2, v3, v4, v5, v6, v7, v8, v9, v10
#define CMGetMessage(mb, msgId, defMsg, rc, fmtArgs)                                               \
  ((mb)->eft->getMessage((mb), (msgId), (defMsg), (rc), fmtArgs))
#define CMLogMessage(mb, severity, id, text, string)                                               \
  ((mb)->eft->logMessage((mb), (severity), (id), (text), (string)))
#define CMTraceMessage(mb, level, component, text, string)                                         \
  ((mb)->eft->trace((mb), (level), (component), (text), (string)))

/* Instance */
#define CMGetProperty(inst, name, rc) ((inst)->ft->getProperty((inst), (name), (rc)))
#define CMGetPropertyAt(inst, index, name, rc)                                                     \
  ((inst)->ft->getPropertyAt((inst), (index), (name), (rc)))
#define CMSetProperty(inst, name, value, type)                                                     \
  ((inst)->ft->setProperty((inst), (name), (CMPIValue*)(value), (type)))
#define CMGetPropertyCount(inst, rc) ((inst)->ft->getPropertyCount((inst), (rc)))
#define CMGetObjectPath(inst, rc) ((inst)->ft->getObjectPath((inst), (rc)))
#define CMSetObjectPath(inst, op) ((inst)->ft->setObjectPath((inst), (op)))
#define CMSetPropertyFilter(inst, propertyList, keys)                                              \
  ((inst)->ft->setPropertyFilter((inst), (propertyList), (keys)))

/* Object path */
#define CMSetHostname(op, hn) ((op)->ft->setHostname((op), (hn)))
#define CMGetHostname(op, rc) ((op)->ft->getHostname((op), (rc)))
#define CMSetNameSpace(op, ns) ((op)->ft->setNameSpace((op), (ns)))
#define CMGetNameSpace(op, rc) ((op)->ft->getNameSpace((op), (rc)))
#define CMSetClassName(op, cn) ((op)->ft->setClassName((op), (cn)))
#define CMGetClassName(op, rc) ((op)->ft->getClassName((op), (rc)))
#define CMAddKey(op, name, value, type)                                                            \
  ((op)->ft->addKey((op), (name), (CMPIValue*)(value), (type)))
#define CMGetKey(op, name, rc) ((op)->ft->getKey((op), (name), (rc)))
#define CMGetKeyAt(op, index, name, rc) ((op)->ft->getKeyAt((op), (index), (name), (rc)))
#define CMGetKeyCount(op, rc) ((op)->ft->getKeyCount((op), (rc)))
#define CMSetNameSpaceFromObjectPath(op, src) ((op)->ft->setNameSpaceFromObjectPath((op), (src)))
#define CMSetHostAndNameSpaceFromObjectPath(op, src)                                               \
  ((op)->ft->setHostAndNameSpaceFromObjectPath((op), (src)))
#define CMGetClassQualifier(op, qName, rc) ((op)->ft->getClassQualifier((op), (qName), (rc)))
#define CMGetPropertyQualifier(op, pName, qName, rc)                                               \
  ((op)->ft->getPropertyQualifier((op), (pName), (qName), (rc)))
#define CMGetMethodQualifier(op, methodName, qName, rc)                                            \
  ((op)->ft->getMethodQualifier((op), (methodName), (qName), (rc)))
#define CMGetParameterQualifier(op, mName, pName, qName, rc)                                       \
  ((op)->ft->getParameterQualifier((op), (mName), (pName), (qName), (rc)))
#define CMObjectPathToString(op, rc) ((op)->ft->toString((op), (rc)))

/* Array, args, string, datetime */
#define CMGetArrayCount(ar, rc) ((ar)->ft->getSize((ar), (rc)))
#define CMGetArrayType(ar, rc) ((ar)->ft->getSimpleType((ar), (rc)))
#define CMGetArrayElementAt(ar, index, rc) ((ar)->ft->getElementAt((ar), (index), (rc)))
#define CMSetArrayElementAt(ar, index, value, type)                                                \
  ((ar)->ft->setElementAt((ar), (index), (CMPIValue*)(value), (type)))
#define CMAddArg(as, name, value, type)                                                            \
  ((as)->ft->addArg((as), (name), (CMPIValue*)(value), (type)))
#define CMGetArg(as, name, rc) ((as)->ft->getArg((as), (name), (rc)))
#define CMGetArgAt(as, index, name, rc) ((as)->ft->getArgAt((as), (index), (name), (rc)))
#define CMGetArgCount(as, rc) ((as)->ft->getArgCount((as), (rc)))
/* Reads the handle directly, which only works where the broker keeps the
 * char* there; CMGetCharsPtr is the portable form. */
#define CMGetCharPtr(str) ((char*)(str)->hdl)
#define CMGetCharsPtr(str, rc) ((str)->ft->getCharPtr((str), (rc)))
#define CMGetStringFormat(dt, rc) ((dt)->ft->getStringFormat((dt), (rc)))
#define CMGetBinaryFormat(dt, rc) ((dt)->ft->getBinaryFormat((dt), (rc)))
#define CMIsInterval(dt, rc) ((dt)->ft->isInterval((dt), (rc)))

/* Enumeration, result, context */
#define CMGetNext(en, rc) ((en)->ft->getNext((en), (rc)))
#define CMHasNext(en, rc) ((en)->ft->hasNext((en), (rc)))
#define CMToArray(en, rc) ((en)->ft->toArray((en), (rc)))
#define CMReturnData(rslt, value, type)                                                            \
  ((rslt)->ft->returnData((rslt), (CMPIValue*)(value), (type)))
#define CMReturnInstance(rslt, inst) ((rslt)->ft->returnInstance((rslt), (inst)))
#define CMReturnObjectPath(rslt, ref) ((rslt)->ft->returnObjectPath((rslt), (ref)))
#define CMReturnDone(rslt) ((rslt)->ft->returnDone((rslt)))
#define CMGetContextEntry(ctx, name, rc) ((ctx)->ft->getEntry((ctx), (name), (rc)))
#define CMGetContextEntryAt(ctx, index, name, rc)                                                  \
  ((ctx)->ft->getEntryAt((ctx), (index), (name), (rc)))
#define CMGetContextEntryCount(ctx, rc) ((ctx)->ft->getEntryCount((ctx), (rc)))
#define CMAddContextEntry(ctx, name, value, type)                                                  \
  ((ctx)->ft->addEntry((ctx), (name), (CMPIValue*)(value), (type)))

/* Select expressions */
#define CMGetSelExpString(se, rc) ((se)->ft->getString((se), (rc)))
#define CMEvaluateSelExp(se, inst, rc) ((se)->ft->evaluate((se), (inst), (rc)))
#define CMEvaluateSelExpUsingAccessor(se, accessor, parm, rc)                                      \
  ((se)->ft->evaluateUsingAccessor((se), (accessor), (parm), (rc)))
#define CMGetDoc(se, rc) ((se)->ft->getDOC((se), (rc)))
#define CMGetCod(se, rc) ((se)->ft->getCOD((se), (rc)))
#define CMGetSubCondCountAndType(cond, type, rc)                                                   \
  ((cond)->ft->getCountAndType((cond), (type), (rc)))
#define CMGetSubCondAt(cond, index, rc) ((cond)->ft->getSubCondAt((cond), (index), (rc)))
#define CMGetPredicateCount(sc, rc) ((sc)->ft->getCount((sc), (rc)))
#define CMGetPredicateAt(sc, index, rc) ((sc)->ft->getPredicateAt((sc), (index), (rc)))
#define CMGetPredicate(sc, name, rc) ((sc)->ft->getPredicate((sc), (name), (rc)))
#define CMGetPredicateData(pr, type, op, lhs, rhs)                                                 \
  ((pr)->ft->getData((pr), (type), (op), (lhs), (rhs)))
#define CMEvaluatePredicateUsingAccessor(pr, accessorFnc, parm, rc)                                \
  ((pr)->ft->evaluateUsingAccessor((pr), (accessorFnc), (parm), (rc)))

/* Broker up-calls */
#define CBGetClassification(mb) ((mb)->bft->brokerCapabilities)
#define CBBrokerVersion(mb) ((mb)->bft->brokerVersion)
#define CBBrokerName(mb) ((mb)->bft->brokerName)
#define CBPrepareAttachThread(mb, ctx) ((mb)->bft->prepareAttachThread((mb), (ctx)))
#define CBAttachThread(mb, ctx) ((mb)->bft->attachThread((mb), (ctx)))
#define CBDetachThread(mb, ctx) ((mb)->bft->detachThread((mb), (ctx)))
#define CBDeliverIndication(mb, ctx, ns, ind) \
  ((mb)->bft->deliverIndication((mb), (ctx), (ns), (ind)))
#define CBEnumInstanceNames(mb, ctx, op, rc) \
  ((mb)->bft->enumerateInstanceNames((mb), (ctx), (op), (rc)))
#define CBEnumInstances(mb, ctx, op, properties, rc) \
  ((mb)->bft->enumerateInstances((mb), (ctx), (op), (properties), (rc)))
#define CBGetInstance(mb, ctx, op, properties, rc) \
  ((mb)->bft->getInstance((mb), (ctx), (op), (properties), (rc)))
#define CBCreateInstance(mb, ctx, op, inst, rc) \
  ((mb)->bft->createInstance((mb), (ctx), (op), (inst), (rc)))
#define CBModifyInstance(mb, ctx, op, inst, properties) \
  ((mb)->bft->modifyInstance((mb), (ctx), (op), (inst), (properties)))
/* The old name of the same slot. */
#define CBSetInstance(mb, ctx, op, inst) \
  ((mb)->bft->modifyInstance((mb), (ctx), (op), (inst), NULL))
#define CBDeleteInstance(mb, ctx, op) ((mb)->bft->deleteInstance((mb), (ctx), (op)))
#define CBExecQuery(mb, ctx, op, query, lang, rc) \
  ((mb)->bft->execQuery((mb), (ctx), (op), (query), (lang), (rc)))
#define CBAssociators(mb, ctx, op, assocClass, resultClass, role, resultRole, properties, rc) \
  ((mb)->bft->associators((mb), (ctx), (op), (assocClass), (resultClass), (role),                  \
                          (resultRole), (properties), (rc)))
#define CBAssociatorNames(mb, ctx, op, assocClass, resultClass, role, resultRole, rc) \
  ((mb)->bft->associatorNames((mb), (ctx), (op), (assocClass), (resultClass), (role),              \
                              (resultRole), (rc)))
#define CBReferences(mb, ctx, op, resultClass, role, properties, rc) \
  ((mb)->bft->references((mb), (ctx), (op), (resultClass), (role), (properties), (rc)))
#define CBReferenceNames(mb, ctx, op, resultClass, role, rc) \
  ((mb)->bft->referenceNames((mb), (ctx), (op), (resultClass), (role), (rc)))
#define CBInvokeMethod(mb, ctx, op, method, in, out, rc) \
  ((mb)->bft->invokeMethod((mb), (ctx), (op), (method), (in), (out), (rc)))
#define CBSetProperty(mb, ctx, op, name, value, type) \
  ((mb)->bft->setProperty((mb), (ctx), (op), (name), (CMPIValue*)(value), (type)))
#define CBGetProperty(mb, ctx, op, name, rc) \
  ((mb)->bft->getProperty((mb), (ctx), (op), (name), (rc)))

/* MI stubs.  Each defines the provider's static table and its exported
 * <pn>_Create_<Type>MI; `broker` names the provider's own broker variable and
 * `hook` is one statement run before the factory returns. */
#define CMNoHook
#define CMInstanceMIStubChange(pfx) pfx##ModifyInstance
#define CMIndicationMIStubExtensions(pfx) pfx##EnableIndications, pfx##DisableIndications,

#define CMInstanceMIStub(pfx, pn, broker, hook)                                                    \
  static CMPIInstanceMIFT pn##_instMIFT__ = {                                                      \
      CMPICurrentVersion, CMPICurrentVersion, "instance" #pn, pfx##Cleanup,                        \
      pfx##EnumInstanceNames, pfx##EnumInstances, pfx##GetInstance, pfx##CreateInstance,           \
      CMInstanceMIStubChange(pfx), pfx##DeleteInstance, pfx##ExecQuery};                           \
  CMPI_EXTERN_C CMPIInstanceMI* pn##_Create_InstanceMI(const CMPIBroker* brkr,                     \
                                                       const CMPIContext* ctx,                     \
                                                       CMPIStatus* rc) {                           \
    static CMPIInstanceMI mi = {NULL, &pn##_instMIFT__};                                           \
    (void)ctx;                                                                                     \
    if (rc) { rc->rc = CMPI_RC_OK; rc->msg = NULL; }                                               \
    broker = brkr;                                                                                 \
    hook;                                                                                          \
    return &mi;                                                                                    \
  }

#define CMAssociationMIStub(pfx, pn, broker, hook)                                                 \
  static CMPIAssociationMIFT pn##_assocMIFT__ = {                                                  \
      CMPICurrentVersion, CMPICurrentVersion, "association" #pn, pfx##AssociationCleanup,          \
      pfx##Associators, pfx##AssociatorNames, pfx##References, pfx##ReferenceNames};               \
  CMPI_EXTERN_C CMPIAssociationMI* pn##_Create_AssociationMI(const CMPIBroker* brkr,               \
                                                             const CMPIContext* ctx,               \
                                                             CMPIStatus* rc) {                     \
    static CMPIAssociationMI mi = {NULL, &pn##_assocMIFT__};                                       \
    (void)ctx;                                                                                     \
    if (rc) { rc->rc = CMPI_RC_OK; rc->msg = NULL; }                                               \
    broker = brkr;                                                                                 \
    hook;                                                                                          \
    return &mi;                                                                                    \
  }

#define CMMethodMIStub(pfx, pn, broker, hook)                                                      \
  static CMPIMethodMIFT pn##_methMIFT__ = {CMPICurrentVersion, CMPICurrentVersion,                 \
                                      "method" #pn, pfx##MethodCleanup,                            \
                                      pfx##InvokeMethod};                                          \
  CMPI_EXTERN_C CMPIMethodMI* pn##_Create_MethodMI(const CMPIBroker* brkr,                         \
                                                   const CMPIContext* ctx,                         \
                                                   CMPIStatus* rc) {                               \
    static CMPIMethodMI mi = {NULL, &pn##_methMIFT__};                                             \
    (void)ctx;                                                                                     \
    if (rc) { rc->rc = CMPI_RC_OK; rc->msg = NULL; }                                               \
    broker = brkr;                                                                                 \
    hook;                                                                                          \
    return &mi;                                                                                    \
  }

#define CMPropertyMIStub(pfx, pn, broker, hook)                                                    \
  static CMPIPropertyMIFT pn##_propMIFT__ = {CMPICurrentVersion, CMPICurrentVersion,               \
                                        "property" #pn, pfx##PropertyCleanup,                      \
                                        pfx##SetProperty, pfx##GetProperty};                       \
  CMPI_EXTERN_C CMPIPropertyMI* pn##_Create_PropertyMI(const CMPIBroker* brkr,                     \
                                                       const CMPIContext* ctx,                     \
                                                       CMPIStatus* rc) {                           \
    static CMPIPropertyMI mi = {NULL, &pn##_propMIFT__};                                           \
    (void)ctx;                                                                                     \
    if (rc) { rc->rc = CMPI_RC_OK; rc->msg = NULL; }                                               \
    broker = brkr;                                                                                 \
    hook;                                                                                          \
    return &mi;                                                                                    \
  }

#define CMIndicationMIStub(pfx, pn, broker, hook)                                                  \
  static CMPIIndicationMIFT pn##_indMIFT__ = {                                                     \
      CMPICurrentVersion, CMPICurrentVersion, "Indication" #pn, pfx##IndicationCleanup,            \
      pfx##AuthorizeFilter, pfx##MustPoll, pfx##ActivateFilter, pfx##DeActivateFilter,             \
      CMIndicationMIStubExtensions(pfx)};                                                          \
  CMPI_EXTERN_C CMPIIndicationMI* pn##_Create_IndicationMI(const CMPIBroker* brkr,                 \
                                                           const CMPIContext* ctx,                 \
                                                           CMPIStatus* rc) {                       \
    static CMPIIndicationMI mi = {NULL, &pn##_indMIFT__};                                          \
    (void)ctx;                                                                                     \
    if (rc) { rc->rc = CMPI_RC_OK; rc->msg = NULL; }                                               \
    broker = brkr;                                                                                 \
    hook;                                                                                          \
    return &mi;                                                                                    \
  }

#endif
