#pragma once

#include <string>
#include <vector>

/// The log as a list of events, each of which stands in it twice.
namespace test {

/// The events of a log: `LEVEL FILE FUNCTION: TEXT` of each line of the log channel, with line numbers as `[Line]` and
/// addresses as `ADDRESS`. Ends with an exception unless each is followed by the same line of the trace channel.
std::vector<std::string> events(const std::vector<std::string>& lines);

/// One event.
std::string event(int level, const std::string& file, const std::string& function, const std::string& text);

/// Events as the provider's functions write them.
std::string method(const std::string& file, const std::string& function);
std::string variable(const std::string& file, const std::string& function, const std::string& name,
                     const std::string& value);
/// The lines around an operation of the frame.
std::vector<std::string> entryMarker(const std::string& operation);
std::vector<std::string> exitMarker(const std::string& operation);

} // namespace test
