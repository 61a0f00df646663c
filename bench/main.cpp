#include "bench/Floor.h"
#include "bench/Host.h"
#include "bench/Rows.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <map>
#include <memory>
#include <optional>
#include <stdexcept>
#include <thread>
#include <vector>

#include <dlfcn.h>

namespace bench {
namespace {

constexpr char usage[] =
    R"(Measures the provider through the embedded object manager, without a log, and beside each request its floor: the
broker calls alone that make the same answer. Times are those of the provider's function, without the object manager's
own work around it.

usage: provider-bench [--live] [--cold] [BENCHMARK OPTIONS]
       provider-bench [--live] [--cold] --run NAME TIMES

  --live            ask about this machine instead of simulated hosts
  --cold            as in a server that does other things: walk over 8 MiB before each request, and use a new thread for it
  --run NAME TIMES  run one benchmark so many times, measuring nothing: for a program that counts
  --help            this text; --benchmark_list_tests lists the names, --benchmark_filter=REGEX chooses

)";

/// The provider and its floor, each in an object manager of its own.
struct Bench {
    Bench(bool live, bool coldRequests)
        : host(live), cold(coldRequests), provider(PROVIDER_LIBRARY, "BaseServerProvider", "root/cimv2"),
          floor(FLOOR_LIBRARY, "Floor", "root/cimv2") {
        void* const library = dlopen(FLOOR_LIBRARY, RTLD_NOW | RTLD_NOLOAD);
        if (library == nullptr) throw std::runtime_error("the floor's library is not loaded");
        prepareFloor = reinterpret_cast<decltype(&Floor_Prepare)>(dlsym(library, "Floor_Prepare"));
        dlclose(library); // the object manager keeps it
        if (prepareFloor == nullptr) throw std::runtime_error("the floor's library lacks Floor_Prepare");
    }

    Host host;
    const bool cold;
    om::ObjectManager provider;
    om::ObjectManager floor;
    decltype(&Floor_Prepare) prepareFloor;
};

/// One benchmark: a row at one number of computers, of the provider or of its floor.
struct Case {
    std::string name;
    Row row;
    int computers;
    bool ofFloor;
};

/// Fills the processor's caches with something else.
void walkOverMemory() {
    constexpr std::size_t size = std::size_t{8} << 20, cacheLine = 64;
    static std::vector<unsigned char> bytes(size);
    for (std::size_t i = 0; i < size; i += cacheLine) ++bytes[i];
    benchmark::DoNotOptimize(bytes.data());
}

/// What a case runs, with the host made ready for it.
class Prepared {
public:
    Prepared(Bench& theBench, const Case& theCase) : bench(theBench), ofFloor(theCase.ofFloor) {
        bench.host.use(theCase.computers);
        request = requestOf(theCase.row, bench.provider);
        answer = bench.provider.run(request);
        if (answer.code != CMPI_RC_OK || answer.results.empty())
            throw std::runtime_error(theCase.name + ": the provider has no answer");
        bench.prepareFloor(&answer);
    }

    /// Runs it once: the time in the provider's function, or nothing when the answer was another one than before.
    std::optional<std::chrono::nanoseconds> run() {
        if (!bench.cold) return runHere();
        walkOverMemory();
        std::optional<std::chrono::nanoseconds> elapsed;
        std::thread([&] { elapsed = runHere(); }).join();
        return elapsed;
    }

private:
    std::optional<std::chrono::nanoseconds> runHere() {
        std::chrono::nanoseconds elapsed{0};
        const om::Answer now = (ofFloor ? bench.floor : bench.provider).run(request, &elapsed);
        const bool same =
            now.code == CMPI_RC_OK && now.done == answer.done && now.results.size() == answer.results.size();
        return same ? std::optional(elapsed) : std::nullopt;
    }

