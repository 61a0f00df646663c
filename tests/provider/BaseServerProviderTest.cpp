#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <cmpift.h>

#include <filesystem>
#include <memory>
#include <set>
#include <string>

#include <dlfcn.h>
#include <stdio.h>

namespace {

using testing::IsEmpty;
using testing::SizeIs;

constexpr char instanceFactory[] = "BaseServerProvider_Create_InstanceMI";
constexpr char associationFactory[] = "BaseServerProvider_Create_AssociationMI";
constexpr char methodFactory[] = "BaseServerProvider_Create_MethodMI";

struct CloseLibrary {
    void operator()(void* handle) const { dlclose(handle); }
};
using Library = std::unique_ptr<void, CloseLibrary>;

Library load(const std::string& file) {
    Library library(dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL));
    if (!library) throw std::runtime_error(dlerror());
    return library;
}

bool isLoaded(const std::string& file) {
    return Library(dlopen(file.c_str(), RTLD_NOW | RTLD_NOLOAD)) != nullptr;
}

template <class MI>
using Factory = MI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

template <class MI>
MI* make(const Library& library, const char* factory, const CMPIBroker* broker, const CMPIContext* context = nullptr,
         CMPIStatus* status = nullptr) {
    const auto function = reinterpret_cast<Factory<MI>>(dlsym(library.get(), factory));
    if (function == nullptr) throw std::runtime_error(factory);
    return function(broker, context, status);
}

template <class MI>
void expectHead(const MI& interface, const char* name) {
    EXPECT_EQ(interface.hdl, nullptr);
    EXPECT_EQ(interface.ft->ftVersion, 200);
    EXPECT_EQ(interface.ft->miVersion, 200);
    EXPECT_STREQ(interface.ft->miName, name);
}

TEST(Factories, AnswerThreeInterfacesWithFullTables) {
    const Library library = load(VK_PROVIDER_LIBRARY);
    const CMPIBroker* const broker = test::provider().broker();
    const CMPIInstanceMI& instance = *make<CMPIInstanceMI>(library, instanceFactory, broker);
    const CMPIAssociationMI& association = *make<CMPIAssociationMI>(library, associationFactory, broker);
    const CMPIMethodMI& method = *make<CMPIMethodMI>(library, methodFactory, broker);
    EXPECT_EQ(std::set<const void*>({&instance, &association, &method}).size(), 3U);
    expectHead(instance, "instanceBaseServerProvider");
    expectHead(association, "associationBaseServerProvider");
    expectHead(method, "methodBaseServerProvider");
    const CMPIInstanceMIFT& ift = *instance.ft;
    EXPECT_TRUE(ift.cleanup && ift.enumerateInstanceNames && ift.enumerateInstances && ift.getInstance &&
                ift.createInstance && ift.modifyInstance && ift.deleteInstance && ift.execQuery);
    const CMPIAssociationMIFT& aft = *association.ft;
    EXPECT_TRUE(aft.cleanup && aft.associators && aft.associatorNames && aft.references && aft.referenceNames);
    EXPECT_TRUE(method.ft->cleanup && method.ft->invokeMethod);
}

TEST(Factories, AnswerTheSameInterfaceEachTimeWithoutAStatusOrALine) {
    const Library library = load(VK_PROVIDER_LIBRARY);
    const CMPIBroker* const broker = test::provider().broker();
    test::takeLog();
    for (const char* factory : {instanceFactory, associationFactory, methodFactory}) {
        CMPIStatus status = {CMPI_RC_ERR_FAILED, nullptr};
        void* const first = make<void>(library, factory, broker, nullptr, &status);
        EXPECT_NE(first, nullptr) << factory;
        EXPECT_EQ(make<void>(library, factory, broker, nullptr, nullptr), first) << factory;
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED) << factory;
    }
    EXPECT_THAT(test::takeLog(), IsEmpty());
}

TEST(Factories, AreAllThatTheLibraryExports) {
    FILE* const names = popen("nm -D --defined-only --format=posix '" VK_PROVIDER_LIBRARY "'", "r");
    ASSERT_NE(names, nullptr);
    std::set<std::string> exported;
    char name[4096];
    while (fscanf(names, "%4095s%*[^\n]", name) == 1) exported.insert(name);
    if (pclose(names) != 0) GTEST_SKIP() << "nm is not there to list the symbols";
    EXPECT_EQ(exported, std::set<std::string>({instanceFactory, associationFactory, methodFactory}));
}

