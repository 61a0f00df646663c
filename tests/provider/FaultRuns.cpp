#include "provider/FaultRuns.h"

#include "support/HostName.h"
#include "support/NoCommands.h"
#include "support/SimulatedHost.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>

namespace test {
namespace {

using Result = std::variant<om::ObjectPath, om::Instance>;

constexpr std::size_t mostCalls = 5000;

const om::ObjectPath& pathOf(const Result& result) {
    const auto* instance = std::get_if<om::Instance>(&result);
    return instance != nullptr ? instance->path : std::get<om::ObjectPath>(result);
}

/// The properties that a whole instance has and this one lacks; nothing when it is not a part of it, in its order.
std::optional<std::size_t> missing(const om::Instance& part, const om::Instance& whole) {
    auto at = whole.properties.begin();
    for (const om::NamedValue& property : part.properties) {
        at = std::find(at, whole.properties.end(), property);
        if (at == whole.properties.end()) return std::nullopt;
        ++at;
    }
    return whole.properties.size() - part.properties.size();
}

std::map<std::string, std::size_t> countByClass(const om::Answer& answer) {
    std::map<std::string, std::size_t> counts;
    for (const Result& result : answer.results) ++counts[pathOf(result).className];
    return counts;
}

/// Whether the fault happened.
bool runWith(const FaultCase& each, const om::Fault& fault, const std::string& kind, Tally& tally, const Check& check) {
    SCOPED_TRACE(each.name + " with " + kind + ":" + std::to_string(fault.call) + (fault.lasting ? "+" : "") +
                 (fault.unstated ? ":null" : ""));
    om::Request request = each.request;
    request.fault = fault;
    const Outcome outcome = runOnce(request);
    if (!outcome.answer.faulted) return false;
    ++tally.runs;
    tally.kinds.insert(kind);
    check(kind, fault.unstated, outcome);
    return true;
}

} // namespace

void simulateHostForFaults() {
    simulate({computer(0, hostName()), computer(1, "node8"), chassis(0, 0, "CZ1"), chassis(0, 1, "CZ2"),
              chassis(1, 0, "CZ3")});
}

const nlohmann::json& untouchedHost() {
    static const nlohmann::json host = [] {
        simulateHostForFaults();
        return simulatedFile();
    }();
    return host;
}

Outcome runOnce(const om::Request& request) {
    const nlohmann::json& untouched = untouchedHost();
    if (simulatedFile() != untouched) simulateHostForFaults();
    takeLog();
    takeCommands();
    Outcome outcome;
    outcome.answer = provider().run(request);
    for (const std::string& line : withoutPlaces(takeLog()))
        if (line.rfind("LOG ", 0) == 0) outcome.lines.push_back(line);
    outcome.host = simulatedFile();
    outcome.commands = takeCommands();
    return outcome;
}

std::vector<std::string> added(const std::vector<std::string>& lines, const std::vector<std::string>& whole) {
    std::vector<std::string> some = lines;
    std::vector<std::string> all = whole;
    std::sort(some.begin(), some.end());
    std::sort(all.begin(), all.end());
    std::vector<std::string> more;
    std::set_difference(some.begin(), some.end(), all.begin(), all.end(), std::back_inserter(more));
    return more;
}

bool tellsException(const std::string& line) {
    return line.find("LOG 3000 Norvane.BaseServerProvider BaseServerProvider BaseServer_") != std::string::npos;
}

bool isOneOf(const std::string& kind, const std::set<std::string>& kinds) {
    return kinds.count(kind) != 0;
}

Loss compare(const om::Answer& part, const om::Answer& whole) {
    Loss loss;
    auto at = whole.results.begin();
    for (const Result& result : part.results) {
        at = std::find_if(at, whole.results.end(), [&](const Result& each) {
            return pathOf(each) == pathOf(result) && each.index() == result.index();
        });
        if (at == whole.results.end()) {
            ADD_FAILURE() << "answered something else, or half of it: " << print(pathOf(result));
            return loss;
        }
        if (const auto* instance = std::get_if<om::Instance>(&result)) {
            const auto lost = missing(*instance, std::get<om::Instance>(*at));
            EXPECT_TRUE(lost) << "a property that the whole instance does not have";
            loss.properties += lost.value_or(0);
        }
        ++at;
    }
    loss.elements = whole.results.size() - part.results.size();
    const auto left = countByClass(part);
    for (const auto& [className, count] : countByClass(whole))
        if (const auto found = left.find(className); found != left.end()) loss.besideOthers += count - found->second;
    return loss;
}

void failEachCall(const FaultCase& each, Tally& tally, const Check& check) {
    for (const std::string& kind : om::faultNames()) {
        for (const bool unstated : {false, true}) {
            std::size_t call = 1;
            while (call <= mostCalls &&
                   runWith(each, {*om::faultKind(kind), call, false, unstated}, kind, tally, check))
                ++call;
            EXPECT_LE(call, mostCalls) << each.name << ": there is no end to the calls of " << kind;
            if (testing::Test::HasFailure()) return; // one fault's lines are enough
            if (call == 1) break;                    // no call of that kind, with or without its status
        }
    }
}

void failAllCalls(const FaultCase& each, Tally& tally, const Check& check) {
    for (const std::string& kind : std::set<std::string>(tally.kinds)) {
        runWith(each, {*om::faultKind(kind), 1, true, false}, kind, tally, check);
        if (testing::Test::HasFailure()) return;
    }
}

} // namespace test
