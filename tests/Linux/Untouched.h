#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace test {

inline void fill(std::string& text) {
    text = "before";
}
template <class Number>
void fill(Number& number) {
    number = static_cast<Number>(77);
}
template <class Value>
void fill(std::vector<Value>& values) {
    fill(values.emplace_back());
}

/// Asks getters that have no value: each answers false, and leaves its output as it was.
template <class Data, class... Values>
void expectUntouched(const Data& data, bool (Data::*... getters)(Values&) const) {
    int number = 0;
    const auto ask = [&](auto getter, auto value) {
        fill(value);
        const auto before = value;
        EXPECT_FALSE((data.*getter)(value)) << "getter " << number;
        EXPECT_EQ(value, before) << "getter " << number;
        ++number;
    };
    (ask(getters, Values()), ...);
}

} // namespace test
