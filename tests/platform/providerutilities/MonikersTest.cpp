#include "vk/ProviderUtilities.h"

#include "platform/providerutilities/FakeBroker.h"
#include "platform/providerutilities/RecordedLog.h"

#include <gmock/gmock.h>

using VK::Moniker;
using VK::ProviderUtilities;

namespace {

class Monikers : public testing::Test {
protected:
    Monikers() { takeLog(); }

    void addKey(const char* name, CMPIType type, const CMPIValue& value) {
        fake.pathTable.addKey(path, name, &value, type);
    }
    template <typename Member, typename Number>
    void addNumber(const char* name, CMPIType type, Member CMPIValue::*member, Number number) {
        CMPIValue value{};
        value.*member = static_cast<Member>(number);
        addKey(name, type, value);
    }
    /// The path's moniker as text.
    std::string moniker(bool expected = true) {
        Moniker result;
        EXPECT_EQ(ProviderUtilities::transformObjectPathToMoniker(path, result), expected);
        std::string text;
        std::string name;
        std::string value;
        for (unsigned int i = 0; i < result.getKeyCount(); ++i) {
            result.selectKey(i);
            result.getName(name);
            result.getValue(value);
            text += (i == 0 ? "" : " ") + name + "=" + value;
        }
        return text;
    }

    FakeBroker fake;
    CMPIObjectPath* path = fake.makePath("root/cimv2", "VESKA_ComputerSystem");
};

} // namespace

TEST_F(Monikers, TakeTextsAsTheyAreAndNumbersAsText) {
    ProviderUtilities::setKeyProperty(path, "Name", "node7");
    addNumber("U8", CMPI_uint8, &CMPIValue::uint8, 255);
    addNumber("U16", CMPI_uint16, &CMPIValue::uint16, 65535);
    addNumber("U32", CMPI_uint32, &CMPIValue::uint32, 4294967295U);
    addNumber("U64", CMPI_uint64, &CMPIValue::uint64, 18446744073709551615ULL);
    addNumber("S8", CMPI_sint8, &CMPIValue::sint8, -128);
    addNumber("S16", CMPI_sint16, &CMPIValue::sint16, -32768);
    addNumber("S32", CMPI_sint32, &CMPIValue::sint32, -2147483647);
    addNumber("S64", CMPI_sint64, &CMPIValue::sint64, -9223372036854775807LL);
    addNumber("Yes", CMPI_boolean, &CMPIValue::boolean, 1);
    addNumber("No", CMPI_boolean, &CMPIValue::boolean, 0);
    EXPECT_EQ(moniker(), "Name=node7 U8=255 U16=65535 U32=4294967295 U64=18446744073709551615 S8=-128 S16=-32768 "
                         "S32=-2147483647 S64=-9223372036854775807 Yes=TRUE No=FALSE");
}

TEST_F(Monikers, LeaveOutReferencesAndNulls) {
    ProviderUtilities::setKeyProperty(path, "System", fake.makePath("root/cimv2", "CIM_System"));
    fake.pathTable.addKey(path, "Null", nullptr, CMPI_string);
    addNumber("Real", CMPI_real64, &CMPIValue::real64, 1.5);
    ProviderUtilities::setKeyProperty(path, "Name", "node7");
    EXPECT_EQ(moniker(), "Name=node7");
}

TEST_F(Monikers, OfAClassPathAreEmpty) {
    EXPECT_EQ(moniker(), "");
}

TEST_F(Monikers, PassOverKeysThatABrokerCountsButDoesNotHave) {
    ProviderUtilities::setKeyProperty(path, "", "counted"); // the fake answers 12 for it
    ProviderUtilities::setKeyProperty(path, "Name", "node7");
    EXPECT_EQ(moniker(), "Name=node7");
}

TEST_F(Monikers, AreNotMadeWhereTheBrokerDoesNotTellTheKeys) {
    ProviderUtilities::setKeyProperty(path, "Name", "node7");
    for (const char* slot : {"getKeyCount", "getKeyAt", "getCharPtr"}) {
        fake.refusals = {{slot, CMPI_RC_ERR_FAILED}};
        EXPECT_EQ(moniker(false), "") << slot;
    }
    fake.refusals = {};
    fake.writesStatus = false;
    EXPECT_EQ(moniker(), "Name=node7");
    fake.pathTable.getKeyAt = nullptr;
    EXPECT_EQ(moniker(false), "");
    Moniker result;
    EXPECT_FALSE(ProviderUtilities::transformObjectPathToMoniker(nullptr, result));
}

TEST_F(Monikers, AreAppendedTo) {
    ProviderUtilities::setKeyProperty(path, "Name", "node7");
    Moniker result;
    result.addKey("First", "1");
    EXPECT_TRUE(ProviderUtilities::transformObjectPathToMoniker(path, result));
    EXPECT_EQ(result.getKeyCount(), 2U);
}

TEST_F(Monikers, BecomeTextKeysInOrder) {
    Moniker moniker;
    moniker.addKey("Name", "node7");
    moniker.addKey("Tag", "");
    moniker.selectKey(1);
    EXPECT_TRUE(ProviderUtilities::transformMonikerToObjectPath(moniker, &path));
    EXPECT_EQ(FakeBroker::contents(path), "Name=string:node7 Tag=string:");
    std::string name;
    EXPECT_TRUE(moniker.getName(name));
    EXPECT_EQ(name, "Name");
}

TEST_F(Monikers, WithoutPairsStandOnTheirFirstPairOnceItComes) {
    Moniker moniker;
    EXPECT_TRUE(ProviderUtilities::transformMonikerToObjectPath(moniker, &path));
    moniker.addKey("Name", "node7");
    std::string name;
    EXPECT_TRUE(moniker.getName(name));
    EXPECT_EQ(name, "Name");
}

TEST_F(Monikers, SayWhenAKeyWasRefused) {
    Moniker moniker;
    EXPECT_TRUE(ProviderUtilities::transformMonikerToObjectPath(moniker, &path));
    moniker.addKey("Name", "node7");
    moniker.addKey("Tag", "1");
    fake.refusals = {{"addKey", CMPI_RC_ERR_FAILED}};
    EXPECT_FALSE(ProviderUtilities::transformMonikerToObjectPath(moniker, &path));
    EXPECT_EQ(takeLog().size(), 2U);
    CMPIObjectPath* none = nullptr;
    EXPECT_FALSE(ProviderUtilities::transformMonikerToObjectPath(moniker, &none));
    EXPECT_FALSE(ProviderUtilities::transformMonikerToObjectPath(moniker, nullptr));
}
