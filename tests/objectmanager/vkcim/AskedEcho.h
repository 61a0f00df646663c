#pragma once

#include "tests/support/Process.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

/// The program, asked about the provider that answers what it was asked.
namespace echo {

using Words = std::vector<std::string>;

inline support::Outcome vkcim(const Words& words, const std::string& input = "") {
    Words all = {VKCIM, "--library", ECHO_PROVIDER, "--provider", "Echo"};
    all.insert(all.end(), words.begin(), words.end());
    return support::runCommand(all, input);
}

/// The JSON answer of a command that succeeds.
inline nlohmann::json answer(Words words, const std::string& input = "") {
    words.insert(words.begin(), {"--format", "json"});
    const support::Outcome outcome = vkcim(words, input);
    EXPECT_EQ(outcome.status, 0) << outcome.error;
    EXPECT_EQ(outcome.error, "");
    EXPECT_EQ(outcome.output.find('\n'), outcome.output.size() - 1) << "one line";
    return nlohmann::json::parse(outcome.output);
}

/// The properties of the only instance answered, each as its value.
inline nlohmann::json properties(const Words& words, const std::string& input = "") {
    const nlohmann::json results = answer(words, input).at("results");
    EXPECT_EQ(results.size(), 1u);
    nlohmann::json values;
    for (const auto& [name, value] : results.at(0).at("properties").items()) values[name] = value.at("value");
    return values;
}

} // namespace echo
