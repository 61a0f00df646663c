#include "objectmanager/mof/Literal.h"

#include <gmock/gmock.h>

#include <limits>

namespace mof {
namespace {

using om::Value;

Value number(std::uint64_t value) {
    return {CMPI_uint64, value};
}

TEST(Literal, ReadsNumbers) {
    const std::pair<const char*, Value> good[] = {
        {"0", number(0)},
        {"+7", number(7)},
        {"18446744073709551615", number(std::numeric_limits<std::uint64_t>::max())},
        {"-9223372036854775808", {CMPI_sint64, std::numeric_limits<std::int64_t>::min()}},
        {"0x1F", number(31)},
        {"+0XfF", number(255)},
        {"-0x10", {CMPI_sint64, std::int64_t{-16}}},
        {"1.5", {CMPI_real64, 1.5}},
        {"-.5e1", {CMPI_real64, -5.0}},
        {"18446744073709551616", {CMPI_real64, 18446744073709551616.0}},
        {"0x10000000000000000", {CMPI_real64, std::numeric_limits<double>::infinity()}},
        {"1.0e999", {CMPI_real64, std::numeric_limits<double>::infinity()}}};
    for (const auto& [text, value] : good) EXPECT_EQ(readLiteral(text), value) << text;
}

TEST(Literal, TakesTheTypeThatItFits) {
    EXPECT_EQ(typed(number(255), CMPI_uint8), (Value{CMPI_uint8, std::uint64_t{255}}));
    EXPECT_EQ(typed(number(5), CMPI_sint8), (Value{CMPI_sint8, std::int64_t{5}}));
    EXPECT_EQ(typed(number(5), CMPI_real32), (Value{CMPI_real32, 5.0}));
    EXPECT_EQ(typed({CMPI_boolean, true}, CMPI_boolean), (Value{CMPI_boolean, true}));
    EXPECT_EQ(typed({CMPI_string, std::string("a")}, CMPI_string), (Value{CMPI_string, std::string("a")}));
    const std::string hour = "00000000010000.000000:000";
    EXPECT_EQ(typed({CMPI_string, hour}, CMPI_dateTime), (Value{CMPI_dateTime, hour}));
    EXPECT_EQ(typed({CMPI_uint64A, std::vector{number(1)}}, CMPI_sint16A),
              (Value{CMPI_sint16A, std::vector{Value{CMPI_sint16, std::int64_t{1}}}}));
    EXPECT_EQ(typed({CMPI_stringA, std::vector<Value>()}, CMPI_uint8A), (Value{CMPI_uint8A, std::vector<Value>()}));
}

TEST(Literal, TakesNoOtherType) {
    const std::pair<Value, CMPIType> bad[] = {{number(256), CMPI_uint8},
                                              {{CMPI_sint64, std::int64_t{-1}}, CMPI_uint8},
                                              {{CMPI_real64, 5.0}, CMPI_uint8},
                                              {number(1), CMPI_boolean},
                                              {number(1), CMPI_string},
                                              {{CMPI_boolean, true}, CMPI_uint8},
                                              {{CMPI_string, std::string("1")}, CMPI_uint8},
                                              {{CMPI_string, std::string("today")}, CMPI_dateTime},
                                              {{CMPI_string, std::string("A.B=1")}, CMPI_ref},
                                              {{}, CMPI_string},
                                              {{}, CMPI_uint8},
                                              {number(1), CMPI_uint8A},
                                              {{CMPI_uint64A, std::vector{number(1)}}, CMPI_uint8},
                                              {{CMPI_uint64A, std::vector{number(1), Value()}}, CMPI_uint8A}};
    for (const auto& [literal, type] : bad) EXPECT_EQ(typed(literal, type), std::nullopt) << type;
}

} // namespace
} // namespace mof
