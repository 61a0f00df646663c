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
    const CMPIStatus status = OperationFrame("Sample").runMarked([](CMPIStatus& inside) {
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
        const CMPIStatus status = OperationFrame("Sample").runMarked([&](CMPIStatus& inside) {
            inside.rc = before;
            throw std::runtime_error("failed");
        });
        EXPECT_EQ(status.rc, before);
        EXPECT_EQ(status.msg, nullptr);
    }
}

TEST(OperationFrame, LogsTheExceptionBeforeTheExitMarker) {
    test::takeLog();
    OperationFrame("Sample").runMarked([](CMPIStatus&) { throw std::runtime_error("it failed: 100%s"); });
    EXPECT_EQ(takeEvents(), test::entryMarker("Sample") +
                                Events{test::event(3000, file, "Sample",
                                                   "MESSAGE [File: BaseServerProvider, Line: N]: "
                                                   "it failed: 100%s")} +
                                test::exitMarker("Sample"));
}

TEST(OperationFrame, HandsTheExceptionOnWithoutAnExitMarker) {
    test::takeLog();
    std::string text;
    OperationFrame("Sample").run([] { throw std::runtime_error("failed"); },
                                 [&](const std::exception& exception) { text = exception.what(); });
    EXPECT_EQ(text, "failed");
    EXPECT_EQ(takeEvents(),
              test::entryMarker("Sample") +
                  Events{test::event(3000, file, "Sample", "MESSAGE [File: BaseServerProvider, Line: N]: failed")});
}

TEST(OperationFrame, DoesNotCatchWhatIsNoStandardException) {
    EXPECT_THROW(OperationFrame("Sample").runMarked([](CMPIStatus&) { throw 42; }), int);
}

TEST(OperationFrame, WritesOneMethodLineForWhatIsNotSupported) {
    test::takeLog();
    const CMPIStatus status = OperationFrame("Sample").notSupported();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_THAT(takeEvents(), ElementsAre(test::method(file, "Sample")));
}

TEST(OperationFrame, IsNamedAfterTheFunctionThatMakesIt) {
    test::takeLog();
    const OperationFrame frame;
    frame.notSupported();
    EXPECT_THAT(takeEvents(), ElementsAre(test::method(file, "TestBody")));
}

TEST(ReturnedObjects, AreNeverNull) {
    // A result without slots would crash if it were called.
    const CMPIResult result = {};
    returnPath(&result, nullptr);
    returnInstance(&result, nullptr);
}

} // namespace
