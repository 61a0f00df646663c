#pragma GCC visibility push(default)
#include "nvlog/NVLogger.h"
#pragma GCC visibility pop

#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gtest/gtest.h>

#include <pthread.h>

// This program's own logger, which stands before the product's: it ends its thread at a line of the test's choice.

namespace {

thread_local int linesLeft = 0; ///< until the thread ends; 0 for never

} // namespace

namespace NVLog {

void NVLogger::logLevelMessage(const char*, const char*, int, const std::string&, int, char*, int, int,
                               const std::string&) {
    if (linesLeft > 0 && --linesLeft == 0) pthread_exit(nullptr);
}

void NVLogger::traceLevelMessage(const char*, const char*, int, const std::string&, int, char*, int, int,
                                 const std::string&) {}

} // namespace NVLog

namespace {

struct Run {
    const om::Request& request;
    const int line;
    bool wentOn = false;
};

void* start(void* argument) {
    Run& run = *static_cast<Run*>(argument);
    linesLeft = run.line;
    test::provider().run(run.request);
    run.wentOn = true;
    return nullptr;
}

/// Whether a thread that runs the request ends at that line.
bool endsAt(const om::Request& request, int line) {
    Run run{request, line};
    pthread_t thread{};
    EXPECT_EQ(pthread_create(&thread, nullptr, start, &run), 0);
    EXPECT_EQ(pthread_join(thread, nullptr), 0);
    return !run.wentOn;
}

om::Request asking(om::Operation operation, const char* className) {
    om::Request request;
    request.operation = operation;
    request.path = test::path(className);
    return request;
}

TEST(EndedThread, IsUnwoundFromEveryLineOfARequestAndTheNextOneIsAnswered) {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")});
    om::Request readingTime = asking(om::Operation::InvokeMethod, "VESKA_TimeService");
    readingTime.method = "ManageTime";
    readingTime.values = {{"GetRequest", {CMPI_boolean, true}}, {"ManagedElement", {CMPI_ref, {}}}};
    for (const om::Request& request : {asking(om::Operation::EnumInstances, "VESKA_ComputerSystem"),
                                       asking(om::Operation::EnumInstanceNames, "VESKA_ComputerSystemPackage"),
                                       asking(om::Operation::Associators, "VESKA_ComputerSystem"), readingTime}) {
        const om::Answer whole = test::provider().run(request);
        int line = 1;
        while (endsAt(request, line)) ++line;
        EXPECT_GT(line, 10) << "they are many";
        const om::Answer after = test::provider().run(request);
        EXPECT_EQ(after.code, CMPI_RC_OK);
        EXPECT_EQ(after.results, whole.results);
    }
}

} // namespace
