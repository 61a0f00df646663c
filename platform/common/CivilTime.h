#pragma once

namespace VK {

/// A UTC date and time of the Gregorian calendar, without leap seconds.
struct CivilTime {
    long year;
    int month, day, hour, minute, second; ///< month and day count from 1
};

/// Turns seconds since 1970-01-01 00:00:00 UTC into a date, before 1970 too. The C library's gmtime may read zone files
/// and takes a lock that is not safe after fork.
constexpr CivilTime civilTime(long seconds) {
    const long daySeconds = 86400;
    long days = seconds / daySeconds;
    long rest = seconds % daySeconds;
    if (rest < 0) {
        rest += daySeconds;
        --days;
    }
    // Years start in March here, so that the leap day comes last; 400 years (an era) have 146097 days.
    days += 719468; // from 0000-03-01 to 1970-01-01
    const long era = (days >= 0 ? days : days - 146096) / 146097;
    const long dayOfEra = days - era * 146097;
    const long yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const long dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const long monthFromMarch = (5 * dayOfYear + 2) / 153;
    const long month = monthFromMarch < 10 ? monthFromMarch + 3 : monthFromMarch - 9;
    return {yearOfEra + era * 400 + (month <= 2 ? 1 : 0),
            static_cast<int>(month),
            static_cast<int>(dayOfYear - (153 * monthFromMarch + 2) / 5 + 1),
            static_cast<int>(rest / 3600),
            static_cast<int>(rest / 60 % 60),
            static_cast<int>(rest % 60)};
}

} // namespace VK
