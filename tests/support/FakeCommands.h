#pragma once

#include "support/TemporaryDirectory.h"

#include <filesystem>
#include <string>
#include <vector>

namespace test {

/// Shell commands of the test's own that record how they were called. While one of these lives, the process's PATH is
/// its directory `bin` and then the system's; afterwards PATH is what it was.
class FakeCommands {
public:
    FakeCommands();
    ~FakeCommands();
    FakeCommands(const FakeCommands&) = delete;
    FakeCommands& operator=(const FakeCommands&) = delete;

    /// The directory of the commands that PATH finds, and the directory that everything is in, with a final slash.
    std::filesystem::path bin() const { return path("bin"); }
    std::filesystem::path path(const std::string& name) const { return directory.path(name); }

    /// Makes a command in `bin`, or at an absolute path, that records its call and goes on with `script`.
    void add(const std::filesystem::path& command, const std::string& script = "");

    /// The calls since it was last asked, in order: the command, then each argument in brackets, as
    /// `ntpd [-xgq]`. Commands in `bin` show their bare name, others their path below the directory, or their whole
    /// path.
    std::vector<std::string> take();

private:
    support::TemporaryDirectory directory;
    std::string formerPath;
};

/// A script that stays for a moment, and notes in the file `overlaps` of that directory that another run of it has not
/// ended yet.
std::string notingOverlaps(const std::string& directory);

/// A script that prints these lines.
std::string printing(const std::vector<std::string>& lines);

} // namespace test
