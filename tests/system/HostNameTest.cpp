// Classes that carry the kernel's host name, under names of the test's own.

#include "support/Provider.h"
#include "support/SimulatedHost.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr char association[] = "VESKA_TimeServiceAffectsElement";

class HostName : public test::NamespaceTest {
protected:
    static om::ObjectPath only(const char* className) {
        const std::vector<om::ObjectPath> found = test::paths(test::names(className));
        EXPECT_THAT(found, SizeIs(1));
        return found.at(0);
    }
    static std::vector<std::string> otherEnds(const om::ObjectPath& source) {
        const om::Answer answer = test::associatorNames(source, association);
        EXPECT_EQ(answer.code, CMPI_RC_OK);
        EXPECT_TRUE(answer.done);
        std::vector<std::string> lines;
        for (const om::ObjectPath& path : test::paths(answer)) lines.push_back(test::print(path));
        return lines;
    }
};

TEST_F(HostName, OfTheTreesComputerLeadsBothWays) {
    test::nameHost("node7");
    test::simulate({test::computer(0, "node7")});
    const om::ObjectPath computer = only("VESKA_ComputerSystem");
    const om::ObjectPath service = only("VESKA_TimeService");
    EXPECT_EQ(test::text(*test::find(service.keys, "Name")), "TimeService@node7");
    EXPECT_EQ(test::text(*test::find(service.keys, "SystemName")), "node7");
    EXPECT_THAT(otherEnds(computer), ElementsAre(test::print(service)));
    EXPECT_THAT(otherEnds(service), ElementsAre(test::print(computer)));
    EXPECT_EQ(test::print(only(association)), std::string(association) + ".AffectedElement=(" + test::print(computer) +
                                                  "),AffectingElement=(" + test::print(service) + ")");
}

TEST_F(HostName, UnlikeTheTreesComputerLeadsFromTheComputerAlone) {
    test::nameHost("node8");
    test::simulate({test::computer(0, "node7")});
    const om::ObjectPath computer = only("VESKA_ComputerSystem");
    const om::ObjectPath service = only("VESKA_TimeService");
    EXPECT_EQ(test::text(*test::find(service.keys, "SystemName")), "node8");
    EXPECT_THAT(otherEnds(computer), ElementsAre(test::print(service)));
    EXPECT_THAT(otherEnds(service), IsEmpty());
    EXPECT_THAT(test::names(association).results, SizeIs(1)) << "the association itself stays one pair";
}

TEST_F(HostName, IsReadAnewForEveryRequest) {
    test::simulate({});
    for (const std::string& name : {std::string("a"), std::string(64, 'h'), std::string("node7.example.com")}) {
        test::nameHost(name);
        EXPECT_EQ(test::text(*test::find(only("VESKA_TimeService").keys, "Name")), "TimeService@" + name);
        EXPECT_EQ(test::text(*test::find(only("VESKA_TimeService").keys, "SystemName")), name);
    }
}

TEST_F(HostName, MayBeEmpty) {
    test::nameHost("");
    test::simulate({});
    EXPECT_EQ(test::text(*test::find(only("VESKA_TimeService").keys, "Name")), "TimeService@");
    EXPECT_EQ(test::text(*test::find(only("VESKA_TimeService").keys, "SystemName")), "");
}

} // namespace
