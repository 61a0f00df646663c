#include "objectmanager/broker/Convert.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

#include <cmath>
#include <limits>

namespace om {
namespace {

class ConvertTest : public BrokerFixture {
protected:
    /// A value that ends at the end of its own memory, so that reading more than its bytes is found by a sanitizer.
    template <class T>
    CMPIData roundTrip(T value, CMPIType type) {
        const auto exact = std::make_unique<T>(value);
        CMPIArgs* container = args();
        EXPECT_EQ(container->ft->addArg(container, "A", at(*exact), type).rc, CMPI_RC_OK);
        return container->ft->getArg(container, "A", &rc);
    }
};

TEST_F(ConvertTest, ScalarsAreReadByTheirOwnWidth) {
    EXPECT_EQ(roundTrip<CMPIUint8>(255, CMPI_uint8).value.uint8, 255);
    EXPECT_EQ(roundTrip<CMPIUint16>(65535, CMPI_uint16).value.uint16, 65535);
    EXPECT_EQ(roundTrip<CMPIChar16>(0x20AC, CMPI_char16).value.char16, 0x20AC);
    EXPECT_EQ(roundTrip<CMPIUint32>(4294967295U, CMPI_uint32).value.uint32, 4294967295U);
    EXPECT_EQ(roundTrip<CMPIUint64>(~0ULL, CMPI_uint64).value.uint64, ~0ULL);
    EXPECT_EQ(roundTrip<CMPISint8>(-128, CMPI_sint8).value.sint8, -128);
    EXPECT_EQ(roundTrip<CMPISint16>(-32768, CMPI_sint16).value.sint16, -32768);
    EXPECT_EQ(roundTrip<CMPISint32>(INT32_MIN, CMPI_sint32).value.sint32, INT32_MIN);
    EXPECT_EQ(roundTrip<CMPISint64>(INT64_MIN, CMPI_sint64).value.sint64, INT64_MIN);
    EXPECT_EQ(roundTrip<CMPIBoolean>(2, CMPI_boolean).value.boolean, 1);
    EXPECT_EQ(roundTrip<CMPIReal32>(0.1F, CMPI_real32).value.real32, 0.1F);
    EXPECT_EQ(roundTrip<CMPIReal64>(0.1, CMPI_real64).value.real64, 0.1);
    EXPECT_TRUE(std::isnan(roundTrip(std::numeric_limits<float>::quiet_NaN(), CMPI_real32).value.real32));
}

TEST_F(ConvertTest, TextsComeBackAsStrings) {
    CMPIArgs* container = args();
    const char* pointer = "by pointer";
    CMPIString* object = string("object");
    container->ft->addArg(container, "Chars", chars("itself"), CMPI_chars);
    container->ft->addArg(container, "CharsPtr", at(pointer), CMPI_charsptr);
    container->ft->addArg(container, "String", at(object), CMPI_string);
    const char* expected[] = {"itself", "by pointer", "object"};
    for (CMPICount i = 0; i < 3; ++i) {
        const CMPIData data = container->ft->getArgAt(container, i, nullptr, &rc);
        EXPECT_EQ(data.type, CMPI_string);
        EXPECT_EQ(textOf(data.value.string), expected[i]);
    }
}

TEST_F(ConvertTest, NullObjectsAreTypedNulls) {
    const void* none = nullptr;
    for (const int code : {CMPI_string, CMPI_charsptr, CMPI_dateTime, CMPI_ref, CMPI_instance, CMPI_stringA}) {
        const auto type = static_cast<CMPIType>(code);
        const CMPIData data = roundTrip(none, type);
        EXPECT_EQ(data.state, CMPI_nullValue);
        EXPECT_EQ(data.type, storedType(type));
    }
}

TEST_F(ConvertTest, AnObjectThatWasReleasedIsRefused) {
    CMPIString* gone = string("x");
    gone->ft->release(gone);
    CMPIArgs* container = args();
    EXPECT_EQ(container->ft->addArg(container, "A", at(gone), CMPI_string).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(container->ft->getArgCount(container, &rc), 0U);
}

TEST_F(ConvertTest, EmbeddedInstancesKeepTheirProperties) {
    CMPIInstance* inner = instance("C");
    inner->ft->setProperty(inner, "P", chars("v"), CMPI_chars);
    const CMPIData data = roundTrip(inner, CMPI_instance);
    ASSERT_EQ(data.type, CMPI_instance);
    EXPECT_EQ(textOf(data.value.inst->ft->getProperty(data.value.inst, "P", &rc).value.string), "v");
}

} // namespace
} // namespace om
