// Every combination of ManageTime's arguments, and what each group of them does.

#include "support/FakeCommands.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <regex>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

enum GetRequest : unsigned { GetMissing = 1, GetOfWrongType = 2, GetNull = 4, Get = 8, Set = 16 };
enum Element : unsigned { ElementMissing = 1, ElementOfWrongType = 2, Reference = 4, NullReference = 8 };
enum Time : unsigned {
    TimeMissing = 1,
    TimeOfWrongType = 2,
    TimeNull = 4,
    East = 8,
    West = 16,
    Utc = 32,
    Interval = 64
};
constexpr unsigned any = ~0U;

/// One combination; `count` arguments in all, of which those that are missing above are made up for by others.
struct Combination {
    unsigned count;
    unsigned getRequest;
    unsigned element;
    unsigned time;
};

/// Combinations that have the same outcome: each member is a set, of counts as bits 1 << count.
struct Group {
    const char* name;
    Combination set;
    unsigned code;
    bool answersTime;       ///< "TimeData" among the out arguments
    const char* offset;     ///< property 127 after the call, as JSON
    const char* timeOfHost; ///< property 126 after the call
};

constexpr unsigned bit(unsigned count) {
    return 1U << count;
}
constexpr unsigned usable = bit(2) | bit(3);
constexpr unsigned anyReference = Reference | NullReference;
constexpr char asBefore[] = "77";

constexpr Group groups[] = {
    {"count", {any & ~usable, any, any, any}, 4, false, asBefore, ""},
    {"no request", {usable, GetMissing | GetOfWrongType | GetNull, any, any}, 4, false, asBefore, ""},
    {"no element", {usable, Get | Set, ElementMissing | ElementOfWrongType, any}, 1, false, asBefore, ""},
    {"get", {usable, Get, anyReference, any}, 0, true, asBefore, ""},
    {"no time", {usable, Set, anyReference, TimeMissing | TimeOfWrongType | TimeNull}, 1, false, asBefore, ""},
    {"set east", {usable, Set, anyReference, East}, 0, true, "60", "20240101110000.000000+000"},
    {"set west", {usable, Set, anyReference, West}, 0, true, "4294966996", "20240101170000.000000+000"},
    {"set UTC", {usable, Set, anyReference, Utc}, 0, true, "0", "20240101120000.000000+000"},
    {"set interval", {usable, Set, anyReference, Interval}, 0, true, "0", "19700102000000.000000+000"},
};

om::Value getRequest(unsigned kind) {
    if (kind == GetOfWrongType) return {CMPI_string, std::string("true")};
    if (kind == GetNull) return {CMPI_boolean, {}};
    return {CMPI_boolean, kind == Get};
}

om::Value element(unsigned kind) {
    if (kind == ElementOfWrongType) return {CMPI_string, std::string("VESKA_TimeService")};
    if (kind == NullReference) return {CMPI_ref, {}};
    return {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("VESKA_ComputerSystem", {{"Name", "other"}}))};
}

om::Value time(unsigned kind) {
    switch (kind) {
    case TimeOfWrongType:
        return {CMPI_string, std::string("20240101120000.000000+060")};
    case TimeNull:
        return {CMPI_dateTime, {}};
    case East:
        return {CMPI_dateTime, std::string("20240101120000.000000+060")};
    case West:
        return {CMPI_dateTime, std::string("20240101120000.999999-300")};
    case Utc:
        return {CMPI_dateTime, std::string("20240101120000.000000+000")};
    default:
        return {CMPI_dateTime, std::string("00000001000000.000000:000")};
    }
}

/// The arguments of a combination; nothing if there is none with so few arguments.
std::optional<std::vector<om::NamedValue>> arguments(const Combination& combination) {
    std::vector<om::NamedValue> in;
    if (combination.getRequest != GetMissing) in.push_back({"GetRequest", getRequest(combination.getRequest)});
    if (combination.element != ElementMissing) in.push_back({"ManagedElement", element(combination.element)});
    if (combination.time != TimeMissing) in.push_back({"TimeData", time(combination.time)});
    if (in.size() > combination.count) return std::nullopt;
    while (in.size() < combination.count)
        in.push_back({"Other" + std::to_string(in.size()), {CMPI_uint32, std::uint64_t{1}}});
    return in;
}

