/* CMPI function tables and the objects that carry them. */
#ifndef _CMPIFT_H_
#define _CMPIFT_H_

#include "cmpidt.h"
#include "cmpios.h"

#ifdef __cplusplus
extern "C" {
#endif

struct timespec;

struct _CMPIContext {
    void* hdl;
    CMPIContextFT* ft;
};

struct _CMPIResult {
    void* hdl;
    CMPIResultFT* ft;
};

struct _CMPIString {
    void* hdl;
    CMPIStringFT* ft;
};

struct _CMPIArray {
    void* hdl;
    CMPIArrayFT* ft;
};

struct _CMPIEnumeration {
    void* hdl;
    CMPIEnumerationFT* ft;
};

struct _CMPIInstance {
    void* hdl;
    CMPIInstanceFT* ft;
};

struct _CMPIObjectPath {
    void* hdl;
    CMPIObjectPathFT* ft;
};

struct _CMPIArgs {
    void* hdl;
    CMPIArgsFT* ft;
};

struct _CMPIDateTime {
    void* hdl;
    CMPIDateTimeFT* ft;
};

struct _CMPISelectExp {
    void* hdl;
    CMPISelectExpFT* ft;
};

struct _CMPISelectCond {
    void* hdl;
    CMPISelectCondFT* ft;
};

struct _CMPISubCond {
    void* hdl;
    CMPISubCondFT* ft;
};

struct _CMPIPredicate {
    void* hdl;
    CMPIPredicateFT* ft;
};

#ifdef CMPI_VER_200
struct _CMPIError {
    void* hdl;
    CMPIErrorFT* ft;
};
#endif

struct _CMPIInstanceMI {
    const void* hdl;
    CMPIInstanceMIFT* ft;
};

struct _CMPIAssociationMI {
    void* hdl;
    CMPIAssociationMIFT* ft;
};

struct _CMPIMethodMI {
    void* hdl;
    CMPIMethodMIFT* ft;
};

struct _CMPIPropertyMI {
    void* hdl;
    CMPIPropertyMIFT* ft;
};

struct _CMPIIndicationMI {
    void* hdl;
    CMPIIndicationMIFT* ft;
};

struct _CMPIBroker {
    void* hdl;
    CMPIBrokerFT* bft;
    CMPIBrokerEncFT* eft;
    CMPIBrokerExtFT* xft;
#ifdef CMPI_VER_200
    CMPIBrokerMemFT* mft;
#endif
};

struct _CMPIBrokerFT {
    unsigned int brokerCapabilities;
    unsigned int brokerVersion;
    const char* brokerName;
    CMPIContext* (*prepareAttachThread)(const CMPIBroker* broker, const CMPIContext* ctx);
    CMPIStatus (*attachThread)(const CMPIBroker* broker, const CMPIContext* ctx);
    CMPIStatus (*detachThread)(const CMPIBroker* broker, const CMPIContext* ctx);
    CMPIStatus (*deliverIndication)(const CMPIBroker* broker, const CMPIContext* ctx, const char* ns,
                                    const CMPIInstance* indication);
    CMPIEnumeration* (*enumerateInstanceNames)(const CMPIBroker* broker, const CMPIContext* ctx,
                                               const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIInstance* (*getInstance)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                 const char** propList, CMPIStatus* rc);
    CMPIObjectPath* (*createInstance)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                      const CMPIInstance* inst, CMPIStatus* rc);
    CMPIStatus (*modifyInstance)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                 const CMPIInstance* inst, const char** propList);
    CMPIStatus (*deleteInstance)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path);
    CMPIEnumeration* (*execQuery)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                  const char* query, const char* lang, CMPIStatus* rc);
    CMPIEnumeration* (*enumerateInstances)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                           const char** propList, CMPIStatus* rc);
    CMPIEnumeration* (*associators)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                    const char* assocClass, const char* resultClass, const char* role,
                                    const char* resultRole, const char** propList, CMPIStatus* rc);
    CMPIEnumeration* (*associatorNames)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                        const char* assocClass, const char* resultClass, const char* role,
                                        const char* resultRole, CMPIStatus* rc);
    CMPIEnumeration* (*references)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                   const char* resultClass, const char* role, const char** propList, CMPIStatus* rc);
    CMPIEnumeration* (*referenceNames)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                                       const char* resultClass, const char* role, CMPIStatus* rc);
    CMPIData (*invokeMethod)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                             const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus* rc);
    CMPIStatus (*setProperty)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                              const char* name, const CMPIValue* value, CMPIType type);
    CMPIData (*getProperty)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                            const char* name, CMPIStatus* rc);
};

