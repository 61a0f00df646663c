#include "provider/OperationFrame.h"

#include "provider/LogEvents.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <stdexcept>

namespace {

using testing::ElementsAre;
using namespace VK::BaseServerProvider;
using Events = std::vector<std::string>;

constexpr char file[] = "BaseServerProvider";

Events operator+(Events left, const Events& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

Events takeEvents() {
    return test::events(test::takeLog());
}

TEST(OperationFrame, RunsTheWorkBetweenTheMarkers) {
    test::takeLog();
    const CMPIStatus status = OperationFrame(VK_PLACE(), "Sample").runMarked([](CMPIStatus& inside) {
        VK::traceVariable(frameSource, "inside", 1U);
        inside.rc = CMPI_RC_ERR_INVALID_CLASS;
    });
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_EQ(takeEvents(), test::entryMarker("Sample") + Events{test::variable(file, "operator()", "inside", "1")} +
                                test::exitMarker("Sample"));
}

TEST(OperationFrame, AnswersTheStatusAsItStoodWhenTheWorkThrows) {
    for (const CMPIrc before : {CMPI_RC_OK, CMPI_RC_ERR_INVALID_CLASS}) {
        const CMPIStatus status = OperationFrame(VK_PLACE(), "Sample").runMarked([&](CMPIStatus& inside) {
            inside.rc = before;
            throw std::runtime_error("failed");
        });
        EXPECT_EQ(status.rc, before);
        EXPECT_EQ(status.msg, nullptr);
    }
}

TEST(OperationFrame, LogsTheExceptionBeforeTheExitMarker) {
    test::takeLog();
    OperationFrame(VK_PLACE(), "Sample").runMarked([](CMPIStatus&) { throw std::runtime_error("it failed: 100%s"); });
    EXPECT_EQ(takeEvents(), test::entryMarker("Sample") +
                                Events{test::event(3000, file, "Sample",
                                                   "MESSAGE [File: BaseServerProvider, Line: N]: "
                                                   "it failed: 100%s")} +
                                test::exitMarker("Sample"));
}

TEST(OperationFrame, HandsTheExceptionOnWithoutAnExitMarker) {
    test::takeLog();
    std::string text;
    OperationFrame(VK_PLACE(), "Sample")
        .run([] { throw std::runtime_error("failed"); },
             [&](const std::exception& exception) { text = exception.what(); });
    EXPECT_EQ(text, "failed");
    EXPECT_EQ(takeEvents(),
              test::entryMarker("Sample") +
                  Events{test::event(3000, file, "Sample", "MESSAGE [File: BaseServerProvider, Line: N]: failed")});
}

TEST(OperationFrame, DoesNotCatchWhatIsNoStandardException) {
    EXPECT_THROW(OperationFrame(VK_PLACE(), "Sample").runMarked([](CMPIStatus&) { throw 42; }), int);
}

TEST(OperationFrame, WritesOneMethodLineForWhatIsNotSupported) {
    test::takeLog();
    const CMPIStatus status = OperationFrame(VK_PLACE(), "Sample").notSupported();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_THAT(takeEvents(), ElementsAre(test::method(file, "Sample")));
}

TEST(OperationFrame, IsNamedAfterTheFunctionThatMakesIt) {
    test::takeLog();
    const OperationFrame frame(VK_PLACE());
    frame.notSupported();
    EXPECT_THAT(takeEvents(), ElementsAre(test::method(file, "TestBody")));
}

/// A result that refuses, by its hdl: false for nothing, true for all.
CMPIResultFT resultTable() {
    CMPIResultFT table = {};
    const auto refusal = [](const CMPIResult* result) {
        return CMPIStatus{*static_cast<const bool*>(result->hdl) ? CMPI_RC_ERR_FAILED : CMPI_RC_OK, nullptr};
    };
    static const auto answer = refusal;
    table.returnObjectPath = [](const CMPIResult* result, const CMPIObjectPath*) { return answer(result); };
    table.returnInstance = [](const CMPIResult* result, const CMPIInstance*) { return answer(result); };
    table.returnData = [](const CMPIResult* result, const CMPIValue*, CMPIType) { return answer(result); };
    table.returnDone = [](const CMPIResult* result) { return answer(result); };
    return table;
}

class AnswerTest : public testing::Test {
protected:
    AnswerTest() { test::takeLog(); }

    bool refusing = true;
    CMPIResultFT table = resultTable();
    const CMPIResult result = {&refusing, &table};
    const OperationFrame frame{VK_PLACE(), "Sample"};
    Answer answer{frame, &result};
    const CMPIObjectPath path = {};
    const CMPIInstance instance = {};
    const std::string refused =
        test::event(6000, file, "Sample",
                    "MESSAGE [File: BaseServerProvider, Line: N]: The object manager refused a part of the answer");
};

TEST_F(AnswerTest, LogsEachRefusedPartInTheOperationsName) {
    answer.add(&path);
    answer.add(&instance);
    answer.add(7U);
    answer.close();
    EXPECT_THAT(takeEvents(), ElementsAre(refused, refused, refused, refused));
}

TEST_F(AnswerTest, WritesNoLineForWhatIsTaken) {
    refusing = false;
    answer.add(&path);
    answer.close();
    EXPECT_THAT(takeEvents(), testing::IsEmpty());
}

TEST_F(AnswerTest, WritesNoLineWhenAnEmptyOneMayNotBeClosed) {
    answer.add(static_cast<const CMPIObjectPath*>(nullptr));
    answer.add(static_cast<const CMPIInstance*>(nullptr));
    answer.close();
    EXPECT_THAT(takeEvents(), testing::IsEmpty());
}

TEST_F(AnswerTest, TakesAMissingSlotForARefusal) {
    table = {};
    answer.add(&path);
    answer.add(&instance);
    answer.add(7U);
    answer.close();
    EXPECT_THAT(takeEvents(), ElementsAre(refused, refused, refused, refused));
}

} // namespace