std::vector<const Group*> groupsOf(const Combination& combination) {
    std::vector<const Group*> found;
    for (const Group& group : groups)
        if ((group.set.count & bit(combination.count)) != 0 && (group.set.getRequest & combination.getRequest) != 0 &&
            (group.set.element & combination.element) != 0 && (group.set.time & combination.time) != 0)
            found.push_back(&group);
    return found;
}

void expectOutcome(const Group& group, const std::vector<om::NamedValue>& in, test::FakeCommands& commands) {
    test::Node computer = test::computer(0, "node7");
    computer.properties[127] = 77;
    test::simulate({computer});
    commands.take();

    const om::Answer answer = test::invoke(test::path("VESKA_TimeService"), "ManageTime", in);

    EXPECT_EQ(answer.code, static_cast<CMPIrc>(group.code));
    EXPECT_EQ(answer.message, std::nullopt);
    EXPECT_TRUE(answer.done);
    ASSERT_TRUE(answer.returnValue.has_value());
    EXPECT_EQ(answer.returnValue->type, CMPI_uint32);
    EXPECT_EQ(std::get<std::uint64_t>(answer.returnValue->data), group.code);
    if (group.answersTime) {
        ASSERT_THAT(test::namesOf(answer.out), ElementsAre("TimeData"));
        EXPECT_EQ(answer.out[0].second.type, CMPI_dateTime);
        EXPECT_TRUE(
            std::regex_match(test::text(answer.out[0].second), std::regex("20[0-9]{12}\\.[0-9]{6}[+-][0-9]{3}")));
    } else {
        EXPECT_THAT(answer.out, IsEmpty());
    }
    EXPECT_EQ(test::simulatedProperty("/computer/0", 127).dump(), group.offset);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), group.timeOfHost);
    if (*group.timeOfHost != '\0')
        EXPECT_THAT(commands.take(), ElementsAre("ps [-ef]", "ntpd [-xgq]"));
    else
        EXPECT_THAT(commands.take(), IsEmpty());
}

TEST(ManageTimeArguments, HaveTheOutcomeOfTheOneGroupThatTheyBelongTo) {
    test::FakeCommands commands;
    commands.add("ps");
    commands.add("ntpd", test::printing({"ntpd: time set +0.000012s"}));
    std::map<std::string, unsigned> seen;
    for (unsigned count = 0; count <= 4; ++count)
        for (unsigned request = GetMissing; request <= Set; request *= 2)
            for (unsigned elementKind = ElementMissing; elementKind <= NullReference; elementKind *= 2)
                for (unsigned timeKind = TimeMissing; timeKind <= Interval; timeKind *= 2) {
                    const Combination combination = {count, request, elementKind, timeKind};
                    const auto in = arguments(combination);
                    if (!in) continue;
                    SCOPED_TRACE("count " + std::to_string(count) + ", GetRequest " + std::to_string(request) +
                                 ", ManagedElement " + std::to_string(elementKind) + ", TimeData " +
                                 std::to_string(timeKind));
                    const std::vector<const Group*> found = groupsOf(combination);
                    ASSERT_EQ(found.size(), 1U);
                    ++seen[found.front()->name];
                    expectOutcome(*found.front(), *in, commands);
                }
    unsigned combinations = 0;
    for (const Group& group : groups) {
        EXPECT_GT(seen[group.name], 0U) << group.name << " is never run";
        combinations += seen[group.name];
    }
    EXPECT_EQ(combinations, 1U + 14U + 68U + 140U + 140U) << "of 0, 1, 2, 3 and 4 arguments";
}

} // namespace
