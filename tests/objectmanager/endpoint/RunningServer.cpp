#include "tests/objectmanager/endpoint/RunningServer.h"

#include "objectmanager/endpoint/Work.h"
#include "tests/objectmanager/cimxml/Messages.h"

#include <arpa/inet.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>

namespace endpoint {
namespace {

template <class Address>
const sockaddr* generic(const Address& address) {
    return reinterpret_cast<const sockaddr*>(&address);
}

sockaddr_in loopback(int n, int port) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(0x7F000000U + static_cast<unsigned>(n));
    address.sin_port = htons(static_cast<in_port_t>(port));
    return address;
}

} // namespace

Client::Client(const std::string& path) : socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::copy(path.begin(), path.end(), address.sun_path);
    EXPECT_EQ(connect(socket, generic(address), sizeof address), 0);
}

Client::Client(int port, int n) : socket(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    const sockaddr_in from = loopback(n, 0);
    const sockaddr_in to = loopback(1, port);
    EXPECT_EQ(bind(socket, generic(from), sizeof from), 0);
    EXPECT_EQ(connect(socket, generic(to), sizeof to), 0);
}

Client::~Client() {
    close(socket);
}

void Client::send(const std::string& text) const {
    EXPECT_EQ(::send(socket, text.data(), text.size(), MSG_NOSIGNAL), static_cast<ssize_t>(text.size()));
}

void Client::sendSome(const std::string& text) const {
    if (::send(socket, text.data(), text.size(), MSG_NOSIGNAL) < 0) return;
}

std::string Client::receive() {
    std::string answer = receiveHead();
    receiveBody(answer.substr(), [&answer](std::string_view piece) { answer += piece; });
    return answer;
}

void Client::receiveBody(const std::string& head, const std::function<void(std::string_view)>& take) {
    constexpr std::string_view announcement = "Content-Length: ";
    if (head.find("Transfer-Encoding: chunked") == std::string::npos) {
        const std::size_t at = head.find(announcement);
        take(exactly(at == std::string::npos ? std::string::npos : std::stoul(head.substr(at + announcement.size()))));
        return;
    }
    for (std::size_t length = 1; length > 0;) {
        length = std::strtoul(through("\r\n").c_str(), nullptr, 16);
        take(exactly(length));
        through("\r\n");
    }
}

bool Client::receiveMore() {
    char bytes[65536];
    const ssize_t count = recv(socket, bytes, sizeof bytes, 0);
    if (count > 0) buffer.append(bytes, static_cast<std::size_t>(count));
    return count > 0;
}

std::string Client::through(std::string_view end) {
    while (buffer.find(end) == std::string::npos) {
        if (!receiveMore()) return take(buffer.size());
    }
    return take(buffer.find(end) + end.size());
}

std::string Client::exactly(std::size_t length) {
    while (buffer.size() < length && receiveMore()) continue;
    return take(std::min(length, buffer.size()));
}

std::string Client::receiveAll() {
    std::string all;
    for (std::string each = receive(); !each.empty(); each = receive()) all += each;
    return all;
}

bool Client::hasEnded(std::chrono::milliseconds patience) const {
    pollfd end = {socket, 0, 0}; // POLLHUP alone
    return poll(&end, 1, static_cast<int>(patience.count())) > 0;
}

void Client::waitForEnd() const {
    while (!hasEnded(std::chrono::hours(1))) {
    }
}

Client& waitForEither(Client& a, Client& b) {
    pollfd both[] = {{a.socket, POLLIN, 0}, {b.socket, POLLIN, 0}};
    poll(both, 2, -1);
    return both[0].revents != 0 ? a : b;
}

std::string Client::take(std::size_t length) {
    std::string taken = buffer.substr(0, length);
    buffer.erase(0, length);
    return taken;
}

std::string head(const std::string& more, const std::string& operation) {
    return "POST /cimom HTTP/1.1\r\nHost: x\r\nContent-Type: application/xml\r\nCIMOperation: MethodCall\r\n"
           "CIMMethod: " +
           operation + "\r\nCIMObject: root%2Fcimv2\r\n" + more + "\r\n";
}

std::string body(const std::string& name) {
    return cimxml::intrinsic("EnumerateInstanceNames", cimxml::parameter("ClassName", cimxml::className(name)));
}

std::string request(const std::string& name) {
    return head("Content-Length: " + std::to_string(body(name).size()) + "\r\n") + body(name);
}

void RunningServer::start(const Limits& limits, int wanted) {
    Ask provider = noting([this](const om::Request& each) { return provide(each); });
    operations.emplace(std::vector<NameSpace>{{"root/cimv2", {}, &om::Schema::builtin(), std::move(provider)}},
                       "host1");
    ServerSettings settings;
    settings.limits = limits;
    settings.anonymousRead = true; // whoever runs the tests
    server.emplace(*operations, settings);
    server->serve(listenAt(ListenUrl("unix:" + path)));
    for (int i = 0; i < wanted; ++i) {
        const Listener listener = listenAt(ListenUrl("http://127.0.0.1:0"));
        server->serve(listener);
        ports.push_back(std::stoi(listener.url.substr(listener.url.rfind(':') + 1)));
    }
    running = std::thread([this] { server->run(stopped, std::chrono::seconds(0)); });
}

void RunningServer::TearDown() {
    release();
    stopped = true;
    if (running.joinable()) running.join();
    EXPECT_TRUE(server->shutDown());
}

void RunningServer::release() {
    const std::lock_guard lock(mutex);
    released = true;
    changed.notify_all();
}

om::Answer RunningServer::provide(const om::Request& wanted) {
    std::unique_lock lock(mutex);
    ++asked;
    if (wanted.path.className == "VESKA_TimeService") {
        ++hanging;
        changed.notify_all();
        changed.wait(lock, [&] { return released; });
    }
    om::Answer answer;
    for (int i = 0; i < results; ++i) answer.results.emplace_back(wanted.path);
    return answer;
}

void RunningServer::waitForHanging(int count) {
    std::unique_lock lock(mutex);
    changed.wait(lock, [&] { return hanging >= count; });
}

} // namespace endpoint
