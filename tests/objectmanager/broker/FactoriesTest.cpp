#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class Factories : public BrokerFixture {
protected:
    bool isA(const char* className, const char* ancestor) {
        return broker->eft->classPathIsA(broker, path(className), ancestor, &rc) != 0;
    }
};

TEST_F(Factories, ClassPathIsA) {
    EXPECT_TRUE(isA("VESKA_ComputerSystem", "VESKA_ComputerSystem"));
    EXPECT_TRUE(isA("veska_computersystem", "CIM_MANAGEDELEMENT"));
    EXPECT_FALSE(isA("CIM_System", "VESKA_ComputerSystem"));
    EXPECT_FALSE(isA("Somebodys_Class", "Somebodys_Class"));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_FALSE(isA("VESKA_ComputerSystem", nullptr));
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(Factories, TypesOfObjectsAreNamed) {
    auto* eft = broker->eft;
    EXPECT_EQ(textOf(eft->getType(broker, string("x"), &rc)), "CMPIString");
    EXPECT_EQ(textOf(eft->getType(broker, path("C"), &rc)), "CMPIObjectPath");
    EXPECT_EQ(textOf(eft->getType(broker, context(), &rc)), "CMPIContext");
    EXPECT_EQ(eft->isOfType(broker, instance("C"), "CMPIInstance", &rc), 1);
    EXPECT_EQ(eft->isOfType(broker, instance("C"), "CMPIArgs", &rc), 0);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(Factories, EveryObjectHasAText) {
    auto* eft = broker->eft;
    EXPECT_EQ(textOf(eft->toString(broker, string("x"), &rc)), "x");
    CMPIInstance* one = instance("C");
    one->ft->setProperty(one, "P", chars("v"), CMPI_chars);
    EXPECT_EQ(textOf(eft->toString(broker, one, &rc)), "root/test:C {P=\"v\"}");
    EXPECT_EQ(textOf(eft->toString(broker, array(2, CMPI_uint8), &rc)), "{NULL, NULL}");
    EXPECT_EQ(textOf(eft->toString(broker, args(), &rc)), "{}");
}

TEST_F(Factories, SelectExpressionsAndMessageFilesAreNotThere) {
    CMPIArray* projection = array(0, CMPI_string);
    EXPECT_EQ(broker->eft->newSelectExp(broker, "select * from C", "WQL", &projection, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(projection, nullptr);
    CMPIMsgFileHandle file = &rc;
    EXPECT_EQ(broker->eft->openMessageFile(broker, "file", &file).rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(file, nullptr);
    EXPECT_EQ(broker->eft->closeMessageFile(broker, file).rc, CMPI_RC_OK);
}

TEST_F(Factories, LogAndTraceSayThatNothingIsWritten) {
    EXPECT_EQ(broker->eft->logMessage(broker, CMPI_SEV_INFO, "id", "text", nullptr).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(broker->eft->trace(broker, CMPI_LEV_INFO, "part", nullptr, string("x")).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(broker->eft->trace(broker, CMPI_LEV_INFO, "part", nullptr, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(Factories, NullStatusPointersAreFine) {
    EXPECT_EQ(broker->eft->newString(broker, nullptr, nullptr), nullptr);
    EXPECT_EQ(broker->eft->newDateTimeFromChars(broker, "bad", nullptr), nullptr);
    EXPECT_NE(broker->eft->newArgs(broker, nullptr), nullptr);
}

} // namespace
} // namespace om
