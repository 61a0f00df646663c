// Message inserts as a broker reads them: a number of pairs, each a type code and a value.

#include <cmpift.h>

#include <cstdarg>
#include <gtest/gtest.h>
#include <string>

namespace {

std::string read(CMPICount pairs, va_list inserts) {
    std::string seen = std::to_string(pairs);
    for (CMPICount i = 0; i < pairs; ++i) {
        const int type = va_arg(inserts, int);
        seen += ' ';
        switch (type) {
        case CMPI_sint32:
            seen += "sint32:" + std::to_string(va_arg(inserts, int));
            break;
        case CMPI_uint32:
            seen += "uint32:" + std::to_string(va_arg(inserts, unsigned));
            break;
        case CMPI_sint64:
            seen += "sint64:" + std::to_string(va_arg(inserts, long long));
            break;
        case CMPI_uint64:
            seen += "uint64:" + std::to_string(va_arg(inserts, unsigned long long));
            break;
        case CMPI_real64:
            seen += "real64:" + std::to_string(va_arg(inserts, double));
            break;
        case CMPI_boolean:
            seen += "boolean:" + std::to_string(va_arg(inserts, int));
            break;
        case CMPI_chars:
            seen += std::string("chars:") + va_arg(inserts, char*);
            break;
        case CMPI_string:
            seen += std::string("string:") + static_cast<char*>(va_arg(inserts, CMPIString*)->hdl);
            break;
        default:
            return seen + "unknown:" + std::to_string(type);
        }
    }
    return seen;
}

std::string lastMessage;
CMPIMsgFileHandle lastHandle;

CMPIString* getMessage(const CMPIBroker*, const char* msgId, const char* defaultText, CMPIStatus* rc, CMPICount pairs,
                       ...) {
    va_list inserts;
    va_start(inserts, pairs);
    lastMessage = std::string(msgId) + '|' + defaultText + '|' + read(pairs, inserts);
    va_end(inserts);
    *rc = {CMPI_RC_OK, nullptr};
    return nullptr;
}

CMPIString* getMessage2(const CMPIBroker*, const char* msgId, CMPIMsgFileHandle handle, const char* defaultText,
                        CMPIStatus* rc, CMPICount pairs, ...) {
    va_list inserts;
    va_start(inserts, pairs);
    lastMessage = std::string(msgId) + '|' + defaultText + '|' + read(pairs, inserts);
    va_end(inserts);
    lastHandle = handle;
    *rc = {CMPI_RC_ERR_NOT_FOUND, nullptr};
    return nullptr;
}

class CmpiMessages : public ::testing::Test {
protected:
    CmpiMessages() {
        table.getMessage = getMessage;
        table.getMessage2 = getMessage2;
    }

    CMPIBrokerEncFT table{};
    CMPIBroker object = {nullptr, nullptr, &table, nullptr, nullptr};
    const CMPIBroker* broker = &object;
    CMPIStatus status = {CMPI_RC_ERR_FAILED, nullptr};
};

TEST_F(CmpiMessages, CarryNoInserts) {
    CMGetMessage(broker, "7", "nothing", &status, CMFmtArgs0());
    EXPECT_EQ(lastMessage, "7|nothing|0");
    EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_F(CmpiMessages, CarryEveryKindOfInsertWithItsType) {
    char text[] = "whole";
    CMPIString string = {text, nullptr};
    CMGetMessage(broker, "7", "$0 ...", &status,
                 CMFmtArgs8(CMFmtSint(-1), CMFmtUint(4000000000U), CMFmtSint64(-5000000000), CMFmtUint64(1ULL << 63),
                            CMFmtReal(0.5F), CMFmtBoolean(1), CMFmtChars("part"), CMFmtString(&string)));
    EXPECT_EQ(lastMessage, "7|$0 ...|8 sint32:-1 uint32:4000000000 sint64:-5000000000 uint64:9223372036854775808 "
                           "real64:0.500000 boolean:1 chars:part string:whole");
}

TEST_F(CmpiMessages, CarryUpToTenInsertsInOrder) {
#define S(n) CMFmtSint(n)
    const auto inserts = [] { return lastMessage.substr(4); };
    CMGetMessage(broker, "7", "", &status, CMFmtArgs1(S(1)));
    EXPECT_EQ(inserts(), " sint32:1");
    EXPECT_EQ(lastMessage[3], '1');
    CMGetMessage(broker, "7", "", &status, CMFmtArgs2(S(1), S(2)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs3(S(1), S(2), S(3)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs4(S(1), S(2), S(3), S(4)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3 sint32:4");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs5(S(1), S(2), S(3), S(4), S(5)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3 sint32:4 sint32:5");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs6(S(1), S(2), S(3), S(4), S(5), S(6)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3 sint32:4 sint32:5 sint32:6");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs7(S(1), S(2), S(3), S(4), S(5), S(6), S(7)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3 sint32:4 sint32:5 sint32:6 sint32:7");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs8(S(1), S(2), S(3), S(4), S(5), S(6), S(7), S(8)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3 sint32:4 sint32:5 sint32:6 sint32:7 sint32:8");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs9(S(1), S(2), S(3), S(4), S(5), S(6), S(7), S(8), S(9)));
    EXPECT_EQ(inserts(), " sint32:1 sint32:2 sint32:3 sint32:4 sint32:5 sint32:6 sint32:7 sint32:8 sint32:9");
    CMGetMessage(broker, "7", "", &status, CMFmtArgs10(S(1), S(2), S(3), S(4), S(5), S(6), S(7), S(8), S(9), S(10)));
    EXPECT_EQ(lastMessage, "7||10 sint32:1 sint32:2 sint32:3 sint32:4 sint32:5 sint32:6 sint32:7 sint32:8 sint32:9 "
                           "sint32:10");
#undef S
}

TEST_F(CmpiMessages, CarryTheMessageFileToo) {
    int file = 0;
    CMGetMessage2(broker, "8", &file, "$0", &status, CMFmtArgs1(CMFmtChars("x")));
    EXPECT_EQ(lastMessage, "8|$0|1 chars:x");
    EXPECT_EQ(lastHandle, &file);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
}

} // namespace
