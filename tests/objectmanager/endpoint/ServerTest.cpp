#include "objectmanager/endpoint/Server.h"

#include "objectmanager/endpoint/Rights.h"
#include "tests/objectmanager/endpoint/RunningServer.h"

#include <gmock/gmock.h>

#include <unistd.h>

namespace endpoint {
namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;

using ServerTest = RunningServer;

TEST_F(ServerTest, ServesSeveralRequestsOverOneConnection) {
    start();
    Client client(path);
    for (int i = 0; i < 3; ++i) {
        const std::string answer = client.ask(request());
        EXPECT_THAT(answer, StartsWith("HTTP/1.1 200 OK\r\n"));
        EXPECT_THAT(answer, HasSubstr("<INSTANCENAME CLASSNAME=\"VESKA_ComputerSystem\">"));
    }
    client.send(request() + request("CIM_ComputerSystem")); // two in one packet
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, TakesChunkedBodies) {
    start();
    Client client(path);
    const std::string whole = body("VESKA_ComputerSystem");
    char size[16];
    std::snprintf(size, sizeof size, "%zx", whole.size() - 5);
    client.send(head("Transfer-Encoding: chunked\r\n") + "5\r\n" + whole.substr(0, 5) + "\r\n");
    client.send(size + std::string("\r\n") + whole.substr(5) + "\r\n0\r\n\r\n");
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, AnswersAMandatoryRequestWithAllOfItsHeaders) {
    start();
    const std::string message = body("VESKA_ComputerSystem");
    const std::string answer =
        Client(path).ask("M-POST /cimom HTTP/1.1\r\nHost: x\r\nContent-Type: application/xml\r\n"
                         "Man: http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=40\r\n40-CIMOperation: MethodCall\r\n"
                         "40-CIMMethod: EnumerateInstanceNames\r\n40-CIMObject: root%2Fcimv2\r\nContent-Length: " +
                         std::to_string(message.size()) + "\r\n\r\n" + message);
    EXPECT_THAT(answer, AllOf(StartsWith("HTTP/1.1 200"), HasSubstr("\r\n73-CIMOperation: MethodResponse\r\n"),
                              testing::ContainsRegex("\r\nExt: +\r\n")));
}

TEST_F(ServerTest, BlanksBehindAHeadersValueAreNoneOfIt) {
    start();
    Client client(path);
    for (const std::string header : {"CIMOperation: MethodCall", "CIMMethod: EnumerateInstanceNames",
                                     "CIMObject: root%2Fcimv2", "Content-Type: application/xml", "Host: x"}) {
        std::string blanks = request();
        blanks.insert(blanks.find(header) + header.size(), " \t");
        EXPECT_THAT(client.ask(blanks), HasSubstr("INSTANCENAME")) << header;
    }
}

TEST_F(ServerTest, AProviderThatHangsHoldsItsOwnRequestOnly) {
    Limits limits;
    limits.workers = 1;
    limits.answer = std::chrono::milliseconds(300);
    start(limits);
    Client stuck(path);
    testing::internal::CaptureStderr();
    EXPECT_THAT(stuck.ask(request("VESKA_TimeService")), StartsWith("HTTP/1.1 503"));
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME"));
    EXPECT_THAT(testing::internal::GetCapturedStderr(), HasSubstr("EnumInstanceNames of VESKA_TimeService"));
}

TEST_F(ServerTest, WhatWasGivenUpInTheQueueIsNotCarriedOut) {
    Limits limits;
    limits.workers = 1;
    limits.answer = std::chrono::milliseconds(100);
    start(limits);
    testing::internal::CaptureStderr();
    for (int i = 0; i < 4; ++i) {
        EXPECT_THAT(Client(path).ask(request("VESKA_TimeService")), StartsWith("HTTP/1.1 503"));
    }
    waitForHanging(4); // all threads that there may be
    EXPECT_THAT(Client(path).ask(request()), StartsWith("HTTP/1.1 503"));
    release();
    while (Client(path).ask(request()).find("INSTANCENAME") == std::string::npos) std::this_thread::yield();
    stopped = true;
    running.join();
    EXPECT_TRUE(server->shutDown());
    EXPECT_EQ(asked, 5);
    // Who asked for what is said of those that hang, too.
    EXPECT_THAT(testing::internal::GetCapturedStderr(),
                AllOf(HasSubstr(" EnumerateInstanceNames root/cimv2 VESKA_TimeService http=503"),
                      testing::Not(HasSubstr(" - EnumerateInstanceNames"))));
}

TEST_F(ServerTest, AnOperationThatRunsMayEndWhileTheServerStops) {
    Limits limits;
    limits.endingOfHanging = std::chrono::milliseconds(200);
    start(limits);
    Client client(path);
    client.send(request("VESKA_TimeService"));
    waitForHanging(1);
    stopped = true;
    running.join();
    bool clean = false;
    std::thread stopping([&] { clean = server->shutDown(); });
    std::this_thread::sleep_for(3 * limits.endingOfHanging);
    release();
    stopping.join();
    EXPECT_TRUE(clean);
    EXPECT_THAT(client.receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, WhoAskedIsSaidOfAHeadThatIsRefused) {
    start();
    testing::internal::CaptureStderr();
    Client client(path);
    EXPECT_THAT(client.ask(request()), HasSubstr("INSTANCENAME"));
    EXPECT_THAT(client.ask("GET /cimom HTTP/1.1\r\nHost: x\r\n\r\n"), StartsWith("HTTP/1.1 405"));
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME")); // by the thread that wrote the line before
    EXPECT_THAT(testing::internal::GetCapturedStderr(), HasSubstr(rightsOf(getuid()).user + " - - - http=405"));
}

TEST_F(ServerTest, AFullQueueIsSaid) {
    Limits limits;
    limits.workers = 1;
    limits.queue = 1;
    start(limits);
    Client first(path);
    first.send(request("VESKA_TimeService"));
    waitForHanging(1);
    Client second(path);
    Client third(path);
    second.send(request());
    third.send(request());
    // Whichever of the two comes later finds the queue full.
    Client& refused = waitForEither(second, third);
    EXPECT_THAT(refused.receive(), StartsWith("HTTP/1.1 503"));
    release();
    EXPECT_THAT(first.receive(), HasSubstr("INSTANCENAME"));
    EXPECT_THAT((&refused == &second ? third : second).receive(), HasSubstr("INSTANCENAME"));
}

TEST_F(ServerTest, AClientThatDoesNotTakeItsAnswerIsCutOff) {
    Limits limits;
    limits.taking = std::chrono::milliseconds(300);
    results = 20000; // more than the socket holds
    testing::internal::CaptureStderr();
    start(limits);
    Client slow(path);
    slow.send(request());
    slow.waitForEnd(); // and reads nothing until then
    results = 1;
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME")); // by the thread that wrote the line before
    EXPECT_THAT(testing::internal::GetCapturedStderr(),
                AllOf(HasSubstr("http=200 cim=0"), HasSubstr("the client did not take the answer")));
}

TEST_F(ServerTest, WhatWasWrongIsSaidBesideThatTheClientIsGone) {
    Limits limits;
    limits.answer = std::chrono::milliseconds(100);
    testing::internal::CaptureStderr();
    start(limits);
    {
        Client gone(path);
        gone.send(request("VESKA_TimeService"));
        waitForHanging(1);
    }
    EXPECT_THAT(Client(path).ask(request("VESKA_TimeService")), StartsWith("HTTP/1.1 503")); // not before the other
    EXPECT_THAT(Client(path).ask(request()), HasSubstr("INSTANCENAME")); // by the thread that wrote the lines before
    EXPECT_THAT(testing::internal::GetCapturedStderr(),
                HasSubstr(": no answer in time; the client did not take the answer\n"));
}

TEST_F(ServerTest, LargeAnswersComeWhole) {
    results = 20000;
    start();
    const std::string answer = Client(path).ask(request());
    EXPECT_GT(answer.size(), std::size_t{1} << 20U);
    EXPECT_THAT(answer.substr(answer.size() - 6), "</CIM>");
}

TEST(ServerOverTcp, TakesACertificateForHttps) {
    Operations operations({}, "host1");
    Server server(operations, {});
    const Listener listener = listenAt(ListenUrl("https://127.0.0.1:0"));
    EXPECT_THROW(server.serve(listener), std::invalid_argument);
}

TEST(ServerOverTcp, SaysThatAMethodIsWrongWhoeverAsks) {
    Operations operations({}, "host1");
    Server server(operations, {});
    const Listener listener = listenAt(ListenUrl("http://127.0.0.1:0"));
    server.serve(listener);
    Client client(std::stoi(listener.url.substr(listener.url.rfind(':') + 1)), 1);
    EXPECT_THAT(client.ask("GET /cimom HTTP/1.1\r\nHost: x\r\n\r\n"), StartsWith("HTTP/1.1 405"));
}

TEST(ServerOverTcp, WantsAUser) {
    Operations operations({}, "host1");
    Server server(operations, {});
    const Listener listener = listenAt(ListenUrl("http://127.0.0.1:0"));
    server.serve(listener);
    EXPECT_THAT(listener.url, StartsWith("http://127.0.0.1:"));
    std::atomic<bool> stopped{false};
    std::thread running([&] { server.run(stopped, std::chrono::seconds(0)); });
    const std::string command = "curl -s -o /dev/null -w '%{http_code} %header{www-authenticate}' -d x " + listener.url;
    FILE* pipe = popen(command.c_str(), "r"); // NOLINT(cert-env33-c)
    char text[100] = "";
    if (pipe != nullptr && std::fgets(text, sizeof text, pipe) == nullptr) text[0] = '\0';
    if (pipe != nullptr) pclose(pipe);
    stopped = true;
    running.join();
    EXPECT_STREQ(text, "401 Basic realm=\"vkcimd\"");
}

} // namespace
} // namespace endpoint
