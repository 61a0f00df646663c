#include "objectmanager/mof/Lexer.h"

#include "objectmanager/mof/Complaint.h"

#include <gmock/gmock.h>

namespace mof {
namespace {

using testing::ElementsAre;
using Kind = Token::Kind;

std::vector<std::string> texts(const std::string& text) {
    std::vector<std::string> found;
    for (const Token& token : readTokens(text, "f")) found.push_back(token.text);
    found.pop_back(); // the end's
    return found;
}

std::string complaint(const std::string& text) {
    return complaintOf([&] { readTokens(text, "f"); });
}

TEST(Lexer, ReadsEveryKindOfToken) {
    const std::vector<Token> tokens = readTokens("a_1 \"s\" 12 1.5 #pragma ;", "f");
    std::vector<Kind> kinds;
    for (const Token& token : tokens) kinds.push_back(token.kind);
    EXPECT_THAT(kinds,
                ElementsAre(Kind::Name, Kind::String, Kind::Integer, Kind::Real, Kind::Pragma, Kind::Mark, Kind::End));
    EXPECT_THAT(texts("a_1 \"s\" 12 1.5 #pragma ;"), ElementsAre("a_1", "s", "12", "1.5", "#pragma", ";"));
}

TEST(Lexer, EndsNumbersWhereTheyEnd) {
    EXPECT_THAT(texts("+0x1Fg"), ElementsAre("+0x1F", "g"));
    EXPECT_THAT(texts("0x"), ElementsAre("0", "x"));
    EXPECT_THAT(texts("0xg"), ElementsAre("0", "xg"));
    EXPECT_THAT(texts("-1.5e-3e"), ElementsAre("-1.5e-3", "e"));
    EXPECT_THAT(texts(".5e b"), ElementsAre(".5", "e", "b"));
}

TEST(Lexer, SkipsBlanksAndCommentsAndCountsTheirLines) {
    const std::vector<Token> tokens = readTokens("// a \"\n/* b\n * // */ c /**/\r\n\td // e", "f");
    ASSERT_EQ(tokens.size(), 3U);
    EXPECT_EQ(tokens[0].line, 3U);
    EXPECT_EQ(tokens[1].line, 4U);
    EXPECT_EQ(tokens[2].line, 4U);
}

TEST(Lexer, ReplacesEscapes) {
    EXPECT_THAT(texts(R"("\b\t\n\f\r\"\'\\" "/* \"" "")"), ElementsAre("\b\t\n\f\r\"'\\", "/* \"", ""));
}

TEST(Lexer, ReadsAnEmptyText) {
    EXPECT_THAT(texts(""), ElementsAre());
    EXPECT_THAT(texts(" \n"), ElementsAre());
}

TEST(Lexer, RefusesWithTheLine) {
    const std::pair<std::string, std::string> bad[] = {
        {"\n\"a", "f:2: the string does not end on its line"},
        {"\"a\nb\"", "f:1: the string does not end on its line"},
        {"\"a\\", "f:1: the string does not end on its line"},
        {"\"a\\\"", "f:1: the string does not end on its line"},
        {"\"\\q\"", "f:1: unknown escape '\\q' in a string"},
        {"\"\\\xC3\xA4\"", "f:1: unknown escape '\\\xC3\xA4' in a string"},
        {"a\n/* b\n", "f:2: the comment does not end"},
        {"/*/", "f:1: the comment does not end"},
        {"a / b", "f:1: unexpected character '/'"},
        {"\n\xC3\xA4", "f:2: unexpected character '\xC3\xA4'"},
        {"1.", "f:1: unexpected character '.'"},
        {"-", "f:1: unexpected character '-'"},
        {std::string("\0", 1), "f:1: unexpected character '" + std::string("\0", 1) + "'"},
        {"a\n\"\xFF\"", "f:2: the text is not UTF-8"},
        {"// \xC3", "f:1: the text is not UTF-8"},
    };
    for (const auto& [text, expected] : bad) EXPECT_EQ(complaint(text), expected.c_str()) << text;
}

TEST(Lexer, ReadsLongTexts) {
    const std::string word(1 << 20, 'a');
    EXPECT_THAT(texts('"' + word + '"'), ElementsAre(word));
    EXPECT_THAT(texts("/*" + word + "*/" + word), ElementsAre(word));
}

} // namespace
} // namespace mof
