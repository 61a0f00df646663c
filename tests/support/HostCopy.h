#pragma once

#include "support/TemporaryDirectory.h"

#include <array>
#include <cstdio>
#include <filesystem>
#include <string>

namespace support {

/// A copy of the host's zone files below a root of its own.
class HostCopy : public TemporaryDirectory {
public:
    HostCopy() {
        const auto options = std::filesystem::copy_options::recursive;
        for (const char* zone : {"Etc", "Asia/Kolkata", "Europe/Berlin", "America/New_York", "Australia/Adelaide"}) {
            const std::string name = std::string("usr/share/zoneinfo/") + zone;
            std::filesystem::create_directories(std::filesystem::path(path(name)).parent_path());
            std::filesystem::copy("/" + name, path(name), options);
        }
        std::filesystem::create_directories(path("etc"));
    }

    using TemporaryDirectory::link;

    /// Puts a zone into force as the system's own tools do.
    void useZone(const std::string& zone) const {
        remove("etc/localtime");
        link("/usr/share/zoneinfo/" + zone, "etc/localtime");
        write("etc/timezone", zone + "\n");
    }

    void remove(const std::string& name) const { std::filesystem::remove_all(path(name)); }
    bool exists(const std::string& name) const {
        return std::filesystem::exists(std::filesystem::symlink_status(path(name)));
    }

    /// A link's target; empty for what is none.
    std::string link(const std::string& name) const {
        std::error_code error;
        const std::string target = std::filesystem::read_symlink(path(name), error).string();
        return error ? std::string() : target;
    }

    /// What the system's `date` says of the offset on a day.
    std::string date(const std::string& day) const {
        return output("TZ=:" + zoneFile() + " date -d '" + day + " 12:00' +%z");
    }

    /// How many changes of offset the system's `zdump` sees from 2027 to 2030.
    int zdumpTransitions() const {
        return std::stoi(output("zdump -v -c 2027,2030 " + zoneFile() + " | grep -c -E ' 20(27|28|29) UT'"));
    }

private:
    /// /etc/localtime, or below this root what it is an absolute link to.
    std::string zoneFile() const {
        const std::string target = link("etc/localtime");
        return path(target.empty() || target.front() != '/' ? "etc/localtime" : target.substr(1));
    }

    /// The first line that a command prints.
    static std::string output(const std::string& command) {
        std::array<char, 256> line{};
        FILE* stream = popen(command.c_str(), "r");
        if (stream == nullptr) return {};
        const char* read = std::fgets(line.data(), static_cast<int>(line.size()), stream);
        pclose(stream);
        std::string text = read != nullptr ? read : "";
        if (!text.empty() && text.back() == '\n') text.pop_back();
        return text;
    }
};

} // namespace support
