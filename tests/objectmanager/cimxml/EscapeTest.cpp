#include "objectmanager/cimxml/Escape.h"

#include <gmock/gmock.h>

namespace cimxml {
namespace {

std::string asText(std::string_view text) {
    std::string out;
    appendText(out, text);
    return out;
}

std::string asAttribute(std::string_view text) {
    std::string out;
    appendAttribute(out, text);
    return out;
}

TEST(Escape, WritesMarkupAsReferences) {
    EXPECT_EQ(asText("a<b>&\"c'"), "a&lt;b&gt;&amp;\"c'");
    EXPECT_EQ(asAttribute("a<b>&\"c'"), "a&lt;b&gt;&amp;&quot;c'");
}

TEST(Escape, KeepsLineFeedsOfTextAndWritesThoseOfAttributesAsReferences) {
    EXPECT_EQ(asText(" a\tb\nc\rd "), " a\tb\nc&#13;d ");
    EXPECT_EQ(asAttribute("a\tb\nc\rd"), "a&#9;b&#10;c&#13;d");
}

TEST(Escape, ReplacesWhatXmlCannotCarry) {
    EXPECT_EQ(asText(std::string_view("a\0b\x1F", 4)), "a\xEF\xBF\xBD"
                                                       "b\xEF\xBF\xBD");
    EXPECT_EQ(asText("\xEF\xBF\xBE|\xEF\xBF\xBF"), "\xEF\xBF\xBD|\xEF\xBF\xBD");
    EXPECT_EQ(asText("\x7F"), "\x7F");
}

TEST(Escape, ReplacesWhatIsNoUtf8) {
    EXPECT_EQ(asText("\xC3\xA4\xF0\x9F\x98\x80"), "\xC3\xA4\xF0\x9F\x98\x80");
    EXPECT_EQ(asText("caf\xE9!"), "caf\xEF\xBF\xBD!");
    EXPECT_EQ(asText("\xED\xA0\x80"), "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
    EXPECT_EQ(asText("x\xE2\x82"), "x\xEF\xBF\xBD\xEF\xBF\xBD");
}

} // namespace
} // namespace cimxml
