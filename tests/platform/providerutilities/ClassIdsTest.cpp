#include "vk/ProviderUtilities.h"

#include "platform/providerutilities/FakeBroker.h"
#include "platform/providerutilities/RecordedLog.h"

#include <gmock/gmock.h>

using testing::ElementsAre;
using testing::IsEmpty;
using VK::ProviderUtilities;

namespace {

constexpr unsigned short unknown = ProviderUtilities::CLASS_ID_UNKNOWN;
const std::string noClass = "LOG 6000 Norvane.ProviderUtilities The broker could not tell ";

class ClassIds : public testing::Test {
protected:
    ClassIds() { takeLog(); }
    ~ClassIds() override { EXPECT_THAT(takeLog(), IsEmpty()); }

    unsigned short idOf(const std::string& name) {
        const unsigned short id = ProviderUtilities::getClassId(name.c_str());
        EXPECT_EQ(ProviderUtilities::getClassId(fake.makePath("root/cimv2", name)), id);
        return id;
    }

    FakeBroker fake;
};

class ClassRelations : public testing::Test {
protected:
    ClassRelations() {
        fake.base = {{"CIM_ElementCapabilities", ""},
                     {"VESKA_ComputerCapabilities", "CIM_ElementCapabilities"},
                     {"VESKA_Special", "VESKA_ComputerCapabilities"},
                     {"CIM_System", ""}};
        takeLog();
    }
    ~ClassRelations() override { EXPECT_THAT(takeLog(), IsEmpty()); }

    bool related(const char* one, const char* other) {
        return ProviderUtilities::areClassesRelated(fake.get(), "root/cimv2", one, other);
    }

    FakeBroker fake;
};

} // namespace

TEST_F(ClassIds, AreThoseOfTheEightClasses) {
    EXPECT_EQ(idOf("VESKA_ComputerSystem"), 1);
    EXPECT_EQ(idOf("VESKA_PhysicalPackage"), 22);
    EXPECT_EQ(idOf("VESKA_EnabledLogicalElementCapabilities"), 23);
    EXPECT_EQ(idOf("VESKA_ComputerSystemPackage"), 24);
    EXPECT_EQ(idOf("VESKA_ComputerCapabilities"), 33);
    EXPECT_EQ(idOf("VESKA_TimeService"), 161);
    EXPECT_EQ(idOf("VESKA_TimeServiceAffectsElement"), 162);
    EXPECT_EQ(idOf("VESKA_CIMServiceConfig"), 185);
}

TEST_F(ClassIds, DoNotDependOnCase) {
    EXPECT_EQ(idOf("veska_computersystem"), 1);
    EXPECT_EQ(idOf("VESKA_CIMSERVICECONFIG"), 185);
}

TEST_F(ClassIds, AreUnknownForEveryOtherName) {
    for (const char* name : {"", "CIM_ComputerSystem", "CIM_ElementCapabilities", "VESKA_ComputerSystem ",
                             "VESKA_ComputerSyste", "VESKA_ComputerSystemPackages", "ComputerSystem"})
        EXPECT_EQ(idOf(name), unknown) << name;
}

TEST_F(ClassIds, AreUnknownWithoutAName) {
    EXPECT_EQ(ProviderUtilities::getClassId(static_cast<const char*>(nullptr)), unknown);
    EXPECT_EQ(ProviderUtilities::getClassId(static_cast<const CMPIObjectPath*>(nullptr)), unknown);
}

