#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

/// What the libraries that the loaded provider uses say of its host. Nothing for another provider than our own, and
/// where a library stands in for one of ours and lacks the function.
namespace vkcim {

/// What the host does not say and why, one line each.
std::vector<std::string> hostNotes(const std::string& provider);

/// Why the host cannot be read at all; empty where it can.
std::string hostProblem(const std::string& provider);

/// What the host's clock says, as far as it is known.
struct HostClock {
    std::optional<std::string> time;         ///< local time, a CIM date-time
    std::optional<std::string> aheadMinutes; ///< how far local time is ahead of UTC, a number in decimal
};
HostClock hostClock(const std::string& provider);

/// Which host is described, in words; `this host, NAME` also where nothing is said.
std::string hostDescribed(const std::string& provider);

/// The name of the host that this program runs on.
std::string kernelsHostName();

/// The last failure that the libraries log while this lives.
class LastFailure {
public:
    LastFailure();
    ~LastFailure();
    LastFailure(const LastFailure&) = delete;
    LastFailure& operator=(const LastFailure&) = delete;

    std::string text() const;

private:
    class Watch;
    std::unique_ptr<Watch> watch;
};

} // namespace vkcim
