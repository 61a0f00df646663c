#include "nvlog/NVLogger.h"
#include "nvlog/LogWatch.h"

#include "platform/logger/LoggingProcess.h"
#include "support/TemporaryDirectory.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <unistd.h>

using logging::Environment;
using logging::log;
using logging::quietly;
using logging::splitLines;
using logging::trace;
using logging::withEnvironment;
using support::TemporaryDirectory;
using testing::ElementsAre;
using testing::EndsWith;

TEST(Syslog, GetsThePrioritiesOfTheLevels) {
    const std::string lines = withEnvironment({{"NVLOG_LEVELS", "all"}, {"NVLOG_CHANNELS", "log,trace"}}, [] {
        log("a%s", 3000);
        log("b\nb", 6000);
        trace("c", 4000);
        trace("d", 1);
    });
    EXPECT_EQ(lines, "5 LOG 3000 Norvane.Test NVLoggerTest:7 run: a%s\n"
                     "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: b\\nb\n"
                     "7 TRACE 4000 Norvane.Test NVLoggerTest:7 run: c\n"
                     "7 TRACE 1 Norvane.Test NVLoggerTest:7 run: d\n");
}

TEST(Syslog, GetsTheLogChannelsNoticesAndFailuresByDefault) {
    for (const Environment& variables : {Environment{}, Environment{{"NVLOG_SINK", "nonsense"}}}) {
        const std::string lines = withEnvironment(variables, [] {
            log("kept");
            log("dropped", 4000);
            trace("dropped");
        });
        EXPECT_THAT(lines, EndsWith("3 LOG 6000 Norvane.Test NVLoggerTest:7 run: kept\n"));
        EXPECT_EQ(splitLines(lines).size(), variables.empty() ? 1U : 2U);
    }
}

TEST(UnknownSettings, AreNamedInOneLineWhateverIsKept) {
    const auto first = [](const Environment& variables) {
        const std::vector<std::string> lines = splitLines(withEnvironment(variables, [] {
            trace("dropped", 17);
            log("dropped", 17);
        }));
        EXPECT_LE(lines.size(), 1U);
        return lines.empty() ? std::string() : lines.front();
    };
    EXPECT_THAT(first({{"NVLOG_SINK", "console"}, {"NVLOG_LEVELS", "4000,lots"}, {"NVLOG_CHANNELS", "trace"}}),
                EndsWith("readSettings: not understood: NVLOG_SINK=console, NVLOG_LEVELS=lots"));
    EXPECT_THAT(first({{"NVLOG_CHANNELS", "log,traces\n"}}), EndsWith("not understood: NVLOG_CHANNELS=traces\\n"));
    EXPECT_EQ(first({{"NVLOG_SINK", "none"}, {"NVLOG_LEVELS", "lots"}}), "");
    EXPECT_EQ(first({{"NVLOG_LEVELS", "3000,,6000,"}, {"NVLOG_CHANNELS", " log "}}), "");
}

TEST(UnknownSettings, GoToTheSinkThatIsKnown) {
    TemporaryDirectory directory;
    quietly({{"NVLOG_SINK", "file:" + directory.path("log")}, {"NVLOG_LEVELS", "many"}}, [] { log("x"); });
    EXPECT_THAT(splitLines(directory.read("log")),
                ElementsAre(EndsWith(" readSettings: not understood: NVLOG_LEVELS=many"), EndsWith(" run: x")));
}

TEST(LogWatch, SeesTheLinesOfTheLogChannelThatAreKept) {
    quietly({{"NVLOG_SINK", "file:/dev/null"}, {"NVLOG_LEVELS", "3000,6000"}}, [] {
        std::vector<std::string> seen;
        const NVLogWatch watch = {[](void* context, int level, const char* text) {
                                      static_cast<std::vector<std::string>*>(context)->push_back(std::to_string(level) +
                                                                                                 text);
                                  },
                                  &seen};
        log("before");
        nvLogWatch(&watch);
        log("a");
        log("b", 3000);
        log("dropped", 4000);
        trace("c");
        nvLogWatch(nullptr);
        log("after");
        EXPECT_THAT(seen, ElementsAre("6000a", "3000b"));
    });
}

TEST(LogWatch, IsNotShownWhatIsWrongWithTheSettings) {
    TemporaryDirectory directory;
    quietly({{"NVLOG_SINK", "file:" + directory.path("log")}, {"NVLOG_LEVELS", "many"}}, [] {
        std::string seen;
        const NVLogWatch watch = {
            [](void* context, int, const char* text) { *static_cast<std::string*>(context) += text; }, &seen};
        nvLogWatch(&watch);
        log("a");
        nvLogWatch(nullptr);
        EXPECT_EQ(seen, "a");
    });
    EXPECT_EQ(splitLines(directory.read("log")).size(), 2U);
}

TEST(StandardError, GetsTheSameLines) {
    TemporaryDirectory directory;
    quietly({{"NVLOG_SINK", "stderr"}}, [&] {
        const int fd = open(directory.path("err").c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0600);
        dup2(fd, STDERR_FILENO);
        log("x");
        trace("y");
    });
    EXPECT_THAT(splitLines(directory.read("err")),
                ElementsAre(EndsWith(" LOG 6000 Norvane.Test NVLoggerTest:7 run: x"),
                            EndsWith(" TRACE 6000 Norvane.Test NVLoggerTest:7 run: y")));
}

TEST(StandardError, ThatIsClosedMakesSyslogOfIt) {
    EXPECT_EQ(withEnvironment({{"NVLOG_SINK", "stderr"}},
                              [] {
                                  close(STDERR_FILENO);
                                  log("x");
                              }),
              "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: x\n");
}

TEST(NoSink, TakesNothing) {
    EXPECT_EQ(withEnvironment({{"NVLOG_SINK", "none"}, {"NVLOG_LEVELS", "all"}},
                              [] {
                                  log("x");
                                  trace("x");
                              }),
              "");
}
