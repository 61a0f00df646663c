#include "objectmanager/endpoint/Authentication.h"

#include "objectmanager/endpoint/Limits.h"
#include "objectmanager/endpoint/Rights.h"

#include <gtest/gtest.h>

#include <unistd.h>

namespace endpoint {
namespace {

constexpr const char* credentials = "Basic Zm9ybWVyOng="; // former:x

/// A request of somebody who had all rights when that was looked up so long ago.
class Request : public Work {
public:
    Request(Listener::Kind kind, std::chrono::seconds ago) {
        connection = std::make_shared<Connection>();
        connection->kind = kind;
        connection->peer = getuid();
        connection->authorization = credentials;
        connection->know({"former", {}, true, true});
        connection->known -= ago;
        http.headers = {{"Authorization", credentials}};
    }
};

const Authentication authentication(false, Limits().trust);

TEST(Authentication, TrustsAPasswordAndRightsForAMinute) {
    using Kind = Listener::Kind;
    const Request early(Kind::Https, std::chrono::seconds(50));
    const Request late(Kind::Https, std::chrono::seconds(61));
    EXPECT_FALSE(authentication.takesPassword(early));
    EXPECT_TRUE(authentication.takesPassword(late));
    const Request earlyPeer(Kind::Unix, std::chrono::seconds(50));
    const Request latePeer(Kind::Unix, std::chrono::seconds(61));
    EXPECT_EQ(authentication.callerOf(earlyPeer).user, "former");
    EXPECT_EQ(authentication.callerOf(latePeer).user, rightsOf(getuid()).user);
    EXPECT_EQ(authentication.callerOf(latePeer).mayChange, rightsOf(getuid()).mayChange);
}

TEST(Authentication, LooksUpTheRightsAnewForAChange) {
    const Request overTcp(Listener::Kind::Https, std::chrono::seconds(0));
    Caller caller = authentication.callerOf(overTcp);
    EXPECT_TRUE(caller.mayChange);
    caller.address = "192.0.2.7";
    const Caller renewed = authentication.renewed(overTcp, caller); // no host has this user
    EXPECT_FALSE(renewed.mayChange);
    EXPECT_FALSE(renewed.mayRead);
    EXPECT_EQ(renewed.user, "former");
    EXPECT_EQ(renewed.address, "192.0.2.7");
    const Request local(Listener::Kind::Unix, std::chrono::seconds(0));
    EXPECT_EQ(authentication.renewed(local, caller).mayChange, rightsOf(getuid()).mayChange);
}

TEST(Authentication, AnEmptyHeaderNamesNobody) {
    Request request(Listener::Kind::Https, std::chrono::seconds(0));
    EXPECT_FALSE(authentication.refuseHead(request));
    request.http.headers = {{"Authorization", ""}};
    const auto refusal = authentication.refuseHead(request);
    ASSERT_TRUE(refusal);
    EXPECT_EQ(refusal->status, 401U);
}

} // namespace
} // namespace endpoint
