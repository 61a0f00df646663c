/*
 * CMPI function tables and the objects that carry them.
 *
 * What holds for every table:
 * - ftVersion is the CMPI version its maker wrote it to. Slots that a later version added come last; look at the number
 *   before touching them.
 * - A CMPIStatus* rc or a ...Out pointer may be null: the answer is then not wanted. Otherwise *rc is always written.
 * - A failing function returns null, 0 or CMPI_null, according to its type.
 * - What a broker's function returns is the broker's and lives until the request ends. What clone returns is a copy of
 *   the caller's own, which lives until release and may be kept between requests. Releasing what a new... function made
 *   only ends it early; releasing what the provider was called with does nothing.
 * - Objects that a provider is called with are the broker's and last for that call; clone what is to be kept.
 * - A value is passed as a pointer to a CMPIValue or to a plain variable of the type named beside it; with CMPI_chars
 *   the pointer is the text itself. A null pointer means null. Values are copied.
 * - Names of properties, keys, arguments and classes match without regard to case. Indexes start at 0.
 * - A property list is an array of names that ends with a null pointer; no list means all properties.
 * - Nothing may be thrown through a slot.
 */
#ifndef _CMPIFT_H_
#define _CMPIFT_H_

#include "cmpidt.h"
#include "cmpios.h"

#ifdef __cplusplus
extern "C" {
#endif

struct timespec;

/*
 * Objects. A broker usually keeps more behind these two words. hdl is its maker's and is never null in a live object;
 * in a CMPIString it points to the text, which macros compiled into old providers read directly.
 */

/* What is known of the request: flags, user, languages. */
struct _CMPIContext {
    void* hdl;
    CMPIContextFT* ft;
};

/* Takes what a provider answers. */
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

/* A point in time or an interval. */
struct _CMPIDateTime {
    void* hdl;
    CMPIDateTimeFT* ft;
};

/* A query, its condition in normal form, the parts of that, and their comparisons. */
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
/* What a status cannot say of a failure. */
struct _CMPIError {
    void* hdl;
    CMPIErrorFT* ft;
};
#endif

/* The parts of a provider. hdl is the provider's own and may be null. */
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

/* What the broker offers to providers; it stays valid as long as the provider is loaded. */
struct _CMPIBroker {
    void* hdl;
    CMPIBrokerFT* bft;
    CMPIBrokerEncFT* eft;
    CMPIBrokerExtFT* xft;
#ifdef CMPI_VER_200
    CMPIBrokerMemFT* mft; /* null without CMPI_MB_Supports_MemEnhancements */
#endif
};

/*
 * Facts about the broker, and requests to other providers through it. Results are the broker's. The context is the one
 * the provider was called with, or one of an attached thread.
 */
struct _CMPIBrokerFT {
    unsigned int brokerCapabilities; /* CMPI_MB_... bits */
    unsigned int brokerVersion;      /* the CMPI version of this table */
    const char* brokerName;

    /*
     * A thread of the provider's own may call the broker between attach and detach. Its parent prepares the context,
     * the thread passes that context to both, and detach ends it together with all that the thread made.
     */
    CMPIContext* (*prepareAttachThread)(const CMPIBroker* broker, const CMPIContext* ctx);
    CMPIStatus (*attachThread)(const CMPIBroker* broker, const CMPIContext* ctx);
    CMPIStatus (*detachThread)(const CMPIBroker* broker, const CMPIContext* ctx);

    /* Hand an event of namespace ns to whoever subscribed, if anybody did. */
    CMPIStatus (*deliverIndication)(const CMPIBroker* broker, const CMPIContext* ctx, const char* ns,
                                    const CMPIInstance* indication);

    /* Instances. Paths name a class to enumerate, create and query, and an instance otherwise. */
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

    /* What stands in association with the object at path. A null filter lets everything pass. */
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

    /* Call a method of the object at path; this returns its return value and fills out, which comes empty. */
    CMPIData (*invokeMethod)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                             const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus* rc);

    /* One property of the instance at path. */
    CMPIStatus (*setProperty)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                              const char* name, const CMPIValue* value, CMPIType type);
    CMPIData (*getProperty)(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* path,
                            const char* name, CMPIStatus* rc);
};

/* Makes objects, which the broker frees when the request ends, and serves messages, log and trace. */
struct _CMPIBrokerEncFT {
    int ftVersion;