// A broker that counts the paths it is asked for, to see which one an operation uses.
class CountingBroker {
public:
    explicit CountingBroker(const CMPIBroker* real) : services(*real->eft), handle(*real) {
        original = services.newObjectPath;
        services.newObjectPath = [](const CMPIBroker* broker, const char* nameSpace, const char* className,
                                    CMPIStatus* status) {
            ++count;
            return original(broker, nameSpace, className, status);
        };
        handle.eft = &services;
        count = 0;
    }

    const CMPIBroker* broker() const { return &handle; }
    static int takeCount() { return std::exchange(count, 0); }

private:
    static inline decltype(CMPIBrokerEncFT::newObjectPath) original = nullptr;
    static inline int count = 0;
    CMPIBrokerEncFT services;
    CMPIBroker handle;
};

TEST(Broker, IsTheOneThatTheLastFactoryCallGaveAlsoAfterTheCleanup) {
    test::simulate({test::computer(0, "node7")});
    const Library library = load(VK_PROVIDER_LIBRARY);
    const CMPIBroker* const first = test::provider().broker();
    test::provider().instanceMI(); // made now, so that no later request stores its broker
    const CountingBroker second(first);
    const auto asked = [&second] {
        EXPECT_THAT(test::names("VESKA_ComputerSystem").results, SizeIs(1));
        return second.takeCount();
    };
    for (const char* factory : {instanceFactory, associationFactory, methodFactory}) {
        make<void>(library, factory, first);
        EXPECT_EQ(asked(), 0) << factory;
        make<void>(library, factory, second.broker());
        EXPECT_EQ(asked(), 1) << factory;
    }
    CMPIInstanceMI* const instance = make<CMPIInstanceMI>(library, instanceFactory, second.broker());
    EXPECT_EQ(instance->ft->cleanup(instance, nullptr, 1).rc, CMPI_RC_OK);
    EXPECT_EQ(asked(), 1);
    make<void>(library, instanceFactory, first);
}

TEST(Cleanup, AnswersOkWhetherTerminatingOrNotAndTracesNothing) {
    const Library library = load(VK_PROVIDER_LIBRARY);
    const CMPIBroker* const broker = test::provider().broker();
    CMPIInstanceMI* const instance = make<CMPIInstanceMI>(library, instanceFactory, broker);
    CMPIAssociationMI* const association = make<CMPIAssociationMI>(library, associationFactory, broker);
    CMPIMethodMI* const method = make<CMPIMethodMI>(library, methodFactory, broker);
    test::takeLog();
    for (const CMPIBoolean terminating : {CMPIBoolean{0}, CMPIBoolean{1}}) {
        for (const CMPIStatus status : {instance->ft->cleanup(instance, nullptr, terminating),
                                        association->ft->cleanup(association, nullptr, terminating),
                                        method->ft->cleanup(method, nullptr, terminating)}) {
            EXPECT_EQ(status.rc, CMPI_RC_OK);
            EXPECT_EQ(status.msg, nullptr);
        }
    }
    EXPECT_THAT(test::takeLog(), IsEmpty());
}

TEST(Library, GoesWhenItIsUnloadedAndServesAgainWhenItIsLoadedAnew) {
    test::simulate({test::computer(0, "node7")});
    test::provider(); // keeps the product's libraries, so that a copy elsewhere finds them
    const std::string copy = (test::processDirectory() / "copied-provider.so").string();
    std::filesystem::copy_file(VK_PROVIDER_LIBRARY, copy, std::filesystem::copy_options::overwrite_existing);
    for (int round = 0; round < 3; ++round) {
        {
            om::ObjectManager manager(copy, "BaseServerProvider", "root/cimv2");
            om::Request request;
            request.operation = om::Operation::EnumInstances;
            request.path = test::path("VESKA_ComputerSystem");
            EXPECT_THAT(manager.run(request).results, SizeIs(1));
            EXPECT_TRUE(isLoaded(copy));
        }
        EXPECT_FALSE(isLoaded(copy)) << "round " << round;
    }
}

} // namespace
