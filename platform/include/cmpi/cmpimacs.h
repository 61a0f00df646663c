/* CMPI convenience macros: short names for slot calls, status helpers and provider stubs. */
#ifndef _CMPIMACS_H_
#define _CMPIMACS_H_

#include "cmpidt.h"
#include "cmpift.h"

/* Return a status from the enclosing function. */
#define CMReturn(rc_)                                                                                                  \
    do {                                                                                                               \
        CMPIStatus stat;                                                                                               \
        stat.rc = (rc_);                                                                                               \
        stat.msg = NULL;                                                                                               \
        return stat;                                                                                                   \
    } while (0)
#define CMReturnWithString(rc_, str)                                                                                   \
    do {                                                                                                               \
        CMPIStatus stat;                                                                                               \
        stat.rc = (rc_);                                                                                               \
        stat.msg = (str);                                                                                              \
        return stat;                                                                                                   \
    } while (0)
#define CMReturnWithChars(broker, rc_, chars)                                                                          \
    do {                                                                                                               \
        CMPIStatus stat;                                                                                               \
        stat.rc = (rc_);                                                                                               \
        stat.msg = (broker) ? (broker)->eft->newString((broker), (chars), NULL) : NULL;                                \
        return stat;                                                                                                   \
    } while (0)

/* Fill a status; a null status is left alone. */
#define CMSetStatus(st, rc_)                                                                                           \
    do {                                                                                                               \
        if (st) {                                                                                                      \
            (st)->rc = (rc_);                                                                                          \
            (st)->msg = NULL;                                                                                          \
        }                                                                                                              \
    } while (0)
#define CMSetStatusWithString(st, rc_, str)                                                                            \
    do {                                                                                                               \
        if (st) {                                                                                                      \
            (st)->rc = (rc_);                                                                                          \
            (st)->msg = (str);                                                                                         \
        }                                                                                                              \
    } while (0)
#define CMSetStatusWithChars(broker, st, rc_, chars)                                                                   \
    do {                                                                                                               \
        if (st) {                                                                                                      \
            (st)->rc = (rc_);                                                                                          \
            (st)->msg = (broker) ? (broker)->eft->newString((broker), (chars), NULL) : NULL;                           \
        }                                                                                                              \
    } while (0)

/* A null object is a null pointer or an object whose first word is null. */
#define CMIsNullObject(obj) ((obj) == NULL || *((void* const*)(obj)) == NULL)
#define CMIsNullValue(data) (((data).state & CMPI_nullValue) != 0)
#define CMIsKeyValue(data) (((data).state & CMPI_keyValue) != 0)
#define CMIsArray(data) (((data).type & CMPI_ARRAY) != 0)

#define CMClone(obj, rc) ((obj)->ft->clone((obj), (rc)))
#define CMRelease(obj) ((obj)->ft->release((obj)))
#define CMGetCharPtr(str) ((char*)(str)->ft->getCharPtr((str), NULL))
#define CMNoHook

#define CBBrokerVersion(broker) ((broker)->bft->brokerVersion)
#define CBBrokerName(broker) ((broker)->bft->brokerName)
#define CBGetCapabilities(broker) ((broker)->bft->brokerCapabilities)
#define CBGetBrokerCapabilities(broker) CBGetCapabilities(broker)
#define CBGetClassification(broker) CBGetCapabilities(broker)
#define CBSetInstance(broker, ctx, path, inst) CBModifyInstance(broker, ctx, path, inst, NULL)

/* Inserts for message templates: a type code and its value. */
#define CMFmtSint(v) CMPI_sint32, (long int)(v)
#define CMFmtUint(v) CMPI_uint32, (unsigned long int)(v)
#define CMFmtSint64(v) CMPI_sint64, (long long int)(v)
#define CMFmtUint64(v) CMPI_uint64, (unsigned long long int)(v)
#define CMFmtReal(v) CMPI_real64, (double)(v)
#define CMFmtBoolean(v) CMPI_boolean, (int)(v)
#define CMFmtChars(v) CMPI_chars, (char*)(v)
#define CMFmtString(v) CMPI_string, (CMPIString*)(v)

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

