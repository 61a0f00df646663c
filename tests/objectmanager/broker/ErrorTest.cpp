#include "objectmanager/broker/Error.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class ErrorObjectTest : public BrokerFixture {
protected:
    CMPIError* one =
        broker->eft->newCMPIError(broker, "owner", "id", "text", ErrorSevHigh, Timeout, CMPI_RC_ERR_ACCESS_DENIED, &rc);
};

TEST_F(ErrorObjectTest, TheSevenAttributesAreKeptAllOthersAreUnset) {
    auto* ft = one->ft;
    EXPECT_EQ(textOf(ft->getOwningEntity(one, &rc)), "owner");
    EXPECT_EQ(textOf(ft->getMessageID(one, &rc)), "id");
    EXPECT_EQ(textOf(ft->getMessage(one, &rc)), "text");
    EXPECT_EQ(ft->getPerceivedSeverity(one, &rc), ErrorSevHigh);
    EXPECT_EQ(ft->getProbableCause(one, &rc), Timeout);
    EXPECT_EQ(ft->getCIMStatusCode(one, &rc), CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(ft->getErrorType(one, &rc), UnknownErrorType);
    EXPECT_EQ(ft->getErrorSourceFormat(one, &rc), CMPIErrSrcUnknown);
    EXPECT_EQ(ft->getOtherErrorType(one, &rc), nullptr);
    EXPECT_EQ(ft->getErrorSource(one, &rc), nullptr);
    EXPECT_EQ(ft->getRecommendedActions(one, &rc), nullptr);
    EXPECT_EQ(ft->getMessageArguments(one, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(ErrorObjectTest, EachSetterSetsItsOwn) {
    auto* ft = one->ft;
    ft->setErrorType(one, SoftwareError);
    ft->setErrorSourceFormat(one, CIMObjectHandle);
    ft->setOtherErrorType(one, "other type");
    ft->setProbableCauseDescription(one, "cause");
    ft->setErrorSource(one, "source");
    ft->setOtherErrorSourceFormat(one, "other format");
    ft->setCIMStatusCodeDescription(one, "code");
    EXPECT_EQ(ft->getErrorType(one, &rc), SoftwareError);
    EXPECT_EQ(ft->getErrorSourceFormat(one, &rc), CIMObjectHandle);
    EXPECT_EQ(textOf(ft->getOtherErrorType(one, &rc)), "other type");
    EXPECT_EQ(textOf(ft->getProbableCauseDescription(one, &rc)), "cause");
    EXPECT_EQ(textOf(ft->getErrorSource(one, &rc)), "source");
    EXPECT_EQ(textOf(ft->getOtherErrorSourceFormat(one, &rc)), "other format");
    EXPECT_EQ(textOf(ft->getCIMStatusCodeDescription(one, &rc)), "code");
}

TEST_F(ErrorObjectTest, ArraysMustBeOfStrings) {
    CMPIArray* texts = array(1, CMPI_string);
    CMPIString* text = string("reboot");
    texts->ft->setElementAt(texts, 0, at(text), CMPI_string);
    EXPECT_EQ(one->ft->setRecommendedActions(one, texts).rc, CMPI_RC_OK);
    EXPECT_EQ(one->ft->setMessageArguments(one, array(2, CMPI_uint8)).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    CMPIArray* given = one->ft->getRecommendedActions(one, &rc);
    EXPECT_EQ(textOf(given->ft->getElementAt(given, 0, &rc).value.string), "reboot");
}

TEST_F(ErrorObjectTest, ACloneIsDeep) {
    CMPIError* copy = one->ft->clone(one, &rc);
    one->ft->setErrorSource(one, "later");
    EXPECT_EQ(copy->ft->getErrorSource(copy, &rc), nullptr);
    EXPECT_EQ(textOf(copy->ft->getMessage(copy, &rc)), "text");
    copy->ft->release(copy);
}

} // namespace
} // namespace om
