/*
 * CMPI convenience macros: short names for slot calls, status helpers and provider stubs.
 *
 * A slot macro calls the slot on its first argument, passes all its arguments in order and is the slot's result; the
 * first argument is evaluated more than once. An argument named value may point to a CMPIValue or to a plain variable
 * of the type that follows; for CMPI_chars it is the text itself.
 */
#ifndef _CMPIMACS_H_
#define _CMPIMACS_H_

#include "cmpidt.h"
#include "cmpift.h"

/* Return a status from the enclosing function. A null broker gives no text. */
#define CMReturn(rc_)                                                                                                  \
    do {                                                                                                               \
        CMPIStatus cmStatus_;                                                                                          \
        cmStatus_.rc = (rc_);                                                                                          \
        cmStatus_.msg = NULL;                                                                                          \
        return cmStatus_;                                                                                              \
    } while (0)
#define CMReturnWithString(rc_, str)                                                                                   \
    do {                                                                                                               \
        CMPIStatus cmStatus_;                                                                                          \
        cmStatus_.rc = (rc_);                                                                                          \
        cmStatus_.msg = (str);                                                                                         \
        return cmStatus_;                                                                                              \
    } while (0)
#define CMReturnWithChars(broker, rc_, chars)                                                                          \
    do {                                                                                                               \
        CMPIStatus cmStatus_;                                                                                          \
        const CMPIBroker* cmBroker_ = (broker);                                                                        \
        cmStatus_.rc = (rc_);                                                                                          \
        cmStatus_.msg = cmBroker_ ? cmBroker_->eft->newString(cmBroker_, (chars), NULL) : NULL;                        \
        return cmStatus_;                                                                                              \
    } while (0)

/* Fill the status that st points to; a null st is left alone, a null broker gives no text. */
#define CMSetStatus(st, rc_)                                                                                           \
    do {                                                                                                               \
        CMPIStatus* cmStatus_ = (st);                                                                                  \
        if (cmStatus_) {                                                                                               \
            cmStatus_->rc = (rc_);                                                                                     \
            cmStatus_->msg = NULL;                                                                                     \
        }                                                                                                              \
    } while (0)
#define CMSetStatusWithString(st, rc_, str)                                                                            \
    do {                                                                                                               \
        CMPIStatus* cmStatus_ = (st);                                                                                  \
        if (cmStatus_) {                                                                                               \
            cmStatus_->rc = (rc_);                                                                                     \
            cmStatus_->msg = (str);                                                                                    \
        }                                                                                                              \
    } while (0)
#define CMSetStatusWithChars(broker, st, rc_, chars)                                                                   \
    do {                                                                                                               \
        CMPIStatus* cmStatus_ = (st);                                                                                  \
        const CMPIBroker* cmBroker_ = (broker);                                                                        \
        if (cmStatus_) {                                                                                               \
            cmStatus_->rc = (rc_);                                                                                     \
            cmStatus_->msg = cmBroker_ ? cmBroker_->eft->newString(cmBroker_, (chars), NULL) : NULL;                   \
        }                                                                                                              \
    } while (0)

/* A null object is a null pointer or an object whose first word is null. */
#define CMIsNullObject(obj) ((obj) == NULL || *((void* const*)(obj)) == NULL)

/* Tests of a CMPIData: 0 or 1. */
#define CMIsNullValue(data) (((data).state & CMPI_nullValue) != 0)
#define CMIsKeyValue(data) (((data).state & CMPI_keyValue) != 0)
#define CMIsArray(data) (((data).type & CMPI_ARRAY) != 0)

/* Of any object. A clone is the caller's own until released; it outlives the request. */
#define CMClone(obj, rc) ((obj)->ft->clone((obj), (rc)))
#define CMRelease(obj) ((obj)->ft->release((obj)))

/* The text of a string; valid as long as the string is. */
#define CMGetCharPtr(str) ((char*)(str)->ft->getCharPtr((str), NULL))

/* Facts of the broker. The capabilities have three names, all in use. */
#define CBBrokerVersion(broker) ((broker)->bft->brokerVersion)
#define CBBrokerName(broker) ((broker)->bft->brokerName)
#define CBGetCapabilities(broker) ((broker)->bft->brokerCapabilities)
#define CBGetBrokerCapabilities(broker) CBGetCapabilities(broker)
#define CBGetClassification(broker) CBGetCapabilities(broker)

