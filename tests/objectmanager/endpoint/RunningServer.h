#pragma once

#include "objectmanager/endpoint/Server.h"

#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <condition_variable>
#include <functional>
#include <mutex>
#include <optional>
#include <string>
#include <thread>

namespace endpoint {

/// A client's end of a connection.
class Client {
public:
    /// To a Unix socket.
    explicit Client(const std::string& path);
    /// To a port of 127.0.0.1, from the address 127.0.0.N.
    Client(int port, int n);
    ~Client();
    Client(const Client&) = delete;
    Client& operator=(const Client&) = delete;

    void send(const std::string& text) const;
    /// As far as the other end takes it.
    void sendSome(const std::string& text) const;

    /// One answer, its head and its body, also one that comes in chunks; what came so far where the connection ends.
    std::string receive();
    std::string receiveHead() { return through("\r\n\r\n"); }
    /// What follows such a head, as it comes.
    void receiveBody(const std::string& head, const std::function<void(std::string_view)>& take);

    /// All that comes until the connection ends.
    std::string receiveAll();

    /// Whether the other end hangs up in that time.
    bool hasEnded(std::chrono::milliseconds patience) const;
    /// Until the other end hangs up. What it sent before stays to be received.
    void waitForEnd() const;

    /// The one of two that has got something.
    friend Client& waitForEither(Client& a, Client& b);

    std::string ask(const std::string& text) {
        send(text);
        return receive();
    }

private:
    bool receiveMore();
    std::string through(std::string_view end);
    std::string exactly(std::size_t length);
    std::string take(std::size_t length);

    int socket;
    std::string buffer;
};

Client& waitForEither(Client& a, Client& b);

/// The head of a POST with these further headers.
std::string head(const std::string& more, const std::string& operation = "EnumerateInstanceNames");
/// The names of a class's instances, asked for.
std::string body(const std::string& name);
std::string request(const std::string& name = "VESKA_ComputerSystem");

/// A server with a provider that hangs in the class VESKA_TimeService until the end of the test.
class RunningServer : public testing::Test {
protected:
    /// On a Unix socket, and on as many ports of the loopback.
    void start(const Limits& limits = {}, int ports = 0);
    void TearDown() override;

    /// Lets what hangs go on.
    void release();
    virtual om::Answer provide(const om::Request& asked);
    void waitForHanging(int count);

    support::TemporaryDirectory directory;
    std::string path = directory.path("socket");
    std::vector<int> ports;
    std::optional<Operations> operations;
    std::optional<Server> server;
    std::atomic<bool> stopped{false};
    std::thread running;
    std::mutex mutex;
    std::condition_variable changed;
    bool released = false;
    int hanging = 0;
    int asked = 0; ///< times
    std::atomic<int> results{1};
};

} // namespace endpoint
