// Asks vkcimd over connections that are kept open, in blocks that alternate with blocks of a constant answer of the
// same size, which the same set-up of libmicrohttpd gives at once. See bench/README.md.
#include "bench/endpoint/Clients.h"
#include "bench/endpoint/Servers.h"
#include "objectmanager/model/Schema.h"
#include "objectmanager/vkcim/RemoteMessages.h"

#include <CLI/CLI.hpp>
#include <fmt/format.h>

#include <algorithm>
#include <chrono>
#include <cstdio>

namespace {

using bench::Clients;
using Clock = std::chrono::steady_clock;

/// A head and a body, for a path of the server.
std::string message(const vkcim::RemoteQuestion& question, const std::string& path) {
    return fmt::format("POST {} HTTP/1.1\r\nHost: localhost\r\nContent-Type: application/xml; charset=\"utf-8\"\r\n"
                       "CIMOperation: MethodCall\r\nCIMMethod: {}\r\nCIMObject: {}\r\nContent-Length: {}\r\n\r\n{}",
                       path, question.method, question.object, question.body.size(), question.body);
}

/// What is asked of both servers.
struct Load {
    std::string name;
    std::vector<std::string> endpoint;
    std::vector<std::string> constant; ///< for answers of the same sizes
};

class Questions {
public:
    explicit Questions(int port) : clients(port, 1) {}

    Load load(const std::string& name, const std::vector<om::Request>& requests) {
        Load made{name, {}, {}};
        for (const om::Request& request : requests) {
            const vkcim::RemoteQuestion question = vkcim::remoteQuestion(request, om::Schema::builtin());
            made.endpoint.push_back(message(question, "/cimom"));
            const std::string answer = clients.askOnce(made.endpoint.back());
            if (answer.find("<ERROR") != std::string::npos) throw std::runtime_error(answer);
            made.constant.push_back(message(question, fmt::format("/{}", answer.size())));
        }
        return made;
    }

    /// The path of the first instance of a class.
    om::ObjectPath first(const std::string& className) {
        const om::Request request = about(om::Operation::EnumInstanceNames, className);
        const vkcim::RemoteQuestion question = vkcim::remoteQuestion(request, om::Schema::builtin());
        const om::Answer answer =
            vkcim::remoteAnswer(clients.askOnce(message(question, "/cimom")), request, om::Schema::builtin());
        if (answer.results.empty()) throw std::runtime_error("there is no " + className);
        om::ObjectPath path = std::get<om::ObjectPath>(answer.results.front());
        path.nameSpace = request.path.nameSpace;
        return path;
    }

    static om::Request about(om::Operation operation, const std::string& className) {
        om::Request request;
        request.operation = operation;
        request.path.className = className;
        request.path.nameSpace = "root/cimv2";
        return request;
    }

private:
    Clients clients;
};

std::vector<Load> loads(int port) {
    using om::Operation;
    const std::string computer = "VESKA_ComputerSystem";
    Questions questions(port);
    const om::Request enumeration = Questions::about(Operation::EnumInstances, computer);
    om::Request get = Questions::about(Operation::GetInstance, computer);
    get.path = questions.first(computer);
    om::Request partners = get;
    partners.operation = Operation::Associators;
    const std::vector<om::Request> mix = {enumeration, Questions::about(Operation::EnumInstanceNames, computer), get,
                                          partners, Questions::about(Operation::EnumInstances, "VESKA_TimeService")};
    return {questions.load("EnumerateInstances", {enumeration}), questions.load("mix", mix)};
}

double median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

/// One of the servers, asked over connections of its own.
class Subject {
public:
    Subject(const bench::ServerProcess& asked, unsigned connections)
        : server(asked), clients(asked.port(), connections) {}

    void block(const std::vector<std::string>& requests, double seconds) {
        const double used = server.processorTime();
        const auto start = Clock::now();
        const std::size_t count = clients.ask(requests, 0, seconds);
        rates.push_back(static_cast<double>(count) / std::chrono::duration<double>(Clock::now() - start).count());
        answers += count;
        processorTime += server.processorTime() - used;
    }

    void forget() {
        rates.clear();
        answers = 0;
        processorTime = 0;
    }

