#pragma once

#include <sys/types.h>

#include <cstddef>
#include <cstdio>
#include <string>

namespace bench {

/// A server in a process of its own, on a port of the loopback. It ends with the object.
class ServerProcess {
public:
    ~ServerProcess();
    ServerProcess(const ServerProcess&) = delete;
    ServerProcess& operator=(const ServerProcess&) = delete;

    int port() const { return listening; }
    /// In KiB.
    std::size_t residentMemory() const;
    std::size_t descriptors() const;
    /// Of all its threads, in microseconds.
    double processorTime() const;
    /// Ends it, after half a minute by force. Whether it ended with status 0, which a sanitizer that found something
    /// changes.
    bool end();

protected:
    ServerProcess() = default;
    /// Sets the status of one that has ended.
    bool isRunning(int& status);

    pid_t process = -1;
    int listening = 0;
};

/// vkcimd, over the library built here.
class Endpoint : public ServerProcess {
public:
    explicit Endpoint(const std::string& program);
    ~Endpoint();

    /// The end of its log, once it has ended.
    std::string lastWords() const;

private:
    std::FILE* const log;
};

/// libmicrohttpd as vkcimd uses it, which answers a request for the path /N with N bytes: at once, or by way of a
/// worker as vkcimd does.
class Constant : public ServerProcess {
public:
    explicit Constant(bool worker);
};

} // namespace bench
