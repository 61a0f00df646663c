#include "objectmanager/broker/DateTime.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

#include <chrono>

namespace om {
namespace {

class DateTimeObjectTest : public BrokerFixture {
protected:
    std::string format(CMPIDateTime* from) { return textOf(from->ft->getStringFormat(from, &rc)); }
    CMPIUint64 binary(CMPIDateTime* from) { return from->ft->getBinaryFormat(from, &rc); }
    CMPIDateTime* fromBinary(CMPIUint64 count, bool interval) {
        return broker->eft->newDateTimeFromBinary(broker, count, interval, &rc);
    }
};

TEST_F(DateTimeObjectTest, ATextIsGivenBackAndItsOffsetApplied) {
    CMPIDateTime* made = dateTime("20240101130000.000001+120");
    EXPECT_EQ(format(made), "20240101130000.000001+120");
    EXPECT_EQ(binary(made), 1704106800000001U);
    EXPECT_EQ(made->ft->isInterval(made, &rc), 0);
}

TEST_F(DateTimeObjectTest, ABadTextIsNullAndInvalidParameter) {
    EXPECT_EQ(dateTime("20240101"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(DateTimeObjectTest, AnInterval) {
    CMPIDateTime* made = dateTime("00000001020304.000005:000");
    EXPECT_EQ(made->ft->isInterval(made, &rc), 1);
    EXPECT_EQ(binary(made), 93784000005U);
    EXPECT_EQ(format(fromBinary(93784000005U, true)), "00000001020304.000005:000");
}

TEST_F(DateTimeObjectTest, BinariesComeBackUnchanged) {
    for (const CMPIUint64 count : {CMPIUint64{0}, CMPIUint64{1}, CMPIUint64{1704106800000000},
                                   CMPIUint64{253402300799999999}, static_cast<CMPIUint64>(-1)}) {
        EXPECT_EQ(binary(fromBinary(count, false)), count);
    }
    for (const CMPIUint64 count : {CMPIUint64{0}, CMPIUint64{86400000000}, CMPIUint64{8639999999999999999}}) {
        EXPECT_EQ(binary(fromBinary(count, true)), count);
    }
}

TEST_F(DateTimeObjectTest, WhatFitsInNoTextIsRefused) {
    EXPECT_EQ(fromBinary(253402300800000000, false), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(fromBinary(~CMPIUint64{0}, true), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(DateTimeObjectTest, ATextWithAsterisksHasNoBinary) {
    CMPIDateTime* made = dateTime("202401011300**.******+000");
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(binary(made), 0U);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(DateTimeObjectTest, NowIsNowInUtc) {
    using namespace std::chrono;
    const auto now = [] { return duration_cast<microseconds>(system_clock::now().time_since_epoch()).count(); };
    const auto before = now();
    CMPIDateTime* made = broker->eft->newDateTime(broker, &rc);
    const auto after = now();
    EXPECT_GE(binary(made), static_cast<CMPIUint64>(before));
    EXPECT_LE(binary(made), static_cast<CMPIUint64>(after));
    EXPECT_EQ(format(made).substr(21), "+000");
}

} // namespace
} // namespace om
