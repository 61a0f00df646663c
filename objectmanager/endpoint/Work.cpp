#include "objectmanager/endpoint/Work.h"

#include "objectmanager/endpoint/Log.h"

#include <array>

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

std::string Work::logLine() const {
    const auto elapsed = std::chrono::duration_cast<std::chrono::microseconds>(Clock::now() - started);
    std::string line = connection->address + ' ' + logged(caller.user) + ' ' + logged(answer.operation) + ' ' +
                       logged(answer.nameSpace) + ' ' + logged(answer.className) +
                       " http=" + std::to_string(answer.status) + " cim=" + std::to_string(answer.cimStatus) +
                       " us=" + std::to_string(elapsed.count());
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
