#include "objectmanager/endpoint/Connections.h"

#include "objectmanager/endpoint/Log.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>

#include <algorithm>
#include <cstdint>

namespace endpoint {
namespace {

/// Whether the client has gone, though its connection is not closed here yet: the next one may be quicker than that.
bool hasHungUp(const Connection& connection) {
    pollfd end = {connection.socket, POLLRDHUP, 0};
    return connection.phase == Connection::Phase::Receiving && poll(&end, 1, 0) > 0;
}

} // namespace

Connections::Connections(unsigned all, unsigned ofAnAddress) : most(all), mostOfAnAddress(ofAnAddress) {}

bool Connections::isCrowded(const Connection& connection) const {
    const auto areOpen = [&](unsigned limit, auto isOne) {
        const auto counted = std::count_if(connections.begin(), connections.end(), isOne);
        if (static_cast<unsigned>(counted) < limit) return false;
        const auto gone = std::count_if(connections.begin(), connections.end(),
                                        [&](const auto& each) { return isOne(each) && hasHungUp(*each); });
        return static_cast<unsigned>(counted - gone) >= limit;
    };
    if (connection.kind == Listener::Kind::Unix && connection.peer == uid_t{0}) return false;
    if (areOpen(most, [](const auto&) { return true; })) return true;
    return areOpen(mostOfAnAddress, [&](const auto& each) { return each->network == connection.network; });
}

void Connections::open(const ConnectionPointer& connection) {
    const std::lock_guard lock(mutex);
    lastUse = Clock::now();
    connection->refused = isCrowded(*connection);
    if (!connection->refused) {
        connections.insert(connection);
        refusing = false;
        return;
    }
    shutdown(connection->socket, SHUT_RDWR);
    // Once: whoever tries again and again does not fill the log.
    if (!refusing) {
        log("a connection of " + connection->address + " is refused: " + std::to_string(connections.size()) +
            " are open");
    }
    refusing = true;
}

void Connections::close(const ConnectionPointer& connection) {
    const std::lock_guard lock(mutex);
    connections.erase(connection);
    lastUse = Clock::now();
    changed.notify_all();
}

void Connections::enter(Connection& connection, Connection::Phase phase) {
    const std::lock_guard lock(mutex);
    connection.phase = phase;
    connection.since = Clock::now();
    changed.notify_all();
}

void Connections::waitForAnswers(std::chrono::milliseconds patience) const {
    std::unique_lock lock(mutex);
    changed.wait_for(lock, patience, [this] {
        return std::all_of(connections.begin(), connections.end(),
                           [](const ConnectionPointer& each) { return each->phase == Connection::Phase::Receiving; });
    });
}

void Connections::endSlow(std::chrono::milliseconds arrival, std::chrono::milliseconds taking) {
    const std::lock_guard lock(mutex);
    const Clock::time_point now = Clock::now();
    for (const ConnectionPointer& connection : connections) {
        if (connection->phase == Connection::Phase::Working) continue;
        const auto limit = connection->phase == Connection::Phase::Receiving ? arrival : taking;
        if (now - connection->since > limit) shutdown(connection->socket, SHUT_RDWR);
    }
}

std::optional<Connections::Clock::time_point> Connections::idleSince() const {
    const std::lock_guard lock(mutex);
    if (!connections.empty()) return std::nullopt;
    return lastUse;
}

std::string addressText(const sockaddr* address) {
    char text[INET6_ADDRSTRLEN] = "?";
    if (address->sa_family == AF_INET) {
        inet_ntop(AF_INET, &reinterpret_cast<const sockaddr_in*>(address)->sin_addr, text, sizeof text);
    } else if (address->sa_family == AF_INET6) {
        const in6_addr& ipv6 = reinterpret_cast<const sockaddr_in6*>(address)->sin6_addr;
        if (IN6_IS_ADDR_V4MAPPED(&ipv6)) {
            inet_ntop(AF_INET, &ipv6.s6_addr[12], text, sizeof text);
        } else {
            inet_ntop(AF_INET6, &ipv6, text, sizeof text);
        }
    }
    return text;
}

std::string networkText(const sockaddr* address) {
    if (address->sa_family != AF_INET6) return addressText(address);
    sockaddr_in6 network = *reinterpret_cast<const sockaddr_in6*>(address);
    if (!IN6_IS_ADDR_V4MAPPED(&network.sin6_addr)) std::fill_n(&network.sin6_addr.s6_addr[8], 8, std::uint8_t{0});
    return addressText(reinterpret_cast<const sockaddr*>(&network));
}

} // namespace endpoint