/* Inserts for message templates: each a type code and its value, and up to ten of them with their number before. */
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

/* Calls into the broker. */
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
/* The older name for changing an instance, which has no property list. */
#define CBSetInstance(broker, ctx, path, inst) CBModifyInstance(broker, ctx, path, inst, NULL)
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
    ((broker)->bft->setProperty((broker), (ctx), (path), (name), (const CMPIValue*)(value), (type)))
#define CBGetProperty(broker, ctx, path, name, rc) ((broker)->bft->getProperty((broker), (ctx), (path), (name), (rc)))

/* New objects, freed by the broker when the request ends. */
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

/* Services. CDToString, CDIsOfType and CDGetType take any object, for debugging. */
#define CMClassPathIsA(broker, path, cls, rc) ((broker)->eft->classPathIsA((broker), (path), (cls), (rc)))
#define CDToString(broker, object, rc) ((broker)->eft->toString((broker), (const void*)(object), (rc)))
#define CDIsOfType(broker, object, typeName, rc)                                                                       \
    ((broker)->eft->isOfType((broker), (const void*)(object), (typeName), (rc)))
#define CDGetType(broker, object, rc) ((broker)->eft->getType((broker), (const void*)(object), (rc)))
#define CMLogMessage(broker, severity, id, text, string)                                                               \
    ((broker)->eft->logMessage((broker), (severity), (id), (text), (string)))
#define CMTraceMessage(broker, level, component, text, string)                                                         \
    ((broker)->eft->trace((broker), (level), (component), (text), (string)))
#define CMGetMessage(broker, msgId, defaultText, rc, fmtArgs)                                                          \
    ((broker)->eft->getMessage((broker), (msgId), (defaultText), (rc), fmtArgs))
#ifdef CMPI_VER_200
#define CMNewCMPIError(broker, owner, msgId, text, severity, cause, cimStatus, rc)                                     \
    ((broker)->eft->newCMPIError((broker), (owner), (msgId), (text), (severity), (cause), (cimStatus), (rc)))
#define CMOpenMessageFile(broker, file, handleOut) ((broker)->eft->openMessageFile((broker), (file), (handleOut)))
#define CMCloseMessageFile(broker, handle) ((broker)->eft->closeMessageFile((broker), (handle)))
#define CMGetMessage2(broker, msgId, handle, defaultText, rc, fmtArgs)                                                 \
    ((broker)->eft->getMessage2((broker), (msgId), (handle), (defaultText), (rc), fmtArgs))
#endif

/* Instances. */
#define CMGetProperty(inst, name, rc) ((inst)->ft->getProperty((inst), (name), (rc)))
#define CMGetPropertyAt(inst, index, nameOut, rc) ((inst)->ft->getPropertyAt((inst), (index), (nameOut), (rc)))
#define CMGetPropertyCount(inst, rc) ((inst)->ft->getPropertyCount((inst), (rc)))
#define CMSetProperty(inst, name, value, type)                                                                         \
    ((inst)->ft->setProperty((inst), (name), (const CMPIValue*)(value), (type)))
#ifdef CMPI_VER_200
#define CMSetPropertyWithOrigin(inst, name, value, type, originClass)                                                  \
    ((inst)->ft->setPropertyWithOrigin((inst), (name), (const CMPIValue*)(value), (type), (originClass)))
#endif
#define CMGetObjectPath(inst, rc) ((inst)->ft->getObjectPath((inst), (rc)))
#define CMSetObjectPath(inst, path) ((inst)->ft->setObjectPath((inst), (path)))
#define CMSetPropertyFilter(inst, propList, keyList) ((inst)->ft->setPropertyFilter((inst), (propList), (keyList)))

/* Object paths. */
#define CMSetHostname(path, host) ((path)->ft->setHostname((path), (host)))
#define CMGetHostname(path, rc) ((path)->ft->getHostname((path), (rc)))
#define CMSetNameSpace(path, ns) ((path)->ft->setNameSpace((path), (ns)))
#define CMGetNameSpace(path, rc) ((path)->ft->getNameSpace((path), (rc)))
#define CMSetClassName(path, cls) ((path)->ft->setClassName((path), (cls)))
#define CMGetClassName(path, rc) ((path)->ft->getClassName((path), (rc)))
#define CMAddKey(path, name, value, type) ((path)->ft->addKey((path), (name), (const CMPIValue*)(value), (type)))
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

