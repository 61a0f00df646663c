#include "bench/endpoint/Servers.h"

#include "objectmanager/endpoint/Workers.h"

#include <microhttpd.h>
#include <netinet/in.h>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <optional>
#include <stdexcept>
#include <system_error>
#include <thread>
#include <utility>

namespace bench {
namespace {

constexpr std::size_t largest = std::size_t{16} << 20U;

[[noreturn]] void fail(const char* what) {
    throw std::system_error(errno, std::generic_category(), what);
}

/// What a request has gone through.
struct Progress {
    bool handed = false;
};

class Answers {
public:
    explicit Answers(bool worker) {
        if (worker) workers.emplace(threads, queue, threads);
    }

    MHD_Result answer(MHD_Connection* connection, const char* url, std::size_t* size, Progress& progress) {
        if (*size > 0) {
            *size = 0;
            return MHD_YES;
        }
        if (workers && !progress.handed) {
            progress.handed = true;
            MHD_suspend_connection(connection);
            workers->post([connection] { MHD_resume_connection(connection); });
            return MHD_YES;
        }
        MHD_Response* response =
            MHD_create_response_from_buffer(std::stoul(url + 1), content.data(), MHD_RESPMEM_PERSISTENT);
        MHD_add_response_header(response, "Content-Type", "application/xml; charset=\"utf-8\"");
        MHD_add_response_header(response, "CIMOperation", "MethodResponse");
        MHD_add_response_header(response, "Cache-Control", "no-cache");
        const MHD_Result queued = MHD_queue_response(connection, MHD_HTTP_OK, response);
        MHD_destroy_response(response);
        return queued;
    }

private:
    static constexpr std::size_t threads = 8; // as many as vkcimd has
    static constexpr std::size_t queue = 64;

    std::string content = std::string(largest, 'x');
    std::optional<endpoint::Workers> workers;
};

MHD_Result access(void* target, MHD_Connection* connection, const char* url, const char*, const char*, const char*,
                  std::size_t* size, void** context) {
    if (*context == nullptr) {
        *context = new Progress;
        return MHD_YES;
    }
    return static_cast<Answers*>(target)->answer(connection, url, size, *static_cast<Progress*>(*context));
}

void completed(void*, MHD_Connection*, void** context, MHD_RequestTerminationCode) {
    delete static_cast<Progress*>(*context);
    *context = nullptr;
}

/// The set-up of objectmanager/endpoint/Daemon.cpp.
void serveConstant(int socket, bool worker) {
    static Answers answers(worker);
    MHD_Daemon* const daemon =
        MHD_start_daemon(MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_POLL | MHD_ALLOW_SUSPEND_RESUME, 0, nullptr, nullptr,
                         &access, &answers, MHD_OPTION_LISTEN_SOCKET, socket, MHD_OPTION_CONNECTION_LIMIT, 72U,
                         MHD_OPTION_CONNECTION_MEMORY_LIMIT, std::size_t{18432}, MHD_OPTION_NOTIFY_COMPLETED,
                         &completed, nullptr, MHD_OPTION_END);
    if (daemon == nullptr) _exit(1);
    for (;;) pause();
}

pid_t forked() {
    const pid_t child = fork();
    if (child < 0) fail("fork");
    if (child == 0) prctl(PR_SET_PDEATHSIG, SIGKILL);
    return child;
}

} // namespace

ServerProcess::~ServerProcess() {
    end();
}

bool ServerProcess::end() {
    if (process <= 0) return false;
    constexpr int patience = 300; // tenths of a second
    int status = -1;
    kill(process, SIGTERM);
    for (int i = 0; i < patience && isRunning(status); ++i) std::this_thread::sleep_for(std::chrono::milliseconds(100));
    if (process > 0) {
        kill(process, SIGKILL);
        waitpid(std::exchange(process, -1), &status, 0);
    }
    return WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

bool ServerProcess::isRunning(int& status) {
    if (process > 0 && waitpid(process, &status, WNOHANG) != 0) process = -1;
    return process > 0;
}

std::size_t ServerProcess::residentMemory() const {
    std::ifstream status("/proc/" + std::to_string(process) + "/status");
    for (std::string word; status >> word;) {
        std::size_t size = 0;
        if (word == "VmRSS:" && status >> size) return size;
    }
    throw std::runtime_error("the server has gone");
}

std::size_t ServerProcess::descriptors() const {
    using Directory = std::filesystem::directory_iterator;
    return static_cast<std::size_t>(std::distance(Directory("/proc/" + std::to_string(process) + "/fd"), Directory()));
}

double ServerProcess::processorTime() const {
    clockid_t clock = 0;
    timespec used{};
    if (clock_getcpuclockid(process, &clock) != 0 || clock_gettime(clock, &used) != 0) fail("processor time");
    return static_cast<double>(used.tv_sec) * 1e6 + static_cast<double>(used.tv_nsec) / 1e3;
}

// Its lines go to a file that nobody reads, but for the first: a pipe would have to be emptied by us.
Endpoint::Endpoint(const std::string& program) : log(std::tmpfile()) {
    if (log == nullptr) fail("tmpfile");
    process = forked();
    if (process == 0) {
        dup2(fileno(log), STDERR_FILENO);
        setenv("NVLOG_SINK", "none", 1);
        execl(program.c_str(), program.c_str(), "--foreground", "--config", "/dev/null", "--anonymous-read", "--listen",
              "http://127.0.0.1:0", nullptr);
        _exit(127);
    }
    int status = 0;
    while (listening == 0 && isRunning(status)) {
        char line[200] = "";
        if (pread(fileno(log), line, sizeof line - 1, 0) < 0) fail("pread");
        const std::string text = line;
        const std::size_t end = text.find('\n');
        if (end != std::string::npos) listening = std::stoi(text.substr(text.rfind(':', end) + 1));
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    if (listening != 0) return;
    const std::string said = lastWords();
    std::fclose(log);
    throw std::runtime_error(program + " does not start: " + said);
}

Endpoint::~Endpoint() {
    end();
    std::fclose(log);
}

std::string Endpoint::lastWords() const {
    constexpr long most = 20000;
    std::string words(most, '\0');
    std::fseek(log, 0, SEEK_END);
    std::fseek(log, std::max(0L, std::ftell(log) - most), SEEK_SET);
    words.resize(std::fread(words.data(), 1, words.size(), log));
    return words;
}

Constant::Constant(bool worker) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    const int opened = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (bind(opened, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 || listen(opened, 128) != 0 ||
        getsockname(opened, reinterpret_cast<sockaddr*>(&address), &length) != 0) {
        fail("listen");
    }
    listening = ntohs(address.sin_port);
    process = forked();
    if (process == 0) serveConstant(opened, worker);
    close(opened);
}

} // namespace bench