#define CBPrepareAttachThread(broker, ctx) ((broker)->bft->prepareAttachThread((broker), (ctx)))
#define CBAttachThread(broker, ctx) ((broker)->bft->attachThread((broker), (ctx)))
#define CBDetachThread(broker, ctx) ((broker)->bft->detachThread((broker), (ctx)))
#define CBDeliverIndication(broker, ctx, ns, inst) ((broker)->bft->deliverIndication((broker), (ctx), (ns), (inst)))
#define CBEnumInstanceNames(broker, ctx, path, rc)                                                                     \
    ((broker)->bft->enumerateInstanceNames((broker), (ctx), (path), (rc)))
#define CBEnumInstances(broker, ctx, path, propList, rc)                                                               \
    ((broker)->bft->enumerateInstances((broker), (ctx), (path), (propList), (rc)))
#define CBGetInstance(broker, ctx, path, propList, rc)                                                                 \
    ((broker)->bft->getInstance((broker), (ctx), (path), (propList), (rc)))
#define CBCreateInstance(broker, ctx, path, inst, rc)                                                                  \
    ((broker)->bft->createInstance((broker), (ctx), (path), (inst), (rc)))
#define CBModifyInstance(broker, ctx, path, inst, propList)                                                            \
    ((broker)->bft->modifyInstance((broker), (ctx), (path), (inst), (propList)))
#define CBDeleteInstance(broker, ctx, path) ((broker)->bft->deleteInstance((broker), (ctx), (path)))
#define CBExecQuery(broker, ctx, path, query, lang, rc)                                                                \
    ((broker)->bft->execQuery((broker), (ctx), (path), (query), (lang), (rc)))
#define CBAssociators(broker, ctx, path, assocClass, resultClass, role, resultRole, propList, rc)                      \
    ((broker)->bft->associators((broker), (ctx), (path), (assocClass), (resultClass), (role), (resultRole),            \
                                (propList), (rc)))
#define CBAssociatorNames(broker, ctx, path, assocClass, resultClass, role, resultRole, rc)                            \
    ((broker)->bft->associatorNames((broker), (ctx), (path), (assocClass), (resultClass), (role), (resultRole), (rc)))
#define CBReferences(broker, ctx, path, resultClass, role, propList, rc)                                               \
    ((broker)->bft->references((broker), (ctx), (path), (resultClass), (role), (propList), (rc)))
#define CBReferenceNames(broker, ctx, path, resultClass, role, rc)                                                     \
    ((broker)->bft->referenceNames((broker), (ctx), (path), (resultClass), (role), (rc)))
#define CBInvokeMethod(broker, ctx, path, method, in, out, rc)                                                         \
    ((broker)->bft->invokeMethod((broker), (ctx), (path), (method), (in), (out), (rc)))
#define CBSetProperty(broker, ctx, path, name, value, type)                                                            \
    ((broker)->bft->setProperty((broker), (ctx), (path), (name), (CMPIValue*)(value), (type)))
#define CBGetProperty(broker, ctx, path, name, rc) ((broker)->bft->getProperty((broker), (ctx), (path), (name), (rc)))

#define CMNewInstance(broker, path, rc) ((broker)->eft->newInstance((broker), (path), (rc)))
#define CMNewObjectPath(broker, ns, cls, rc) ((broker)->eft->newObjectPath((broker), (ns), (cls), (rc)))
#define CMNewArgs(broker, rc) ((broker)->eft->newArgs((broker), (rc)))
#define CMNewString(broker, text, rc) ((broker)->eft->newString((broker), (text), (rc)))
#define CMNewArray(broker, size, type, rc) ((broker)->eft->newArray((broker), (size), (type), (rc)))
#define CMNewDateTime(broker, rc) ((broker)->eft->newDateTime((broker), (rc)))
#define CMNewDateTimeFromBinary(broker, usec, isInterval, rc)                                                          \
    ((broker)->eft->newDateTimeFromBinary((broker), (usec), (isInterval), (rc)))
#define CMNewDateTimeFromChars(broker, text, rc) ((broker)->eft->newDateTimeFromChars((broker), (text), (rc)))
#define CMNewSelectExp(broker, query, lang, projectionOut, rc)                                                         \
    ((broker)->eft->newSelectExp((broker), (query), (lang), (projectionOut), (rc)))
