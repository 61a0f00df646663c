#include "objectmanager/broker/Result.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

namespace om {
namespace {

class ResultObjectTest : public BrokerFixture {
protected:
    Answer answer;

    CMPIResult* result(Operation operation) { return &make<ResultObject>(owner, operation, answer); }
};

TEST_F(ResultObjectTest, WhatIsReturnedIsCopiedAtOnce) {
    CMPIResult* to = result(Operation::EnumInstanceNames);
    CMPIObjectPath* one = path("Before");
    EXPECT_EQ(to->ft->returnObjectPath(to, one).rc, CMPI_RC_OK);
    one->ft->setClassName(one, "After");
    one->ft->release(one);
    ASSERT_EQ(answer.results.size(), 1U);
    EXPECT_EQ(std::get<ObjectPath>(answer.results[0]).className, "Before");
    EXPECT_FALSE(answer.done);
}

TEST_F(ResultObjectTest, NothingIsTakenAfterTheEnd) {
    CMPIResult* to = result(Operation::EnumInstances);
    EXPECT_EQ(to->ft->returnDone(to).rc, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
    EXPECT_EQ(to->ft->returnInstance(to, instance("C")).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(to->ft->returnDone(to).rc, CMPI_RC_ERR_FAILED);
    EXPECT_TRUE(answer.results.empty());
}

TEST_F(ResultObjectTest, PathsAndInstancesGoWhereTheyBelong) {
    const Operation paths[] = {Operation::EnumInstanceNames, Operation::CreateInstance, Operation::AssociatorNames,
                               Operation::ReferenceNames};
    const Operation instances[] = {Operation::EnumInstances, Operation::GetInstance, Operation::ExecQuery,
                                   Operation::Associators, Operation::References};
    const auto codes = [this](Operation operation) {
        CMPIResult* to = result(operation);
        return std::pair(to->ft->returnObjectPath(to, path("C")).rc, to->ft->returnInstance(to, instance("C")).rc);
    };
    for (const Operation each : paths) {
        EXPECT_EQ(codes(each), std::pair(CMPI_RC_OK, CMPI_RC_ERR_INVALID_DATA_TYPE));
    }
    for (const Operation each : instances) {
        EXPECT_EQ(codes(each), std::pair(CMPI_RC_ERR_INVALID_DATA_TYPE, CMPI_RC_OK));
    }
    for (const Operation each : {Operation::ModifyInstance, Operation::DeleteInstance}) {
        EXPECT_EQ(codes(each), std::pair(CMPI_RC_ERR_INVALID_DATA_TYPE, CMPI_RC_ERR_INVALID_DATA_TYPE));
    }
}

TEST_F(ResultObjectTest, AMethodReturnsOneValue) {
    CMPIResult* to = result(Operation::InvokeMethod);
    const CMPIUint32 value = 7;
    EXPECT_EQ(to->ft->returnData(to, at(value), CMPI_uint32).rc, CMPI_RC_OK);
    EXPECT_EQ(answer.returnValue, (Value{CMPI_uint32, std::uint64_t{7}}));
    EXPECT_EQ(to->ft->returnData(to, at(value), CMPI_uint32).rc, CMPI_RC_ERR_FAILED);
}

TEST_F(ResultObjectTest, AMethodMayReturnAnObject) {
    CMPIResult* to = result(Operation::InvokeMethod);
    EXPECT_EQ(to->ft->returnObjectPath(to, path("C")).rc, CMPI_RC_OK);
    ASSERT_TRUE(answer.returnValue);
    EXPECT_EQ(answer.returnValue->type, CMPI_ref);
    EXPECT_TRUE(answer.results.empty());
}

TEST_F(ResultObjectTest, DataOfAWrongTypeIsRefused) {
    CMPIResult* method = result(Operation::InvokeMethod);
    const CMPIUint32 value = 7;
    EXPECT_EQ(method->ft->returnData(method, at(value), CMPI_args).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(method->ft->returnData(method, nullptr, CMPI_null).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    CMPIResult* instances = result(Operation::GetInstance);
    EXPECT_EQ(instances->ft->returnData(instances, at(value), CMPI_uint32).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(instances->ft->returnData(instances, nullptr, CMPI_instance).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    CMPIInstance* one = instance("C");
    EXPECT_EQ(instances->ft->returnData(instances, at(one), CMPI_instance).rc, CMPI_RC_OK);
    EXPECT_EQ(answer.results.size(), 1U);
}

TEST_F(ResultObjectTest, AReturnedInstanceHasItsKeysInThePath) {
    CMPIResult* to = result(Operation::GetInstance);
    CMPIInstance* one = instance("VESKA_ComputerSystem");
    one->ft->setProperty(one, "Name", chars("node7"), CMPI_chars);
    to->ft->returnInstance(to, one);
    const auto& keys = std::get<Instance>(answer.results.at(0)).path.keys;
    ASSERT_EQ(keys.size(), 1U);
    EXPECT_EQ(keys[0].first, "Name");
}

TEST_F(ResultObjectTest, TheFirstErrorsMessageIsKept) {
    auto& result = make<ResultObject>(owner, Operation::GetInstance, answer);
    for (const char* text : {"first", "second"}) {
        const CMPIError* error = broker->eft->newCMPIError(broker, "owner", "id", text, ErrorSevHigh,
                                                           ErrorProbCauseUnknown, CMPI_RC_ERR_FAILED, &rc);
        EXPECT_EQ(result.table.returnError(&result, error).rc, CMPI_RC_OK);
    }
    EXPECT_EQ(result.errorMessage, "first");
}

} // namespace
} // namespace om
