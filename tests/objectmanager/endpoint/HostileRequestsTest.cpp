#include "tests/objectmanager/endpoint/HostileRequests.h"

#include "tests/objectmanager/endpoint/RunningServer.h"

#include <gmock/gmock.h>

#include <regex>

namespace endpoint {
namespace {

using testing::HasSubstr;
using testing::Not;

/// What the expression has found, or "none".
std::string foundIn(const std::string& text, const char* expression) {
    std::smatch found;
    return std::regex_search(text, found, std::regex(expression)) ? found[1].str() : "none";
}

class HostileRequestsTest : public RunningServer {
protected:
    /// One request, its answer, and what the connection is good for then.
    void expectAnswered(const HostileRequest& hostile) {
        Client client(path);
        client.sendSome(hostile.sent.bytes);
        const std::string answer = client.receive();
        const std::string status = foundIn(answer, "^HTTP/1\\.1 (\\d+) ");
        EXPECT_THAT(hostile.status, HasSubstr(status)) << answer;
        EXPECT_EQ(foundIn(answer, "\r\n(?:73-)?CIMError: ([^\r]*)\r\n"), hostile.cimError) << answer;
        EXPECT_EQ(foundIn(answer, "<ERROR CODE=\"(\\d+)\""), hostile.cimStatus) << answer;
        client.sendSome(request());
        if (hostile.ends || status != "200") { // nobody knows where the next request would begin
            EXPECT_THAT(client.receiveAll(), Not(HasSubstr("INSTANCENAME")));
        } else {
            EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
        }
    }

    void expectHonestIsServed() const { EXPECT_THAT(Client(ports.at(0), 1).ask(request()), HasSubstr("INSTANCENAME")); }
};

TEST_F(HostileRequestsTest, GetTheAnswersOfTheStandardAndHarmNobody) {
    Limits limits;
    limits.arrival = std::chrono::seconds(1);
    limits.connectionsPerAddress = limits.connections;
    start(limits, 1);
    // These wait for the limit while all others are served.
    const HostileRequests slow = slowRequests();
    std::vector<std::unique_ptr<Client>> waiting;
    for (const HostileRequest& hostile : slow) {
        waiting.push_back(std::make_unique<Client>(path));
        waiting.back()->send(hostile.sent.bytes);
    }
    const HostileRequests answered = together({hostileHeads(), hostileLengths(), hostileBodies(), hostileOperations()});
    for (const HostileRequest& hostile : answered) {
        SCOPED_TRACE(hostile.what);
        expectAnswered(hostile);
        expectHonestIsServed();
    }
    for (std::size_t i = 0; i < slow.size(); ++i) {
        SCOPED_TRACE(slow[i].what);
        EXPECT_EQ(waiting[i]->receiveAll(), "");
        expectHonestIsServed();
    }
}

TEST_F(HostileRequestsTest, OneByteAfterTheOtherDoesNotBuyTime) {
    Limits limits;
    limits.arrival = std::chrono::milliseconds(300);
    start(limits, 1);
    Client client(path);
    for (const char byte : bytesOf(goodRequest())) {
        if (client.hasEnded(std::chrono::milliseconds(10))) break;
        client.sendSome(std::string(1, byte));
    }
    EXPECT_EQ(client.receiveAll(), ""); // what had come whole would be answered
    expectHonestIsServed();
}

} // namespace
} // namespace endpoint
