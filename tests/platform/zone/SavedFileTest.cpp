#include "zone/SavedFile.h"

#include "support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

using namespace std::literals;

TEST(SavedZone, IsReadAsItWasWritten) {
    const SavedZone zones[] = {
        {{SavedFile::Link, "/usr/share/zoneinfo/Europe/Berlin"}, {SavedFile::File, "Europe/Berlin\n"}},
        {{SavedFile::File, "TZif2\0\n\n1 2\n"s}, {SavedFile::Absent, ""}},
        {{SavedFile::Absent, ""}, {SavedFile::File, ""}},
    };
    for (const SavedZone& zone : zones) {
        const auto read = readSavedZone(writeSavedZone(zone));
        ASSERT_TRUE(read.has_value());
        EXPECT_TRUE(read->localTime == zone.localTime);
        EXPECT_TRUE(read->zoneName == zone.zoneName);
    }
}

TEST(SavedZone, IsRefusedUnlessWhole) {
    const std::string whole = writeSavedZone({{SavedFile::Link, "a\nb"}, {SavedFile::File, "c"}});
    ASSERT_EQ(whole, "vk-zone 1\nlink 3\na\nb\nfile 1\nc\n");
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_FALSE(readSavedZone(whole.substr(0, length)).has_value()) << length;
    for (const char* bad : {"vk-zone 2\nlink 0\n\nfile 0\n\n", "vk-zone 1\nlink -1\n\nfile 0\n\n",
                            "vk-zone 1\nlink 99999999999\n\nfile 0\n\n", "vk-zone 1\nfifo 0\n\nfile 0\n\n",
                            "vk-zone 1\nlink 0\n\nfile 0\n\n\n"})
        EXPECT_FALSE(readSavedZone(bad).has_value()) << bad;
}

TEST(SavedFile, PutsBackWhatItSaw) {
    const support::TemporaryDirectory directory;
    directory.write("file", "bytes");
    directory.link("nowhere", "link");
    const Root root(directory.path());
    const int folder = root.open("/", O_RDONLY | O_DIRECTORY);
    for (const char* name : {"file", "link", "missing"}) {
        SavedFile before, after;
        ASSERT_EQ(lookAt(root, name, before), 0);
        ASSERT_EQ(putBack(folder, name, {SavedFile::File, "other"}), 0);
        EXPECT_EQ(directory.read(name), "other");
        ASSERT_EQ(putBack(folder, name, before), 0);
        ASSERT_EQ(lookAt(root, name, after), 0);
        EXPECT_TRUE(before == after) << name;
    }
    close(folder);
    SavedFile found;
    EXPECT_EQ(lookAt(root, "/", found), EISDIR);
}

} // namespace

} // namespace VK::Zone
