#include "vk/ProviderUtilities.h"

#include "platform/providerutilities/FakeBroker.h"
#include "platform/providerutilities/RecordedLog.h"

#include <gmock/gmock.h>

using testing::ElementsAre;
using testing::IsEmpty;
using VK::ProviderUtilities;

namespace {

class Properties : public testing::Test {
protected:
    Properties() {
        add("Yes", CMPI_boolean, &CMPIValue::boolean, 1);
        add("No", CMPI_boolean, &CMPIValue::boolean, 0);
        add("U8", CMPI_uint8, &CMPIValue::uint8, 7);
        add("U16", CMPI_uint16, &CMPIValue::uint16, 65535);
        add("U32", CMPI_uint32, &CMPIValue::uint32, 4294967295U);
        add("U64", CMPI_uint64, &CMPIValue::uint64, 5);
        add("S32", CMPI_sint32, &CMPIValue::sint32, 5);
        fake.put(entries(instance), "Null", nullptr, CMPI_uint16);
        fake.put(entries(arguments), "Null", nullptr, CMPI_uint32);
        takeLog();
    }
    ~Properties() override { EXPECT_THAT(takeLog(), IsEmpty()) << "where nothing failed"; }

    template <typename Object>
    static std::vector<FakeBroker::Entry>& entries(const Object* object) {
        using Fake = std::conditional_t<std::is_same_v<Object, CMPIInstance>, FakeBroker::Instance, FakeBroker::Args>;
        return static_cast<Fake*>(object->hdl)->entries;
    }

    template <typename Member, typename Number>
    void add(const char* name, CMPIType type, Member CMPIValue::*member, Number number) {
        CMPIValue value{};
        value.*member = static_cast<Member>(number);
        fake.put(entries(instance), name, &value, type);
        fake.put(entries(arguments), name, &value, type);
    }

    /// The value as a number; -1 where there is none, and it must be untouched then.
    template <typename Value, typename Object>
    static long get(const Object* object, const char* name, Value untouched) {
        Value value = untouched;
        const bool found = ProviderUtilities::getProperty(object, name, value);
        EXPECT_TRUE(found || value == untouched) << (name != nullptr ? name : "(null)");
        return found ? static_cast<long>(value) : -1;
    }
    template <typename Object>
    static long getBool(const Object* object, const char* name) {
        EXPECT_EQ(get(object, name, true), get(object, name, false));
        return get(object, name, true);
    }
    long getUint16(const char* name) const { return get<unsigned short>(instance, name, 9); }
    long getUint32(const char* name) const { return get<unsigned int>(arguments, name, 9); }

    FakeBroker fake;
    CMPIInstance* instance = fake.makeInstance();
    CMPIArgs* arguments = fake.makeArgs();
};

} // namespace

TEST_F(Properties, AreReadByTheirType) {
    EXPECT_EQ(getBool(instance, "Yes"), 1);
    EXPECT_EQ(getBool(instance, "No"), 0);
    EXPECT_EQ(getBool(arguments, "Yes"), 1);
    EXPECT_EQ(getBool(arguments, "No"), 0);
    EXPECT_EQ(getUint16("U16"), 65535);
    EXPECT_EQ(getUint32("U32"), 4294967295);
}

TEST_F(Properties, OfAnotherTypeAreAbsent) {
    for (const char* name : {"U8", "U16", "U32", "S32", "Null", "None"}) {
        EXPECT_EQ(getBool(instance, name), -1) << name;
        EXPECT_EQ(getBool(arguments, name), -1) << name;
    }
    for (const char* name : {"Yes", "U8", "U32", "U64", "S32", "Null", "None"}) EXPECT_EQ(getUint16(name), -1) << name;
    for (const char* name : {"Yes", "U8", "U16", "U64", "S32", "Null", "None"}) EXPECT_EQ(getUint32(name), -1) << name;
}

TEST_F(Properties, AreAbsentWhereTheBrokerFails) {
    fake.refusals = {{"getProperty", CMPI_RC_ERR_FAILED}, {"getArg", CMPI_RC_ERR_FAILED}};
    const std::string failure = "LOG 6000 Norvane.ProviderUtilities The broker could not tell a value that a request "
                                "brings, return code 1";
    EXPECT_EQ(getUint16("U16"), -1);
    EXPECT_THAT(takeLog(), ElementsAre(failure));
    EXPECT_EQ(getUint32("U32"), -1);
    EXPECT_THAT(takeLog(), ElementsAre(failure));
    for (const CMPIrc absence : {CMPI_RC_ERR_NO_SUCH_PROPERTY, CMPI_RC_ERR_NOT_FOUND}) {
        fake.refusals = {{"getProperty", absence}};
        EXPECT_EQ(getUint16("U16"), -1);
        EXPECT_THAT(takeLog(), IsEmpty());
    }
    fake.refusals = {};
    fake.writesStatus = false;
    EXPECT_EQ(getUint16("U16"), 65535);
    EXPECT_EQ(getUint32("U32"), 4294967295);
    fake.instanceTable.getProperty = nullptr;
    fake.argsTable.getArg = nullptr;
    EXPECT_EQ(getUint16("U16"), -1);
    EXPECT_EQ(getUint32("U32"), -1);
}

TEST_F(Properties, OfNothingAreAbsent) {
    EXPECT_EQ(getBool(static_cast<const CMPIInstance*>(nullptr), "Yes"), -1);
    EXPECT_EQ(getBool(static_cast<const CMPIArgs*>(nullptr), "Yes"), -1);
    EXPECT_EQ(getUint16(nullptr), -1);
    EXPECT_EQ(getUint32(nullptr), -1);
}

TEST_F(Properties, InABadStateAreAbsent) {
    for (const int state : {CMPI_nullValue, CMPI_notFound, CMPI_badValue}) {
        entries(instance).at(3).data.state = static_cast<CMPIValueState>(state);
        EXPECT_EQ(getUint16("U16"), -1) << state;
    }
    entries(instance).at(3).data.state = CMPI_keyValue;
    EXPECT_EQ(getUint16("U16"), 65535);
}
