#include "objectmanager/cimxml/Writer.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Typing.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>

#include <limits>

namespace cimxml {
namespace {

std::string written(const om::Value& value) {
    Writer writer;
    writer.value(value);
    return writer.take();
}

om::ObjectPath thing() {
    om::ObjectPath path;
    path.nameSpace = "root/x";
    path.className = "Test_Thing";
    path.keys = {{"Name", {CMPI_string, std::string(" a<b ")}}};
    return path;
}

TEST(Writer, WritesValuesInTheSpellingOfTheirType) {
    EXPECT_EQ(written({CMPI_boolean, true}), "<VALUE>TRUE</VALUE>");
    EXPECT_EQ(written({CMPI_uint64, UINT64_MAX}), "<VALUE>18446744073709551615</VALUE>");
    EXPECT_EQ(written({CMPI_sint8, std::int64_t{-5}}), "<VALUE>-5</VALUE>");
    EXPECT_EQ(written({CMPI_real32, 1.5}), "<VALUE>1.5000000000e+00</VALUE>");
    EXPECT_EQ(written({CMPI_real64, -std::numeric_limits<double>::infinity()}), "<VALUE>-INF</VALUE>");
    EXPECT_EQ(written({CMPI_char16, std::uint64_t{'<'}}), "<VALUE>&lt;</VALUE>");
    EXPECT_EQ(written({CMPI_char16, std::uint64_t{0x20AC}}), "<VALUE>\xE2\x82\xAC</VALUE>");
    EXPECT_EQ(written({CMPI_char16, std::uint64_t{0xD800}}), "<VALUE>\xEF\xBF\xBD</VALUE>");
    EXPECT_EQ(written({CMPI_string, std::string()}), "<VALUE></VALUE>");
    EXPECT_EQ(written({CMPI_string, {}}), "");
    EXPECT_EQ(written({CMPI_stringA, std::vector<om::Value>()}), "<VALUE.ARRAY></VALUE.ARRAY>");
    EXPECT_EQ(written({CMPI_uint8A, std::vector<om::Value>{{CMPI_uint8, std::uint64_t{1}}, {CMPI_uint8, {}}}}),
              "<VALUE.ARRAY><VALUE>1</VALUE><VALUE.NULL></VALUE.NULL></VALUE.ARRAY>");
}

TEST(Writer, WritesKeysWithTheirType) {
    Writer writer;
    om::ObjectPath path = thing();
    path.keys.push_back({"Slot", {CMPI_uint16, std::uint64_t{2}}});
    path.keys.push_back({"On", {CMPI_boolean, false}});
    writer.instanceName(path);
    EXPECT_EQ(
        writer.text(),
        "<INSTANCENAME CLASSNAME=\"Test_Thing\">"
        "<KEYBINDING NAME=\"Name\"><KEYVALUE VALUETYPE=\"string\" TYPE=\"string\"> a&lt;b </KEYVALUE></KEYBINDING>"
        "<KEYBINDING NAME=\"Slot\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint16\">2</KEYVALUE></KEYBINDING>"
        "<KEYBINDING NAME=\"On\"><KEYVALUE VALUETYPE=\"boolean\" TYPE=\"boolean\">FALSE</KEYVALUE></KEYBINDING>"
        "</INSTANCENAME>");
}

TEST(Writer, AnEmptyElementIsAPairOfTags) {
    Writer writer;
    writer.property("N", {CMPI_uint8, {}});
    writer.property("A", {CMPI_stringA, {}});
    EXPECT_EQ(writer.text(), "<PROPERTY NAME=\"N\" TYPE=\"uint8\"></PROPERTY>"
                             "<PROPERTY.ARRAY NAME=\"A\" TYPE=\"string\"></PROPERTY.ARRAY>");
}

TEST(Writer, PathsCarryHostAndNamespace) {
    Writer writer;
    om::ObjectPath path = thing();
    path.keys.clear();
    writer.instancePath(path, "node7");
    EXPECT_EQ(writer.text(),
              "<INSTANCEPATH><NAMESPACEPATH><HOST>node7</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\">"
              "</NAMESPACE><NAMESPACE NAME=\"x\"></NAMESPACE></LOCALNAMESPACEPATH></NAMESPACEPATH>"
              "<INSTANCENAME CLASSNAME=\"Test_Thing\"></INSTANCENAME></INSTANCEPATH>");
}

om::Instance wholeInstance() {
    om::Instance embedded;
    embedded.path.nameSpace = "root/x";
    embedded.path.className = "Test_Thing";
    embedded.properties = {{"Name", {CMPI_string, std::string("in & side")}}};
    om::Instance instance;
    instance.path.nameSpace = "root/x";
    instance.path.className = "Test_Thing";
    instance.properties = {
        {"Name", {CMPI_string, std::string(" a\n<b>\r&amp; \xC3\xA4 ")}},
        {"Speed", {CMPI_uint16, std::uint64_t{65535}}},
        {"States", {CMPI_uint16A, std::vector<om::Value>{{CMPI_uint16, std::uint64_t{2}}, {CMPI_uint16, {}}}}},
        {"Since", {CMPI_dateTime, std::string("20240229235959.000000+060")}},
        {"Owner", {CMPI_ref, std::make_shared<const om::ObjectPath>(thing())}},
        {"Inside", {CMPI_instance, std::make_shared<const om::Instance>(embedded)}},
        {"Ratio", {CMPI_real32, static_cast<double>(0.1F)}},
        {"Exact", {CMPI_real64, 0.1}},
        {"Letter", {CMPI_char16, std::uint64_t{0x20AC}}},
        {"Nothing", {CMPI_sint64, {}}}};
    return instance;
}

TEST(Writer, WhatItWritesReadsBackTheSame) {
    Writer writer;
    writer.instance(wholeInstance());
    pugi::xml_document document;
    load(document, writer.text());
    const om::Instance again =
        typedInstance(readInstance(document.document_element()), {vkcim::testSchema(), "root/x", Trust::Message});
    EXPECT_EQ(again, wholeInstance());
}

TEST(Writer, SaysWhereAPropertyComesFrom) {
    Writer writer;
    writer.property("A", {CMPI_boolean, true}, [](const std::string&) { return std::string_view("CIM_Above"); });
    EXPECT_EQ(writer.text(),
              "<PROPERTY NAME=\"A\" TYPE=\"boolean\" CLASSORIGIN=\"CIM_Above\"><VALUE>TRUE</VALUE></PROPERTY>");
}

TEST(Writer, ParametersCarryTheirType) {
    Writer writer;
    writer.returnValue({CMPI_uint32, std::uint64_t{0}});
    writer.parameter("To", {CMPI_ref, std::make_shared<const om::ObjectPath>(thing())});
    EXPECT_THAT(writer.text(), testing::StartsWith("<RETURNVALUE PARAMTYPE=\"uint32\"><VALUE>0</VALUE></RETURNVALUE>"
                                                   "<PARAMVALUE NAME=\"To\" PARAMTYPE=\"reference\"><VALUE.REFERENCE>"
                                                   "<LOCALINSTANCEPATH>"));
}

} // namespace
} // namespace cimxml