    /*
     * newInstance: starts with that path, which needs namespace and class. newString: copies the text.
     * newArray: of size null elements; type has no array bit. newDateTime: now.
     */
    CMPIInstance* (*newInstance)(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* rc);
    CMPIObjectPath* (*newObjectPath)(const CMPIBroker* broker, const char* ns, const char* cls, CMPIStatus* rc);
    CMPIArgs* (*newArgs)(const CMPIBroker* broker, CMPIStatus* rc);
    CMPIString* (*newString)(const CMPIBroker* broker, const char* text, CMPIStatus* rc);
    CMPIArray* (*newArray)(const CMPIBroker* broker, CMPICount size, CMPIType type, CMPIStatus* rc);
    CMPIDateTime* (*newDateTime)(const CMPIBroker* broker, CMPIStatus* rc);

    /* From microseconds since 1970 in UTC, or of length; from the 25 characters of a CIM datetime. */
    CMPIDateTime* (*newDateTimeFromBinary)(const CMPIBroker* broker, CMPIUint64 usec, CMPIBoolean isInterval,
                                           CMPIStatus* rc);
    CMPIDateTime* (*newDateTimeFromChars)(const CMPIBroker* broker, const char* text, CMPIStatus* rc);

    /* Parses a query. The projection is an array of the selected names, or null where everything is selected. */
    CMPISelectExp* (*newSelectExp)(const CMPIBroker* broker, const char* query, const char* lang,
                                   CMPIArray** projectionOut, CMPIStatus* rc);

    /* True where the class of path is cls or derives from it. */
    CMPIBoolean (*classPathIsA)(const CMPIBroker* broker, const CMPIObjectPath* path, const char* cls, CMPIStatus* rc);

    /* For debugging, of any object: a text, and its type by name ("CMPIInstance"). */
    CMPIString* (*toString)(const CMPIBroker* broker, const void* object, CMPIStatus* rc);
    CMPIBoolean (*isOfType)(const CMPIBroker* broker, const void* object, const char* typeName, CMPIStatus* rc);
    CMPIString* (*getType)(const CMPIBroker* broker, const void* object, CMPIStatus* rc);

    /*
     * The message of that id, or else the default text, with $0 ... $9 replaced by the inserts: up to ten pairs of a
     * type code and a value, as the CMFmt macros make them.
     */
    CMPIString* (*getMessage)(const CMPIBroker* broker, const char* msgId, const char* defaultText, CMPIStatus* rc,
                              CMPICount pairs, ...);

    /* Write to the broker's log and trace: the text, or where that is null the string. CMPISeverity, CMPILevel. */
    CMPIStatus (*logMessage)(const CMPIBroker* broker, int severity, const char* id, const char* text,
                             const CMPIString* stringObj);
    CMPIStatus (*trace)(const CMPIBroker* broker, int level, const char* component, const char* text,
                        const CMPIString* stringObj);
#ifdef CMPI_VER_200
    /* An error with these attributes, to be given to the result; the others start null or unknown. */
    CMPIError* (*newCMPIError)(const CMPIBroker* broker, const char* owner, const char* msgId, const char* text,
                               CMPIErrorSeverity severity, CMPIErrorProbableCause cause, CMPIrc cimStatus,
                               CMPIStatus* rc);

    /* A file of translations; its handle is null where there is none, which getMessage2 and close take as well. */
    CMPIStatus (*openMessageFile)(const CMPIBroker* broker, const char* file, CMPIMsgFileHandle* handleOut);
    CMPIStatus (*closeMessageFile)(const CMPIBroker* broker, CMPIMsgFileHandle handle);
    CMPIString* (*getMessage2)(const CMPIBroker* broker, const char* msgId, CMPIMsgFileHandle handle,
                               const char* defaultText, CMPIStatus* rc, CMPICount pairs, ...);
#endif
};

/* Services of the operating system. Those that return an int return 0 or an errno value. */
struct _CMPIBrokerExtFT {
    int ftVersion;

    /* The file name of a library ("X": "libX.so"), on the heap: the caller frees it. */
    char* (*resolveFileName)(const char* libName);

    /* Threads. A new one is not attached to the broker. null: failed. exitThread does not come back. */
    CMPI_THREAD_TYPE (*newThread)(CMPIThreadFunc start, void* arg, int detached);
    int (*joinThread)(CMPI_THREAD_TYPE thread, CMPI_THREAD_RETURN* retvalOut);
    int (*exitThread)(CMPI_THREAD_RETURN retval);
    int (*cancelThread)(CMPI_THREAD_TYPE thread);
    int (*threadSleep)(CMPIUint32 msec);
    int (*threadOnce)(int* once, CMPIThreadOnceFunc init); /* *once starts at 0 */