TEST_F(ClassIds, AreUnknownWhereTheBrokerDoesNotTellTheName) {
    const CMPIObjectPath* const path = fake.makePath("root/cimv2", "VESKA_ComputerSystem");
    for (const char* const slot : {"getClassName", "getCharPtr"}) {
        for (const CMPIrc code : {CMPI_RC_ERR_FAILED, CMPI_RC_ERR_NOT_FOUND}) {
            fake.refusals = {{slot, code}};
            EXPECT_EQ(ProviderUtilities::getClassId(path), unknown);
            EXPECT_THAT(takeLog(), ElementsAre(noClass + "the class of a path, return code 1")) << slot << code;
        }
    }
    fake.refusals = {};
    fake.nullAnswers = {"getClassName"};
    EXPECT_EQ(ProviderUtilities::getClassId(path), unknown);
    EXPECT_THAT(takeLog(), ElementsAre(noClass + "the class of a path, return code 1"));
    fake.nullAnswers = {};
    fake.writesStatus = false;
    EXPECT_EQ(ProviderUtilities::getClassId(path), 1);
    fake.pathTable.getClassName = nullptr;
    EXPECT_EQ(ProviderUtilities::getClassId(path), unknown);
    const CMPIObjectPath withoutTable{nullptr, nullptr};
    EXPECT_EQ(ProviderUtilities::getClassId(&withoutTable), unknown);
}

TEST_F(ClassRelations, HoldOnOneLineOfInheritanceInBothDirections) {
    EXPECT_TRUE(related("VESKA_ComputerCapabilities", "VESKA_ComputerCapabilities"));
    EXPECT_TRUE(related("VESKA_ComputerCapabilities", "CIM_ElementCapabilities"));
    EXPECT_TRUE(related("CIM_ElementCapabilities", "VESKA_ComputerCapabilities"));
    EXPECT_TRUE(related("VESKA_Special", "CIM_ElementCapabilities"));
    EXPECT_TRUE(related("CIM_ElementCapabilities", "VESKA_Special"));
    EXPECT_FALSE(related("CIM_ElementCapabilities", "CIM_System"));
    EXPECT_FALSE(related("VESKA_Special", "CIM_System"));
}

TEST_F(ClassRelations, DoNotHoldForUnknownClasses) {
    EXPECT_FALSE(related("No_Such", "No_Such"));
    EXPECT_FALSE(related("No_Such", "CIM_System"));
    EXPECT_FALSE(related("CIM_System", "No_Such"));
}

TEST_F(ClassRelations, AreNotAskedForWithoutNames) {
    for (const char* none : {static_cast<const char*>(nullptr), ""}) {
        EXPECT_FALSE(related(none, "CIM_System"));
        EXPECT_FALSE(related("CIM_System", none));
    }
    EXPECT_EQ(fake.classQuestions, 0);
}

TEST_F(ClassRelations, DoNotHoldWhereTheBrokerDoesNotAnswer) {
    const char* const name = "CIM_System";
    EXPECT_FALSE(ProviderUtilities::areClassesRelated(nullptr, "root/cimv2", name, name));
    fake.refusals = {{"classPathIsA", CMPI_RC_ERR_FAILED}};
    EXPECT_FALSE(related(name, name));
    const std::string failure = noClass + "whether a class is derived from another, return code 1";
    EXPECT_THAT(takeLog(), ElementsAre(failure, failure)) << "one for each direction";
    for (const CMPIrc absent : {CMPI_RC_ERR_NOT_FOUND, CMPI_RC_ERR_INVALID_CLASS}) {
        fake.refusals = {{"classPathIsA", absent}};
        EXPECT_FALSE(related(name, name));
        EXPECT_THAT(takeLog(), IsEmpty()) << "a class that is not there is related to none";
    }
    fake.refusals = {{"newObjectPath", CMPI_RC_ERR_INVALID_NAMESPACE}};
    EXPECT_FALSE(related(name, name));
    fake.refusals = {};
    fake.nullAnswers = {"newObjectPath"};
    EXPECT_FALSE(related(name, name));
    EXPECT_EQ(takeLog().size(), 4U) << "one for each path that was refused";
    fake.nullAnswers = {};
    EXPECT_TRUE(related(name, name));
    fake.encapsulated.classPathIsA = nullptr;
    EXPECT_FALSE(related(name, name));
}
