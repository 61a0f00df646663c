#include "objectmanager/endpoint/Server.h"

#include "objectmanager/endpoint/Log.h"
#include "objectmanager/endpoint/Rights.h"
#include "objectmanager/endpoint/Work.h"
#include "objectmanager/endpoint/Workers.h"

#include <arpa/inet.h>
#include <microhttpd.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include <algorithm>
#include <charconv>
#include <map>
#include <set>
#include <stdexcept>
#include <thread>

namespace endpoint {
namespace {

using Clock = std::chrono::steady_clock;
using WorkPointer = std::shared_ptr<Work>;

constexpr std::size_t mostAuthentications = 4; ///< at once: the other workers go on while PAM is slow
constexpr const char* tlsPriorities = "NORMAL:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2";

HttpAnswer plainAnswer(unsigned status, const std::string& detail) {
    HttpAnswer answer;
    answer.status = status;
    answer.detail = detail;
    return answer;
}

HttpAnswer challenge(const std::string& detail) {
    HttpAnswer answer = plainAnswer(401, detail);
    answer.headers.emplace_back("WWW-Authenticate", "Basic realm=\"vkcimd\"");
    return answer;
}

MHD_Result collectHeader(void* target, MHD_ValueKind, const char* key, const char* value) {
    static_cast<Headers*>(target)->emplace_back(key, value != nullptr ? value : "");
    return MHD_YES;
}

std::string addressText(const sockaddr* address) {
    char text[INET6_ADDRSTRLEN] = "?";
    if (address->sa_family == AF_INET) {
        inet_ntop(AF_INET, &reinterpret_cast<const sockaddr_in*>(address)->sin_addr, text, sizeof text);
    } else if (address->sa_family == AF_INET6) {
        inet_ntop(AF_INET6, &reinterpret_cast<const sockaddr_in6*>(address)->sin6_addr, text, sizeof text);
    }
    return text;
}

std::string requestLine(const Work& work) {
    const auto elapsed = std::chrono::duration_cast<std::chrono::microseconds>(Clock::now() - work.started);
    const HttpAnswer& answer = work.answer;
    std::string line = work.connection->address + ' ' + logged(work.caller.user) + ' ' + logged(answer.operation) +
                       ' ' + logged(answer.nameSpace) + ' ' + logged(answer.className) +
                       " http=" + std::to_string(answer.status) + " cim=" + std::to_string(answer.cimStatus) +
                       " us=" + std::to_string(elapsed.count());
    if (!answer.detail.empty()) line += ": " + answer.detail;
    return line;
}

} // namespace

class Server::Impl {
public:
    Impl(Operations& given, ServerSettings wanted)
        : operations(given), settings(std::move(wanted)),
          workers(settings.limits.workers, settings.limits.queue, settings.limits.workers * 4) {}

    ~Impl() { shutDown(); }

    void serve(const Listener& listener) {
        auto entry = std::make_unique<Entry>(Entry{this, listener, nullptr});
        entry->daemon = start(*entry);
        if (entry->daemon == nullptr) throw std::runtime_error("cannot serve " + listener.url);
        entries.push_back(std::move(entry));
    }

    void run(const std::atomic<bool>& stop, std::chrono::seconds idle) {
        while (!stop) {
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
            const std::lock_guard lock(mutex);
            const Clock::time_point now = Clock::now();
            endSlowSenders(now);
            answerForHanging(now);
            if (!connections.empty()) lastUse = now;
            if (idle.count() > 0 && now - lastUse >= idle) return;
        }
    }

    bool shutDown() {
        if (entries.empty()) return clean;
        const bool ended = workers.stop();
        {
            const std::lock_guard lock(mutex);
            for (const WorkPointer& work : std::set<WorkPointer>(working)) finish(work, plainAnswer(503, "stopping"));
        }
        for (const auto& entry : entries) MHD_stop_daemon(entry->daemon);
        entries.clear();
        clean = ended;
        return clean;
    }

private:
    struct Entry {
        Impl* server;
        Listener listener;
        MHD_Daemon* daemon;
    };

