// The host's files change while they are read: they vanish, shrink, grow and are replaced. Nobody locks them.
#include "instrumentation/HardwareFacts.h"
#include "instrumentation/HostState.h"
#include "instrumentation/SimulatedHost.h"
#include "support/HostCopy.h"
#include "support/SmbiosImage.h"

#include <gmock/gmock.h>

#include <atomic>
#include <filesystem>
#include <fstream>
#include <functional>
#include <thread>

namespace VK::Inside {

namespace {

using support::SmbiosChassisImage;
using support::SmbiosImage;
using support::SmbiosSystemImage;
using testing::AnyOf;

/// Does one after the other of these things to the files, again and again, until it is destroyed.
class Churn {
public:
    explicit Churn(std::vector<std::function<void()>> things)
        : thread([this, all = std::move(things)] {
              for (std::size_t i = 0; !ended; ++i) {
                  all[i % all.size()]();
                  done = i / all.size();
              }
          }) {}
    ~Churn() {
        ended = true;
        thread.join();
    }

    /// Whether everything has been done often enough while somebody read.
    bool isEnough() const { return done >= 50; }

private:
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
    while (!churn.isEnough()) {
        const HardwareFacts facts = readHardware(Root(host.path()));
        EXPECT_THAT(facts.serial.text, AnyOf("", "FIRST", "SECOND"));
        EXPECT_LE(facts.chassis.size(), 200u);
        for (const ChassisFacts& chassis : facts.chassis)
            EXPECT_THAT(chassis.serial.text, AnyOf("", "FIRST", "SECOND"));
    }
}

TEST(ChangingFiles, OfTheZoneAreOneZoneOrUtc) {
    const support::HostCopy host;
    const std::string zone = host.path("etc/localtime");
    const std::string kolkata = host.read("usr/share/zoneinfo/Asia/Kolkata");
    const Churn churn({[&] { host.write("etc/localtime", kolkata); }, [&] { cut(zone, 50); }, [&] { cut(zone, 0); },
                       [&] { append(zone, kolkata); }, [&] { host.remove("etc/localtime"); },
                       [&] { host.link("/usr/share/zoneinfo/Asia/Kolkata", "etc/localtime"); },
                       [&] { host.remove("etc/localtime"); }});
    while (!churn.isEnough()) EXPECT_THAT(offsetInForce(Root(host.path())), AnyOf(0, 330));
}

TEST(ChangingFiles, OfASimulatedHostAreOneOfItsTreesOrNone) {
    const support::TemporaryDirectory folder;
    const std::string file = folder.path("tree.json");
    const std::string one = R"({"nodes":[{"type":40,"path":"/c","properties":{"108":"one"}}]})";
    const std::string two = R"({"nodes":[{"type":40,"path":"/c","properties":{"108":"two"}},{"type":1,"path":"/d"}]})";
    const Churn churn({[&] { folder.write("tree.json", one); }, [&] { cut(file, 20); },
                       [&] { folder.write("tree.json", two); }, [&] { append(file, std::string(70000, ' ') + "x"); },
                       [&] { std::filesystem::remove(file); }});
    SimulatedHost host(file);
    while (!churn.isEnough()) {
        const auto tree = host.tree();
        const NodeTree::Place place = tree->find("/c");
        if (place.node == nullptr) continue;
        const auto name = host.read(*place.node, 108);
        if (!name) continue;
        EXPECT_THAT(*name, AnyOf(Value("one"), Value("two")));
    }
    folder.write("tree.json", one);
}

} // namespace

} // namespace VK::Inside
