// A provider that answers with what it was asked, for tests of the command line. The class asked for chooses more:
// Echo_Everything has every type, Echo_Fail and Echo_Odd answer errors, Echo_Flaky fails every second time,
// Echo_Crowd says how many calls were inside at once, Echo_Missing knows no instance, Echo_Quiet takes changes without
// a word, Echo_Crash ends the process. With ECHO_LOUD in the environment it prints on standard output in every way that
// there is.
#include <cmpift.h>

#include <atomic>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <string>
#include <thread>
#include <unistd.h>

namespace {

const CMPIBroker* broker;
std::atomic<unsigned> calls{0};
std::atomic<unsigned> inside{0};

void printLoudly() {
    if (std::getenv("ECHO_LOUD") == nullptr) return;
    const bool done = write(STDOUT_FILENO, "loud write\n", 11) == 11 && std::system("echo loud command") == 0;
    std::printf("loud buffer %d\n", done ? 1 : 0); // left in the buffer
}

/// Prints while the library is loaded and unloaded, too.
struct Loudness {
    Loudness() { printLoudly(); }
    ~Loudness() { printLoudly(); }
} const loudness;

std::string textOf(CMPIString* string) {
    const char* text = string ? string->ft->getCharPtr(string, nullptr) : nullptr;
    return text ? text : "";
}

std::string classOf(const CMPIObjectPath* path) {
    return textOf(path->ft->getClassName(path, nullptr));
}

CMPIStatus status(CMPIrc code, const char* message = nullptr) {
    return {code, message ? broker->eft->newString(broker, message, nullptr) : nullptr};
}

CMPIObjectPath* newPath(const CMPIObjectPath* request, const char* name, const char* className = nullptr) {
    const std::string nameSpace = textOf(request->ft->getNameSpace(request, nullptr));
    const std::string ownClass = className ? className : classOf(request);
    CMPIObjectPath* path = broker->eft->newObjectPath(broker, nameSpace.c_str(), ownClass.c_str(), nullptr);
    path->ft->addKey(path, "Name", reinterpret_cast<const CMPIValue*>(name), CMPI_chars);
    return path;
}

CMPIInstance* newInstance(const CMPIObjectPath* path) {
    return broker->eft->newInstance(broker, path, nullptr);
}

void setText(CMPIInstance* instance, const char* name, const char* text) {
    if (text) instance->ft->setProperty(instance, name, reinterpret_cast<const CMPIValue*>(text), CMPI_chars);
}

template <typename Member, typename Number>
void setNumber(CMPIInstance* instance, const char* name, Member CMPIValue::*member, Number number, CMPIType type) {
    CMPIValue value{};
    value.*member = static_cast<Member>(number);
    instance->ft->setProperty(instance, name, &value, type);
}

void setList(CMPIInstance* instance, const char** list) {
    if (!list) return;
    std::string names;
    for (; *list; ++list) names += std::string(*list) + ';';
    setText(instance, "PropertyList", names.c_str());
}

/// What was asked, as an instance.
CMPIInstance* echo(const CMPIObjectPath* path, const char* operation, const char** list) {
    CMPIInstance* instance = newInstance(path);
    setText(instance, "Operation", operation);
    setList(instance, list);
    const CMPICount count = path->ft->getKeyCount(path, nullptr);
    for (CMPICount i = 0; i < count; ++i) {
        CMPIString* name = nullptr;
        const CMPIData key = path->ft->getKeyAt(path, i, &name, nullptr);
        instance->ft->setProperty(instance, ("Key" + textOf(name)).c_str(), &key.value, key.type);
    }
    return instance;
}

void setNumbers(CMPIInstance* instance) {
    setNumber(instance, "B", &CMPIValue::boolean, 1, CMPI_boolean);
    setNumber(instance, "C16", &CMPIValue::char16, 65, CMPI_char16);
    setNumber(instance, "U8", &CMPIValue::uint8, 255, CMPI_uint8);
    setNumber(instance, "U64", &CMPIValue::uint64, std::numeric_limits<CMPIUint64>::max(), CMPI_uint64);
    setNumber(instance, "S64", &CMPIValue::sint64, std::numeric_limits<CMPISint64>::min(), CMPI_sint64);
    setNumber(instance, "R32", &CMPIValue::real32, 0.1, CMPI_real32);
    setNumber(instance, "R64", &CMPIValue::real64, 0.1, CMPI_real64);
    setNumber(instance, "NaN", &CMPIValue::real64, std::nan(""), CMPI_real64);
}

CMPIInstance* everything(const CMPIObjectPath* request) {
    CMPIInstance* instance = newInstance(newPath(request, "all"));
    setNumbers(instance);
    setText(instance, "Text", "a\xff\"\n");
    CMPIValue value{};
    value.dateTime = broker->eft->newDateTimeFromChars(broker, "20261121060000.123456+060", nullptr);
    instance->ft->setProperty(instance, "When", &value, CMPI_dateTime);
    value.ref = newPath(request, "other");
    instance->ft->setProperty(instance, "Ref", &value, CMPI_ref);
    value.ref->ft->setNameSpace(value.ref, "root/x");
    instance->ft->setProperty(instance, "Far", &value, CMPI_ref);
    value.inst = newInstance(newPath(request, "inside", "Echo_Inside"));
    setText(value.inst, "Text", "deep");
    instance->ft->setProperty(instance, "Embedded", &value, CMPI_instance);
    value.array = broker->eft->newArray(broker, 2, CMPI_uint16, nullptr);
    CMPIValue element{};
    element.uint16 = 11;
    value.array->ft->setElementAt(value.array, 1, &element, CMPI_uint16);
    instance->ft->setProperty(instance, "Array", &value, CMPI_uint16A);
    instance->ft->setProperty(instance, "Null", nullptr, CMPI_uint32);
    return instance;
}

/// Errors that a class name asks for; sets `answered` when there is nothing more to do.
CMPIStatus trouble(const CMPIObjectPath* path, bool& answered) {
    const std::string name = classOf(path);
    const unsigned call = ++calls;
    answered = true;
    if (name == "Echo_Crash") std::abort();
    if (name == "Echo_Fail") return status(CMPI_RC_ERR_FAILED, "asked to\x1b fail");
    if (name == "Echo_Odd") return status(static_cast<CMPIrc>(77));
    if (name == "Echo_Flaky" && call % 2 == 0) return status(CMPI_RC_ERR_FAILED);
    if (name.compare(0, 5, "Echo_") != 0) return status(CMPI_RC_ERR_INVALID_CLASS);
    answered = false;
    return status(CMPI_RC_OK);
}

/// How many calls were inside at once, waiting a while for as many as the name asks.
unsigned crowd(unsigned wanted) {
    const unsigned self = ++inside;
    const auto giveUp = std::chrono::steady_clock::now() + std::chrono::seconds(20);
    while (inside < wanted && std::chrono::steady_clock::now() < giveUp) std::this_thread::yield();
    return self > wanted ? self : inside.load();
}

CMPIStatus cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
    return status(CMPI_RC_OK);
}