    MHD_Daemon* start(Entry& entry) {
        const Limits& limits = settings.limits;
        const bool tls = entry.listener.kind == Listener::Kind::Https;
        const bool tcp = entry.listener.kind != Listener::Kind::Unix;
        std::vector<MHD_OptionItem> options = {
            {MHD_OPTION_LISTEN_SOCKET, entry.listener.socket, nullptr},
            {MHD_OPTION_CONNECTION_LIMIT, static_cast<intptr_t>(limits.connections), nullptr},
            {MHD_OPTION_PER_IP_CONNECTION_LIMIT, static_cast<intptr_t>(tcp ? limits.connectionsPerAddress : 0),
             nullptr},
            // What MHD itself puts into an answer takes room there, too.
            {MHD_OPTION_CONNECTION_MEMORY_LIMIT, static_cast<intptr_t>(limits.head + 2048), nullptr},
            {MHD_OPTION_NOTIFY_COMPLETED, reinterpret_cast<intptr_t>(&Impl::completed), &entry},
            {MHD_OPTION_NOTIFY_CONNECTION, reinterpret_cast<intptr_t>(&Impl::connectionChanged), &entry},
        };
        if (tls) {
            options.push_back({MHD_OPTION_HTTPS_MEM_CERT, 0, settings.certificate.data()});
            options.push_back({MHD_OPTION_HTTPS_MEM_KEY, 0, settings.key.data()});
            options.push_back({MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(tlsPriorities)});
        }
        options.push_back({MHD_OPTION_END, 0, nullptr});
        const unsigned flags = MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_EPOLL | MHD_ALLOW_SUSPEND_RESUME |
                               (tls ? unsigned{MHD_USE_TLS} : 0U);
        return MHD_start_daemon(flags, 0, nullptr, nullptr, &Impl::access, &entry, MHD_OPTION_ARRAY, options.data(),
                                MHD_OPTION_END);
    }

