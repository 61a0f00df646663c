#include "cmpi/PropertyTable.h"
#include "support/Provider.h"

#include <cmpimacs.h>
#include <gtest/gtest.h>

namespace {

using VK::BaseServerProvider::dateTime;
using VK::BaseServerProvider::Property;
using VK::BaseServerProvider::publish;

/// Supplies a value of every type, and nothing.
struct Sample {
    bool getText(std::string& value) const { return set(value, value + "text"); }
    bool getTime(std::string& value) const { return set(value, "20240101120000.000000+060"); }
    bool getNothing(std::string& value) const { return !set(value, "nothing"); }
    bool getFlag(bool& value) const { return set(value, true); }
    bool getRatio(float& value) const { return set(value, 1.5F); }
    bool getNumber(unsigned int& value) const { return set(value, 4294967295U); }
    bool getSmallNumber(unsigned short& value) const { return set(value, static_cast<unsigned short>(65535)); }
    bool getTexts(std::vector<std::string>& values) const {
        values.emplace_back("text");
        return true;
    }
    bool getNumbers(std::vector<unsigned short>& values) const {
        values.push_back(7);
        return true;
    }

private:
    template <class Value>
    static bool set(Value& value, Value theValue) {
        value = std::move(theValue);
        return true;
    }
    static bool set(std::string& value, const std::string& text) {
        value = text;
        return true;
    }
};

/// The property after its getter was published, in an instance of a class that declares it.
CMPIData published(const char* className, const Property<Sample>& property) {
    const CMPIBroker* const broker = test::provider().broker();
    CMPIInstance* const instance =
        CMNewInstance(broker, CMNewObjectPath(broker, "root/cimv2", className, nullptr), nullptr);
    publish(broker, instance, Sample(), property);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    CMPIData data = CMGetProperty(instance, property.name, &status);
    if (status.rc != CMPI_RC_OK) data = CMPIData{CMPI_null, CMPI_notFound, {}};
    return data;
}

const char* charactersOf(const CMPIString* string) {
    return CMGetCharsPtr(string, nullptr);
}

TEST(PropertyTable, SetsATextAsATextOrAsADateTime) {
    const CMPIData text = published("VESKA_ComputerSystem", {"Description", &Sample::getText});
    ASSERT_EQ(text.type, CMPI_string);
    EXPECT_STREQ(charactersOf(text.value.string), "text");
    const CMPIData time = published("VESKA_ComputerSystem", {"InstallDate", &Sample::getTime, dateTime});
    ASSERT_EQ(time.type, CMPI_dateTime);
    EXPECT_STREQ(charactersOf(CMGetStringFormat(time.value.dateTime, nullptr)), "20240101120000.000000+060");
}

TEST(PropertyTable, LeavesADateTimeOutThatIsNone) {
    EXPECT_EQ(published("VESKA_ComputerSystem", {"InstallDate", &Sample::getText, dateTime}).type, CMPI_null);
}

TEST(PropertyTable, LeavesOutWhatIsNotSupplied) {
    EXPECT_EQ(published("VESKA_ComputerSystem", {"Description", &Sample::getNothing}).type, CMPI_null);
    EXPECT_EQ(published("VESKA_ComputerSystem", {"InstallDate", &Sample::getNothing, dateTime}).type, CMPI_null);
}

TEST(PropertyTable, SetsNumbersAndFlagsOfTheGettersType) {
    const CMPIData flag = published("VESKA_TimeService", {"AutomaticDSTAdjustment", &Sample::getFlag});
    ASSERT_EQ(flag.type, CMPI_boolean);
    EXPECT_EQ(flag.value.boolean, 1);
    const CMPIData ratio = published("VESKA_PhysicalPackage", {"Height", &Sample::getRatio});
    ASSERT_EQ(ratio.type, CMPI_real32);
    EXPECT_EQ(ratio.value.real32, 1.5F);
    const CMPIData number = published("VESKA_CIMServiceConfig", {"deliveryRetryAttempts", &Sample::getNumber});
    ASSERT_EQ(number.type, CMPI_uint32);
    EXPECT_EQ(number.value.uint32, 4294967295U);
    const CMPIData small = published("VESKA_ComputerSystem", {"HealthState", &Sample::getSmallNumber});
    ASSERT_EQ(small.type, CMPI_uint16);
    EXPECT_EQ(small.value.uint16, 65535);
}

TEST(PropertyTable, SetsListsAsArrays) {
    const CMPIData texts = published("VESKA_ComputerSystem", {"StatusDescriptions", &Sample::getTexts});
    ASSERT_EQ(texts.type, CMPI_stringA);
    ASSERT_EQ(CMGetArrayCount(texts.value.array, nullptr), 1U);
    EXPECT_STREQ(charactersOf(CMGetArrayElementAt(texts.value.array, 0, nullptr).value.string), "text");
    const CMPIData numbers = published("VESKA_ComputerSystem", {"OperationalStatus", &Sample::getNumbers});
    ASSERT_EQ(numbers.type, CMPI_uint16A);
    ASSERT_EQ(CMGetArrayCount(numbers.value.array, nullptr), 1U);
    EXPECT_EQ(CMGetArrayElementAt(numbers.value.array, 0, nullptr).value.uint16, 7);
}

} // namespace
