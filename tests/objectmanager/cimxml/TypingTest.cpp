#include "objectmanager/cimxml/Typing.h"

#include "objectmanager/cimxml/Errors.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>

#include <cmath>

namespace cimxml {
namespace {

using Kind = ValueElement::Kind;

Reading reading(Trust trust = Trust::Schema) {
    return {vkcim::testSchema(), "root/x", trust};
}

ValueElement text(const std::string& content) {
    ValueElement element;
    element.kind = Kind::Text;
    element.text = content;
    return element;
}

om::Value typed(const std::string& content, int type) {
    return typedValue(text(content), static_cast<CMPIType>(type), reading());
}

TEST(Typing, ReadsTextsOfEveryType) {
    EXPECT_EQ(std::get<bool>(typed(" tRuE ", CMPI_boolean).data), true);
    EXPECT_EQ(std::get<bool>(typed("FALSE", CMPI_boolean).data), false);
    EXPECT_EQ(std::get<std::uint64_t>(typed(" 255\n", CMPI_uint8).data), 255U);
    EXPECT_EQ(std::get<std::uint64_t>(typed("0x1F", CMPI_uint16).data), 31U);
    EXPECT_EQ(std::get<std::uint64_t>(typed("18446744073709551615", CMPI_uint64).data), UINT64_MAX);
    EXPECT_EQ(std::get<std::int64_t>(typed("-128", CMPI_sint8).data), -128);
    EXPECT_EQ(std::get<std::int64_t>(typed("-0X10", CMPI_sint8).data), -16);
    EXPECT_EQ(std::get<double>(typed("1.5E+10", CMPI_real64).data), 1.5e10);
    EXPECT_EQ(std::get<double>(typed(".5", CMPI_real32).data), 0.5);
    EXPECT_TRUE(std::isnan(std::get<double>(typed("nan", CMPI_real32).data)));
    EXPECT_EQ(std::get<double>(typed("-inf", CMPI_real64).data), -HUGE_VAL);
    EXPECT_EQ(std::get<std::string>(typed(" blanks stay ", CMPI_string).data), " blanks stay ");
    EXPECT_EQ(std::get<std::uint64_t>(typed("\xE2\x82\xAC", CMPI_char16).data), 0x20ACU);
    EXPECT_EQ(std::get<std::string>(typed("20240229235959.000000+060", CMPI_dateTime).data),
              "20240229235959.000000+060");
}

TEST(Typing, RefusesTextsThatAreNoSuchValue) {
    struct {
        const char* content;
        int type;
    } const bad[] = {{"1", CMPI_boolean},
                     {"", CMPI_boolean},
                     {"yes", CMPI_boolean},
                     {"256", CMPI_uint8},
                     {"-1", CMPI_uint8},
                     {"+5", CMPI_uint8},
                     {"", CMPI_uint32},
                     {"5 5", CMPI_uint32},
                     {"0x", CMPI_uint32},
                     {"0xG", CMPI_uint32},
                     {"1.0", CMPI_uint32},
                     {"0x1FFFFFFFFFFFFFFFF", CMPI_uint64},
                     {"-129", CMPI_sint8},
                     {"NaN", CMPI_uint32},
                     {"", CMPI_real32},
                     {"1e999", CMPI_real64},
                     {"Infinity", CMPI_real64},
                     {"0x10", CMPI_real64},
                     {"", CMPI_char16},
                     {"65", CMPI_char16},
                     {"\xF0\x9F\x98\x80", CMPI_char16},
                     {"", CMPI_dateTime},
                     {"20230229000000.000000+000", CMPI_dateTime},
                     {"text", CMPI_ref},
                     {"1", CMPI_uint8A}};
    for (const auto& each : bad) {
        try {
            typed(each.content, each.type);
            ADD_FAILURE() << each.content << " was read";
        } catch (const CimError& error) {
            EXPECT_EQ(error.code, CMPI_RC_ERR_TYPE_MISMATCH) << each.content;
        }
    }
    EXPECT_THROW(typed("<X/>", CMPI_instance), CimError);
}

TEST(Typing, KeepsNullsTyped) {
    const om::Value null = typedValue({}, CMPI_uint16A, reading());
    EXPECT_TRUE(null.isNull());
    EXPECT_EQ(null.type, CMPI_uint16A);
    ValueElement array;
    array.kind = Kind::Array;
    array.elements = {text("1"), {}};
    const om::Value value = typedValue(array, CMPI_uint16A, reading());
    const auto& elements = std::get<std::vector<om::Value>>(value.data);
    EXPECT_EQ(elements.at(0), (om::Value{CMPI_uint16, std::uint64_t{1}}));
    EXPECT_EQ(elements.at(1), (om::Value{CMPI_uint16, {}}));
}

KeyElement key(const std::string& name, const std::string& content, const char* valueType, const char* type = "") {
    KeyElement element;
    element.name = name;
    element.valueType = valueType;
    element.type = type;
    element.value = text(content);
    return element;
}

TEST(Typing, TheSchemaTypesKeysAndSpellsNames) {
    PathElement path;
    path.className = "test_thing";
    path.keys = {key("name", "5", "numeric", "uint8")};
    const om::ObjectPath typedOne = typedPath(path, reading());
    EXPECT_EQ(typedOne.className, "Test_Thing");
    EXPECT_EQ(typedOne.nameSpace, "root/x");
    EXPECT_EQ(typedOne.keys.at(0), (om::NamedValue{"Name", {CMPI_string, std::string("5")}}));
    path.keys.front().name.clear(); // the only key need not be named
    EXPECT_EQ(typedPath(path, reading()).keys.at(0).first, "Name");
}

TEST(Typing, AKeyThatTheSchemaLacksIsWhatTheMessageSays) {
    PathElement path;
    path.className = "Unknown";
    path.keys = {key("A", "5", "numeric"), key("B", "18446744073709551615", "numeric"), key("C", "true", "boolean"),
                 key("D", "5", "string"), key("E", "5", "numeric", "uint8")};
    const auto keys = typedPath(path, reading()).keys;
    EXPECT_EQ(keys.at(0).second, (om::Value{CMPI_sint64, std::int64_t{5}}));
    EXPECT_EQ(keys.at(1).second, (om::Value{CMPI_uint64, UINT64_MAX}));
    EXPECT_EQ(keys.at(2).second, (om::Value{CMPI_boolean, true}));
    EXPECT_EQ(keys.at(3).second, (om::Value{CMPI_string, std::string("5")}));
    EXPECT_EQ(keys.at(4).second, (om::Value{CMPI_uint8, std::uint64_t{5}}));
}

TEST(Typing, RefusesAKeyGivenTwiceAndOneWithoutAName) {
    PathElement path;
    path.className = "Unknown";
    path.keys = {key("A", "5", "string"), key("a", "5", "string")};
    EXPECT_THROW(typedPath(path, reading()), CimError);
    path.keys = {key("", "5", "string")};
    EXPECT_THROW(typedPath(path, reading()), CimError);
}

TEST(Typing, AReferenceLiesWhereThePathAroundItLies) {
    auto inner = std::make_shared<PathElement>();
    inner->className = "Test_Thing";
    KeyElement from;
    from.name = "From";
    from.value.kind = Kind::Reference;
    from.value.path = inner;
    PathElement link;
    link.className = "Test_Link";
    link.nameSpace = "root/y";
    link.keys = {from};
    const om::ObjectPath path = typedPath(link, reading());
    EXPECT_EQ(std::get<std::shared_ptr<const om::ObjectPath>>(path.keys.at(0).second.data)->nameSpace, "root/y");
    inner->nameSpace = "root/z";
    EXPECT_EQ(
        std::get<std::shared_ptr<const om::ObjectPath>>(typedPath(link, reading()).keys.at(0).second.data)->nameSpace,
        "root/z");
}

PropertyElement property(const std::string& name, const std::string& type, const std::string& content) {
    PropertyElement element;
    element.name = name;
    element.type = type;
    element.value = text(content);
    return element;
}

TEST(Typing, APropertyOfARequestHasTheSchemasType) {
    InstanceElement instance;
    instance.className = "TEST_SPECIALTHING";
    instance.properties = {property("speed", "uint16", "5"), property("Extra", "string", "x")};
    const om::Instance good = typedInstance(instance, reading());
    EXPECT_EQ(good.path.className, "Test_SpecialThing");
    EXPECT_EQ(good.properties.at(0), (om::NamedValue{"Speed", {CMPI_uint16, std::uint64_t{5}}}));
    EXPECT_EQ(good.properties.at(1).second.type, CMPI_string);
    instance.properties = {property("Speed", "uint32", "5")};
    EXPECT_THROW(typedInstance(instance, reading()), CimError);
    EXPECT_EQ(typedInstance(instance, reading(Trust::Message)).properties.at(0).second.type, CMPI_uint32);
    instance.properties = {property("Speed", "int", "5")};
    EXPECT_THROW(typedInstance(instance, reading()), CimError);
}

TEST(Typing, ReadsAnInstanceInAText) {
    const om::Value value = typed("<INSTANCE CLASSNAME=\"Test_Thing\"><PROPERTY NAME=\"Speed\" "
                                  "TYPE=\"uint16\"><VALUE>7</VALUE></PROPERTY></INSTANCE>",
                                  CMPI_instance);
    const auto& instance = *std::get<std::shared_ptr<const om::Instance>>(value.data);
    EXPECT_EQ(instance.properties.at(0).second, (om::Value{CMPI_uint16, std::uint64_t{7}}));
}

} // namespace
} // namespace cimxml
