// An answer as any server may send it to vkcim: whatever it holds, it is refused, or printed as JSON that can be read.
#include "fuzz/Expect.h"
#include "objectmanager/model/Schema.h"
#include "objectmanager/vkcim/JsonOutput.h"
#include "objectmanager/vkcim/RemoteMessages.h"
#include "objectmanager/vkcim/TextOutput.h"

#include <nlohmann/json.hpp>

#include <cstdint>
#include <stdexcept>

namespace {

const std::string nameSpace = "root/cimv2";

void tryAnswer(std::string_view body, om::Operation operation) {
    const om::Schema& schema = om::Schema::builtin();
    om::Request request;
    request.operation = operation;
    request.path.nameSpace = nameSpace;
    request.path.className = "VESKA_ComputerSystem";
    om::Answer answer;
    try {
        answer = vkcim::remoteAnswer(body, request, schema);
    } catch (const std::runtime_error&) {
        return;
    }
    const nlohmann::json json = nlohmann::json::parse(vkcim::jsonText(answer, nameSpace, schema));
    fuzz::expect(json["results"].size() == answer.results.size(), "a result was lost");
    vkcim::plainAnswer(answer, {nameSpace, schema});
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view body(reinterpret_cast<const char*>(data), size);
    tryAnswer(body, om::Operation::EnumInstances);
    tryAnswer(body, om::Operation::InvokeMethod);
    return 0;
}
