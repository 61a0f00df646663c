// This program's own logger, which stands before the product's.
#pragma GCC visibility push(default)
#include "nvlog/NVLogger.h"
#pragma GCC visibility pop

#include "include/Trace.h"
#include "support/Allocations.h"
#include "support/InChild.h"

#include <gmock/gmock.h>

#include <atomic>
#include <climits>
#include <cstring>
#include <functional>
#include <map>
#include <mutex>
#include <set>
#include <sstream>
#include <thread>
#include <vector>

#include <unistd.h>

namespace {

using testing::AllOf;
using testing::ElementsAre;
using testing::EndsWith;
using testing::Field;
using testing::SizeIs;
using testing::StartsWith;
using namespace VK;

struct Event {
    std::string channel;
    const std::string* handed; ///< the string itself
    std::string text;
    std::string function;
    std::string file;
    int line;
    const std::string* category;
    int level;
};

std::mutex mutex;
std::vector<Event> events;
std::atomic<bool> quiet{false};
/// Where lines go instead while the process ends and the objects above are gone.
void (*atTheEnd)(const std::string& category, const std::string& text) = nullptr;

void write(const char* channel, const char* function, const char* file, int line, const std::string& category,
           int level, const std::string& text) {
    if (atTheEnd != nullptr) return atTheEnd(category, text);
    if (quiet) return;
    const std::lock_guard<std::mutex> lock(mutex);
    events.push_back({channel, &text, text, function, file, line, &category, level});
}

} // namespace

namespace NVLog {

void NVLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& category, int level,
                               char*, int, int, const std::string& text) {
    write("LOG", function, file, line, category, level, text);
}

void NVLogger::traceLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                 int level, char*, int, int, const std::string& text) {
    write("TRACE", function, file, line, category, level, text);
}

} // namespace NVLog

