#include "objectmanager/endpoint/Work.h"

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

Ask noting(Ask provider) {
    return [asked = std::move(provider)](const om::Request& request) {
        if (current != nullptr) {
            current->note(std::string(operations[static_cast<std::size_t>(request.operation)]) + " of " +
                          request.path.className);
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
