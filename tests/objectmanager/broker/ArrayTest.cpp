#include "objectmanager/broker/Array.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class ArrayObjectTest : public BrokerFixture {
protected:
    CMPIData element(CMPIArray* from, CMPICount index) { return from->ft->getElementAt(from, index, &rc); }
};

TEST_F(ArrayObjectTest, ANewArrayIsFullOfNulls) {
    CMPIArray* made = array(3, CMPI_uint32);
    EXPECT_EQ(made->ft->getSize(made, &rc), 3U);
    EXPECT_EQ(made->ft->getSimpleType(made, &rc), CMPI_uint32);
    EXPECT_EQ(element(made, 2).type, CMPI_uint32);
    EXPECT_EQ(element(made, 2).state, CMPI_nullValue);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(ArrayObjectTest, AnEmptyArrayIsFine) {
    CMPIArray* made = array(0, CMPI_string);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(made->ft->getSize(made, &rc), 0U);
}

TEST_F(ArrayObjectTest, TheArrayBitOfTheTypeIsIgnored) {
    CMPIArray* made = array(1, CMPI_uint16A);
    EXPECT_EQ(made->ft->getSimpleType(made, &rc), CMPI_uint16);
}

TEST_F(ArrayObjectTest, BadTypesAndHugeSizesAreRefused) {
    EXPECT_EQ(array(1, CMPI_null), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(array(1, CMPI_args), nullptr);
    EXPECT_EQ(array(~0U, CMPI_uint8), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(ArrayObjectTest, AnIndexOutOfRangeIsNoSuchProperty) {
    CMPIArray* made = array(1, CMPI_uint8);
    const CMPIUint8 value = 1;
    EXPECT_EQ(made->ft->setElementAt(made, 1, at(value), CMPI_uint8).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(element(made, 1).state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(ArrayObjectTest, AnElementOfAnotherTypeIsAMismatchAndStaysNull) {
    CMPIArray* made = array(1, CMPI_string);
    EXPECT_EQ(made->ft->setElementAt(made, 0, chars("text"), CMPI_chars).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(element(made, 0).state, CMPI_nullValue);
    CMPIArray* numbers = array(1, CMPI_uint64);
    const CMPIUint32 small = 1;
    EXPECT_EQ(numbers->ft->setElementAt(numbers, 0, at(small), CMPI_uint32).rc, CMPI_RC_ERR_TYPE_MISMATCH);
}

TEST_F(ArrayObjectTest, StringsGoInAndOut) {
    CMPIArray* made = array(2, CMPI_string);
    CMPIString* text = string("text");
    EXPECT_EQ(made->ft->setElementAt(made, 1, at(text), CMPI_string).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(element(made, 1).value.string), "text");
    EXPECT_EQ(made->ft->setElementAt(made, 1, nullptr, CMPI_null).rc, CMPI_RC_OK);
    EXPECT_EQ(element(made, 1).state, CMPI_nullValue);
}

TEST_F(ArrayObjectTest, AnArrayOfCharsTakesCharsAndGivesStrings) {
    CMPIArray* made = array(1, CMPI_chars);
    char buffer[] = "before";
    EXPECT_EQ(made->ft->setElementAt(made, 0, chars(buffer), CMPI_chars).rc, CMPI_RC_OK);
    buffer[0] = 'x';
    EXPECT_EQ(element(made, 0).type, CMPI_string);
    EXPECT_EQ(textOf(element(made, 0).value.string), "before");
    CMPIArgs* container = args();
    EXPECT_EQ(container->ft->addArg(container, "A", at(made), CMPI_charsA).rc, CMPI_RC_OK);
    const CMPIData given = container->ft->getArg(container, "A", &rc);
    EXPECT_EQ(given.type, CMPI_stringA);
    EXPECT_EQ(given.value.array->ft->getSimpleType(given.value.array, &rc), CMPI_string);
}

TEST_F(ArrayObjectTest, ACloneIsDeep) {
    CMPIArray* made = array(1, CMPI_uint8);
    CMPIUint8 value = 1;
    made->ft->setElementAt(made, 0, at(value), CMPI_uint8);
    CMPIArray* copy = made->ft->clone(made, &rc);
    value = 2;
    made->ft->setElementAt(made, 0, at(value), CMPI_uint8);
    EXPECT_EQ(element(copy, 0).value.uint8, 1);
    copy->ft->release(copy);
}

} // namespace
} // namespace om
