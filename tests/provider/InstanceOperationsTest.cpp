#include "provider/LogEvents.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace {

using om::Operation;
using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using Events = std::vector<std::string>;

constexpr char frame[] = "BaseServerProvider";

om::Answer run(Operation operation, const om::ObjectPath& path) {
    om::Request request;
    request.operation = operation;
    request.path = path;
    return test::provider().run(request);
}

void simulateOneComputer() {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")});
}

Events operator+(Events left, const Events& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

/// The frame's own events among all of an operation's.
Events ofFrame(const Events& all) {
    Events own;
    for (const std::string& each : all)
        if (each.find(" Trace mark") != std::string::npos || each.find(" BaseServerProvider BaseServer_") == 4)
            own.push_back(each);
    return own;
}

Events classId(const std::string& operation, const std::string& id, int times) {
    return Events(static_cast<std::size_t>(times), test::variable(frame, operation, "classId", id));
}

enum Expected { InvalidClass, Open, Done };

struct Row {
    const char* className;
    Expected names;
    Expected instances;
    Expected get;
};

// clang-format off
constexpr Row rows[] = {
    //                                          names         instances     get
    {"VESKA_ComputerSystem",                    Done,         Done,         Done},
    {"VESKA_PhysicalPackage",                   Done,         Done,         Done},
    {"VESKA_EnabledLogicalElementCapabilities", Done,         Open,         Done},
    {"VESKA_ComputerSystemPackage",             Open,         Open,         Open},
    {"VESKA_ComputerCapabilities",              Done,         Open,         Open},
    {"VESKA_TimeService",                       Open,         Open,         Done},
    {"VESKA_TimeServiceAffectsElement",         Open,         Open,         InvalidClass},
    {"VESKA_CIMServiceConfig",                  Open,         Open,         Open},
    {"CIM_ComputerSystem",                      InvalidClass, InvalidClass, InvalidClass},
    {"CIM_ElementCapabilities",                 InvalidClass, InvalidClass, InvalidClass},
    {"NoSuchClass",                             InvalidClass, InvalidClass, InvalidClass},
};
// clang-format on

TEST(InstanceOperations, ServeEachClassAndCloseTheResultAsTheTableSays) {
    simulateOneComputer();
    for (const Row& row : rows) {
        for (const auto& [operation, expected] :
             {std::pair(Operation::EnumInstanceNames, row.names), std::pair(Operation::EnumInstances, row.instances),
              std::pair(Operation::GetInstance, row.get)}) {
            SCOPED_TRACE(std::string(row.className) + ", operation " + std::to_string(static_cast<int>(operation)));
            const om::Answer answer = run(operation, test::path(row.className));
            EXPECT_EQ(answer.code, expected == InvalidClass ? CMPI_RC_ERR_INVALID_CLASS : CMPI_RC_OK);
            EXPECT_EQ(answer.message, std::nullopt);
            EXPECT_EQ(answer.done, expected == Done);
            EXPECT_THAT(answer.results, SizeIs(expected == InvalidClass ? 0 : 1));
        }
    }
}

TEST(InstanceOperations, TakeTheClassNameInAnyCase) {
    simulateOneComputer();
    EXPECT_THAT(test::names("veska_COMPUTERSYSTEM").results, SizeIs(1));
}

TEST(EnumInstanceNames, ReturnsEveryComputerAndThenCloses) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    const om::Answer answer = test::names("VESKA_ComputerSystem");
    EXPECT_THAT(answer.results, SizeIs(2));
    EXPECT_TRUE(answer.done);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
}

TEST(EnumInstances, ReturnsTheTimeServiceAndNeverCloses) {
    simulateOneComputer();
    const om::Answer answer = test::instances("VESKA_TimeService");
    EXPECT_THAT(answer.results, SizeIs(1));
    EXPECT_FALSE(answer.done);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
}

TEST(GetInstance, DoesNotKnowTheTimeServicesAssociationAlthoughItIsEnumerated) {
    simulateOneComputer();
    const std::vector<om::ObjectPath> paths = test::paths(test::names("VESKA_TimeServiceAffectsElement"));
    ASSERT_THAT(paths, SizeIs(1));
    const om::Answer answer = test::get(paths[0]);
    EXPECT_EQ(answer.code, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(answer.message, std::nullopt);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_FALSE(answer.done);
}

TEST(GetInstance, ReturnsNothingAndOkForKeysThatMatchNothing) {
    simulateOneComputer();
    const om::Answer answer = test::get(test::path("VESKA_ComputerSystem", {{"Name", "other"}}));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_TRUE(answer.done);
}

TEST(GetInstance, ReturnsEveryElementOfTheWalkNotOnlyTheFirst) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8")});
    EXPECT_THAT(test::get(test::path("VESKA_ComputerSystem")).results, SizeIs(2));
}