struct _CMPIBrokerEncFT {
    int ftVersion;
    CMPIInstance* (*newInstance)(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIObjectPath* (*newObjectPath)(const CMPIBroker* broker, const char* ns, const char* cls, CMPIStatus* rc);
    CMPIArgs* (*newArgs)(const CMPIBroker* broker, CMPIStatus* rc);
    CMPIString* (*newString)(const CMPIBroker* broker, const char* text, CMPIStatus* rc);
    CMPIArray* (*newArray)(const CMPIBroker* broker, CMPICount size, CMPIType type, CMPIStatus* rc);
    CMPIDateTime* (*newDateTime)(const CMPIBroker* broker, CMPIStatus* rc);
    CMPIDateTime* (*newDateTimeFromBinary)(const CMPIBroker* broker, CMPIUint64 usec, CMPIBoolean isInterval,
                                           CMPIStatus* rc);
    CMPIDateTime* (*newDateTimeFromChars)(const CMPIBroker* broker, const char* text, CMPIStatus* rc);
    CMPISelectExp* (*newSelectExp)(const CMPIBroker* broker, const char* query, const char* lang,
                                   CMPIArray** projectionOut, CMPIStatus* rc);
    CMPIBoolean (*classPathIsA)(const CMPIBroker* broker, const CMPIObjectPath* path, const char* cls, CMPIStatus* rc);
    CMPIString* (*toString)(const CMPIBroker* broker, const void* object, CMPIStatus* rc);
    CMPIBoolean (*isOfType)(const CMPIBroker* broker, const void* object, const char* typeName, CMPIStatus* rc);
    CMPIString* (*getType)(const CMPIBroker* broker, const void* object, CMPIStatus* rc);
    CMPIString* (*getMessage)(const CMPIBroker* broker, const char* msgId, const char* defaultText, CMPIStatus* rc,
                              CMPICount pairs, ...);
    CMPIStatus (*logMessage)(const CMPIBroker* broker, int severity, const char* id, const char* text,
                             const CMPIString* stringObj);
    CMPIStatus (*trace)(const CMPIBroker* broker, int level, const char* component, const char* text,
                        const CMPIString* stringObj);
#ifdef CMPI_VER_200
    CMPIError* (*newCMPIError)(const CMPIBroker* broker, const char* owner, const char* msgId, const char* text,
                               CMPIErrorSeverity severity, CMPIErrorProbableCause cause, CMPIrc cimStatus,
                               CMPIStatus* rc);
    CMPIStatus (*openMessageFile)(const CMPIBroker* broker, const char* file, CMPIMsgFileHandle* handleOut);
    CMPIStatus (*closeMessageFile)(const CMPIBroker* broker, CMPIMsgFileHandle handle);
    CMPIString* (*getMessage2)(const CMPIBroker* broker, const char* msgId, CMPIMsgFileHandle handle,
                               const char* defaultText, CMPIStatus* rc, CMPICount pairs, ...);
#endif
};

struct _CMPIBrokerExtFT {
    int ftVersion;
    char* (*resolveFileName)(const char* libName);
    CMPI_THREAD_TYPE (*newThread)(CMPI_THREAD_RETURN(CMPI_THREAD_CDECL* start)(void*), void* arg, int detached);
    int (*joinThread)(CMPI_THREAD_TYPE thread, CMPI_THREAD_RETURN* retvalOut);
    int (*exitThread)(CMPI_THREAD_RETURN retval);
    int (*cancelThread)(CMPI_THREAD_TYPE thread);
    int (*threadSleep)(CMPIUint32 msec);
    int (*threadOnce)(int* once, void (*init)(void));
    int (*createThreadKey)(CMPI_THREAD_KEY_TYPE* keyOut, void (*destructor)(void*));
    int (*destroyThreadKey)(CMPI_THREAD_KEY_TYPE key);
    void* (*getThreadSpecific)(CMPI_THREAD_KEY_TYPE key);
    int (*setThreadSpecific)(CMPI_THREAD_KEY_TYPE key, void* value);
    CMPI_MUTEX_TYPE (*newMutex)(int opt);
    void (*destroyMutex)(CMPI_MUTEX_TYPE mutex);
    void (*lockMutex)(CMPI_MUTEX_TYPE mutex);
    void (*unlockMutex)(CMPI_MUTEX_TYPE mutex);
    CMPI_COND_TYPE (*newCondition)(int opt);
    void (*destroyCondition)(CMPI_COND_TYPE cond);
    int (*condWait)(CMPI_COND_TYPE cond, CMPI_MUTEX_TYPE mutex);
    int (*timedCondWait)(CMPI_COND_TYPE cond, CMPI_MUTEX_TYPE mutex, struct timespec* until);
    int (*signalCondition)(CMPI_COND_TYPE cond);
};

#ifdef CMPI_VER_200
struct _CMPIBrokerMemFT {
    int ftVersion;
    CMPIGcStat* (*mark)(const CMPIBroker* broker, CMPIStatus* rc);
    CMPIStatus (*release)(const CMPIBroker* broker, const CMPIGcStat* mark);
    void* (*cmpiMalloc)(const CMPIBroker* broker, size_t size);
    void* (*cmpiCalloc)(const CMPIBroker* broker, size_t count, size_t elemSize);
    void* (*cmpiRealloc)(const CMPIBroker* broker, void* ptr, size_t size);
    char* (*cmpiStrDup)(const CMPIBroker* broker, const char* text);
    void (*cmpiFree)(const CMPIBroker* broker, void* ptr);
    void (*freeInstance)(const CMPIBroker* broker, CMPIInstance* inst);
    void (*freeObjectPath)(const CMPIBroker* broker, CMPIObjectPath* path);
    void (*freeArgs)(const CMPIBroker* broker, CMPIArgs* args);
    void (*freeString)(const CMPIBroker* broker, CMPIString* str);
    void (*freeArray)(const CMPIBroker* broker, CMPIArray* array);
    void (*freeDateTime)(const CMPIBroker* broker, CMPIDateTime* dt);
    void (*freeSelectExp)(const CMPIBroker* broker, CMPISelectExp* se);
};
#endif

struct _CMPIContextFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIContext* ctx);
    CMPIContext* (*clone)(const CMPIContext* ctx, CMPIStatus* rc);
    CMPIData (*getEntry)(const CMPIContext* ctx, const char* name, CMPIStatus* rc);
    CMPIData (*getEntryAt)(const CMPIContext* ctx, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getEntryCount)(const CMPIContext* ctx, CMPIStatus* rc);
    CMPIStatus (*addEntry)(const CMPIContext* ctx, const char* name, const CMPIValue* value, CMPIType type);
};

