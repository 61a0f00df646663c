#include "support/SimulatedHost.h"
#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::parameter;
using cimxml::text;
using testing::ElementsAre;
using testing::SizeIs;

class PullOperations : public testing::Test {
protected:
    PullOperations() {
        test::simulate(
            {test::computer(0, "node7"), test::chassis(0, 0, "A"), test::chassis(0, 1, "B"), test::chassis(0, 2, "C")});
    }
};

Reply open(const std::string& more = "", const char* operation = "OpenEnumerateInstancePaths") {
    return ask(operation, parameter("ClassName", className("VESKA_PhysicalPackage")) + more);
}

std::string count(unsigned number) {
    return parameter("MaxObjectCount", text(std::to_string(number)));
}

Reply pull(const std::string& context, unsigned number, const char* operation = "PullInstancePaths") {
    return ask(operation, parameter("EnumerationContext", text(context)) + count(number));
}

TEST_F(PullOperations, AnEnumerationIsPulledToItsEnd) {
    const Reply opened = open();
    EXPECT_EQ(opened.out("EndOfSequence"), "FALSE");
    EXPECT_THAT(opened.results(), SizeIs(0));
    const std::string context = opened.out("EnumerationContext");
    const Reply first = pull(context, 2);
    EXPECT_THAT(first.results(), SizeIs(2));
    EXPECT_STREQ(first.results().front().name(), "INSTANCEPATH");
    EXPECT_EQ(first.out("EndOfSequence"), "FALSE");
    EXPECT_EQ(first.out("EnumerationContext"), context);
    const Reply last = pull(context, 2);
    EXPECT_THAT(last.results(), SizeIs(1));
    EXPECT_EQ(last.out("EndOfSequence"), "TRUE");
    EXPECT_EQ(last.out("EnumerationContext"), "");
    EXPECT_EQ(pull(context, 2).code, 21);
}

TEST_F(PullOperations, WhatIsSmallComesWithTheOpening) {
    const Reply opened = open(count(10), "OpenEnumerateInstances");
    EXPECT_EQ(opened.out("EndOfSequence"), "TRUE");
    ASSERT_THAT(opened.results(), SizeIs(3));
    EXPECT_TRUE(opened.results().front().child("INSTANCEPATH"));
    EXPECT_TRUE(opened.results().front().child("INSTANCE"));
}

TEST_F(PullOperations, AContextIsOfItsKindAndUser) {
    const std::string context = open().out("EnumerationContext");
    EXPECT_EQ(pull(context, 1, "PullInstancesWithPath").code, 21);
    const Caller other{"other", "", true, true};
    EXPECT_EQ(
        ask(cimxml::intrinsic("PullInstancePaths", parameter("EnumerationContext", text(context)) + count(1)), other)
            .code,
        21);
    EXPECT_EQ(pull(context, 1).code, 0);
}

TEST_F(PullOperations, AnEnumerationCanBeClosed) {
    const std::string context = open().out("EnumerationContext");
    const Reply closed = ask("CloseEnumeration", parameter("EnumerationContext", text(context)));
    EXPECT_EQ(closed.code, 0);
    EXPECT_FALSE(closed.returned());
    EXPECT_EQ(ask("CloseEnumeration", parameter("EnumerationContext", text(context))).code, 21);
}

TEST_F(PullOperations, WhatIsNotOfferedIsRefused) {
    EXPECT_EQ(open(parameter("OperationTimeout", text("0"))).code, 22);
    EXPECT_EQ(open(parameter("OperationTimeout", text("100000"))).code, 22);
    EXPECT_EQ(open(parameter("ContinueOnError", text("TRUE"))).code, 26);
    EXPECT_EQ(open(parameter("FilterQueryLanguage", text("DMTF:FQL")) + parameter("FilterQuery", text("x"))).code, 25);
    EXPECT_EQ(open(parameter("FilterQueryLanguage", text("DMTF:FQL"))).code, 4);
    EXPECT_EQ(open(parameter("MaxObjectCount", text("-1"))).code, 4);
    EXPECT_EQ(open(parameter("IncludeQualifiers", text("TRUE"))).code, 4);
    EXPECT_EQ(ask("PullInstancePaths", parameter("EnumerationContext", text("x"))).code, 4);
    EXPECT_EQ(pull("x", 1).code, 21);
}

TEST_F(PullOperations, AssociationsAreOpenedFromAnInstance) {
    const auto opened = [](const char* operation) {
        return ask(operation, parameter("InstanceName", computerName()) +
                                  parameter("AssocClass", className("VESKA_ComputerSystemPackage")) + count(10));
    };
    EXPECT_THAT(opened("OpenAssociatorInstancePaths").results(), SizeIs(3));
    EXPECT_THAT(opened("OpenAssociatorInstances").results(), SizeIs(3));
    EXPECT_EQ(ask("OpenReferenceInstances", parameter("InstanceName", computerName())).code, 7);
    EXPECT_EQ(ask("OpenAssociatorInstances", parameter("ObjectName", computerName())).code, 4);
}

} // namespace
} // namespace endpoint
