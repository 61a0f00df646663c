#include "provider/Look.h"

#include <dlfcn.h>
#include <gtest/gtest.h>

namespace {

void count(void* calls) {
    ++*static_cast<int*>(calls);
}

// As with a stand-in for libvkcommon; the product's libraries are not in this program.
TEST(Look, IsDoneWithoutWhereNoLibraryHasOne) {
    ASSERT_EQ(dlsym(RTLD_DEFAULT, "vkWithinLook"), nullptr);
    int calls = 0;
    VK::BaseServerProvider::withinLook(count, &calls);
    VK::BaseServerProvider::withinLook(count, &calls);
    EXPECT_EQ(calls, 2);
}

} // namespace
