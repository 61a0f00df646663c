#include "load/Requests.h"
#include "load/Resources.h"
#include "load/Runs.h"

#include <cstdio>
#include <exception>
#include <map>
#include <stdexcept>
#include <string>

namespace {

constexpr char help[] =
    "usage: provider-load [OPTIONS] threads|soak|unload\n"
    "\n"
    "Loads the provider on a simulated host; exit 1 and what went wrong when something did.\n"
    "\n"
    "  threads   mixed requests from many threads at once, each answer compared with that of a single thread\n"
    "  soak      mixed requests one after the other; memory and descriptors must stay flat\n"
    "  unload    load, ask, unload, again and again; every library must be gone and nothing left behind\n"
    "\n"
    "  --threads N     threads (16)\n"
    "  --seconds N     duration of threads (2; 60 by hand)\n"
    "  --requests N    requests of soak (10000; 200000 by hand)\n"
    "  --times N       rounds of unload (100)\n"
    "  --log SINK      NVLOG_SINK, with every level on both channels (file:/dev/null; for soak none)\n"
    "  --library FILE  provider library (the one built here)\n";

struct Options {
    std::map<std::string, unsigned long> numbers = {
        {"--threads", 16}, {"--seconds", 2}, {"--requests", 10000}, {"--times", 100}};
    std::map<std::string, std::string> texts = {{"--log", ""}, {"--library", VK_PROVIDER_LIBRARY}};
    std::string mode;
    bool help = false;

    unsigned number(const char* name) const { return static_cast<unsigned>(numbers.at(name)); }
};

Options parse(int count, char** words) {
    Options options;
    for (int index = 1; index < count; ++index) {
        const std::string word = words[index];
        const bool isNumber = options.numbers.count(word) != 0;
        if (word == "--help") {
            options.help = true;
        } else if (isNumber || options.texts.count(word) != 0) {
            if (++index == count) throw std::invalid_argument(word + " needs a value");
            if (isNumber)
                options.numbers[word] = std::stoul(words[index]);
            else
                options.texts[word] = words[index];
        } else if (options.mode.empty() && word[0] != '-') {
            options.mode = word;
        } else {
            throw std::invalid_argument("what is " + word + "?");
        }
    }
    return options;
}

void run(const Options& options) {
    const std::string& library = options.texts.at("--library");
    const std::string& sink = options.texts.at("--log");
    if (options.mode != "threads" && load::memoryTells() && !load::heapTells())
        std::printf("%s: the heap is not checked, for GLIBC_TUNABLES is set without glibc.malloc.tcache_count=0\n",
                    options.mode.c_str());
    load::makeHost(!sink.empty() ? sink : options.mode == "soak" ? "none" : "file:/dev/null");
    if (options.mode == "threads")
        load::runThreads(library, options.number("--threads"), options.number("--seconds"));
    else if (options.mode == "soak")
        load::runSoak(library, options.numbers.at("--requests"));
    else
        load::runUnload(library, options.number("--times"));
}

} // namespace

int main(int count, char** words) {
    Options options;
    try {
        options = parse(count, words);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "provider-load: %s; see --help\n", error.what());
        return 2;
    }
    if (options.help) return std::fputs(help, stdout) < 0;
    if (options.mode != "threads" && options.mode != "soak" && options.mode != "unload") {
        std::fputs(help, stderr);
        return 2;
    }
    try {
        run(options);
        return 0;
    } catch (const std::exception& error) {
        std::fprintf(stderr, "provider-load: %s: %s\n", options.mode.c_str(), error.what());
        return 1;
    }
}
