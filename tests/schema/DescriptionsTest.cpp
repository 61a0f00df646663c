// What a class of ours says of the properties that it inherits and does not declare.
#include "objectmanager/model/NumberText.h"
#include "objectmanager/mof/Checker.h"
#include "objectmanager/mof/Parser.h"

#include <gmock/gmock.h>

#include <fstream>
#include <sstream>

namespace {

void addFile(mof::Checker& checker, const std::string& name, bool ours) {
    std::ostringstream text;
    text << std::ifstream(VK_SCHEMA_FILES "/" + name).rdbuf();
    checker.add(mof::parse(text.str(), name), ours);
}

/// The default values that an object manager adds to instances of a class: `EnabledState 5`.
std::vector<std::string> inheritedDefaults(const om::Schema& schema, const std::string& className) {
    std::vector<std::string> found;
    for (const om::ClassDeclaration* above : schema.line(schema.find(className)->superclass)) {
        for (const om::PropertyDeclaration& property : above->properties) {
            if (!property.defaultValue.isNull() && schema.findProperty(className, property.name) == &property)
                found.push_back(property.name + ' ' + om::numberText(property.defaultValue));
        }
    }
    return found;
}

TEST(Descriptions, NameTheDefaultValuesThatAnObjectManagerAdds) {
    mof::Checker checker;
    addFile(checker, "superclasses.mof", false);
    addFile(checker, "vk-baseserver.mof", true);
    ASSERT_THAT(checker.complaints(), testing::IsEmpty());
    const om::Schema& schema = checker.schema();
    EXPECT_EQ(schema.served().size(), 8U);
    for (const std::string& name : schema.served()) {
        const std::string description(om::textOf(schema.find(name)->qualifiers, "Description"));
        for (const std::string& value : inheritedDefaults(schema, name)) {
            EXPECT_THAT(description, testing::HasSubstr(value)) << name;
        }
    }
    EXPECT_EQ(inheritedDefaults(schema, "VESKA_TimeService").size(), 4U);
}

} // namespace
