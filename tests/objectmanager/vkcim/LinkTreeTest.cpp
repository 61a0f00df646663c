#include "objectmanager/vkcim/LinkTree.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(LinkTree, WhatStandsAboveEverythingComesFirst) {
    EXPECT_THAT(drawLinks({{"chassis", "computer", "Package"},
                           {"computer", "capabilities", "Capabilities"},
                           {"time", "computer", "Affects"}}),
                ElementsAre("chassis", "└─ computer  (Package)", "   └─ capabilities  (Capabilities)", "time",
                            "└─ computer  (Affects)"));
}

TEST(LinkTree, SeveralThingsBelowOneAreBranches) {
    EXPECT_THAT(drawLinks({{"a", "b", "L"}, {"a", "c", "L"}, {"b", "d", "L"}}),
                ElementsAre("a", "├─ b  (L)", "│  └─ d  (L)", "└─ c  (L)"));
}

TEST(LinkTree, ACircleEnds) {
    EXPECT_THAT(drawLinks({{"a", "b", "L"}, {"b", "a", "L"}}), ElementsAre("a", "└─ b  (L)", "   └─ a  (L)"));
    EXPECT_THAT(drawLinks({{"a", "a", "L"}}), ElementsAre("a", "└─ a  (L)"));
}

TEST(LinkTree, ATerminalWithoutBoxesGetsPlainCharacters) {
    Look plain;
    plain.boxes = false;
    EXPECT_THAT(drawLinks({{"a", "b", "L"}, {"a", "c", "L"}, {"b", "d", "L"}}, plain),
                ElementsAre("a", "|- b  (L)", "|  `- d  (L)", "`- c  (L)"));
}

TEST(LinkTree, AnAssociationThatDoesNotFitStandsOnTheNextLine) {
    Look narrow;
    narrow.width = 16;
    EXPECT_THAT(drawLinks({{"a", "bbbbb", "Link"}, {"a", "cccccc", "Link"}, {"bbbbb", "ddd", "Link"}}, narrow),
                ElementsAre("a", "├─ bbbbb  (Link)", "│  └─ ddd", "│       (Link)", "└─ cccccc", "     (Link)"));
}

TEST(LinkTree, APathThatDoesNotFitGoesOnBehindItsCommas) {
    Look narrow;
    narrow.width = 24;
    EXPECT_THAT(drawLinks({{R"(Service.Name="aaa",System="b")", R"(Computer.Name="b")", "L"}}, narrow),
                ElementsAre(R"(Service.Name="aaa",)", R"(  System="b")", R"(└─ Computer.Name="b")", "     (L)"));
}

TEST(LinkTree, WhatWouldSteerATerminalIsWrittenOut) {
    EXPECT_THAT(drawLinks({{"a\x1b[31m", "b\n", "L"}}), ElementsAre(R"(a\x1b[31m)", R"(└─ b\n  (L))"));
}

TEST(LinkTree, NoLinksDrawNothing) {
    EXPECT_THAT(drawLinks({}), IsEmpty());
}

} // namespace
} // namespace vkcim
