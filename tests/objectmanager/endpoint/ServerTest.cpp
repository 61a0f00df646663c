#include "objectmanager/endpoint/Server.h"
#include "objectmanager/endpoint/Work.h"

#include "support/TemporaryDirectory.h"
#include "tests/objectmanager/cimxml/Messages.h"

#include <gmock/gmock.h>

#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <condition_variable>
#include <thread>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::parameter;
using testing::HasSubstr;
using testing::StartsWith;

/// A client's end of a connection.
class Client {
public:
    explicit Client(const std::string& path) : socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        std::copy(path.begin(), path.end(), address.sun_path);
        EXPECT_EQ(connect(socket, reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    }
    ~Client() { close(socket); }
    Client(const Client&) = delete;
    Client& operator=(const Client&) = delete;

    void send(const std::string& text) const {
        EXPECT_EQ(::send(socket, text.data(), text.size(), MSG_NOSIGNAL), static_cast<ssize_t>(text.size()));
    }

    /// One answer, its head and its body; what came so far where the connection ends.
    std::string receive() {
        for (;;) {
            const std::size_t end = buffer.find("\r\n\r\n");
            if (end != std::string::npos) {
                const std::size_t at = buffer.find("Content-Length: ");
                const std::size_t length = at < end ? std::stoul(buffer.substr(at + 16)) : 0;
                if (buffer.size() >= end + 4 + length) return take(end + 4 + length);
            }
            char bytes[65536];
            const ssize_t count = recv(socket, bytes, sizeof bytes, 0);
            if (count <= 0) return take(buffer.size());
            buffer.append(bytes, static_cast<std::size_t>(count));
        }
    }

    /// The one of two that has got something.
    friend Client& waitForEither(Client& a, Client& b) {
        pollfd both[] = {{a.socket, POLLIN, 0}, {b.socket, POLLIN, 0}};
        poll(both, 2, -1);
        return both[0].revents != 0 ? a : b;
    }

    std::string ask(const std::string& text) {
        send(text);
        return receive();
    }

private:
    std::string take(std::size_t length) {
        std::string taken = buffer.substr(0, length);
        buffer.erase(0, length);
        return taken;
    }

    int socket;
    std::string buffer;
};

std::string head(const std::string& more, const std::string& operation = "EnumerateInstanceNames") {
    return "POST /cimom HTTP/1.1\r\nHost: x\r\nContent-Type: application/xml\r\nCIMOperation: MethodCall\r\n"
           "CIMMethod: " +
           operation + "\r\nCIMObject: root%2Fcimv2\r\n" + more + "\r\n";
}

std::string body(const std::string& name) {
    return cimxml::intrinsic("EnumerateInstanceNames", parameter("ClassName", className(name)));
}

std::string request(const std::string& name = "VESKA_ComputerSystem") {
    return head("Content-Length: " + std::to_string(body(name).size()) + "\r\n") + body(name);
}

/// A server with a provider that hangs in the class VESKA_TimeService until the end of the test.
class ServerFixture : public testing::Test {
protected:
    void start(const Limits& limits = {}) {
        ServerSettings settings;
        settings.limits = limits;
        settings.anonymousRead = true; // whoever runs the tests
        server.emplace(operations, settings);
        server->serve(listenAt(ListenUrl("unix:" + path)));
        running = std::thread([this] { server->run(stopped, std::chrono::seconds(0)); });
    }

    void TearDown() override {
        release();
        stopped = true;
        if (running.joinable()) running.join();
        EXPECT_TRUE(server->shutDown());
    }

    void release() {
        const std::lock_guard lock(mutex);
        released = true;
        changed.notify_all();
    }

    om::Answer provide(const om::Request& asked) {
        std::unique_lock lock(mutex);
        if (asked.path.className == "VESKA_TimeService") {
            ++hanging;
            changed.notify_all();
            changed.wait(lock, [&] { return released; });
        }
        om::Answer answer;
        answer.results.emplace_back(asked.path);
        return answer;
    }

    void waitForHanging(int count) {
        std::unique_lock lock(mutex);
        changed.wait(lock, [&] { return hanging >= count; });
    }

