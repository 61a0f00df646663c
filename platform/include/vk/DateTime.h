#pragma once

#include <string>

namespace VK {

/// An instant, printed as a CIM date-time.
class DateTime {
public:
    /// `seconds` since 1970-01-01 00:00:00 UTC. The number behind them asks for a format; there is one only, the
    /// instant in UTC with the offset `+000`, whatever the number (callers pass 3).
    DateTime(long seconds, unsigned int format);

    /// The 25 characters of the CIM form, 1704106800 being `20240101110000.000000+000`. Empty for an instant outside
    /// the years 0000 to 9999.
    operator std::string() const;

private:
    long seconds;
};

} // namespace VK
