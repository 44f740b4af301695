#include "web/RequestGate.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

const std::string kLink = "0123456789abcdef0123456789abcdef";
const std::string kSession = "fedcba9876543210fedcba9876543210";
const std::string kCookie = "pallax-8080=" + kSession;

using Decision = RequestGate::Decision;

class RequestGateTest : public testing::Test {
protected:
    static RequestGate gate(const std::string& address = "127.0.0.1", std::uint16_t port = 8080,
                            bool isEncrypted = false, bool hasMetrics = false) {
        return RequestGate({address, port, isEncrypted, AccessToken(kLink), std::nullopt,
                            AccessToken(kSession), hasMetrics});
    }
    static WebRequest request(const std::string& path = "/api/figures") {
        return {.method = "GET",
                .path = path,
                .headers = {{"Host", "127.0.0.1:8080"}, {"Cookie", kCookie}},
                .isFromThisMachine = true};
    }
    /// 0 if it is served.
    static unsigned statusOf(RequestGate gate, const WebRequest& request) {
        const RequestGate::Verdict verdict = gate.decide(request);
        return verdict.decision == Decision::Serve ? 0U : verdict.response.status;
    }
    static unsigned statusWithHost(const RequestGate& gate, const std::string& host) {
        WebRequest with = request();
        with.headers[0].second = host;
        with.headers[1].second =
            "pallax-80=" + kSession + "; pallax-443=" + kSession + "; " + kCookie;
        return statusOf(gate, with);
    }
};

TEST_F(RequestGateTest, ServesAClientWithTheCookie) {
    EXPECT_EQ(statusOf(gate(), request()), 0U);
    EXPECT_EQ(statusOf(gate(), request("/")), 0U);
}

TEST_F(RequestGateTest, AnswersOnlyGet) {
    for (const char* method : {"POST", "HEAD", "PUT", "DELETE", "OPTIONS", "TRACE", "get", ""}) {
        WebRequest other = request();
        other.method = method;
        const auto verdict = gate().decide(other);
        EXPECT_EQ(verdict.response.status, 405U) << method;
        EXPECT_EQ(verdict.response.headers, (WebRequest::Fields{{"Allow", "GET"}})) << method;
    }
}

TEST_F(RequestGateTest, TheHostIsThisOne) {
    for (const char* host : {"127.0.0.1:8080", "localhost:8080"}) {
        EXPECT_EQ(statusWithHost(gate(), host), 0U) << host;
    }
    for (const char* host :
         {"", "127.0.0.1", "localhost", "127.0.0.1:80", "127.0.0.1:8080 ", "127.0.0.1:80800",
          "evil.example", "evil.example:8080", "localhost.evil.example:8080",
          "127.0.0.1.evil.example:8080", "127.0.0.1:8080@evil.example", "192.168.1.5:8080",
          "[::1]:8080", "0.0.0.0:8080", ":8080"}) {
        EXPECT_EQ(statusWithHost(gate(), host), 421U) << host;
    }
}

TEST_F(RequestGateTest, TheUsualPortNeedsNoMention) {
    EXPECT_EQ(statusWithHost(gate("127.0.0.1", 80), "localhost"), 0U);
    EXPECT_EQ(statusWithHost(gate("127.0.0.1", 80), "localhost:80"), 0U);
    EXPECT_EQ(statusWithHost(gate("127.0.0.1", 443, true), "localhost"), 0U);
    EXPECT_EQ(statusWithHost(gate("127.0.0.1", 443), "localhost"), 421U);
}

TEST_F(RequestGateTest, AnAddressThatIsListenedOnIsAHostToo) {
    EXPECT_EQ(statusWithHost(gate("192.168.1.5"), "192.168.1.5:8080"), 0U);
    EXPECT_EQ(statusWithHost(gate("192.168.1.5"), "192.168.1.6:8080"), 421U);
    EXPECT_EQ(statusWithHost(gate("::1"), "[::1]:8080"), 0U);
}

TEST_F(RequestGateTest, OnAllAddressesANameIsStillNoHost) {
    for (const char* address : {"0.0.0.0", "::"}) {
        EXPECT_EQ(statusWithHost(gate(address), "192.168.1.6:8080"), 0U) << address;
        EXPECT_EQ(statusWithHost(gate(address), "[fe80::1]:8080"), 0U) << address;
        EXPECT_EQ(statusWithHost(gate(address), "evil.example:8080"), 421U) << address;
        EXPECT_EQ(statusWithHost(gate(address), ":8080"), 421U) << address;
    }
}

TEST_F(RequestGateTest, NoneOrTwoHostsAreRefused) {
    WebRequest two = request();
    two.headers.emplace_back("hoST", "127.0.0.1:8080");
    EXPECT_EQ(statusOf(gate(), two), 400U);
    WebRequest none = request();
    none.headers.erase(none.headers.begin());
    EXPECT_EQ(statusOf(gate(), none), 400U);
}