/* Arguments of methods. */
#define CMAddArg(args, name, value, type) ((args)->ft->addArg((args), (name), (const CMPIValue*)(value), (type)))
#define CMGetArg(args, name, rc) ((args)->ft->getArg((args), (name), (rc)))
#define CMGetArgAt(args, index, nameOut, rc) ((args)->ft->getArgAt((args), (index), (nameOut), (rc)))
#define CMGetArgCount(args, rc) ((args)->ft->getArgCount((args), (rc)))

/* Arrays. */
#define CMGetArrayCount(array, rc) ((array)->ft->getSize((array), (rc)))
#define CMGetArrayType(array, rc) ((array)->ft->getSimpleType((array), (rc)))
#define CMGetArrayElementAt(array, index, rc) ((array)->ft->getElementAt((array), (index), (rc)))
#define CMSetArrayElementAt(array, index, value, type)                                                                 \
    ((array)->ft->setElementAt((array), (index), (const CMPIValue*)(value), (type)))

/* Strings. */
#define CMGetCharsPtr(str, rc) ((str)->ft->getCharPtr((str), (rc)))

/* Dates and times. */
#define CMGetStringFormat(dt, rc) ((dt)->ft->getStringFormat((dt), (rc)))
#define CMGetBinaryFormat(dt, rc) ((dt)->ft->getBinaryFormat((dt), (rc)))
#define CMIsInterval(dt, rc) ((dt)->ft->isInterval((dt), (rc)))

/* Enumerations. */
#define CMGetNext(en, rc) ((en)->ft->getNext((en), (rc)))
#define CMHasNext(en, rc) ((en)->ft->hasNext((en), (rc)))
#define CMToArray(en, rc) ((en)->ft->toArray((en), (rc)))

/* Results. These do not return from the enclosing function. */
#define CMReturnData(rslt, value, type) ((rslt)->ft->returnData((rslt), (const CMPIValue*)(value), (type)))
#define CMReturnInstance(rslt, inst) ((rslt)->ft->returnInstance((rslt), (inst)))
#define CMReturnObjectPath(rslt, path) ((rslt)->ft->returnObjectPath((rslt), (path)))
#define CMReturnDone(rslt) ((rslt)->ft->returnDone((rslt)))
#ifdef CMPI_VER_200
#define CMReturnError(rslt, err) ((rslt)->ft->returnError((rslt), (err)))
#endif

/* Contexts. */
#define CMGetContextEntry(ctx, name, rc) ((ctx)->ft->getEntry((ctx), (name), (rc)))
#define CMGetContextEntryAt(ctx, index, nameOut, rc) ((ctx)->ft->getEntryAt((ctx), (index), (nameOut), (rc)))
#define CMGetContextEntryCount(ctx, rc) ((ctx)->ft->getEntryCount((ctx), (rc)))
#define CMAddContextEntry(ctx, name, value, type)                                                                      \
    ((ctx)->ft->addEntry((ctx), (name), (const CMPIValue*)(value), (type)))

/* Queries: the expression, its condition in normal form, the parts of that and their predicates. */
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
/* Errors. */
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

/*
 * Provider stubs, for use at file scope: each is one static function table, filled with the functions of the provider
 * whose names begin with pfx, and one exported factory function. The factory stores the broker in brokerVar, runs hook
 * and returns the static object mi, whose handle starts null. It leaves *rc alone. A hook is a statement (or CMNoHook)
 * and can use brkr, ctx, rc and mi. Each kind of stub once per source file.
 */
#define CMNoHook

/* A hook that calls pfx##Kind##Initialize(&mi, ctx), which returns a status; unless that is OK, the factory fails. */
#define CMInitHook(pfx, Kind)                                                                                          \
    do {                                                                                                               \
        CMPIStatus cmInit_ = pfx##Kind##Initialize(&mi, ctx);                                                          \
        if (cmInit_.rc != CMPI_RC_OK) {                                                                                \
            if (rc) *rc = cmInit_;                                                                                     \
            return NULL;                                                                                               \
        }                                                                                                              \
    } while (0)

