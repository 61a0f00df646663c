#include "objectmanager/broker/ObjectManager.h"

#include "objectmanager/model/Names.h"

#include <gmock/gmock.h>

#include <atomic>
#include <thread>

namespace om {
namespace {

using testing::HasSubstr;

constexpr const char* Library = TEST_PROVIDER;

Value string(const char* text) {
    return {CMPI_string, std::string(text)};
}
Value uint32(std::uint64_t number) {
    return {CMPI_uint32, number};
}

Request request(Operation operation, const char* className = "Test_Thing") {
    Request result;
    result.operation = operation;
    result.path.className = className;
    return result;
}

class ObjectManagerTest : public testing::Test {
protected:
    ObjectManager manager{Library, "Test", "root/test"};
};

const Value* property(const Answer& answer, std::size_t index, const char* name) {
    return findValue(std::get<Instance>(answer.results.at(index)).properties, name);
}

TEST_F(ObjectManagerTest, NamesComeInOrderWithTheDefaultNamespace) {
    const Answer answer = manager.run(request(Operation::EnumInstanceNames));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
    ASSERT_EQ(answer.results.size(), 2U);
    EXPECT_EQ(std::get<ObjectPath>(answer.results[0]),
              (ObjectPath{"", "root/test", "Test_Thing", {{"Name", string("a")}}}));
    EXPECT_EQ(std::get<ObjectPath>(answer.results[1]).keys[0].second, string("b"));
}

TEST_F(ObjectManagerTest, AnOpenResultIsTold) {
    const Answer answer = manager.run(request(Operation::EnumInstanceNames, "Test_Open"));
    EXPECT_EQ(answer.results.size(), 2U);
    EXPECT_FALSE(answer.done);
}

TEST_F(ObjectManagerTest, AStatusCarriesItsMessage) {
    const Answer answer = manager.run(request(Operation::EnumInstanceNames, "Test_Denied"));
    EXPECT_EQ(answer.code, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(answer.message, "not you");
    EXPECT_FALSE(answer.done);
}

TEST_F(ObjectManagerTest, InstancesKeepTheOrderOfTheirProperties) {
    const Answer answer = manager.run(request(Operation::EnumInstances));
    ASSERT_EQ(answer.results.size(), 2U);
    const auto& instance = std::get<Instance>(answer.results[1]);
    ASSERT_EQ(instance.properties.size(), 2U);
    EXPECT_EQ(instance.properties[0], NamedValue("Name", string("b")));
    const Value states{CMPI_uint16A,
                       std::vector<Value>{{CMPI_uint16, std::uint64_t{2}}, {CMPI_uint16, std::uint64_t{11}}}};
    EXPECT_EQ(instance.properties[1], NamedValue("States", states));
}

TEST_F(ObjectManagerTest, GetPassesKeysPropertyListAndFlags) {
    Request get = request(Operation::GetInstance);
    get.path.keys = {{"NAME", string("x")}};
    get.propertyList = {"One", "Two"};
    const Answer answer = manager.run(get);
    ASSERT_EQ(answer.results.size(), 1U);
    EXPECT_EQ(*property(answer, 0, "Name"), string("x"));
    EXPECT_EQ(*property(answer, 0, "Two"), string("asked for"));
    EXPECT_EQ(*property(answer, 0, "ListLength"), uint32(2));
    EXPECT_EQ(*property(answer, 0, "Flags"), uint32(0));
}

TEST_F(ObjectManagerTest, NoPropertyListAndAnEmptyOneDiffer) {
    Request get = request(Operation::GetInstance);
    get.path.keys = {{"Name", string("x")}};
    EXPECT_EQ(property(manager.run(get), 0, "ListLength"), nullptr);
    get.propertyList.emplace();
    const Answer answer = manager.run(get);
    EXPECT_EQ(*property(answer, 0, "ListLength"), uint32(0));
}

TEST_F(ObjectManagerTest, GetOfNothingIsOk) {
    const Answer answer = manager.run(request(Operation::GetInstance));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.results.empty());
    EXPECT_TRUE(answer.done);
}

TEST_F(ObjectManagerTest, CreatePassesValuesAndGivesThePathBack) {
    Request create = request(Operation::CreateInstance);
    create.values = {{"Name", string("new")}};
    const Answer answer = manager.run(create);
    ASSERT_EQ(answer.results.size(), 1U);
    EXPECT_EQ(std::get<ObjectPath>(answer.results[0]).keys[0].second, string("new"));
}

TEST_F(ObjectManagerTest, ModifyPassesValuesAndPropertyList) {
    Request modify = request(Operation::ModifyInstance);
    modify.values = {{"Speed", uint32(7)}};
    EXPECT_EQ(manager.run(modify).code, CMPI_RC_ERR_INVALID_PARAMETER);
    modify.propertyList = {"Speed"};
    EXPECT_EQ(manager.run(modify).code, CMPI_RC_OK);
}

TEST_F(ObjectManagerTest, DeleteGivesTheProvidersStatus) {
    const Answer answer = manager.run(request(Operation::DeleteInstance));
    EXPECT_EQ(answer.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(answer.message, std::nullopt);
}

TEST_F(ObjectManagerTest, QueryPassesTextAndLanguage) {
    Request query = request(Operation::ExecQuery);
    query.query = "select * from Test_Thing";
    query.language = "WQL";
    const Answer answer = manager.run(query);
    EXPECT_EQ(*property(answer, 0, "Query"), string("select * from Test_Thing"));
    EXPECT_EQ(*property(answer, 0, "Language"), string("WQL"));
}

TEST_F(ObjectManagerTest, AssociationFiltersArriveEachInItsPlace) {
    Request associators = request(Operation::Associators);
    associators.assocClass = "A";
    associators.resultClass = "B";
    associators.role = "C";
    associators.resultRole = "D";
    associators.propertyList = {"P"};
    const Answer answer = manager.run(associators);
    EXPECT_EQ(*property(answer, 0, "AssocClass"), string("A"));
    EXPECT_EQ(*property(answer, 0, "ResultClass"), string("B"));
    EXPECT_EQ(*property(answer, 0, "Role"), string("C"));
    EXPECT_EQ(*property(answer, 0, "ResultRole"), string("D"));
    EXPECT_EQ(*property(answer, 0, "ListLength"), uint32(1));

    associators.operation = Operation::References;
    const Answer references = manager.run(associators);
    EXPECT_EQ(*property(references, 0, "ResultClass"), string("B"));
    EXPECT_EQ(*property(references, 0, "Role"), string("C"));
    EXPECT_EQ(property(references, 0, "AssocClass"), nullptr);
}

TEST_F(ObjectManagerTest, AssociationFiltersThatAreNotGivenAreNull) {
    const Answer answer = manager.run(request(Operation::Associators));
    EXPECT_TRUE(std::get<Instance>(answer.results.at(0)).properties.empty());
    const Answer names = manager.run(request(Operation::AssociatorNames));
    EXPECT_EQ(std::get<ObjectPath>(names.results.at(0)).keys[0].second, string("none"));
    Request withRole = request(Operation::ReferenceNames);
    withRole.role = "Dependent";
    EXPECT_EQ(std::get<ObjectPath>(manager.run(withRole).results.at(0)).keys[0].second, string("Dependent"));
}

Request invoke(const char* method) {
    Request result = request(Operation::InvokeMethod);
    result.method = method;
    return result;
}

TEST_F(ObjectManagerTest, EveryTypeGoesInAndOutOfAMethod) {
    Request echo = invoke("Echo");
    const auto path = std::make_shared<const ObjectPath>(ObjectPath{"", "root/x", "C", {{"K", string("v")}}});
    const auto instance = std::make_shared<const Instance>(Instance{*path, {{"P", uint32(1)}}});
    echo.values = {{"boolean", {CMPI_boolean, true}},
                   {"char16", {CMPI_char16, std::uint64_t{65}}},
                   {"uint8", {CMPI_uint8, std::uint64_t{255}}},
                   {"uint16", {CMPI_uint16, std::uint64_t{65535}}},
                   {"uint32", {CMPI_uint32, std::uint64_t{4294967295}}},
                   {"uint64", {CMPI_uint64, UINT64_MAX}},
                   {"sint8", {CMPI_sint8, std::int64_t{-128}}},
                   {"sint16", {CMPI_sint16, std::int64_t{-32768}}},
                   {"sint32", {CMPI_sint32, std::int64_t{-2147483648}}},
                   {"sint64", {CMPI_sint64, INT64_MIN}},
                   {"real32", {CMPI_real32, 0.5}},
                   {"real64", {CMPI_real64, 0.1}},
                   {"string", string("text")},
                   {"empty", string("")},
                   {"datetime", {CMPI_dateTime, std::string("20261121060000.123456+060")}},
                   {"ref", {CMPI_ref, path}},
                   {"instance", {CMPI_instance, instance}},
                   {"null", {CMPI_uint16, {}}},
                   {"strings", {CMPI_stringA, std::vector<Value>{string("a"), {CMPI_string, {}}}}},
                   {"none", {CMPI_uint64A, std::vector<Value>{}}}};
    const Answer answer = manager.run(echo);
    EXPECT_EQ(answer.returnValue, uint32(20));
    EXPECT_EQ(answer.out, echo.values);
    EXPECT_TRUE(answer.done);
}

TEST_F(ObjectManagerTest, AProviderCallsItselfThroughTheBroker) {
    const Answer answer = manager.run(invoke("AskBroker"));
    EXPECT_EQ(answer.returnValue, uint32(2));
    ASSERT_EQ(answer.out.size(), 2U);
    EXPECT_EQ(answer.out[0].first, "a");
    const auto& instance = *std::get<std::shared_ptr<const Instance>>(answer.out[1].second.data);
    EXPECT_EQ(*findValue(instance.properties, "Name"), string("b"));
}

TEST_F(ObjectManagerTest, AThreadOfTheProviderIsAttachedAndDetached) {
    EXPECT_EQ(manager.run(invoke("RunThread")).returnValue, uint32(50));
}

TEST_F(ObjectManagerTest, AProviderThatCallsItselfWithoutEndGetsAnError) {
    EXPECT_EQ(manager.run(request(Operation::GetInstance, "Test_Endless")).code, CMPI_RC_ERR_FAILED);
}

TEST_F(ObjectManagerTest, TheTimeOfTheProvidersFunctionIsTaken) {
    std::chrono::nanoseconds elapsed{-1};
    manager.run(request(Operation::EnumInstances), &elapsed);
    EXPECT_GT(elapsed.count(), 0);
}

TEST_F(ObjectManagerTest, ThreadsCallAtOnce) {
    // The usual factories all write the same variable of the provider.
    manager.instanceMI();
    manager.methodMI();
    std::vector<std::thread> threads;
    std::atomic<int> right{0};
    for (int t = 0; t < 8; ++t) {
        threads.emplace_back([this, &right] {
            for (int i = 0; i < 100; ++i) {
                const bool names = manager.run(request(Operation::EnumInstanceNames)).results.size() == 2;
                const bool asked = manager.run(invoke("AskBroker")).returnValue == uint32(2);
                if (names && asked) ++right;
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(right, 800);
}

std::string loadError(const char* library, const char* provider) {
    try {
        ObjectManager manager(library, provider, "root/test");
        manager.run(request(Operation::EnumInstances));
    } catch (const LoadError& error) {
        return error.what();
    }
    return "";
}

TEST(ObjectManagerLoading, AnUnusableLibraryOrFactoryIsTold) {
    EXPECT_THAT(loadError("/nonexistent.so", "Test"), HasSubstr("/nonexistent.so"));
    EXPECT_THAT(loadError(Library, "Missing"), HasSubstr("no function Missing_Create_InstanceMI"));
    EXPECT_THAT(loadError(Library, "Null"), HasSubstr("returned null"));
    EXPECT_THAT(loadError(Library, "Failing"), HasSubstr("status 2: no licence"));
    EXPECT_THAT(loadError(Library, "Old"), HasSubstr("version 90"));
}

TEST(ObjectManagerLoading, AFactoryIsCalledWhenItIsNeededFirst) {
    ObjectManager manager(Library, "Null", "root/test");
    EXPECT_NE(manager.broker(), nullptr);
    EXPECT_THROW(manager.instanceMI(), LoadError);
    EXPECT_THROW(manager.methodMI(), LoadError);
}

TEST(ObjectManagerLoading, AnExceptionOfTheProviderIsAFailure) {
    ObjectManager manager(THROWING_PROVIDER, "Throwing", "root/test");
    const Answer answer = manager.run(request(Operation::EnumInstances));
    EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(answer.message, "the provider threw an exception");
    EXPECT_THROW(manager.methodMI(), LoadError);
}

TEST(ObjectManagerLoading, AFunctionLeftNullIsNotSupported) {
    ObjectManager manager(Library, "Empty", "root/test");
    EXPECT_EQ(manager.run(request(Operation::EnumInstances)).code, CMPI_RC_ERR_NOT_SUPPORTED);
}

} // namespace
} // namespace om
