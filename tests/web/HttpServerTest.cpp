#include "web/HttpServer.h"

#include "host/AsioMainQueue.h"
#include "tests/doubles/HttpClient.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::getRequest;
using doubles::HttpClient;

class HttpServerTest : public testing::Test {
protected:
    void start(const HttpServer::Limits& limits = {}) {
        auto listener = Listener::at("127.0.0.1", 0);
        ASSERT_TRUE(listener) << listener.error().sentence;
        port = listener->port;
        auto started = HttpServer::start({.queue = queue,
                                          .listener = std::move(listener).value(),
                                          .answer =
                                              [this](const auto& request) {
                                                  requests.push_back(request);
                                                  return answer;
                                              },
                                          .limits = limits});
        ASSERT_TRUE(started) << started.error().sentence;
        server = std::move(started).value();
    }
    HttpClient client() {
        return HttpClient(port, [this] { (void)queue.runReady(); });
    }
    HttpClient stream(const std::string& beginning = "data: 1\n\n") {
        answer = {.type = "text/event-stream",
                  .content = std::make_shared<const std::string>(beginning),
                  .isStream = true};
        HttpClient made = client();
        made.send(getRequest("/api/events", "here"));
        return made;
    }
    void publish(const std::string& text) {
        server->publish(std::make_shared<const std::string>(text));
    }

    AsioMainQueue queue;
    std::uint16_t port = 0;
    WebResponse answer = textResponse(200, "All is well.");
    std::vector<WebRequest> requests;
    std::unique_ptr<HttpServer> server;
};

TEST_F(HttpServerTest, GivesARequestAndSendsItsAnswer) {
    start();
    HttpClient browser = client();
    browser.send(getRequest("/a%20b?x=1%262&y=&z", "here", "Cookie: c=1\r\nHost: there\r\n"));
    const std::string response = browser.receive();
    EXPECT_TRUE(response.starts_with("HTTP/1.1 200 OK\r\n")) << response;
    EXPECT_TRUE(response.ends_with("\r\n\r\nAll is well.\n")) << response;
    for (const char* header :
         {"\r\nConnection: close\r\n", "\r\nContent-Length: 13\r\n",
          "\r\nContent-Type: text/plain; charset=utf-8\r\n", "\r\nCache-Control: no-store\r\n",
          "\r\nX-Content-Type-Options: nosniff\r\n", "\r\nReferrer-Policy: no-referrer\r\n",
          "\r\nContent-Security-Policy: default-src 'none'; frame-ancestors 'none'\r\n"}) {
        EXPECT_NE(response.find(header), std::string::npos) << header << response;
    }
    EXPECT_EQ(response.find("Access-Control"), std::string::npos) << response;
    ASSERT_EQ(requests.size(), 1U);
    const WebRequest& request = requests.front();
    EXPECT_EQ(request.method, "GET");
    EXPECT_EQ(request.path, "/a b");
    EXPECT_EQ(request.query, (WebRequest::Fields{{"x", "1&2"}, {"y", ""}, {"z", ""}}));
    EXPECT_EQ(request.countOfHeader("Host"), 2U) << "no Host is lost";
    EXPECT_EQ(request.cookie("c"), "1");
    EXPECT_TRUE(request.isFromThisMachine);
    EXPECT_TRUE(browser.isClosedWithin(1s)) << "a connection carries one request";
}

TEST_F(HttpServerTest, LongHeadersAreRefused) {
    start();
    HttpClient browser = client();
    browser.send(getRequest("/", "here", "X: " + std::string(20000, 'x') + "\r\n"));
    EXPECT_TRUE(browser.receive().starts_with("HTTP/1.1 431 ")) << browser.receive();
    HttpClient other = client();
    other.send(getRequest("/" + std::string(20000, 'x'), "here"));
    EXPECT_TRUE(other.receive().starts_with("HTTP/1.1 414 ")) << other.receive();
    EXPECT_EQ(requests.size(), 0U);
}

