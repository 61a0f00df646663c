// The provider stubs, as a broker meets them: in a library of C, of C++ and of the older level.

#include "ProbeProvider.h"

#include <dlfcn.h>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace {

struct Probe {
    const char* name;
    const char* library;
    int version;
};

std::ostream& operator<<(std::ostream& out, const Probe& probe) {
    return out << probe.name;
}

class CmpiStubs : public ::testing::TestWithParam<Probe> {
protected:
    CmpiStubs() : library(dlopen(GetParam().library, RTLD_NOW | RTLD_LOCAL)) {
        broker = &brokerObject;
        facts = library ? symbol<ProbeFactsFunction>("probeFacts")() : nullptr;
    }
    ~CmpiStubs() override {
        if (library) dlclose(library);
    }
    void SetUp() override { ASSERT_NE(library, nullptr) << dlerror(); }

    template <class Function>
    Function* symbol(const std::string& name) {
        void* address = dlsym(library, name.c_str());
        EXPECT_NE(address, nullptr) << name;
        return reinterpret_cast<Function*>(address);
    }

    template <class MI>
    MI* create(const std::string& kind) {
        return symbol<MI*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>("Probe_Create_" + kind +
                                                                               "MI")(broker, &ctx, &status);
    }

    template <class MI>
    void expectVersionsAndName(const MI* mi, const std::string& miName) {
        EXPECT_EQ(mi->ft->ftVersion, GetParam().version);
        EXPECT_EQ(mi->ft->miVersion, GetParam().version);
        EXPECT_EQ(mi->ft->miName, miName);
        EXPECT_EQ(facts->broker, broker);
    }

    // Calls a slot and checks that it is that function of the provider, and got these arguments.
    template <class Slot, class MI, class... Arguments>
    void expectCalls(const char* function, Slot slot, MI* mi, Arguments... arguments) {
        EXPECT_EQ(slot(mi, &ctx, arguments...).rc, CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED);
        EXPECT_STREQ(facts->called, function);
        const std::vector<const void*> expected = {mi, &ctx, pointer(mi, arguments)...};
        EXPECT_EQ(std::vector<const void*>(facts->arguments, facts->arguments + facts->count), expected) << function;
    }

    // The provider notes a flag as its own address or null, and data as the value's pointer.
    static const void* pointer(const void*, const void* argument) { return argument; }
    static const void* pointer(const void* mi, CMPIBoolean flag) { return flag ? mi : nullptr; }
    static const void* pointer(const void*, const CMPIData& data) { return data.value.chars; }

    void* library;
    ProbeFacts* facts;
    CMPIBroker brokerObject{};
    const CMPIBroker* broker;
    CMPIContext ctx{};
    CMPIResult resultObject{};
    CMPIObjectPath pathObject{};
    const CMPIResult* result = &resultObject;
    const CMPIObjectPath* path = &pathObject;
    const char* list[2] = {"Name", nullptr};
    CMPIStatus status = {CMPI_RC_ERR_ALREADY_EXISTS, nullptr};
    const CMPIBoolean yes = 1;
    const CMPIBoolean no = 0;
};

TEST_P(CmpiStubs, FillTheInstanceTable) {
    auto* mi = create<CMPIInstanceMI>("Instance");
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(mi->hdl, nullptr);
    expectVersionsAndName(mi, "instanceProbe");
    const CMPIInstance inst{};
    expectCalls("probeCleanup", mi->ft->cleanup, mi, yes);
    expectCalls("probeEnumInstanceNames", mi->ft->enumerateInstanceNames, mi, result, path);
    expectCalls("probeEnumInstances", mi->ft->enumerateInstances, mi, result, path, list);
    expectCalls("probeGetInstance", mi->ft->getInstance, mi, result, path, list);
    expectCalls("probeCreateInstance", mi->ft->createInstance, mi, result, path, &inst);
    expectCalls("probeModifyInstance", mi->ft->modifyInstance, mi, result, path, &inst, list);
    expectCalls("probeDeleteInstance", mi->ft->deleteInstance, mi, result, path);
    expectCalls("probeExecQuery", mi->ft->execQuery, mi, result, path, "SELECT", "WQL");
}

TEST_P(CmpiStubs, FillTheAssociationTable) {
    auto* mi = create<CMPIAssociationMI>("Association");
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(mi->hdl, nullptr);
    expectVersionsAndName(mi, "associationProbe");
    expectCalls("probeAssociationCleanup", mi->ft->cleanup, mi, no);
    expectCalls("probeAssociators", mi->ft->associators, mi, result, path, "A", "R", "From", "To", list);
    expectCalls("probeAssociatorNames", mi->ft->associatorNames, mi, result, path, "A", "R", "From", "To");
    expectCalls("probeReferences", mi->ft->references, mi, result, path, "R", "From", list);
    expectCalls("probeReferenceNames", mi->ft->referenceNames, mi, result, path, "R", "From");
}

