#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>

namespace support {

/// A new directory that goes away with everything in it.
class TemporaryDirectory {
public:
    TemporaryDirectory() {
        std::string name = (std::filesystem::temp_directory_path() / "vk-test-XXXXXX").string();
        if (mkdtemp(name.data()) == nullptr) throw std::runtime_error("cannot make a temporary directory");
        directory = name;
    }
    ~TemporaryDirectory() {
        std::error_code ignored;
        std::filesystem::remove_all(directory, ignored);
    }
    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    std::string path() const { return directory.string(); }
    std::string path(const std::string& name) const { return (directory / name).string(); }

    /// Writes a file, with the directories on its way.
    void write(const std::string& name, const std::string& bytes) const {
        std::filesystem::create_directories((directory / name).parent_path());
        std::ofstream file(directory / name, std::ios::binary);
        file << bytes;
        if (!file.flush()) throw std::runtime_error("cannot write " + name);
    }

    /// Makes a symbolic link, with the directories on its way.
    void link(const std::string& target, const std::string& name) const {
        std::filesystem::create_directories((directory / name).parent_path());
        std::filesystem::create_symlink(target, directory / name);
    }

    /// A whole file's bytes; empty where there is none.
    std::string read(const std::string& name) const {
        std::ifstream file(directory / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    }

private:
    std::filesystem::path directory;
};

} // namespace support