TEST_F(HttpServerTest, ContentIsNotReadBeforeTheAnswer) {
    start();
    answer = textResponse(405, "Only GET is answered.");
    HttpClient browser = client();
    browser.send("POST / HTTP/1.1\r\nHost: here\r\nContent-Length: 10000000\r\n\r\n");
    EXPECT_TRUE(browser.receive().starts_with("HTTP/1.1 405 ")) << browser.receive();
    EXPECT_TRUE(browser.isClosedWithin(1s));
}

TEST_F(HttpServerTest, ARequestThatDripsIsCutOff) {
    start({.request = 600ms});
    HttpClient browser = client();
    const auto begin = std::chrono::steady_clock::now();
    browser.send("GET / HTTP/1.1\r\nHost: here\r\nX: ");
    while (!browser.isClosedWithin(50ms) && std::chrono::steady_clock::now() - begin < 5s) {
        browser.send("x");
    }
    const auto taken = std::chrono::steady_clock::now() - begin;
    EXPECT_GT(taken, 500ms);
    EXPECT_LT(taken, 2s);
    EXPECT_EQ(requests.size(), 0U);
}

TEST_F(HttpServerTest, AResponseThatIsNotTakenIsCutOff) {
    start({.response = 600ms});
    answer.content = std::make_shared<const std::string>(std::string(50'000'000, 'x'));
    HttpClient browser = client();
    browser.send(getRequest("/", "here"));
    for (int count = 0; count < 200; ++count) {
        (void)queue.runReady();
        usleep(10'000);
    }
    EXPECT_LT(browser.receive().size(), 50'000'000U);
    EXPECT_TRUE(browser.isClosedWithin(1s));
}

TEST_F(HttpServerTest, AnEventStreamGoesOnWithWhatIsPublished) {
    start();
    HttpClient first = stream();
    const std::string begun = first.receive("data: 1\n\n");
    EXPECT_TRUE(begun.starts_with("HTTP/1.1 200 ")) << begun;
    EXPECT_NE(begun.find("\r\nContent-Type: text/event-stream\r\n"), std::string::npos) << begun;
    EXPECT_NE(begun.find("data: 1\n\n"), std::string::npos) << begun;
    HttpClient second = stream("data: 2\n\n");
    (void)second.receive("data: 2\n\n");
    EXPECT_EQ(server->streams(), 2U);
    publish("data: 3\n\n");
    EXPECT_NE(first.receive("data: 3\n\n").find("data: 3"), std::string::npos);
    EXPECT_NE(second.receive("data: 3\n\n").find("data: 3"), std::string::npos);
    publish("data: " + std::string(100'000, 'y') + "\n\n");
    EXPECT_NE(first.receive("y\n\n").find("y\n\n"), std::string::npos) << "in several pieces";
}

TEST_F(HttpServerTest, AStreamWithoutEventsBeatsAndOutlivesTheDeadlineOfARequest) {
    start({.request = 300ms, .response = 300ms, .heartbeat = 200ms});
    HttpClient browser = stream();
    EXPECT_FALSE(browser.isClosedWithin(1500ms));
    EXPECT_NE(browser.receive(":\n\n").find(":\n\n"), std::string::npos);
}

TEST_F(HttpServerTest, AClientThatHasLeftIsForgotten) {
    start({.heartbeat = 100ms});
    HttpClient stays = stream();
    {
        HttpClient leaves = stream();
        (void)leaves.receive("data: 1\n\n");
        EXPECT_EQ(server->streams(), 2U);
    }
    const auto end = std::chrono::steady_clock::now() + 5s;
    while (server->streams() > 1 && std::chrono::steady_clock::now() < end) {
        (void)stays.isClosedWithin(20ms);
    }
    EXPECT_EQ(server->streams(), 1U);
}

TEST_F(HttpServerTest, ASlowClientOfAStreamIsCutOffAndNobodyElse) {
    start({.waitingBytes = 200'000});
    HttpClient slow = stream();
    HttpClient quick = stream();
    (void)slow.receive("data: 1\n\n");
    (void)quick.receive("data: 1\n\n");
    const std::string event = "data: " + std::string(50'000, 'z') + "\n\n";
    for (int count = 0; count < 400 && server->streams() == 2; ++count) {
        publish(event + "data: end" + std::to_string(count) + "\n\n");
        (void)quick.receive("data: end" + std::to_string(count) + "\n\n");
    }
    EXPECT_EQ(server->streams(), 1U);
    publish("data: last\n\n");
    EXPECT_NE(quick.receive("data: last\n\n").find("data: last"), std::string::npos);
}

TEST_F(HttpServerTest, AStreamBeginsWithATextOfAnySize) {
    start({.waitingBytes = 1000});
    HttpClient browser = stream("data: " + std::string(5'000'000, 'z') + "\n\n");
    (void)browser.isClosedWithin(100ms); // it is being sent
    publish("data: next\n\n");
    EXPECT_GT(browser.receive("data: next\n\n").size(), 5'000'000U);
    EXPECT_EQ(server->streams(), 1U);
}

TEST_F(HttpServerTest, ClientsThatAskNothingKeepNobodyOut) {
    start({.connections = 8, .spare = 2});
    HttpClient follows = stream();
    (void)follows.receive("data: 1\n\n");
    std::vector<HttpClient> idle;
    for (int count = 0; count < 30; ++count) {
        idle.push_back(client());
        idle.back().send("GET / HTTP/1.1\r\nX: ");
        (void)queue.runReady();
    }
    answer = textResponse(200, "All is well.");
    HttpClient owner = client();
    const auto begin = std::chrono::steady_clock::now();
    owner.send(getRequest("/", "here"));
    EXPECT_TRUE(owner.receive().starts_with("HTTP/1.1 200 "));
    EXPECT_LT(std::chrono::steady_clock::now() - begin, 2s) << "idle ones have five seconds";
    EXPECT_TRUE(idle.front().isClosedWithin(1s)) << "the oldest is cut off";
    EXPECT_EQ(server->streams(), 1U) << "an answered one stays";
}

TEST_F(HttpServerTest, StreamsLeaveConnectionsForOtherRequests) {
    start({.streams = 2});
    HttpClient first = stream();
    HttpClient second = stream();
    (void)first.receive("data: 1\n\n");
    (void)second.receive("data: 1\n\n");
    HttpClient third = stream();
    EXPECT_TRUE(third.receive().starts_with("HTTP/1.1 503 ")) << third.receive();
    EXPECT_EQ(server->streams(), 2U);
}

TEST_F(HttpServerTest, ClientsBeyondTheLimitWaitForThoseThatLeave) {
    start({.connections = 2, .spare = 0, .heartbeat = 100ms});
    auto first = std::make_unique<HttpClient>(stream());
    HttpClient second = stream();
    (void)first->receive("data: 1\n\n");
    (void)second.receive("data: 1\n\n");
    HttpClient third = stream();
    EXPECT_FALSE(third.isClosedWithin(300ms));
    EXPECT_EQ(server->streams(), 2U);
    first.reset();
    EXPECT_NE(third.receive("data: 1\n\n").find("data: 1\n\n"), std::string::npos);
}

TEST_F(HttpServerTest, EndsItsStreams) {
    start();
    HttpClient browser = stream();
    (void)browser.receive("data: 1\n\n");
    server.reset();
    EXPECT_TRUE(browser.isClosedWithin(1s));
}

TEST_F(HttpServerTest, AnExceptionOfAnAnswerLeavesThroughTheQueue) {
    auto listener = Listener::at("127.0.0.1", 0);
    port = listener->port;
    server = HttpServer::start({.queue = queue,
                                .listener = std::move(listener).value(),
                                .answer = [](const auto& /*request*/) -> WebResponse {
                                    throw std::runtime_error("no template");
                                }})
                 .value();
    HttpClient browser = client();
    browser.send(getRequest("/", "here"));
    EXPECT_THROW((void)browser.receive(), std::runtime_error);
}

TEST_F(HttpServerTest, ACertificateThatIsNoneIsOneSentence) {
    auto listener = Listener::at("127.0.0.1", 0);
    const auto refused = HttpServer::start({.queue = queue,
                                            .listener = std::move(listener).value(),
                                            .identity = HttpServer::Identity{"no", "key"},
                                            .answer = [](const auto&) { return WebResponse(); }});
    ASSERT_FALSE(refused);
    EXPECT_EQ(refused.error().sentence, "The certificate and its key cannot be used.");
}

} // namespace
} // namespace pallax