TEST(GetInstance, LogsEachStepOnceToEitherChannel) {
    simulateOneComputer();
    const om::ObjectPath path =
        test::path("VESKA_ComputerSystem", {{"CreationClassName", "VESKA_ComputerSystem"}, {"Name", "node7"}});
    test::get(path); // a first request may report what the host lacks
    test::takeLog();
    test::get(path);

    const std::string data = "ComputerSystem";
    const std::string adapter = "CMPIComputerSystem";
    const auto around = [](const std::string& file, const std::string& function, const Events& inside,
                           const std::string& list = "") {
        return Events{test::entering(file, function, list)} + inside + Events{test::exiting(file, function, list)};
    };
    const Events standing = around(adapter, "operator bool", around(data, "operator bool", {}));
    const std::string pathList = " objectPath=ADDRESS";
    const Events constructing =
        around(adapter, "CMPIComputerSystem",
               around(data, "ComputerSystem", {}) +
                   around(adapter, "setObjectPath",
                          Events{test::variable(adapter, "setObjectPath", "name", "node7")} +
                              around(data, "setFilter", around(data, "evaluate", {}), " filterType=0 reference=node7"),
                          pathList),
               " _broker=ADDRESS _context=ADDRESS" + pathList);

    Events reading =
        around(adapter, "getObjectPath", around(data, "getCreationClassName", {}) + around(data, "getName", {}));
    const Events identifying = around(data, "getIdentifyingInfo", around(data, "getUUID", {}));
    for (const char* getter :
         {"getDescription", "getElementName", "getOperationalStatus", "getHealthState", "getEnabledState",
          "getCreationClassName", "getName", "getPrimaryOwnerName", "getPrimaryOwnerContact", "getOtherIdentifyingInfo",
          "getIdentifyingDescriptions", "getDedicated", "getUUID", "getStatus"})
        reading =
            reading +
            around(data, getter, std::string(getter).find("Identifying") == std::string::npos ? Events{} : identifying);

    const Events expected = test::entryMarker("BaseServer_GetInstance") + classId("BaseServer_GetInstance", "1", 1) +
                            constructing + standing + around(adapter, "getCMPIInstance", reading, " properties=0") +
                            around(adapter, "operator++", around(data, "operator++", {})) + standing +
                            Events{test::method(adapter, "~CMPIComputerSystem")} + around(data, "~ComputerSystem", {}) +
                            test::exitMarker("BaseServer_GetInstance");
    EXPECT_THAT(test::events(test::takeLog()), ElementsAreArray(expected));
}

/// The request with a list of properties, and what it left in the log.
Events eventsWithPropertyList(Operation operation, const om::ObjectPath& path) {
    om::Request request;
    request.operation = operation;
    request.path = path;
    const om::Answer without = test::provider().run(request);
    request.propertyList = std::vector<std::string>{"Name"};
    test::takeLog();
    const om::Answer with = test::provider().run(request);
    EXPECT_EQ(with.results, without.results) << "the list is not applied";
    return test::events(test::takeLog());
}

TEST(InstanceOperations, TraceTheListOfPropertiesAndDoNotApplyIt) {
    simulateOneComputer();
    const om::ObjectPath computer = test::path("VESKA_ComputerSystem", {{"Name", "node7"}});
    const std::string traced = test::entering("CMPIComputerSystem", "getCMPIInstance", " properties=ADDRESS");
    for (const Operation operation : {Operation::EnumInstances, Operation::GetInstance})
        EXPECT_THAT(eventsWithPropertyList(operation, computer), testing::Contains(traced));
    EXPECT_THAT(eventsWithPropertyList(Operation::ModifyInstance, test::path("VESKA_TimeService")),
                testing::Contains(test::entering("CMPITimeService", "modifyInstance",
                                                 " referenceInstance=ADDRESS properties=ADDRESS")));
}

TEST(EnumInstanceNames, TracesTheClassOnceMoreForEveryComputer) {
    test::simulate({test::computer(0, "node7"), test::computer(1, "node8"), test::chassis(0, 0, "CZ1")});
    const std::string operation = "BaseServer_EnumInstanceNames";
    test::takeLog();
    test::names("VESKA_ComputerSystem");
    EXPECT_EQ(ofFrame(test::events(test::takeLog())),
              test::entryMarker(operation) + classId(operation, "1", 3) + test::exitMarker(operation));
    test::names("VESKA_PhysicalPackage");
    EXPECT_EQ(ofFrame(test::events(test::takeLog())),
              test::entryMarker(operation) + classId(operation, "22", 1) + test::exitMarker(operation));
}

