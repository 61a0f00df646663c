#pragma once

#include <string>

namespace VK {

/// Where the libraries find the host they describe. Chosen once per process, with secure_getenv.
struct HostSource {
    enum Kind {
        Live,     ///< this host: files under `/` and the running kernel
        Snapshot, ///< `VK_INSTRUMENTATION_ROOT`: the same files under `location`
        Simulated ///< `VK_INSTRUMENTATION_TREE`: the node tree in the JSON file `location`
    };

    Kind kind = Live;
    /// Empty for Live. A relative one is made absolute, links left as they are, when the source is chosen.
    std::string location;

    /// The process's source. A tree wins over a root when both are set; an empty variable counts as not set.
    static const HostSource& current();
};

} // namespace VK
