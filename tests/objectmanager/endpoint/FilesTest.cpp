#include "objectmanager/endpoint/Files.h"

#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <fstream>

namespace endpoint {
namespace {

using testing::ElementsAre;

class Files : public testing::Test {
protected:
    std::string file(const std::string& name, const std::string& content) const {
        std::ofstream(directory.path(name)) << content;
        return directory.path(name);
    }

    static std::string problem(const std::vector<std::string>& files) {
        try {
            SchemaFiles read(files);
        } catch (const std::invalid_argument& error) {
            return error.what();
        }
        return {};
    }

    support::TemporaryDirectory directory;
};

TEST_F(Files, WithoutAnyTheClassesAreThoseBuiltIn) {
    EXPECT_EQ(&SchemaFiles({}).schema(), &om::Schema::builtin());
}

TEST_F(Files, StandBehindTheStandardsClasses) {
    const SchemaFiles read(
        {file("a", "class ACME_Disk : CIM_LogicalElement { [Key] string Id; };"),
         file("b", "[Association] class ACME_Holds { [Key] CIM_System REF Holder; [Key] ACME_Disk REF "
                   "Held; };")});
    EXPECT_THAT(read.schema().served(), ElementsAre("ACME_Disk", "ACME_Holds"));
    EXPECT_TRUE(read.schema().isA("ACME_Disk", "CIM_ManagedElement"));
    EXPECT_EQ(read.schema().find("VESKA_ComputerSystem"), nullptr);
}

TEST_F(Files, BringTheStandardsClassesThemselvesWhereTheyHaveOne) {
    const SchemaFiles read({file("a", "class CIM_ManagedElement { string Caption; };"),
                            file("b", "class ACME_Disk : CIM_ManagedElement { [Key] string Id; };")});
    EXPECT_EQ(read.schema().classes().size(), 2U);
}

TEST_F(Files, MayRepeatAClassOfTheBuiltInProvider) {
    const SchemaFiles read({file("a", "class VESKA_ComputerSystem : CIM_ComputerSystem { uint8 Own; };")});
    EXPECT_NE(read.schema().findProperty("VESKA_ComputerSystem", "Own"), nullptr);
}

TEST_F(Files, AreRefusedWithAllThatIsWrong) {
    const std::string bad = file("bad", "[Colour] class ACME_A {};\nclass ACME_B : ACME_Gone {};");
    EXPECT_EQ(problem({bad}), bad + ":1: unknown qualifier Colour on ACME_A; " + bad +
                                  ":2: superclass ACME_Gone of ACME_B is not declared");
    EXPECT_EQ(problem({file("open", "class")}),
              directory.path("open") + ":1: expected a class name, found the file's end");
    EXPECT_EQ(problem({directory.path("gone")}), "cannot read " + directory.path("gone"));
    EXPECT_EQ(problem({file("empty", "")}), "cannot read " + directory.path("empty"));
}

} // namespace
} // namespace endpoint
