// A body as clients send it: whatever it holds, it is refused or answered with a document that can be read.
#include "fuzz/Expect.h"
#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/endpoint/Interop.h"
#include "objectmanager/endpoint/Operations.h"

#include <cstdint>

namespace {

/// Values of every type of the schema for what is asked, and back what a client sent.
om::Answer provide(const om::Request& request) {
    om::Answer answer;
    using om::Operation;
    switch (request.operation) {
    case Operation::EnumInstanceNames:
    case Operation::AssociatorNames:
    case Operation::CreateInstance:
        answer.results.emplace_back(request.path);
        break;
    case Operation::EnumInstances:
    case Operation::GetInstance:
    case Operation::Associators:
        answer.results.emplace_back(om::Instance{request.path, request.path.keys});
        break;
    case Operation::InvokeMethod:
        answer.returnValue = om::Value{CMPI_uint32, std::uint64_t{0}};
        answer.out = request.values;
        break;
    default:
        answer.code = CMPI_RC_ERR_NOT_SUPPORTED;
        answer.message = request.path.className;
    }
    return answer;
}

endpoint::Operations& operations() {
    static endpoint::Operations made(
        {{"root/cimv2", {}, &om::Schema::builtin(), provide}, endpoint::interopNameSpace({"root/cimv2"}, "host1")},
        "host1");
    return made;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view body(reinterpret_cast<const char*>(data), size);
    cimxml::Request request;
    try {
        request = cimxml::readRequest(body);
    } catch (const cimxml::Refusal& refusal) {
        fuzz::expect(refusal.status == 400 || refusal.status == 501, "a refusal is 400 or 501");
        return 0;
    }
    const endpoint::Outcome outcome = operations().answer(request, {"root", "", true, true});
    pugi::xml_document document;
    try {
        cimxml::load(document, outcome.message);
    } catch (const cimxml::Refusal& refusal) {
        // Paths and embedded instances are at most as deep as the request's, and an answer wraps them.
        fuzz::expect(std::string_view(refusal.what()) == "elements are nested too deeply", refusal.what());
    }
    return 0;
}
