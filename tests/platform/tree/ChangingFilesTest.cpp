// The host's files change while they are read: they vanish, shrink, grow and are replaced. Nobody locks them. What is
// read is what stood there at some time, or nothing; and all of that is read some time.
#include "host/HardwareFacts.h"
#include "host/State.h"
#include "support/HostCopy.h"
#include "support/RunLevel.h"
#include "support/SmbiosImage.h"
#include "tree/SimulatedHost.h"
#include "zone/ZoneInForce.h"

#include <gmock/gmock.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <functional>
#include <set>
#include <thread>

namespace VK::Tree {

namespace {

using support::runLevel;
using support::SmbiosChassisImage;
using support::SmbiosImage;
using support::SmbiosSystemImage;
using testing::AllOf;
using testing::AnyOf;
using testing::Contains;
using testing::Ge;
using testing::Le;

/// Does one after the other of these things to the files, again and again, until it is destroyed.
class Churn {
public:
    explicit Churn(std::vector<std::function<void()>> things)
        : thread([this, all = std::move(things)] {
              for (std::size_t i = 0; !ended; ++i) {
                  all[i % all.size()]();
                  done = i / all.size();
                  // A slow reader sees each state, too.
                  if (done >= often) std::this_thread::sleep_for(std::chrono::milliseconds(1));
              }
          }) {}
    ~Churn() {
        ended = true;
        thread.join();
    }

    /// Reads until everything has been done often enough and every one of these answers has come, which is waited for;
    /// no other may come.
    template <class Answer, class Read>
    void expectOnly(const std::set<Answer>& answers, const Read& read) const {
        const auto end = std::chrono::steady_clock::now() + std::chrono::minutes(1);
        std::set<Answer> seen;
        while ((done < often || seen != answers) && std::chrono::steady_clock::now() < end) {
            const Answer answer = read();
            ASSERT_THAT(answers, Contains(answer));
            seen.insert(answer);
        }
        EXPECT_EQ(seen, answers);
    }

private:
    static constexpr std::size_t often = 50;

