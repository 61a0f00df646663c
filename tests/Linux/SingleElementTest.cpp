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

TEST(SingleElement, IsWalkedWithoutALine) {
    test::simulate({test::computer(0, "node7")});
    VK::BaseServerProvider::TimeService service;
    VK::BaseServerProvider::CIMServiceConfig configuration;
    const auto walk = [](auto& element) {
        element.setFilter({}, "another");
        EXPECT_TRUE(static_cast<bool>(element));
        ++element;
        EXPECT_FALSE(static_cast<bool>(element));
    };
    test::takeLog();
    walk(service);
    walk(configuration);
    EXPECT_THAT(test::takeLog(), testing::IsEmpty());
    EXPECT_TRUE(service.getName(*std::make_unique<std::string>())) << "which writes, unlike these";
    EXPECT_THAT(test::takeLog(), testing::Not(testing::IsEmpty()));
}

} // namespace
