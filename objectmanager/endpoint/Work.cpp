#include "objectmanager/endpoint/Work.h"

#include "objectmanager/endpoint/Log.h"

#include <array>
#include <utility>

namespace endpoint {
namespace {

thread_local Work* current = nullptr;

/// In the order of om::Operation.
constexpr std::array<const char*, 12> operations = {
    "EnumInstanceNames", "EnumInstances", "GetInstance",     "CreateInstance", "ModifyInstance", "DeleteInstance",
    "ExecQuery",         "Associators",   "AssociatorNames", "References",     "ReferenceNames", "InvokeMethod"};

} // namespace

bool Work::finish(HttpAnswer given) {
    const std::lock_guard lock(mutex);
    if (finished) return false;
    finished = true;
    answer = std::move(given);
    return true;
}

bool Work::isFinished() const {
    const std::lock_guard lock(mutex);
    return finished;
}

bool Work::start(std::string text) {
    const std::lock_guard lock(mutex);
    if (!finished) doing = std::move(text);
    return !finished;
}

void Work::know(const Caller& who) {
    const std::lock_guard lock(mutex);
    if (!finished) caller = who;
}

bool Work::ask(const HttpAnswer& what) {
    const std::lock_guard lock(mutex);
    if (!finished) asked = what;
    return !finished;
}

HttpAnswer Work::question() const {
    const std::lock_guard lock(mutex);
    return asked;
}

void Work::note(std::string text) {
    const std::lock_guard lock(mutex);
    doing = std::move(text);
}

std::string Work::noted() const {
    const std::lock_guard lock(mutex);
    return doing;
}

bool Work::receive(std::string_view piece, std::size_t longest) {
    received += piece.size();
    if (received <= longest) {
        http.body.append(piece);
        return true;
    }
    tooLarge = true;
    http.body = std::string();
    return received <= longest * 8;
}

std::size_t Work::take(char* to, std::size_t room) {
    if (sent == answer.body.size()) {
        answer.body.clear();
        sent = 0;
        cimxml::Writer writer(std::move(answer.body));
        answer.rest.writeTo(writer, room);
        answer.body = writer.take();
    }
    const std::size_t taken = answer.body.copy(to, room, sent);
    sent += taken;
    return taken;
}

void Work::breakOff(std::string_view reason) {
    if (std::exchange(broken, true)) return;
    if (!answer.detail.empty()) answer.detail += "; ";
    answer.detail += reason;
}

std::string Work::logLine() const {
    const auto elapsed = std::chrono::duration_cast<std::chrono::microseconds>(Clock::now() - started);
    std::string line;
    line.reserve(200); // of nearly all of them
    line += connection->address;
    for (const std::string* word : {&caller.user, &answer.operation, &answer.nameSpace, &answer.className}) {
        line += ' ';
        line += logged(*word);
    }
    line += " http=" + std::to_string(answer.status);
    line += " cim=" + std::to_string(answer.cimStatus);
    line += " us=" + std::to_string(elapsed.count());
    if (!answer.detail.empty()) line += ": " + detailed(answer.detail);
    return line;
}

HttpAnswer plainAnswer(unsigned status, std::string detail) {
    HttpAnswer answer;
    answer.status = status;
    answer.detail = std::move(detail);
    return answer;
}

Ask noting(Ask provider) {
    return [asked = std::move(provider)](const om::Request& request) {
        if (current != nullptr) {
            current->note(std::string(operations[static_cast<std::size_t>(request.operation)]) + " of " +
                          logged(request.path.className));
        }
        return asked(request);
    };
}

CurrentWork::CurrentWork(Work& work) {
    current = &work;
}

CurrentWork::~CurrentWork() {
    current = nullptr;
}

} // namespace endpoint
