#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using om::Operation;

class AssociationOperations : public testing::Test {
protected:
    AssociationOperations() { test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1234")}); }

    const om::ObjectPath node7 = test::path("VESKA_ComputerSystem", {{"Name", "node7"}});
};

TEST_F(AssociationOperations, TakeTheClassNameInAnyCase) {
    EXPECT_EQ(test::printed(test::associatorNames(node7, "cim_systempackaging")),
              test::printed(test::associatorNames(node7, "VESKA_ComputerSystemPackage")));
    EXPECT_THAT(test::associatorNames(node7, "veska_COMPUTERcapabilities").results, testing::SizeIs(1));
}

TEST_F(AssociationOperations, LeaveRolesUnread) {
    om::Request request = test::asking(Operation::AssociatorNames, node7, "VESKA_ComputerSystemPackage");
    request.role = "Antecedent"; // the computer is the Dependent
    request.resultRole = "Nothing";
    EXPECT_THAT(test::provider().run(request).results, testing::SizeIs(1));
}

TEST_F(AssociationOperations, DoNotApplyTheListOfProperties) {
    for (const char* association : {"VESKA_ComputerCapabilities", "VESKA_ComputerSystemPackage"}) {
        const om::Request request = test::asking(Operation::Associators, node7, association);
        const om::Answer whole = test::provider().run(request);
        EXPECT_THAT(whole.results, testing::SizeIs(1));
        EXPECT_EQ(test::provider().run(test::askingFor({"ElementName"}, request)).results, whole.results);
    }
}

} // namespace
