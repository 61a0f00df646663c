#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using testing::Contains;
using testing::ContainsRegex;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;

std::vector<std::string> printed(const om::Answer& answer) {
    std::vector<std::string> lines;
    for (const om::ObjectPath& path : test::paths(answer)) lines.push_back(test::print(path));
    return lines;
}

class AssociationOperations : public testing::Test {
protected:
    void SetUp() override { test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1234")}); }

    const om::ObjectPath node7 = test::path("VESKA_ComputerSystem", {{"Name", "node7"}});
};

TEST_F(AssociationOperations, ReturnTheCapabilitiesOfAComputerAndCloseTheResult) {
    const om::Answer answer = test::associatorNames(node7, "VESKA_ComputerCapabilities");
    EXPECT_THAT(printed(answer), ElementsAre("VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/0\""));
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST_F(AssociationOperations, ResolveAClassOutsideTheTableThroughTheSchema) {
    EXPECT_EQ(printed(test::associatorNames(node7, "CIM_ElementCapabilities")),
              printed(test::associatorNames(node7, "VESKA_ComputerCapabilities")));
    EXPECT_EQ(printed(test::associatorNames(node7, "cim_systempackaging")),
              printed(test::associatorNames(node7, "VESKA_ComputerSystemPackage")));
}

TEST_F(AssociationOperations, ReturnNothingForAResultClassThatThePackageDoesNotReach) {
    const om::Answer answer = test::associators(node7, "VESKA_ComputerSystemPackage", "CIM_Fan");
    EXPECT_THAT(answer.results, IsEmpty());
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
}

TEST_F(AssociationOperations, TraceTheInvalidClassWithItsCode) {
    test::takeLog();
    const om::Answer answer = test::associatorNames(node7, "VESKA_Nothing", "CIM_X");
    EXPECT_EQ(answer.code, CMPI_RC_ERR_INVALID_CLASS);
    const std::string head = " 4000 Norvane.BaseServerProvider BaseServerProvider BaseServer_AssociatorNames: ";
    const std::vector<std::string> log = test::withoutPlaces(test::takeLog());
    EXPECT_THAT(log, Contains("LOG" + head + "VARIABLE: 'resultClass' has Value 'CIM_X' [Line] in BaseServerProvider"));
    EXPECT_THAT(log, Contains("TRACE" + head +
                              "VARIABLE: 'associationClass' has Value 'VESKA_Nothing' [Line] in BaseServerProvider"));
    EXPECT_THAT(log, Contains("LOG" + head +
                              "VARIABLE: 'CMPI_RC_ERR_INVALID_CLASS' has Value '5' [Line] in BaseServerProvider"));
    EXPECT_THAT(log, Not(Contains(HasSubstr("'rcode'"))));
}

TEST_F(AssociationOperations, TraceWhetherEachIdWasServed) {
    test::takeLog();
    test::associatorNames(node7, "VESKA_ComputerCapabilities");
    const std::string line = "LOG 4000 Norvane.BaseServerProvider BaseServerProvider BaseServer_AssociatorNames: "
                             "VARIABLE: 'rcode' has Value ";
    EXPECT_THAT(test::withoutPlaces(test::takeLog()), Contains(line + "'1' [Line] in BaseServerProvider").Times(1));
    test::associatorNames(node7, "VESKA_ComputerSystem");
    // Meant: an id that is not served is traced twice.
    EXPECT_THAT(test::withoutPlaces(test::takeLog()), Contains(line + "'0' [Line] in BaseServerProvider").Times(2));
}

TEST_F(AssociationOperations, TraceANullResultClassAsNull) {
    test::takeLog();
    test::associators(node7, "VESKA_ComputerCapabilities");
    EXPECT_THAT(test::takeLog(), Contains(HasSubstr("VARIABLE: 'resultClass' has Value '(null)'")));
}

TEST_F(AssociationOperations, TraceAMissingAssociationClassAsNullTextsAre) {
    for (const auto& [assocClass, traced] :
         {std::pair<std::optional<std::string>, const char*>({}, "(null)"), {"", ""}}) {
        test::takeLog();
        test::associatorNames(node7, assocClass);
        const std::vector<std::string> log = test::takeLog();
        EXPECT_THAT(log, Contains(HasSubstr(std::string("VARIABLE: 'associationClass' has Value '") + traced + "'")));
        EXPECT_THAT(log, Contains(HasSubstr("LOG 4000 Norvane.BaseServerProvider BaseServerProvider")).Times(5))
            << "two classes and three times 'rcode'";
    }
}

TEST_F(AssociationOperations, LogAnExceptionAndEndWithoutClosing) {
    test::takeLog();
    const om::Answer answer =
        test::associatorNames(test::path("VESKA_ComputerSystem", {{"Name", "other"}}), "VESKA_ComputerSystemPackage");
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_FALSE(answer.done);
    const std::vector<std::string> log = test::withoutPlaces(test::takeLog());
    EXPECT_THAT(log, Contains(MatchesRegex("LOG 3000 Norvane.BaseServerProvider BaseServerProvider "
                                           "BaseServer_AssociatorNames: MESSAGE .File: BaseServerProvider, Line: "
                                           "[0-9]+.: Concerned Computer Could Not Be Found[.]")));
    EXPECT_THAT(log.back(), HasSubstr("TRACE 4000 Norvane.BaseServerProvider Trace markProviderExit: ====="));
}

TEST_F(AssociationOperations, DoNotFollowReferences) {
    for (const auto operation : {om::Operation::References, om::Operation::ReferenceNames}) {
        test::takeLog();
        om::Request request;
        request.operation = operation;
        request.path = node7;
        const om::Answer answer = test::provider().run(request);
        EXPECT_EQ(answer.code, CMPI_RC_ERR_NOT_SUPPORTED);
        EXPECT_FALSE(answer.done);
        const char* const name =
            operation == om::Operation::References ? "BaseServer_References" : "BaseServer_ReferenceNames";
        const std::string line = std::string(" 4000 Norvane.BaseServerProvider BaseServerProvider ") + name +
                                 ": METHOD: " + name + "() was invoked in BaseServerProvider [Line]";
        EXPECT_THAT(test::withoutPlaces(test::takeLog()), ElementsAre("LOG" + line, "TRACE" + line));
    }
}

TEST_F(AssociationOperations, LeaveRolesUnread) {
    om::Request request;
    request.operation = om::Operation::AssociatorNames;
    request.path = node7;
    request.assocClass = "VESKA_ComputerSystemPackage";
    request.role = "Antecedent"; // the computer is the Dependent
    request.resultRole = "Nothing";
    EXPECT_EQ(test::provider().run(request).results.size(), 1U);
}

TEST_F(AssociationOperations, TraceTheListOfPropertiesAndDoNotApplyIt) {
    om::Request request;
    request.operation = om::Operation::Associators;
    request.path = node7;
    for (const char* association : {"VESKA_ComputerCapabilities", "VESKA_ComputerSystemPackage"}) {
        request.assocClass = association;
        request.propertyList.reset();
        const om::Answer without = test::provider().run(request);
        request.propertyList = std::vector<std::string>{"ElementName"};
        test::takeLog();
        EXPECT_EQ(test::provider().run(request).results, without.results) << association;
        EXPECT_THAT(test::takeLog(), Contains(ContainsRegex(
                                         " getCMPIInstance: ENTERING: .*,Parameters List:  properties=0x[0-9a-f]+$")));
    }
}

} // namespace
