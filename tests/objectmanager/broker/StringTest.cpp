#include "objectmanager/broker/String.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class StringObjectTest : public BrokerFixture {};

TEST_F(StringObjectTest, TheTextIsCopied) {
    char buffer[] = "before";
    CMPIString* made = string(buffer);
    buffer[0] = 'x';
    EXPECT_STREQ(made->ft->getCharPtr(made, &rc), "before");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(StringObjectTest, TheHandlePointsToTheText) {
    for (const char* text : {"", "short", "a text that is much too long to be kept inside of the string itself"}) {
        CMPIString* made = string(text);
        EXPECT_STREQ(static_cast<const char*>(made->hdl), text);
        CMPIString* copy = made->ft->clone(made, nullptr);
        EXPECT_STREQ(static_cast<const char*>(copy->hdl), text);
        copy->ft->release(copy);
    }
}

TEST_F(StringObjectTest, NoTextIsRefused) {
    EXPECT_EQ(string(nullptr), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(StringObjectTest, ACloneIsIndependent) {
    CMPIString* made = string("text");
    CMPIString* copy = made->ft->clone(made, &rc);
    made->ft->release(made);
    EXPECT_EQ(textOf(copy), "text");
    EXPECT_EQ(copy->ft->release(copy).rc, CMPI_RC_OK);
}

} // namespace
} // namespace om
