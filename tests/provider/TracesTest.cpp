// Every line that a request hands to the logger, compared with what stands in the directory `traces`. A change in it is
// a change that administrators see; GoldenFile.h says how the files are written.
#include "provider/GoldenFile.h"
#include "provider/Sequence.h"
#include "support/HostName.h"
#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gtest/gtest.h>

#include <optional>
#include <regex>
#include <tuple>

namespace {

using om::Operation;
using test::asking;
using test::hostName;
using Lines = std::vector<std::string>;

/// A host that the traces are of. Its first computer is named like this host, so that it has the time service.
struct TracedHost {
    const char* name;
    const char* directory;
    std::vector<test::Node> (*nodes)();
};

const TracedHost tracedHosts[] = {
    {"OneComputer", "",
     [] {
         return std::vector{test::computer(0, hostName()), test::chassis(0, 0, "CZ1")};
     }},
    {"TwoComputers", "/two-computers-three-chassis",
     [] {
         return std::vector{test::computer(0, hostName()), test::computer(1, "node8"), test::chassis(0, 0, "CZ1"),
                            test::chassis(0, 1, "CZ2"), test::chassis(1, 0, "CZ3")};
     }},
};

void simulateHost(const TracedHost& host) {
    test::simulate(
        host.nodes(),
        {{"architecture", "x86_64"}, {"uid", "uid-1"}, {"rootDirectory", "/opt/vk/platform/"}, {"kvm", false}});
}

/// The host's own name, as a whole value.
std::string withoutHostName(const std::string& line) {
    const std::string name = hostName();
    for (const char* before : {"@", "reference=", "has Value '"}) {
        const std::size_t at = line.find(before + name);
        const std::size_t end = at == std::string::npos ? at : at + std::string(before).size() + name.size();
        if (end != std::string::npos && (end == line.size() || line[end] == '\'' || line[end] == ' '))
            return line.substr(0, end - name.size()) + "HOST" + line.substr(end);
    }
    return line;
}

/// Events in an outline. What stands between the two lines of a function is indented, and its second line left out; a
/// line that a destructor or the like leaves ends in "()", one of a variable shows its value. Commands and what is
/// handed to the object manager as the answer stand between the lines as "Shell" and "Broker". All that is not exactly
/// of the usual form and level stands as it is.
class Outline {
public:
    void add(const std::string& event) {
        static const std::regex broker("4000 Broker ([^:]+): called");
        static const std::regex form("4000 ([^ ]+) ([^:]+): (ENTERING|EXITING|METHOD|VARIABLE): (.*)");
        std::smatch parts;
        if (std::regex_match(event, parts, broker)) return write("Broker " + parts.str(1));
        if (!std::regex_match(event, parts, form)) return write(event);
        const std::string place = parts.str(1) + " " + parts.str(2);
        const std::string call = parts.str(2) + "() ";
        const std::string word = parts[3];
        const std::string in = "in " + parts.str(1);
        std::optional<std::string> rest;
        if (word == "VARIABLE") {
            rest = between("'", parts[4], "' [Line] " + in);
            const std::size_t value = rest ? rest->find("' has Value '") : std::string::npos;
            if (value == std::string::npos) return write(event);
            return write(place + ": " + rest->substr(0, value) + " = " + rest->substr(value + 13));
        }
        if (word == "METHOD") {
            const bool usual = parts[4] == call + "was invoked " + in + " [Line]";
            return write(usual ? place + "()" : event);
        }
        rest = between(call + in + " [Line]", parts[4], "");
        const std::string list = rest ? between(",Parameters List:  ", *rest, "").value_or("") : "";
        if (!rest || (!rest->empty() && list.empty())) return write(event);
        const std::string scope = place + (list.empty() ? "" : ": " + list);
        if (word == "ENTERING") {
            write(scope);
            open.push_back(scope);
        } else if (!open.empty() && open.back() == scope) {
            open.pop_back();
        } else {
            write(event);
        }
    }

    Lines lines;

private:
    void write(const std::string& text) { lines.push_back(std::string(2 * open.size() + 2, ' ') + text); }

    static std::optional<std::string> between(const std::string& begin, const std::string& text,
                                              const std::string& end) {
        if (text.size() < begin.size() + end.size() || text.compare(0, begin.size(), begin) != 0 ||
            text.compare(text.size() - end.size(), end.size(), end) != 0)
            return std::nullopt;
        return text.substr(begin.size(), text.size() - begin.size() - end.size());
    }

