#include "objectmanager/endpoint/Listening.h"

#include <arpa/inet.h>
#include <netdb.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <systemd/sd-daemon.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <cstring>
#include <memory>
#include <stdexcept>
#include <string_view>
#include <system_error>

namespace endpoint {
namespace {

constexpr int backlog = 128;
constexpr in_port_t plainPort = 5988;

bool isLoopback(const sockaddr* address) {
    if (address->sa_family == AF_INET) {
        const auto* ipv4 = reinterpret_cast<const sockaddr_in*>(address);
        return (ntohl(ipv4->sin_addr.s_addr) >> 24U) == 127;
    }
    const auto* ipv6 = reinterpret_cast<const sockaddr_in6*>(address);
    return address->sa_family == AF_INET6 && IN6_IS_ADDR_LOOPBACK(&ipv6->sin6_addr);
}

using Addresses = std::unique_ptr<addrinfo, decltype(&freeaddrinfo)>;

/// Only numbers: no name service decides where we listen.
Addresses resolve(const std::string& host, const std::string& port) {
    addrinfo hints{};
    hints.ai_family = AF_UNSPEC;
    hints.ai_socktype = SOCK_STREAM;
    hints.ai_flags = AI_PASSIVE | AI_NUMERICHOST | AI_NUMERICSERV;
    addrinfo* found = nullptr;
    const int error = getaddrinfo(host.c_str(), port.c_str(), &hints, &found);
    if (error != 0) throw std::invalid_argument("'" + host + "' is no numeric address: " + gai_strerror(error));
    return {found, freeaddrinfo};
}

[[noreturn]] void failed(int socket, const std::string& url) {
    const int error = errno;
    if (socket >= 0) close(socket);
    throw std::system_error(error, std::generic_category(), "cannot listen on " + url);
}

/// Removes a socket that nobody serves any more; where somebody does, to bind another one there fails.
void removeForsaken(const sockaddr_un& address) {
    struct stat old {};
    if (lstat(address.sun_path, &old) != 0 || !S_ISSOCK(old.st_mode)) return;
    const int client = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
    if (client < 0) return;
    const bool forsaken =
        connect(client, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 && errno == ECONNREFUSED;
    close(client);
    if (forsaken) unlink(address.sun_path);
}

int listenUnix(const ListenUrl& url) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::copy(url.host.begin(), url.host.end(), address.sun_path);
    removeForsaken(address);
    const int made = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    // Not by chmod later on, which would follow a link that was put in its place.
    const mode_t former = umask(0111);
    const bool bound = made >= 0 && bind(made, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
    const int error = errno;
    umask(former);
    errno = error;
    if (!bound || listen(made, backlog) != 0) failed(made, url.text);
    return made;
}

int listenTcp(const ListenUrl& url) {
    const Addresses addresses = resolve(url.host, url.port);
    const int made = socket(addresses->ai_family, SOCK_STREAM | SOCK_CLOEXEC, 0);
    const int on = 1;
    if (made < 0 || setsockopt(made, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) != 0 ||
        bind(made, addresses->ai_addr, addresses->ai_addrlen) != 0 || listen(made, backlog) != 0) {
        failed(made, url.text);
    }
    return made;
}

in_port_t portOf(const sockaddr_storage& address) {
    if (address.ss_family == AF_INET) return ntohs(reinterpret_cast<const sockaddr_in&>(address).sin_port);
    return ntohs(reinterpret_cast<const sockaddr_in6&>(address).sin6_port);
}

/// The URL of a listening socket, with the port that the kernel chose for 0.
std::string urlOf(Listener::Kind kind, int socket) {
    sockaddr_storage address{};
    socklen_t length = sizeof address;
    if (getsockname(socket, reinterpret_cast<sockaddr*>(&address), &length) != 0) return "?";
    if (kind == Listener::Kind::Unix) return std::string("unix:") + reinterpret_cast<sockaddr_un&>(address).sun_path;
    char host[INET6_ADDRSTRLEN] = "";
    const bool ipv6 = address.ss_family == AF_INET6;
    const void* raw = ipv6 ? static_cast<const void*>(&reinterpret_cast<sockaddr_in6&>(address).sin6_addr)
                           : &reinterpret_cast<sockaddr_in&>(address).sin_addr;
    inet_ntop(address.ss_family, raw, host, sizeof host);
    const std::string shown = ipv6 ? '[' + std::string(host) + ']' : host;
    return (kind == Listener::Kind::Http ? "http://" : "https://") + shown + ':' + std::to_string(portOf(address));
}

Listener::Kind activatedKind(int socket) {
    sockaddr_storage address{};
    socklen_t length = sizeof address;
    if (getsockname(socket, reinterpret_cast<sockaddr*>(&address), &length) != 0) {
        throw std::system_error(errno, std::generic_category(), "the service manager's socket");
    }
    if (address.ss_family == AF_UNIX) return Listener::Kind::Unix;
    const bool plain = isLoopback(reinterpret_cast<sockaddr*>(&address)) && portOf(address) == plainPort;
    return plain ? Listener::Kind::Http : Listener::Kind::Https;
}

} // namespace

ListenUrl::ListenUrl(const std::string& given) : kind(Listener::Kind::Unix), text(given) {
    constexpr std::string_view unixPrefix = "unix:";
    constexpr std::string_view http = "http://";
    constexpr std::string_view https = "https://";
    const std::string_view url = text;
    if (url.substr(0, unixPrefix.size()) == unixPrefix) {
        host = url.substr(unixPrefix.size());
        if (host.empty() || host.front() != '/' || host.size() >= sizeof(sockaddr_un::sun_path)) {
            throw std::invalid_argument("'" + text + "': the path of a socket is absolute, and not long");
        }
        return;
    }
    const bool plain = url.substr(0, http.size()) == http;
    if (!plain && url.substr(0, https.size()) != https) {
        throw std::invalid_argument("'" + text +
                                    "' is neither unix:PATH, http://ADDRESS:PORT nor https://ADDRESS:PORT");
    }
    kind = plain ? Listener::Kind::Http : Listener::Kind::Https;
    std::string_view rest = url.substr(plain ? http.size() : https.size());
    if (!rest.empty() && rest.back() == '/') rest.remove_suffix(1);
    const std::size_t colon = rest.rfind(':');
    const bool hasPort = colon != std::string_view::npos && rest.find(']', colon) == std::string_view::npos;
    host = hasPort ? rest.substr(0, colon) : rest;
    port = hasPort ? std::string(rest.substr(colon + 1)) : plain ? "5988" : "5989";
    if (host.size() >= 2 && host.front() == '[' && host.back() == ']') host = host.substr(1, host.size() - 2);
    in_port_t number = 0;
    const auto [end, error] = std::from_chars(port.data(), port.data() + port.size(), number);
    if (error != std::errc() || end != port.data() + port.size()) {
        throw std::invalid_argument("'" + text + "': no such port");
    }
    const Addresses addresses = host.empty() ? Addresses(nullptr, freeaddrinfo) : resolve(host, port);
    if (!addresses) throw std::invalid_argument("'" + text + "' has no address");
    if (plain && !isLoopback(addresses->ai_addr)) {
        throw std::invalid_argument("'" + text + "': plain HTTP is for the loopback only, use https");
    }
}

Listener listenAt(const ListenUrl& url) {
    Listener listener;
    listener.kind = url.kind;
    listener.socket = url.kind == Listener::Kind::Unix ? listenUnix(url) : listenTcp(url);
    listener.url = urlOf(url.kind, listener.socket);
    return listener;
}

std::vector<Listener> activatedListeners() {
    const int count = sd_listen_fds(1);
    std::vector<Listener> listeners;
    for (int i = 0; i < count; ++i) {
        Listener listener;
        listener.socket = SD_LISTEN_FDS_START + i;
        listener.kind = activatedKind(listener.socket);
        listener.url = urlOf(listener.kind, listener.socket);
        listeners.push_back(std::move(listener));
    }
    return listeners;
}

} // namespace endpoint
