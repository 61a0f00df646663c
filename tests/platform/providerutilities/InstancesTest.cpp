#include "vk/ProviderUtilities.h"

#include "platform/providerutilities/FakeBroker.h"
#include "platform/providerutilities/RecordedLog.h"

#include <gmock/gmock.h>
#include <type_traits>

using testing::ElementsAre;
using testing::IsEmpty;
using VK::ProviderUtilities;

namespace {

const std::string refusal = "LOG 6000 Norvane.ProviderUtilities The broker refused the property P, return code ";

class Instances : public testing::Test {
protected:
    Instances() { takeLog(); }

    std::string contents() const { return FakeBroker::contents(instance); }
    bool setText(std::string value, bool dateTime) {
        return ProviderUtilities::setProperty(fake.get(), instance, "P", value, dateTime);
    }
    bool setTexts(std::vector<std::string> values) {
        return ProviderUtilities::setProperty(fake.get(), instance, "P", values);
    }
    bool setNumbers(std::vector<unsigned short> values) {
        return ProviderUtilities::setProperty(fake.get(), instance, "P", values);
    }

    FakeBroker fake;
    CMPIInstance* instance = fake.makeInstance();
};

template <typename Value, typename = void>
constexpr bool isSettable = false;
template <typename Value>
constexpr bool isSettable<Value, std::void_t<decltype(ProviderUtilities::setProperty(
                                     static_cast<CMPIInstance*>(nullptr), "P", std::declval<Value>()))>> = true;

} // namespace

TEST_F(Instances, AreMadeOfAPath) {
    CMPIObjectPath* const path = fake.makePath("root/cimv2", "CIM_System");
    EXPECT_NE(ProviderUtilities::createInstance(fake.get(), path), nullptr);
    EXPECT_EQ(ProviderUtilities::createInstance(fake.get(), nullptr), nullptr);
    EXPECT_EQ(ProviderUtilities::createInstance(nullptr, path), nullptr);
    EXPECT_THAT(takeLog(), IsEmpty());
    fake.refusals = {{"newInstance", CMPI_RC_ERR_NOT_FOUND}};
    EXPECT_EQ(ProviderUtilities::createInstance(fake.get(), path), nullptr);
    EXPECT_THAT(takeLog(), ElementsAre("LOG 6000 Norvane.ProviderUtilities The broker refused an instance of the class "
                                       "CIM_System, return code 6"));
    fake.refusals = {};
    fake.nullAnswers = {"newInstance"};
    EXPECT_EQ(ProviderUtilities::createInstance(fake.get(), path), nullptr);
    EXPECT_THAT(takeLog(), ElementsAre("LOG 6000 Norvane.ProviderUtilities The broker refused an instance of the class "
                                       "CIM_System, return code 1"))
        << "failed, whatever the status says";
    fake.encapsulated.newInstance = nullptr;
    EXPECT_EQ(ProviderUtilities::createInstance(fake.get(), path), nullptr);
}

TEST_F(Instances, RefusedForAPathThatHidesItsClassAreLoggedWithoutOne) {
    CMPIObjectPath* const path = fake.makePath("root/cimv2", "CIM_System");
    fake.refusals = {{"newInstance", CMPI_RC_ERR_NOT_FOUND}};
    fake.pathTable.getClassName = nullptr;
    EXPECT_EQ(ProviderUtilities::createInstance(fake.get(), path), nullptr);
    EXPECT_THAT(takeLog(), ElementsAre("LOG 6000 Norvane.ProviderUtilities The broker refused an instance of the class "
                                       "(null), return code 6"));
}

TEST_F(Instances, TakePropertiesOfTheTypeThatTheValueStandsFor) {
    std::string text = "node7";
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "A", text));
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "B", true));
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "C", false));
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "D", 1.5F));
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "E", 4294967295U));
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "F", static_cast<unsigned short>(65535)));
    EXPECT_TRUE(ProviderUtilities::setProperty(instance, "G", fake.makePath("root/cimv2", "CIM_System")));
    EXPECT_EQ(contents(), "A=string:node7 B=boolean:true C=boolean:false D=real32:1.500000 E=uint32:4294967295 "
                          "F=uint16:65535 G=ref:CIM_System");
    EXPECT_THAT(takeLog(), IsEmpty());
}