    /* Values that each thread has its own of; the destructor, where given, gets a thread's value when it ends. */
    int (*createThreadKey)(CMPI_THREAD_KEY_TYPE* keyOut, CMPIThreadKeyCleanupFunc destructor);
    int (*destroyThreadKey)(CMPI_THREAD_KEY_TYPE key);
    void* (*getThreadSpecific)(CMPI_THREAD_KEY_TYPE key);
    int (*setThreadSpecific)(CMPI_THREAD_KEY_TYPE key, void* value);

    /* Mutexes and conditions; opt is 0. until is an absolute time of the real-time clock. */
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
/* Memory, for providers that cannot wait for the request to end. */
struct _CMPIBrokerMemFT {
    int ftVersion;

    /* release frees every object made since that mark, but no clones. Marks nest. */
    CMPIGcStat* (*mark)(const CMPIBroker* broker, CMPIStatus* rc);
    CMPIStatus (*release)(const CMPIBroker* broker, const CMPIGcStat* mark);

    /* As malloc and its family. What is left is freed once the provider has been cleaned up. */
    void* (*cmpiMalloc)(const CMPIBroker* broker, size_t size);
    void* (*cmpiCalloc)(const CMPIBroker* broker, size_t count, size_t elemSize);
    void* (*cmpiRealloc)(const CMPIBroker* broker, void* ptr, size_t size);
    char* (*cmpiStrDup)(const CMPIBroker* broker, const char* text);
    void (*cmpiFree)(const CMPIBroker* broker, void* ptr);

    /* End an object from a new... function early. */
    void (*freeInstance)(const CMPIBroker* broker, CMPIInstance* inst);
    void (*freeObjectPath)(const CMPIBroker* broker, CMPIObjectPath* path);
    void (*freeArgs)(const CMPIBroker* broker, CMPIArgs* args);
    void (*freeString)(const CMPIBroker* broker, CMPIString* str);
    void (*freeArray)(const CMPIBroker* broker, CMPIArray* array);
    void (*freeDateTime)(const CMPIBroker* broker, CMPIDateTime* dt);
    void (*freeSelectExp)(const CMPIBroker* broker, CMPISelectExp* se);
};
#endif

/* Entries by name (CMPIPrincipal ...) or by index. addEntry adds or replaces. */
struct _CMPIContextFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIContext* ctx);
    CMPIContext* (*clone)(const CMPIContext* ctx, CMPIStatus* rc);
    CMPIData (*getEntry)(const CMPIContext* ctx, const char* name, CMPIStatus* rc);
    CMPIData (*getEntryAt)(const CMPIContext* ctx, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getEntryCount)(const CMPIContext* ctx, CMPIStatus* rc);
    CMPIStatus (*addEntry)(const CMPIContext* ctx, const char* name, const CMPIValue* value, CMPIType type);
};

/* The result copies what it is given at once. returnDone follows the last item. */
struct _CMPIResultFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIResult* rslt);
    CMPIResult* (*clone)(const CMPIResult* rslt, CMPIStatus* rc);
    CMPIStatus (*returnData)(const CMPIResult* rslt, const CMPIValue* value, CMPIType type);
    CMPIStatus (*returnInstance)(const CMPIResult* rslt, const CMPIInstance* inst);
    CMPIStatus (*returnObjectPath)(const CMPIResult* rslt, const CMPIObjectPath* path);
    CMPIStatus (*returnDone)(const CMPIResult* rslt);
#ifdef CMPI_VER_200
    /* May come more than once; the first one's status is what the provider then answers. */
    CMPIStatus (*returnError)(const CMPIResult* rslt, const CMPIError* err);
#endif
};