#define CMClassPathIsA(broker, path, cls, rc) ((broker)->eft->classPathIsA((broker), (path), (cls), (rc)))
#define CDToString(broker, object, rc) ((broker)->eft->toString((broker), (void*)(object), (rc)))
#define CDIsOfType(broker, object, typeName, rc) ((broker)->eft->isOfType((broker), (void*)(object), (typeName), (rc)))
#define CDGetType(broker, object, rc) ((broker)->eft->getType((broker), (void*)(object), (rc)))
#define CMLogMessage(broker, severity, id, text, string)                                                               \
    ((broker)->eft->logMessage((broker), (severity), (id), (text), (string)))
#define CMTraceMessage(broker, level, component, text, string)                                                         \
    ((broker)->eft->trace((broker), (level), (component), (text), (string)))
#ifdef CMPI_VER_200
#define CMNewCMPIError(broker, owner, msgId, text, severity, cause, cimStatus, rc)                                     \
    ((broker)->eft->newCMPIError((broker), (owner), (msgId), (text), (severity), (cause), (cimStatus), (rc)))
#define CMOpenMessageFile(broker, file, handleOut) ((broker)->eft->openMessageFile((broker), (file), (handleOut)))
#define CMCloseMessageFile(broker, handle) ((broker)->eft->closeMessageFile((broker), (handle)))
#endif
#define CMGetMessage(broker, msgId, defaultText, rc, fmtArgs)                                                          \
    ((broker)->eft->getMessage((broker), (msgId), (defaultText), (rc), fmtArgs))
#ifdef CMPI_VER_200
#define CMGetMessage2(broker, msgId, handle, defaultText, rc, fmtArgs)                                                 \
    ((broker)->eft->getMessage2((broker), (msgId), (handle), (defaultText), (rc), fmtArgs))
#endif

#define CMGetProperty(inst, name, rc) ((inst)->ft->getProperty((inst), (name), (rc)))
#define CMGetPropertyAt(inst, index, nameOut, rc) ((inst)->ft->getPropertyAt((inst), (index), (nameOut), (rc)))
#define CMGetPropertyCount(inst, rc) ((inst)->ft->getPropertyCount((inst), (rc)))
#define CMSetProperty(inst, name, value, type) ((inst)->ft->setProperty((inst), (name), (CMPIValue*)(value), (type)))
#ifdef CMPI_VER_200
#define CMSetPropertyWithOrigin(inst, name, value, type, originClass)                                                  \
    ((inst)->ft->setPropertyWithOrigin((inst), (name), (CMPIValue*)(value), (type), (originClass)))
#endif
#define CMGetObjectPath(inst, rc) ((inst)->ft->getObjectPath((inst), (rc)))
#define CMSetObjectPath(inst, path) ((inst)->ft->setObjectPath((inst), (path)))
#define CMSetPropertyFilter(inst, propList, keyList) ((inst)->ft->setPropertyFilter((inst), (propList), (keyList)))
#define CMSetHostname(path, host) ((path)->ft->setHostname((path), (host)))
#define CMGetHostname(path, rc) ((path)->ft->getHostname((path), (rc)))
#define CMSetNameSpace(path, ns) ((path)->ft->setNameSpace((path), (ns)))
#define CMGetNameSpace(path, rc) ((path)->ft->getNameSpace((path), (rc)))
#define CMSetClassName(path, cls) ((path)->ft->setClassName((path), (cls)))
#define CMGetClassName(path, rc) ((path)->ft->getClassName((path), (rc)))
#define CMAddKey(path, name, value, type) ((path)->ft->addKey((path), (name), (CMPIValue*)(value), (type)))
#define CMGetKey(path, name, rc) ((path)->ft->getKey((path), (name), (rc)))
#define CMGetKeyAt(path, index, nameOut, rc) ((path)->ft->getKeyAt((path), (index), (nameOut), (rc)))
#define CMGetKeyCount(path, rc) ((path)->ft->getKeyCount((path), (rc)))
#define CMSetNameSpaceFromObjectPath(path, source) ((path)->ft->setNameSpaceFromObjectPath((path), (source)))
#define CMSetHostAndNameSpaceFromObjectPath(path, source)                                                              \
    ((path)->ft->setHostAndNameSpaceFromObjectPath((path), (source)))
#define CMGetClassQualifier(path, qualifier, rc) ((path)->ft->getClassQualifier((path), (qualifier), (rc)))
#define CMGetPropertyQualifier(path, property, qualifier, rc)                                                          \
    ((path)->ft->getPropertyQualifier((path), (property), (qualifier), (rc)))