CMPIStatus enumInstanceNames(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                             const CMPIObjectPath* path) {
    bool answered;
    const CMPIStatus answer = trouble(path, answered);
    if (answered) return answer;
    result->ft->returnObjectPath(result, newPath(path, "a"));
    result->ft->returnObjectPath(result, newPath(path, "b\"\\"));
    if (classOf(path) != "Echo_Open") result->ft->returnDone(result);
    return answer;
}

CMPIStatus enumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                         const char** list) {
    bool answered;
    const CMPIStatus answer = trouble(path, answered);
    if (answered) return answer;
    printLoudly();
    CMPIInstance* instance = classOf(path) == "Echo_Everything" ? everything(path) : echo(path, "EnumInstances", list);
    if (classOf(path) == "Echo_Crowd") setNumber(instance, "Crowd", &CMPIValue::uint32, crowd(4), CMPI_uint32);
    result->ft->returnInstance(result, instance);
    result->ft->returnDone(result);
    return answer;
}

CMPIStatus getInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                       const char** list) {
    if (classOf(path) != "Echo_Missing") result->ft->returnInstance(result, echo(path, "GetInstance", list));
    result->ft->returnDone(result);
    return status(CMPI_RC_OK);
}

CMPIStatus createInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                          const CMPIInstance*) {
    result->ft->returnObjectPath(result, path);
    result->ft->returnDone(result);
    return status(CMPI_RC_OK);
}

std::string described(const CMPIData& data) {
    if ((data.state & CMPI_nullValue) != 0) return "null";
    if (data.type == CMPI_string) return '"' + textOf(data.value.string) + '"';
    if ((data.type & CMPI_ARRAY) == 0) return std::to_string(data.value.uint32);
    const CMPICount size = data.value.array->ft->getSize(data.value.array, nullptr);
    std::string text;
    for (CMPICount i = 0; i < size; ++i) {
        text += '[' + described(data.value.array->ft->getElementAt(data.value.array, i, nullptr)) + ']';
    }
    return text;
}

/// An instance cannot come back from here: its properties do as the message of an error.
CMPIStatus modifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                          const CMPIInstance* instance, const char** list) {
    if (classOf(path) == "Echo_Quiet") return status(CMPI_RC_OK);
    std::string text;
    const CMPICount count = instance->ft->getPropertyCount(instance, nullptr);
    for (CMPICount i = 0; i < count; ++i) {
        CMPIString* name = nullptr;
        const CMPIData data = instance->ft->getPropertyAt(instance, i, &name, nullptr);
        text += textOf(name) + ' ' + std::to_string(data.type) + ' ' + described(data) + "; ";
    }
    result->ft->returnDone(result);
    return status(CMPI_RC_ERR_FAILED, (text + (list ? list[0] : "no list")).c_str());
}

CMPIStatus deleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath* path) {
    return classOf(path) == "Echo_Missing" ? status(CMPI_RC_ERR_NOT_FOUND) : status(CMPI_RC_OK);
}

