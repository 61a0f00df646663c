// Whole requests: the provider's library, loaded by the embedded object manager, on a simulated host. The bytes choose
// the host and the request. No command is started, whatever is asked (NoCommands).
#include "fuzz/RandomHost.h"
#include "fuzz/RandomRequest.h"
#include "objectmanager/broker/Describe.h"
#include "support/NoCommands.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>

#include <strings.h>
#include <unistd.h>

namespace {

using om::Operation;

std::string treeFile;

void expect(bool holds, const std::string& what) {
    if (holds) return;
    std::fprintf(stderr, "%s\n", what.c_str());
    std::abort();
}

om::ObjectManager& provider() {
    static om::ObjectManager manager(VK_PROVIDER_LIBRARY, "BaseServerProvider", "root/cimv2");
    return manager;
}

std::string hostName() {
    char name[128] = {};
    gethostname(name, sizeof name - 1);
    return name;
}

void simulate(const std::string& json) {
    const std::string temporary = treeFile + ".new";
    std::ofstream(temporary, std::ios::binary) << json;
    std::rename(temporary.c_str(), treeFile.c_str());
}

bool isOneOf(CMPIrc code, std::initializer_list<CMPIrc> codes) {
    return std::find(codes.begin(), codes.end(), code) != codes.end();
}

void checkMethod(const om::Request& request, const om::Answer& answer) {
    expect(isOneOf(answer.code, {CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_INVALID_PARAMETER,
                                 CMPI_RC_ERR_INVALID_CLASS, CMPI_RC_ERR_METHOD_NOT_FOUND}),
           "a method answered a status that it does not have");
    if (request.fault) return;
    expect(answer.done && answer.returnValue && answer.returnValue->type == CMPI_uint32, "a method returned no code");
    const auto code = std::get<std::uint64_t>(answer.returnValue->data);
    expect(code == static_cast<std::uint64_t>(answer.code) || (answer.message && code == 0),
           "a method's code is not its status");
}

void checkStatus(const om::Request& request, const om::Answer& answer) {
    switch (request.operation) {
    case Operation::InvokeMethod:
        return checkMethod(request, answer);
    case Operation::CreateInstance:
    case Operation::DeleteInstance:
    case Operation::ExecQuery:
    case Operation::References:
    case Operation::ReferenceNames:
        return expect(answer.code == CMPI_RC_ERR_NOT_SUPPORTED && answer.results.empty(), "it is not supported");
    case Operation::ModifyInstance:
        return expect(isOneOf(answer.code, {CMPI_RC_OK, CMPI_RC_ERR_NOT_SUPPORTED}), "modify answered another status");
    default:
        return expect(isOneOf(answer.code, {CMPI_RC_OK, CMPI_RC_ERR_INVALID_CLASS}), "reading answered another status");
    }
}

const om::ObjectPath& pathOf(const std::variant<om::ObjectPath, om::Instance>& result) {
    const auto* instance = std::get_if<om::Instance>(&result);
    return instance != nullptr ? instance->path : std::get<om::ObjectPath>(result);
}

const om::Value* keyOf(const om::ObjectPath& path, const char* name) {
    const auto found =
        std::find_if(path.keys.begin(), path.keys.end(), [&](const auto& key) { return key.first == name; });
    return found != path.keys.end() ? &found->second : nullptr;
}

/// The node that an end of an association names by this key; `all.end()` when there is none, or several.
fuzz::Identities::const_iterator theOnly(const fuzz::Identities& all, const om::ObjectPath& end, const char* key) {
    const om::Value* const value = keyOf(end, key);
    const auto* const text = value != nullptr ? std::get_if<std::string>(&value->data) : nullptr;
    if (text == nullptr) return all.end();
    const auto found = std::find(all.begin(), all.end(), *text);
    return found == all.end() || std::find(found + 1, all.end(), *text) == all.end() ? found : all.end();
}

/// Whether an end of an association names one element that can be found from it. The search for a chassis ends at the
/// first one without a serial number, on purpose: those behind it cannot be found.
bool endCanBeFound(const om::ObjectPath& end, const fuzz::RandomHost& host) {
    if (end.className == "VESKA_ComputerSystem") return theOnly(host.computers, end, "Name") != host.computers.end();
    if (end.className != "VESKA_PhysicalPackage") return true;
    const auto found = theOnly(host.chassis, end, "Tag");
    return found != host.chassis.end() && std::find(host.chassis.begin(), found, std::nullopt) == found;
}

/// Whether the path names one element: that of a computer without a name or a chassis without a tag does not, nor that
/// of an association with an end that cannot be found. GetInstance does not serve the time service's, on purpose.
bool canBeGot(const om::ObjectPath& path, const fuzz::RandomHost& host) {
    if (path.className == "VESKA_TimeServiceAffectsElement") return false;
    if (path.className == "VESKA_ComputerSystem") return keyOf(path, "Name") != nullptr;
    if (path.className == "VESKA_PhysicalPackage") return keyOf(path, "Tag") != nullptr;
    return std::all_of(path.keys.begin(), path.keys.end(), [&](const auto& key) {
        const auto* const end = std::get_if<std::shared_ptr<const om::ObjectPath>>(&key.second.data);
        return end == nullptr || endCanBeFound(**end, host);
    });
}

void checkThatItCanBeGot(const om::ObjectPath& path, const fuzz::RandomHost& host) {
    om::Request request;
    request.operation = Operation::GetInstance;
    request.path = path;
    const om::Answer answer = provider().run(request);
    const auto found = [&] { return om::describe(path) + " on " + host.json; };
    expect(answer.code == CMPI_RC_OK, "a path that was returned is not known: " + found());
    expect(std::any_of(answer.results.begin(), answer.results.end(),
                       [&](const auto& result) { return pathOf(result) == path; }),
           "a path that was returned cannot be got: " + found());
}

void checkThatAllCanBeGot(const om::Answer& answer, const fuzz::RandomHost& host) {
    for (const auto& result : answer.results)
        if (canBeGot(pathOf(result), host)) checkThatItCanBeGot(pathOf(result), host);
}

/// Few requests are for associations, for which the shape of the host matters most: every host is asked for its own.
void checkAssociations(const fuzz::RandomHost& host) {
    for (const char* className : {"VESKA_ComputerCapabilities", "VESKA_ComputerSystemPackage"}) {
        om::Request request;
        request.operation = Operation::EnumInstanceNames;
        request.path.nameSpace = "root/cimv2";
        request.path.className = className;
        checkThatAllCanBeGot(provider().run(request), host);
    }
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    treeFile = "/tmp/fuzz-request-" + std::to_string(getpid()) + ".json";
    setenv("VK_INSTRUMENTATION_TREE", treeFile.c_str(), 1);
    setenv("NVLOG_SINK", "none", 1);
    std::atexit([] { std::remove(treeFile.c_str()); });
    provider();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    static const std::string thisHost = hostName();
    fuzz::Choices choices(data, size);
    const fuzz::RandomHost host = fuzz::randomHost(choices, thisHost);
    const om::Request request = fuzz::randomRequest(choices, thisHost);
    simulate(host.json);
    const om::Answer answer = provider().run(request);
    checkStatus(request, answer);
    test::takeCommands();
    if (request.fault) return 0;
    checkThatAllCanBeGot(answer, host);
    checkAssociations(host);
    test::takeCommands();
    return 0;
}
