#include "load/Requests.h"

#include "objectmanager/vkcim/JsonOutput.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>

#include <unistd.h>

namespace load {
namespace {

namespace fs = std::filesystem;
using om::Operation;

constexpr const char* associationBases[] = {"CIM_SystemPackaging", "CIM_ElementCapabilities", "CIM_Dependency"};

std::string hostName() {
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    return name;
}

void addCommand(const fs::path& file, const std::string& script) {
    fs::create_directories(file.parent_path());
    std::ofstream(file) << "#!/bin/sh\n" << script << "\n";
    fs::permissions(file, fs::perms::owner_all);
}

/// Collects kinds of request.
class Collection {
public:
    explicit Collection(om::ObjectManager& theManager) : manager(theManager) {}

    std::vector<Kind> kinds;

    void add(Operation operation, const om::ObjectPath& path, const std::string& name, bool slow,
             const om::Request& more = {}) {
        om::Request request = more;
        request.operation = operation;
        request.path = path;
        kinds.push_back({request, name + " " + test::print(path), ask(manager, request), slow});
    }

    std::vector<om::ObjectPath> namesOf(const std::string& className) {
        om::Request request;
        request.path = test::path(className);
        return test::paths(manager.run(request));
    }

    void addReading(const std::string& className) {
        const bool slow = className == "VESKA_CIMServiceConfig"; // reads its settings with commands
        add(Operation::EnumInstanceNames, test::path(className), "names", false);
        add(Operation::EnumInstances, test::path(className), "instances", slow);
        add(Operation::GetInstance, test::path(className), "get", slow);
        for (const om::ObjectPath& path : namesOf(className)) add(Operation::GetInstance, path, "get", slow);
    }

    void addWalks(const om::ObjectPath& source, const std::string& associationClass) {
        om::Request more;
        more.assocClass = associationClass;
        add(Operation::AssociatorNames, source, "associator-names " + associationClass, false, more);
        add(Operation::Associators, source, "associators " + associationClass, false, more);
    }

    void addOthers(const om::ObjectPath& path) {
        add(Operation::CreateInstance, path, "create", false);
        add(Operation::DeleteInstance, path, "delete", false);
        add(Operation::ExecQuery, path, "query", false);
        add(Operation::References, path, "references", false);
        add(Operation::ReferenceNames, path, "reference-names", false);
    }

    void addMethod(const om::ObjectPath& path, const std::string& method, std::vector<om::NamedValue> in, bool slow) {
        om::Request more;
        more.method = method;
        more.values = std::move(in);
        add(Operation::InvokeMethod, path, "invoke " + method, slow, more);
    }

private:
    om::ObjectManager& manager;
};

void addTimeService(Collection& collection) {
    const om::ObjectPath service = test::path("VESKA_TimeService");
    om::Request flag;
    flag.values = {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}}; // as it is already, so that answers stay
    collection.add(Operation::ModifyInstance, service, "modify", true, flag);
    const om::NamedValue element = {
        "ManagedElement",
        {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("VESKA_ComputerSystem", {{"Name", "a"}}))}};
    const om::NamedValue time = {"TimeData", {CMPI_dateTime, std::string("20261121060000.000000+060")}};
    collection.addMethod(service, "ManageTime", {{"GetRequest", {CMPI_boolean, true}}, element}, false);
    collection.addMethod(service, "ManageTime", {{"GetRequest", {CMPI_boolean, false}}, element, time}, true);
    collection.addMethod(service, "ManageTime", {{"GetRequest", {CMPI_boolean, false}}, element}, false);
    collection.addMethod(service, "ManageTime", {}, false);
}

void addServiceConfig(Collection& collection) {
    const om::ObjectPath config = test::path("VESKA_CIMServiceConfig");
    const om::NamedValue seconds = {"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t(30)}};
    collection.addMethod(config, "SetCIMconfig", {seconds}, true);
    collection.addMethod(config, "SetCIMconfig", {}, false);
    collection.addMethod(config, "Unknown", {seconds}, false);
}

} // namespace

void makeHost(const std::string& sink) {
    const fs::path directory = test::processDirectory();
    addCommand(directory / "bin/ps", "");
    addCommand(directory / "bin/ntpd", "echo 'ntpd: time set +0.1s'");
    addCommand(directory / "vcm/bin/cimconfig", "[ \"$1\" = -s ] || echo 'Current value: 20'");
    const char* const path = std::getenv("PATH");
    setenv("PATH", ((directory / "bin").string() + ":" + (path != nullptr ? path : "/usr/bin:/bin")).c_str(), 1);
    setenv("NVLOG_SINK", sink.c_str(), 1);

    test::Node first = test::computer(0, hostName());
    first.properties[200] = 1;
    test::simulate({first, test::computer(1, "second"), test::chassis(0, 0, "CHASSIS-A"),
                    test::chassis(0, 1, "CHASSIS-B"), test::chassis(1, 0, "CHASSIS-C")});
    nlohmann::json host = test::simulatedFile();
    host["product"]["rootDirectory"] = (directory / "platform/").string();
    test::simulateText(host.dump());
}

std::string ask(om::ObjectManager& manager, const om::Request& request) {
    om::Answer answer = manager.run(request);
    for (auto& [name, value] : answer.out) {
        auto* const text = std::get_if<std::string>(&value.data);
        if (name != "TimeData" || value.type != CMPI_dateTime || text == nullptr) continue;
        if (text->size() == 25) *text = "now";
    }
    return vkcim::jsonText(answer, "root/cimv2", om::Schema::builtin());
}

std::vector<Kind> allKinds(om::ObjectManager& manager) {
    Collection collection(manager);
    std::vector<om::ObjectPath> ends;
    const std::vector<std::string> associations = om::Schema::builtin().servedAssociations();
    for (const std::string& className : om::Schema::builtin().servedClasses()) {
        collection.addReading(className);
        for (const om::ObjectPath& path : collection.namesOf(className)) ends.push_back(path);
        ends.push_back(test::path(className));
    }
    for (const std::string& className : associations) collection.addReading(className);
    ends.push_back(test::path("VESKA_ComputerSystem", {{"Name", "nobody"}}));
    for (const om::ObjectPath& end : ends) {
        for (const std::string& className : associations) collection.addWalks(end, className);
        for (const char* className : associationBases) collection.addWalks(end, className);
        collection.addOthers(end);
    }
    collection.addReading("VESKA_Unknown");
    addTimeService(collection);
    addServiceConfig(collection);
    for (const Kind& kind : collection.kinds)
        if (ask(manager, kind.request) != kind.answer)
            throw std::runtime_error(kind.name + " answered differently the second time");
    return collection.kinds;
}

Picker::Picker(const std::vector<Kind>& kinds, unsigned seed) : random(seed) {
    for (const Kind& kind : kinds) (kind.slow ? slow : quick).push_back(&kind);
}

const Kind& Picker::next() {
    const auto& some = random() % 50 == 0 ? slow : quick;
    return *some[random() % some.size()];
}

} // namespace load
