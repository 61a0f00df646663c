// Sends two HTTP requests to a server over one connection that is kept open, in alternating blocks, and prints how long
// the requests of each took, and what processor time the server's processes used for them. What the requests say is the
// caller's: each file holds one, head and body.
#include <CLI/CLI.hpp>
#include <fmt/format.h>

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <charconv>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <netdb.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sstream>
#include <stdexcept>
#include <string>
#include <strings.h>
#include <sys/socket.h>
#include <system_error>
#include <unistd.h>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

/// A connection that stays open from request to request, as far as the server lets it.
class Connection {
public:
    Connection(std::string theHost, std::string thePort) : host(std::move(theHost)), port(std::move(thePort)) {}
    ~Connection() { close(); }
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    /// The answer's body. Connects first where there is no connection.
    std::string ask(const std::string& request) {
        if (descriptor < 0) connect();
        send(request);
        return receive();
    }

    int timesConnected() const { return connected; }

private:
    void connect() {
        addrinfo hints{};
        hints.ai_socktype = SOCK_STREAM;
        addrinfo* found = nullptr;
        if (const int error = getaddrinfo(host.c_str(), port.c_str(), &hints, &found); error != 0)
            throw std::runtime_error(fmt::format("{}: {}", host, gai_strerror(error)));
        descriptor = socket(found->ai_family, found->ai_socktype | SOCK_CLOEXEC, found->ai_protocol);
        const int failed = descriptor < 0 ? -1 : ::connect(descriptor, found->ai_addr, found->ai_addrlen);
        freeaddrinfo(found);
        if (failed != 0) throw std::system_error(errno, std::generic_category(), host + ':' + port);
        const int on = 1;
        setsockopt(descriptor, IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
        ++connected;
    }

    void close() {
        if (descriptor >= 0) ::close(descriptor);
        descriptor = -1;
        received.clear();
    }

    void send(const std::string& request) {
        for (std::size_t sent = 0; sent < request.size();) {
            const ssize_t count = ::send(descriptor, request.data() + sent, request.size() - sent, MSG_NOSIGNAL);
            if (count < 0) throw std::system_error(errno, std::generic_category(), "send");
            sent += static_cast<std::size_t>(count);
        }
    }

    void readMore() {
        char bytes[65536];
        const ssize_t count = recv(descriptor, bytes, sizeof bytes, 0);
        if (count < 0) throw std::system_error(errno, std::generic_category(), "recv");
        if (count == 0) throw std::runtime_error("the server closed the connection within an answer");
        received.append(bytes, static_cast<std::size_t>(count));
    }

    std::string takeUntil(std::string_view mark) {
        std::size_t end = received.find(mark);
        for (; end == std::string::npos; end = received.find(mark)) readMore();
        return take(end + mark.size());
    }

    std::string take(std::size_t count) {
        while (received.size() < count) readMore();
        const std::string taken = received.substr(0, count);
        received.erase(0, count);
        return taken;
    }

    std::string receive() {
        const std::string head = takeUntil("\r\n\r\n");
        if (head.compare(0, 5, "HTTP/") != 0 || head.find(" 200 ") == std::string::npos)
            throw std::runtime_error("the server refused: " + head.substr(0, head.find('\r')));
        std::string body = isChunked(head) ? takeChunks() : take(number(field(head, "Content-Length"), 10));
        if (strcasecmp(field(head, "Connection").c_str(), "close") == 0) close();
        return body;
    }

    std::string takeChunks() {
        std::string body;
        for (;;) {
            const std::size_t length = number(takeUntil("\r\n"), 16);
            if (length == 0) break;
            body += take(length + 2).substr(0, length);
        }
        while (takeUntil("\r\n") != "\r\n") {
        } // trailers
        return body;
    }

    static bool isChunked(const std::string& head) { return field(head, "Transfer-Encoding") == "chunked"; }

    /// A header's value; empty when it is missing.
    static std::string field(const std::string& head, std::string_view name) {
        for (std::size_t line = head.find("\r\n"); line != std::string::npos; line = head.find("\r\n", line)) {
            line += 2;
            if (strncasecmp(head.c_str() + line, name.data(), name.size()) != 0 || head[line + name.size()] != ':')
                continue;
            const std::size_t start = head.find_first_not_of(' ', line + name.size() + 1);
            return head.substr(start, head.find("\r\n", start) - start);
        }
        return {};
    }

    static std::size_t number(const std::string& text, int base) {
        std::size_t value = 0;
        if (std::from_chars(text.data(), text.data() + text.size(), value, base).ec != std::errc())
            throw std::runtime_error("the answer has no length: \"" + text + '"');
        return value;
    }

    std::string host, port;
    int descriptor = -1;
    int connected = 0;
    std::string received;
};

struct Subject {
    std::string request;
    std::size_t size = 0;         ///< of each answer
    std::vector<double> blocks{}; ///< microseconds a request
    long ticks = 0;               ///< of the server's processes, over all blocks
};

std::string contentOf(const std::string& file) {
    std::ifstream stream(file, std::ios::binary);
    if (!stream) throw std::runtime_error(file + ": cannot be read");
    return {std::istreambuf_iterator<char>(stream), {}};
}

/// The processor time, in clock ticks, that a process has used with all its threads, also those that have ended: the
/// fields utime and stime of its stat file. 0 when its program has another name.
long ticksOf(const std::filesystem::path& process, const std::vector<std::string>& names) {
    const std::string stat = contentOf(process / "stat");
    const std::size_t open = stat.find('('), close = stat.rfind(')');
    if (std::find(names.begin(), names.end(), stat.substr(open + 1, close - open - 1)) == names.end()) return 0;
    std::istringstream fields(stat.substr(close + 1));
    std::string skipped;
    for (int i = 0; i < 11; ++i) fields >> skipped;
    long user = 0, kernel = 0;
    fields >> user >> kernel;
    return user + kernel;
}

long ticksOfAll(const std::vector<std::string>& names) {
    long sum = 0;
    for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
        if (names.empty() || !std::isdigit(static_cast<unsigned char>(entry.path().filename().native().front())))
            continue;
        try {
            sum += ticksOf(entry.path(), names);
        } catch (const std::runtime_error&) {
        } // it has just ended
    }
    return sum;
}

