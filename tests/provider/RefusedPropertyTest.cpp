#pragma GCC visibility push(default)
#include "nvlog/NVLogger.h"
#pragma GCC visibility pop

#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

// This program's own logger, which stands before the product's: it counts the lines of the provider utilities, and may
// throw at each of them.

namespace {

int refusals = 0;
bool throws = false;

void receive(const std::string& category, int level) {
    if (category != "Norvane.ProviderUtilities" || level != 6000) return;
    ++refusals;
    if (throws) throw 42;
}

} // namespace

namespace NVLog {

void NVLogger::logLevelMessage(const char*, const char*, int, const std::string& category, int level, char*, int, int,
                               const std::string&) {
    receive(category, level);
}

void NVLogger::traceLevelMessage(const char*, const char*, int, const std::string& category, int level, char*, int, int,
                                 const std::string&) {
    receive(category, level);
}

} // namespace NVLog

namespace {

/// Declares "Description" as a number, so that the broker refuses the text.
om::Schema schemaWithNumericDescription() {
    const auto& builtin = om::Schema::builtin().classes();
    std::vector<om::ClassDeclaration> classes(builtin.begin(), builtin.end());
    for (om::ClassDeclaration& each : classes)
        for (om::PropertyDeclaration& property : each.properties)
            if (property.name == "Description") property.type = CMPI_uint16;
    return om::Schema(classes);
}

class RefusedProperty : public testing::TestWithParam<bool> {};

TEST_P(RefusedProperty, IsLeftOutAndLoggedOnceWhateverTheLoggerDoes) {
    test::simulate({test::computer(0, "node7")});
    const om::Schema schema = schemaWithNumericDescription();
    om::ObjectManager manager(VK_PROVIDER_LIBRARY, "BaseServerProvider", "root/cimv2", schema);
    om::Request request;
    request.operation = om::Operation::EnumInstances;
    request.path = test::path("VESKA_ComputerSystem");
    throws = GetParam();
    refusals = 0;
    const om::Answer answer = manager.run(request);
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_TRUE(answer.done);
    EXPECT_EQ(refusals, 1);
    const std::vector<om::Instance> found = test::instancesOf(answer);
    ASSERT_EQ(found.size(), 1U);
    EXPECT_EQ(test::find(found[0].properties, "Description"), nullptr);
    EXPECT_EQ(test::text(*test::find(found[0].properties, "ElementName")), "node7");
    EXPECT_EQ(test::text(*test::find(found[0].properties, "Status")), "OK");
}

INSTANTIATE_TEST_SUITE_P(, RefusedProperty, testing::Bool(), [](const auto& each) {
    return std::string(each.param ? "WithALoggerThatThrows" : "WithALoggerThatWrites");
});

} // namespace