TEST(InstanceOperations, TraceTheClassTwiceWhereItIsNotServedButOnceInGetInstance) {
    for (const auto& [operation, name, times] :
         {std::tuple(Operation::EnumInstanceNames, "BaseServer_EnumInstanceNames", 2),
          std::tuple(Operation::EnumInstances, "BaseServer_EnumInstances", 2),
          std::tuple(Operation::GetInstance, "BaseServer_GetInstance", 1)}) {
        test::takeLog();
        run(operation, test::path("NoSuchClass"));
        EXPECT_EQ(test::events(test::takeLog()),
                  test::entryMarker(name) + classId(name, "255", times) + test::exitMarker(name));
    }
}

/// A path of the chassis association that names neither end, so that its adapter throws.
om::ObjectPath unknownAssociation(const char* className) {
    return test::path(className, {{"Odd", "key"}});
}

TEST(GetInstance, AnswersOkWithoutClosingAfterAnException) {
    simulateOneComputer();
    const om::Answer answer = test::get(unknownAssociation("VESKA_ComputerSystemPackage"));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_EQ(answer.message, std::nullopt);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_FALSE(answer.done);
}

TEST(EnumInstanceNames, DoesNotCloseAfterAnExceptionWhereItWouldOtherwise) {
    simulateOneComputer();
    const om::Answer answer = run(Operation::EnumInstanceNames, unknownAssociation("VESKA_ComputerCapabilities"));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_FALSE(answer.done);
}

TEST(EnumInstances, KeepsWhatWasReturnedBeforeAnException) {
    test::Node nameless = test::computer(1, "");
    nameless.properties.erase(108);
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1"), nameless});
    test::takeLog();
    const om::Answer answer = test::instances("VESKA_ComputerSystemPackage");
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_THAT(answer.results, SizeIs(1));
    EXPECT_FALSE(answer.done);
    EXPECT_THAT(ofFrame(test::events(test::takeLog())),
                testing::Contains(test::event(3000, frame, "BaseServer_EnumInstances",
                                              "MESSAGE [File: BaseServerProvider, Line: N]: Could not find 'Name' Key "
                                              "in Moniker")));
}

TEST(GetInstance, LogsTheExceptionBetweenTheAdaptersEndAndTheExitMarker) {
    simulateOneComputer();
    test::takeLog();
    test::get(unknownAssociation("VESKA_ComputerSystemPackage"));
    const Events events = test::events(test::takeLog());
    const std::string operation = "BaseServer_GetInstance";
    const std::string message =
        test::event(3000, frame, operation, "MESSAGE [File: BaseServerProvider, Line: N]: Could not find instance");
    EXPECT_EQ(ofFrame(events), test::entryMarker(operation) + classId(operation, "24", 1) + Events{message} +
                                   test::exitMarker(operation));

    const auto at = [&](const std::string& wanted) {
        return std::find(events.begin(), events.end(), wanted) - events.begin();
    };
    // What the adapter owns ends before the frame reports; the exit marker is the last of all.
    for (const char* owned : {"~CMPIComputerSystem", "~CMPIPhysicalPackage"})
        EXPECT_LT(at(test::method(std::string(owned).substr(1), owned)), at(message)) << owned;
    EXPECT_LT(at(test::exiting("ComputerSystem", "~ComputerSystem")), at(message));
    EXPECT_EQ(at(message) + 3, static_cast<std::ptrdiff_t>(events.size()));
}

std::string refusedPart(const std::string& operation) {
    return test::event(6000, frame, operation,
                       "MESSAGE [File: BaseServerProvider, Line: N]: The object manager refused a part of the answer");
}