/* Host, namespace, class and keys. */
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

    /* Keys. addKey adds or replaces; a key is never null. */
    CMPIStatus (*addKey)(CMPIObjectPath* path, const char* name, const CMPIValue* value, CMPIType type);
    CMPIData (*getKey)(const CMPIObjectPath* path, const char* name, CMPIStatus* rc);
    CMPIData (*getKeyAt)(const CMPIObjectPath* path, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getKeyCount)(const CMPIObjectPath* path, CMPIStatus* rc);

    /* Take the namespace, or host and namespace, over from source. */
    CMPIStatus (*setNameSpaceFromObjectPath)(CMPIObjectPath* path, const CMPIObjectPath* source);
    CMPIStatus (*setHostAndNameSpaceFromObjectPath)(CMPIObjectPath* path, const CMPIObjectPath* source);

    /* Qualifiers of the class and its features. Brokers without CMPI_MB_BasicQualifierSupport may leave these null. */
    CMPIData (*getClassQualifier)(const CMPIObjectPath* path, const char* qualifier, CMPIStatus* rc);
    CMPIData (*getPropertyQualifier)(const CMPIObjectPath* path, const char* property, const char* qualifier,
                                     CMPIStatus* rc);
    CMPIData (*getMethodQualifier)(const CMPIObjectPath* path, const char* method, const char* qualifier,
                                   CMPIStatus* rc);
    CMPIData (*getParameterQualifier)(const CMPIObjectPath* path, const char* method, const char* parameter,
                                      const char* qualifier, CMPIStatus* rc);

    /* A readable form; the broker decides which. */
    CMPIString* (*toString)(const CMPIObjectPath* path, CMPIStatus* rc);
};

/* Properties by name or by index, and the instance's path. setProperty adds or replaces. */
struct _CMPIInstanceFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIInstance* inst);
    CMPIInstance* (*clone)(const CMPIInstance* inst, CMPIStatus* rc);
    CMPIData (*getProperty)(const CMPIInstance* inst, const char* name, CMPIStatus* rc);
    CMPIData (*getPropertyAt)(const CMPIInstance* inst, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getPropertyCount)(const CMPIInstance* inst, CMPIStatus* rc);
    CMPIStatus (*setProperty)(const CMPIInstance* inst, const char* name, const CMPIValue* value, CMPIType type);

    /* The path made of namespace, class and key properties. */
    CMPIObjectPath* (*getObjectPath)(const CMPIInstance* inst, CMPIStatus* rc);

    /* From now on setProperty ignores what is not in propList. No list: ignores nothing. */
    CMPIStatus (*setPropertyFilter)(CMPIInstance* inst, const char** propList, const char** keyList);

    /* Replaces the path. Whether key properties follow is up to the broker: set both. */
    CMPIStatus (*setObjectPath)(CMPIInstance* inst, const CMPIObjectPath* path);
#ifdef CMPI_VER_200
    /* As setProperty, and says which class brought the property in. */
    CMPIStatus (*setPropertyWithOrigin)(const CMPIInstance* inst, const char* name, const CMPIValue* value,
                                        CMPIType type, const char* originClass);
#endif
};

/* Parameters of a method by name or by index. addArg adds or replaces. */
struct _CMPIArgsFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIArgs* args);
    CMPIArgs* (*clone)(const CMPIArgs* args, CMPIStatus* rc);
    CMPIStatus (*addArg)(const CMPIArgs* args, const char* name, const CMPIValue* value, CMPIType type);
    CMPIData (*getArg)(const CMPIArgs* args, const char* name, CMPIStatus* rc);
    CMPIData (*getArgAt)(const CMPIArgs* args, CMPICount index, CMPIString** nameOut, CMPIStatus* rc);
    CMPICount (*getArgCount)(const CMPIArgs* args, CMPIStatus* rc);
};

/* The text stays the string's, is valid as long as it is and ends with a zero byte. */
struct _CMPIStringFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIString* str);
    CMPIString* (*clone)(const CMPIString* str, CMPIStatus* rc);
    const char* (*getCharPtr)(const CMPIString* str, CMPIStatus* rc);
};

/* A fixed number of elements of one type, which has no array bit. */
struct _CMPIArrayFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIArray* array);
    CMPIArray* (*clone)(const CMPIArray* array, CMPIStatus* rc);
    CMPICount (*getSize)(const CMPIArray* array, CMPIStatus* rc);
    CMPIType (*getSimpleType)(const CMPIArray* array, CMPIStatus* rc);
    CMPIData (*getElementAt)(const CMPIArray* array, CMPICount index, CMPIStatus* rc);
    CMPIStatus (*setElementAt)(CMPIArray* array, CMPICount index, const CMPIValue* value, CMPIType type);
};

/* Items one after the other. toArray gives those that are left. */
struct _CMPIEnumerationFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIEnumeration* en);
    CMPIEnumeration* (*clone)(const CMPIEnumeration* en, CMPIStatus* rc);
    CMPIData (*getNext)(const CMPIEnumeration* en, CMPIStatus* rc);
    CMPIBoolean (*hasNext)(const CMPIEnumeration* en, CMPIStatus* rc);
    CMPIArray* (*toArray)(const CMPIEnumeration* en, CMPIStatus* rc);
};