    support::TemporaryDirectory directory;
    std::string path = directory.path("socket");
    Operations operations{{{"root/cimv2", {}, &om::Schema::builtin(), noting([this](const om::Request& asked) {
                                return provide(asked);
                            })}},
                          "host1"};
    std::optional<Server> server;
    std::atomic<bool> stopped{false};
    std::thread running;
    std::mutex mutex;
    std::condition_variable changed;
    bool released = false;
    int hanging = 0;
};

using ServerTest = ServerFixture;

TEST_F(ServerTest, ServesSeveralRequestsOverOneConnection) {
    start();
    Client client(path);
    for (int i = 0; i < 3; ++i) {
        const std::string answer = client.ask(request());
        EXPECT_THAT(answer, StartsWith("HTTP/1.1 200 OK\r\n"));
        EXPECT_THAT(answer, HasSubstr("<INSTANCENAME CLASSNAME=\"VESKA_ComputerSystem\">"));
    }
    client.send(request() + request("CIM_ComputerSystem")); // two in one packet
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, TakesChunkedBodies) {
    start();
    Client client(path);
    const std::string whole = body("VESKA_ComputerSystem");
    char size[16];
    std::snprintf(size, sizeof size, "%zx", whole.size() - 5);
    client.send(head("Transfer-Encoding: chunked\r\n") + "5\r\n" + whole.substr(0, 5) + "\r\n");
    client.send(size + std::string("\r\n") + whole.substr(5) + "\r\n0\r\n\r\n");
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, RefusesBodiesThatAreTooLargeOrHaveNoLength) {
    start();
    struct {
        const char* header;
        const char* answer;
    } const bad[] = {{"Content-Length: 1048577\r\n", "HTTP/1.1 413"},
                     {"Content-Length: 99999999999999999999999\r\n", "HTTP/1.1 413"},
                     {"", "HTTP/1.1 411"},
                     {"Content-Length: -5\r\n", "HTTP/1.1 400"},
                     {"Content-Length: 5x\r\n", "HTTP/1.1 400"},
                     {"Content-Length: 5\r\nContent-Length: 6\r\n", "HTTP/1.1 400"},
                     {"Content-Length: 5\r\nTransfer-Encoding: chunked\r\n", "HTTP/1.1 400"}};
    for (const auto& each : bad) {
        Client client(path);
        EXPECT_THAT(client.ask(head(each.header)), StartsWith(each.answer)) << each.header;
    }
    Client chunked(path);
    const std::string piece(0x40000, ' ');
    chunked.send(head("Transfer-Encoding: chunked\r\n"));
    for (int i = 0; i < 5; ++i) chunked.send("40000\r\n" + piece + "\r\n");
    chunked.send("0\r\n\r\n");
    EXPECT_THAT(chunked.receive(), StartsWith("HTTP/1.1 413"));
}

TEST_F(ServerTest, RefusesHeadsThatAreTooLarge) {
    start();
    Client client(path);
    const std::string answer = client.ask(head("X-Long: " + std::string(20000, 'x') + "\r\nContent-Length: 5\r\n"));
    EXPECT_THAT(answer, testing::Not(HasSubstr(" 200 ")));
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, AProviderThatHangsHoldsItsOwnRequestOnly) {
    Limits limits;
    limits.workers = 1;
    limits.answer = std::chrono::milliseconds(300);
    start(limits);
    Client stuck(path);
    testing::internal::CaptureStderr();
    EXPECT_THAT(stuck.ask(request("VESKA_TimeService")), StartsWith("HTTP/1.1 503"));
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME"));
    EXPECT_THAT(testing::internal::GetCapturedStderr(), HasSubstr("EnumInstanceNames of VESKA_TimeService"));
}

TEST_F(ServerTest, AFullQueueIsSaid) {
    Limits limits;
    limits.workers = 1;
    limits.queue = 1;
    start(limits);
    Client first(path);
    first.send(request("VESKA_TimeService"));
    waitForHanging(1);
    Client second(path);
    Client third(path);
    second.send(request());
    third.send(request());
    // Whichever of the two comes later finds the queue full.
    Client& refused = waitForEither(second, third);
    EXPECT_THAT(refused.receive(), StartsWith("HTTP/1.1 503"));
    release();
    EXPECT_THAT(first.receive(), HasSubstr("INSTANCENAME"));
    EXPECT_THAT((&refused == &second ? third : second).receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, ASlowSenderIsCutOff) {
    Limits limits;
    limits.arrival = std::chrono::milliseconds(300);
    start(limits);
    Client silent(path);
    Client slow(path);
    slow.send(head("Content-Length: 1000\r\n") + "<CIM");
    EXPECT_THAT(silent.receive(), testing::Not(HasSubstr(" 200 ")));
    EXPECT_THAT(slow.receive(), testing::Not(HasSubstr(" 200 ")));
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, ClientsThatGoAwayDoNoHarm) {
    start();
    const std::string whole = request();
    for (std::size_t i = 0; i < 200; ++i) Client(path).send(whole.substr(0, i * whole.size() / 199));
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME"));
}

TEST(ServerOverTcp, WantsAUser) {
    Operations operations({}, "host1");
    Server server(operations, {});
    const Listener listener = listenAt(ListenUrl("http://127.0.0.1:0"));
    server.serve(listener);
    EXPECT_THAT(listener.url, StartsWith("http://127.0.0.1:"));
    std::atomic<bool> stopped{false};
    std::thread running([&] { server.run(stopped, std::chrono::seconds(0)); });
    const std::string command = "curl -s -o /dev/null -w '%{http_code} %header{www-authenticate}' -d x " + listener.url;
    FILE* pipe = popen(command.c_str(), "r"); // NOLINT(cert-env33-c)
    char text[100] = "";
    if (pipe != nullptr && std::fgets(text, sizeof text, pipe) == nullptr) text[0] = '\0';
    if (pipe != nullptr) pclose(pipe);
    stopped = true;
    running.join();
    EXPECT_STREQ(text, "401 Basic realm=\"vkcimd\"");
}

} // namespace
} // namespace endpoint