struct _CMPIResultFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIResult* rslt);
    CMPIResult* (*clone)(const CMPIResult* rslt, CMPIStatus* rc);
    CMPIStatus (*returnData)(const CMPIResult* rslt, const CMPIValue* value, CMPIType type);
    CMPIStatus (*returnInstance)(const CMPIResult* rslt, const CMPIInstance* inst);
    CMPIStatus (*returnObjectPath)(const CMPIResult* rslt, const CMPIObjectPath* path);
    CMPIStatus (*returnDone)(const CMPIResult* rslt);
#ifdef CMPI_VER_200
    CMPIStatus (*returnError)(const CMPIResult* rslt, const CMPIError* err);
#endif
};

struct _CMPIObjectPathFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIObjectPath* path);
    CMPIObjectPath* (*clone)(const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIStatus (*setNameSpace)(CMPIObjectPath* path, const char* ns);
    CMPIString* (*getNameSpace)(const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIStatus (*setHostname)(CMPIObjectPath* path, const char* host);
    CMPIString* (*getHostname)(const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIStatus (*setClassName)(CMPIObjectPath* path, const char* cls);
    CMPIString* (*getClassName)(const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIStatus (*addKey)(CMPIObjectPath* path, const char* name, const CMPIValue* value, CMPIType type);
    CMPIData (*getKey)(const CMPIObjectPath* path, const char* name, CMPIStatus* rc);
    CMPIData (*getKeyAt)(const CMPIObjectPath* path, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getKeyCount)(const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIStatus (*setNameSpaceFromObjectPath)(CMPIObjectPath* path, const CMPIObjectPath* source);
    CMPIStatus (*setHostAndNameSpaceFromObjectPath)(CMPIObjectPath* path, const CMPIObjectPath* source);
    CMPIData (*getClassQualifier)(const CMPIObjectPath* path, const char* qualifier, CMPIStatus* rc);
    CMPIData (*getPropertyQualifier)(const CMPIObjectPath* path, const char* property, const char* qualifier,
                                     CMPIStatus* rc);
    CMPIData (*getMethodQualifier)(const CMPIObjectPath* path, const char* method, const char* qualifier,
                                   CMPIStatus* rc);
    CMPIData (*getParameterQualifier)(const CMPIObjectPath* path, const char* method, const char* parameter,
                                      const char* qualifier, CMPIStatus* rc);
    CMPIString* (*toString)(const CMPIObjectPath* path, CMPIStatus* rc);
};

struct _CMPIInstanceFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIInstance* inst);
    CMPIInstance* (*clone)(const CMPIInstance* inst, CMPIStatus* rc);
    CMPIData (*getProperty)(const CMPIInstance* inst, const char* name, CMPIStatus* rc);
    CMPIData (*getPropertyAt)(const CMPIInstance* inst, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getPropertyCount)(const CMPIInstance* inst, CMPIStatus* rc);
    CMPIStatus (*setProperty)(const CMPIInstance* inst, const char* name, const CMPIValue* value, CMPIType type);
    CMPIObjectPath* (*getObjectPath)(const CMPIInstance* inst, CMPIStatus* rc);
    CMPIStatus (*setPropertyFilter)(CMPIInstance* inst, const char** propList, const char** keyList);
    CMPIStatus (*setObjectPath)(CMPIInstance* inst, const CMPIObjectPath* path);
#ifdef CMPI_VER_200
    CMPIStatus (*setPropertyWithOrigin)(const CMPIInstance* inst, const char* name, const CMPIValue* value,
                                        CMPIType type, const char* originClass);
#endif
};

struct _CMPIArgsFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIArgs* args);
    CMPIArgs* (*clone)(const CMPIArgs* args, CMPIStatus* rc);
    CMPIStatus (*addArg)(const CMPIArgs* args, const char* name, const CMPIValue* value, CMPIType type);
    CMPIData (*getArg)(const CMPIArgs* args, const char* name, CMPIStatus* rc);
    CMPIData (*getArgAt)(const CMPIArgs* args, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getArgCount)(const CMPIArgs* args, CMPIStatus* rc);
};

