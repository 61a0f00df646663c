#include "FakeTables.h"

#include <gtest/gtest.h>

namespace {

using fake::word;

template <class... Arguments>
std::vector<std::uintptr_t> words(Arguments... arguments) {
    return {word(arguments)...};
}

template <class Macro>
void expectCall(const char* name, const void* slot, const std::vector<std::uintptr_t>& arguments, Macro macro) {
    fake::lastCall = {};
    EXPECT_TRUE(fake::isAnswer(macro())) << name;
    EXPECT_EQ(fake::lastCall.slot, slot) << name;
    EXPECT_EQ(fake::lastCall.arguments, arguments) << name;
}

TEST(CmpiMacros, CallTheirSlotWithTheirArgumentsInOrderAndYieldItsAnswer) {
    fake::installAll();
#define ARGUMENT(type, name) [[maybe_unused]] type name = fake::Distinct<type, __COUNTER__>::make();
#include "MacroArguments.inc"

#define CALL(type, slot, macro, ...)                                                                                   \
    expectCall(#macro, &fake::table<type>.slot, words(__VA_ARGS__), [&] { return macro(__VA_ARGS__); });
#include "MacroCalls.inc"
    expectCall("CBSetInstance", &fake::table<CMPIBrokerFT>.modifyInstance, words(broker, ctx, path, inst, 0),
               [&] { return CBSetInstance(broker, ctx, path, inst); });
}

TEST(CmpiMacros, TakeAnyPointerAsValue) {
    fake::installAll();
    CMPIInstance instance = {&instance, &fake::table<CMPIInstanceFT>};
    const auto valuePassed = [] { return fake::lastCall.arguments.at(2); };

    const CMPIBoolean flag = 1;
    CMSetProperty(&instance, "Enabled", &flag, CMPI_boolean);
    EXPECT_EQ(valuePassed(), word(&flag));

    CMPIReal64 load = 0.5;
    CMSetProperty(&instance, "Load", &load, CMPI_real64);
    EXPECT_EQ(valuePassed(), word(&load));

    const char* text = "host.example";
    CMSetProperty(&instance, "Name", text, CMPI_chars);
    EXPECT_EQ(valuePassed(), word(text));

    const CMPIValue value = {3};
    CMSetProperty(&instance, "Count", &value, CMPI_uint64);
    EXPECT_EQ(valuePassed(), word(&value));

    CMSetProperty(&instance, "Caption", NULL, CMPI_string);
    EXPECT_EQ(valuePassed(), 0U);
}

TEST(CmpiMacros, ReadTheFactsOfTheBroker) {
    CMPIBrokerFT facts{};
    facts.brokerCapabilities = CMPI_MB_BasicWrite;
    facts.brokerVersion = CMPIVersion200;
    facts.brokerName = "broker";
    const CMPIBroker broker = {nullptr, &facts, nullptr, nullptr, nullptr};
    EXPECT_EQ(CBBrokerVersion(&broker), 200U);
    EXPECT_STREQ(CBBrokerName(&broker), "broker");
    EXPECT_EQ(CBGetCapabilities(&broker), 3U);
    EXPECT_EQ(CBGetBrokerCapabilities(&broker), 3U);
    EXPECT_EQ(CBGetClassification(&broker), 3U);
}

TEST(CmpiMacros, ReadATextThroughTheSlotNotTheHandle) {
    fake::installAll();
    char handle[] = "handle";
    const CMPIString string = {handle, &fake::table<CMPIStringFT>};
    char* text = CMGetCharPtr(&string);
    EXPECT_EQ(word(text), word(fake::answer<const char*>()));
    EXPECT_EQ(fake::lastCall.arguments, words(&string, 0));
}

} // namespace