#define CMGetMethodQualifier(path, method, qualifier, rc)                                                              \
    ((path)->ft->getMethodQualifier((path), (method), (qualifier), (rc)))
#define CMGetParameterQualifier(path, method, parameter, qualifier, rc)                                                \
    ((path)->ft->getParameterQualifier((path), (method), (parameter), (qualifier), (rc)))
#define CMObjectPathToString(path, rc) ((path)->ft->toString((path), (rc)))
#define CMAddArg(args, name, value, type) ((args)->ft->addArg((args), (name), (CMPIValue*)(value), (type)))
#define CMGetArg(args, name, rc) ((args)->ft->getArg((args), (name), (rc)))
#define CMGetArgAt(args, index, nameOut, rc) ((args)->ft->getArgAt((args), (index), (nameOut), (rc)))
#define CMGetArgCount(args, rc) ((args)->ft->getArgCount((args), (rc)))
#define CMGetArrayCount(array, rc) ((array)->ft->getSize((array), (rc)))
#define CMGetArrayType(array, rc) ((array)->ft->getSimpleType((array), (rc)))
#define CMGetArrayElementAt(array, index, rc) ((array)->ft->getElementAt((array), (index), (rc)))
#define CMSetArrayElementAt(array, index, value, type)                                                                 \
    ((array)->ft->setElementAt((array), (index), (CMPIValue*)(value), (type)))
#define CMGetCharsPtr(str, rc) ((str)->ft->getCharPtr((str), (rc)))
#define CMGetStringFormat(dt, rc) ((dt)->ft->getStringFormat((dt), (rc)))
#define CMGetBinaryFormat(dt, rc) ((dt)->ft->getBinaryFormat((dt), (rc)))
#define CMIsInterval(dt, rc) ((dt)->ft->isInterval((dt), (rc)))
#define CMGetNext(en, rc) ((en)->ft->getNext((en), (rc)))
#define CMHasNext(en, rc) ((en)->ft->hasNext((en), (rc)))
#define CMToArray(en, rc) ((en)->ft->toArray((en), (rc)))
#define CMReturnData(rslt, value, type) ((rslt)->ft->returnData((rslt), (CMPIValue*)(value), (type)))
#define CMReturnInstance(rslt, inst) ((rslt)->ft->returnInstance((rslt), (inst)))
#define CMReturnObjectPath(rslt, path) ((rslt)->ft->returnObjectPath((rslt), (path)))
#define CMReturnDone(rslt) ((rslt)->ft->returnDone((rslt)))
#ifdef CMPI_VER_200
#define CMReturnError(rslt, err) ((rslt)->ft->returnError((rslt), (err)))
#endif
#define CMGetContextEntry(ctx, name, rc) ((ctx)->ft->getEntry((ctx), (name), (rc)))
#define CMGetContextEntryAt(ctx, index, nameOut, rc) ((ctx)->ft->getEntryAt((ctx), (index), (nameOut), (rc)))
#define CMGetContextEntryCount(ctx, rc) ((ctx)->ft->getEntryCount((ctx), (rc)))
#define CMAddContextEntry(ctx, name, value, type) ((ctx)->ft->addEntry((ctx), (name), (CMPIValue*)(value), (type)))
#define CMGetSelExpString(se, rc) ((se)->ft->getString((se), (rc)))
#define CMEvaluateSelExp(se, inst, rc) ((se)->ft->evaluate((se), (inst), (rc)))
#define CMEvaluateSelExpUsingAccessor(se, accessor, accessorArg, rc)                                                   \
    ((se)->ft->evaluateUsingAccessor((se), (accessor), (accessorArg), (rc)))
#define CMGetDoc(se, rc) ((se)->ft->getDOC((se), (rc)))
#define CMGetCod(se, rc) ((se)->ft->getCOD((se), (rc)))
#define CMGetSubCondCountAndType(sc, typeOut, rc) ((sc)->ft->getCountAndType((sc), (typeOut), (rc)))
#define CMGetSubCondAt(sc, index, rc) ((sc)->ft->getSubCondAt((sc), (index), (rc)))
#define CMGetPredicateCount(sub, rc) ((sub)->ft->getCount((sub), (rc)))
#define CMGetPredicateAt(sub, index, rc) ((sub)->ft->getPredicateAt((sub), (index), (rc)))
#define CMGetPredicate(sub, name, rc) ((sub)->ft->getPredicate((sub), (name), (rc)))
#define CMGetPredicateData(pred, typeOut, opOut, lhsOut, rhsOut)                                                       \
    ((pred)->ft->getData((pred), (typeOut), (opOut), (lhsOut), (rhsOut)))
