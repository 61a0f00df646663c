#include "common/HostLook.h"

#include "support/InChild.h"
#include "vk/WithinLook.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdlib>
#include <functional>
#include <optional>

namespace VK {

namespace {

/// Sources of which each answer is another.
struct Sources {
    int ask(std::size_t source = 0) {
        return *HostLook::once<int>(&places.at(source), [&] { return std::make_shared<const int>(++asked); });
    }
    void forget(std::size_t source = 0) { HostLook::forget(&places.at(source)); }

    std::array<char, 10> places{};
    int asked = 0;
};

/// In a process of its own, whose host is a simulated one.
void onSimulatedHost(const std::function<void()>& run) {
    support::inOwnProcess([&] {
        setenv("VK_INSTRUMENTATION_TREE", "/nowhere", 1);
        run();
    });
}

TEST(HostLook, AsksASourceOnce) {
    onSimulatedHost([] {
        Sources sources;
        EXPECT_EQ(sources.ask(), 1);
        EXPECT_EQ(sources.ask(), 2) << "there is no look";
        std::optional<HostLook> look(std::in_place);
        EXPECT_EQ(sources.ask(), 3);
        EXPECT_EQ(sources.ask(), 3);
        EXPECT_EQ(sources.ask(1), 4) << "another source";
        EXPECT_EQ(sources.ask(), 3);
        look.reset();
        EXPECT_EQ(sources.ask(), 5);
    });
}

TEST(HostLook, AsksAgainAfterAChangeOfOurOwn) {
    onSimulatedHost([] {
        Sources sources;
        const HostLook look;
        EXPECT_EQ(sources.ask(0), 1);
        EXPECT_EQ(sources.ask(1), 2);
        sources.forget(0);
        EXPECT_EQ(sources.ask(0), 3);
        EXPECT_EQ(sources.ask(0), 3);
        EXPECT_EQ(sources.ask(1), 2);
    });
}

TEST(HostLook, WithinAnotherIsTheSame) {
    onSimulatedHost([] {
        Sources sources;
        const HostLook outer;
        EXPECT_EQ(sources.ask(), 1);
        {
            const HostLook inner;
            EXPECT_EQ(sources.ask(), 1);
        }
        EXPECT_EQ(sources.ask(), 1);
        vkWithinLook([](void* asked) { EXPECT_EQ(static_cast<Sources*>(asked)->ask(), 1); }, &sources);
    });
}

TEST(HostLook, LastsAsLongAsTheWorkWithinIt) {
    onSimulatedHost([] {
        Sources sources;
        vkWithinLook(
            [](void* asked) {
                EXPECT_EQ(static_cast<Sources*>(asked)->ask(), 1);
                EXPECT_EQ(static_cast<Sources*>(asked)->ask(), 1);
            },
            &sources);
        EXPECT_EQ(sources.ask(), 2);
    });
}

TEST(HostLook, KeepsNoMoreThanEightSources) {
    onSimulatedHost([] {
        Sources sources;
        const HostLook look;
        for (std::size_t i = 0; i < 9; ++i) sources.ask(i);
        EXPECT_EQ(sources.ask(7), 8);
        EXPECT_EQ(sources.ask(8), 10) << "asked each time";
        EXPECT_EQ(sources.ask(8), 11);
    });
}

TEST(HostLook, KeepsNothingOfThisHost) {
    support::inOwnProcess([] {
        unsetenv("VK_INSTRUMENTATION_TREE");
        unsetenv("VK_INSTRUMENTATION_ROOT");
        Sources sources;
        const HostLook look;
        EXPECT_EQ(sources.ask(), 1);
        EXPECT_EQ(sources.ask(), 2);
    });
}

} // namespace

} // namespace VK
