#include "nvlog/NVLogger.h"

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
        EXPECT_EQ(lines, "3 LOG 6000 Norvane.Test NVLoggerTest:7 run: kept\n");
    }
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
