#include "include/Trace.h"
#include "support/Allocations.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <stdexcept>
#include <thread>

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::StartsWith;
using namespace VK;

const std::string category("Norvane.BaseServerProvider");
const TraceSource source{category, "Sample"};
const std::string rule(78, '=');

TEST(Trace, FormatsEachMessageType) {
    EXPECT_STREQ(trace("BaseServerProvider", "BaseServer_GetInstance", 573U, ENTERING),
                 "ENTERING: BaseServer_GetInstance() in BaseServerProvider [Line: 573]");
    EXPECT_STREQ(trace("f", "fn", 7U, EXITING), "EXITING: fn() in f [Line: 7]");
    EXPECT_STREQ(trace("f", "fn", 7U, METHOD_INVOKED), "METHOD: fn() was invoked in f [Line: 7]");
}

TEST(Trace, PutsTheMessageLast) {
    EXPECT_STREQ(trace("f", "text", 9U, MESSAGE), "MESSAGE [File: f, Line: 9]: text");
}

TEST(Trace, AppendsTheParameterList) {
    EXPECT_STREQ(tracepara("f", "fn", 7U, " a=1", ENTERING), "ENTERING: fn() in f [Line: 7],Parameters List:  a=1");
    EXPECT_STREQ(tracepara("f", "fn", 7U, " a=1", EXITING), "EXITING: fn() in f [Line: 7],Parameters List:  a=1");
    EXPECT_STREQ(tracepara("f", "fn", 7U, " a=1", METHOD_INVOKED),
                 "METHOD: fn() was invoked in f [Line: 7],Parameters List:  a=1");
    EXPECT_STREQ(tracepara("f", "text", 7U, " a=1", MESSAGE), "MESSAGE [File: f, Line: 7]: text,Parameters List:  a=1");
}

TEST(Trace, FormatsVariablesNameFirstAndValueBeforeLine) {
    EXPECT_STREQ(trace("resultClass", "f", 12U, "CIM_X"), "VARIABLE: 'resultClass' has Value 'CIM_X' at line 12 in f");
    EXPECT_STREQ(trace("classId", "f", 12U, 162U), "VARIABLE: 'classId' has Value '162' at line 12 in f");
}

TEST(Trace, PrintsTheLargestUnsignedVariableAsMinusOne) {
    EXPECT_STREQ(trace("v", "f", 1U, 4294967295U), "VARIABLE: 'v' has Value '-1' at line 1 in f");
}

TEST(Trace, PrintsANullValueAsNull) {
    EXPECT_STREQ(trace("resultClass", "f", 1U, static_cast<const char*>(nullptr)),
                 "VARIABLE: 'resultClass' has Value '(null)' at line 1 in f");
}

TEST(Trace, PrintsANullFileOrFunctionAsNull) {
    const char* const none = nullptr;
    EXPECT_STREQ(trace(none, none, 7U, ENTERING), "ENTERING: (null)() in (null) [Line: 7]");
    EXPECT_STREQ(tracepara(none, none, 7U, none, EXITING),
                 "EXITING: (null)() in (null) [Line: 7],Parameters List: (null)");
}

TEST(Trace, AnswersAnAllZeroBufferForAnUnknownType) {
    trace("file", "function", 1U, ENTERING);
    const char* text = trace("file", "function", 1U, static_cast<MessageType>(4));
    EXPECT_EQ(std::string(text, 512), std::string(512, '\0'));
    tracepara("file", "function", 1U, "p", ENTERING);
    text = tracepara("file", "function", 1U, "p", static_cast<MessageType>(99));
    EXPECT_EQ(std::string(text, 512), std::string(512, '\0'));
}

TEST(Trace, OverwritesTheTextOfTheSameFormAndOfNoOther) {
    const char* first = trace("f", "one", 1U, ENTERING);
    const char* variable = trace("v", "f", 1U, 5U);
    const char* second = trace("f", "two", 2U, ENTERING);
    EXPECT_EQ(first, second);
    EXPECT_STREQ(first, "ENTERING: two() in f [Line: 2]");
    EXPECT_STREQ(variable, "VARIABLE: 'v' has Value '5' at line 1 in f");
}

TEST(Trace, KeepsABufferForEachThread) {
    const char* mine = trace("f", "mine", 1U, ENTERING);
    std::thread([] { trace("f", "theirs", 2U, ENTERING); }).join();
    EXPECT_STREQ(mine, "ENTERING: mine() in f [Line: 1]");
}

TEST(Trace, LogsPointersAsAddressesAndTextsAsText) {
    NVLog::NVMessageBuffer buffer;
    const int object = 5;
    char characters[] = "chars";
    buffer << " text="
           << "const"
           << " more=" << characters;
    std::ostringstream address;
    address << static_cast<const void*>(&object);
    EXPECT_EQ(NVLog::NVMessageBuffer::str(buffer << &object), " text=const more=chars" + address.str());
}

