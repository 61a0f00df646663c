#include "provider/LogEvents.h"
#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace {

using om::Operation;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

om::Answer run(Operation operation, const om::ObjectPath& path) {
    return test::provider().run(test::asking(operation, path));
}

void simulateOneComputer() {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")});
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
    EXPECT_THAT(test::takeLog(), testing::Contains(testing::HasSubstr("]: Could not find 'Name' Key in Moniker")));
}

std::string refusedPart(const std::string& operation) {
    return test::event(6000, "BaseServerProvider", operation,
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
            om::Request request = test::asking(row.operation, test::path(row.className), "VESKA_ComputerCapabilities");
            request.fault = om::Fault{kind};
            test::takeLog();
            test::provider().run(request);
            EXPECT_THAT(test::events(test::takeLog()), testing::Contains(refusedPart(row.name)).Times(1)) << row.name;
        }
}

TEST(RefusedParts, AreNoneWhereNothingWasFoundAndTheResultCannotBeClosed) {
    simulateOneComputer();
    om::Request request = test::asking(Operation::GetInstance, test::path("VESKA_ComputerSystem", {{"Name", "other"}}));
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

TEST(ModifyInstance, AnswersOkForTheTimeServiceAlsoWhereTheHostRefuses) {
    for (const auto& [refusing, automatic] : {std::pair(false, true), std::pair(false, false), std::pair(true, true)}) {
        test::Node node = test::computer(0, "node7");
        node.properties[200] = refusing || automatic ? 0 : 1;
        if (refusing) node.failWrites = {200};
        test::simulate({node});
        const om::Answer answer =
            test::modify(test::path("VESKA_TimeService"), {{"AutomaticDSTAdjustment", {CMPI_boolean, automatic}}});
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_FALSE(answer.done);
        EXPECT_THAT(answer.results, IsEmpty());
        EXPECT_EQ(test::simulatedProperty("/computer/0", 200), automatic && !refusing ? 1 : 0);
    }
}

TEST(UnsupportedOperations, AnswerSo) {
    simulateOneComputer();
    for (const Operation operation : {Operation::CreateInstance, Operation::DeleteInstance, Operation::ExecQuery,
                                      Operation::References, Operation::ReferenceNames}) {
        for (const char* className : {"VESKA_ComputerSystem", "VESKA_TimeService", "NoSuchClass"}) {
            SCOPED_TRACE(std::string(className) + ", operation " + std::to_string(static_cast<int>(operation)));
            const om::Answer answer = run(operation, test::path(className));
            EXPECT_EQ(answer.code, CMPI_RC_ERR_NOT_SUPPORTED);
            EXPECT_EQ(answer.message, std::nullopt);
            EXPECT_FALSE(answer.done);
            EXPECT_THAT(answer.results, IsEmpty());
        }
    }
}

} // namespace
