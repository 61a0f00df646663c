#include "Linux/SingleElement.h"

#include "Linux/CIMServiceConfig.h"
#include "Linux/TimeService.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <memory>

namespace {

class Sample : public VK::BaseServerProvider::SingleElement {};

TEST(SingleElement, StandsOnOneElementAndIsPastItAfterOneStep) {
    Sample sample;
    EXPECT_TRUE(static_cast<bool>(sample));
    EXPECT_EQ(&++sample, &sample);
    EXPECT_FALSE(static_cast<bool>(sample));
    ++sample;
    EXPECT_FALSE(static_cast<bool>(sample));
}

TEST(SingleElement, IsWalkedOnceByALoop) {
    unsigned int seen = 0;
    for (Sample sample; sample; ++sample) ++seen;
    EXPECT_EQ(seen, 1U);
}

TEST(SingleElement, HasNothingToFilter) {
    Sample sample;
    sample.setFilter(Sample::FilterType{}, "another");
    EXPECT_TRUE(static_cast<bool>(sample));
}

} // namespace
