// One event of the provider's log, formatted and handed to both channels, none of which keeps it, beside one snprintf
// of the same line.
#include "include/Trace.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <string_view>

namespace {

const std::string category("Norvane.BaseServerProvider");
const VK::TraceSource source{category, "ComputerSystem"};
constexpr char function[] = "getOperationalStatus";
constexpr unsigned int line = 137;

using Once = void (*)();

void methodEvent() {
    VK::traceMethod(VK_METHOD_OF(source, function));
}
void methodLine() {
    char text[512];
    std::snprintf(text, sizeof text, "METHOD: %s() was invoked in %s [Line: %d]", function, source.file.data(),
                  static_cast<int>(line));
    benchmark::DoNotOptimize(text);
}
void variableEvent() {
    VK::traceVariable(VK::TracePoint(source, function, line), "classId", 161U);
}
void variableLine() {
    char text[512];
    std::snprintf(text, sizeof text, "VARIABLE: '%s' has Value '%d' at line %d in %s", "classId", 161,
                  static_cast<int>(line), source.file.data());
    benchmark::DoNotOptimize(text);
}
void scopeEvents() {
    const VK::TraceScope scope(VK_SCOPE_OF(source, function));
}
void scopeLines() {
    for (const char* word : {"ENTERING", "EXITING"}) {
        char text[512];
        std::snprintf(text, sizeof text, "%s: %s() in %s [Line: %d]", word, function, source.file.data(),
                      static_cast<int>(line));
        benchmark::DoNotOptimize(text);
    }
}
const int object = 0;
void pointerEvents() {
    const VK::ParameterTraceScope scope(VK_SCOPE_OF(source, function), " objectPath=", &object);
}
void pointerLines() {
    for (const char* word : {"ENTERING", "EXITING"}) {
        char text[512];
        std::snprintf(text, sizeof text, "%s: %s() in %s [Line: %d],Parameters List:  objectPath=%p", word, function,
                      source.file.data(), static_cast<int>(line), static_cast<const void*>(&object));
        benchmark::DoNotOptimize(text);
    }
}

struct Case {
    const char* name;
    Once once;
};
constexpr Case cases[] = {
    {"Event/method/floor", methodLine},    {"Event/method", methodEvent},     {"Event/variable/floor", variableLine},
    {"Event/variable", variableEvent},     {"Event/scope/floor", scopeLines}, {"Event/scope", scopeEvents},
    {"Event/pointer/floor", pointerLines}, {"Event/pointer", pointerEvents},
};

/// For a program that counts.
int runOne(std::string_view name, long times) {
    for (const Case& each : cases) {
        if (name != each.name) continue;
        for (long i = 0; i < times; ++i) each.once();
        return 0;
    }
    std::fprintf(stderr, "event-bench: there is no %s\n", std::string(name).c_str());
    return 2;
}

} // namespace

int main(int argc, char** argv) {
    setenv("NVLOG_SINK", "none", 1);
    if (argc == 4 && std::strcmp(argv[1], "--run") == 0) return runOne(argv[2], std::strtol(argv[3], nullptr, 10));
    for (const Case& each : cases)
        benchmark::RegisterBenchmark(each.name, [once = each.once](benchmark::State& state) {
            for (auto iteration : state) {
                static_cast<void>(iteration);
                once();
            }
        });
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
