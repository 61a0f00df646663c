#include "Linux/ServiceAffectsElement.h"

#include <gmock/gmock.h>

#include <unistd.h>

namespace {

using testing::ElementsAre;
using testing::Pair;
using VK::Moniker;
using VK::BaseServerProvider::TimeServiceAffectsElement;

using Keys = std::vector<std::pair<std::string, std::string>>;

Moniker monikerOf(const Keys& keys) {
    Moniker moniker;
    for (const auto& [name, value] : keys) moniker.addKey(name, value);
    return moniker;
}

Keys keysOf(Moniker moniker) {
    Keys keys(moniker.getKeyCount());
    for (unsigned int index = 0; index < keys.size(); ++index) {
        moniker.selectKey(index);
        moniker.getName(keys[index].first);
        moniker.getValue(keys[index].second);
    }
    return keys;
}

std::string hostName() {
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    return name;
}

const Keys anyKeys[] = {{}, {{"Name", hostName()}}, {{"SystemName", "another"}}, {{"Colour", "red"}, {"Name", ""}}};

TEST(TimeServiceAffectsElement, MapsAnyComputerToTheTimeServiceOfThisHost) {
    for (const Keys& keys : anyKeys) {
        Moniker computer = monikerOf(keys);
        EXPECT_THAT(keysOf(TimeServiceAffectsElement().getTimeMoniker(computer)),
                    ElementsAre(Pair("SystemName", hostName())));
        EXPECT_EQ(keysOf(computer), keys) << "the argument is not touched";
    }
}

TEST(TimeServiceAffectsElement, MapsAnyTimeServiceToTheComputerOfThisHost) {
    for (const Keys& keys : anyKeys) {
        Moniker service = monikerOf(keys);
        EXPECT_THAT(keysOf(TimeServiceAffectsElement().getComputerMoniker(service)),
                    ElementsAre(Pair("Name", hostName())));
        EXPECT_EQ(keysOf(service), keys) << "the argument is not touched";
    }
}

} // namespace
