#include "nvlog/NVMessageBuffer.h"

#include "support/Allocations.h"

#include <gtest/gtest.h>
#include <iomanip>
#include <locale>
#include <sstream>
#include <thread>
#include <vector>

using NVLog::NVMessageBuffer;

namespace {

std::string takeText(NVMessageBuffer& buffer) {
    return NVMessageBuffer::str(buffer);
}

} // namespace

TEST(NVMessageBuffer, CollectsTextsAndNumbers) {
    NVMessageBuffer buffer;
    char writable[] = "b";
    EXPECT_EQ(&(buffer << "a" << writable << 0U << 4294967295U), &buffer);
    EXPECT_EQ(takeText(buffer), "ab04294967295");
}

TEST(NVMessageBuffer, PrintsNullTexts) {
    NVMessageBuffer buffer;
    buffer << static_cast<const char*>(nullptr) << static_cast<char*>(nullptr);
    EXPECT_EQ(takeText(buffer), "(null)(null)");
}

TEST(NVMessageBuffer, IsEmptyAtFirst) {
    NVMessageBuffer buffer;
    EXPECT_EQ(takeText(buffer), "");
    EXPECT_EQ(takeText(buffer << ""), "");
}

TEST(NVMessageBuffer, StartsAnewOnceItsTextWasTaken) {
    NVMessageBuffer buffer;
    const std::string& first = NVMessageBuffer::str(buffer << "log line");
    EXPECT_EQ(first, "log line");
    EXPECT_EQ(NVMessageBuffer::str(buffer), "");
    EXPECT_EQ(first, "log line"); // until the next insertion
    EXPECT_EQ(NVMessageBuffer::str(buffer << "trace line"), "trace line");
}

TEST(NVMessageBuffer, CollectsThroughItsStream) {
    NVMessageBuffer buffer;
    buffer << "at ";
    std::ostream& stream = buffer;
    stream << 7 << ' ' << std::string("text");
    EXPECT_EQ(&static_cast<std::ostream&>(buffer), &stream);
    EXPECT_EQ(NVMessageBuffer::str(stream), "at 7 text");
    EXPECT_EQ(NVMessageBuffer::str(stream), "");
    stream << 'x';
    EXPECT_EQ(takeText(buffer << 1U), "x1");
}

TEST(NVMessageBuffer, HasNoTextForAnotherStream) {
    std::ostringstream other;
    other << "text";
    EXPECT_EQ(NVMessageBuffer::str(other), "");
    NVMessageBuffer buffer;
    buffer << "mine";
    EXPECT_EQ(NVMessageBuffer::str(other), "");
}

TEST(NVMessageBuffer, HandsOnNoStateOfAFormerUser) {
    std::ostringstream other;
    for (int i = 0; i < 100; ++i) {
        NVMessageBuffer buffer;
        std::ostream& stream = buffer;
        stream << 255 << ' ' << 0.5;
        EXPECT_EQ(NVMessageBuffer::str(stream), "255 0.5");
        buffer << "left over";
        stream << std::hex << std::showbase << std::setfill('*') << std::setprecision(1);
        stream.width(20);
        stream.tie(&other);
        stream.setstate(i % 2 == 0 ? std::ios_base::failbit : std::ios_base::eofbit);
        if (i % 3 == 0) stream.rdbuf(other.rdbuf());
    }
    EXPECT_EQ(other.str(), "");
}

TEST(NVMessageBuffer, PrintsNumbersPlainWhateverTheLocale) {
    struct Grouped : std::numpunct<char> {
        char do_thousands_sep() const override { return '.'; }
        std::string do_grouping() const override { return "\3"; }
    };
    const std::locale before = std::locale::global(std::locale(std::locale::classic(), new Grouped));
    {
        std::vector<NVMessageBuffer> buffers(64); // more than are kept, so that some are new
        for (NVMessageBuffer& buffer : buffers) {
            std::ostream& stream = buffer;
            stream << 1234567;
            EXPECT_EQ(NVMessageBuffer::str(stream), "1234567");
        }
    }
    std::locale::global(before);
}

TEST(NVMessageBuffer, CostsNoMemoryAllocationALine) {
    const auto line = [] {
        NVMessageBuffer buffer;
        buffer << "a text that is longer than a short string is inside " << 7U;
        EXPECT_FALSE(NVMessageBuffer::str(buffer).empty());
        static_cast<std::ostream&>(buffer) << static_cast<const void*>(&buffer);
        EXPECT_FALSE(NVMessageBuffer::str(buffer).empty());
    };
    line();
    EXPECT_EQ(support::allocationsDuring([&] {
                  for (int i = 0; i < 1000; ++i) line();
              }),
              0U);
}

TEST(NVMessageBuffer, TakesLongTextsWhole) {
    const std::string text(2'000'000, 'x');
    NVMessageBuffer buffer;
    EXPECT_EQ(takeText(buffer << text.c_str()), text);
}

TEST(NVMessageBuffer, MayBeUsedByManyThreadsEachItsOwn) {
    std::vector<std::thread> threads;
    for (unsigned int thread = 0; thread < 8; ++thread)
        threads.emplace_back([thread] {
            for (unsigned int i = 0; i < 2000; ++i) {
                NVMessageBuffer outer;
                NVMessageBuffer inner;
                outer << thread << " " << i;
                inner << i;
                ASSERT_EQ(takeText(outer), std::to_string(thread) + " " + std::to_string(i));
                ASSERT_EQ(takeText(inner), std::to_string(i));
            }
        });
    for (auto& thread : threads) thread.join();
}
