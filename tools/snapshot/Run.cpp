#include "tools/snapshot/Run.h"

#include "tools/snapshot/Interruption.h"
#include "tools/snapshot/Snapshot.h"
#include "tree/HostNodes.h"

#include <csignal>
#include <random>
#include <sys/stat.h>

namespace snapshot {

namespace {

struct Arguments {
    std::string directory;
    std::string root = "/";
    std::optional<std::string> hostName;
    bool masked = false; ///< asked for by name
    bool withSerials = false;
};

void describe(CLI::App& app, Arguments& arguments) {
    tools::addCommonOptions(app);
    app.add_option("DIR", arguments.directory,
                   "A directory that is not there yet, or an empty one of your own that is closed to others; in any "
                   "other one a new one is made")
        ->required()
        ->type_name("");
    app.add_flag("--mask", arguments.masked,
                 "Replace serial numbers, UUIDs and the machine id by others of the same shape: the default");
    app.add_flag("--with-serials", arguments.withSerials, "Leave them as they are");
    app.add_option("--host-name", arguments.hostName, "Write NAME in place of the host's name")->type_name("NAME");
    app.add_option("--root", arguments.root, "Read below DIR (/)")->type_name("DIR");
    app.footer("With VK_INSTRUMENTATION_ROOT=DIR the provider answers as on this host.\n"
               "Exit status: 0 done; 1 some file is there and cannot be read (most take root), or cannot be written, "
               "and then nothing is left; 2 unusable arguments.\n"
               "Example: vk-host-snapshot --host-name node7 ~/snapshot");
}

std::string randomSalt() {
    std::random_device source;
    std::string salt;
    while (salt.size() < 16) salt += static_cast<char>(source());
    return salt;
}

int take(Target& target, const Arguments& arguments, tools::Output output) {
    Mask mask(randomSalt());
    const VK::Root root(arguments.root);
    Snapshot snapshot(root, target, {arguments.withSerials ? nullptr : &mask, arguments.hostName, throwIfInterrupted});
    const auto fail = [&](const std::string& reason) {
        output.error << "vk-host-snapshot: " << reason << "; "
                     << (target.remove() ? "nothing is left of the snapshot" : "the snapshot is INCOMPLETE") << "\n";
        return 1;
    };
    try {
        snapshot.take(VK::Tree::readEverything);
    } catch (const Failure& failure) {
        return fail(failure.what());
    } catch (const Interrupted&) {
        return fail("interrupted");
    }
    output.out << snapshot.count() << " files in " << target.getPath().string()
               << (arguments.withSerials ? ", NOT masked: with serial numbers, UUIDs and the machine id\n"
                                         : ", masked\n");
    for (const std::string& problem : snapshot.problems()) output.error << "vk-host-snapshot: " << problem << "\n";
    return snapshot.problems().empty() ? 0 : 1;
}

} // namespace

int run(const std::vector<std::string>& words, tools::Output output) {
    Arguments arguments;
    CLI::App app("Copies the files of this host that the provider reads into DIR, for bug reports and for developers "
                 "of consoles.",
                 "vk-host-snapshot");
    describe(app, arguments);
    if (const std::optional<int> status = tools::parse(app, words, output)) return *status;
    if (arguments.directory.empty()) return tools::refuse(app, "DIR is empty", output);
    if (arguments.masked && arguments.withSerials)
        return tools::refuse(app, "--mask and --with-serials exclude each other", output);
    if (const auto problem = tools::problemOfDirectory(arguments.root)) return tools::refuse(app, *problem, output);
    umask(forOthers);
    signal(SIGXFSZ, SIG_IGN); // a file that becomes too large is an error like others
    catchInterruptions();
    try {
        Target target(arguments.directory);
        return take(target, arguments, output);
    } catch (const Failure& failure) {
        return tools::refuse(app, failure.what(), output);
    }
}

} // namespace snapshot