struct _CMPIStringFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIString* str);
    CMPIString* (*clone)(const CMPIString* str, CMPIStatus* rc);
    const char* (*getCharPtr)(const CMPIString* str, CMPIStatus* rc);
};

struct _CMPIArrayFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIArray* array);
    CMPIArray* (*clone)(const CMPIArray* array, CMPIStatus* rc);
    CMPICount (*getSize)(const CMPIArray* array, CMPIStatus* rc);
    CMPIType (*getSimpleType)(const CMPIArray* array, CMPIStatus* rc);
    CMPIData (*getElementAt)(const CMPIArray* array, CMPICount index, CMPIStatus* rc);
    CMPIStatus (*setElementAt)(CMPIArray* array, CMPICount index, const CMPIValue* value, CMPIType type);
};

struct _CMPIEnumerationFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIEnumeration* en);
    CMPIEnumeration* (*clone)(const CMPIEnumeration* en, CMPIStatus* rc);
    CMPIData (*getNext)(const CMPIEnumeration* en, CMPIStatus* rc);
    CMPIBoolean (*hasNext)(const CMPIEnumeration* en, CMPIStatus* rc);
    CMPIArray* (*toArray)(const CMPIEnumeration* en, CMPIStatus* rc);
};

struct _CMPIDateTimeFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIDateTime* dt);
    CMPIDateTime* (*clone)(const CMPIDateTime* dt, CMPIStatus* rc);
    CMPIUint64 (*getBinaryFormat)(const CMPIDateTime* dt, CMPIStatus* rc);
    CMPIString* (*getStringFormat)(const CMPIDateTime* dt, CMPIStatus* rc);
    CMPIBoolean (*isInterval)(const CMPIDateTime* dt, CMPIStatus* rc);
};

