#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

namespace bench {

/// Connections of the loopback that stay open, each from an address of its own, as long as there are addresses: a
/// server may count them by address. One thread keeps a request on the way on each.
class Clients {
public:
    /// Throws std::system_error.
    Clients(int port, unsigned connections);
    ~Clients();
    Clients(const Clients&) = delete;
    Clients& operator=(const Clients&) = delete;

    /// Sends the requests in turn until so many answers came, or so many seconds went by; 0: no end. Returns the
    /// answers. Throws std::runtime_error for one that is not HTTP's status 200.
    std::size_t ask(const std::vector<std::string>& requests, std::size_t answers, double seconds);

    /// One request, and the body of its answer.
    std::string askOnce(const std::string& request);

private:
    struct Connection;

    void send(Connection& connection);
    bool receive(Connection& connection);

    std::vector<std::unique_ptr<Connection>> all;
    const std::vector<std::string>* asked = nullptr;
    std::size_t next = 0;
    int events;
};

} // namespace bench