CMPIStatus execQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                     const char* query, const char* language) {
    CMPIInstance* instance = newInstance(path);
    setText(instance, "Query", query);
    setText(instance, "Language", language);
    result->ft->returnInstance(result, instance);
    return status(CMPI_RC_OK);
}

CMPIStatus associationCleanup(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) {
    return status(CMPI_RC_OK);
}

CMPIInstance* echoLink(const CMPIObjectPath* path, const char* operation, const char* assocClass,
                       const char* resultClass, const char* role, const char* resultRole, const char** list) {
    CMPIInstance* instance = echo(path, operation, list);
    setText(instance, "AssocClass", assocClass);
    setText(instance, "ResultClass", resultClass);
    setText(instance, "Role", role);
    setText(instance, "ResultRole", resultRole);
    return instance;
}

CMPIStatus associators(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                       const char* assocClass, const char* resultClass, const char* role, const char* resultRole,
                       const char** list) {
    bool answered = false;
    const CMPIStatus error = trouble(path, answered);
    if (answered) return error;
    result->ft->returnInstance(result, echoLink(path, "Associators", assocClass, resultClass, role, resultRole, list));
    return status(CMPI_RC_OK);
}

CMPIStatus associatorNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                           const char* assocClass, const char*, const char*, const char*) {
    result->ft->returnObjectPath(result, newPath(path, assocClass ? assocClass : "none"));
    return status(CMPI_RC_OK);
}

CMPIStatus references(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                      const char* resultClass, const char* role, const char** list) {
    result->ft->returnInstance(result, echoLink(path, "References", nullptr, resultClass, role, nullptr, list));
    return status(CMPI_RC_OK);
}

CMPIStatus referenceNames(CMPIAssociationMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* path,
                          const char* resultClass, const char*) {
    result->ft->returnObjectPath(result, newPath(path, resultClass ? resultClass : "none"));
    return status(CMPI_RC_OK);
}

CMPIStatus methodCleanup(CMPIMethodMI*, const CMPIContext*, CMPIBoolean) {
    return status(CMPI_RC_OK);
}

/// Gives every argument back, and their number.
CMPIStatus invokeMethod(CMPIMethodMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*,
                        const char* method, const CMPIArgs* in, CMPIArgs* out) {
    const CMPICount count = in->ft->getArgCount(in, nullptr);
    for (CMPICount i = 0; i < count; ++i) {
        CMPIString* name = nullptr;
        const CMPIData argument = in->ft->getArgAt(in, i, &name, nullptr);
        const bool null = (argument.state & CMPI_nullValue) != 0;
        out->ft->addArg(out, textOf(name).c_str(), null ? nullptr : &argument.value, argument.type);
    }
    out->ft->addArg(out, "Method", reinterpret_cast<const CMPIValue*>(method), CMPI_chars);
    CMPIValue value{};
    value.uint32 = count;
    result->ft->returnData(result, &value, CMPI_uint32);
    result->ft->returnDone(result);
    return status(CMPI_RC_OK);
}

CMPIInstanceMIFT instanceTable = {CMPICurrentVersion, CMPICurrentVersion, "instanceEcho", cleanup,
                                  enumInstanceNames,  enumInstances,      getInstance,    createInstance,
                                  modifyInstance,     deleteInstance,     execQuery};
CMPIAssociationMIFT associationTable = {CMPICurrentVersion, CMPICurrentVersion, "associationEcho", associationCleanup,
                                        associators,        associatorNames,    references,        referenceNames};
CMPIMethodMIFT methodTable = {CMPICurrentVersion, CMPICurrentVersion, "methodEcho", methodCleanup, invokeMethod};

CMPIInstanceMI instanceMI = {nullptr, &instanceTable};
CMPIAssociationMI associationMI = {nullptr, &associationTable};
CMPIMethodMI methodMI = {nullptr, &methodTable};

} // namespace

CMPI_EXTERN_C CMPIInstanceMI* Echo_Create_InstanceMI(const CMPIBroker* brk, const CMPIContext*, CMPIStatus*) {
    broker = brk;
    return &instanceMI;
}

CMPI_EXTERN_C CMPIAssociationMI* Echo_Create_AssociationMI(const CMPIBroker* brk, const CMPIContext*, CMPIStatus*) {
    broker = brk;
    return &associationMI;
}

CMPI_EXTERN_C CMPIMethodMI* Echo_Create_MethodMI(const CMPIBroker* brk, const CMPIContext*, CMPIStatus*) {
    broker = brk;
    return &methodMI;
}

CMPI_EXTERN_C CMPIInstanceMI* Null_Create_InstanceMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*) {
    return nullptr;
}

CMPI_EXTERN_C CMPIInstanceMI* Failing_Create_InstanceMI(const CMPIBroker*, const CMPIContext*, CMPIStatus* rc) {
    rc->rc = CMPI_RC_ERR_FAILED;
    return &instanceMI;
}
