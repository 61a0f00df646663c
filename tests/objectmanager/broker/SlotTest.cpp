#include "objectmanager/broker/Slot.h"

#include <gtest/gtest.h>

#include <new>
#include <stdexcept>

namespace om {
namespace {

int throwFailure(const CMPIString*, CMPIStatus*) {
    throw Failure{CMPI_RC_ERR_NOT_FOUND};
}
CMPIStatus throwBadAlloc(const CMPIString*) {
    throw std::bad_alloc();
}
void throwAnything() {
    throw 1;
}
CMPIData throwData(CMPIStatus*) {
    throw std::runtime_error("text");
}
void* throwPointer(CMPIStatus*) {
    throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
}
bool isNegative(long number) {
    return number < 0;
}

TEST(SlotTest, ItTakesTheTypeOfWhatItFills) {
    enum Level { Low = -1 };
    CMPIBoolean (*narrow)(Level) = Slot<&isNegative>();
    CMPIBoolean (*wide)(long) = Slot<&isNegative>();
    EXPECT_EQ(narrow(Low), 1);
    EXPECT_EQ(wide(1), 0);
}

TEST(SlotTest, AFailureIsTheStatus) {
    CMPIUint64 (*slot)(const CMPIString*, CMPIStatus*) = Slot<&throwFailure>();
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    EXPECT_EQ(slot(nullptr, &rc), 0U);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(slot(nullptr, nullptr), 0U);
}

TEST(SlotTest, NoExceptionGetsThrough) {
    CMPIStatus (*status)(CMPIString*) = Slot<&throwBadAlloc>();
    EXPECT_EQ(status(nullptr).rc, CMPI_RC_ERR_FAILED);
    void (*nothing)() = Slot<&throwAnything>();
    EXPECT_NO_THROW(nothing());
    int (*number)(const CMPIString*, CMPIStatus*) = Slot<&throwFailure>();
    EXPECT_EQ(number(nullptr, nullptr), ENOMEM);
    void* (*pointer)(CMPIStatus*) = Slot<&throwPointer>();
    EXPECT_EQ(pointer(nullptr), nullptr);
}

TEST(SlotTest, FailedDataIsNullNotFoundAndCleared) {
    CMPIData (*slot)(CMPIStatus*) = Slot<&throwData>();
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    const CMPIData data = slot(&rc);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(data.state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(data.type, CMPI_null);
    EXPECT_EQ(data.value.dataPtr.length, 0U);
}

} // namespace
} // namespace om
