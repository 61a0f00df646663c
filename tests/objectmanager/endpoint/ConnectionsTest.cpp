#include "objectmanager/endpoint/Connections.h"

#include "support/OpenDescriptors.h"
#include "tests/objectmanager/endpoint/RunningServer.h"

#include <gmock/gmock.h>

#include <arpa/inet.h>

#include <random>

namespace endpoint {
namespace {

using support::openDescriptors;
using testing::HasSubstr;
using testing::IsEmpty;

class ConnectionLimits : public RunningServer {
protected:
    using Clients = std::vector<std::unique_ptr<Client>>;

    /// A connection that has been served.
    std::unique_ptr<Client> served(int port, int n) {
        auto client = std::make_unique<Client>(port, n);
        EXPECT_THAT(client->ask(request()), HasSubstr("INSTANCENAME")) << n;
        return client;
    }

    /// What a connection gets that is refused: it may end before the request is sent.
    static std::string refused(int port, int n) {
        Client client(port, n);
        client.sendSome(request());
        return client.receive();
    }

    int timesAsked() {
        const std::lock_guard lock(mutex);
        return asked;
    }
};

TEST_F(ConnectionLimits, HoldForAllListenersTogether) {
    Limits limits;
    limits.connections = 5;
    start(limits, 2);
    Clients clients;
    clients.push_back(served(ports[0], 2));
    clients.push_back(served(ports[0], 3));
    clients.push_back(served(ports[1], 4));
    clients.push_back(served(ports[1], 5));
    Client local(path);
    EXPECT_THAT(local.ask(request()), HasSubstr("INSTANCENAME"));
    const int before = timesAsked();
    testing::internal::CaptureStderr();
    for (int i = 0; i < 3; ++i) EXPECT_THAT(refused(ports[i % 2], 6), IsEmpty());
    // Said once, however often it is tried; and what was sent is not carried out.
    const std::string log = testing::internal::GetCapturedStderr();
    const std::size_t said = log.find("a connection of 127.0.0.6 is refused: 5 are open\n");
    EXPECT_NE(said, std::string::npos) << log;
    EXPECT_EQ(log.find("refused", said + 40), std::string::npos) << log;
    EXPECT_EQ(timesAsked(), before);
    clients.pop_back();
    served(ports[0], 6); // at once, even before the server has seen that one has gone
}

TEST_F(ConnectionLimits, HoldForEachAddressOnAllListenersTogether) {
    Limits limits;
    limits.connectionsPerAddress = 2;
    start(limits, 2);
    const auto first = served(ports[0], 2);
    const auto second = served(ports[1], 2);
    EXPECT_THAT(refused(ports[0], 2), IsEmpty());
    EXPECT_THAT(refused(ports[1], 2), IsEmpty());
    served(ports[1], 3);
}

TEST_F(ConnectionLimits, AreThoseOfTheManual) {
    EXPECT_EQ(Limits().connections, 64U);
    EXPECT_EQ(Limits().connectionsPerAddress, 8U);
    start({}, 2);
    Clients clients;
    for (int n = 2; n < 2 + 64; ++n) clients.push_back(served(ports[n % 2], n));
    EXPECT_THAT(refused(ports[0], 100), IsEmpty());
}

TEST_F(ConnectionLimits, AThousandClientsThatGoAwayAtAnyPointDoNoHarm) {
    Limits limits;
    limits.arrival = std::chrono::hours(1); // nobody is helped by it
    start(limits, 1);
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME"));
    const std::size_t before = openDescriptors();
    std::mt19937 random(20240229); // NOLINT(cert-msc32-c,cert-msc51-cpp): the same points every time
    const std::string whole = request();
    Clients open;
    for (int i = 0; i < 1000; ++i) {
        if (random() % 4 == 0) {
            open.push_back(std::make_unique<Client>(path));
        } else {
            open.push_back(std::make_unique<Client>(ports[0], 2 + static_cast<int>(random() % 100)));
        }
        open.back()->sendSome(whole.substr(0, random() % (whole.size() + 1)));
        while (open.size() > random() % 60) open.erase(open.begin() + static_cast<long>(random() % open.size()));
    }
    open.clear();
    while (Client(path).ask(request()).empty()) std::this_thread::yield();
    while (openDescriptors() > before + 1) std::this_thread::yield(); // the last client's end may still be open
    for (int n = 2; n < 40; ++n) served(ports[0], n);
}

ConnectionPointer connectionOf(Listener::Kind kind, const std::string& address) {
    auto connection = std::make_shared<Connection>();
    connection->kind = kind;
    connection->address = connection->network = address;
    return connection;
}

TEST(Connections, OfRootOverTheUnixSocketAreLetInWhenAllOthersAreTaken) {
    Connections connections(2, 1);
    for (const char* address : {"192.0.2.7", "192.0.2.8"}) {
        const ConnectionPointer other = connectionOf(Listener::Kind::Http, address);
        connections.open(other);
        EXPECT_FALSE(other->refused);
    }
    for (int i = 0; i < 2; ++i) {
        const ConnectionPointer root = connectionOf(Listener::Kind::Unix, "unix:0");
        root->peer = uid_t{0};
        connections.open(root);
        EXPECT_FALSE(root->refused);
    }
    const ConnectionPointer user = connectionOf(Listener::Kind::Unix, "unix:1000");
    user->peer = uid_t{1000};
    connections.open(user);
    EXPECT_TRUE(user->refused);
}

TEST(NetworkText, IsOneForAllAddressesOfAnIpv6Network) {
    const auto of = [](const char* text) {
        sockaddr_in6 address{};
        address.sin6_family = AF_INET6;
        inet_pton(AF_INET6, text, &address.sin6_addr);
        return networkText(reinterpret_cast<const sockaddr*>(&address));
    };
    EXPECT_EQ(of("2001:db8:0:1::7"), of("2001:db8:0:1:ffff::8"));
    EXPECT_NE(of("2001:db8:0:1::7"), of("2001:db8:0:2::7"));
    EXPECT_EQ(of("::ffff:192.0.2.7"), "192.0.2.7");
}

TEST(AddressText, IsTheSameForIpv4OnASocketForBothKinds) {
    sockaddr_in6 address{};
    address.sin6_family = AF_INET6;
    inet_pton(AF_INET6, "::ffff:192.0.2.7", &address.sin6_addr);
    EXPECT_EQ(addressText(reinterpret_cast<const sockaddr*>(&address)), "192.0.2.7");
    inet_pton(AF_INET6, "2001:db8::7", &address.sin6_addr);
    EXPECT_EQ(addressText(reinterpret_cast<const sockaddr*>(&address)), "2001:db8::7");
}

} // namespace
} // namespace endpoint
