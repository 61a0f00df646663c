#pragma once

#include "objectmanager/vkcim/Commands.h"
#include "objectmanager/vkcim/Remote.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace vkcim {

enum class Format { Text, Mof, Json, Facts, OpenMetrics };

/// Whether it is a format of the report alone, for programs that collect from many hosts.
constexpr bool isForEngines(Format format) {
    return format == Format::Facts || format == Format::OpenMetrics;
}

/// What the user asked for, its texts not yet read.
struct Arguments {
    const Command* command = nullptr;     ///< never null in what was parsed
    std::string subject;                  ///< CLASS, PATH or TEXT
    std::string member;                   ///< METHOD or PROPERTY
    std::vector<std::string> assignments; ///< NAME=VALUE…

    std::string library; ///< empty: the default one
    std::string provider = "BaseServerProvider";
    std::string nameSpace = "root/cimv2";
    Format format = Format::Text;
    std::optional<std::string> assocClass, resultClass, role, resultRole;
    std::optional<std::vector<std::string>> properties;
    std::size_t repeat = 1;
    std::size_t threads = 1;
    bool timing = false;
    bool verbose = false;
    bool withSerials = false;
    bool dryRun = false;
    std::optional<om::Fault> fault;
    RemoteOptions remote; ///< the server that is asked instead of a library
};

/// Either arguments to run, or a text to print and the status to exit with.
struct Parsed {
    std::optional<Arguments> arguments;
    int exitStatus = 0;
    std::string output; ///< for standard output
    std::string error;  ///< for standard error
};

/// Reads the command line, without the program's name.
Parsed parseArguments(const std::vector<std::string>& words);

} // namespace vkcim
