#include "objectmanager/endpoint/Authentication.h"

#include "objectmanager/endpoint/Rights.h"

namespace endpoint {
namespace {

HttpAnswer challenge(const std::string& detail) {
    HttpAnswer answer = plainAnswer(401, detail);
    answer.headers.emplace_back("WWW-Authenticate", "Basic realm=\"vkcimd\"");
    return answer;
}

std::string authorizationOf(const HttpRequest& request) {
    return headerOf(request, "Authorization").value_or("");
}

} // namespace

Authentication::Authentication(bool anonymous, std::chrono::milliseconds trusted)
    : anonymousRead(anonymous), trust(trusted) {}

bool Authentication::mayBeAnonymous(const Connection& connection) const {
    return anonymousRead && connection.kind == Listener::Kind::Http;
}

std::optional<HttpAnswer> Authentication::refuseHead(const Work& work) const {
    const bool named = work.connection->kind == Listener::Kind::Unix || !authorizationOf(work.http).empty();
    if (!named && !mayBeAnonymous(*work.connection)) return challenge("no user is named");
    return std::nullopt;
}

bool Authentication::isKnown(const Connection& connection) const {
    return connection.caller && Connection::Clock::now() - connection.known <= trust;
}

/// The user at the other end of a Unix socket, with the rights of this moment.
Caller Authentication::localUser(const Connection& connection) const {
    Caller caller = connection.peer ? rightsOf(*connection.peer) : Caller();
    caller.mayRead = caller.mayRead || anonymousRead;
    return caller;
}

bool Authentication::takesPassword(const Work& work) const {
    const Connection& connection = *work.connection;
    const std::string authorization = authorizationOf(work.http);
    return connection.kind != Listener::Kind::Unix && !authorization.empty() &&
           (!isKnown(connection) || authorization != connection.authorization);
}

Caller Authentication::callerOf(const Work& work) const {
    Connection& connection = *work.connection;
    Caller caller;
    if (connection.kind == Listener::Kind::Unix) {
        if (!isKnown(connection)) connection.know(localUser(connection));
        caller = *connection.caller;
    } else if (authorizationOf(work.http).empty()) {
        caller.mayRead = mayBeAnonymous(connection);
    } else {
        caller = *connection.caller;
    }
    caller.address = connection.address;
    return caller;
}

Caller Authentication::renewed(const Work& work, const Caller& caller) const {
    const Connection& connection = *work.connection;
    Caller anew;
    if (connection.kind == Listener::Kind::Unix) {
        anew = localUser(connection);
    } else if (caller.user.empty()) {
        return caller; // nobody in particular: no rights of a user
    } else {
        anew = rightsOf(caller.user);
    }
    anew.user = caller.user;
    anew.address = caller.address;
    return anew;
}

std::string claimedUser(const Work& work) {
    const Connection& connection = *work.connection;
    if (connection.kind == Listener::Kind::Unix) return connection.caller ? connection.caller->user : std::string();
    const auto credentials = basicCredentials(authorizationOf(work.http));
    return credentials ? credentials->first : std::string();
}

PasswordCheck checkPassword(const HttpRequest& request, const std::string& address) {
    const auto credentials = basicCredentials(authorizationOf(request));
    if (!credentials) return {std::nullopt, challenge("credentials that cannot be read")};
    const auto& [user, password] = *credentials;
    if (!isAuthentic(user, password, address)) return {std::nullopt, challenge("authentication failed")};
    Caller caller = rightsOf(user);
    caller.user = user;
    return {std::move(caller), {}};
}

} // namespace endpoint
