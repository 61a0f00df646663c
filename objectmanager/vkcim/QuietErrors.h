#pragma once

#include <string>

namespace vkcim {

/// As long as this lives, keeps from standard error what others print there: commands that the provider's library
/// starts say what they lack in words that help nobody who did not start them.
class QuietErrors {
public:
    QuietErrors();
    /// Puts standard error back and prints the log lines that went there, as the user asked for these.
    ~QuietErrors();
    QuietErrors(const QuietErrors&) = delete;
    QuietErrors& operator=(const QuietErrors&) = delete;

private:
    int before; ///< a descriptor of what standard error was; -1 where nothing is kept from it
};

/// The lines of a text that NVLOG_SINK=stderr writes: those that begin with a time and a channel.
std::string logLinesOf(const std::string& text);

} // namespace vkcim
