/*
 * A provider made with the stubs, in plain C, that records which of its functions was called and with what. It also
 * compiles as C++.
 */
#include "ProbeProvider.h"

#include <stddef.h>

static struct ProbeFacts facts;

CMPI_EXTERN_C struct ProbeFacts* probeFacts(void) {
    return &facts;
}

static CMPIStatus note(const char* function, const void* const* arguments, size_t count) {
    size_t i;
    facts.called = function;
    facts.count = count;
    for (i = 0; i < count; ++i) facts.arguments[i] = arguments[i];
    CMReturn(CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED);
}

/* A function of the provider: its name, its parameters and the same as pointers. */
#define FUNCTION(name, parameters, ...)                                                                                \
    static CMPIStatus name parameters {                                                                                \
        const void* const arguments[] = {__VA_ARGS__};                                                                 \
        return note(#name, arguments, sizeof arguments / sizeof arguments[0]);                                         \
    }
#define START(kind) CMPI##kind##MI *mi, const CMPIContext *ctx
#define REQUEST(kind) START(kind), const CMPIResult *rslt, const CMPIObjectPath *path

FUNCTION(probeCleanup, (START(Instance), CMPIBoolean terminating), mi, ctx, terminating ? mi : NULL)
FUNCTION(probeEnumInstanceNames, (REQUEST(Instance)), mi, ctx, rslt, path)
FUNCTION(probeEnumInstances, (REQUEST(Instance), const char** list), mi, ctx, rslt, path, list)
FUNCTION(probeGetInstance, (REQUEST(Instance), const char** list), mi, ctx, rslt, path, list)
FUNCTION(probeCreateInstance, (REQUEST(Instance), const CMPIInstance* inst), mi, ctx, rslt, path, inst)
FUNCTION(probeModifyInstance, (REQUEST(Instance), const CMPIInstance* inst, const char** list), mi, ctx, rslt, path,
         inst, list)
FUNCTION(probeDeleteInstance, (REQUEST(Instance)), mi, ctx, rslt, path)
FUNCTION(probeExecQuery, (REQUEST(Instance), const char* query, const char* language), mi, ctx, rslt, path, query,
         language)

FUNCTION(probeAssociationCleanup, (START(Association), CMPIBoolean terminating), mi, ctx, terminating ? mi : NULL)
FUNCTION(probeAssociators,
         (REQUEST(Association), const char* association, const char* result, const char* role, const char* resultRole,
          const char** list),
         mi, ctx, rslt, path, association, result, role, resultRole, list)
FUNCTION(probeAssociatorNames,
         (REQUEST(Association), const char* association, const char* result, const char* role, const char* resultRole),
         mi, ctx, rslt, path, association, result, role, resultRole)
FUNCTION(probeReferences, (REQUEST(Association), const char* result, const char* role, const char** list), mi, ctx,
         rslt, path, result, role, list)
FUNCTION(probeReferenceNames, (REQUEST(Association), const char* result, const char* role), mi, ctx, rslt, path, result,
         role)

FUNCTION(probeMethodCleanup, (START(Method), CMPIBoolean terminating), mi, ctx, terminating ? mi : NULL)
FUNCTION(probeInvokeMethod, (REQUEST(Method), const char* method, const CMPIArgs* in, CMPIArgs* out), mi, ctx, rslt,
         path, method, in, out)

FUNCTION(probePropertyCleanup, (START(Property), CMPIBoolean terminating), mi, ctx, terminating ? mi : NULL)
FUNCTION(probeSetProperty, (REQUEST(Property), const char* name, CMPIData data), mi, ctx, rslt, path, name,
         data.value.chars)
FUNCTION(probeGetProperty, (REQUEST(Property), const char* name), mi, ctx, rslt, path, name)

#define FILTER START(Indication), const CMPISelectExp *filter, const char *className, const CMPIObjectPath *classPath
FUNCTION(probeIndicationCleanup, (START(Indication), CMPIBoolean terminating), mi, ctx, terminating ? mi : NULL)
FUNCTION(probeAuthorizeFilter, (FILTER, const char* owner), mi, ctx, filter, className, classPath, owner)
FUNCTION(probeMustPoll, (FILTER), mi, ctx, filter, className, classPath)
FUNCTION(probeActivateFilter, (FILTER, CMPIBoolean first), mi, ctx, filter, className, classPath, first ? mi : NULL)
FUNCTION(probeDeActivateFilter, (FILTER, CMPIBoolean last), mi, ctx, filter, className, classPath, last ? mi : NULL)
FUNCTION(probeEnableIndications, (START(Indication)), mi, ctx)
FUNCTION(probeDisableIndications, (START(Indication)), mi, ctx)

/* Called by the method stub's hook; fails without a context. */
static CMPIStatus probeMethodInitialize(CMPIMethodMI* mi, const CMPIContext* ctx) {
    mi->hdl = &facts;
    if (ctx == NULL) CMReturn(CMPI_RC_ERR_ACCESS_DENIED);
    CMReturn(CMPI_RC_OK);
}

/* A hook of several statements, with a comma that is not in parentheses. */
#define PROPERTY_HOOK                                                                                                  \
    int one = 1, two = 2;                                                                                              \
    facts.hookSum = one + two

/* clang-format off */
CMInstanceMIStub(probe, Probe, facts.broker, facts.brokerInHook = facts.broker)
CMAssociationMIStub(probe, Probe, facts.broker, CMNoHook)
CMMethodMIStub(probe, Probe, facts.broker, CMInitHook(probe, Method))
CMPropertyMIStub(probe, Probe, facts.broker, PROPERTY_HOOK)
CMIndicationMIStub(probe, Probe, facts.broker, if (brkr && rc) mi.hdl = (void*)rc)
