#pragma once

#include "objectmanager/endpoint/Listening.h"
#include "objectmanager/endpoint/NameSpace.h"

#include <sys/socket.h>
#include <sys/types.h>

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>

namespace endpoint {

/// A connection, from its first byte to its last.
struct Connection {
    using Clock = std::chrono::steady_clock;

    Listener::Kind kind = Listener::Kind::Unix;
    int socket = -1;
    std::string address;       ///< for the log
    std::string network;       ///< that its limit counts: who has one address of IPv6 has all of its network
    std::optional<uid_t> peer; ///< at the other end of a Unix socket
    bool refused = false;      ///< nothing is read from it

    /// A request is arriving or expected, is with us, or its answer is on its way.
    enum class Phase { Receiving, Working, Sending };
    Phase phase = Phase::Receiving;
    Clock::time_point since = Clock::now();

    std::string authorization; ///< that has been checked: its user is `caller`
    std::optional<Caller> caller;
    Clock::time_point known; ///< since when

    void know(Caller who) {
        caller = std::move(who);
        known = Clock::now();
    }
};

using ConnectionPointer = std::shared_ptr<Connection>;

/// Those that are open, of all listeners together. Safe for threads.
class Connections {
public:
    using Clock = Connection::Clock;

    Connections(unsigned most, unsigned mostOfAnAddress);

    /// Counts a connection in, or refuses and ends it: there are too many in all, or from its network. Root's over a
    /// Unix socket are always let in: others must not be able to lock out who could end them.
    void open(const ConnectionPointer& connection);
    void close(const ConnectionPointer& connection);

    /// The client's turn begins, or ours.
    void enter(Connection& connection, Connection::Phase phase);

    /// Ends those whose request does not arrive in time, or who do not take their answer.
    void endSlow(std::chrono::milliseconds arrival, std::chrono::milliseconds taking);

    /// Waits until no answer is on its way any more, or for as long as that.
    void waitForAnswers(std::chrono::milliseconds patience) const;

    /// Since when nobody is there; nothing while somebody is.
    std::optional<Clock::time_point> idleSince() const;

private:
    bool isCrowded(const Connection& connection) const;

    const unsigned most;
    const unsigned mostOfAnAddress;
    mutable std::mutex mutex; // of what follows, and of the connections' times
    mutable std::condition_variable changed;
    std::set<ConnectionPointer> connections;
    Clock::time_point lastUse = Clock::now();
    bool refusing = false; ///< it was said in the log
};

/// An address of a network without its port; one of IPv4 looks the same on a socket for both kinds.
std::string addressText(const sockaddr* address);

/// The address itself for IPv4, the first 64 bits for IPv6.
std::string networkText(const sockaddr* address);

} // namespace endpoint