#define CMEvaluatePredicateUsingAccessor(pred, accessor, accessorArg, rc)                                              \
    ((pred)->ft->evaluateUsingAccessor((pred), (accessor), (accessorArg), (rc)))
#ifdef CMPI_VER_200
#define CMGetErrorType(err, rc) ((err)->ft->getErrorType((err), (rc)))
#define CMGetOtherErrorType(err, rc) ((err)->ft->getOtherErrorType((err), (rc)))
#define CMGetOwningEntity(err, rc) ((err)->ft->getOwningEntity((err), (rc)))
#define CMGetMessageID(err, rc) ((err)->ft->getMessageID((err), (rc)))
#define CMGetErrorMessage(err, rc) ((err)->ft->getMessage((err), (rc)))
#define CMGetPerceivedSeverity(err, rc) ((err)->ft->getPerceivedSeverity((err), (rc)))
#define CMGetProbableCause(err, rc) ((err)->ft->getProbableCause((err), (rc)))
#define CMGetProbableCauseDescription(err, rc) ((err)->ft->getProbableCauseDescription((err), (rc)))
#define CMGetRecommendedActions(err, rc) ((err)->ft->getRecommendedActions((err), (rc)))
#define CMGetErrorSource(err, rc) ((err)->ft->getErrorSource((err), (rc)))
#define CMGetErrorSourceFormat(err, rc) ((err)->ft->getErrorSourceFormat((err), (rc)))
#define CMGetOtherErrorSourceFormat(err, rc) ((err)->ft->getOtherErrorSourceFormat((err), (rc)))
#define CMGetCIMStatusCode(err, rc) ((err)->ft->getCIMStatusCode((err), (rc)))
#define CMGetCIMStatusCodeDescription(err, rc) ((err)->ft->getCIMStatusCodeDescription((err), (rc)))
#define CMGetMessageArguments(err, rc) ((err)->ft->getMessageArguments((err), (rc)))
#define CMSetErrorType(err, errorType) ((err)->ft->setErrorType((err), (errorType)))
#define CMSetOtherErrorType(err, text) ((err)->ft->setOtherErrorType((err), (text)))
#define CMSetProbableCauseDescription(err, text) ((err)->ft->setProbableCauseDescription((err), (text)))
#define CMSetRecommendedActions(err, array) ((err)->ft->setRecommendedActions((err), (array)))
#define CMSetErrorSource(err, text) ((err)->ft->setErrorSource((err), (text)))
#define CMSetErrorSourceFormat(err, format) ((err)->ft->setErrorSourceFormat((err), (format)))
#define CMSetOtherErrorSourceFormat(err, text) ((err)->ft->setOtherErrorSourceFormat((err), (text)))
#define CMSetCIMStatusCodeDescription(err, text) ((err)->ft->setCIMStatusCodeDescription((err), (text)))
#define CMSetMessageArguments(err, array) ((err)->ft->setMessageArguments((err), (array)))
#endif

/* Each stub expands to one static function table and one exported factory function. */
#define CMInstanceMIStubChange(pfx) pfx##ModifyInstance
#define CMIndicationMIStubExtensions(pfx) pfx##EnableIndications, pfx##DisableIndications

#define CMInstanceMIStub(pfx, miName, brokerVar, hook)                                                                 \
    static CMPIInstanceMIFT instMIFT__ = {                                                                             \
        CMPICurrentVersion,          CMPICurrentVersion,  "instance" #miName, pfx##Cleanup,                            \
        pfx##EnumInstanceNames,      pfx##EnumInstances,  pfx##GetInstance,   pfx##CreateInstance,                     \
        CMInstanceMIStubChange(pfx), pfx##DeleteInstance, pfx##ExecQuery,                                              \
    };                                                                                                                 \
    CMPI_EXTERN_C CMPIInstanceMI* miName##_Create_InstanceMI(const CMPIBroker* brkr, const CMPIContext* ctx,           \
                                                             CMPIStatus* rc) {                                         \
        static CMPIInstanceMI mi = {NULL, &instMIFT__};                                                                \
        (void)ctx;                                                                                                     \
        (void)rc;                                                                                                      \
        brokerVar = brkr;                                                                                              \
        hook;                                                                                                          \
        return &mi;                                                                                                    \
    }