TEST_F(RequestGateTest, APageOfAnotherOriginIsRefused) {
    const auto status = [](const std::string& origin) {
        WebRequest from = request();
        from.headers.emplace_back("Origin", origin);
        return statusOf(gate(), from);
    };
    EXPECT_EQ(status("http://127.0.0.1:8080"), 0U);
    EXPECT_EQ(status("http://localhost:8080"), 0U);
    for (const char* origin :
         {"null", "", "http://evil.example", "https://127.0.0.1:8080", "http://127.0.0.1:8081",
          "http://127.0.0.1", "file://", "http://127.0.0.1:8080.evil.example"}) {
        EXPECT_EQ(status(origin), 403U) << origin;
    }
    WebRequest two = request();
    two.headers.emplace_back("Origin", "http://127.0.0.1:8080");
    two.headers.emplace_back("Origin", "http://127.0.0.1:8080");
    EXPECT_EQ(statusOf(gate(), two), 400U);
}

TEST_F(RequestGateTest, WithoutTheCookieNothingIsServed) {
    for (const std::string& cookie : std::vector<std::string>{
             "", "pallax-8080=", "pallax-8080=" + kLink, "pallax-8081=" + kSession,
             "pallax-8080=" + kSession + "0", "xpallax-8080=" + kSession}) {
        for (const char* path : {"/", "/api/figures", "/metrics", "/no-such-page"}) {
            WebRequest without = request(path);
            without.headers[1].second = cookie;
            EXPECT_EQ(statusOf(gate(), without), 403U) << cookie << " " << path;
        }
    }
    WebRequest two = request();
    two.headers.emplace_back("Cookie", kCookie);
    EXPECT_EQ(statusOf(gate(), two), 400U);
}

TEST_F(RequestGateTest, TheLinkGivesTheCookieAndLeavesTheAddressBar) {
    WebRequest first{.method = "GET",
                     .path = "/",
                     .headers = {{"Host", "127.0.0.1:8080"}},
                     .query = {{"token", kLink}}};
    const auto verdict = gate().decide(first);
    EXPECT_EQ(verdict.decision, Decision::Enter);
    EXPECT_EQ(verdict.response.status, 303U);
    EXPECT_EQ(
        verdict.response.headers,
        (WebRequest::Fields{{"Location", "/"},
                            {"Set-Cookie", kCookie + "; Path=/; HttpOnly; SameSite=Strict"}}));
    EXPECT_EQ(gate("127.0.0.1", 8080, true).decide(first).response.headers[1].second,
              kCookie + "; Path=/; HttpOnly; SameSite=Strict; Secure");
    first.path = "/api/figures";
    EXPECT_EQ(statusOf(gate(), first), 403U) << "only the page is entered";
    first.path = "/";
    for (const std::string& wrong : {std::string(), kSession, kLink.substr(1), kLink + "0"}) {
        first.query[0].second = wrong;
        EXPECT_EQ(statusOf(gate(), first), 403U) << wrong;
    }
}

TEST_F(RequestGateTest, ALinkForOnceOpensOnce) {
    RequestGate once({.address = "127.0.0.1",
                      .port = 8080,
                      .link = AccessToken(kLink),
                      .once = AccessToken(std::string(32, '5')),
                      .session = AccessToken(kSession)});
    EXPECT_EQ(once.linkForOnce(), "http://127.0.0.1:8080/?token=" + std::string(32, '5'));
    const auto status = [&once](const std::string& token) {
        return once
            .decide({.method = "GET",
                     .path = "/",
                     .headers = {{"Host", "127.0.0.1:8080"}},
                     .query = {{"token", token}}})
            .response.status;
    };
    EXPECT_EQ(status(std::string(32, '5')), 303U);
    EXPECT_EQ(status(std::string(32, '5')), 403U);
    EXPECT_EQ(status(kLink), 303U);
    EXPECT_EQ(status(kLink), 303U);
}

TEST_F(RequestGateTest, ARequestHasNoContent) {
    for (const auto& [name, value] : WebRequest::Fields{
             {"Content-Length", "1"}, {"content-length", "00"}, {"Transfer-Encoding", "chunked"}}) {
        WebRequest with = request();
        with.headers.emplace_back(name, value);
        EXPECT_EQ(statusOf(gate(), with), 400U) << name;
    }
}

TEST_F(RequestGateTest, MetricsNeedNoTokenButThisMachine) {
    WebRequest scrape = request("/metrics");
    scrape.headers.pop_back();
    EXPECT_EQ(statusOf(gate("127.0.0.1", 8080, false, true), scrape), 0U);
    EXPECT_EQ(statusOf(gate(), scrape), 403U) << "not asked for";
    scrape.isFromThisMachine = false;
    EXPECT_EQ(statusOf(gate("0.0.0.0", 8080, false, true), scrape), 403U);
    scrape.isFromThisMachine = true;
    scrape.headers[0].second = "evil.example:8080";
    EXPECT_EQ(statusOf(gate("127.0.0.1", 8080, false, true), scrape), 421U);
}

TEST_F(RequestGateTest, PrintsTheLinkOfThePage) {
    EXPECT_EQ(gate().link(), "http://127.0.0.1:8080/?token=" + kLink);
    EXPECT_EQ(gate("::1", 9, true).link(), "https://[::1]:9/?token=" + kLink);
    EXPECT_EQ(gate("0.0.0.0").link(), "http://localhost:8080/?token=" + kLink);
}

} // namespace
} // namespace pallax
