#pragma once

#include <string>
#include <vector>

namespace endpoint {

/// Where requests come in.
struct Listener {
    enum class Kind { Unix, Http, Https };

    Kind kind = Kind::Unix;
    std::string url;
    int socket = -1; ///< listening; the server closes it
};

/// A URL of the option --listen: `unix:PATH`, `http://127.0.0.1:5988`, `https://[::]:5989`. Throws
/// std::invalid_argument for another one, and for plain HTTP on an address that is not of the loopback.
struct ListenUrl {
    explicit ListenUrl(const std::string& text);

    Listener::Kind kind;
    std::string text;
    std::string host; ///< or the socket's path
    std::string port;
};

/// Opens a listening socket. A Unix socket is open to everybody: its clients are known by their credentials. It
/// takes the place of one that nobody serves any more. Throws std::system_error.
Listener listenAt(const ListenUrl& url);

/// The sockets that the service manager has opened; none where it started us without. A TCP socket is plain HTTP on
/// the loopback's port 5988, and HTTPS anywhere else.
std::vector<Listener> activatedListeners();

} // namespace endpoint
