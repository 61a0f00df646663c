#include "zone/SavedFile.h"

#include "support/Synchronised.h"
#include "support/TemporaryDirectory.h"
#include "vk/FileDescriptor.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

using namespace std::literals;

TEST(SavedZone, OfTheFirstVersionIsRead) {
    const std::pair<std::string, SavedZone> zones[] = {
        {"vk-zone 1\nlink 33\n/usr/share/zoneinfo/Europe/Berlin\nfile 14\nEurope/Berlin\n\n",
         {{SavedFile::Link, "/usr/share/zoneinfo/Europe/Berlin"}, {SavedFile::File, "Europe/Berlin\n"}}},
        {"vk-zone 1\nfile 12\nTZif2\0\n\n1 2\n\nabsent 0\n\n"s,
         {{SavedFile::File, "TZif2\0\n\n1 2\n"s}, {SavedFile::Absent, ""}}},
        {"vk-zone 1\nabsent 0\n\nfile 0\n\n", {{SavedFile::Absent, ""}, {SavedFile::File, ""}}},
    };
    for (const auto& [bytes, zone] : zones) {
        const auto read = readSavedZone(bytes);
        ASSERT_TRUE(read.has_value()) << bytes;
        EXPECT_TRUE(*read == zone) << bytes;
    }
}

TEST(SavedZone, OfTheFirstVersionIsRefusedUnlessWhole) {
    const std::string whole = "vk-zone 1\nlink 3\na\nb\nfile 1\nc\n";
    ASSERT_TRUE(readSavedZone(whole).has_value());
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
    const int opened = root.open("/", O_RDONLY | O_DIRECTORY);
    for (const char* name : {"file", "link", "missing"}) {
        SavedFile before, after;
        ASSERT_EQ(lookAt(root, name, before), 0);
        ASSERT_EQ(putBack(opened, name, {SavedFile::File, "other"}), 0);
        EXPECT_EQ(directory.read(name), "other");
        ASSERT_EQ(putBack(opened, name, before), 0);
        ASSERT_EQ(lookAt(root, name, after), 0);
        EXPECT_TRUE(before == after) << name;
    }
    close(opened);
    SavedFile found;
    EXPECT_EQ(lookAt(root, "/", found), EISDIR);
}

TEST(SavedFile, PutBackWhereNothingWasSurvivesACrash) {
    const support::TemporaryDirectory directory;
    directory.write("file", "bytes");
    const FileDescriptor opened(open(directory.path().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    support::synchronised().clear();
    ASSERT_EQ(putBack(opened.get(), "file", {}), 0);
    EXPECT_THAT(support::synchronised(), testing::ElementsAre(directory.path()));
    EXPECT_FALSE(std::filesystem::exists(directory.path("file")));
}

} // namespace

} // namespace VK::Zone
