#include "objectmanager/broker/ObjectPath.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class PathObjectTest : public BrokerFixture {
protected:
    CMPIObjectPath* one = path("VESKA_ComputerSystem");
};

TEST_F(PathObjectTest, ANewPathHasNamespaceAndClassOnly) {
    EXPECT_EQ(textOf(one->ft->getNameSpace(one, &rc)), "root/test");
    EXPECT_EQ(textOf(one->ft->getClassName(one, &rc)), "VESKA_ComputerSystem");
    EXPECT_EQ(textOf(one->ft->getHostname(one, &rc)), "");
    EXPECT_EQ(one->ft->getKeyCount(one, &rc), 0U);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(PathObjectTest, NullNamesAreEmptyInAFactoryButRefusedBySetters) {
    CMPIObjectPath* empty = broker->eft->newObjectPath(broker, nullptr, nullptr, &rc);
    EXPECT_EQ(textOf(empty->ft->getClassName(empty, &rc)), "");
    EXPECT_EQ(one->ft->setClassName(one, nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(one->ft->setNameSpace(one, nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(one->ft->setHostname(one, nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(PathObjectTest, KeysAreFoundInAnyCaseAndMarkedAsKeys) {
    EXPECT_EQ(one->ft->addKey(one, "Name", chars("node7"), CMPI_chars).rc, CMPI_RC_OK);
    const CMPIData data = one->ft->getKey(one, "nAME", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(data.type, CMPI_string);
    EXPECT_EQ(data.state, CMPI_keyValue);
    EXPECT_EQ(textOf(data.value.string), "node7");
}

TEST_F(PathObjectTest, AKeySetAgainIsReplacedInItsPlace) {
    one->ft->addKey(one, "A", chars("1"), CMPI_chars);
    one->ft->addKey(one, "B", chars("2"), CMPI_chars);
    one->ft->addKey(one, "a", chars("3"), CMPI_chars);
    ASSERT_EQ(one->ft->getKeyCount(one, &rc), 2U);
    CMPIString* name = nullptr;
    EXPECT_EQ(textOf(one->ft->getKeyAt(one, 0, &name, &rc).value.string), "3");
    EXPECT_EQ(textOf(name), "A");
}

TEST_F(PathObjectTest, AbsentKeysAreNotFound) {
    CMPIString* name = string("left over");
    const CMPIData byName = one->ft->getKey(one, "Missing", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(byName.state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(byName.value.uint64, 0U);
    one->ft->getKeyAt(one, 0, &name, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(name, nullptr);
    EXPECT_EQ(one->ft->getKeyAt(one, 0, nullptr, nullptr).state, CMPI_nullValue | CMPI_notFound);
}

TEST_F(PathObjectTest, KeysMayNotBeNullArraysOrInstances) {
    EXPECT_EQ(one->ft->addKey(one, "K", nullptr, CMPI_string).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(one->ft->addKey(one, nullptr, chars("v"), CMPI_chars).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    CMPIString* none = nullptr;
    EXPECT_EQ(one->ft->addKey(one, "K", at(none), CMPI_string).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(one->ft->addKey(one, "K", nullptr, CMPI_null).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    CMPIArray* list = array(1, CMPI_uint8);
    EXPECT_EQ(one->ft->addKey(one, "K", at(list), CMPI_uint8A).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    CMPIInstance* whole = instance("C");
    EXPECT_EQ(one->ft->addKey(one, "K", at(whole), CMPI_instance).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(one->ft->getKeyCount(one, &rc), 0U);
}

TEST_F(PathObjectTest, AReferenceKeyIsACopy) {
    CMPIObjectPath* other = path("CIM_System");
    other->ft->addKey(other, "Name", chars("x"), CMPI_chars);
    one->ft->addKey(one, "Antecedent", at(other), CMPI_ref);
    other->ft->setClassName(other, "Changed");
    const CMPIData data = one->ft->getKey(one, "Antecedent", &rc);
    EXPECT_EQ(data.type, CMPI_ref);
    EXPECT_EQ(textOf(data.value.ref->ft->getClassName(data.value.ref, &rc)), "CIM_System");
}

TEST_F(PathObjectTest, NamespaceAndHostAreCopiedButNotTheClass) {
    CMPIObjectPath* other = broker->eft->newObjectPath(broker, "root/other", "Other", nullptr);
    other->ft->setHostname(other, "host");
    EXPECT_EQ(one->ft->setNameSpaceFromObjectPath(one, other).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(one->ft->getNameSpace(one, &rc)), "root/other");
    EXPECT_EQ(textOf(one->ft->getHostname(one, &rc)), "");
    EXPECT_EQ(one->ft->setHostAndNameSpaceFromObjectPath(one, other).rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(one->ft->getHostname(one, &rc)), "host");
    EXPECT_EQ(textOf(one->ft->getClassName(one, &rc)), "VESKA_ComputerSystem");
}

TEST_F(PathObjectTest, QualifiersAreNotSupported) {
    one->ft->getClassQualifier(one, "Key", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    one->ft->getParameterQualifier(one, "M", "P", "In", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(PathObjectTest, TheTextFormIsReadable) {
    one->ft->addKey(one, "Name", chars("a\"b"), CMPI_chars);
    const CMPIUint16 number = 7;
    one->ft->addKey(one, "Number", at(number), CMPI_uint16);
    EXPECT_EQ(textOf(one->ft->toString(one, &rc)), "root/test:VESKA_ComputerSystem.Name=\"a\\\"b\",Number=7");
}

} // namespace
} // namespace om
