#include "objectmanager/broker/Memory.h"

#include "tests/objectmanager/broker/BrokerFixture.h"

#include <cstdint>
#include <future>

#include <malloc.h>

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
    constexpr std::size_t size = std::size_t{1} << 20;
    const auto used = [] {
        const struct mallinfo2 all = mallinfo2();
        return all.uordblks + all.hblkhd;
    };
    const std::size_t before = used();
    {
        const Broker forgetful(Schema::builtin(), "root/test");
        const CMPIBroker* const handle = forgetful.handle();
        EXPECT_STREQ(handle->mft->cmpiStrDup(handle, "left behind"), "left behind");
        ASSERT_NE(handle->mft->cmpiMalloc(handle, size), nullptr);
    }
    EXPECT_LT(used(), before + size);
}

TEST_F(Memory, ThreadsAllocateAtOnceAndKeepTheirOwnBlocks) {
    const auto work = [this](char own) {
        std::size_t kept = 0;
        for (int i = 0; i < 500; ++i) {
            auto* block = static_cast<char*>(mft->cmpiMalloc(broker, 8));
            std::memset(block, own, 8);
            block = static_cast<char*>(mft->cmpiRealloc(broker, block, 64));
            kept += std::string(block, 8) == std::string(8, own) ? 1 : 0;
            mft->cmpiFree(broker, block);
        }
        return kept;
    };
    std::future<std::size_t> other = std::async(std::launch::async, work, 'a');
    EXPECT_EQ(work('b'), 500U);
    EXPECT_EQ(other.get(), 500U);
}

} // namespace
} // namespace om
