#include "vk/ProviderUtilities.h"

#include "platform/providerutilities/FakeBroker.h"
#include "platform/providerutilities/RecordedLog.h"

#include <gmock/gmock.h>

#include <stdexcept>
#include <utility>

using testing::ElementsAre;
using testing::IsEmpty;
using VK::ProviderUtilities;

namespace {

class ObjectPaths : public testing::Test {
protected:
    ObjectPaths() { takeLog(); }

    FakeBroker fake;
    CMPIObjectPath* path = fake.makePath("root/cimv2", "VESKA_ComputerSystem");
};

class Keys : public ObjectPaths {
protected:
    Keys() {
        ProviderUtilities::setKeyProperty(path, "Name", "node7");
        ProviderUtilities::setKeyProperty(path, "System", other);
        CMPIValue number{};
        number.sint64 = 5;
        fake.pathTable.addKey(path, "Number", &number, CMPI_sint64);
        fake.pathTable.addKey(path, "Null", nullptr, CMPI_string);
        CMPIValue none{};
        fake.pathTable.addKey(path, "NullRef", &none, CMPI_ref);
        fake.pathTable.addKey(path, "NullString", &none, CMPI_string);
    }
    /// The text key of that name, or `-`.
    std::string text(const char* name) const {
        std::string value = "-";
        const bool found = ProviderUtilities::getKeyProperty(path, name, value);
        EXPECT_EQ(found, value != "-");
        return value;
    }
    CMPIObjectPath* reference(const char* name) const {
        CMPIObjectPath* value = nullptr;
        const bool found = ProviderUtilities::getKeyProperty(path, name, &value);
        EXPECT_EQ(found, value != nullptr);
        return value;
    }

    CMPIObjectPath* other = fake.makePath("root/cimv2", "CIM_System");
};

} // namespace

TEST_F(ObjectPaths, HaveANamespace) {
    EXPECT_EQ(ProviderUtilities::getNamespace(path), "root/cimv2");
    EXPECT_EQ(ProviderUtilities::getNamespace(fake.makePath("", "C")), "");
    EXPECT_EQ(ProviderUtilities::getNamespace(nullptr), "");
    for (const char* slot : {"getNameSpace", "getCharPtr"}) {
        fake.refusals = {{slot, CMPI_RC_ERR_FAILED}};
        EXPECT_THROW(ProviderUtilities::getNamespace(path), std::runtime_error) << slot;
    }
    fake.refusals = {};
    fake.nullAnswers = {"getNameSpace"};
    EXPECT_EQ(ProviderUtilities::getNamespace(path), "");
    fake.pathTable.getNameSpace = nullptr;
    EXPECT_EQ(ProviderUtilities::getNamespace(path), "");
}

TEST_F(ObjectPaths, AreMadeWithoutKeys) {
    const CMPIObjectPath* const made = ProviderUtilities::createObjectPath(fake.get(), "CIM_System", "root/x");
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(ProviderUtilities::getNamespace(made), "root/x");
    EXPECT_EQ(ProviderUtilities::getKeyCount(made), 0U);
}

TEST_F(ObjectPaths, AreNullWhereTheBrokerMakesNone) {
    const auto make = [this] { return ProviderUtilities::createObjectPath(fake.get(), "CIM_System", "root/x"); };
    EXPECT_EQ(ProviderUtilities::createObjectPath(nullptr, "CIM_System", "root/x"), nullptr);
    EXPECT_EQ(ProviderUtilities::createObjectPath(fake.get(), nullptr, "root/x"), nullptr);
    fake.refusals = {{"newObjectPath", CMPI_RC_ERR_FAILED}};
    EXPECT_EQ(make(), nullptr);
    EXPECT_THAT(takeLog(), ElementsAre("LOG 6000 Norvane.ProviderUtilities The broker refused a path of the class "
                                       "CIM_System, return code 1"));
    fake.refusals = {};
    fake.nullAnswers = {"newObjectPath"};
    EXPECT_EQ(make(), nullptr);
    EXPECT_THAT(takeLog(), ElementsAre("LOG 6000 Norvane.ProviderUtilities The broker refused a path of the class "
                                       "CIM_System, return code 1"))
        << "failed, whatever the status says";
    fake.nullAnswers = {};
    fake.writesStatus = false;
    EXPECT_NE(make(), nullptr);
    EXPECT_THAT(takeLog(), IsEmpty());
    fake.encapsulated.newObjectPath = nullptr;
    EXPECT_EQ(make(), nullptr);
    fake.broker.eft = nullptr;
    EXPECT_EQ(make(), nullptr);
}

TEST_F(Keys, AreCounted) {
    EXPECT_EQ(ProviderUtilities::getKeyCount(path), 6U);
    EXPECT_EQ(ProviderUtilities::getKeyCount(nullptr), 0U);
    fake.refusals = {{"getKeyCount", CMPI_RC_ERR_FAILED}};
    EXPECT_THROW(ProviderUtilities::getKeyCount(path), std::runtime_error)
        << "not a path without keys, which means all";
    fake.pathTable.getKeyCount = nullptr;
    EXPECT_THROW(ProviderUtilities::getKeyCount(path), std::runtime_error) << "nor where it cannot be asked";
}

TEST_F(Keys, AreReadAsTextOrReference) {
    EXPECT_EQ(text("Name"), "node7");
    EXPECT_EQ(reference("System"), other);
    fake.writesStatus = false;
    EXPECT_EQ(text("Name"), "node7");
}

