#include "objectmanager/endpoint/Rights.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"
#include "tests/objectmanager/cimxml/Messages.h"
#include "tests/objectmanager/endpoint/RunningServer.h"

#include <gmock/gmock.h>

#include <fstream>

namespace endpoint {
namespace {

using testing::AllOf;
using testing::ContainsRegex;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

const auto inChunks = AllOf(StartsWith("HTTP/1.1 200"), HasSubstr("\r\nTransfer-Encoding: chunked\r\n"),
                            Not(HasSubstr("Content-Length")));

std::string posted(const std::string& operation, const std::string& message) {
    return head("Content-Length: " + std::to_string(message.size()) + "\r\n", operation) + message;
}

std::string bodyOf(Client& client, const std::string& itsHead) {
    std::string text;
    client.receiveBody(itsHead, [&text](std::string_view piece) { text += piece; });
    return text;
}

/// The provider's real library, on a host of several hundred computers.
class ManyComputers : public RunningServer {
protected:
    ManyComputers() {
        std::vector<test::Node> nodes;
        for (unsigned i = 0; i < 300; ++i) {
            nodes.push_back(test::computer(i, "node" + std::to_string(i)));
            nodes.push_back(test::chassis(i, 0, "CZ" + std::to_string(i)));
        }
        test::simulate(nodes);
    }

    om::Answer provide(const om::Request& wanted) override { return test::provider().run(wanted); }

    /// What an answer would be in one buffer.
    std::string whole(const std::string& message) {
        const Caller caller{"root", "", true, true};
        return operations->answer(cimxml::readRequest(message), caller).message;
    }
};

TEST_F(ManyComputers, LargeAnswersComeInChunksAndAreTheSameText) {
    start();
    Client client(path);
    const std::string computers = cimxml::parameter("ClassName", cimxml::className("CIM_ComputerSystem"));
    const std::string origins = cimxml::parameter("IncludeClassOrigin", "<VALUE>TRUE</VALUE>");
    const std::string all = cimxml::parameter("MaxObjectCount", "<VALUE>300</VALUE>");
    const std::string classes = cimxml::parameter("DeepInheritance", "<VALUE>TRUE</VALUE>") +
                                cimxml::parameter("LocalOnly", "<VALUE>FALSE</VALUE>");
    const std::pair<std::string, std::string> questions[] = {{"EnumerateInstances", computers},
                                                             {"EnumerateInstances", computers + origins},
                                                             {"EnumerateInstanceNames", computers},
                                                             {"OpenEnumerateInstances", computers + all},
                                                             {"OpenEnumerateInstancePaths", computers + all},
                                                             {"EnumerateClasses", classes}};
    for (const auto& [operation, parameters] : questions) {
        const std::string message = cimxml::intrinsic(operation, parameters);
        client.send(posted(operation, message));
        const std::string itsHead = client.receiveHead();
        EXPECT_THAT(itsHead, inChunks) << operation;
        const std::string text = bodyOf(client, itsHead);
        EXPECT_GT(text.size(), Limits().wholeAnswer) << operation;
        EXPECT_EQ(text, whole(message)) << operation;
    }
    EXPECT_THAT(client.ask(request("VESKA_TimeService")), HasSubstr("\r\nContent-Length: ")); // still open
}

TEST_F(ManyComputers, AnEnumerationIsPulledInLargePieces) {
    start();
    Client client(path);
    const auto pieceOf = [&](const std::string& operation, const std::string& parameters) {
        return client.ask(posted(operation, cimxml::intrinsic(operation, parameters)));
    };
    const std::string count = cimxml::parameter("MaxObjectCount", "<VALUE>150</VALUE>");
    const std::string first = pieceOf("OpenEnumerateInstances",
                                      cimxml::parameter("ClassName", cimxml::className("CIM_ComputerSystem")) + count);
    EXPECT_THAT(first, AllOf(HasSubstr("chunked"), HasSubstr("node149<"), Not(HasSubstr("node150<"))));
    const std::size_t at = first.rfind("<VALUE>", first.rfind("</VALUE>"));
    const std::string context = first.substr(at, first.rfind("</VALUE>") + 8 - at);
    const std::string second =
        pieceOf("PullInstancesWithPath", cimxml::parameter("EnumerationContext", context) + count);
    EXPECT_THAT(second, AllOf(HasSubstr("chunked"), HasSubstr("node150<"), HasSubstr("node299<"),
                              HasSubstr("<PARAMVALUE NAME=\"EndOfSequence\" PARAMTYPE=\"boolean\"><VALUE>TRUE<")));
}

TEST_F(ManyComputers, AClientOfHttp10GetsAllUntilTheConnectionEnds) {
    start();
    Client client(path);
    const std::string message = body("CIM_ComputerSystem");
    std::string old = posted("EnumerateInstanceNames", message);
    old.replace(old.find("HTTP/1.1"), 8, "HTTP/1.0");
    client.send(old);
    const std::string itsHead = client.receiveHead();
    EXPECT_THAT(itsHead, AllOf(HasSubstr(" 200 "), Not(HasSubstr("chunked")), Not(HasSubstr("Content-Length"))));
    EXPECT_EQ(bodyOf(client, itsHead), whole(message));
}

/// Answers with as many paths as `results` says.
class Streaming : public RunningServer {
protected:
    Streaming() { results = 100000; } // some 15 MB, more than any socket holds
};

TEST_F(Streaming, ShortAnswersHaveALength) {
    results = 100;
    start();
    EXPECT_THAT(Client(path).ask(request()), AllOf(HasSubstr("\r\nContent-Length: "), Not(HasSubstr("chunked"))));
}

TEST_F(Streaming, WhoTakesNothingHoldsUpNobody) {
    start();
    Client slow(path);
    slow.send(request());
    EXPECT_THAT(slow.receiveHead(), inChunks);
    results = 1;
    Client other(path);
    for (int i = 0; i < 10; ++i) EXPECT_THAT(other.ask(request()), EndsWith("</CIM>"));
    EXPECT_THAT(bodyOf(slow, "Transfer-Encoding: chunked"), EndsWith("</CIM>"));
}

TEST_F(Streaming, AClientThatGoesAwayInTheMiddleIsSaid) {
    testing::internal::CaptureStderr();
    Limits limits;
    limits.endingOfHanging = std::chrono::hours(1);
    start(limits);
    {
        Client gone(path);
        gone.send(request());
        EXPECT_THAT(gone.receiveHead(), inChunks);
    }
    stopped = true;
    running.join();
    EXPECT_TRUE(server->shutDown()); // when no answer is on its way any more
    EXPECT_THAT(testing::internal::GetCapturedStderr(),
                ContainsRegex(" EnumerateInstanceNames root/cimv2 VESKA_ComputerSystem http=200 cim=0 us=[0-9]+: "
                              "the client did not take the answer\n"));
}

TEST_F(Streaming, WhatIsOnItsWayMayEndWhileTheServerStops) {
    Limits limits;
    limits.endingOfHanging = std::chrono::minutes(5);
    start(limits);
    Client client(path);
    client.send(request());
    const std::string itsHead = client.receiveHead();
    stopped = true;
    running.join();
    bool clean = false;
    std::thread stopping([&] { clean = server->shutDown(); });
    EXPECT_THAT(bodyOf(client, itsHead), EndsWith("</CIM>"));
    stopping.join();
    EXPECT_TRUE(clean);
}

#if !defined(__SANITIZE_ADDRESS__) && !defined(__SANITIZE_THREAD__) // whose own memory hides it

/// Instances that share what they hold, so that only their text is large: some 64 KiB for each.
class SharedTexts : public Streaming {
protected:
    om::Answer provide(const om::Request& wanted) override {
        om::Instance instance;
        instance.path = wanted.path;
        instance.properties.emplace_back("Description", om::Value{CMPI_instance, part});
        om::Answer answer;
        for (int i = 0; i < results; ++i) answer.results.emplace_back(instance);
        return answer;
    }