    double rate() const { return median(rates); }
    double microseconds() const { return processorTime / static_cast<double>(answers); }
    /// The other's share of this one's answers, block by block.
    double ratio(const Subject& other) const {
        std::vector<double> shares;
        for (std::size_t i = 0; i < rates.size(); ++i) shares.push_back(other.rates[i] / rates[i]);
        return median(std::move(shares));
    }

private:
    const bench::ServerProcess& server;
    Clients clients;
    std::vector<double> rates;
    std::size_t answers = 0;
    double processorTime = 0;
};

void compare(const bench::Endpoint& endpoint, int rounds, double seconds) {
    const bench::Constant handed(true);
    const bench::Constant direct(false);
    fmt::print("{:<18} {:>11} | {:>10} {:>7} | {:>10} {:>7} {:>5} | {:>10} {:>7} {:>5}\n", "load", "connections",
               "endpoint/s", "CPU us", "worker/s", "CPU us", "ratio", "direct/s", "CPU us", "ratio");
    for (const Load& load : loads(endpoint.port())) {
        for (const unsigned connections : {1U, 8U, 64U}) {
            Subject own(endpoint, connections);
            Subject worker(handed, connections);
            Subject bare(direct, connections);
            for (int round = 0; round <= rounds; ++round) {
                own.block(load.endpoint, seconds);
                worker.block(load.constant, seconds);
                bare.block(load.constant, seconds);
                if (round > 0) continue; // it warmed all up
                for (Subject* each : {&own, &worker, &bare}) each->forget();
            }
            fmt::print(
                "{:<18} {:>11} | {:>10.0f} {:>7.1f} | {:>10.0f} {:>7.1f} {:>5.2f} | {:>10.0f} {:>7.1f} {:>5.2f}\n",
                load.name, connections, own.rate(), own.microseconds(), worker.rate(), worker.microseconds(),
                worker.ratio(own), bare.rate(), bare.microseconds(), bare.ratio(own));
            std::fflush(stdout);
        }
    }
}

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr bool memoryTells = false; ///< a sanitizer keeps what was freed
#else
constexpr bool memoryTells = true;
#endif

/// Whether memory and descriptors stay as they are.
bool staysSmall(const bench::Endpoint& endpoint, std::size_t requests, unsigned connections) {
    const std::size_t allowance = 2048 + std::size_t{32} * connections; ///< KiB: what the allocator takes some day
    const std::vector<std::string> mix = loads(endpoint.port()).back().endpoint;
    Clients clients(endpoint.port(), connections);
    clients.ask(mix, std::max(requests / 20, std::size_t{50} * connections), 0);
    const std::size_t memory = endpoint.residentMemory();
    const std::size_t descriptors = endpoint.descriptors();
    clients.ask(mix, requests, 0);
    const std::size_t after = endpoint.residentMemory();
    const std::size_t open = endpoint.descriptors();
    fmt::print("{} requests: resident memory {} KiB, then {} KiB; descriptors {}, then {}\n", requests, memory, after,
               descriptors, open);
    return (!memoryTells || after <= memory + allowance) && open <= descriptors;
}

/// Returns the exit status: 1 where the server grew, or did not serve or end well; then it has said why.
int soak(bench::Endpoint& endpoint, std::size_t requests, unsigned connections) {
    bool isSmall = false;
    std::string failure;
    try {
        isSmall = staysSmall(endpoint, requests, connections);
    } catch (const std::exception& error) {
        failure = error.what();
    }
    if (!endpoint.end() || !failure.empty())
        failure = fmt::format("{}\nthe server's last words:\n{}", failure, endpoint.lastWords());
    fmt::print(stderr, "{}", failure);
    return isSmall && failure.empty() ? 0 : 1;
}

} // namespace

int main(int argc, char** argv) {
    CLI::App app(
        "Requests a second of vkcimd over kept connections, beside those of a constant answer of the same size.");
    std::string program = VKCIMD;
    int rounds = 9;
    double seconds = 0.5;
    std::size_t requests = 200000;
    unsigned connections = 8;
    app.add_option("--program", program, "vkcimd (the one built here)");
    app.add_option("--rounds", rounds, "blocks of each")->check(CLI::PositiveNumber);
    app.add_option("--seconds", seconds, "of a block")->check(CLI::PositiveNumber);
    CLI::App* const soaking =
        app.add_subcommand("soak", "many requests, with memory and descriptors before and after them; "
                                   "1 if they grow, or the server fails");
    soaking->add_option("--requests", requests, "how many")->check(CLI::PositiveNumber);
    soaking->add_option("--connections", connections, "over how many connections")->check(CLI::Range(1, 64));
    CLI11_PARSE(app, argc, argv);
    try {
        bench::Endpoint endpoint(program);
        if (soaking->parsed()) return soak(endpoint, requests, connections);
        compare(endpoint, rounds, seconds);
        return 0;
    } catch (const std::exception& failure) {
        fmt::print(stderr, "endpoint-load: {}\n", failure.what());
        return 1;
    }
}