struct _CMPISelectExpFT {
    int ftVersion;
    CMPIStatus (*release)(CMPISelectExp* se);
    CMPISelectExp* (*clone)(const CMPISelectExp* se, CMPIStatus* rc);
    CMPIBoolean (*evaluate)(const CMPISelectExp* se, const CMPIInstance* inst, CMPIStatus* rc);
    CMPIString* (*getString)(const CMPISelectExp* se, CMPIStatus* rc);
    CMPISelectCond* (*getDOC)(const CMPISelectExp* se, CMPIStatus* rc);
    CMPISelectCond* (*getCOD)(const CMPISelectExp* se, CMPIStatus* rc);
    CMPIBoolean (*evaluateUsingAccessor)(const CMPISelectExp* se, CMPIAccessor* accessor, void* accessorArg,
                                         CMPIStatus* rc);
};

struct _CMPISelectCondFT {
    int ftVersion;
    CMPIStatus (*release)(CMPISelectCond* sc);
    CMPISelectCond* (*clone)(const CMPISelectCond* sc, CMPIStatus* rc);
    CMPICount (*getCountAndType)(const CMPISelectCond* sc, int* typeOut, CMPIStatus* rc);
    CMPISubCond* (*getSubCondAt)(const CMPISelectCond* sc, CMPICount index, CMPIStatus* rc);
};

struct _CMPISubCondFT {
    int ftVersion;
    CMPIStatus (*release)(CMPISubCond* sub);
    CMPISubCond* (*clone)(const CMPISubCond* sub, CMPIStatus* rc);
    CMPICount (*getCount)(const CMPISubCond* sub, CMPIStatus* rc);
    CMPIPredicate* (*getPredicateAt)(const CMPISubCond* sub, CMPICount index, CMPIStatus* rc);
    CMPIPredicate* (*getPredicate)(const CMPISubCond* sub, const char* name, CMPIStatus* rc);
};

struct _CMPIPredicateFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIPredicate* pred);
    CMPIPredicate* (*clone)(const CMPIPredicate* pred, CMPIStatus* rc);
    CMPIStatus (*getData)(const CMPIPredicate* pred, CMPIType* typeOut, CMPIPredOp* opOut, CMPIString** lhsOut,
                          CMPIString** rhsOut);
    CMPIBoolean (*evaluateUsingAccessor)(const CMPIPredicate* pred, CMPIAccessor* accessor, void* accessorArg,
                                         CMPIStatus* rc);
};

