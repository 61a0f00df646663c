// Status helpers and tests of objects and values.

#include "Layout.h"

#include <cmpift.h>

#include <gtest/gtest.h>
#include <string>

namespace {

std::string lastText;
CMPIString madeString;

CMPIString* newString(const CMPIBroker*, const char* text, CMPIStatus*) {
    lastText = text;
    return &madeString;
}

class CmpiHelpers : public ::testing::Test {
protected:
    CmpiHelpers() {
        table.newString = newString;
        lastText.clear();
    }

    CMPIBrokerEncFT table{};
    CMPIBroker object = {nullptr, nullptr, &table, nullptr, nullptr};
    const CMPIBroker* broker = &object;
    CMPIString own{};
};

CMPIStatus denyOrPass(bool deny) {
    if (deny)
        CMReturn(CMPI_RC_ERR_ACCESS_DENIED);
    else
        CMReturn(CMPI_RC_OK);
}

TEST_F(CmpiHelpers, ReturnAStatusAlsoBeforeElse) {
    EXPECT_EQ(denyOrPass(true).rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(denyOrPass(false).rc, CMPI_RC_OK);
    EXPECT_EQ(denyOrPass(true).msg, nullptr);
}

TEST_F(CmpiHelpers, ReturnAStatusFromAVariableOfAnyName) {
    const auto pass = [] {
        CMPIStatus stat = {CMPI_RC_ERR_NOT_FOUND, nullptr};
        CMReturn(stat.rc);
    };
    EXPECT_EQ(pass().rc, CMPI_RC_ERR_NOT_FOUND);
}

TEST_F(CmpiHelpers, ReturnAStatusWithAText) {
    const auto withString = [this](bool fail) -> CMPIStatus {
        if (fail)
            CMReturnWithString(CMPI_RC_ERR_FAILED, &own);
        else
            CMReturnWithString(CMPI_RC_OK, nullptr);
    };
    EXPECT_EQ(withString(true).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(withString(true).msg, &own);
    EXPECT_EQ(withString(false).msg, nullptr);

    const auto withChars = [](const CMPIBroker* maker) -> CMPIStatus {
        if (maker)
            CMReturnWithChars(maker, CMPI_RC_ERR_FAILED, "disk is gone");
        else
            CMReturnWithChars(maker, CMPI_RC_ERR_INVALID_HANDLE, "no broker");
    };
    EXPECT_EQ(withChars(broker).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(withChars(broker).msg, &madeString);
    EXPECT_EQ(lastText, "disk is gone");
    EXPECT_EQ(withChars(nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(withChars(nullptr).msg, nullptr);
}

TEST_F(CmpiHelpers, SetAStatus) {
    CMPIStatus status = {CMPI_RC_OK, &own};
    CMSetStatus(&status, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(status.msg, nullptr);

    CMSetStatusWithString(&status, CMPI_RC_ERR_FAILED, &own);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, &own);

    CMSetStatusWithChars(broker, &status, CMPI_RC_ERR_NOT_FOUND, "not here");
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(status.msg, &madeString);
    EXPECT_EQ(lastText, "not here");

    CMSetStatusWithChars(NULL, &status, CMPI_RC_ERR_FAILED, "nobody makes the text");
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
}

TEST_F(CmpiHelpers, LeaveANullStatusAlone) {
    CMPIStatus* none = nullptr;
    CMSetStatus(none, CMPI_RC_ERR_FAILED);
    CMSetStatusWithString(none, CMPI_RC_ERR_FAILED, &own);
    CMSetStatusWithChars(broker, none, CMPI_RC_ERR_FAILED, "unheard");
    EXPECT_EQ(lastText, "") << "no text is made for nobody";
}

TEST_F(CmpiHelpers, TellNullObjects) {
    CMPIString* none = nullptr;
    CMPIString dead = {nullptr, nullptr};
    const CMPIString live = {&dead, nullptr};
    const CMPIString* pointers[] = {none, &dead, &live};
    EXPECT_TRUE(CMIsNullObject(pointers[0]));
    EXPECT_TRUE(CMIsNullObject(pointers[1])) << "a first word of null marks a null object";
    EXPECT_FALSE(CMIsNullObject(pointers[2]));
}

TEST_F(CmpiHelpers, AnswerOneOrZeroThatFitsABoolean) {
    CMPIData data{};
    const auto booleans = [&data] {
        const CMPIBoolean null = CMIsNullValue(data), key = CMIsKeyValue(data), array = CMIsArray(data);
        return null * 100 + key * 10 + array;
    };
    data.state = CMPI_goodValue;
    data.type = CMPI_string;
    EXPECT_EQ(booleans(), 0);
    data.state = CMPI_nullValue | CMPI_notFound;
    EXPECT_EQ(booleans(), 100);
    data.state = CMPI_keyValue;
    EXPECT_EQ(booleans(), 10);
    data.state = CMPI_nullValue | CMPI_keyValue;
    data.type = CMPI_uint8A;
    EXPECT_EQ(booleans(), 111);
}

TEST_F(CmpiHelpers, NameContextEntriesByTheirOwnNames) {
#define VALUE(name, number)
#define TEXT(name, text) EXPECT_STREQ(name, text);
#include "Constants.inc"
}

} // namespace
