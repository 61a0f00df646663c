#pragma once

#include "objectmanager/endpoint/Certificate.h"
#include "objectmanager/endpoint/Connections.h"
#include "objectmanager/endpoint/Processing.h"

#include <memory>

struct MHD_Daemon;

namespace endpoint {

/// What the daemons of a server share.
struct Parts {
    const Limits limits;
    std::shared_ptr<Certificate> certificate; ///< for HTTPS
    Authentication authentication;
    Connections connections;
    Processing processing;
};

/// libmicrohttpd on one listener: a thread that serves its connections, and hands whole requests on.
class Daemon {
public:
    /// Throws std::runtime_error, and std::invalid_argument for HTTPS without a certificate.
    Daemon(Listener listener, Parts& parts);
    /// No connection may be suspended any more.
    ~Daemon();
    Daemon(const Daemon&) = delete;
    Daemon& operator=(const Daemon&) = delete;

private:
    class Callbacks;

    const Listener listener;
    Parts& parts;
    MHD_Daemon* handle = nullptr;
};

} // namespace endpoint
