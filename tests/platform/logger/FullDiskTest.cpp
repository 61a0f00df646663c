// A log file on a disk that fills up, and is made room on again.
#include "nvlog/NVLogger.h"
#include "support/InChild.h"
#include "support/TemporaryDirectory.h"

#include "platform/logger/Syslog.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sched.h>
#include <sstream>
#include <sys/mount.h>
#include <unistd.h>

namespace {

constexpr const char* forbidden = "no mounts here";
constexpr std::size_t lines = 2000;

bool mountOver(const std::string& directory) {
    if (unshare(CLONE_NEWNS) != 0) return false;
    if (mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0) return false;
    return mount("vk-test", directory.c_str(), "tmpfs", 0, "size=64k") == 0;
}

void logNumber(std::size_t number) {
    NVLog::NVLogger::logLevelMessage("run", "FullDiskTest", 1, "Norvane.Test", 6000, nullptr, 0, 0,
                                     "number " + std::to_string(number) + " of many");
}

/// The numbers of whole lines, in order; a cut line counts as none.
std::vector<std::size_t> wholeNumbers(const std::string& text) {
    std::vector<std::size_t> numbers;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        const std::size_t at = line.find("run: number ");
        if (at == std::string::npos || line.size() < 8 || line.compare(line.size() - 8, 8, " of many") != 0) continue;
        numbers.push_back(std::stoul(line.substr(at + 12)));
    }
    return numbers;
}

TEST(FullDisk, SendsToSyslogWhatTheFileCannotTakeAndGoesBackToTheFile) {
    const support::TemporaryDirectory directory;
    const std::string outcome = support::inChild([&]() -> std::string {
        if (!mountOver(directory.path())) return forbidden;
        const std::string file = directory.path("vk.log");
        setenv("NVLOG_SINK", ("file:" + file).c_str(), 1);
        setenv("NVLOG_CHANNELS", "log", 1);
        for (std::size_t i = 0; i < lines; ++i) logNumber(i);
        const std::vector<std::size_t> kept = wholeNumbers(directory.read("vk.log"));
        std::string sent;
        for (const std::string& line : takeSyslog()) sent += line + "\n";
        const std::vector<std::size_t> passedOn = wholeNumbers(sent);
        EXPECT_GT(kept.size(), 300u);
        EXPECT_EQ(kept.size() + passedOn.size(), lines) << "no line is lost, and none is there twice";
        for (std::size_t i = 0; i < kept.size(); ++i) EXPECT_EQ(kept[i], i);

        std::filesystem::resize_file(file, 0); // somebody makes room
        logNumber(lines);
        EXPECT_THAT(wholeNumbers(directory.read("vk.log")), testing::ElementsAre(lines));
        EXPECT_THAT(takeSyslog(), testing::IsEmpty());
        return "done";
    });
    if (outcome == forbidden) GTEST_SKIP() << "mounting a file system takes root";
    EXPECT_EQ(outcome, "done");
}

} // namespace