TEST(Trace, StartsAnewAfterTheTextWasTaken) {
    NVLog::NVMessageBuffer buffer;
    EXPECT_EQ(NVLog::NVMessageBuffer::str(buffer << "one"), "one");
    EXPECT_EQ(NVLog::NVMessageBuffer::str(buffer << "two" << 3U), "two3");
}

TEST(Markers, WriteTheRuleAroundTheOperation) {
    test::takeLog();
    markProviderEntry(category, "BaseServerProvider", "BaseServer_GetInstance", 573);
    const std::string head = " 4000 Norvane.BaseServerProvider Trace markProviderEntry: ";
    const std::string entering = "ENTERING: BaseServer_GetInstance() in BaseServerProvider [Line]";
    EXPECT_THAT(test::withoutPlaces(test::takeLog()), ElementsAre("LOG" + head + rule, "TRACE" + head + rule,
                                                                  "LOG" + head + entering, "TRACE" + head + entering));

    markProviderExit(category, "BaseServerProvider", "BaseServer_GetInstance", 580);
    const std::string tail = " 4000 Norvane.BaseServerProvider Trace markProviderExit: ";
    const std::string exiting = "EXITING: BaseServer_GetInstance() in BaseServerProvider [Line]";
    EXPECT_THAT(test::withoutPlaces(test::takeLog()), ElementsAre("LOG" + tail + exiting, "TRACE" + tail + exiting,
                                                                  "LOG" + tail + rule, "TRACE" + tail + rule));
}

void earlyReturn(bool leave) {
    const TraceScope scope(VK_SCOPE(source));
    if (leave) return;
    traceVariable(source, "leave", 0U);
}

TEST(TraceScope, WritesEntryAndExitAlsoOnAnEarlyReturn) {
    test::takeLog();
    earlyReturn(true);
    const std::string head = " 4000 Norvane.BaseServerProvider Sample earlyReturn: ";
    EXPECT_THAT(test::withoutPlaces(test::takeLog()),
                ElementsAre("LOG" + head + "ENTERING: earlyReturn() in Sample [Line]",
                            "TRACE" + head + "ENTERING: earlyReturn() in Sample [Line]",
                            "LOG" + head + "EXITING: earlyReturn() in Sample [Line]",
                            "TRACE" + head + "EXITING: earlyReturn() in Sample [Line]"));
}

void throwing(const std::string& reference) {
    const ParameterTraceScope scope(VK_SCOPE(source), " filterType=", 0U, " reference=", reference.c_str());
    throw std::runtime_error("out");
}

TEST(ParameterTraceScope, WritesItsParametersTwiceAlsoOnAnException) {
    test::takeLog();
    EXPECT_THROW(throwing("node7"), std::runtime_error);
    const std::string head = " 4000 Norvane.BaseServerProvider Sample throwing: ";
    const std::string list = ",Parameters List:  filterType=0 reference=node7";
    EXPECT_THAT(test::withoutPlaces(test::takeLog()),
                ElementsAre("LOG" + head + "ENTERING: throwing() in Sample [Line]" + list,
                            "TRACE" + head + "ENTERING: throwing() in Sample [Line]" + list,
                            "LOG" + head + "EXITING: throwing() in Sample [Line]" + list,
                            "TRACE" + head + "EXITING: throwing() in Sample [Line]" + list));
}

TEST(TraceLines, CarryTheLevelAskedFor) {
    test::takeLog();
    traceMessage(source, "failed", FailureLevel);
    traceMethod(VK_METHOD(source));
    const std::vector<std::string> lines = test::withoutPlaces(test::takeLog());
    ASSERT_EQ(lines.size(), 4U);
    EXPECT_THAT(lines[0], StartsWith("LOG 6000 Norvane.BaseServerProvider Sample "));
    EXPECT_THAT(lines[0], EndsWith("]: failed"));
    EXPECT_THAT(lines[2], StartsWith("LOG 4000 Norvane.BaseServerProvider Sample "));
}

TEST(Trace, CostsNoMemoryAllocationALine) {
    const int object = 5;
    const auto lines = [&object] {
        const TraceScope scope(VK_SCOPE(source));
        const ParameterTraceScope parameters(VK_SCOPE(source), " object=", &object, " number=", 7U);
        traceVariable(source, "name", "a value that is longer than a short string is inside");
        traceMessage(source, "a message that is longer than a short string is inside", DebugLevel);
    };
    lines(); // the first of a thread makes what the others use
    EXPECT_EQ(support::allocationsDuring([&] {
                  for (int i = 0; i < 100; ++i) lines();
              }),
              0U);
}

} // namespace
