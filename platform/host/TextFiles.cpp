#include "host/TextFiles.h"

#include "common/Text.h"

#include <cstring>
#include <utmp.h>

namespace VK::Host {

namespace {

/// The value of an assignment, without the quotes. What follows a closing quote counts too, as in the shell.
std::string unquoted(std::string_view value) {
    std::string result;
    char quote = '\0';
    for (std::size_t i = 0; i < value.size(); ++i) {
        const char c = value[i];
        if (c == quote) {
            quote = '\0';
        } else if (quote == '\0' && (c == '"' || c == '\'')) {
            quote = c;
        } else if (c == '\\' && quote != '\'' && i + 1 < value.size()) {
            result += value[++i];
        } else {
            result += c;
        }
    }
    return result;
}

bool isDecimal(std::string_view text) {
    return !text.empty() && text.size() < 20 && text.find_first_not_of("0123456789") == std::string_view::npos;
}

} // namespace

std::map<std::string, std::string> parseAssignments(std::string_view text) {
    std::map<std::string, std::string> values;
    while (!text.empty()) {
        const std::string_view line = trimmed(takeLine(text));
        const std::size_t equals = line.find('=');
        if (equals == std::string_view::npos || line.front() == '#' || line.front() == ';') continue;
        values[std::string(trimmed(line.substr(0, equals)))] = unquoted(trimmed(line.substr(equals + 1)));
    }
    return values;
}

std::string sysinfoValue(std::string_view text, std::string_view key) {
    while (!text.empty()) {
        const std::string_view line = takeLine(text);
        const std::size_t colon = line.find(':');
        if (colon != std::string_view::npos && trimmed(line.substr(0, colon)) == key)
            return cleanText(line.substr(colon + 1));
    }
    return {};
}

std::string deviceTreeText(std::string_view bytes) {
    return cleanText(bytes.substr(0, bytes.find('\0')));
}

std::string hostNameFromFile(std::string_view text) {
    while (!text.empty()) {
        const std::string_view line = trimmed(takeLine(text));
        if (!line.empty() && line.front() != '#') return cleanText(line);
    }
    return {};
}

bool utmpSaysShutdown(std::string_view bytes) {
    bool shutdown = false;
    for (utmp entry{}; bytes.size() >= sizeof entry; bytes.remove_prefix(sizeof entry)) {
        std::memcpy(&entry, bytes.data(), sizeof entry);
        const int level = entry.ut_pid % 256; // the level before it stands in the upper byte
        if (entry.ut_type == RUN_LVL) shutdown = level == '0' || level == '6';
    }
    return shutdown;
}

bool scheduledShutdownIsDue(std::string_view text, std::uint64_t now) {
    const std::map<std::string, std::string> values = parseAssignments(text);
    const auto mode = values.find("MODE");
    if (mode != values.end() && mode->second.rfind("dry-", 0) == 0) return false;
    const auto time = values.find("USEC");
    return time != values.end() && isDecimal(time->second) && std::stoull(time->second) <= now;
}

} // namespace VK::Host
