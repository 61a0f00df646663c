#include "host/TextFiles.h"
#include "support/RunLevel.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <utmp.h>

namespace VK::Host {

namespace {

using support::runLevel;
using testing::ElementsAre;
using testing::Pair;

TEST(Assignments, AreReadAsTheShellReadsThem) {
    EXPECT_THAT(parseAssignments("# comment\n"
                                 "; another\n"
                                 "A=plain\n"
                                 "  B = \"in quotes\" \n"
                                 "C='$x \\\"'\n"
                                 "D=\"a \\\"b\\\" \\\\\"\n"
                                 "E=\n"
                                 "F=x=y\n"
                                 "no assignment\n"
                                 "A=again"),
                ElementsAre(Pair("A", "again"), Pair("B", "in quotes"), Pair("C", "$x \\\""), Pair("D", "a \"b\" \\"),
                            Pair("E", ""), Pair("F", "x=y")));
    EXPECT_THAT(parseAssignments(""), ElementsAre());
    EXPECT_THAT(parseAssignments("A=\"open\\"), ElementsAre(Pair("A", "open\\")));
}

constexpr const char* sysinfo = "Manufacturer:         IBM             \n"
                                "Type:                 2964\n"
                                "Model:                701              N63\n"
                                "Sequence Code:        00000000000AB1C7\n"
                                "LPAR Name:            LP01\n";

TEST(Sysinfo, IsReadByItsKeys) {
    EXPECT_EQ(sysinfoValue(sysinfo, "Manufacturer"), "IBM");
    EXPECT_EQ(sysinfoValue(sysinfo, "Sequence Code"), "00000000000AB1C7");
    EXPECT_EQ(sysinfoValue(sysinfo, "Name"), "");
    EXPECT_EQ(sysinfoValue("", "Type"), "");
}

TEST(DeviceTree, TextsEndAtTheFirstNul) {
    EXPECT_EQ(deviceTreeText(std::string("Board Mk 2\0second\0", 18)), "Board Mk 2");
    EXPECT_EQ(deviceTreeText("no end"), "no end");
    EXPECT_EQ(deviceTreeText(""), "");
}

TEST(HostNameFile, HoldsTheNameInItsFirstRealLine) {
    EXPECT_EQ(hostNameFromFile("# name\n\n  node7 \nother\n"), "node7");
    EXPECT_EQ(hostNameFromFile("\n"), "");
    EXPECT_EQ(hostNameFromFile(""), "");
}

TEST(Utmp, TellsAShutdownByTheLastRunLevel) {
    EXPECT_TRUE(utmpSaysShutdown(runLevel('0', '5')));
    EXPECT_TRUE(utmpSaysShutdown(runLevel('5') + runLevel('6', '5')));
    EXPECT_FALSE(utmpSaysShutdown(runLevel('5')));
    EXPECT_FALSE(utmpSaysShutdown(runLevel('6') + runLevel('5', '0')));
    EXPECT_FALSE(utmpSaysShutdown(""));
    EXPECT_FALSE(utmpSaysShutdown(runLevel('6').substr(1)));
    std::string other = runLevel('6');
    other[0] = USER_PROCESS;
    EXPECT_FALSE(utmpSaysShutdown(other));
}

TEST(ScheduledShutdown, IsDueWhenItsTimeHasPassed) {
    const char* text = "USEC=1000\nWARN_WALL=1\nMODE=poweroff\n";
    EXPECT_FALSE(scheduledShutdownIsDue(text, 999));
    EXPECT_TRUE(scheduledShutdownIsDue(text, 1000));
    EXPECT_FALSE(scheduledShutdownIsDue("USEC=1000\nMODE=dry-reboot\n", 2000));
    for (const char* bad : {"", "MODE=reboot", "USEC=\n", "USEC=-1", "USEC=99999999999999999999999"})
        EXPECT_FALSE(scheduledShutdownIsDue(bad, 2000)) << bad;
}

} // namespace

} // namespace VK::Host
