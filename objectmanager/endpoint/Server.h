#pragma once

#include "objectmanager/endpoint/Listening.h"
#include "objectmanager/endpoint/Operations.h"

#include <atomic>
#include <chrono>
#include <memory>
#include <string>

namespace endpoint {

struct Limits {
    std::size_t body = std::size_t{1} << 20U;
    std::size_t head = std::size_t{16} << 10U;
    unsigned connections = 64;
    unsigned connectionsPerAddress = 8;
    std::chrono::milliseconds arrival = std::chrono::seconds(30); ///< of a whole request
    std::chrono::milliseconds answer = std::chrono::seconds(60);
    std::size_t workers = 8;
    std::size_t queue = 64;
};

struct ServerSettings {
    std::string certificate; ///< in PEM, as is the key; for HTTPS
    std::string key;
    bool anonymousRead = false; ///< everybody may read over the loopback and the Unix socket
    Limits limits;
};

/// The operations over HTTP. Connections are served by one thread for each listener, operations run in workers: one
/// that hangs holds its worker, is named in the log, and its client gets an error in time.
class Server {
public:
    Server(Operations& operations, ServerSettings settings);
    ~Server();
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    /// Throws std::runtime_error, for example for a certificate that cannot be used.
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
