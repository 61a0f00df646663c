/*
 * A provider that looks at nothing and says nothing: it returns prepared answers with the broker calls that they take
 * and no others. What a request costs with it in an object manager is the floor for any provider there.
 *
 * The answers stand in a file beside the library, "LIBRARY.answers", one thing a line, its words parted by tabs:
 *   request   OPERATION CLASS      what follows answers this operation on this class or association
 *   path      CLASS                an object path, or with properties an instance
 *   key       NAME TYPE VALUE
 *   property  NAME TYPE VALUE      TYPE is string, datetime, boolean, uint8 to uint64 or sint8 to sint64
 *   array     NAME TYPE VALUE...
 */
#define _GNU_SOURCE
#include <cmpift.h>
#include <cmpimacs.h>

#include <dlfcn.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

enum { maximumWords = 64, maximumLine = 8192 };

struct Line {
    char* words[maximumWords + 1]; /* a null behind the last */
    struct Line* next;
};

static const CMPIBroker* broker;
static struct Line* lines;

static struct Line* readLine(char* text) {
    struct Line* line = calloc(1, sizeof *line);
    char* rest = strdup(text);
    int i;
    if (line == NULL || rest == NULL) abort();
    for (i = 0; i < maximumWords && rest != NULL; ++i) line->words[i] = strsep(&rest, "\t\n");
    return line;
}

static void readAnswers(void) {
    char name[4096], text[maximumLine];
    struct Line** end = &lines;
    Dl_info library;
    FILE* file;
    if (lines != NULL || dladdr(&lines, &library) == 0) return;
    snprintf(name, sizeof name, "%s.answers", library.dli_fname);
    file = fopen(name, "re");
    if (file == NULL) return;
    while (fgets(text, sizeof text, file) != NULL) {
        text[strcspn(text, "\n")] = '\0';
        *end = readLine(text);
        end = &(*end)->next;
    }
    fclose(file);
}

static const struct Line* answerTo(const char* operation, const char* className) {
    const struct Line* line;
    for (line = lines; line != NULL; line = line->next)
        if (strcmp(line->words[0], "request") == 0 && strcmp(line->words[1], operation) == 0 &&
            strcasecmp(line->words[2], className) == 0)
            return line->next;
    return NULL;
}

static CMPIType typeOf(const char* word) {
    static const struct {
        const char* word;
        CMPIType type;
    } types[] = {{"string", CMPI_string}, {"datetime", CMPI_dateTime}, {"boolean", CMPI_boolean}, {"uint8", CMPI_uint8},
                 {"uint16", CMPI_uint16}, {"uint32", CMPI_uint32},     {"uint64", CMPI_uint64},   {"sint8", CMPI_sint8},
                 {"sint16", CMPI_sint16}, {"sint32", CMPI_sint32},     {"sint64", CMPI_sint64}};
    size_t i;
    for (i = 0; i < sizeof types / sizeof *types; ++i)
        if (strcmp(types[i].word, word) == 0) return types[i].type;
    return CMPI_null;
}

static CMPIValue valueOf(CMPIType type, const char* text) {
    CMPIValue value;
    memset(&value, 0, sizeof value);
    switch (type) {
    case CMPI_string:
        value.string = CMNewString(broker, text, NULL);
        break;
    case CMPI_dateTime:
        value.dateTime = CMNewDateTimeFromChars(broker, text, NULL);
        break;
    case CMPI_boolean:
        value.boolean = strcasecmp(text, "true") == 0;
        break;
    default: /* little-endian machines: the low bytes are those of the smaller types */
        value.uint64 = strtoull(text, NULL, 10);
    }
    return value;
}

static CMPIValue arrayOf(CMPIType type, char* const* words) {
    CMPIValue value;
    CMPICount count = 0, i;
    while (words[count] != NULL) ++count;
    value.array = CMNewArray(broker, count, type, NULL);
    for (i = 0; i < count; ++i) {
        const CMPIValue element = valueOf(type, words[i]);
        CMSetArrayElementAt(value.array, i, &element, type);
    }
    return value;
}

static void addKey(CMPIObjectPath* path, const struct Line* line) {
    const CMPIType type = typeOf(line->words[2]);
    if (type == CMPI_string) {
        CMAddKey(path, line->words[1], (const CMPIValue*)line->words[3], CMPI_chars);
    } else {
        const CMPIValue value = valueOf(type, line->words[3]);
        CMAddKey(path, line->words[1], &value, type);
    }
}

static void setProperty(CMPIInstance* instance, const struct Line* line) {
    const CMPIType type = typeOf(line->words[2]);
    if (strcmp(line->words[0], "array") == 0) {
        const CMPIValue value = arrayOf(type, line->words + 3);
        CMSetProperty(instance, line->words[1], &value, type | CMPI_ARRAY);
    } else if (type == CMPI_string) {
        CMSetProperty(instance, line->words[1], (const CMPIValue*)line->words[3], CMPI_chars);
    } else {
        const CMPIValue value = valueOf(type, line->words[3]);
        CMSetProperty(instance, line->words[1], &value, type);
    }
}

