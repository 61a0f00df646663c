#include "bench/endpoint/Clients.h"

#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/epoll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <chrono>
#include <stdexcept>
#include <system_error>

namespace bench {
namespace {

using Clock = std::chrono::steady_clock;

int checked(int result, const char* what) {
    if (result < 0) throw std::system_error(errno, std::generic_category(), what);
    return result;
}

sockaddr_in loopback(unsigned host, int port) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(0x7F000000U + host);
    address.sin_port = htons(static_cast<in_port_t>(port));
    return address;
}

int connected(int port, unsigned host) {
    const int made = checked(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0), "socket");
    const int on = 1;
    checked(setsockopt(made, IPPROTO_TCP, TCP_NODELAY, &on, sizeof on), "TCP_NODELAY");
    const sockaddr_in from = loopback(host, 0);
    const sockaddr_in to = loopback(1, port);
    checked(bind(made, reinterpret_cast<const sockaddr*>(&from), sizeof from), "bind");
    checked(connect(made, reinterpret_cast<const sockaddr*>(&to), sizeof to), "connect");
    return made;
}

} // namespace

struct Clients::Connection {
    int socket;
    std::string received;  ///< the head, and what came behind it
    std::size_t whole = 0; ///< bytes of the answer, once its head is there
    std::size_t count = 0; ///< bytes of it that came
};

Clients::Clients(int port, unsigned connections) : events(checked(epoll_create1(EPOLL_CLOEXEC), "epoll")) {
    for (unsigned i = 0; i < connections; ++i) {
        all.push_back(std::make_unique<Connection>());
        all.back()->socket = connected(port, 2 + i % 200);
        epoll_event event{};
        event.events = EPOLLIN;
        event.data.ptr = all.back().get();
        checked(epoll_ctl(events, EPOLL_CTL_ADD, all.back()->socket, &event), "epoll");
    }
}

Clients::~Clients() {
    for (const auto& connection : all) close(connection->socket);
    close(events);
}

void Clients::send(Connection& connection) {
    const std::string& request = (*asked)[next++ % asked->size()];
    connection.received.clear();
    connection.whole = connection.count = 0;
    const ssize_t sent = ::send(connection.socket, request.data(), request.size(), MSG_NOSIGNAL);
    if (checked(static_cast<int>(sent), "send") != static_cast<int>(request.size())) {
        throw std::runtime_error("a request did not fit into its socket");
    }
}

/// Whether the answer is whole.
bool Clients::receive(Connection& connection) {
    std::array<char, 65536> bytes; // NOLINT(cppcoreguidelines-pro-type-member-init): it is read into
    const ssize_t count = recv(connection.socket, bytes.data(), bytes.size(), 0);
    if (checked(static_cast<int>(count), "recv") == 0) throw std::runtime_error("the server closed a connection");
    connection.received.append(bytes.data(), static_cast<std::size_t>(count));
    connection.count += static_cast<std::size_t>(count);
    if (connection.whole == 0) {
        const std::size_t end = connection.received.find("\r\n\r\n");
        if (end == std::string::npos) return false;
        const std::size_t length = connection.received.find("Content-Length: ");
        if (connection.received.compare(0, 13, "HTTP/1.1 200 ") != 0 || length > end) {
            throw std::runtime_error("the server answers " + connection.received.substr(0, end));
        }
        connection.whole = end + 4 + std::stoul(connection.received.substr(length + 16));
    }
    return connection.count == connection.whole;
}

std::size_t Clients::ask(const std::vector<std::string>& requests, std::size_t answers, double seconds) {
    const auto end = Clock::now() + std::chrono::duration<double>(seconds);
    asked = &requests;
    std::size_t begun = 0;
    std::size_t done = 0;
    for (const auto& connection : all) {
        if (answers != 0 && begun == answers) break;
        ++begun;
        send(*connection);
    }
    while (done < begun) {
        std::array<epoll_event, 64> ready{};
        const int count = checked(epoll_wait(events, ready.data(), static_cast<int>(ready.size()), 60000), "epoll");
        if (count == 0) throw std::runtime_error("no answer for a minute");
        for (int i = 0; i < count; ++i) {
            auto& connection = *static_cast<Connection*>(ready.at(static_cast<std::size_t>(i)).data.ptr);
            if (!receive(connection)) continue;
            ++done;
            const bool goesOn = answers != 0 ? begun < answers : Clock::now() < end;
            if (!goesOn) continue;
            ++begun;
            send(connection);
        }
    }
    return done;
}

std::string Clients::askOnce(const std::string& request) {
    ask({request}, 1, 0);
    const std::string& received = all.front()->received;
    return received.substr(received.find("\r\n\r\n") + 4);
}

} // namespace bench
