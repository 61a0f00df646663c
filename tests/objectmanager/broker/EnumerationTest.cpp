#include "objectmanager/broker/Enumeration.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

Value reference(const char* className) {
    return {CMPI_ref, std::make_shared<const ObjectPath>(ObjectPath{"", "root/test", className, {}})};
}

class EnumerationObjectTest : public BrokerFixture {
protected:
    CMPIEnumeration* one = &make<EnumerationObject>(owner, static_cast<CMPIType>(CMPI_ref),
                                                    std::vector<Value>{reference("A"), reference("B")});

    std::string next() {
        const CMPIData data = one->ft->getNext(one, &rc);
        return rc.rc == CMPI_RC_OK ? textOf(data.value.ref->ft->getClassName(data.value.ref, nullptr)) : "";
    }
};

TEST_F(EnumerationObjectTest, ElementsComeInOrderAndThenTheEnd) {
    EXPECT_EQ(one->ft->hasNext(one, &rc), 1);
    EXPECT_EQ(next(), "A");
    EXPECT_EQ(next(), "B");
    EXPECT_EQ(one->ft->hasNext(one, &rc), 0);
    EXPECT_EQ(one->ft->getNext(one, &rc).state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc.rc, 18);
}

TEST_F(EnumerationObjectTest, AnArrayOfAllElements) {
    next();
    CMPIArray* all = one->ft->toArray(one, &rc);
    EXPECT_EQ(all->ft->getSize(all, &rc), 2U);
    EXPECT_EQ(all->ft->getSimpleType(all, &rc), CMPI_ref);
    EXPECT_EQ(next(), "B");
}

TEST_F(EnumerationObjectTest, ACloneGoesItsOwnWay) {
    next();
    CMPIEnumeration* copy = one->ft->clone(one, &rc);
    EXPECT_EQ(next(), "B");
    EXPECT_EQ(copy->ft->hasNext(copy, &rc), 1);
    copy->ft->release(copy);
}

} // namespace
} // namespace om