#define CMAssociationMIStub(pfx, miName, brokerVar, hook)                                                              \
    static CMPIAssociationMIFT assocMIFT__ = {                                                                         \
        CMPICurrentVersion, CMPICurrentVersion,   "association" #miName, pfx##AssociationCleanup,                      \
        pfx##Associators,   pfx##AssociatorNames, pfx##References,       pfx##ReferenceNames,                          \
    };                                                                                                                 \
    CMPI_EXTERN_C CMPIAssociationMI* miName##_Create_AssociationMI(const CMPIBroker* brkr, const CMPIContext* ctx,     \
                                                                   CMPIStatus* rc) {                                   \
        static CMPIAssociationMI mi = {NULL, &assocMIFT__};                                                            \
        (void)ctx;                                                                                                     \
        (void)rc;                                                                                                      \
        brokerVar = brkr;                                                                                              \
        hook;                                                                                                          \
        return &mi;                                                                                                    \
    }

#define CMMethodMIStub(pfx, miName, brokerVar, hook)                                                                   \
    static CMPIMethodMIFT methMIFT__ = {                                                                               \
        CMPICurrentVersion, CMPICurrentVersion, "method" #miName, pfx##MethodCleanup, pfx##InvokeMethod,               \
    };                                                                                                                 \
    CMPI_EXTERN_C CMPIMethodMI* miName##_Create_MethodMI(const CMPIBroker* brkr, const CMPIContext* ctx,               \
                                                         CMPIStatus* rc) {                                             \
        static CMPIMethodMI mi = {NULL, &methMIFT__};                                                                  \
        (void)ctx;                                                                                                     \
        (void)rc;                                                                                                      \
        brokerVar = brkr;                                                                                              \
        hook;                                                                                                          \
        return &mi;                                                                                                    \
    }

#ifdef CMPI_VER_200
#define CMPI_NO_PROPERTY_ORIGIN NULL
#else
#define CMPI_NO_PROPERTY_ORIGIN
#endif
#define CMPropertyMIStub(pfx, miName, brokerVar, hook)                                                                 \
    static CMPIPropertyMIFT propMIFT__ = {                                                                             \
        CMPICurrentVersion, CMPICurrentVersion, "property" #miName,      pfx##PropertyCleanup,                         \
        pfx##SetProperty,   pfx##GetProperty,   CMPI_NO_PROPERTY_ORIGIN,                                               \
    };                                                                                                                 \
    CMPI_EXTERN_C CMPIPropertyMI* miName##_Create_PropertyMI(const CMPIBroker* brkr, const CMPIContext* ctx,           \
                                                             CMPIStatus* rc) {                                         \
        static CMPIPropertyMI mi = {NULL, &propMIFT__};                                                                \
        (void)ctx;                                                                                                     \
        (void)rc;                                                                                                      \
        brokerVar = brkr;                                                                                              \
        hook;                                                                                                          \
        return &mi;                                                                                                    \
    }

#define CMIndicationMIStub(pfx, miName, brokerVar, hook)                                                               \
    static CMPIIndicationMIFT indMIFT__ = {                                                                            \
        CMPICurrentVersion,     CMPICurrentVersion,    "Indication" #miName,                                           \
        pfx##IndicationCleanup, pfx##AuthorizeFilter,  pfx##MustPoll,                                                  \
        pfx##ActivateFilter,    pfx##DeActivateFilter, CMIndicationMIStubExtensions(pfx),                              \
    };                                                                                                                 \
    CMPI_EXTERN_C CMPIIndicationMI* miName##_Create_IndicationMI(const CMPIBroker* brkr, const CMPIContext* ctx,       \
                                                                 CMPIStatus* rc) {                                     \
        static CMPIIndicationMI mi = {NULL, &indMIFT__};                                                               \
        (void)ctx;                                                                                                     \
        (void)rc;                                                                                                      \
        brokerVar = brkr;                                                                                              \
        hook;                                                                                                          \
        return &mi;                                                                                                    \
    }

#endif
