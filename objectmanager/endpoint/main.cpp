#include "objectmanager/broker/ObjectManager.h"
#include "objectmanager/endpoint/Files.h"
#include "objectmanager/endpoint/Interop.h"
#include "objectmanager/endpoint/Log.h"
#include "objectmanager/endpoint/Server.h"
#include "objectmanager/endpoint/Settings.h"
#include "objectmanager/endpoint/Work.h"
#include "objectmanager/vkcim/DefaultLibrary.h"
#include "objectmanager/vkcim/Terminal.h"

#include <sys/utsname.h>
#include <systemd/sd-daemon.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <csignal>
#include <iostream>

namespace {

constexpr int unusableConfiguration = 2;
constexpr int notToBeHad = 3;
constexpr std::chrono::seconds usualIdle{300};

std::atomic<bool> stopped{false};

void stop(int) {
    stopped = true;
}

void handleSignals() {
    struct sigaction action {};
    action.sa_handler = stop;
    sigaction(SIGTERM, &action, nullptr);
    sigaction(SIGINT, &action, nullptr);
    std::signal(SIGPIPE, SIG_IGN);
}

std::string hostName() {
    utsname names{};
    return uname(&names) == 0 && names.nodename[0] != '\0' ? names.nodename : "localhost";
}

/// The service manager's sockets, and those of the configuration that are not among them.
std::vector<endpoint::Listener> listeners(const endpoint::Settings& settings) {
    std::vector<endpoint::Listener> found = endpoint::activatedListeners();
    if (found.empty() && !settings.foreground) {
        throw std::invalid_argument("the service manager gave no socket: without one say --foreground");
    }
    const std::size_t activated = found.size();
    std::vector<endpoint::ListenUrl> wanted = settings.listen;
    if (activated == 0 && wanted.empty()) wanted.emplace_back("unix:/run/vkcimd.sock");
    for (const endpoint::ListenUrl& url : wanted) {
        const bool again = std::any_of(found.begin(), found.begin() + static_cast<std::ptrdiff_t>(activated),
                                       [&](const endpoint::Listener& each) { return each.url == url.text; });
        if (!again) found.push_back(endpoint::listenAt(url));
    }
    return found;
}

/// Where we hold a socket that nobody opens again for us, we stay.
std::chrono::seconds idleOf(const endpoint::Settings& settings) {
    return settings.idleExit.value_or(settings.foreground || !settings.listen.empty() ? std::chrono::seconds(0)
                                                                                      : usualIdle);
}

int makeCertificate(const endpoint::Settings& settings) {
    std::vector<std::string> names = *settings.makeCertificate;
    if (names.empty()) names = {hostName(), "localhost", "127.0.0.1", "::1"};
    endpoint::makeCertificate(names, settings.certificate, settings.key);
    std::cout << settings.certificate << " and " << settings.key << " are for";
    for (const std::string& name : names) std::cout << ' ' << name;
    std::cout << std::endl;
    return 0;
}

int serve(const endpoint::Settings& settings) {
    endpoint::ServerSettings served;
    if (!settings.certificate.empty()) {
        served.certificate = std::make_shared<endpoint::Certificate>(settings.certificate, settings.key);
    }
    served.anonymousRead = settings.anonymousRead;
    const endpoint::SchemaFiles classes(settings.schema);
    if (settings.checkOnly) return 0;
    const std::string library = settings.library.empty() ? vkcim::defaultLibrary(vkcim::programDirectory())
                                                         : vkcim::libraryPath(settings.library);
    om::ObjectManager manager(library, settings.provider, "root/cimv2", classes.schema());
    manager.instanceMI(); // so that a library that is none is known now
    endpoint::NameSpace provided{
        "root/cimv2", {}, &classes.schema(), endpoint::noting([&manager](const om::Request& request) {
            return manager.run(request);
        })};
    endpoint::Operations operations({provided, endpoint::interopNameSpace({"root/cimv2"}, hostName())}, hostName());
    endpoint::Server server(operations, served);
    for (const endpoint::Listener& listener : listeners(settings)) {
        server.serve(listener);
        std::cerr << "listening on " << listener.url << std::endl;
    }
    // Whoever starts us by hand asks as soon as the service manager returns.
    sd_notify(0, "READY=1");
    server.run(stopped, idleOf(settings));
    // A provider that hangs cannot be unloaded.
    if (!server.shutDown()) _exit(0);
    return 0;
}

} // namespace

int main(int argc, char** argv) {
    const auto parsed = endpoint::parseSettings(std::vector<std::string>(argv + (argc > 0), argv + argc));
    std::cout << vkcim::wrapped(parsed.output, vkcim::lookOfStandardOutput().width) << std::flush;
    std::cerr << parsed.error;
    if (!parsed.settings) return parsed.exitStatus;
    handleSignals();
    try {
        return parsed.settings->makeCertificate ? makeCertificate(*parsed.settings) : serve(*parsed.settings);
    } catch (const std::invalid_argument& error) {
        endpoint::log(error.what());
        return unusableConfiguration;
    } catch (const std::exception& error) {
        endpoint::log(error.what());
        return notToBeHad;
    }
}