    std::atomic<bool> ended{false};
    std::atomic<std::size_t> done{0};
    std::thread thread;
};

SmbiosImage machine(const std::string& serial, std::size_t chassis) {
    SmbiosImage image(3, 2);
    image.add(SmbiosSystemImage{"Veska", "VS 200", "A1", serial, "P1"});
    for (std::size_t i = 0; i < chassis; ++i) image.add(SmbiosChassisImage{23, "Veska", "V1", serial, "S1"});
    return image;
}

/// Cuts a file; there may be none.
void cut(const std::string& file, std::uintmax_t size) {
    std::error_code ignored;
    std::filesystem::resize_file(file, size, ignored);
}

void append(const std::string& file, const std::string& bytes) {
    std::ofstream(file, std::ios::binary | std::ios::app) << bytes;
}

TEST(ChangingFiles, OfTheFirmwareGiveWholeTextsOrNone) {
    const support::TemporaryDirectory host;
    const std::string table = host.path("sys/firmware/dmi/tables/DMI");
    const std::string entryPoint = host.path("sys/firmware/dmi/tables/smbios_entry_point");
    const Churn churn({[&] { machine("FIRST", 1).writeTo(host); }, [&] { cut(table, 40); },
                       [&] { machine("SECOND", 60).writeTo(host); }, [&] { append(table, std::string(100000, 'x')); },
                       [&] { std::filesystem::remove(table); }, [&] { machine("FIRST", 200).writeTo(host); },
                       [&] { cut(entryPoint, 7); }, [&] { std::filesystem::remove(entryPoint); }});
    std::size_t mostChassis = 0;
    churn.expectOnly<std::string>({"", "FIRST", "SECOND"}, [&] {
        const Host::HardwareFacts facts = Host::readHardware(Root(host.path()));
        mostChassis = std::max(mostChassis, facts.chassis.size());
        for (const Host::ChassisFacts& chassis : facts.chassis)
            EXPECT_THAT(chassis.serial.text, AnyOf("", "FIRST", "SECOND"));
        return facts.serial.text;
    });
    EXPECT_THAT(mostChassis, AllOf(Ge(1u), Le(200u)));
}

TEST(ChangingFiles, OfTheZoneAreOneZoneOrUtc) {
    const support::HostCopy host;
    const std::string zone = host.path("etc/localtime");
    const std::string kolkata = host.read("usr/share/zoneinfo/Asia/Kolkata");
    const Churn churn({[&] { host.write("etc/localtime", kolkata); }, [&] { cut(zone, 50); }, [&] { cut(zone, 0); },
                       [&] { append(zone, kolkata); }, [&] { host.remove("etc/localtime"); },
                       [&] { host.write("etc/localtime", Zone::makeZoneFile(-210)); },
                       [&] { host.remove("etc/localtime"); },
                       [&] { host.link("/usr/share/zoneinfo/Asia/Kolkata", "etc/localtime"); },
                       [&] { host.remove("etc/localtime"); }});
    churn.expectOnly<int>({0, 330, -210}, [&] { return Zone::offsetInForce(Root(host.path())); });
}

TEST(ChangingFiles, OfASimulatedHostAreOneOfItsTreesOrNone) {
    const support::TemporaryDirectory directory;
    const std::string file = directory.path("tree.json");
    const std::string one = R"({"nodes":[{"type":40,"path":"/c","properties":{"108":"one"}}]})";
    const std::string two = R"({"nodes":[{"type":40,"path":"/c","properties":{"108":"two"}},{"type":1,"path":"/d"}]})";
    const Churn churn({[&] { directory.write("tree.json", one); }, [&] { cut(file, 20); },
                       [&] { directory.write("tree.json", two); }, [&] { append(file, std::string(70000, ' ') + "x"); },
                       [&] { std::filesystem::remove(file); }});
    SimulatedHost host(file);
    churn.expectOnly<Value>({Value(""), Value("one"), Value("two")}, [&] {
        const auto tree = host.tree();
        const NodeTree::Place place = tree->find("/c");
        return place.node != nullptr ? host.read(*place.node, 108).value_or("nameless") : Value("");
    });
    directory.write("tree.json", one);
}

/// Puts a file in the place of another at one stroke, as system tools do.
void exchange(const support::TemporaryDirectory& host, const std::string& name, const std::string& bytes) {
    host.write(name + ".new", bytes);
    std::filesystem::rename(host.path(name + ".new"), host.path(name));
}

std::function<void()> exchanging(const support::TemporaryDirectory& host, const char* name, const std::string& bytes) {
    return [&host, name, bytes] { exchange(host, name, bytes); };
}

std::function<void()> removing(const support::TemporaryDirectory& host, const char* name) {
    return [&host, name] { std::filesystem::remove_all(host.path(name)); };
}

std::function<void()> emptying(const support::TemporaryDirectory& host, const char* name) {
    return [&host, name] { cut(host.path(name), 0); };
}

TEST(ChangingFiles, OfMemoryControllersTellErrorsOnlyWhereTheyAreCounted) {
    const char* const count = "sys/devices/system/edac/mc/mc1/ue_count";
    const support::TemporaryDirectory host;
    const auto read = [&] { return Host::hasUncorrectableMemoryErrors(Root(host.path())); };
    const auto none = exchanging(host, count, "0\n");
    const auto gone = removing(host, "sys/devices/system/edac/mc/mc1");
    {
        const Churn churn({none, exchanging(host, count, "12\n"), emptying(host, count), gone});
        churn.expectOnly<bool>({false, true}, read);
    }
    none();
    const Churn churn({none, emptying(host, count), gone, exchanging(host, count, "00000\n")});
    churn.expectOnly<bool>({false}, read);
}

TEST(ChangingFiles, OfTheHostsNameAreOneNameOrNone) {
    const char* const file = "etc/hostname";
    const support::TemporaryDirectory host;
    const Churn churn({exchanging(host, file, "node7\n"), emptying(host, file),
                       exchanging(host, file, "# " + std::string(9000, '-') + "\na-much-longer-name.example\n"),
                       removing(host, file)});
    churn.expectOnly<std::string>({"", "node7", "a-much-longer-name.example"},
                                  [&] { return Host::hostName(Root(host.path())).value_or(""); });
}

TEST(ChangingFiles, OfShutdownsTellOneOnlyWhereItIsDue) {
    const char* const utmpFile = "run/utmp";
    const char* const scheduled = "run/systemd/shutdown/scheduled";
    const support::TemporaryDirectory host;
    const auto read = [&] { return Host::readShutdown(Root(host.path())).isUnderWay(); };
    const auto normal = exchanging(host, utmpFile, runLevel('5'));
    const auto halfARecord = [&] { append(host.path(utmpFile), runLevel('6').substr(0, 100)); };
    const auto dryRun = exchanging(host, scheduled, "USEC=1\nMODE=dry-reboot\n");
    {
        const Churn churn({normal, exchanging(host, utmpFile, runLevel('5') + runLevel('0')), emptying(host, utmpFile),
                           removing(host, utmpFile)});
        churn.expectOnly<bool>({false, true}, read);
    }
    exchange(host, utmpFile, runLevel('5'));
    {
        const Churn churn({dryRun, exchanging(host, scheduled, "USEC=1\nMODE=reboot\n"), emptying(host, scheduled),
                           removing(host, scheduled)});
        churn.expectOnly<bool>({false, true}, read);
    }
    exchange(host, scheduled, "USEC=1\nMODE=dry-reboot\n");
    const Churn churn({normal, halfARecord, emptying(host, utmpFile), dryRun, emptying(host, scheduled),
                       removing(host, utmpFile), removing(host, scheduled)});
    churn.expectOnly<bool>({false}, read);
}

/// More than what is read at once, so that the last line comes from a later read than the others.
std::string sysinfo(const std::string& maker, const std::string& type, const std::string& serial) {
    return "Manufacturer: " + maker + "\nType: " + type + "\nComment: " + std::string(9000, '-') +
           "\nSequence Code: " + serial + "\n";
}

TEST(ChangingFiles, OfSystemInformationGiveTheFactsOfOneSystem) {
    using Facts = std::array<std::string, 3>;
    const char* const file = "proc/sysinfo";
    const support::TemporaryDirectory host;
    const Churn churn({exchanging(host, file, sysinfo("Veska", "2964", "FIRST")), removing(host, file),
                       exchanging(host, file, sysinfo("Another maker", "3906 model B", "SECOND")),
                       removing(host, file)});
    churn.expectOnly<Facts>({{"", "", ""}, {"Veska", "2964", "FIRST"}, {"Another maker", "3906 model B", "SECOND"}},
                            [&] {
                                const Host::HardwareFacts facts = Host::readHardware(Root(host.path()));
                                return Facts{facts.manufacturer.text, facts.model.text, facts.serial.text};
                            });
}

TEST(ChangingFiles, OfADeviceTreeGiveWholeTextsOrNone) {
    const char* const model = "proc/device-tree/model";
    const std::string zero(1, '\0');
    const support::TemporaryDirectory host;
    const Churn churn({exchanging(host, model, "Board" + zero), emptying(host, model),
                       exchanging(host, model, "Another board" + zero + "rest" + zero), removing(host, model),
                       [&] { std::filesystem::create_directories(host.path(model)); }, removing(host, model)});
    churn.expectOnly<std::string>({"", "Board", "Another board"},
                                  [&] { return Host::readHardware(Root(host.path())).model.text; });
}

} // namespace

} // namespace VK::Tree
