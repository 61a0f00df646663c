#include "objectmanager/broker/Context.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class ContextObjectTest : public BrokerFixture {
protected:
    CMPIContext* one = context();

    CMPIData get(const char* name) { return one->ft->getEntry(one, name, &rc); }
};

TEST_F(ContextObjectTest, TheUsualEntriesAreAlwaysThere) {
    EXPECT_EQ(get(CMPIInvocationFlags).type, CMPI_uint32);
    EXPECT_EQ(get(CMPIInvocationFlags).value.uint32, 0U);
    EXPECT_EQ(textOf(get(CMPIInitNameSpace).value.string), "root/test");
    for (const char* name : {CMPIPrincipal, CMPIRole, CMPIAcceptLanguage, CMPIContentLanguage}) {
        EXPECT_EQ(textOf(get(name).value.string), "") << name;
    }
}

TEST_F(ContextObjectTest, EntriesAreAddedAndReplaced) {
    EXPECT_EQ(one->ft->addEntry(one, "Mine", chars("1"), CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(one->ft->addEntry(one, "Mine", chars("2"), CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(one->ft->getEntryCount(one, &rc), 7U);
    CMPIString* name = nullptr;
    EXPECT_EQ(textOf(one->ft->getEntryAt(one, 6, &name, &rc).value.string), "2");
    EXPECT_EQ(textOf(name), "Mine");
}

TEST_F(ContextObjectTest, APointerIsHandedThrough) {
    int data = 0;
    CMPIValuePtr pointer{&data, sizeof data};
    EXPECT_EQ(one->ft->addEntry(one, "Pointer", at(pointer), CMPI_ptr).rc, CMPI_RC_OK);
    CMPIContext* copy = one->ft->clone(one, &rc);
    const CMPIData given = copy->ft->getEntry(copy, "Pointer", &rc);
    EXPECT_EQ(given.type, CMPI_ptr);
    EXPECT_EQ(given.value.dataPtr.ptr, &data);
    EXPECT_EQ(given.value.dataPtr.length, sizeof data);
    copy->ft->release(copy);
}

TEST_F(ContextObjectTest, AbsentOnesAreNoSuchProperty) {
    EXPECT_EQ(get("Missing").state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    one->ft->getEntryAt(one, 6, nullptr, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

} // namespace
} // namespace om
