/* A provider for the tests of the object manager. The class or method asked for chooses what it does. */
#include <cmpift.h>

#include <stdint.h>
#include <string.h>

static const CMPIBroker* broker;

static const char* classOf(const CMPIObjectPath* path) {
    return CMGetCharPtr(CMGetClassName(path, NULL));
}

static int asked(const CMPIObjectPath* path, const char* name) {
    return strcmp(classOf(path), name) == 0;
}

static CMPIObjectPath* newPath(const CMPIObjectPath* request, const char* name) {
    CMPIObjectPath* path = CMNewObjectPath(broker, CMGetCharPtr(CMGetNameSpace(request, NULL)), classOf(request), NULL);
    CMAddKey(path, "Name", name, CMPI_chars);
    return path;
}

static CMPIInstance* newThing(const CMPIObjectPath* request, const char* name) {
    CMPIInstance* instance = CMNewInstance(broker, newPath(request, name), NULL);
    CMPIUint16 states[] = {2, 11};
    CMPIArray* array = CMNewArray(broker, 2, CMPI_uint16, NULL);
    CMSetArrayElementAt(array, 0, &states[0], CMPI_uint16);
    CMSetArrayElementAt(array, 1, &states[1], CMPI_uint16);
    CMSetProperty(instance, "Name", name, CMPI_chars);
    CMSetProperty(instance, "States", &array, CMPI_uint16A);
    return instance;
}

static void setText(CMPIInstance* instance, const char* name, const char* text) {
    if (text) CMSetProperty(instance, name, text, CMPI_chars);
}

/* What the provider was asked, as properties. */
static void setProperties(CMPIInstance* instance, const char** list) {
    CMPIUint32 count = 0;
    if (!list) return;
    for (; list[count]; ++count) setText(instance, list[count], "asked for");
    CMSetProperty(instance, "ListLength", &count, CMPI_uint32);
}

