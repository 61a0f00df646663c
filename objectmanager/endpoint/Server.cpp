#include "objectmanager/endpoint/Server.h"

#include "objectmanager/endpoint/Daemon.h"

#include <thread>
#include <vector>

namespace endpoint {

class Server::Impl {
public:
    Impl(Operations& operations, const ServerSettings& settings)
        : parts{settings.limits, settings.certificate, Authentication(settings.anonymousRead, settings.limits.trust),
                Connections(settings.limits.connections, settings.limits.connectionsPerAddress),
                Processing(operations, parts.authentication, settings.limits)} {}

    ~Impl() { shutDown(); }

    void serve(const Listener& listener) { daemons.push_back(std::make_unique<Daemon>(listener, parts)); }

    void run(const std::atomic<bool>& stop, std::chrono::seconds idle) {
        while (!stop) {
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
            parts.connections.endSlow(parts.limits.arrival, parts.limits.taking);
            parts.processing.answerForHanging();
            const auto since = parts.connections.idleSince();
            if (idle.count() > 0 && since && Connection::Clock::now() - *since >= idle) return;
        }
    }

    bool shutDown() {
        if (daemons.empty()) return clean;
        clean = parts.processing.stop();
        parts.connections.waitForAnswers(parts.limits.endingOfHanging);
        daemons.clear();
        return clean;
    }

private:
    Parts parts;
    std::vector<std::unique_ptr<Daemon>> daemons;
    bool clean = true;
};

Server::Server(Operations& operations, const ServerSettings& settings)
    : impl(std::make_unique<Impl>(operations, settings)) {}

Server::~Server() = default;

void Server::serve(const Listener& listener) {
    impl->serve(listener);
}

void Server::run(const std::atomic<bool>& stop, std::chrono::seconds idle) {
    impl->run(stop, idle);
}

bool Server::shutDown() {
    return impl->shutDown();
}

} // namespace endpoint