TEST_P(CmpiStubs, FillTheMethodTable) {
    auto* mi = create<CMPIMethodMI>("Method");
    ASSERT_NE(mi, nullptr);
    expectVersionsAndName(mi, "methodProbe");
    const CMPIArgs in{};
    CMPIArgs out{};
    expectCalls("probeMethodCleanup", mi->ft->cleanup, mi, yes);
    expectCalls("probeInvokeMethod", mi->ft->invokeMethod, mi, result, path, "Reset", &in, &out);
}

TEST_P(CmpiStubs, FillThePropertyTableButForTheOrigin) {
    auto* mi = create<CMPIPropertyMI>("Property");
    ASSERT_NE(mi, nullptr);
    expectVersionsAndName(mi, "propertyProbe");
    char text[] = "value";
    CMPIData data{CMPI_chars, CMPI_goodValue, {}};
    data.value.chars = text;
    expectCalls("probePropertyCleanup", mi->ft->cleanup, mi, no);
    expectCalls("probeSetProperty", mi->ft->setProperty, mi, result, path, "Name", data);
    expectCalls("probeGetProperty", mi->ft->getProperty, mi, result, path, "Name");
    if (GetParam().version >= 200) {
        EXPECT_EQ(mi->ft->setPropertyWithOrigin, nullptr);
    }
}

TEST_P(CmpiStubs, FillTheIndicationTableToItsEnd) {
    auto* mi = create<CMPIIndicationMI>("Indication");
    ASSERT_NE(mi, nullptr);
    expectVersionsAndName(mi, "IndicationProbe"); // a capital letter on purpose: brokers know it so
    CMPISelectExp filterObject{};
    const CMPISelectExp* filter = &filterObject;
    expectCalls("probeIndicationCleanup", mi->ft->cleanup, mi, yes);
    expectCalls("probeAuthorizeFilter", mi->ft->authorizeFilter, mi, filter, "Class", path, "owner");
    expectCalls("probeMustPoll", mi->ft->mustPoll, mi, filter, "Class", path);
    expectCalls("probeActivateFilter", mi->ft->activateFilter, mi, filter, "Class", path, yes);
    expectCalls("probeDeActivateFilter", mi->ft->deActivateFilter, mi, filter, "Class", path, no);
    expectCalls("probeEnableIndications", mi->ft->enableIndications, mi);
    expectCalls("probeDisableIndications", mi->ft->disableIndications, mi);
}

TEST_P(CmpiStubs, StoreTheBrokerBeforeTheHookRuns) {
    create<CMPIInstanceMI>("Instance");
    EXPECT_EQ(facts->brokerInHook, broker);
    CMPIBroker other{};
    broker = &other;
    create<CMPIInstanceMI>("Instance");
    EXPECT_EQ(facts->brokerInHook, &other);
}

TEST_P(CmpiStubs, RunHooksOfSeveralStatements) {
    facts->hookSum = 0;
    create<CMPIPropertyMI>("Property");
    EXPECT_EQ(facts->hookSum, 3);
}

TEST_P(CmpiStubs, LetHooksUseWhatTheFactoryWasGiven) {
    auto* mi = create<CMPIIndicationMI>("Indication");
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(mi->hdl, &status);
}

TEST_P(CmpiStubs, LeaveTheStatusAlone) {
    create<CMPIInstanceMI>("Instance");
    create<CMPIAssociationMI>("Association");
    create<CMPIMethodMI>("Method");
    create<CMPIPropertyMI>("Property");
    create<CMPIIndicationMI>("Indication");
    EXPECT_EQ(status.rc, CMPI_RC_ERR_ALREADY_EXISTS);
}

TEST_P(CmpiStubs, FailWhenAnInitialisationFails) {
    auto* factory = symbol<CMPIMethodMI*(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>("Probe_Create_MethodMI");
    EXPECT_EQ(factory(broker, nullptr, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(factory(broker, nullptr, nullptr), nullptr);

    auto* mi = factory(broker, &ctx, &status);
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(mi->hdl, facts) << "the initialisation got the provider's object";
}

INSTANTIATE_TEST_SUITE_P(, CmpiStubs,
                         ::testing::Values(Probe{"C", PROBE_C, 200}, Probe{"Cpp", PROBE_CPP, 200},
                                           Probe{"Level100", PROBE_LEVEL100, 100}),
                         [](const auto& probe) { return std::string(probe.param.name); });

} // namespace