    Lines open;
};

/// Of the calls to the object manager those alone whose name begins so: there are hundreds that make or read objects,
/// and the lines between them say which they are.
bool isOutlined(const std::string& event, const std::string& calls) {
    static const std::string broker = test::brokerCall("");
    const std::string head = broker.substr(0, broker.find(':'));
    return event.rfind(head, 0) != 0 || event.rfind(head + calls, 0) == 0;
}

void append(Lines& lines, const std::string& title, const om::Request& request, const std::string& calls = "return") {
    Outline outline;
    for (const std::string& event : test::sequence(request))
        if (isOutlined(event, calls)) outline.add(withoutHostName(event));
    lines.push_back(title);
    lines.insert(lines.end(), outline.lines.begin(), outline.lines.end());
}

om::ObjectPath firstOf(const std::string& className) {
    return test::paths(test::names(className)).at(0);
}

/// The classes at the ends of an association, the computer first; of another class none.
std::vector<std::string> endsOf(const std::string& className) {
    std::vector<std::string> ends;
    for (const om::PropertyDeclaration* key : om::Schema::builtin().resolve(className)->keys)
        if (key->type == CMPI_ref)
            ends.insert(key->referenceClass == "VESKA_ComputerSystem" ? ends.begin() : ends.end(), key->referenceClass);
    return ends;
}

const std::vector<om::NamedValue> settings = {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                                              {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{3}}}};

using Requests = std::vector<std::pair<std::string, om::Request>>;

/// The requests of one class, in order, each with its title.
Requests requestsOf(const std::string& className) {
    const om::ObjectPath all = test::path(className);
    Requests requests = {
        {"EnumInstanceNames", asking(Operation::EnumInstanceNames, all)},
        {"EnumInstances", asking(Operation::EnumInstances, all)},
    };
    if (!test::names(className).results.empty())
        requests.emplace_back("GetInstance", asking(Operation::GetInstance, firstOf(className)));
    for (const std::string& source : endsOf(className)) {
        om::Request request = asking(Operation::Associators, firstOf(source));
        request.assocClass = className;
        request.resultClass = "CIM_ManagedElement";
        request.operation = Operation::AssociatorNames;
        requests.emplace_back("AssociatorNames of " + source + ", with a class above", request);
        request.resultClass.reset();
        requests.emplace_back("AssociatorNames of " + source, request);
        request.operation = Operation::Associators;
        requests.emplace_back("Associators of " + source, request);
    }
    if (className == "VESKA_ComputerSystem")
        requests.emplace_back("AssociatorNames without an association class",
                              asking(Operation::AssociatorNames, firstOf(className)));
    if (className == "VESKA_TimeService") {
        om::Request modify = asking(Operation::ModifyInstance, firstOf(className));
        modify.values = {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}};
        requests.emplace_back("ModifyInstance", modify);
        om::Request manage = asking(Operation::InvokeMethod, firstOf(className));
        manage.method = "ManageTime";
        manage.values = {
            {"GetRequest", {CMPI_boolean, false}},
            {"ManagedElement", {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("VESKA_ComputerSystem"))}},
            {"TimeData", {CMPI_dateTime, std::string("20240101120000.000000+060")}}};
        requests.emplace_back("ManageTime", manage);
    }
    if (className == "VESKA_CIMServiceConfig") {
        requests.emplace_back("SetCIMconfig", test::calling(firstOf(className), "SetCIMconfig", settings));
    }
    return requests;
}