TEST(RefusedParts, AreLoggedInTheNameOfTheOperationWhoseAnswerItIs) {
    simulateOneComputer();
    const struct {
        Operation operation;
        const char* name;
        om::FaultKind part;
        const char* className;
    } refusals[] = {
        {Operation::EnumInstanceNames, "BaseServer_EnumInstanceNames", om::FaultKind::returnObjectPath,
         "VESKA_ComputerSystem"},
        {Operation::EnumInstances, "BaseServer_EnumInstances", om::FaultKind::returnInstance, "VESKA_ComputerSystem"},
        {Operation::GetInstance, "BaseServer_GetInstance", om::FaultKind::returnInstance, "VESKA_ComputerSystem"},
        {Operation::Associators, "BaseServer_Associators", om::FaultKind::returnInstance, "VESKA_ComputerSystem"},
        {Operation::AssociatorNames, "BaseServer_AssociatorNames", om::FaultKind::returnObjectPath,
         "VESKA_ComputerSystem"},
        {Operation::InvokeMethod, "BaseServer_InvokeMethod", om::FaultKind::returnData, "VESKA_TimeService"},
    };
    for (const auto& row : refusals)
        for (const om::FaultKind kind : {row.part, om::FaultKind::returnDone}) {
            om::Request request;
            request.operation = row.operation;
            request.path = test::path(row.className);
            request.assocClass = "VESKA_ComputerCapabilities";
            request.fault = om::Fault{kind};
            test::takeLog();
            test::provider().run(request);
            EXPECT_THAT(test::events(test::takeLog()), testing::Contains(refusedPart(row.name)).Times(1)) << row.name;
        }
}

TEST(RefusedParts, AreNoneWhereNothingWasFoundAndTheResultCannotBeClosed) {
    simulateOneComputer();
    om::Request request;
    request.operation = Operation::GetInstance;
    request.path = test::path("VESKA_ComputerSystem", {{"Name", "other"}});
    request.fault = om::Fault{om::FaultKind::returnDone};
    test::takeLog();
    const om::Answer answer = test::provider().run(request);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.faulted) << "it was tried";
    EXPECT_THAT(test::takeLog(), Not(testing::Contains(testing::HasSubstr("refused a part of the answer"))));
}

TEST(ModifyInstance, IsNotSupportedForAnyClassButTheTimeService) {
    simulateOneComputer();
    for (const Row& row : rows) {
        if (std::string(row.className) == "VESKA_TimeService") continue;
        const om::Answer answer = test::modify(test::path(row.className), {});
        EXPECT_EQ(answer.code, CMPI_RC_ERR_NOT_SUPPORTED) << row.className;
        EXPECT_EQ(answer.message, std::nullopt) << row.className;
        EXPECT_THAT(answer.results, IsEmpty()) << row.className;
        EXPECT_FALSE(answer.done) << row.className;
    }
}

TEST(ModifyInstance, IsMarkedAndTracesTheClass) {
    const std::string operation = "BaseServer_ModifyInstance";
    test::takeLog();
    test::modify(test::path("VESKA_ComputerSystem"), {});
    EXPECT_EQ(test::events(test::takeLog()),
              test::entryMarker(operation) + classId(operation, "1", 1) + test::exitMarker(operation));
}

TEST(ModifyInstance, AnswersOkForTheTimeServiceAlsoWhereTheHostRefuses) {
    for (const bool refusing : {false, true}) {
        test::Node node = test::computer(0, "node7");
        if (refusing) node.failWrites = {200};
        test::simulate({node});
        const om::Answer answer =
            test::modify(test::path("VESKA_TimeService"), {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}});
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_FALSE(answer.done);
        EXPECT_THAT(answer.results, IsEmpty());
        EXPECT_EQ(test::simulatedProperty("/computer/0", 200), refusing ? 0 : 1);
    }
}

TEST(UnsupportedOperations, AnswerSoAndWriteOneMethodLineWithoutMarkers) {
    simulateOneComputer();
    for (const auto& [operation, name] : {std::pair(Operation::CreateInstance, "BaseServer_CreateInstance"),
                                          std::pair(Operation::DeleteInstance, "BaseServer_DeleteInstance"),
                                          std::pair(Operation::ExecQuery, "BaseServer_ExecQuery"),
                                          std::pair(Operation::References, "BaseServer_References"),
                                          std::pair(Operation::ReferenceNames, "BaseServer_ReferenceNames")}) {
        for (const char* className : {"VESKA_ComputerSystem", "VESKA_TimeService", "NoSuchClass"}) {
            test::takeLog();
            const om::Answer answer = run(operation, test::path(className));
            EXPECT_EQ(answer.code, CMPI_RC_ERR_NOT_SUPPORTED) << name;
            EXPECT_EQ(answer.message, std::nullopt) << name;
            EXPECT_FALSE(answer.done) << name;
            EXPECT_THAT(answer.results, IsEmpty()) << name;
            EXPECT_THAT(test::events(test::takeLog()), ElementsAre(test::method(frame, name)));
        }
    }
}

} // namespace
