#include "objectmanager/broker/Instance.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class InstanceObjectTest : public BrokerFixture {
protected:
    CMPIInstance* one = instance("VESKA_ComputerSystem");

    CMPIrc set(const char* name, const CMPIValue* value, CMPIType type) {
        return one->ft->setProperty(one, name, value, type).rc;
    }
    CMPIData get(const char* name) { return one->ft->getProperty(one, name, &rc); }
};

TEST_F(InstanceObjectTest, ItStartsWithItsPathAndWithoutProperties) {
    CMPIObjectPath* keyed = path("VESKA_ComputerSystem");
    keyed->ft->addKey(keyed, "Name", chars("x"), CMPI_chars);
    CMPIInstance* made = broker->eft->newInstance(broker, keyed, &rc);
    EXPECT_EQ(made->ft->getPropertyCount(made, &rc), 0U);
    CMPIObjectPath* same = made->ft->getObjectPath(made, &rc);
    EXPECT_EQ(same->ft->getKeyCount(same, &rc), 1U);
}

TEST_F(InstanceObjectTest, NoClassIsRefusedAnUnknownOneIsNot) {
    EXPECT_EQ(instance(""), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_NE(instance("Somebodys_Class"), nullptr);
}

TEST_F(InstanceObjectTest, PropertiesAreFoundInAnyCaseInTheOrderInWhichTheyWereSet) {
    EXPECT_EQ(set("Name", chars("n"), CMPI_chars), CMPI_RC_OK);
    EXPECT_EQ(set("ElementName", chars("e"), CMPI_chars), CMPI_RC_OK);
    EXPECT_EQ(set("NAME", chars("m"), CMPI_chars), CMPI_RC_OK);
    EXPECT_EQ(textOf(get("name").value.string), "m");
    EXPECT_EQ(get("name").state, CMPI_goodValue);
    CMPIString* name = nullptr;
    one->ft->getPropertyAt(one, 0, &name, &rc);
    EXPECT_EQ(textOf(name), "Name");
    EXPECT_EQ(one->ft->getPropertyCount(one, &rc), 2U);
}

TEST_F(InstanceObjectTest, AbsentPropertiesAreNotFound) {
    EXPECT_EQ(get("Name").state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    one->ft->getPropertyAt(one, 0, nullptr, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(InstanceObjectTest, AnotherTypeThanTheSchemasIsRefused) {
    const CMPIUint32 wide = 2;
    const CMPIUint16 right = 2;
    EXPECT_EQ(set("EnabledState", at(wide), CMPI_uint32), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(set("enabledstate", chars("2"), CMPI_chars), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(set("OperationalStatus", at(right), CMPI_uint16), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(set("EnabledState", nullptr, CMPI_uint32), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(one->ft->getPropertyCount(one, &rc), 0U);
    EXPECT_EQ(set("EnabledState", at(right), CMPI_uint16), CMPI_RC_OK);
    EXPECT_EQ(get("EnabledState").value.uint16, 2);
}

TEST_F(InstanceObjectTest, AnUnknownPropertyIsKept) {
    const CMPIUint32 value = 5;
    EXPECT_EQ(set("Unheard", at(value), CMPI_uint32), CMPI_RC_OK);
    EXPECT_EQ(get("Unheard").value.uint32, 5U);
}

TEST_F(InstanceObjectTest, NullsHaveTheTypeOfTheProperty) {
    EXPECT_EQ(set("EnabledState", nullptr, CMPI_uint16), CMPI_RC_OK);
    EXPECT_EQ(get("EnabledState").state, CMPI_nullValue);
    EXPECT_EQ(get("EnabledState").type, CMPI_uint16);
    EXPECT_EQ(set("Name", nullptr, CMPI_null), CMPI_RC_OK);
    EXPECT_EQ(get("Name").type, CMPI_string);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(InstanceObjectTest, TypesThatNoValueHasAreRefused) {
    const CMPIUint64 zero = 0;
    for (const int type : {CMPI_args, CMPI_filter, CMPI_enumeration, CMPI_ptr, CMPI_class}) {
        EXPECT_EQ(set("Any", at(zero), static_cast<CMPIType>(type)), CMPI_RC_ERR_INVALID_DATA_TYPE);
    }
    EXPECT_EQ(set("Any", at(zero), 0x0001), CMPI_RC_ERR_INVALID_DATA_TYPE);
}

TEST_F(InstanceObjectTest, AnObjectOfAnotherKindInAValueIsRefused) {
    CMPIObjectPath* wrong = path("C");
    EXPECT_EQ(set("Any", at(wrong), CMPI_string), CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(set("Any", at(wrong), CMPI_uint8A), CMPI_RC_ERR_INVALID_HANDLE);
    CMPIArray* numbers = array(1, CMPI_uint8);
    EXPECT_EQ(set("Any", at(numbers), CMPI_uint16A), CMPI_RC_ERR_TYPE_MISMATCH);
}

TEST_F(InstanceObjectTest, ThePathTakesMissingKeysFromKeyProperties) {
    set("Name", chars("n"), CMPI_chars);
    set("CreationClassName", chars("VESKA_ComputerSystem"), CMPI_chars);
    set("ElementName", chars("no key"), CMPI_chars);
    CMPIObjectPath* keyed = one->ft->getObjectPath(one, &rc);
    EXPECT_EQ(keyed->ft->getKeyCount(keyed, &rc), 2U);
    EXPECT_EQ(textOf(keyed->ft->getKey(keyed, "Name", &rc).value.string), "n");
}

TEST_F(InstanceObjectTest, TheClassOfANewPathIsTheOneWhoseTypesCount) {
    CMPIObjectPath* other = path("Somebodys_Class");
    EXPECT_EQ(one->ft->setObjectPath(one, other).rc, CMPI_RC_OK);
    const CMPIUint32 wide = 2;
    EXPECT_EQ(set("EnabledState", at(wide), CMPI_uint32), CMPI_RC_OK);
    CMPIObjectPath* same = one->ft->getObjectPath(one, &rc);
    EXPECT_EQ(textOf(same->ft->getClassName(same, &rc)), "Somebodys_Class");
}

TEST_F(InstanceObjectTest, AFilterDropsWhatItDoesNotName) {
    set("ElementName", chars("e"), CMPI_chars);
    const char* properties[] = {"caption", nullptr};
    const char* keys[] = {"Name", nullptr};
    EXPECT_EQ(one->ft->setPropertyFilter(one, properties, keys).rc, CMPI_RC_OK);
    EXPECT_EQ(one->ft->getPropertyCount(one, &rc), 0U);
    EXPECT_EQ(set("ElementName", chars("e"), CMPI_chars), CMPI_RC_OK);
    set("Caption", chars("c"), CMPI_chars);
    set("Name", chars("n"), CMPI_chars);
    EXPECT_EQ(one->ft->getPropertyCount(one, &rc), 2U);
    one->ft->setPropertyFilter(one, nullptr, nullptr);
    set("ElementName", chars("e"), CMPI_chars);
    EXPECT_EQ(one->ft->getPropertyCount(one, &rc), 3U);
}

TEST_F(InstanceObjectTest, ACloneIsDeep) {
    set("Name", chars("before"), CMPI_chars);
    CMPIInstance* copy = one->ft->clone(one, &rc);
    set("Name", chars("after"), CMPI_chars);
    EXPECT_EQ(textOf(copy->ft->getProperty(copy, "Name", &rc).value.string), "before");
    EXPECT_EQ(copy->ft->setPropertyWithOrigin(copy, "Name", chars("own"), CMPI_chars, "CIM_System").rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(get("Name").value.string), "after");
    copy->ft->release(copy);
}

} // namespace
} // namespace om
