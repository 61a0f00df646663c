#pragma once

#include "objectmanager/vkcim/Facts.h"

#include <gmock/gmock.h>

/// Facts of hosts that are made up, for tests.
namespace vkcim {

inline const std::string testNameSpace = "root/cimv2";

inline om::Value text(const char* value) {
    return {CMPI_string, std::string(value)};
}

inline om::Value number(std::uint64_t value) {
    return {CMPI_uint16, value};
}

inline om::Value list(CMPIType type, std::vector<om::Value> elements) {
    return {type, std::move(elements)};
}

inline om::Instance instance(const char* className, std::vector<om::NamedValue> properties,
                             const char* name = "node7") {
    return {{"", testNameSpace, className, {{"Name", text(name)}}}, std::move(properties)};
}

/// The facts of a host that answers so, whose clock says so.
inline Facts factsFrom(const std::function<om::Answer(const om::Request&)>& run,
                       const char* time = "20261121060000.123456-300") {
    return gatherFacts(
        om::Schema::builtin(), testNameSpace, {}, run,
        [&] {
            return HostClock{time, "-300"};
        },
        [] {
            return std::vector<std::string>{"no UUID: the host has none", "time service: NTP daemon ntpd running"};
        });
}

/// The facts of a host whose computer and chassis have these properties.
inline Facts factsOf(const std::vector<om::NamedValue>& computer,
                     const std::vector<std::vector<om::NamedValue>>& chassis = {}, const char* name = "node7") {
    return factsFrom([&](const om::Request& request) {
        om::Answer answer;
        if (request.path.className == "VESKA_ComputerSystem")
            answer.results.emplace_back(instance("VESKA_ComputerSystem", computer, name));
        if (request.path.className == "VESKA_PhysicalPackage")
            for (const auto& each : chassis) answer.results.emplace_back(instance("VESKA_PhysicalPackage", each));
        EXPECT_EQ(request.operation, om::Operation::EnumInstances) << "facts change nothing";
        return answer;
    });
}

} // namespace vkcim