/// Requests that are not served, that end with an exception or that lose a part of the answer, and those whose keys and
/// lists of properties select nothing.
Requests otherRequests() {
    const om::ObjectPath computer = test::path("VESKA_ComputerSystem");
    const om::ObjectPath service = test::path("VESKA_TimeService");
    const om::ObjectPath configuration = test::path("VESKA_CIMServiceConfig");
    const om::ObjectPath nothing = test::path("NoSuchClass");
    const om::ObjectPath odd = test::path("VESKA_ComputerSystemPackage", {{"Odd", "key"}});
    om::Request filtered = asking(Operation::AssociatorNames, firstOf("VESKA_ComputerSystem"), "VESKA_Nothing");
    filtered.resultClass = "CIM_X";
    om::Request refused = asking(Operation::EnumInstanceNames, computer);
    refused.fault = om::Fault{om::FaultKind::newObjectPath, 1};
    return {
        {"EnumInstanceNames of no class", asking(Operation::EnumInstanceNames, nothing)},
        {"EnumInstances of no class", asking(Operation::EnumInstances, nothing)},
        {"GetInstance of no class", asking(Operation::GetInstance, nothing)},
        {"CreateInstance", asking(Operation::CreateInstance, computer)},
        {"DeleteInstance", asking(Operation::DeleteInstance, computer)},
        {"ExecQuery", asking(Operation::ExecQuery, computer)},
        {"References", asking(Operation::References, computer)},
        {"ReferenceNames", asking(Operation::ReferenceNames, computer)},
        {"ModifyInstance of a computer", asking(Operation::ModifyInstance, computer)},
        {"InvokeMethod of a computer", test::calling(computer, "ManageTime", {})},
        {"AssociatorNames through no association", filtered},
        {"AssociatorNames through a class that is none",
         asking(Operation::AssociatorNames, computer, computer.className)},
        {"AssociatorNames through an empty name", asking(Operation::AssociatorNames, nothing, "")},
        {"AssociatorNames of an unknown computer",
         asking(Operation::AssociatorNames, test::path(computer.className, {{"Name", "other"}}), odd.className)},
        {"GetInstance of an unknown association", asking(Operation::GetInstance, odd)},
        {"GetInstance of a chassis by both keys",
         asking(Operation::GetInstance,
                test::path("VESKA_PhysicalPackage", {{"SystemName", "/computer/0"}, {"Tag", "CZ1"}}))},
        {"GetInstance of another host's time service",
         asking(Operation::GetInstance,
                test::path(service.className, {{"Name", "TimeService@other"}, {"SystemName", "other"}}))},
        {"EnumInstances with a list", test::askingFor({"Name"}, asking(Operation::EnumInstances, computer))},
        {"GetInstance with a list", test::askingFor({"Name"}, asking(Operation::GetInstance, computer))},
        {"Associators with a list",
         test::askingFor({"Name"}, asking(Operation::Associators, computer, "VESKA_ComputerCapabilities"))},
        {"ModifyInstance with a list", test::askingFor({"Name"}, asking(Operation::ModifyInstance, service))},
        {"ManageTime without arguments", test::calling(service, "ManageTime", {})},
        {"ManageTime, reading",
         test::calling(service, "ManageTime",
                       {{"GetRequest", {CMPI_boolean, true}}, {"ManagedElement", {CMPI_ref, {}}}})},
        {"A method that the class lacks", test::calling(configuration, "NoSuchMethod", settings)},
        {"EnumInstanceNames with a path that the object manager does not make", refused},
    };
}

TEST(OtherTraces, AreWhatTheyHaveAlwaysBeen) {
    simulateHost(tracedHosts[1]);
    test::get(firstOf("VESKA_ComputerSystem"));
    Lines lines;
    for (const auto& [title, request] : otherRequests()) append(lines, title, request);
    append(lines, "SetCIMconfig, its arguments and commands",
           test::calling(test::path("VESKA_CIMServiceConfig"), "SetCIMconfig", settings), "getArg");
    EXPECT_EQ(test::differenceFrom(std::string(TRACES) + "/other-requests", lines), "");
}

/// What a failing test prints of it.
std::ostream& operator<<(std::ostream& out, const TracedHost& host) {
    return out << host.name;
}

using TracedClass = std::tuple<TracedHost, std::string>;

class Traces : public testing::TestWithParam<TracedClass> {};

TEST_P(Traces, AreWhatTheyHaveAlwaysBeen) {
    const auto& [host, className] = GetParam();
    simulateHost(host);
    test::instances(className); // a first request may report what the host lacks
    Lines lines;
    for (const auto& [title, request] : requestsOf(className)) append(lines, title, request);
    EXPECT_EQ(test::differenceFrom(std::string(TRACES) + host.directory + "/" + className, lines), "");
}

INSTANTIATE_TEST_SUITE_P(
    , Traces, testing::Combine(testing::ValuesIn(tracedHosts), testing::ValuesIn(om::Schema::builtin().served())),
    [](const auto& each) { return std::string(std::get<0>(each.param).name) + "_" + std::get<1>(each.param); });

} // namespace
