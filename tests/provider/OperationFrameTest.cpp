#include "provider/OperationFrame.h"

#include "provider/LogEvents.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <stdexcept>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
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

/// The built-in schema with one more class above the three associations, and one below two of them that has no
/// relation to the third.
om::Schema schemaWithCommonAncestor() {
    std::vector<om::ClassDeclaration> classes = om::Schema::builtin().classes();
    for (om::ClassDeclaration& each : classes)
        if (each.name == "CIM_ElementCapabilities" || each.name == "CIM_ComputerSystemPackage" ||
            each.name == "CIM_ServiceAffectsElement")
            each.superclass = "Test_AnyAssociation";
    om::ClassDeclaration any;
    any.name = "Test_AnyAssociation";
    any.association = true;
    classes.push_back(any);
    om::ClassDeclaration derived;
    derived.name = "Test_OtherPackage";
    derived.superclass = "CIM_ComputerSystemPackage";
    derived.association = true;
    classes.push_back(derived);
    return om::Schema(classes);
}

class ClassResolution : public testing::Test {
protected:
    ClassResolution() { broker = manager.broker(); }
    ~ClassResolution() override { broker = nullptr; }

    static std::vector<unsigned short> resolve(const char* className) {
        std::vector<unsigned short> ids;
        const bool found = getClassId(className, "root/cimv2", ids);
        EXPECT_EQ(found, !ids.empty());
        return ids;
    }

    const om::Schema schema = schemaWithCommonAncestor();
    om::ObjectManager manager{VK_PROVIDER_LIBRARY, "BaseServerProvider", "root/cimv2", schema};
};

TEST_F(ClassResolution, AnswersTheClassTablesNumberAlone) {
    EXPECT_THAT(resolve("VESKA_ComputerCapabilities"), ElementsAre(33));
    EXPECT_THAT(resolve("VESKA_ComputerSystemPackage"), ElementsAre(24));
    EXPECT_THAT(resolve("VESKA_TimeServiceAffectsElement"), ElementsAre(162));
    EXPECT_THAT(resolve("VESKA_ComputerSystem"), ElementsAre(1));
}

TEST_F(ClassResolution, TakesRelativesOfAnAssociationForIt) {
    EXPECT_THAT(resolve("CIM_ElementCapabilities"), ElementsAre(33));
    EXPECT_THAT(resolve("CIM_ComputerSystemPackage"), ElementsAre(24));
    EXPECT_THAT(resolve("CIM_ServiceAffectsElement"), ElementsAre(162));
    EXPECT_THAT(resolve("Test_OtherPackage"), ElementsAre(24));
}

TEST_F(ClassResolution, AnswersSeveralNumbersInTheOrderOfTheTable) {
    EXPECT_THAT(resolve("Test_AnyAssociation"), ElementsAre(33, 24, 162));
}

TEST_F(ClassResolution, FindsNothingForUnrelatedUnknownOrMissingNames) {
    EXPECT_THAT(resolve("CIM_ComputerSystem"), IsEmpty());
    EXPECT_THAT(resolve("NoSuchClass"), IsEmpty());
    EXPECT_THAT(resolve(""), IsEmpty());
    EXPECT_THAT(resolve(nullptr), IsEmpty());
}

TEST_F(ClassResolution, AppendsToWhatIsThere) {
    std::vector<unsigned short> ids = {7};
    EXPECT_TRUE(getClassId("CIM_ElementCapabilities", "root/cimv2", ids));
    EXPECT_THAT(ids, ElementsAre(7, 33));
}

} // namespace
