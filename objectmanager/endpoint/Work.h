#pragma once

#include "objectmanager/endpoint/Exchange.h"
#include "objectmanager/endpoint/Listening.h"

#include <sys/types.h>

#include <chrono>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

struct MHD_Connection;

namespace endpoint {

/// A connection, from its first byte to its last.
struct Connection {
    using Clock = std::chrono::steady_clock;

    Listener::Kind kind = Listener::Kind::Unix;
    int socket = -1;
    std::string address;       ///< for the log
    std::optional<uid_t> peer; ///< at the other end of a Unix socket
    bool receiving = true;     ///< a request is arriving, or expected
    Clock::time_point since = Clock::now();
    std::string authorization; ///< that has been checked: its user is `caller`
    std::optional<Caller> caller;
};

/// One request, from its head to its log line.
class Work {
public:
    using Clock = std::chrono::steady_clock;

    HttpRequest http;
    std::shared_ptr<Connection> connection;
    MHD_Connection* handle = nullptr;
    Caller caller;
    Clock::time_point started = Clock::now();
    bool tooLarge = false;
    std::size_t received = 0;
    bool replaced = false; ///< another thread took the place of the one that hangs in it

    /// Once, whoever comes first: the worker, or the watch over those that take too long.
    bool finish(HttpAnswer given);
    bool isFinished() const;
    /// Only after it is finished.
    HttpAnswer answer;

    /// What the provider is doing, for the log.
    void note(std::string text);
    std::string noted() const;

private:
    mutable std::mutex mutex;
    bool finished = false;
    std::string doing;
};

/// Notes what the provider is asked in the work that the present thread does.
Ask noting(Ask provider);

/// The work that this thread does while it lives.
class CurrentWork {
public:
    explicit CurrentWork(Work& work);
    ~CurrentWork();
    CurrentWork(const CurrentWork&) = delete;
    CurrentWork& operator=(const CurrentWork&) = delete;
};

} // namespace endpoint