/* Microseconds since 1970 in UTC, or of length; the 25 characters of a CIM datetime. */
struct _CMPIDateTimeFT {
    int ftVersion;
    CMPIStatus (*release)(CMPIDateTime* dt);
    CMPIDateTime* (*clone)(const CMPIDateTime* dt, CMPIStatus* rc);
    CMPIUint64 (*getBinaryFormat)(const CMPIDateTime* dt, CMPIStatus* rc);
    CMPIString* (*getStringFormat)(const CMPIDateTime* dt, CMPIStatus* rc);
    CMPIBoolean (*isInterval)(const CMPIDateTime* dt, CMPIStatus* rc);
};

/* A query. The accessor supplies properties where there is no instance to look into. */
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

/* The parts of a condition; *typeOut is a CMPISelectCondType. They live as long as the query. */
struct _CMPISelectCondFT {
    int ftVersion;
    CMPIStatus (*release)(CMPISelectCond* sc);
    CMPISelectCond* (*clone)(const CMPISelectCond* sc, CMPIStatus* rc);
    CMPICount (*getCountAndType)(const CMPISelectCond* sc, int* typeOut, CMPIStatus* rc);
    CMPISubCond* (*getSubCondAt)(const CMPISelectCond* sc, CMPICount index, CMPIStatus* rc);
};

/* The comparisons of a part, by index or by the property on their left side. */
struct _CMPISubCondFT {
    int ftVersion;
    CMPIStatus (*release)(CMPISubCond* sub);
    CMPISubCond* (*clone)(const CMPISubCond* sub, CMPIStatus* rc);
    CMPICount (*getCount)(const CMPISubCond* sub, CMPIStatus* rc);
    CMPIPredicate* (*getPredicateAt)(const CMPISubCond* sub, CMPICount index, CMPIStatus* rc);
    CMPIPredicate* (*getPredicate)(const CMPISubCond* sub, const char* name, CMPIStatus* rc);
};

/* One comparison: the kind of its operands, its operator, and both sides as text. */
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
/* Attributes of an error. Those that newCMPIError takes cannot be changed. */
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

/*
 * The provider's side. The broker calls these slots, from several threads at once, with a context and a result of its
 * own. What all five tables have: the versions (see above; miVersion is the broker's version that the provider needs),
 * the provider's name, and cleanup. That comes before the library is unloaded, and alone: a provider that is not yet
 * ready for it returns CMPI_RC_DO_NOT_UNLOAD or CMPI_RC_NEVER_UNLOAD, which counts unless terminating is true.
 */

/* Instances of a class. */
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

/* What stands in association with the object at path. A null filter lets everything pass. */
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

/* Methods. The return value goes to the result, output parameters into out. */
struct _CMPIMethodMIFT {
    int ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIMethodMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*invokeMethod)(CMPIMethodMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                               const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out);
};

/* Single properties. */
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
    /* May be null. */
    CMPIStatus (*setPropertyWithOrigin)(CMPIPropertyMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                        CMPIObjectPath* path, const char* name, CMPIData data, const char* originClass);
#endif
};

/* Events. className is what the filter selects from, classPath that class's path; owner may be empty, not null. */
struct _CMPIIndicationMIFT {
    int ftVersion;
    int miVersion;
    const char* miName;
    CMPIStatus (*cleanup)(CMPIIndicationMI* mi, const CMPIContext* ctx, CMPIBoolean terminating);
    CMPIStatus (*authorizeFilter)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                                  const char* className, const CMPIObjectPath* classPath, const char* owner);

    /* Whether the broker is to poll. The number of its parameters differs between versions: better not called. */
    CMPIStatus (*mustPoll)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                           const char* className, const CMPIObjectPath* classPath);

    /* The flags are true for the first activation of a filter and for its last deactivation. */
    CMPIStatus (*activateFilter)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                                 const char* className, const CMPIObjectPath* classPath, CMPIBoolean firstActivation);
    CMPIStatus (*deActivateFilter)(CMPIIndicationMI* mi, const CMPIContext* ctx, const CMPISelectExp* filter,
                                   const char* className, const CMPIObjectPath* classPath,
                                   CMPIBoolean lastDeactivation);

    /* Whether the broker takes events. Null in providers compiled against headers that leave them out. */
    CMPIStatus (*enableIndications)(CMPIIndicationMI* mi, const CMPIContext* ctx);
    CMPIStatus (*disableIndications)(CMPIIndicationMI* mi, const CMPIContext* ctx);
};

#ifdef __cplusplus
}
#endif

#include "cmpimacs.h"

#endif
