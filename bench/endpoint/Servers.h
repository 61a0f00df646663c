#pragma once

#include <sys/types.h>

#include <cstddef>
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

protected:
    ServerProcess() = default;

    pid_t process = -1;
    int listening = 0;
};

/// vkcimd, over the library built here.
class Endpoint : public ServerProcess {
public:
    explicit Endpoint(const std::string& program);
};

/// libmicrohttpd as vkcimd uses it, which answers at once: to a request for the path /N with N bytes.
class Constant : public ServerProcess {
public:
    Constant();
};

} // namespace bench
