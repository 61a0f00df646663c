#include "objectmanager/endpoint/Contexts.h"

#include "objectmanager/cimxml/Errors.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using namespace std::chrono_literals;

Enumeration enumeration(std::size_t bytes = 1) {
    Enumeration made;
    made.elements = {om::ObjectPath{{}, {}, std::string(bytes, 'x'), {}}};
    made.timeout = 60s;
    return made;
}

TEST(Contexts, AnEnumerationIsTakenOnceAndCanBePutBack) {
    Contexts contexts;
    const std::string name = contexts.keep(enumeration());
    EXPECT_EQ(name.size(), 32U);
    auto taken = contexts.take(name);
    ASSERT_TRUE(taken);
    EXPECT_FALSE(contexts.take(name));
    contexts.putBack(name, std::move(*taken));
    EXPECT_TRUE(contexts.take(name));
    EXPECT_FALSE(contexts.take("unknown"));
}

TEST(Contexts, OneThatIsNotPulledInTimeGoes) {
    Contexts contexts;
    const Contexts::Clock::time_point start{};
    const std::string first = contexts.keep(enumeration(), start);
    const std::string second = contexts.keep(enumeration(), start);
    auto taken = contexts.take(first, start + 59s);
    ASSERT_TRUE(taken);
    contexts.putBack(first, std::move(*taken), start + 59s);
    EXPECT_FALSE(contexts.take(second, start + 60s));
    EXPECT_TRUE(contexts.take(first, start + 118s));
}

Enumeration enumerationOf(const std::string& user) {
    Enumeration made = enumeration();
    made.user = user;
    return made;
}

TEST(Contexts, NobodyTakesThoseOfOthers) {
    Contexts contexts;
    std::string name;
    for (std::size_t i = 0; i < 16; ++i) name = contexts.keep(enumerationOf("greedy"));
    EXPECT_THROW(contexts.keep(enumerationOf("greedy")), cimxml::CimError);
    EXPECT_NO_THROW(contexts.keep(enumerationOf("other")));
    contexts.take(name);
    EXPECT_NO_THROW(contexts.keep(enumerationOf("greedy")));
}

TEST(Contexts, WhatReferencesAndArraysHoldCountsToo) {
    using Reference = std::shared_ptr<const om::ObjectPath>;
    const om::ObjectPath large{{}, {}, std::string(Contexts::mostBytes, 'x'), {}};
    const std::vector<om::Value> list = {{CMPI_ref, Reference()}, {CMPI_ref, std::make_shared<om::ObjectPath>(large)}};
    Enumeration made = enumeration();
    made.elements = {om::Instance{{}, {{"Partners", {CMPI_refA, list}}}}};
    EXPECT_THROW(Contexts().keep(made), cimxml::CimError);
}

TEST(Contexts, NumberAndSizeAreBounded) {
    Contexts contexts;
    const Contexts::Clock::time_point start{};
    for (std::size_t i = 0; i < Contexts::mostContexts; ++i)
        contexts.keep(enumerationOf(std::to_string(i / 16)), start);
    EXPECT_THROW(contexts.keep(enumeration(), start), cimxml::CimError);
    EXPECT_NO_THROW(contexts.keep(enumeration(), start + 60s)); // the others are gone by then
    EXPECT_THROW(contexts.keep(enumeration(Contexts::mostBytes + 1), start + 60s), cimxml::CimError);
    const std::string large = contexts.keep(enumeration(Contexts::mostBytes - 1024), start + 60s);
    EXPECT_THROW(contexts.keep(enumeration(1024), start + 60s), cimxml::CimError);
    contexts.take(large, start + 60s);
    EXPECT_NO_THROW(contexts.keep(enumeration(1024), start + 60s));
}

} // namespace
} // namespace endpoint
