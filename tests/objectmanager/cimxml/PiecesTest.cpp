#include "objectmanager/cimxml/Pieces.h"

#include <gmock/gmock.h>

namespace cimxml {
namespace {

using Names = std::vector<std::string>;

Pieces listOf(Names names) {
    Pieces pieces(oneByOne(std::move(names), [](Writer& writer, const std::string& name) { writer.className(name); }));
    pieces.enclose("<A>", "</A>");
    return pieces;
}

/// The pieces as they come, of at least that many bytes but for the last.
Names pieces(Pieces from, std::size_t enough) {
    Names made;
    while (!from.isEmpty()) {
        Writer writer;
        from.writeTo(writer, enough);
        made.push_back(writer.take());
    }
    return made;
}

TEST(Pieces, AreTheSameTextHoweverLargeTheyAre) {
    const std::string whole = "<A><CLASSNAME NAME=\"X\"></CLASSNAME><CLASSNAME NAME=\"Y\"></CLASSNAME></A>";
    EXPECT_EQ(pieces(listOf({"X", "Y"}), std::string::npos), Names{whole});
    EXPECT_EQ(pieces(listOf({"X", "Y"}), 4),
              (Names{"<A><CLASSNAME NAME=\"X\"></CLASSNAME>", "<CLASSNAME NAME=\"Y\"></CLASSNAME>", "</A>"}));
    EXPECT_EQ(pieces(listOf({}), 4), (Names{"<A></A>"}));
}

TEST(Pieces, SayWhetherSomethingIsLeft) {
    Pieces two = listOf({"X", "Y"});
    Writer writer;
    EXPECT_TRUE(two.writeTo(writer, 4));
    EXPECT_FALSE(two.isEmpty());
    EXPECT_FALSE(two.writeTo(writer, std::string::npos));
    EXPECT_TRUE(two.isEmpty());
}

TEST(Pieces, WhatWasWrittenGivesItsMemoryBack) {
    const auto shared = std::make_shared<int>(1);
    const auto write = [](Writer& writer, const std::shared_ptr<int>&) { writer.className("X"); };
    Pieces made(oneByOne(std::vector<std::shared_ptr<int>>{shared, shared}, write));
    Writer writer;
    made.writeTo(writer, 1);
    EXPECT_EQ(shared.use_count(), 2);
}

TEST(Pieces, AreATextWithoutElements) {
    Pieces text(std::string("<B></B>"));
    text.enclose("<A>", "</A>");
    text.enclose("", "!");
    EXPECT_EQ(pieces(std::move(text), 1), Names{"<A><B></B></A>!"});
}

} // namespace
} // namespace cimxml
