#pragma once

#include "objectmanager/endpoint/Connections.h"
#include "objectmanager/endpoint/Exchange.h"

#include <chrono>
#include <memory>
#include <mutex>
#include <string>

struct MHD_Connection;

namespace endpoint {

class Workers;

/// One request, from its head to its log line.
class Work {
public:
    using Clock = std::chrono::steady_clock;

    HttpRequest http;
    ConnectionPointer connection;
    MHD_Connection* handle = nullptr;
    Caller caller; ///< as soon as it is known
    Clock::time_point started = Clock::now();
    bool tooLarge = false;
    Workers* workers = nullptr; ///< those that it was handed to
    bool hangs = false;         ///< its thread was named in the log
    bool replaced = false;      ///< another thread took the place of the one that hangs in it

    /// Once the work is finished none of these does anything, and false says so: what was answered is not carried out.
    bool start(std::string doing);
    void know(const Caller& who);
    /// What an answer says for the log, once the message was read.
    bool ask(const HttpAnswer& asked);
    HttpAnswer question() const;

    /// Takes a piece of the body. Nothing is kept of one that is longer than allowed, and false says that it goes on
    /// for too long to be read to its end.
    bool receive(std::string_view piece, std::size_t longest);

    /// Once, whoever comes first: the worker, or the watch over those that take too long.
    bool finish(HttpAnswer given);
    bool isFinished() const;
    /// Only after it is finished.
    HttpAnswer answer;
    /// Takes what comes next of an answer that is written while it is sent; nothing at its end.
    std::size_t take(char* to, std::size_t room);

    /// Says in the log line why the client did not get the whole answer. The first reason is the cause of all others.
    void breakOff(std::string_view reason);

    /// What the provider is doing, for the log.
    void note(std::string text);
    std::string noted() const;

    /// Who asked what, how it went and how long it took.
    std::string logLine() const;

private:
    mutable std::mutex mutex;
    std::size_t received = 0;
    std::size_t sent = 0; ///< of the answer's present piece
    bool finished = false;
    bool broken = false; ///< its answer ended too early
    std::string doing;
    HttpAnswer asked;
};

using WorkPointer = std::shared_ptr<Work>;

/// An answer of HTTP alone. The detail is for the log.
HttpAnswer plainAnswer(unsigned status, std::string detail);

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
