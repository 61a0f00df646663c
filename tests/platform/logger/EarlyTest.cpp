#include "nvlog/NVMessageBuffer.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace {

/// Collects a line while it is made and another when it is destroyed, and is made before everything else here.
struct Early {
    Early() : length(lengthOfALine()) {}
    ~Early() {
        if (lengthOfALine() != length) std::abort();
    }
    static std::size_t lengthOfALine() {
        NVLog::NVMessageBuffer buffer;
        return NVLog::NVMessageBuffer::str(buffer << "a text that is longer than a short string is inside").size();
    }
    std::size_t length;
};

__attribute__((init_priority(101))) Early early;

TEST(NVMessageBuffer, WorksBeforeTheLibrarysOwnObjectsAreMade) {
    EXPECT_EQ(early.length, 51U);
    EXPECT_EQ(Early::lengthOfALine(), 51U);
}

} // namespace
