#pragma once

#include <filesystem>

namespace bench {

/// The host that the requests are about: a simulated one of as many computers as a row wants, or this machine. Chooses
/// it through the environment, so it is made before the libraries are loaded.
class Host {
public:
    explicit Host(bool live);
    ~Host();
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;

    bool isLive() const { return live; }
    /// From now on there are so many computers, with a chassis each. Does nothing on this machine.
    void use(int computers);

private:
    const bool live;
    std::filesystem::path directory;
    int present = 0;
};

} // namespace bench
