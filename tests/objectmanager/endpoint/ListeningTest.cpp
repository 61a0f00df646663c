#include "objectmanager/endpoint/Listening.h"

#include "support/TemporaryDirectory.h"
#include "tests/objectmanager/endpoint/RunningServer.h"

#include <gmock/gmock.h>

#include <unistd.h>

#include <filesystem>
#include <fstream>

namespace endpoint {
namespace {

class UnixSocket : public testing::Test {
protected:
    support::TemporaryDirectory directory;
    std::string path = directory.path("socket");
    ListenUrl url = ListenUrl("unix:" + path);
};

TEST_F(UnixSocket, IsOpenToEverybody) {
    const Listener listener = listenAt(url);
    EXPECT_EQ(std::filesystem::status(path).permissions(), std::filesystem::perms{0666});
    close(listener.socket);
}

TEST_F(UnixSocket, IsNotTakenAwayFromWhoeverServesIt) {
    const Listener alive = listenAt(url);
    EXPECT_THROW(listenAt(url), std::system_error);
    const Client client(path); // of the first one, which is still there
    close(alive.socket);
}

TEST_F(UnixSocket, TakesThePlaceOfOneThatNobodyServes) {
    close(listenAt(url).socket);
    const Listener listener = listenAt(url);
    const Client client(path);
    close(listener.socket);
}

TEST_F(UnixSocket, TakesThePlaceOfNothingElse) {
    std::ofstream(path) << "kept";
    EXPECT_THROW(listenAt(url), std::system_error);
    EXPECT_EQ(std::filesystem::file_size(path), 4U);
}

} // namespace
} // namespace endpoint
