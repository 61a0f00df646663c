#include "zone/Clock.h"

#include "common/Text.h"
#include "logger/LogLine.h"
#include "vk/FileDescriptor.h"
#include "zone/ZoneInForce.h"

#include <cerrno>
#include <fcntl.h>
#include <linux/rtc.h>
#include <sys/ioctl.h>
#include <unistd.h>

namespace VK::Zone {

namespace {

constexpr std::int64_t earliest = 946684800; // 2000-01-01

bool notSet(const std::string& reason) {
    logLine(failure, "setProperty", __LINE__, "clock not set: " + reason);
    return false;
}

/// 0, or the errno value.
int writeHardwareClock(int fd, const tm& time) {
    rtc_time fields{};
    fields.tm_sec = time.tm_sec;
    fields.tm_min = time.tm_min;
    fields.tm_hour = time.tm_hour;
    fields.tm_mday = time.tm_mday;
    fields.tm_mon = time.tm_mon;
    fields.tm_year = time.tm_year;
    return ioctl(fd, RTC_SET_TIME, &fields) == 0 ? 0 : errno;
}

/// The clock is right already: a hardware clock that will not be set is logged and nothing else.
void setHardwareClock(const Root& root, Instant instant) {
    const int opened = root.open("/dev/rtc0", O_RDONLY);
    if (opened == -ENOENT) return;
    const FileDescriptor fd(opened);
    const bool local = adjtimeSaysLocal(root.read("/etc/adjtime").text);
    const int offset = local ? zoneInForce(root).at(instant.seconds).offset : 0;
    const int error = fd ? writeHardwareClock(fd.get(), hardwareClockTime(instant, offset)) : -opened;
    if (error != 0) logLine(failure, "setProperty", __LINE__, "/dev/rtc0 not set: " + errorText(error));
}

std::string inUtc(const timespec& time) {
    return formatCimDateTime({time.tv_sec, time.tv_nsec / 1000}, 0);
}

} // namespace

std::string checkClockText(const std::string& text, Instant& instant) {
    const std::optional<Instant> read = parseCimDateTime(text);
    if (!read) return inQuotes(text) + " is no date-time";
    if (read->seconds < earliest) return inQuotes(text) + " lies before 2000";
    instant = *read;
    return {};
}

bool adjtimeSaysLocal(std::string_view text) {
    takeLine(text);
    takeLine(text);
    return trimmed(takeLine(text)) == "LOCAL";
}

tm hardwareClockTime(Instant instant, int offsetSeconds) {
    const auto time = static_cast<std::time_t>(instant.seconds + (instant.microseconds + 500'000) / 1'000'000);
    const std::time_t local = time + offsetSeconds;
    tm fields{};
    gmtime_r(&local, &fields);
    return fields;
}

bool changeClock(const Root& root, const std::string& text) {
    Instant instant;
    if (const std::string problem = checkClockText(text, instant); !problem.empty()) return notSet(problem);
    if (!root.isLive()) return notSet("a snapshot has none");
    timespec before{};
    clock_gettime(CLOCK_REALTIME, &before);
    const timespec wanted{instant.seconds, instant.microseconds * 1000};
    if (clock_settime(CLOCK_REALTIME, &wanted) != 0) {
        const int error = errno;
        return notSet(errorText(error) + (error == EPERM ? "; this takes the privilege CAP_SYS_TIME" : ""));
    }
    setHardwareClock(root, instant);
    logLine(notice, "setProperty", __LINE__,
            "clock set from " + inUtc(before) + " to " + inUtc(wanted) + " by uid " + std::to_string(getuid()));
    return true;
}

} // namespace VK::Zone
