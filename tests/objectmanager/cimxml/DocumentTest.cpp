#include "objectmanager/cimxml/Document.h"

#include "objectmanager/cimxml/Errors.h"

#include <gmock/gmock.h>

namespace cimxml {
namespace {

std::string nested(int depth) {
    std::string text;
    for (int i = 0; i < depth; ++i) text += "<A>";
    for (int i = 0; i < depth; ++i) text += "</A>";
    return text;
}

TEST(Document, ReadsWhatXmlAllows) {
    const std::string good[] = {"<A/>",
                                "<A></A>",
                                "<?xml version='1.0'?><A/>",
                                "\xEF\xBB\xBF<A/>",
                                "<!-- < & > --><A/><!-- after -->",
                                "<A x='1>2' y=\"'\"/>",
                                "<A><![CDATA[ <!DOCTYPE & ]]></A>",
                                "<A>&lt;&gt;&amp;&quot;&apos;&#65;&#x41;&#10;</A>",
                                "<A>\xC3\xA4 \xF0\x9F\x98\x80</A>",
                                "<A>\t\r\n</A>",
                                "  <A/>  ",
                                nested(deepestElement)};
    for (const std::string& text : good) {
        pugi::xml_document document;
        EXPECT_NO_THROW(load(document, text)) << text;
        EXPECT_STREQ(document.document_element().name(), "A") << text;
    }
}

TEST(Document, IsRefusedWithMoreElementsThanAreTaken) {
    pugi::xml_document document;
    EXPECT_NO_THROW(load(document, "<A><V/><V></V></A>", 3));
    try {
        load(document, "<A><V/><V></V><V/></A>", 3);
        ADD_FAILURE();
    } catch (const Refusal& refusal) {
        EXPECT_EQ(refusal.cimError, "request-not-valid");
    }
}

TEST(Document, RefusesTheRest) {
    struct {
        std::string text;
        const char* cimError;
    } const bad[] = {
        {"", "request-not-well-formed"},
        {"   ", "request-not-well-formed"},
        {"hello", "request-not-well-formed"},
        {"<A>", "request-not-well-formed"},
        {"<A", "request-not-well-formed"},
        {"<A></B>", "request-not-well-formed"},
        {"<A><B></A></B>", "request-not-well-formed"},
        {"<A/><B/>", "request-not-well-formed"},
        {"<A x=1/>", "request-not-well-formed"},
        {"<A x='1/>", "request-not-well-formed"},
        {"<A x='<'/>", "request-not-well-formed"},
        {"<A>&unknown;</A>", "request-not-well-formed"},
        {"<A x='&unknown;'/>", "request-not-well-formed"},
        {"<A>&</A>", "request-not-well-formed"},
        {"<A>& </A>", "request-not-well-formed"},
        {"<A>&#0;</A>", "request-not-well-formed"},
        {"<A>&#x1;</A>", "request-not-well-formed"},
        {"<A>&#xD800;</A>", "request-not-well-formed"},
        {"<A>&#xFFFF;</A>", "request-not-well-formed"},
        {"<A>&#x110000;</A>", "request-not-well-formed"},
        {"<A>&#99999999999;</A>", "request-not-well-formed"},
        {"<A>&#;</A>", "request-not-well-formed"},
        {"<A>&#x;</A>", "request-not-well-formed"},
        {"<A>&#-5;</A>", "request-not-well-formed"},
        {"<A>\x01</A>", "request-not-well-formed"},
        {std::string("<A>\0</A>", 8), "request-not-well-formed"},
        {"<A>\xEF\xBF\xBF</A>", "request-not-well-formed"},
        {"<A>\xC3</A>", "request-not-well-formed"},
        {"<A>\xC0\x80</A>", "request-not-well-formed"},
        {"<A>\xED\xA0\x80</A>", "request-not-well-formed"},
        {"<A>\xE4</A>", "request-not-well-formed"}, // Latin-1
        {std::string("\xFF\xFE<\0A\0/\0>\0", 10), "request-not-well-formed"},
        {"<A><!-- </A>", "request-not-well-formed"},
        {"<A><![CDATA[ </A>", "request-not-well-formed"},
        {"<?xml", "request-not-well-formed"},
        {"<!DOCTYPE A><A/>", "request-not-valid"},
        {"<!DOCTYPE A SYSTEM 'file:///etc/passwd'><A/>", "request-not-valid"},
        {"<!DOCTYPE A [<!ENTITY x 'y'>]><A>&x;</A>", "request-not-valid"},
        {"<A><!DOCTYPE B></A>", "request-not-valid"},
        {"<!ENTITY x 'y'><A/>", "request-not-valid"},
        {nested(deepestElement + 1), "request-not-valid"},
        {nested(100000), "request-not-valid"},
    };
    for (const auto& each : bad) {
        pugi::xml_document document;
        try {
            load(document, each.text);
            ADD_FAILURE() << each.text.substr(0, 60) << " was read";
        } catch (const Refusal& refusal) {
            EXPECT_EQ(refusal.status, 400U);
            EXPECT_EQ(refusal.cimError, each.cimError) << each.text.substr(0, 60);
        }
    }
}

TEST(Document, KeepsTextOfBlanksWhereItStandsAlone) {
    pugi::xml_document document;
    load(document, "<A> <B>  </B> </A>");
    EXPECT_STREQ(document.child("A").child("B").text().get(), "  ");
}

} // namespace
} // namespace cimxml
