#include "objectmanager/endpoint/Settings.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <sstream>
#include <stdexcept>

namespace endpoint {
namespace {

constexpr int unusable = 2;

void check(const Settings& settings) {
    const bool https = std::any_of(settings.listen.begin(), settings.listen.end(),
                                   [](const ListenUrl& url) { return url.kind == Listener::Kind::Https; });
    if (https && (settings.certificate.empty() || settings.key.empty())) {
        throw std::invalid_argument("https takes --certificate and --key");
    }
    if (settings.certificate.empty() != settings.key.empty()) {
        throw std::invalid_argument("--certificate and --key go together");
    }
    if (settings.makeCertificate && settings.certificate.empty()) {
        throw std::invalid_argument("--make-certificate takes --certificate and --key");
    }
    if (settings.provider.empty()) throw std::invalid_argument("--provider is empty");
}

} // namespace

ParsedSettings parseSettings(const std::vector<std::string>& words) {
    CLI::App app("Answers CIM operations over HTTP for a CMPI provider library.", "vkcimd");
    Settings settings;
    std::vector<std::string> urls;
    long idle = -1;
    app.set_version_flag("--version", "vkcimd " VKCIMD_VERSION, "Print the version and exit");
    app.set_help_flag("--help", "Print this and exit");
    app.allow_config_extras(CLI::config_extras_mode::error);
    app.set_config("--config", "/etc/vkcimd.conf", "Configuration file; its keys are the options' names");
    app.add_option("--listen", urls, "unix:PATH, http://127.0.0.1:5988 or https://[::]:5989; may be repeated")
        ->type_name("URL");
    app.add_option("--certificate", settings.certificate, "Certificate for https, in PEM")->type_name("FILE");
    app.add_option("--key", settings.key, "Its key, in PEM")->type_name("FILE");
    app.add_flag("--anonymous-read", settings.anonymousRead, "Everybody may read, over the loopback and the socket");
    app.add_option("--library", settings.library, "Provider library")->type_name("FILE");
    app.add_option("--provider", settings.provider, "Provider name, the prefix of the factory functions")
        ->capture_default_str()
        ->type_name("NAME");
    app.add_option("--schema", settings.schema,
                   "MOF file with the provider's classes, each behind those that it refers to; may be repeated (the "
                   "classes built in)")
        ->type_name("FILE");
    app.add_option("--idle-exit", idle,
                   "Exit after so many seconds without a connection, 0: never (300 for a socket that the service "
                   "manager holds)")
        ->type_name("SECONDS")
        ->check(CLI::Range(0L, 86400L).description(""));
    app.add_flag("--foreground", settings.foreground, "Open the sockets ourselves, without a service manager")
        ->configurable(false);
    app.add_flag("--check-config", settings.checkOnly, "Only check the configuration")->configurable(false);
    std::vector<std::string> names;
    const CLI::Option* make =
        app.add_option("--make-certificate", names,
                       "Write a certificate that nobody else has signed, and its key, for these names and addresses "
                       "(this host's), and exit")
            ->type_name("[NAME...]")
            ->expected(0, -1)
            ->configurable(false);
    app.footer("Exit status: 0 stopped or idle, 2 unusable configuration, 3 the provider or a socket cannot be had.");
    try {
        app.parse(std::vector<std::string>(words.rbegin(), words.rend()));
        for (const std::string& url : urls) settings.listen.emplace_back(url);
        if (idle >= 0) settings.idleExit = std::chrono::seconds(idle);
        names.erase(std::remove(names.begin(), names.end(), ""), names.end()); // CLI11 has one where none is given
        if (make->count() > 0) settings.makeCertificate = names;
        check(settings);
        return {std::move(settings), 0, {}, {}};
    } catch (const CLI::Success& success) { // --help and --version
        std::ostringstream output;
        app.exit(success, output, output);
        return {std::nullopt, 0, output.str(), {}};
    } catch (const std::exception& error) {
        return {std::nullopt, unusable, {}, std::string("vkcimd: ") + error.what() + '\n'};
    }
}

} // namespace endpoint