TEST_F(Keys, AreFoundWithoutRegardToCase) {
    for (const bool byCase : {false, true}) {
        fake.namesByCase = byCase;
        EXPECT_EQ(text("NAME"), "node7");
        EXPECT_EQ(reference("system"), other);
    }
}

TEST_F(Keys, OfAnotherKindAreAbsent) {
    for (const char* name : {"System", "Number", "Null", "NullString", "None", ""}) EXPECT_EQ(text(name), "-") << name;
    for (const char* name : {"Name", "Number", "Null", "NullRef", "None", ""})
        EXPECT_EQ(reference(name), nullptr) << name;
    EXPECT_EQ(text(nullptr), "-");
    EXPECT_EQ(reference(nullptr), nullptr);
    EXPECT_FALSE(ProviderUtilities::getKeyProperty(path, "System", static_cast<CMPIObjectPath**>(nullptr)));
    std::string value = "untouched";
    EXPECT_FALSE(ProviderUtilities::getKeyProperty(nullptr, "Name", value));
    EXPECT_EQ(value, "untouched");
}

TEST_F(Keys, AreFoundAmongAllWhereTheBrokerFindsNone) {
    fake.refusals = {{"getKey", CMPI_RC_ERR_NOT_FOUND}};
    EXPECT_EQ(text("name"), "node7");
    fake.pathTable.getKey = nullptr;
    EXPECT_EQ(text("name"), "node7");
}

TEST_F(Keys, AreAbsentWhereTheOneWayOfAskingFindsNone) {
    for (const bool countable : {true, false}) {
        const auto at = fake.pathTable.getKeyAt;
        const auto count = fake.pathTable.getKeyCount;
        if (countable)
            fake.pathTable.getKeyAt = nullptr;
        else
            fake.pathTable.getKeyCount = nullptr;
        EXPECT_EQ(text("Name"), "node7");
        EXPECT_EQ(text("None"), "-");
        fake.pathTable.getKeyAt = at;
        fake.pathTable.getKeyCount = count;
    }
}

TEST_F(Keys, AreNotTakenForAbsentWhereNoWayOfAskingIsLeft) {
    fake.refusals = {{"getKey", CMPI_RC_ERR_FAILED}};
    fake.pathTable.getKeyAt = nullptr;
    EXPECT_THROW(text("Name"), std::runtime_error);
    EXPECT_THROW(reference("System"), std::runtime_error);
    fake.pathTable.getKey = nullptr;
    EXPECT_THROW(text("Name"), std::runtime_error);
}

TEST_F(Keys, AreNotTakenForAbsentWhereTheBrokerCannotTellThem) {
    fake.refusals = {{"getKey", CMPI_RC_ERR_FAILED}};
    EXPECT_EQ(text("Name"), "node7") << "found among all";
    EXPECT_EQ(text("None"), "-");
    fake.refusals = {{"getKey", CMPI_RC_ERR_FAILED}, {"getKeyAt", CMPI_RC_ERR_FAILED}};
    EXPECT_THROW(text("Name"), std::runtime_error);
    EXPECT_THROW(reference("System"), std::runtime_error);
    fake.refusals = {{"getKey", CMPI_RC_ERR_FAILED}, {"getKeyCount", CMPI_RC_ERR_FAILED}};
    EXPECT_THROW(text("Name"), std::runtime_error);
    fake.refusals = {{"getKey", CMPI_RC_ERR_FAILED}};
    const auto counting = std::exchange(fake.pathTable.getKeyCount, nullptr);
    EXPECT_THROW(text("Name"), std::runtime_error) << "nobody knows among how many to look";
    fake.pathTable.getKeyCount = counting;
    fake.refusals = {{"getCharPtr", CMPI_RC_ERR_FAILED}};
    EXPECT_THROW(text("Name"), std::runtime_error);
    EXPECT_THROW(text("None"), std::runtime_error) << "its name could be any of those that cannot be read";
}

TEST_F(ObjectPaths, TakeTextAndReferenceKeys) {
    EXPECT_TRUE(ProviderUtilities::setKeyProperty(path, "Name", "node7"));
    EXPECT_TRUE(ProviderUtilities::setKeyProperty(path, "Empty", ""));
    EXPECT_TRUE(ProviderUtilities::setKeyProperty(path, "System", fake.makePath("root/cimv2", "CIM_System")));
    EXPECT_EQ(FakeBroker::contents(path), "Name=string:node7 Empty=string: System=ref:CIM_System");
    EXPECT_THAT(takeLog(), IsEmpty());
}

TEST_F(ObjectPaths, LeaveOutAndLogAKeyThatIsRefused) {
    fake.refusals = {{"addKey", CMPI_RC_ERR_TYPE_MISMATCH}};
    EXPECT_FALSE(ProviderUtilities::setKeyProperty(path, "Name", "node7"));
    EXPECT_EQ(FakeBroker::contents(path), "");
    EXPECT_THAT(takeLog(),
                ElementsAre("LOG 6000 Norvane.ProviderUtilities The broker refused the key Name, return code 13"));
    fake.pathTable.addKey = nullptr;
    EXPECT_FALSE(ProviderUtilities::setKeyProperty(path, "Name", "node7"));
    EXPECT_FALSE(ProviderUtilities::setKeyProperty(nullptr, "Name", "node7"));
    EXPECT_FALSE(ProviderUtilities::setKeyProperty(path, nullptr, "node7"));
    EXPECT_FALSE(ProviderUtilities::setKeyProperty(path, "System", static_cast<CMPIObjectPath*>(nullptr)));
    EXPECT_EQ(takeLog().size(), 4U);
}