void askOnce(Connection& connection, Subject& subject) {
    const std::string answer = connection.ask(subject.request);
    if (answer.find("<ERROR") != std::string::npos)
        throw std::runtime_error("the server answers with an error:\n" + answer);
    subject.size = answer.size();
}

void runBlock(Connection& connection, Subject& subject, int requests, const std::vector<std::string>& processes) {
    const long ticks = ticksOfAll(processes);
    const auto start = Clock::now();
    for (int i = 0; i < requests; ++i) askOnce(connection, subject);
    const std::chrono::duration<double, std::micro> spent = Clock::now() - start;
    subject.blocks.push_back(spent.count() / requests);
    subject.ticks += ticksOfAll(processes) - ticks;
}

std::string described(const Subject& subject, int requests) {
    std::vector<double> sorted = subject.blocks;
    std::sort(sorted.begin(), sorted.end());
    const double cpu = 1e6 * static_cast<double>(subject.ticks) / static_cast<double>(sysconf(_SC_CLK_TCK)) /
                       (static_cast<double>(requests) * static_cast<double>(sorted.size()));
    return fmt::format(R"({{"bytes": {}, "microseconds": {:.2f}, "cpu_microseconds": {:.2f}}})", subject.size,
                       sorted[sorted.size() / 2], cpu);
}

} // namespace

int main(int argc, char** argv) {
    CLI::App app(
        "Sends two requests to a server in alternating blocks over one connection, and prints for each the size of "
        "its answer and the median over the blocks of a request's microseconds, as JSON.");
    std::string host, port;
    std::vector<std::string> files, processes;
    int blocks = 20, requests = 200;
    app.add_option("host", host, "the server's name or address")->required();
    app.add_option("port", port, "its port")->required();
    app.add_option("files", files, "the requests, head and body")->required()->expected(2);
    app.add_option("--blocks", blocks, "of each request")->check(CLI::PositiveNumber);
    app.add_option("--requests", requests, "in a block")->check(CLI::PositiveNumber);
    app.add_option("--process", processes, "the server's processes, whose processor time counts")
        ->allow_extra_args(false);
    CLI11_PARSE(app, argc, argv);
    try {
        Connection connection(host, port);
        Subject subjects[] = {{contentOf(files[0])}, {contentOf(files[1])}};
        for (Subject& subject : subjects) runBlock(connection, subject, requests, {}); // the server warms up
        for (Subject& subject : subjects) subject.blocks.clear();
        for (int i = 0; i < blocks; ++i)
            for (int k : {i % 2, 1 - i % 2}) runBlock(connection, subjects[k], requests, processes);
        fmt::print("[{}, {}, {{\"connections\": {}}}]\n", described(subjects[0], requests),
                   described(subjects[1], requests), connection.timesConnected());
        return 0;
    } catch (const std::exception& failure) {
        fmt::print(stderr, "server-load: {}\n", failure.what());
        return 1;
    }
}