/* The factory function that all stubs share; private to this file. The hook comes last, as it may contain commas. */
#define CMPI_STUB_FACTORY_(MI, factory, table, brokerVar, ...)                                                         \
    CMPI_EXTERN_C MI* factory(const CMPIBroker* brkr, const CMPIContext* ctx, CMPIStatus* rc) {                        \
        static MI mi = {NULL, &table};                                                                                 \
        (void)ctx;                                                                                                     \
        (void)rc;                                                                                                      \
        brokerVar = brkr;                                                                                              \
        __VA_ARGS__;                                                                                                   \
        return &mi;                                                                                                    \
    }

/* The functions of a stub whose presence depends on the level. */
#define CMInstanceMIStubChange(pfx) pfx##ModifyInstance
#define CMIndicationMIStubExtensions(pfx) pfx##EnableIndications, pfx##DisableIndications

#define CMInstanceMIStub(pfx, miName, brokerVar, hook)                                                                 \
    static CMPIInstanceMIFT instMIFT__ = {                                                                             \
        CMPICurrentVersion,          CMPICurrentVersion,  "instance" #miName, pfx##Cleanup,                            \
        pfx##EnumInstanceNames,      pfx##EnumInstances,  pfx##GetInstance,   pfx##CreateInstance,                     \
        CMInstanceMIStubChange(pfx), pfx##DeleteInstance, pfx##ExecQuery,                                              \
    };                                                                                                                 \
    CMPI_STUB_FACTORY_(CMPIInstanceMI, miName##_Create_InstanceMI, instMIFT__, brokerVar, hook)

#define CMAssociationMIStub(pfx, miName, brokerVar, hook)                                                              \
    static CMPIAssociationMIFT assocMIFT__ = {                                                                         \
        CMPICurrentVersion, CMPICurrentVersion,   "association" #miName, pfx##AssociationCleanup,                      \
        pfx##Associators,   pfx##AssociatorNames, pfx##References,       pfx##ReferenceNames,                          \
    };                                                                                                                 \
    CMPI_STUB_FACTORY_(CMPIAssociationMI, miName##_Create_AssociationMI, assocMIFT__, brokerVar, hook)

#define CMMethodMIStub(pfx, miName, brokerVar, hook)                                                                   \
    static CMPIMethodMIFT methMIFT__ = {                                                                               \
        CMPICurrentVersion, CMPICurrentVersion, "method" #miName, pfx##MethodCleanup, pfx##InvokeMethod,               \
    };                                                                                                                 \
    CMPI_STUB_FACTORY_(CMPIMethodMI, miName##_Create_MethodMI, methMIFT__, brokerVar, hook)

/* The stub offers no setPropertyWithOrigin: that slot, which only level 200 has, stays null. */
#ifdef CMPI_VER_200
#define CMPropertyMIStub(pfx, miName, brokerVar, hook)                                                                 \
    static CMPIPropertyMIFT propMIFT__ = {                                                                             \
        CMPICurrentVersion,                                                                                            \
        CMPICurrentVersion,                                                                                            \
        "property" #miName,                                                                                            \
        pfx##PropertyCleanup,                                                                                          \
        pfx##SetProperty,                                                                                              \
        pfx##GetProperty,                                                                                              \
        NULL,                                                                                                          \
    };                                                                                                                 \
    CMPI_STUB_FACTORY_(CMPIPropertyMI, miName##_Create_PropertyMI, propMIFT__, brokerVar, hook)
#else
#define CMPropertyMIStub(pfx, miName, brokerVar, hook)                                                                 \
    static CMPIPropertyMIFT propMIFT__ = {                                                                             \
        CMPICurrentVersion,   CMPICurrentVersion, "property" #miName,                                                  \
        pfx##PropertyCleanup, pfx##SetProperty,   pfx##GetProperty,                                                    \
    };                                                                                                                 \
    CMPI_STUB_FACTORY_(CMPIPropertyMI, miName##_Create_PropertyMI, propMIFT__, brokerVar, hook)
#endif

#define CMIndicationMIStub(pfx, miName, brokerVar, hook)                                                               \
    static CMPIIndicationMIFT indMIFT__ = {                                                                            \
        CMPICurrentVersion,     CMPICurrentVersion,    "Indication" #miName,                                           \
        pfx##IndicationCleanup, pfx##AuthorizeFilter,  pfx##MustPoll,                                                  \
        pfx##ActivateFilter,    pfx##DeActivateFilter, CMIndicationMIStubExtensions(pfx),                              \
    };                                                                                                                 \
    CMPI_STUB_FACTORY_(CMPIIndicationMI, miName##_Create_IndicationMI, indMIFT__, brokerVar, hook)

#endif