#ifdef CMPI_VER_200
struct _CMPIErrorFT {
    CMPISint32 ftVersion;
    CMPIStatus (*release)(CMPIError* err);
    CMPIError* (*clone)(const CMPIError* err, CMPIStatus* rc);
    CMPIErrorType (*getErrorType)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getOtherErrorType)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getOwningEntity)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getMessageID)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getMessage)(const CMPIError* err, CMPIStatus* rc);
    CMPIErrorSeverity (*getPerceivedSeverity)(const CMPIError* err, CMPIStatus* rc);
    CMPIErrorProbableCause (*getProbableCause)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getProbableCauseDescription)(const CMPIError* err, CMPIStatus* rc);
    CMPIArray* (*getRecommendedActions)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getErrorSource)(const CMPIError* err, CMPIStatus* rc);
    CMPIErrorSrcFormat (*getErrorSourceFormat)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getOtherErrorSourceFormat)(const CMPIError* err, CMPIStatus* rc);
    CMPIrc (*getCIMStatusCode)(const CMPIError* err, CMPIStatus* rc);
    CMPIString* (*getCIMStatusCodeDescription)(const CMPIError* err, CMPIStatus* rc);
    CMPIArray* (*getMessageArguments)(const CMPIError* err, CMPIStatus* rc);
    CMPIStatus (*setErrorType)(CMPIError* err, CMPIErrorType errorType);
    CMPIStatus (*setOtherErrorType)(CMPIError* err, const char* text);
    CMPIStatus (*setProbableCauseDescription)(CMPIError* err, const char* text);
    CMPIStatus (*setRecommendedActions)(CMPIError* err, const CMPIArray* array);
    CMPIStatus (*setErrorSource)(CMPIError* err, const char* text);
    CMPIStatus (*setErrorSourceFormat)(CMPIError* err, CMPIErrorSrcFormat format);
    CMPIStatus (*setOtherErrorSourceFormat)(CMPIError* err, const char* text);
    CMPIStatus (*setCIMStatusCodeDescription)(CMPIError* err, const char* text);
    CMPIStatus (*setMessageArguments)(CMPIError* err, CMPIArray* array);
};
#endif

struct _CMPIInstanceMIFT {
    int ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIInstanceMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*enumerateInstanceNames)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                         const CMPIObjectPath* path);
    CMPIStatus (*enumerateInstances)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                     const CMPIObjectPath* path, const char** propList);
    CMPIStatus (*getInstance)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                              const CMPIObjectPath* path, const char** propList);
    CMPIStatus (*createInstance)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                 const CMPIObjectPath* path, const CMPIInstance* inst);
    CMPIStatus (*modifyInstance)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                 const CMPIObjectPath* path, const CMPIInstance* inst, const char** propList);
    CMPIStatus (*deleteInstance)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                 const CMPIObjectPath* path);
    CMPIStatus (*execQuery)(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                            const CMPIObjectPath* path, const char* query, const char* lang);
};

struct _CMPIAssociationMIFT {
    int ftVersion;
    CMPISint32 miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIAssociationMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*associators)(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                              const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                              const char* role, const char* resultRole, const char** propList);
    CMPIStatus (*associatorNames)(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                  const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                                  const char* role, const char* resultRole);
    CMPIStatus (*references)(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                             const CMPIObjectPath* path, const char* resultClass, const char* role,
                             const char** propList);
    CMPIStatus (*referenceNames)(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                 const CMPIObjectPath* path, const char* resultClass, const char* role);
};

struct _CMPIMethodMIFT {
    int ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIMethodMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*invokeMethod)(CMPIMethodMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                               const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out);
};

struct _CMPIPropertyMIFT {
    int ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIPropertyMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*setProperty)(CMPIPropertyMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                              const CMPIObjectPath* path, const char* name, CMPIData data);
    CMPIStatus (*getProperty)(CMPIPropertyMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                              const CMPIObjectPath* path, const char* name);
#ifdef CMPI_VER_200
    CMPIStatus (*setPropertyWithOrigin)(CMPIPropertyMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                        CMPIObjectPath* path, const char* name, CMPIData data, const char* originClass);
#endif
};

struct _CMPIIndicationMIFT {
    int ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIIndicationMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*authorizeFilter)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                                  const char* className, const CMPIObjectPath* classPath, const char* owner);
    CMPIStatus (*mustPoll)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                           const char* className, const CMPIObjectPath* classPath);
    CMPIStatus (*activateFilter)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                                 const char* className, const CMPIObjectPath* classPath, CMPIBoolean firstActivation);
    CMPIStatus (*deActivateFilter)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                                   const char* className, const CMPIObjectPath* classPath,
                                   CMPIBoolean lastDeactivation);
    CMPIStatus (*enableIndications)(CMPIIndicationMI* mi, const CMPIContext* ctx);
    CMPIStatus (*disableIndications)(CMPIIndicationMI* mi, const CMPIContext* ctx);
};

#ifdef __cplusplus
}
#endif

#include "cmpimacs.h"

#endif
