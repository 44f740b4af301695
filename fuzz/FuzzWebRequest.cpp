// A client of `pallax web` that sends any bytes, through a real socket to a real server with the
// gate and the page behind it. The server must stay alive and answer its owner afterwards, and give
// nothing to a client that has neither the link nor the cookie. The gate believes to be at port
// 8080, and its secrets are known, so that inputs can name them.

#include "fuzz/QueryTimeline.h"
#include "host/AsioMainQueue.h"
#include "knowledge/Networks.h"
#include "web/HttpServer.h"
#include "web/LiveData.h"
#include "web/LivePage.h"
#include "web/RequestGate.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

namespace {

using namespace pallax;

constexpr const char* kLink = "11111111111111111111111111111111";
constexpr const char* kSession = "22222222222222222222222222222222";

[[noreturn]] void fail(const std::string& sentence) {
    constexpr std::size_t kMost = 300; // of a page
    (void)std::fprintf(stderr, "%s\n", sentence.substr(0, kMost).c_str());
    std::abort();
}

class RunningPage {
public:
    RunningPage() {
        _data.begin(&_recorded.timeline());
        (void)_data.follow([] { return true; });
        _data.settle();
        auto listener = Listener::at("127.0.0.1", 0);
        if (!listener) {
            fail(listener.error().sentence);
        }
        _port = listener->port;
        auto server = HttpServer::start(
            {.queue = _queue,
             .listener = std::move(listener).value(),
             .answer = [this](const WebRequest& request) { return answer(request); }});
        if (!server) {
            fail(server.error().sentence);
        }
        _server = std::move(server).value();
    }

    /// Sends the bytes and returns all that the server says until it closes the connection, or has
    /// nothing more to say.
    std::string exchange(std::string_view bytes) {
        const int client = connected();
        while (!bytes.empty()) {
            const ssize_t sent =
                ::send(client, bytes.data(), bytes.size(), MSG_NOSIGNAL | MSG_DONTWAIT);
            _queue.runReady();
            if (sent < 0 && errno != EAGAIN) {
                break; // the server has refused it already
            }
            bytes.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(sent, 0)));
        }
        (void)::shutdown(client, SHUT_WR);
        std::string said;
        constexpr int kQuiet = 4;
        for (int quiet = 0; quiet < kQuiet;) {
            _queue.runReady();
            char buffer[65536];
            const ssize_t got = ::recv(client, buffer, sizeof buffer, MSG_DONTWAIT);
            if (got == 0) {
                break;
            }
            quiet = got > 0 ? 0 : quiet + 1;
            said.append(buffer, static_cast<std::size_t>(std::max<ssize_t>(got, 0)));
        }
        (void)::close(client);
        while (_server->streams() > 0) { // one notices that its client has left when it is sent
            _server->publish(std::make_shared<const std::string>(":\n\n"));
            _queue.runReady();
        }
        return said;
    }

private:
    WebResponse answer(const WebRequest& request) {
        auto verdict = _gate.decide(request);
        return verdict.decision == RequestGate::Decision::Serve ? _page.answer(request)
                                                                : verdict.response;
    }

    int connected() const {
        const int client = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_port = htons(_port);
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        const auto* generic = static_cast<const sockaddr*>(static_cast<const void*>(&address));
        if (client < 0 || ::connect(client, generic, sizeof address) != 0) {
            fail("no connection");
        }
        return client;
    }

    QueryTimeline _recorded;
    NetworkNames _names;
    QualityProfile _profile = *builtInProfile(kDefaultProfile);
    DirectoryResources _resources{DirectoryResources::programFolder()};
    LiveData _data{{_names,
                    _profile,
                    _resources,
                    {.title = "", .recording = "drive", .technology = "", .version = "1"}}};
    RequestGate _gate{{.address = "127.0.0.1",
                       .port = 8080,
                       .link = AccessToken(kLink),
                       .session = AccessToken(kSession),
                       .hasMetrics = false}};
    LivePage _page{{_data, [] { return SessionCounts{}; }}};
    AsioMainQueue _queue;
    std::uint16_t _port = 0;
    std::unique_ptr<HttpServer> _server;
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static RunningPage page;
    const std::string sent(data, data + size);
    const std::string said = page.exchange(sent);
    const bool hasLink = sent.find(kLink) != std::string::npos;
    const bool hasCookie = sent.find(kSession) != std::string::npos;
    if (!said.empty() && !said.starts_with("HTTP/1.")) {
        fail("no answer of HTTP: " + said);
    }
    if (said.find(kSession) != std::string::npos && !hasLink) {
        fail("a stranger has got the cookie: " + said);
    }
    if (said.find(" 200 OK\r\n") != std::string::npos && !hasCookie) {
        fail("a stranger has got something: " + said);
    }
    const std::string owner =
        page.exchange(std::string("GET /api/figures HTTP/1.1\r\nHost: 127.0.0.1:8080\r\nCookie: "
                                  "pallax-8080=") +
                      kSession + "\r\n\r\n");
    if (!owner.starts_with("HTTP/1.1 200 OK\r\n")) {
        fail("its owner gets nothing: " + owner);
    }
    return 0;
}
