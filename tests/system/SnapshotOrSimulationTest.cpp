// A snapshot and a simulated host of the same facts look the same to a client, and in the log.

#include "bench/Rows.h"
#include "objectmanager/vkcim/JsonOutput.h"
#include "provider/LogEvents.h"
#include "support/HostCopy.h"
#include "support/InChild.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"
#include "support/SmbiosImage.h"

#include <gmock/gmock.h>

namespace {

/// A machine with two chassis, one of them in a critical state, and a memory controller that has counted errors.
void makeSnapshot(const support::HostCopy& copy) {
    support::SmbiosImage(3, 2)
        .add(support::SmbiosSystemImage{"Veska", "VS 200", {}, "CZ1234", "P0815", std::string(16, 'u')})
        .add(support::SmbiosChassisImage{23, "Boxes", "V1", {}, {}, 3, 3, 3})
        .add(support::SmbiosChassisImage{28, {}, "V2", "CZ5678", {}, 5, 3, 3})
        .end()
        .writeTo(copy);
    copy.write("etc/hostname", "node7\n");
    copy.write("etc/machine-info", "PRIMARY_OWNER_NAME=Operations\n");
    copy.write("sys/devices/system/edac/mc/mc0/ue_count", "3\n");
    copy.useZone("Asia/Kolkata");
}

/// The same as nodes.
std::vector<test::Node> nodes() {
    const std::map<unsigned, nlohmann::json> computer = {{39, "VS 200"},
                                                         {50, "CZ1234"},
                                                         {64, "75757575-7575-7575-7575-757575757575"},
                                                         {108, "node7"},
                                                         {116, "Operations"},
                                                         {123, 1},
                                                         {127, 330},
                                                         {200, 0}};
    const std::map<unsigned, nlohmann::json> first = {
        {36, "Boxes"}, {39, "VS 200"}, {50, "CZ1234"}, {86, "P0815"}, {108, "Rack Mount Chassis"}, {128, 2}};
    const std::map<unsigned, nlohmann::json> second = {
        {36, "Veska"}, {39, "V2"}, {50, "CZ5678"}, {108, "Blade"}, {128, 3}};
    return {{40, "/computer/0", "", 22, "Veska VS 200", computer, {108}},
            {1, "/computer/0/chassis/0", "/computer/0", 1, "Rack Mount Chassis", first},
            {1, "/computer/0/chassis/1", "/computer/0", 23, "Blade", second}};
}

/// Every request with its answer and the lines that it logs.
std::string requestsAndLines() {
    std::string all;
    for (const bench::Row& row : bench::rows()) {
        const om::Request request = bench::requestOf(row, test::provider());
        test::provider().run(request);
        test::takeLog();
        all += bench::nameOf(row) + '\n' +
               vkcim::jsonText(test::provider().run(request), "root/cimv2", om::Schema::builtin()) + '\n';
        for (const std::string& event : test::events(test::takeLog())) all += event + '\n';
    }
    return all;
}

TEST(SnapshotOrSimulation, AnswerAndLogTheSame) {
    const support::HostCopy copy;
    makeSnapshot(copy);
    const std::string ofSnapshot = support::inChild([&copy] {
        unsetenv("VK_INSTRUMENTATION_TREE");
        setenv("VK_INSTRUMENTATION_ROOT", copy.path().c_str(), 1);
        return requestsAndLines();
    });
    // The product's identifier as it follows from the UUID; its architecture is this machine's.
    test::simulate(nodes(), {{"uid", "d66da6b0-79a5-83f5-b1c4-6a157f9c9086"}, {"kvm", false}});
    const std::string ofSimulation = support::inChild(requestsAndLines);
    EXPECT_THAT(ofSnapshot, testing::AllOf(testing::HasSubstr("\"PrimaryOwnerName\""), testing::HasSubstr("ENTERING")));
    EXPECT_EQ(ofSnapshot, ofSimulation);
}

} // namespace
