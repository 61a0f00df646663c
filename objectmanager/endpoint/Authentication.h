#pragma once

#include "objectmanager/endpoint/Work.h"

#include <chrono>
#include <optional>
#include <string>

namespace endpoint {

/// Says who asks: from the socket, or from user and password.
class Authentication {
public:
    /// Whether everybody may read over the loopback and the Unix socket, and for how long a connection's password and
    /// rights are trusted.
    Authentication(bool anonymousRead, std::chrono::milliseconds trust);

    /// What can be said without the body: that a user has to be named.
    std::optional<HttpAnswer> refuseHead(const Work& work) const;

    /// Whether a password has to be checked before it is known who asks.
    bool takesPassword(const Work& work) const;

    /// Who asks, where no password has to be checked.
    Caller callerOf(const Work& work) const;

    /// The caller with the rights of this moment: one who lost them changes nothing more.
    Caller renewed(const Work& work, const Caller& caller) const;

private:
    bool mayBeAnonymous(const Connection& connection) const;

    bool isKnown(const Connection& connection) const;

    Caller localUser(const Connection& connection) const;

    bool anonymousRead;
    std::chrono::milliseconds trust;
};

/// What became of a password.
struct PasswordCheck {
    std::optional<Caller> caller; ///< empty where it was refused
    HttpAnswer refusal;
};

/// The user that the request names, or whom its connection is known to belong to; empty for none.
std::string claimedUser(const Work& work);
/// Takes as long as PAM does.
PasswordCheck checkPassword(const HttpRequest& request, const std::string& address);

} // namespace endpoint
