#include "objectmanager/endpoint/Daemon.h"

#include "objectmanager/endpoint/Log.h"
#include "objectmanager/endpoint/Rights.h"
#include "objectmanager/model/Names.h"

#include <microhttpd.h>

#include <charconv>
#include <stdexcept>
#include <vector>

namespace endpoint {
namespace {

constexpr const char* tlsPriorities = "NORMAL:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2";
constexpr std::size_t usualHeaders = 16;
constexpr unsigned spareConnections = 8; ///< that are open while they are refused

MHD_Result collectHeader(void* target, MHD_ValueKind, const char* key, const char* value) {
    static_cast<Headers*>(target)->emplace_back(key, value != nullptr ? value : "");
    return MHD_YES;
}

ConnectionPointer connectionOf(MHD_Connection* handle) {
    const MHD_ConnectionInfo* info = MHD_get_connection_info(handle, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
    return *static_cast<ConnectionPointer*>(info->socket_context);
}

/// A connection of which is known what the socket says.
ConnectionPointer connectionAt(Listener::Kind kind, MHD_Connection* handle) {
    auto connection = std::make_shared<Connection>();
    connection->kind = kind;
    connection->socket = MHD_get_connection_info(handle, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
    if (kind == Listener::Kind::Unix) {
        connection->peer = peerOf(connection->socket);
        connection->address = "unix:" + (connection->peer ? std::to_string(*connection->peer) : "?");
        connection->network = connection->address;
    } else {
        const sockaddr* address = MHD_get_connection_info(handle, MHD_CONNECTION_INFO_CLIENT_ADDRESS)->client_addr;
        connection->address = addressText(address);
        connection->network = networkText(address);
    }
    return connection;
}

/// Blanks behind a header's value are none of it, but libmicrohttpd leaves them there.
void dropBlanksBehind(Headers& headers) {
    for (auto& [name, value] : headers) value.erase(value.find_last_not_of(" \t") + 1);
}

bool isPosted(const HttpRequest& request) {
    return request.method == "POST" || request.method == "M-POST";
}

/// What is wrong with the length that a head announces.
std::optional<HttpAnswer> refuseLength(const HttpRequest& request, std::size_t longest) {
    const std::optional<std::string> announced = headerOf(request, "Content-Length");
    const std::string length = announced.value_or("0");
    std::size_t bytes = 0;
    const auto [end, error] = std::from_chars(length.data(), length.data() + length.size(), bytes);
    if (error == std::errc::result_out_of_range || bytes > longest) return plainAnswer(413, "the body is too large");
    if (error != std::errc() || end != length.data() + length.size()) return plainAnswer(400, "Content-Length");
    const std::optional<std::string> encoding = headerOf(request, "Transfer-Encoding");
    const bool chunked = encoding.has_value();
    if (chunked && !om::sameName(*encoding, "chunked")) return plainAnswer(501, "Transfer-Encoding " + *encoding);
    if (isPosted(request) && !chunked && !announced) return plainAnswer(411, "no Content-Length");
    if (chunked && announced) return plainAnswer(400, "two lengths");
    if (chunked && request.version == "HTTP/1.0") return plainAnswer(400, "chunks of HTTP/1.0");
    return std::nullopt;
}

/// A piece of an answer, for a connection that has room for it.
ssize_t takePiece(void* target, std::uint64_t, char* to, std::size_t room) {
    Work& work = *static_cast<Work*>(target);
    try {
        const std::size_t taken = work.take(to, room);
        return taken > 0 ? static_cast<ssize_t>(taken) : MHD_CONTENT_READER_END_OF_STREAM;
    } catch (const std::exception& error) {
        work.breakOff(std::string("the answer cannot be written: ") + error.what());
        return MHD_CONTENT_READER_END_WITH_ERROR;
    }
}

/// What the answer holds lies in the work, which MHD keeps until the request is completed.
MHD_Response* responseOf(Work& work, std::size_t piece) {
    std::string& body = work.answer.body;
    if (!work.answer.rest.isEmpty()) {
        return MHD_create_response_from_callback(MHD_SIZE_UNKNOWN, piece, &takePiece, &work, nullptr);
    }
    return MHD_create_response_from_buffer(body.size(), body.data(), MHD_RESPMEM_PERSISTENT);
}

MHD_Result send(Work& work, const Limits& limits) {
    const HttpAnswer& made = work.answer;
    MHD_Response* response = responseOf(work, limits.piece);
    for (const auto& [name, value] : made.headers) MHD_add_response_header(response, name.c_str(), value.c_str());
    // After a refusal nobody knows where the next request begins.
    if (made.status != 200 && made.status != 401) MHD_add_response_header(response, "Connection", "close");
    const MHD_Result queued = MHD_queue_response(work.handle, made.status, response);
    MHD_destroy_response(response);
    return queued;
}

} // namespace

/// What libmicrohttpd calls, in the daemon's thread.
class Daemon::Callbacks {
public:
    static void connectionChanged(void* target, MHD_Connection* handle, void** context,
                                  MHD_ConnectionNotificationCode code) {
        Daemon& daemon = *static_cast<Daemon*>(target);
        if (code == MHD_CONNECTION_NOTIFY_STARTED) {
            ConnectionPointer connection = connectionAt(daemon.listener.kind, handle);
            daemon.parts.connections.open(connection);
            *context = new ConnectionPointer(std::move(connection));
        } else {
            const std::unique_ptr<ConnectionPointer> connection(static_cast<ConnectionPointer*>(*context));
            daemon.parts.connections.close(*connection);
            *context = nullptr;
        }
    }

    static MHD_Result access(void* target, MHD_Connection* handle, const char* url, const char* method,
                             const char* version, const char* data, std::size_t* size, void** context) {
        Parts& parts = static_cast<Daemon*>(target)->parts;
        if (*context == nullptr) return begin(parts, handle, {method, version, url, {}, {}}, context);
        const WorkPointer& work = *static_cast<WorkPointer*>(*context);
        if (*size > 0) {
            const bool goesOn = work->receive({data, *size}, parts.limits.body);
            *size = 0;
            return goesOn ? MHD_YES : MHD_NO;
        }
        if (!work->isFinished() && work->tooLarge) work->finish(plainAnswer(413, "the body is too large"));
        if (work->isFinished()) {
            parts.connections.enter(*work->connection, Connection::Phase::Sending);
            return send(*work, parts.limits);
        }
        parts.connections.enter(*work->connection, Connection::Phase::Working);
        parts.processing.begin(work);
        return MHD_YES;
    }

    static void completed(void* target, MHD_Connection*, void** context, MHD_RequestTerminationCode ending) {
        if (*context == nullptr) return;
        const std::unique_ptr<WorkPointer> work(static_cast<WorkPointer*>(*context));
        *context = nullptr;
        if (!(*work)->isFinished()) {
            (*work)->finish(plainAnswer(400, "the request did not arrive"));
        } else if (ending != MHD_REQUEST_TERMINATED_COMPLETED_OK) {
            (*work)->breakOff("the client did not take the answer");
        }
        log((*work)->logLine());
        static_cast<Daemon*>(target)->parts.connections.enter(*(*work)->connection, Connection::Phase::Receiving);
    }

private:
    /// What can be said once the head is there.
    static MHD_Result begin(const Parts& parts, MHD_Connection* handle, HttpRequest request, void** context) {
        auto work = std::make_shared<Work>();
        work->handle = handle;
        work->connection = connectionOf(handle);
        if (work->connection->refused) return MHD_NO; // what came before it was ended can still be read
        work->http = std::move(request);
        work->http.headers.reserve(usualHeaders);
        MHD_get_connection_values(handle, MHD_HEADER_KIND, &collectHeader, &work->http.headers);
        // Before the blanks go: libmicrohttpd knows no transfer encoding with them, and would wait for other bytes than
        // we.
        auto refusal = refuseLength(work->http, parts.limits.body);
        dropBlanksBehind(work->http.headers);
        // With another method nobody gets on, whoever it is.
        if (!refusal && !isPosted(work->http)) refusal = endpoint::refuseHead(work->http);
        if (!refusal) refusal = parts.authentication.refuseHead(*work);
        if (!refusal) refusal = endpoint::refuseHead(work->http);
        if (refusal) {
            work->caller.user = claimedUser(*work);
            work->finish(std::move(*refusal));
        }
        *context = new WorkPointer(work);
        return work->isFinished() ? send(*work, parts.limits) : MHD_YES;
    }
};

Daemon::Daemon(Listener given, Parts& shared) : listener(std::move(given)), parts(shared) {
    const Limits& limits = parts.limits;
    std::vector<MHD_OptionItem> options = {
        {MHD_OPTION_LISTEN_SOCKET, listener.socket, nullptr},
        {MHD_OPTION_CONNECTION_LIMIT, static_cast<intptr_t>(limits.connections + spareConnections), nullptr},
        // What MHD itself puts into an answer takes room there, too.
        {MHD_OPTION_CONNECTION_MEMORY_LIMIT, static_cast<intptr_t>(limits.head + 2048), nullptr},
        {MHD_OPTION_NOTIFY_COMPLETED, reinterpret_cast<intptr_t>(&Callbacks::completed), this},
        {MHD_OPTION_NOTIFY_CONNECTION, reinterpret_cast<intptr_t>(&Callbacks::connectionChanged), this},
    };
    // Not MHD_USE_EPOLL: of a client that sends less than it announced and goes away, only poll says that it has gone.
    unsigned flags = MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_POLL | MHD_ALLOW_SUSPEND_RESUME;
    if (listener.kind == Listener::Kind::Https) {
        if (!parts.certificate) throw std::invalid_argument(listener.url + " takes a certificate and a key");
        flags |= MHD_USE_TLS;
        options.push_back({MHD_OPTION_HTTPS_CERT_CALLBACK2, 0, Certificate::retriever()});
        options.push_back({MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(tlsPriorities)});
    }
    options.push_back({MHD_OPTION_END, 0, nullptr});
    handle = MHD_start_daemon(flags, 0, nullptr, nullptr, &Callbacks::access, this, MHD_OPTION_ARRAY, options.data(),
                              MHD_OPTION_END);
    if (handle == nullptr) throw std::runtime_error("cannot serve " + listener.url);
}

Daemon::~Daemon() {
    MHD_stop_daemon(handle);
}

} // namespace endpoint