static CMPIStatus answer(const CMPIResult* result, const char* nameSpace, const char* operation,
                         const char* className) {
    const struct Line* line = answerTo(operation, className);
    if (line == NULL) CMReturn(CMPI_RC_ERR_NOT_FOUND);
    while (line != NULL && strcmp(line->words[0], "path") == 0) {
        CMPIObjectPath* path = CMNewObjectPath(broker, nameSpace, line->words[1], NULL);
        CMPIInstance* instance = NULL;
        for (line = line->next; line != NULL && strcmp(line->words[0], "key") == 0; line = line->next)
            addKey(path, line);
        for (; line != NULL && (strcmp(line->words[0], "property") == 0 || strcmp(line->words[0], "array") == 0);
             line = line->next) {
            if (instance == NULL) instance = CMNewInstance(broker, path, NULL);
            setProperty(instance, line);
        }
        if (instance != NULL)
            CMReturnInstance(result, instance);
        else
            CMReturnObjectPath(result, path);
    }
    CMReturnDone(result);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus answerOf(const CMPIResult* result, const CMPIObjectPath* path, const char* operation,
                           const char* association) {
    const CMPIString* nameSpace = CMGetNameSpace(path, NULL);
    const CMPIString* className = CMGetClassName(path, NULL);
    return answer(result, CMGetCharPtr(nameSpace), operation,
                  association != NULL ? association : CMGetCharPtr(className));
}

#define ignored __attribute__((unused))

static CMPIStatus benchCleanup(CMPIInstanceMI* mi ignored, const CMPIContext* context ignored,
                               CMPIBoolean ending ignored) {
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus benchAssociationCleanup(CMPIAssociationMI* mi ignored, const CMPIContext* context ignored,
                                          CMPIBoolean ending ignored) {
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus benchNames(CMPIInstanceMI* mi ignored, const CMPIContext* context ignored, const CMPIResult* result,
                             const CMPIObjectPath* path) {
    return answerOf(result, path, "EnumerateInstanceNames", NULL);
}

static CMPIStatus benchInstances(CMPIInstanceMI* mi ignored, const CMPIContext* context ignored,
                                 const CMPIResult* result, const CMPIObjectPath* path,
                                 const char** properties ignored) {
    return answerOf(result, path, "EnumerateInstances", NULL);
}

static CMPIStatus benchGet(CMPIInstanceMI* mi ignored, const CMPIContext* context ignored, const CMPIResult* result,
                           const CMPIObjectPath* path, const char** properties ignored) {
    return answerOf(result, path, "GetInstance", NULL);
}

static CMPIStatus benchAssociators(CMPIAssociationMI* mi ignored, const CMPIContext* context ignored,
                                   const CMPIResult* result, const CMPIObjectPath* path, const char* association,
                                   const char* resultClass ignored, const char* role ignored,
                                   const char* resultRole ignored, const char** properties ignored) {
    return answerOf(result, path, "Associators", association);
}

static CMPIStatus benchAssociatorNames(CMPIAssociationMI* mi ignored, const CMPIContext* context ignored,
                                       const CMPIResult* result, const CMPIObjectPath* path, const char* association,
                                       const char* resultClass ignored, const char* role ignored,
                                       const char* resultRole ignored) {
    return answerOf(result, path, "AssociatorNames", association);
}

static CMPIStatus benchMethodCleanup(CMPIMethodMI* mi ignored, const CMPIContext* context ignored,
                                     CMPIBoolean ending ignored) {
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus benchInvoke(CMPIMethodMI* mi ignored, const CMPIContext* context ignored,
                              const CMPIResult* result ignored, const CMPIObjectPath* path ignored,
                              const char* method ignored, const CMPIArgs* in ignored, CMPIArgs* out ignored) {
    CMReturn(CMPI_RC_ERR_METHOD_NOT_AVAILABLE);
}

static void start(const CMPIBroker* theBroker, CMPIStatus* status) {
    broker = theBroker;
    readAnswers();
    CMSetStatus(status, CMPI_RC_OK);
}

CMPIInstanceMI* VKRef_Create_InstanceMI(const CMPIBroker* theBroker, const CMPIContext* context ignored,
                                        CMPIStatus* status) {
    static CMPIInstanceMIFT table = {.ftVersion = 200,
                                     .miVersion = 200,
                                     .miName = "instanceVKRef",
                                     .cleanup = benchCleanup,
                                     .enumerateInstanceNames = benchNames,
                                     .enumerateInstances = benchInstances,
                                     .getInstance = benchGet};
    static CMPIInstanceMI mi = {NULL, &table};
    start(theBroker, status);
    return &mi;
}

CMPIAssociationMI* VKRef_Create_AssociationMI(const CMPIBroker* theBroker, const CMPIContext* context ignored,
                                              CMPIStatus* status) {
    static CMPIAssociationMIFT table = {.ftVersion = 200,
                                        .miVersion = 200,
                                        .miName = "associationVKRef",
                                        .cleanup = benchAssociationCleanup,
                                        .associators = benchAssociators,
                                        .associatorNames = benchAssociatorNames};
    static CMPIAssociationMI mi = {NULL, &table};
    start(theBroker, status);
    return &mi;
}

/* Registered because classes have methods; none is measured. */
CMPIMethodMI* VKRef_Create_MethodMI(const CMPIBroker* theBroker, const CMPIContext* context ignored,
                                    CMPIStatus* status) {
    static CMPIMethodMIFT table = {.ftVersion = 200,
                                   .miVersion = 200,
                                   .miName = "methodVKRef",
                                   .cleanup = benchMethodCleanup,
                                   .invokeMethod = benchInvoke};
    static CMPIMethodMI mi = {NULL, &table};
    start(theBroker, status);
    return &mi;
}
