#include "objectmanager/broker/Args.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class ArgsObjectTest : public BrokerFixture {
protected:
    CMPIArgs* one = args();
};

TEST_F(ArgsObjectTest, ArgumentsComeByNameAndInOrder) {
    const CMPIBoolean yes = 1;
    EXPECT_EQ(one->ft->addArg(one, "GetRequest", at(yes), CMPI_boolean).rc, CMPI_RC_OK);
    EXPECT_EQ(one->ft->addArg(one, "TimeData", nullptr, CMPI_dateTime).rc, CMPI_RC_OK);
    EXPECT_EQ(one->ft->getArgCount(one, &rc), 2U);
    EXPECT_EQ(one->ft->getArg(one, "getrequest", &rc).value.boolean, 1);
    CMPIString* name = nullptr;
    const CMPIData second = one->ft->getArgAt(one, 1, &name, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(name), "TimeData");
    EXPECT_EQ(second.type, CMPI_dateTime);
    EXPECT_EQ(second.state, CMPI_nullValue);
}

TEST_F(ArgsObjectTest, AbsentOnesAreNoSuchProperty) {
    EXPECT_EQ(one->ft->getArg(one, "Missing", &rc).state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    one->ft->getArgAt(one, 0, nullptr, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

} // namespace
} // namespace om
