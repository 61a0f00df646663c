#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <memory>
#include <optional>
#include <string>

namespace vkcim {

/// Where a CIM server is, and how it is asked.
struct RemoteOptions {
    std::string url;                 ///< `https://HOST:5989`, `http://HOST:5988` or `unix:PATH`; empty: no server
    std::optional<std::string> user; ///< its password is in the netrc file, or asked for
    std::string netrcFile;
    std::string certificates; ///< file of those that are trusted; empty: the system's
    bool insecure = false;    ///< any certificate will do
};

/// A CIM server that is asked instead of a provider's library. Safe for threads.
class RemoteServer {
public:
    /// Throws std::runtime_error for a URL that cannot be used, and in a build without HTTP.
    RemoteServer(const RemoteOptions& options, const om::Schema& schema);
    ~RemoteServer();
    RemoteServer(const RemoteServer&) = delete;
    RemoteServer& operator=(const RemoteServer&) = delete;

    /// Throws om::LoadError where the server cannot be reached or refuses, and std::runtime_error for an answer that
    /// cannot be read.
    om::Answer run(const om::Request& request);

private:
    class Impl;
    std::unique_ptr<Impl> impl;
};

} // namespace vkcim
