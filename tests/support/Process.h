#pragma once

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace support {

/// What a program left behind.
struct Outcome {
    int status = -1; ///< its exit status, or 128 and the signal that ended it
    std::string output;
    std::string error;
};

namespace detail {

using File = std::unique_ptr<std::FILE, int (*)(std::FILE*)>;

inline File temporaryFile(const std::string& content = "") {
    File file(std::tmpfile(), &std::fclose);
    if (!file) throw std::runtime_error("cannot make a temporary file");
    std::fwrite(content.data(), 1, content.size(), file.get());
    std::rewind(file.get());
    return file;
}

inline std::string contentOf(std::FILE* file) {
    std::string content;
    char buffer[4096];
    std::rewind(file);
    while (const std::size_t count = std::fread(buffer, 1, sizeof buffer, file)) content.append(buffer, count);
    return content;
}

} // namespace detail

/// Runs a program to its end: `words` are its path and arguments, `variables` are set in its environment beside ours.
inline Outcome runCommand(const std::vector<std::string>& words, const std::string& input = "",
                          const std::vector<std::pair<std::string, std::string>>& variables = {}) {
    // Files, since nobody has to read them while the program runs.
    const detail::File files[] = {detail::temporaryFile(input), detail::temporaryFile(), detail::temporaryFile()};
    std::vector<char*> arguments;
    for (const std::string& word : words) arguments.push_back(const_cast<char*>(word.c_str()));
    arguments.push_back(nullptr);
    const pid_t child = fork();
    if (child < 0) throw std::runtime_error("cannot fork");
    if (child == 0) {
        for (int i = 0; i < 3; ++i) dup2(fileno(files[i].get()), i);
        for (const auto& [name, value] : variables) setenv(name.c_str(), value.c_str(), 1);
        execv(arguments.front(), arguments.data());
        _exit(127);
    }
    int status = 0;
    waitpid(child, &status, 0);
    return {WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status), detail::contentOf(files[1].get()),
            detail::contentOf(files[2].get())};
}

} // namespace support