    static std::shared_ptr<Connection> connectionOf(MHD_Connection* handle) {
        const MHD_ConnectionInfo* info = MHD_get_connection_info(handle, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
        return *static_cast<std::shared_ptr<Connection>*>(info->socket_context);
    }

    static void connectionChanged(void* target, MHD_Connection* handle, void** context,
                                  MHD_ConnectionNotificationCode code) {
        Entry& entry = *static_cast<Entry*>(target);
        const std::lock_guard lock(entry.server->mutex);
        if (code == MHD_CONNECTION_NOTIFY_STARTED) {
            auto connection = std::make_shared<Connection>();
            connection->kind = entry.listener.kind;
            connection->socket = MHD_get_connection_info(handle, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
            identify(*connection, handle);
            entry.server->refuseCrowds(*connection);
            entry.server->connections.insert(connection);
            *context = new std::shared_ptr<Connection>(std::move(connection));
        } else {
            auto* connection = static_cast<std::shared_ptr<Connection>*>(*context);
            entry.server->connections.erase(*connection);
            entry.server->lastUse = Clock::now();
            delete connection;
            *context = nullptr;
        }
    }

    /// Who is at the other end, as far as the socket says.
    static void identify(Connection& connection, MHD_Connection* handle) {
        if (connection.kind == Listener::Kind::Unix) {
            connection.peer = peerOf(connection.socket);
            connection.address = "unix:" + (connection.peer ? std::to_string(*connection.peer) : "?");
        } else {
            connection.address =
                addressText(MHD_get_connection_info(handle, MHD_CONNECTION_INFO_CLIENT_ADDRESS)->client_addr);
        }
    }

    /// Under the lock. MHD counts the connections of network addresses; root may have as many as there are.
    void refuseCrowds(const Connection& connection) const {
        if (connection.kind != Listener::Kind::Unix || connection.peer == uid_t{0}) return;
        const auto same = std::count_if(connections.begin(), connections.end(),
                                        [&](const auto& each) { return each->address == connection.address; });
        if (static_cast<unsigned>(same) >= settings.limits.connectionsPerAddress) {
            shutdown(connection.socket, SHUT_RDWR);
        }
    }

    static MHD_Result access(void* target, MHD_Connection* handle, const char* url, const char* method,
                             const char* version, const char* data, std::size_t* size, void** context) {
        Impl& self = *static_cast<Entry*>(target)->server;
        if (*context == nullptr) {
            auto work = self.begin(handle, url, method, version);
            *context = new WorkPointer(work);
            return work->isFinished() ? self.send(*work) : MHD_YES;
        }
        const WorkPointer& work = *static_cast<WorkPointer*>(*context);
        if (*size > 0) return self.receive(*work, data, *size, *size);
        if (work->isFinished()) return self.send(*work);
        if (work->tooLarge) {
            work->finish(plainAnswer(413, "the body is too large"));
            return self.send(*work);
        }
        self.process(work);
        return MHD_YES;
    }

    /// What can be said once the head is there.
    WorkPointer begin(MHD_Connection* handle, const char* url, const char* method, const char* version) {
        auto work = std::make_shared<Work>();
        work->handle = handle;
        work->connection = connectionOf(handle);
        work->http.method = method;
        work->http.version = version;
        work->http.path = url;
        MHD_get_connection_values(handle, MHD_HEADER_KIND, &collectHeader, &work->http.headers);
        if (auto refused = refuse(*work)) work->finish(std::move(*refused));
        return work;
    }

    std::optional<HttpAnswer> refuse(const Work& work) const {
        const std::string length = headerOf(work.http, "Content-Length").value_or("0");
        std::size_t bytes = 0;
        const auto [end, error] = std::from_chars(length.data(), length.data() + length.size(), bytes);
        if (error == std::errc::result_out_of_range || bytes > settings.limits.body) {
            return plainAnswer(413, "the body is too large");
        }
        if (error != std::errc() || end != length.data() + length.size()) return plainAnswer(400, "Content-Length");
        const bool chunked = headerOf(work.http, "Transfer-Encoding").has_value();
        const bool posted = work.http.method == "POST" || work.http.method == "M-POST";
        if (posted && !chunked && !headerOf(work.http, "Content-Length")) return plainAnswer(411, "no Content-Length");
        if (chunked && headerOf(work.http, "Content-Length")) return plainAnswer(400, "two lengths");
        const bool named = work.connection->kind == Listener::Kind::Unix || headerOf(work.http, "Authorization");
        if (!named && !mayBeAnonymous(*work.connection)) return challenge("no user is named");
        return refuseHead(work.http);
    }

    bool mayBeAnonymous(const Connection& connection) const {
        return settings.anonymousRead && connection.kind == Listener::Kind::Http;
    }

    MHD_Result receive(Work& work, const char* data, std::size_t length, std::size_t& left) {
        work.received += length;
        left = 0;
        if (work.received > settings.limits.body) {
            work.tooLarge = true;
            work.http.body = std::string();
            // One that goes on for long is cut off.
            return work.received > settings.limits.body * 8 ? MHD_NO : MHD_YES;
        }
        work.http.body.append(data, length);
        return MHD_YES;
    }

    /// Hands a whole request to a worker. MHD asks again when the connection is resumed.
    void process(const WorkPointer& work) {
        const std::lock_guard lock(mutex);
        work->connection->receiving = false;
        work->started = Clock::now();
        working.insert(work);
        MHD_suspend_connection(work->handle);
        if (!workers.post([this, work] { answer(work); })) finish(work, plainAnswer(503, "too many requests"));
    }

    /// In a worker.
    void answer(const WorkPointer& work) {
        const CurrentWork current(*work);
        work->note("authentication of its client");
        HttpAnswer made;
        try {
            if (auto refused = authenticate(*work)) {
                made = std::move(*refused);
            } else {
                made = exchange(operations, work->http, work->caller);
            }
        } catch (const std::exception& error) {
            made = plainAnswer(500, error.what());
        }
        const std::lock_guard lock(mutex);
        if (!finish(work, std::move(made))) {
            if (work->replaced) workers.cameBack();
            log("a request came back after all: " + work->noted());
        }
    }

    /// Under the lock. Whether this was the first answer.
    bool finish(const WorkPointer& work, HttpAnswer made) {
        if (!work->finish(std::move(made))) return false;
        working.erase(work);
        MHD_resume_connection(work->handle);
        return true;
    }

    std::optional<HttpAnswer> authenticate(Work& work) {
        Connection& connection = *work.connection;
        const std::string authorization = headerOf(work.http, "Authorization").value_or("");
        if (connection.kind == Listener::Kind::Unix) {
            if (!connection.caller) connection.caller = connection.peer ? rightsOf(*connection.peer) : Caller();
            work.caller = *connection.caller;
            work.caller.mayRead = work.caller.mayRead || settings.anonymousRead;
        } else if (connection.caller && authorization == connection.authorization) {
            work.caller = *connection.caller;
        } else if (authorization.empty()) {
            work.caller.mayRead = mayBeAnonymous(connection);
        } else {
            const auto credentials = basicCredentials(authorization);
            if (!credentials) return challenge("credentials that cannot be read");
            work.caller.user = credentials->first;
            if (authenticating.fetch_add(1) >= mostAuthentications) {
                authenticating.fetch_sub(1);
                return plainAnswer(503, "too many authentications");
            }
            const bool authentic = isAuthentic(credentials->first, credentials->second);
            authenticating.fetch_sub(1);
            if (!authentic) return challenge("authentication failed");
            work.caller = rightsOf(credentials->first);
            work.caller.user = credentials->first;
            connection.caller = work.caller;
            connection.authorization = authorization;
        }
        work.caller.address = connection.address;
        return std::nullopt;
    }

    MHD_Result send(Work& work) {
        HttpAnswer& made = work.answer;
        // It lies in the work, which MHD keeps until the request is completed.
        MHD_Response* response =
            MHD_create_response_from_buffer(made.body.size(), made.body.data(), MHD_RESPMEM_PERSISTENT);
        for (const auto& [name, value] : made.headers) MHD_add_response_header(response, name.c_str(), value.c_str());
        // After a refusal nobody knows where the next request begins.
        if (made.status != 200 && made.status != 401) MHD_add_response_header(response, "Connection", "close");
        const MHD_Result queued = MHD_queue_response(work.handle, made.status, response);
        MHD_destroy_response(response);
        return queued;
    }

    static void completed(void* target, MHD_Connection*, void** context, MHD_RequestTerminationCode) {
        if (*context == nullptr) return;
        const std::unique_ptr<WorkPointer> work(static_cast<WorkPointer*>(*context));
        *context = nullptr;
        if (!(*work)->isFinished()) (*work)->finish(plainAnswer(400, "the request did not arrive"));
        log(requestLine(**work));
        Impl& self = *static_cast<Entry*>(target)->server;
        const std::lock_guard lock(self.mutex);
        (*work)->connection->receiving = true;
        (*work)->connection->since = self.lastUse = Clock::now();
    }

    void endSlowSenders(Clock::time_point now) {
        for (const auto& connection : connections) {
            if (connection->receiving && now - connection->since > settings.limits.arrival) {
                shutdown(connection->socket, SHUT_RDWR);
            }
        }
    }

    void answerForHanging(Clock::time_point now) {
        for (const WorkPointer& work : std::set<WorkPointer>(working)) {
            if (now - work->started <= settings.limits.answer) continue;
            const std::string doing = work->noted();
            work->replaced = !doing.empty() && workers.replace();
            log("no answer in time: " + (doing.empty() ? "all threads were busy" : doing) +
                (work->replaced || doing.empty() ? "" : "; no other thread takes its place"));
            finish(work, plainAnswer(503, "no answer in time"));
        }
    }

    Operations& operations;
    ServerSettings settings;
    Workers workers;
    std::mutex mutex; // of what follows, and of connections' times
    std::set<std::shared_ptr<Connection>> connections;
    std::set<WorkPointer> working;
    Clock::time_point lastUse = Clock::now();
    std::atomic<std::size_t> authenticating{0};
    std::vector<std::unique_ptr<Entry>> entries;
    bool clean = true;
};

Server::Server(Operations& operations, ServerSettings settings)
    : impl(std::make_unique<Impl>(operations, std::move(settings))) {}

Server::~Server() = default;

void Server::serve(const Listener& listener) {
    impl->serve(listener);
}

void Server::run(const std::atomic<bool>& stop, std::chrono::seconds idle) {
    impl->run(stop, idle);
}

bool Server::shutDown() {
    return impl->shutDown();
}

} // namespace endpoint