    Bench& bench;
    const bool ofFloor;
    om::Request request;
    om::Answer answer;
};

/// Each floor before what stands on it, so that the ratio is known when that is measured.
std::vector<Case> cases(bool live) {
    std::vector<Case> all;
    for (const Row& row : rows()) {
        for (const int computers : live ? one : row.computers) {
            const std::string name = nameOf(row, live, computers);
            all.push_back({name + "/floor", row, computers, true});
            all.push_back({name, row, computers, false});
        }
    }
    return all;
}

/// Mean nanoseconds of the cases measured so far, by name.
using Means = std::map<std::string, double>;

/// A host need not have an element of every class: such a case is left out, and said to be.
std::optional<Prepared> prepare(benchmark::State& state, Bench& bench, const Case& measured) {
    try {
        return std::optional<Prepared>(std::in_place, bench, measured);
    } catch (const std::exception& exception) {
        state.SkipWithError(exception.what());
        return std::nullopt;
    }
}

void measure(benchmark::State& state, Bench& bench, const Case& measured, Means& means) {
    std::optional<Prepared> prepared = prepare(state, bench, measured);
    if (!prepared) return;
    std::chrono::nanoseconds sum{0};
    for (auto iteration : state) {
        static_cast<void>(iteration);
        const auto elapsed = prepared->run();
        if (!elapsed) {
            state.SkipWithError("the answer changed");
            return;
        }
        sum += *elapsed;
        state.SetIterationTime(std::chrono::duration<double>(*elapsed).count());
    }
    const double mean = static_cast<double>(sum.count()) / static_cast<double>(state.iterations());
    means[measured.name] = mean;
    const auto floor = means.find(measured.name + "/floor");
    if (!measured.ofFloor && floor != means.end()) state.counters["ratio"] = mean / floor->second;
}

/// On standard error, since standard output may be JSON.
void printRatios(const std::vector<Case>& all, const Means& means) {
    std::fprintf(stderr, "\n%-56s %14s %14s %7s\n", "request", "provider ns", "floor ns", "ratio");
    for (const Case& each : all) {
        const auto own = means.find(each.name);
        const auto floor = means.find(each.name + "/floor");
        if (own == means.end() || floor == means.end()) continue;
        std::fprintf(stderr, "%-56s %14.0f %14.0f %7.2f\n", each.name.c_str(), own->second, floor->second,
                     own->second / floor->second);
    }
}

int runBenchmarks(Bench& bench, int argc, char** argv) {
    const std::vector<Case> all = cases(bench.host.isLive());
    Means means;
    for (const Case& each : all)
        benchmark::RegisterBenchmark(each.name.c_str(), [&](benchmark::State& state) {
            measure(state, bench, each, means);
        })->UseManualTime();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
    benchmark::RunSpecifiedBenchmarks();
    printRatios(all, means);
    benchmark::Shutdown();
    return 0;
}

int runOne(Bench& bench, const std::string& name, long times) {
    for (const Case& each : cases(bench.host.isLive())) {
        if (each.name != name) continue;
        Prepared prepared(bench, each);
        for (long i = 0; i < times; ++i) {
            if (!prepared.run()) throw std::runtime_error("the answer changed");
        }
        return 0;
    }
    std::fprintf(stderr, "provider-bench: there is no %s\n", name.c_str());
    return 2;
}

/// Takes an argument out of the list if it stands first.
bool take(int& argc, char** argv, const char* argument) {
    if (argc < 2 || std::strcmp(argv[1], argument) != 0) return false;
    for (int i = 1; i < argc; ++i) argv[i] = argv[i + 1];
    --argc;
    return true;
}

int run(int argc, char** argv) {
    if (argc > 1 && std::strcmp(argv[1], "--help") == 0) {
        std::fputs(usage, stdout);
        return 0;
    }
    const bool live = take(argc, argv, "--live"), cold = take(argc, argv, "--cold");
    Bench bench(live, cold);
    if (!take(argc, argv, "--run")) return runBenchmarks(bench, argc, argv);
    if (argc != 3) {
        std::fputs(usage, stderr);
        return 2;
    }
    return runOne(bench, argv[1], std::strtol(argv[2], nullptr, 10));
}

} // namespace
} // namespace bench

int main(int argc, char** argv) {
    try {
        return bench::run(argc, argv);
    } catch (const std::exception& exception) {
        std::fprintf(stderr, "provider-bench: %s\n", exception.what());
        return 1;
    }
}
