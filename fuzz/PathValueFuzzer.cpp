// The command line's PATH and VALUE texts: whatever can be read is printed as a text that reads back the same, and
// fits into an answer in JSON.
#include "objectmanager/model/Schema.h"
#include "objectmanager/vkcim/JsonOutput.h"
#include "objectmanager/vkcim/ParseError.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/ValueText.h"

#include <nlohmann/json.hpp>

#include <cstdint>
#include <cstdio>
#include <cstdlib>

namespace {

const std::string nameSpace = "root/cimv2";

void expect(bool holds, const char* what) {
    if (holds) return;
    std::fprintf(stderr, "%s\n", what);
    std::abort();
}

void tryPath(std::string_view text, const om::Schema& schema) {
    const om::ObjectPath path = vkcim::parsePath(text, nameSpace, schema);
    const std::string printed = vkcim::qualifiedPathText(path, nameSpace, schema);
    expect(vkcim::parsePath(printed, nameSpace, schema) == path, "the printed path reads back as another one");
    om::Answer answer;
    answer.results.emplace_back(path);
    expect(!nlohmann::json::parse(vkcim::jsonText(answer, nameSpace, schema)).is_null(), "no JSON");
}

void tryValue(std::string_view text, std::optional<CMPIType> declared, const om::Schema& schema) {
    const om::Value value = vkcim::parseValue(text, declared, {nameSpace, schema});
    const std::string printed = vkcim::valueText(value, {nameSpace, schema});
    const om::Value again = vkcim::parseValue(printed, std::nullopt, {nameSpace, schema});
    expect(again.type == value.type, "the printed value reads back with another type");
    // Texts, since NaN differs from itself.
    expect(vkcim::valueText(again, {nameSpace, schema}) == printed, "the printed value reads back as another one");
    om::Answer answer;
    answer.returnValue = value;
    expect(!nlohmann::json::parse(vkcim::jsonText(answer, nameSpace, schema)).is_null(), "no JSON");
}

template <typename Try>
void unlessRefused(std::string_view text, const Try& attempt) {
    try {
        attempt();
    } catch (const vkcim::ParseError& error) {
        expect(error.position >= 1 && error.position <= text.size() + 1, "an error's position lies outside the text");
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const om::Schema& schema = om::Schema::builtin();
    unlessRefused(text, [&] { tryPath(text, schema); });
    unlessRefused(text, [&] { tryValue(text, std::nullopt, schema); });
    for (const int declared : {CMPI_real32, CMPI_real64, CMPI_stringA, CMPI_refA, CMPI_dateTime, CMPI_sint8}) {
        unlessRefused(text, [&] { tryValue(text, static_cast<CMPIType>(declared), schema); });
    }
    return 0;
}
