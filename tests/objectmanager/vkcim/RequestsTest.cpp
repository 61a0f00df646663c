#include "objectmanager/vkcim/Requests.h"
#include "objectmanager/vkcim/ValueText.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>

#include <sstream>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::ThrowsMessage;

om::Request request(const std::vector<std::string>& words, const std::string& input = "") {
    std::istringstream stream(input);
    return makeRequest(parseArguments(words).arguments.value(), testSchema(), stream);
}

std::string value(const om::Request& request, std::size_t index) {
    const om::NamedValue& named = request.values.at(index);
    return named.first + '=' + valueText(named.second, {request.path.nameSpace, testSchema()});
}

TEST(Requests, PropertiesTakeTheTypeOfTheClass) {
    const om::Request made = request({"modify", "test_specialthing.Name=\"a\"", "speed=7", "States=2,11", "Other=7"});
    EXPECT_EQ(made.operation, om::Operation::ModifyInstance);
    EXPECT_EQ(value(made, 0), "speed=uint16:7");
    EXPECT_EQ(value(made, 1), "States=uint16[]:2,11");
    EXPECT_EQ(value(made, 2), "Other=uint32:7");
}

TEST(Requests, ArgumentsTakeTheTypeOfTheMethodsParameters) {
    const om::Request made = request({"invoke", "Test_Thing", "START", "level=-3", "Speed=7"});
    EXPECT_EQ(made.method, "START");
    EXPECT_EQ(value(made, 0), "level=sint8:-3");
    EXPECT_EQ(value(made, 1), "Speed=uint32:7") << "a property of that name is no parameter";
}

TEST(Requests, APathMayComeFromStandardInput) {
    EXPECT_EQ(request({"get", "-"}, "root/x:Test_Thing\nignored").path.nameSpace, "root/x");
    EXPECT_EQ(request({"get", "-"}, "Test_Thing\r\n").path.className, "Test_Thing");
    EXPECT_THAT([] { request({"get", "-"}); }, ThrowsMessage<std::runtime_error>(HasSubstr("no path")));
    EXPECT_THAT(
        [] {
            request({"get", "-"}, std::string("Test\0Thing\n", 11));
        },
        ThrowsMessage<std::runtime_error>(HasSubstr("a zero byte at 4")));
}

TEST(Requests, AQueryNamesItsClassInThePath) {
    const om::Request made = request({"query", "SELECT Name from  Test_Thing WHERE Name = 'from'"});
    EXPECT_EQ(made.language, "WQL");
    EXPECT_EQ(made.query, "SELECT Name from  Test_Thing WHERE Name = 'from'");
    EXPECT_EQ(made.path.className, "Test_Thing");
    EXPECT_EQ(request({"query", "no sense"}).path.className, "");
}

TEST(Requests, OptionsAreHandedOn) {
    const om::Request made = request({"associators", "Test_Thing", "--assoc-class", "A", "--result-class", "B",
                                      "--role", "C", "--result-role", "D", "--properties", "E,F"});
    EXPECT_EQ(made.assocClass, "A");
    EXPECT_EQ(made.resultClass, "B");
    EXPECT_EQ(made.role, "C");
    EXPECT_EQ(made.resultRole, "D");
    EXPECT_EQ(made.propertyList, (std::vector<std::string>{"E", "F"}));
}

TEST(Requests, AValueIsAskedOfOneInstanceOrOfAll) {
    EXPECT_EQ(request({"value", "Test_Thing", "Speed"}).operation, om::Operation::EnumInstances);
    EXPECT_EQ(request({"value", "Test_Thing.Name=\"a\"", "Speed"}).operation, om::Operation::GetInstance);
}

TEST(Requests, WhatMayBeATypingErrorIsRemarkedOnAndAskedAllTheSame) {
    const auto remarks = [](const std::vector<std::string>& words) {
        std::vector<std::string> found;
        std::istringstream none;
        makeRequest(parseArguments(words).arguments.value(), testSchema(), none, &found);
        return found;
    };
    EXPECT_THAT(remarks({"get", "Test_Thing.Nmae=\"a\""}),
                ElementsAre("path Test_Thing.Nmae=\"a\": position 12: Test_Thing has no key Nmae; did you mean Name?"));
    EXPECT_THAT(remarks({"invoke", "Test_Thing", "Start", "Thing=ref:Test_Thing.Name=7"}),
                ElementsAre("Thing=ref:Test_Thing.Name=7: position 27: key Name of Test_Thing is text in quotes",
                            "Start has no parameter Thing; its parameters: Level"));
    EXPECT_THAT(remarks({"modify", "Test_Thing", "Sped=1"}),
                ElementsAre("Test_Thing has no property Sped; did you mean Speed?"));
}

TEST(Requests, TextsThatCannotBeReadAreNamed) {
    EXPECT_THAT([] { request({"names", "A.K=1"}); }, ThrowsMessage<std::runtime_error>(HasSubstr("no keys")));
    EXPECT_THAT(
        [] {
            request({"get", "A.K"});
        },
        ThrowsMessage<std::runtime_error>(HasSubstr("path A.K: position 4: '=' is missing")));
    EXPECT_THAT(
        [] {
            request({"modify", "Test_Thing", "Speed=70000"});
        },
        ThrowsMessage<std::runtime_error>(HasSubstr("Speed=70000: position 7: 70000 is out of range")));
    EXPECT_THAT(
        [] {
            request({"modify", "Test_Thing", "Speed=7", "SPEED=8"});
        },
        ThrowsMessage<std::runtime_error>(HasSubstr("given twice")));
}

} // namespace
} // namespace vkcim