    /// How far the process's memory grows while an answer of so many instances is received, in bytes; below 0 where the
    /// kernel, which counts for each thread by itself, had not counted everything before.
    std::ptrdiff_t peakFor(int instances) {
        results = instances;
        Client client(path);
        const std::string message = cimxml::intrinsic(
            "EnumerateInstances", cimxml::parameter("ClassName", cimxml::className("VESKA_ComputerSystem")));
        std::ofstream("/proc/self/clear_refs") << "5"; // the peak is what there is now
        const std::ptrdiff_t before = resident("VmRSS:");
        client.send(posted("EnumerateInstances", message));
        std::size_t length = 0;
        client.receiveBody(client.receiveHead(), [&](std::string_view piece) { length += piece.size(); });
        EXPECT_GT(length, static_cast<std::size_t>(instances) << 16U);
        return resident("VmHWM:") - before;
    }

private:
    static std::ptrdiff_t resident(const std::string& name) {
        std::ifstream status("/proc/self/status");
        for (std::string word; status >> word;) {
            std::ptrdiff_t kilobytes = 0;
            if (word == name && status >> kilobytes) return kilobytes * 1024;
        }
        return 0;
    }

    std::shared_ptr<const om::Instance> part = [] {
        om::Instance made;
        made.path.className = "VESKA_ComputerSystem";
        made.properties.emplace_back("Description", om::Value{CMPI_string, std::string(std::size_t{1} << 16U, 'x')});
        return std::make_shared<const om::Instance>(std::move(made));
    }();
};

TEST_F(SharedTexts, TheTextOfALargeAnswerIsNeverInMemoryAtOnce) {
    start();
    peakFor(100); // what the threads and the allocator take for good
    const std::ptrdiff_t small = peakFor(100);
    const std::ptrdiff_t large = peakFor(1000); // 64 MiB
    EXPECT_LT(large, small + 4 * 1024 * 1024);
}

#endif

} // namespace
} // namespace endpoint