TEST_F(Instances, TakeNoPointerForABoolean) {
    static_assert(isSettable<bool> && isSettable<CMPIObjectPath*> && isSettable<std::string&>);
    static_assert(!isSettable<const char*> && !isSettable<const CMPIObjectPath*> && !isSettable<char*>);
}

TEST_F(Instances, TakeTextsAndDateTimes) {
    EXPECT_TRUE(setText("20240101110000.000000+000", true));
    EXPECT_TRUE(setText("20240101110000.000000+000", false));
    EXPECT_EQ(contents(), "P=datetime:20240101110000.000000+000 P=string:20240101110000.000000+000");
}

TEST_F(Instances, LeaveABadDateTimeUnset) {
    EXPECT_FALSE(setText("yesterday", true));
    EXPECT_FALSE(setText("", true));
    EXPECT_EQ(contents(), "");
    EXPECT_THAT(takeLog(), ElementsAre(refusal + "4", refusal + "4"));
    fake.nullAnswers = {"newDateTimeFromChars"};
    EXPECT_FALSE(setText("20240101110000.000000+000", true));
    EXPECT_THAT(takeLog(), ElementsAre(refusal + "1")) << "failed, whatever the status says";
    fake.encapsulated.newDateTimeFromChars = nullptr;
    EXPECT_FALSE(setText("20240101110000.000000+000", true));
    EXPECT_EQ(contents(), "");
}

TEST_F(Instances, TakeArrays) {
    EXPECT_TRUE(setTexts({"a", "", "c"}));
    EXPECT_TRUE(setNumbers({2, 65535}));
    EXPECT_EQ(contents(), "P=strings[string:a,string:,string:c,] P=uint16s[uint16:2,uint16:65535,]");
}

TEST_F(Instances, TakeEmptyArrays) {
    EXPECT_TRUE(setTexts({}));
    EXPECT_TRUE(setNumbers({}));
    EXPECT_EQ(contents(), "P=strings[] P=uint16s[]");
}

TEST_F(Instances, LeaveOutAnArrayOfWhichAnyPartIsRefused) {
    for (const char* slot : {"newArray", "newString", "setElementAt", "setProperty"}) {
        fake.refusals = {{slot, CMPI_RC_ERR_FAILED}};
        EXPECT_FALSE(setTexts({"a", "b"})) << slot;
        EXPECT_THAT(takeLog(), ElementsAre(refusal + "1")) << slot;
    }
    fake.refusals = {};
    for (const char* slot : {"newArray", "newString"}) {
        fake.nullAnswers = {slot};
        EXPECT_FALSE(setTexts({"a"})) << slot;
        EXPECT_EQ(takeLog().size(), 1U) << slot;
    }
    EXPECT_EQ(contents(), "");
}

TEST_F(Instances, LeaveOutAnArrayWhereTheBrokerLacksASlot) {
    fake.arrayTable.setElementAt = nullptr;
    EXPECT_FALSE(setNumbers({1}));
    fake.encapsulated.newString = nullptr;
    EXPECT_FALSE(setTexts({"a"}));
    fake.encapsulated.newArray = nullptr;
    EXPECT_FALSE(setNumbers({}));
    std::vector<unsigned short> numbers;
    EXPECT_FALSE(ProviderUtilities::setProperty(nullptr, instance, "P", numbers));
    EXPECT_EQ(contents(), "");
}

TEST_F(Instances, LeaveOutAndLogAPropertyThatIsRefused) {
    fake.refusals = {{"setProperty", CMPI_RC_ERR_INVALID_DATA_TYPE}};
    EXPECT_FALSE(ProviderUtilities::setProperty(instance, "P", 1U));
    EXPECT_THAT(takeLog(), ElementsAre(refusal + "61"));
    fake.refusals = {};
    EXPECT_FALSE(ProviderUtilities::setProperty(nullptr, "P", 1U));
    EXPECT_FALSE(ProviderUtilities::setProperty(instance, nullptr, 1U));
    EXPECT_FALSE(ProviderUtilities::setProperty(instance, "P", static_cast<CMPIObjectPath*>(nullptr)));
    fake.instanceTable.setProperty = nullptr;
    EXPECT_FALSE(ProviderUtilities::setProperty(instance, "P", true));
    EXPECT_EQ(takeLog().size(), 4U);
    EXPECT_EQ(contents(), "");
}
