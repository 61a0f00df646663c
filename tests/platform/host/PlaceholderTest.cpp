#include "host/Placeholder.h"

#include "host/Smbios.h"
#include "support/RealMachines.h"
#include "vk/Root.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <iterator>
#include <map>
#include <set>
#include <string>

namespace VK::Host {

namespace {

struct Row {
    FirmwareText kind;
    const char* text;
};

constexpr Row sayNothing[] = {
#define SAYS_NOTHING(KIND, TEXT) {FirmwareText::KIND, TEXT},
#define SAYS_SOMETHING(KIND, TEXT)
#include "support/FirmwareTexts.inc"
#undef SAYS_NOTHING
#undef SAYS_SOMETHING
};

constexpr Row saySomething[] = {
#define SAYS_NOTHING(KIND, TEXT)
#define SAYS_SOMETHING(KIND, TEXT) {FirmwareText::KIND, TEXT},
#include "support/FirmwareTexts.inc"
#undef SAYS_NOTHING
#undef SAYS_SOMETHING
};

TEST(Placeholder, IsSeenThrough) {
    for (const Row& row : sayNothing) EXPECT_TRUE(isPlaceholder(row.text, row.kind)) << row.text;
}

TEST(Placeholder, LeavesWhatTellsSomething) {
    for (const Row& row : saySomething) {
        const PlaceholderRule* rule = placeholderRule(row.text, row.kind);
        EXPECT_EQ(rule, nullptr) << row.text << " is taken for " << (rule != nullptr ? rule->reason : "");
    }
}

TEST(Placeholder, IsOneInAnyLetterCaseWithBlanksAndDotsAround) {
    for (const Row& row : sayNothing) {
        std::string text = row.text;
        std::transform(text.begin(), text.end(), text.begin(),
                       [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
        EXPECT_TRUE(isPlaceholder(" ." + text + ". . ", row.kind)) << text;
    }
}

TEST(Placeholder, HasTheRuleThatSaysWhy) {
    const auto reason = [](const char* text) { return placeholderRule(text, FirmwareText::Other)->reason; };
    EXPECT_THAT(std::string(reason("0123456789")), testing::StartsWith("counts up or down"));
    EXPECT_THAT(std::string(reason("System SKU#")), testing::StartsWith("the name of the field itself"));
    EXPECT_THAT(std::string(reason("SKU=NotProvided;ModelName=X")), testing::HasSubstr("without the SKU"));
}

TEST(Placeholder, RulesAllHaveATextThatTheyAreFor) {
    std::set<std::string_view> reasons;
    for (const Row& row : sayNothing)
        if (const PlaceholderRule* const rule = placeholderRule(row.text, row.kind)) reasons.insert(rule->reason);
    constexpr const char* all[] = {
#define PLACEHOLDER(MATCH, MACHINES, REASON, TEXTS) REASON,
#include "host/Placeholders.inc"
    };
    for (const char* reason : all) EXPECT_EQ(reasons.count(reason), 1U) << reason;
    EXPECT_EQ(reasons.size(), std::size(all)); // no two rules have the same
}

/// The reasons why texts of a machine's tables say nothing.
std::set<std::string_view> reasonsOn(const Smbios& smbios) {
    std::set<std::string_view> reasons;
    const auto look = [&reasons](const std::string& text, FirmwareText kind) {
        const PlaceholderRule* const rule = text.empty() ? nullptr : placeholderRule(text, kind);
        if (rule != nullptr) reasons.insert(rule->reason);
    };
    if (const auto& system = smbios.system) {
        for (const auto& text : {system->manufacturer, system->serial, system->sku}) look(text, FirmwareText::Other);
        for (const auto& text : {system->product, system->version}) look(text, FirmwareText::Model);
    }
    for (const SmbiosChassis& chassis : smbios.chassis) {
        for (const auto& text : {chassis.manufacturer, chassis.serial}) look(text, FirmwareText::Other);
        look(chassis.version, FirmwareText::Model);
        look(chassis.sku, FirmwareText::ChassisSku);
    }
    return reasons;
}

TEST(Placeholder, RulesStateOnHowManyOfTheTestsMachinesTheyWereSeen) {
    const char* const directory = support::realMachines();
    if (directory == nullptr) GTEST_SKIP() << support::noRealMachines;
    std::map<std::string_view, unsigned int> machines;
    for (const std::string& name : Root(directory).list("/").names) {
        const Root machine(std::string(directory) + "/" + name);
        const Smbios smbios = parseSmbios(machine.read("/sys/firmware/dmi/tables/smbios_entry_point").text,
                                          machine.read("/sys/firmware/dmi/tables/DMI").text);
        for (const std::string_view reason : reasonsOn(smbios)) ++machines[reason];
    }
    EXPECT_FALSE(machines.empty());
    constexpr unsigned int notCounted = 0;
#define PLACEHOLDER(MATCH, MACHINES, REASON, TEXTS) EXPECT_EQ(machines[REASON], MACHINES) << REASON;
#include "host/Placeholders.inc"
}

} // namespace

} // namespace VK::Host
