#pragma once

#include "objectmanager/endpoint/Certificate.h"
#include "objectmanager/endpoint/Limits.h"
#include "objectmanager/endpoint/Listening.h"
#include "objectmanager/endpoint/Operations.h"

#include <atomic>
#include <chrono>
#include <memory>

namespace endpoint {

struct ServerSettings {
    std::shared_ptr<Certificate> certificate; ///< for HTTPS
    bool anonymousRead = false;               ///< everybody may read over the loopback and the Unix socket
    Limits limits;
};

/// The operations over HTTP.
class Server {
public:
    Server(Operations& operations, const ServerSettings& settings);
    ~Server();
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    /// Throws std::runtime_error, and std::invalid_argument for HTTPS without a certificate.
    void serve(const Listener& listener);

    /// Returns when `stop` is true, or when no connection was open and no request came for that long (0: never).
    void run(const std::atomic<bool>& stop, std::chrono::seconds idle);

    /// Whether no provider hangs, so that the process can end in good order.
    bool shutDown();

private:
    class Impl;
    std::unique_ptr<Impl> impl;
};

} // namespace endpoint
