#include "objectmanager/broker/Messages.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class Messages : public BrokerFixture {};

TEST_F(Messages, EveryTypeIsInserted) {
    CMPIString* text =
        broker->eft->getMessage(broker, "id", "$0 $1 $2 $3 $4 $5 $6 $7", &rc, 8, CMFmtSint(-1), CMFmtUint(4294967295U),
                                CMFmtSint64(-5000000000LL), CMFmtUint64(~0ULL), CMFmtReal(0.5), CMFmtBoolean(1),
                                CMFmtChars("chars"), CMFmtString(string("string")));
    EXPECT_EQ(textOf(text), "-1 4294967295 -5000000000 18446744073709551615 0.5 true chars string");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(Messages, AnInsertMayRepeatAndOneWithoutAValueStays) {
    EXPECT_EQ(textOf(broker->eft->getMessage(broker, nullptr, "$0$0 $1 $ $a 5$", &rc, 1, CMFmtChars("x"))),
              "xx $1 $ $a 5$");
    EXPECT_EQ(textOf(broker->eft->getMessage2(broker, "id", nullptr, "plain", &rc, 0)), "plain");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(Messages, InsertsAreNotExpandedAgain) {
    EXPECT_EQ(textOf(broker->eft->getMessage(broker, "id", "$0", &rc, 2, CMFmtChars("$1"), CMFmtChars("no"))), "$1");
}

TEST_F(Messages, OnAnErrorTheTextComesAsItIs) {
    EXPECT_EQ(textOf(broker->eft->getMessage(broker, "id", "$0", &rc, 1, CMPI_uint8, 7)), "$0");
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(textOf(broker->eft->getMessage(broker, "id", "$0", &rc, 11)), "$0");
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(textOf(broker->eft->getMessage(broker, "id", "$0", &rc, 1, CMFmtString(nullptr))), "$0");
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
}

} // namespace
} // namespace om
