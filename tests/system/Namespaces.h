#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <list>
#include <string>

namespace test {

/// Runs the program's tests in namespaces of their own: what they mount, the host's name and the processes that they
/// see are theirs alone. The program's main, which links this, enters them before the first test.
class NamespaceTest : public testing::Test {
protected:
    /// Skips the test, and says why, where this machine allows no namespaces.
    void SetUp() override;
};

/// A file system that lies over a directory of the host for as long as this lives; empty at first, and gone afterwards
/// with everything in it.
class CoveredDirectory {
public:
    explicit CoveredDirectory(const std::filesystem::path& directory);
    ~CoveredDirectory();
    CoveredDirectory(const CoveredDirectory&) = delete;
    CoveredDirectory& operator=(const CoveredDirectory&) = delete;

private:
    std::list<CoveredDirectory> below; ///< what was covered before, where the directory was missing
    const std::filesystem::path directory;
};

/// Gives the namespaces' host a name.
void nameHost(const std::string& name);

} // namespace test
