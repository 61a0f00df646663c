#include "objectmanager/broker/Memory.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

#include <cstdint>
#include <thread>

namespace om {
namespace {

class Memory : public BrokerFixture {
protected:
    const CMPIBrokerMemFT* mft = broker->mft;
};

TEST_F(Memory, BlocksAreAlignedForAnyType) {
    for (const std::size_t size : {std::size_t{1}, std::size_t{24}, std::size_t{4096}}) {
        void* block = mft->cmpiMalloc(broker, size);
        ASSERT_NE(block, nullptr);
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block) % alignof(std::max_align_t), 0U);
        std::memset(block, 0xFF, size);
        mft->cmpiFree(broker, block);
    }
}

TEST_F(Memory, CallocClearsAndChecksTheProduct) {
    auto* block = static_cast<char*>(mft->cmpiCalloc(broker, 4, 8));
    EXPECT_EQ(std::string(block, 32), std::string(32, '\0'));
    mft->cmpiFree(broker, block);
    EXPECT_EQ(mft->cmpiCalloc(broker, SIZE_MAX / 2, 3), nullptr);
    EXPECT_EQ(mft->cmpiMalloc(broker, SIZE_MAX), nullptr);
}

TEST_F(Memory, ReallocKeepsTheContentAndTheOldBlockOnFailure) {
    auto* block = static_cast<char*>(mft->cmpiRealloc(broker, nullptr, 6));
    std::memcpy(block, "hello", 6);
    block = static_cast<char*>(mft->cmpiRealloc(broker, block, 10000));
    EXPECT_STREQ(block, "hello");
    EXPECT_EQ(mft->cmpiRealloc(broker, block, SIZE_MAX), nullptr);
    EXPECT_EQ(mft->cmpiRealloc(broker, block, SIZE_MAX / 2), nullptr);
    EXPECT_STREQ(block, "hello");
    mft->cmpiFree(broker, block);
}

TEST_F(Memory, WhatIsForgottenIsFreedWithTheBroker) {
    for (int i = 0; i < 3; ++i) EXPECT_STREQ(mft->cmpiStrDup(broker, "left behind"), "left behind");
}

TEST_F(Memory, ThreadsAllocateAtOnce) {
    const auto work = [this] {
        for (int i = 0; i < 500; ++i) mft->cmpiFree(broker, mft->cmpiRealloc(broker, mft->cmpiMalloc(broker, 8), 64));
    };
    std::thread first(work);
    std::thread second(work);
    first.join();
    second.join();
}

} // namespace
} // namespace om
