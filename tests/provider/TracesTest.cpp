// Every line that a request hands to the logger, compared with what stands in the folder `traces`. With VK_WRITE_TRACES
// in the environment the files are written instead; a change in them is a change that administrators see.
#include "provider/Sequence.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <optional>
#include <regex>
#include <tuple>
#include <unistd.h>

namespace {

using om::Operation;
using Lines = std::vector<std::string>;

std::string hostName() {
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    return name;
}

/// A host that the traces are of. Its first computer is named like this host, so that it has the time service.
struct TracedHost {
    const char* name;
    const char* folder;
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
    test::simulate(host.nodes(), {{"rootDirectory", "/opt/vk/platform/"}, {"kvm", false}});
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

/// Calls that make or read objects are left out: there are hundreds, and the lines between them tell which they are.
bool isOutlined(const std::string& event) {
    static const std::string broker = test::brokerCall("");
    const std::string head = broker.substr(0, broker.find(':'));
    return event.rfind(head, 0) != 0 || event.rfind(head + "return", 0) == 0;
}

void append(Lines& lines, const std::string& title, const om::Request& request) {
    Outline outline;
    for (const std::string& event : test::sequence(request))
        if (isOutlined(event)) outline.add(withoutHostName(event));
    lines.push_back(title);
    lines.insert(lines.end(), outline.lines.begin(), outline.lines.end());
}

om::Request asking(Operation operation, const om::ObjectPath& path) {
    om::Request request;
    request.operation = operation;
    request.path = path;
    return request;
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

/// The requests of one class, in order, each with its title.
std::vector<std::pair<std::string, om::Request>> requestsOf(const std::string& className) {
    const om::ObjectPath all = test::path(className);
    std::vector<std::pair<std::string, om::Request>> requests = {
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
        om::Request set = asking(Operation::InvokeMethod, firstOf(className));
        set.method = "SetCIMconfig";
        set.values = {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                      {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{3}}}};
        requests.emplace_back("SetCIMconfig", set);
    }
    return requests;
}

Lines readLines(const std::string& file) {
    std::ifstream stream(file);
    Lines lines;
    for (std::string line; std::getline(stream, line);) lines.push_back(line);
    return lines;
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
    const std::string file = std::string(TRACES) + host.folder + "/" + className;
    if (std::getenv("VK_WRITE_TRACES") != nullptr) {
        std::ofstream stream(file);
        for (const std::string& line : lines) stream << line << '\n';
        ASSERT_TRUE(stream.flush()) << file;
        return;
    }
    const Lines expected = readLines(file);
    for (std::size_t i = 0; i < std::max(lines.size(), expected.size()); ++i) {
        const std::string is = i < lines.size() ? lines[i] : "(nothing)";
        const std::string was = i < expected.size() ? expected[i] : "(nothing)";
        ASSERT_EQ(is, was) << "at " << file << ":" << i + 1;
    }
}

INSTANTIATE_TEST_SUITE_P(
    , Traces, testing::Combine(testing::ValuesIn(tracedHosts), testing::ValuesIn(om::Schema::builtin().served())),
    [](const auto& each) { return std::string(std::get<0>(each.param).name) + "_" + std::get<1>(each.param); });

} // namespace
