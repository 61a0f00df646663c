#pragma once

#include "objectmanager/endpoint/Listening.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace endpoint {

/// What the command line and the configuration file say.
struct Settings {
    std::vector<ListenUrl> listen;
    std::string certificate; ///< files
    std::string key;
    bool anonymousRead = false;
    bool foreground = false;
    bool checkOnly = false;
    std::optional<std::vector<std::string>> makeCertificate; ///< for these names, or where there are none the host's
    std::vector<std::string> schema;                         ///< MOF files; none: the classes built in
    std::string library;                                     ///< empty: the one installed beside the program
    std::string provider = "BaseServerProvider";
    std::optional<std::chrono::seconds> idleExit;
};

/// Either settings, or a text to print and the status to exit with.
struct ParsedSettings {
    std::optional<Settings> settings;
    int exitStatus = 0;
    std::string output;
    std::string error;
};

/// Reads the command line, without the program's name, and the file that it names, or /etc/vkcimd.conf where that is
/// there. The command line goes before the file.
ParsedSettings parseSettings(const std::vector<std::string>& words);

} // namespace endpoint