static CMPIStatus TestCleanup(CMPIInstanceMI* mi, const CMPIContext* ctx, CMPIBoolean terminating) {
    (void)mi, (void)ctx, (void)terminating;
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestEnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                        const CMPIObjectPath* path) {
    (void)mi, (void)ctx;
    if (asked(path, "Test_Denied")) CMReturnWithChars(broker, CMPI_RC_ERR_ACCESS_DENIED, "not you");
    CMReturnObjectPath(rslt, newPath(path, "a"));
    CMReturnObjectPath(rslt, newPath(path, "b"));
    if (!asked(path, "Test_Open")) CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestEnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                    const CMPIObjectPath* path, const char** properties) {
    (void)mi, (void)ctx, (void)properties;
    CMReturnInstance(rslt, newThing(path, "a"));
    CMReturnInstance(rslt, newThing(path, "b"));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

/* Answers the instance of the key Name; keyless or unknown, nothing. */
static CMPIStatus TestGetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                  const CMPIObjectPath* path, const char** properties) {
    CMPIStatus status = {CMPI_RC_OK, NULL};
    CMPIData name = CMGetKey(path, "name", &status);
    (void)mi;
    if (asked(path, "Test_Endless")) {
        CBGetInstance(broker, ctx, path, NULL, &status);
        return status;
    }
    if (status.rc == CMPI_RC_OK && strlen(CMGetCharPtr(name.value.string)) == 1) {
        CMPIInstance* instance = newThing(path, CMGetCharPtr(name.value.string));
        CMPIUint32 flags = CMGetContextEntry(ctx, CMPIInvocationFlags, NULL).value.uint32;
        CMSetProperty(instance, "Flags", &flags, CMPI_uint32);
        if (!asked(path, "Test_Bare")) setProperties(instance, properties);
        CMReturnInstance(rslt, instance);
        if (asked(path, "Test_Twice")) CMReturnInstance(rslt, instance);
    }
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestCreateInstance(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                     const CMPIObjectPath* path, const CMPIInstance* instance) {
    CMPIObjectPath* made = newPath(path, CMGetCharPtr(CMGetProperty(instance, "Name", NULL).value.string));
    (void)mi, (void)ctx;
    CMReturnObjectPath(rslt, made);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestModifyInstance(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                     const CMPIObjectPath* path, const CMPIInstance* instance, const char** list) {
    CMPIData value = CMGetProperty(instance, "Speed", NULL);
    (void)mi, (void)ctx, (void)path;
    if (CMIsNullValue(value) || value.type != CMPI_uint32 || value.value.uint32 != 7 || !list ||
        strcmp(list[0], "Speed") != 0)
        CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestDeleteInstance(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                     const CMPIObjectPath* path) {
    (void)mi, (void)ctx, (void)rslt, (void)path;
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

static CMPIStatus TestExecQuery(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                const CMPIObjectPath* path, const char* query, const char* lang) {
    CMPIInstance* instance = CMNewInstance(broker, CMNewObjectPath(broker, "root/q", "Test_Row", NULL), NULL);
    (void)mi, (void)ctx, (void)path;
    setText(instance, "Query", query);
    setText(instance, "Language", lang);
    CMReturnInstance(rslt, instance);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

CMInstanceMIStub(Test, Test, broker, CMNoHook)

    static CMPIStatus TestAssociationCleanup(CMPIAssociationMI* mi, const CMPIContext* ctx, CMPIBoolean terminating) {
    (void)mi, (void)ctx, (void)terminating;
    CMReturn(CMPI_RC_OK);
}

static CMPIInstance* filters(const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                             const char* role, const char* resultRole, const char** properties) {
    CMPIInstance* instance = CMNewInstance(broker, path, NULL);
    setText(instance, "AssocClass", assocClass);
    setText(instance, "ResultClass", resultClass);
    setText(instance, "Role", role);
    setText(instance, "ResultRole", resultRole);
    setProperties(instance, properties);
    return instance;
}

static CMPIStatus TestAssociators(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                  const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                                  const char* role, const char* resultRole, const char** properties) {
    (void)mi, (void)ctx;
    CMReturnInstance(rslt, filters(path, assocClass, resultClass, role, resultRole, properties));
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestAssociatorNames(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                      const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                                      const char* role, const char* resultRole) {
    (void)mi, (void)ctx, (void)assocClass, (void)resultClass, (void)role;
    CMReturnObjectPath(rslt, newPath(path, resultRole ? resultRole : "none"));
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestReferences(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                 const CMPIObjectPath* path, const char* resultClass, const char* role,
                                 const char** properties) {
    (void)mi, (void)ctx;
    CMReturnInstance(rslt, filters(path, NULL, resultClass, role, NULL, properties));
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus TestReferenceNames(CMPIAssociationMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                     const CMPIObjectPath* path, const char* resultClass, const char* role) {
    (void)mi, (void)ctx, (void)resultClass;
    CMReturnObjectPath(rslt, newPath(path, role ? role : "none"));
    CMReturn(CMPI_RC_OK);
}

CMAssociationMIStub(Test, Test, broker, CMNoHook)

    static CMPIStatus TestMethodCleanup(CMPIMethodMI* mi, const CMPIContext* ctx, CMPIBoolean terminating) {
    (void)mi, (void)ctx, (void)terminating;
    CMReturn(CMPI_RC_OK);
}

/* Gives every argument back, in order, and their number. */
static CMPIUint32 echo(const CMPIArgs* in, CMPIArgs* out) {
    CMPICount count = CMGetArgCount(in, NULL);
    for (CMPICount i = 0; i < count; ++i) {
        CMPIString* name = NULL;
        CMPIData data = CMGetArgAt(in, i, &name, NULL);
        CMAddArg(out, CMGetCharPtr(name), CMIsNullValue(data) ? NULL : &data.value, data.type);
    }
    return count;
}

/* Calls itself through the object manager: how many instances and names there are, and the first one's name. */
static CMPIUint32 askBroker(const CMPIContext* ctx, const CMPIObjectPath* path, CMPIArgs* out) {
    CMPIStatus status = {CMPI_RC_OK, NULL};
    CMPIUint32 count = 0;
    CMPIEnumeration* names = CBEnumInstanceNames(broker, ctx, path, &status);
    while (names && CMHasNext(names, NULL)) {
        CMPIData name = CMGetNext(names, &status);
        CMPIInstance* instance = CBGetInstance(broker, ctx, name.value.ref, NULL, &status);
        CMPIData key = CMGetProperty(instance, "Name", &status);
        CMAddArg(out, CMGetCharPtr(key.value.string), &instance, CMPI_instance);
        ++count;
    }
    return count;
}

struct Work {
    CMPIContext* ctx;
    CMPIUint32 result;
};

static CMPI_THREAD_RETURN CMPI_THREAD_CDECL work(void* parameter) {
    struct Work* job = parameter;
    if (CBAttachThread(broker, job->ctx).rc != CMPI_RC_OK) return NULL;
    for (CMPIUint32 i = 0; i < 50; ++i) {
        CMPIString* text = CMNewString(broker, "made on another thread", NULL);
        if (text && strcmp(CMGetCharPtr(text), "made on another thread") == 0) ++job->result;
    }
    CBDetachThread(broker, job->ctx);
    return NULL;
}

static CMPIUint32 runThread(const CMPIContext* ctx) {
    struct Work job = {CBPrepareAttachThread(broker, ctx), 0};
    CMPI_THREAD_TYPE thread = broker->xft->newThread(work, &job, 0);
    broker->xft->joinThread(thread, NULL);
    return job.result;
}

static CMPIStatus TestInvokeMethod(CMPIMethodMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                   const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out) {
    CMPIUint32 value = 0;
    (void)mi;
    if (strcmp(method, "Echo") == 0) {
        value = echo(in, out);
    } else if (strcmp(method, "AskBroker") == 0) {
        value = askBroker(ctx, path, out);
    } else if (strcmp(method, "RunThread") == 0) {
        value = runThread(ctx);
    } else {
        CMReturnWithChars(broker, CMPI_RC_ERR_METHOD_NOT_FOUND, method);
    }
    CMReturnData(rslt, &value, CMPI_uint32);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

CMMethodMIStub(Test, Test, broker, CMNoHook)

    /* Factories that fail in every way. */
    CMPI_EXTERN_C CMPIInstanceMI* Null_Create_InstanceMI(const CMPIBroker* brkr, const CMPIContext* ctx,
                                                         CMPIStatus* rc) {
    (void)brkr, (void)ctx, (void)rc;
    return NULL;
}

CMPI_EXTERN_C CMPIInstanceMI* Failing_Create_InstanceMI(const CMPIBroker* brkr, const CMPIContext* ctx,
                                                        CMPIStatus* rc) {
    CMSetStatusWithChars(brkr, rc, CMPI_RC_ERR_ACCESS_DENIED, "no licence");
    return Test_Create_InstanceMI(brkr, ctx, NULL);
}

CMPI_EXTERN_C CMPIInstanceMI* Old_Create_InstanceMI(const CMPIBroker* brkr, const CMPIContext* ctx, CMPIStatus* rc) {
    static CMPIInstanceMIFT old = {90, 90, "old", NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL};
    static CMPIInstanceMI mi = {NULL, &old};
    (void)brkr, (void)ctx, (void)rc;
    return &mi;
}

CMPI_EXTERN_C CMPIInstanceMI* Empty_Create_InstanceMI(const CMPIBroker* brkr, const CMPIContext* ctx, CMPIStatus* rc) {
    static CMPIInstanceMIFT empty = {100, 100, "empty", NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL};
    static CMPIInstanceMI mi = {NULL, &empty};
    (void)brkr, (void)ctx, (void)rc;
    return &mi;
}