namespace {

const std::string& category = lastingString("Norvane.BaseServerProvider");
const TraceSource source{category, "Sample"};

std::vector<Event> eventsOf(const std::function<void()>& run) {
    events.clear();
    run();
    return events;
}

/// Those of the log channel.
std::vector<std::string> textsOf(const std::function<void()>& run) {
    std::vector<std::string> texts;
    for (const Event& event : eventsOf(run))
        if (event.channel == "LOG") texts.push_back(event.text);
    return texts;
}

void scope() {
    const TraceScope lines(VK_SCOPE(source), FailureLevel);
}
constexpr int lineOfScope = __LINE__ - 2;

TEST(TracePlace, HandsEveryArgumentToBothChannelsEachTime) {
    const std::string in = "() in Sample [Line: " + std::to_string(lineOfScope) + "]";
    for (int time = 1; time <= 2; ++time) {
        EXPECT_THAT(textsOf(scope), ElementsAre("ENTERING: scope" + in, "EXITING: scope" + in));
        const std::vector<Event> both = eventsOf(scope);
        EXPECT_THAT(both, testing::Each(AllOf(Field(&Event::function, "scope"), Field(&Event::file, "Sample"),
                                              Field(&Event::line, lineOfScope), Field(&Event::category, &category))));
        std::vector<std::string> order;
        for (const Event& event : both) order.push_back(event.channel + std::to_string(event.level));
        EXPECT_THAT(order, ElementsAre("LOG6000", "TRACE6000", "LOG4000", "TRACE4000"));
    }
}

TEST(TracePlace, HandsOverTheSameStringAtEveryCall) {
    const auto lines = [] {
        scope();
        traceMethod(VK_METHOD(source));
        traceDestructor(VK_METHOD_OF(source, "~Sample"));
        const DestructorTraceScope destructor(VK_SCOPE(source));
    };
    lines();
    std::vector<const std::string*> first;
    for (const Event& event : eventsOf(lines)) first.push_back(event.handed);
    std::vector<const std::string*> second;
    for (const Event& event : eventsOf(lines)) second.push_back(event.handed);
    ASSERT_THAT(first, SizeIs(12));
    EXPECT_EQ(first, second);
}

TEST(TracePlace, MakesItsLinesOnce) {
    quiet = true;
    const auto reach = [] {
        const TraceScope lines(VK_SCOPE(source));
        traceMethod(VK_METHOD(source));
    };
    EXPECT_EQ(support::allocationsDuring(reach), 5U) << "two places, and their three strings";
    EXPECT_EQ(support::allocationsDuring([&] {
                  for (int i = 0; i < 100; ++i) reach();
              }),
              0U);
    quiet = false;
}

TEST(TracePlace, NeedsNoMemoryForALongLineAfterAShortOne) {
    quiet = true;
    const std::string longText(400, 'x');
    traceVariable(source, "name", "short");
    EXPECT_EQ(support::allocationsDuring([&] { traceVariable(source, "name", longText.c_str()); }), 0U);
    quiet = false;
}

void reachARacedPlace() {
    traceMethod(VK_METHOD_OF(source, "raced"));
}

TEST(TracePlace, TakesTheLinesOfAnotherThatWasFirstMeanwhile) {
    events.clear();
    events.reserve(4);
    support::atNextAllocation(reachARacedPlace);
    reachARacedPlace();
    ASSERT_THAT(events, SizeIs(4)) << "two calls to two channels";
    for (const Event& event : events) EXPECT_EQ(event.handed, events[0].handed);
}

TEST(TracePlace, ThrowsWhereThereIsNoMemoryForItsLinesAndMakesThemTheNextTime) {
    quiet = true;
    const auto reach = [] { traceMethod(VK_METHOD(source)); };
    bool thrown = false;
    {
        const support::MemoryShortage shortage;
        try {
            reach();
        } catch (const std::bad_alloc&) {
            thrown = true;
        }
    }
    EXPECT_TRUE(thrown);
    EXPECT_GT(support::allocationsDuring(reach), 0U);
    EXPECT_EQ(support::allocationsDuring(reach), 0U);
    quiet = false;
}

constexpr const char* names[] = {"zero", "one", "two", "three"};

template <int number>
void reachAPlace() {
    traceMethod(VK_METHOD_OF(source, names[number]));
}

TEST(TracePlace, IsReachedFirstBySeveralThreadsAndHasOneString) {
    constexpr int threads = 8;
    std::atomic<int> waiting{threads};
    const auto reachAll = [&] {
        --waiting;
        while (waiting > 0) std::this_thread::yield();
        reachAPlace<0>(), reachAPlace<1>(), reachAPlace<2>(), reachAPlace<3>();
    };
    std::map<std::string, std::set<const std::string*>> strings;
    for (const Event& event : eventsOf([&] {
             std::vector<std::thread> running;
             for (int i = 0; i < threads; ++i) running.emplace_back(reachAll);
             for (std::thread& thread : running) thread.join();
         }))
        strings[event.text].insert(event.handed);
    EXPECT_THAT(strings, SizeIs(4));
    for (const auto& [text, handed] : strings) EXPECT_THAT(handed, SizeIs(1)) << text;
}

void parameters(const char* value) {
    const ParameterTraceScope scope(VK_SCOPE(source), " value=", value);
}
constexpr int lineOfParameters = __LINE__ - 2;

TEST(ParameterTraceScope, CutsEachOfItsLinesAt511Characters) {
    const std::string in =
        "parameters() in Sample [Line: " + std::to_string(lineOfParameters) + "],Parameters List:  value=";
    const std::size_t head = ("EXITING: " + in).size();
    for (const std::size_t room : {509U, 510U, 511U, 512U, 600U}) { // of the exit line, which is the shorter one
        const std::string value = std::string(room - head - 1, 'x') + "yzz";
        EXPECT_THAT(textsOf([&] { parameters(value.c_str()); }),
                    ElementsAre(("ENTERING: " + in + value).substr(0, 511), ("EXITING: " + in + value).substr(0, 511)));
    }
}

TEST(ParameterTraceScope, ShowsAddressesAsAStreamDoesAndNumbersUnsigned) {
    const auto shown = [](const auto&... parts) {
        const std::string text = textsOf([&] { const ParameterTraceScope scope(VK_SCOPE(source), parts...); }).at(0);
        return text.substr(text.find("List: ") + 6);
    };
    const int object = 5;
    std::ostringstream address;
    address << static_cast<const void*>(&object);
    char text[] = "text";
    const char* const none = nullptr;
    EXPECT_EQ(shown(&object, static_cast<const int*>(nullptr)), address.str() + "0");
    EXPECT_EQ(shown(static_cast<char*>(text), none), "text(null)");
    EXPECT_EQ(shown(UINT_MAX, "/", 0U), "4294967295/0");
}

TEST(ParameterTraceScope, KeepsItsLineWhileOthersOfThePlaceAreOpen) {
    const std::function<void(unsigned int)> nested = [&](unsigned int depth) {
        const ParameterTraceScope scope(VK_SCOPE_OF(source, "nested"), " depth=", depth);
        if (depth < 100) nested(depth + 1); // more than there are strings for all
    };
    const std::vector<std::string> texts = textsOf([&] { nested(1); });
    ASSERT_THAT(texts, SizeIs(200));
    for (std::size_t i = 0; i < 100; ++i) {
        const std::string end = ",Parameters List:  depth=" + std::to_string(i + 1);
        EXPECT_THAT(texts[i], AllOf(StartsWith("ENTERING: nested() in Sample [Line: "), EndsWith(end)));
        EXPECT_THAT(texts[199 - i], AllOf(StartsWith("EXITING: nested() in Sample [Line: "), EndsWith(end)));
    }
}

TEST(Fork, LeavesTheChildItsLinesWhateverOtherThreadsHadInHand) {
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
    GTEST_SKIP() << "a sanitizer's own memory stays locked in a child that is forked while another thread takes some";
#endif
    std::atomic<bool> stop{false};
    std::vector<std::thread> busy;
    quiet = true;
    for (int i = 0; i < 4; ++i)
        busy.emplace_back([&] {
            while (!stop) {
                const ParameterTraceScope held(VK_SCOPE_OF(source, "held"), " value=", 1U);
                traceVariable(source, "name", "value");
            }
        });
    for (int i = 0; i < 20; ++i)
        EXPECT_EQ(support::inChild([] {
                      alarm(20);
                      quiet = false;
                      const std::vector<std::string> texts = textsOf([] {
                          const ParameterTraceScope scope(VK_SCOPE_OF(source, "held"), " value=", 2U);
                          traceVariable(source, "name", "value");
                          traceMethod(VK_METHOD_OF(source, "new"));
                      });
                      std::_Exit(texts.size() == 4 && texts[3].find(" value=2") != std::string::npos ? 7 : 8);
                      return std::string();
                  }),
                  "the child exited with 7");
    stop = true;
    for (std::thread& thread : busy) thread.join();
    quiet = false;
}

void linesAtTheEnd() {
    const TraceScope scope(VK_SCOPE_OF(source, "scope"));
    traceMethod(VK_METHOD_OF(source, "method"));
    const ParameterTraceScope withParameters(VK_SCOPE_OF(source, "parameters"), " value=", "a value");
    traceVariable(TracePoint(source, "variable", 7), "name", "a value that is longer than a short string is inside");
}

int rightLines = 0;

/// Runs behind the destructors of all static objects, and behind the library's own end.
__attribute__((destructor(101))) void afterTheEnd() {
    if (atTheEnd == nullptr) return;
    std::thread(linesAtTheEnd).join();
    std::_Exit(rightLines == 12 ? 7 : 8);
}

TEST(EndOfTheProcess, LeavesThreadsTheirLines) {
    EXPECT_EQ(support::inChild([] {
                  quiet = true;
                  linesAtTheEnd(); // made before the end
                  atTheEnd = [](const std::string& ofCategory, const std::string& text) {
                      const char* const starts[] = {"ENTERING: scope() in Sample [Line: ",
                                                    "METHOD: method() was invoked in Sample [Line: ",
                                                    "ENTERING: parameters() in Sample [Line: ",
                                                    "VARIABLE: 'name' has Value 'a value that is longer than a short ",
                                                    "EXITING: parameters() in Sample [Line: ",
                                                    "EXITING: scope() in Sample [Line: "};
                      const char* const start = starts[rightLines / 2];
                      if (ofCategory == "Norvane.BaseServerProvider" && text.compare(0, std::strlen(start), start) == 0)
                          ++rightLines;
                  };
                  return std::string();
              }),
              "the child exited with 7");
}

} // namespace
