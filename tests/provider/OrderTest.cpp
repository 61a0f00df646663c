// In which order a request's lines, its calls to the object manager and its commands come.
#include "provider/LogEvents.h"
#include "provider/Sequence.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace {

using om::Operation;
using testing::ElementsAre;
using Events = std::vector<std::string>;

constexpr char frame[] = "BaseServerProvider";
const std::string done = test::brokerCall("returnDone");

om::Request asking(Operation operation, const om::ObjectPath& path) {
    om::Request request;
    request.operation = operation;
    request.path = path;
    return request;
}

om::Request calling(const std::string& className, const std::string& method, std::vector<om::NamedValue> in) {
    om::Request request = asking(Operation::InvokeMethod, test::path(className));
    request.method = method;
    request.values = std::move(in);
    return request;
}

om::Request settingConfiguration() {
    return calling("VESKA_CIMServiceConfig", "SetCIMconfig",
                   {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                    {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{3}}}});
}

om::Request readingTime() {
    return calling("VESKA_TimeService", "ManageTime",
                   {{"GetRequest", {CMPI_boolean, true}}, {"ManagedElement", {CMPI_ref, {}}}});
}

/// The places of these events, the last of each; the test fails for one that is not there.
std::vector<std::size_t> places(const Events& events, const Events& wanted) {
    std::vector<std::size_t> found;
    for (const std::string& each : wanted) {
        const auto place = test::last(events, each);
        EXPECT_TRUE(place) << each << " is not there";
        found.push_back(place.value_or(0));
    }
    return found;
}

void expectInOrder(const Events& events, const Events& wanted) {
    const std::vector<std::size_t> found = places(events, wanted);
    EXPECT_TRUE(std::is_sorted(found.begin(), found.end()))
        << testing::PrintToString(wanted) << " at " << testing::PrintToString(found);
}

/// Some of a request's events, in their order.
Events onlyThese(const Events& events, const Events& wanted) {
    Events some;
    for (const std::string& each : events)
        if (std::find(wanted.begin(), wanted.end(), each) != wanted.end()) some.push_back(each);
    return some;
}

class Order : public testing::Test {
protected:
    Order() {
        test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")},
                       {{"rootDirectory", "/opt/vk/platform/"}, {"kvm", false}});
    }
};

TEST_F(Order, AnInstanceOperationClosesTheResultWhileTheAdapterStands) {
    const struct {
        const char* adapter;
        const char* className;
        std::vector<Operation> closing;
    } rows[] = {
        {"CMPIComputerSystem",
         "VESKA_ComputerSystem",
         {Operation::EnumInstanceNames, Operation::EnumInstances, Operation::GetInstance}},
        {"CMPIPhysicalPackage",
         "VESKA_PhysicalPackage",
         {Operation::EnumInstanceNames, Operation::EnumInstances, Operation::GetInstance}},
        {"CMPIEnabledLogicalElementCapabilities",
         "VESKA_EnabledLogicalElementCapabilities",
         {Operation::EnumInstanceNames, Operation::GetInstance}},
        {"CMPIElementCapabilities", "VESKA_ComputerCapabilities", {Operation::EnumInstanceNames}},
        {"CMPITimeService", "VESKA_TimeService", {Operation::GetInstance}},
    };
    for (const auto& row : rows)
        for (const Operation operation : row.closing) {
            SCOPED_TRACE(std::string(row.className) + ", operation " + std::to_string(static_cast<int>(operation)));
            const Events events = test::sequence(asking(operation, test::path(row.className)));
            const std::string adapter = row.adapter;
            const std::vector<std::size_t> at =
                places(events, {test::exiting(adapter, "operator bool"), done, test::method(adapter, "~" + adapter)});
            EXPECT_EQ(at[1], at[0] + 1) << "behind the walk";
            EXPECT_EQ(at[2], at[1] + 1) << "before the adapter goes";
        }
}

TEST_F(Order, AnAssociationOperationClosesTheResultBehindAllAdapters) {
    const Events events = test::sequence(asking(Operation::AssociatorNames, test::path("VESKA_ComputerSystem")));
    expectInOrder(events, {test::method("CMPIServiceAffectsElement", "~CMPITimeServiceAffectsElement"),
                           test::variable(frame, "BaseServer_AssociatorNames", "rcode", "1"), done,
                           test::exitMarker("BaseServer_AssociatorNames").front()});
}

TEST_F(Order, AMethodsReturnCodeIsTracedBeforeTheAdapterGoes) {
    const std::string code = test::variable(frame, "BaseServer_InvokeMethod", "returnCode", "0");
    const std::string list = " in=ADDRESS out=ADDRESS result=ADDRESS";
    for (const auto& [adapter, request] :
         {std::pair("CMPITimeService", readingTime()), std::pair("CMPICIMServiceConfig", settingConfiguration())}) {
        const std::string name = adapter;
        const Events events = test::sequence(request);
        expectInOrder(events, {test::exiting(name, "invokeMethod", " methodName=" + request.method + list), code,
                               test::method(name, "~" + name), test::brokerCall("returnData"), done});
        EXPECT_EQ(test::first(events, code), test::last(events, code)) << "once";
    }
}

TEST_F(Order, SetCIMconfigReadsBothArgumentsBeforeItRunsACommand) {
    const std::string read = test::brokerCall("getArg");
    const std::string interval =
        test::command("system", "/opt/vk/vcm/bin/cimconfig -s minIndicationDeliveryRetryInterval=30 -p");
    const std::string attempts =
        test::command("system", "/opt/vk/vcm/bin/cimconfig -s maxIndicationDeliveryRetryAttempts=3 -p");
    EXPECT_THAT(onlyThese(test::sequence(settingConfiguration()), {read, interval, attempts}),
                ElementsAre(read, read, interval, attempts));
}

TEST_F(Order, TheClassIsTracedForEveryComputerPathThatIsReturned) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    const std::string traced = test::variable(frame, "BaseServer_EnumInstanceNames", "classId", "1");
    const std::string made = test::exiting("CMPIComputerSystem", "getObjectPath");
    const std::string returned = test::brokerCall("returnObjectPath");
    om::Request request = asking(Operation::EnumInstanceNames, test::path("VESKA_ComputerSystem"));
    EXPECT_THAT(onlyThese(test::sequence(request), {traced, made, returned}),
                ElementsAre(traced, made, traced, returned, made, traced, returned));
    request.fault = om::Fault{om::FaultKind::newObjectPath, 1};
    EXPECT_THAT(onlyThese(test::sequence(request), {traced, made, returned}),
                ElementsAre(traced, made, made, traced, returned))
        << "none for the path that the broker did not make";
}

} // namespace
