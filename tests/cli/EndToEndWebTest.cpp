#include "tests/cli/EndToEnd.h"
#include "tests/doubles/HttpClient.h"
#include "tests/doubles/PropertyListRecord.h"

#include <csignal>
#include <optional>

// The live page of the real program.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::getRequest;
using doubles::HttpClient;
using doubles::PallaxProcess;

class EndToEndWeb : public EndToEnd {
protected:
    static constexpr const char* kIccid = "8949020000012345670";

    /// Waits for the link, and enters.
    void enter(const PallaxProcess& web) {
        ASSERT_TRUE(web.says("/?token=")) << web.err();
        const std::string link = web.out();
        ASSERT_TRUE(link.starts_with("http://127.0.0.1:")) << link;
        port = static_cast<std::uint16_t>(std::stoi(link.substr(link.rfind(':') + 1)));
        host = "127.0.0.1:" + std::to_string(port);
        const std::string path = link.substr(link.find("/?"), link.find('\n') - link.find("/?"));
        const std::string entered = answer(getRequest(path, host));
        ASSERT_TRUE(entered.starts_with("HTTP/1.1 303 ")) << entered;
        const auto begin = entered.find("Set-Cookie: ") + 12;
        cookie = "Cookie: " + entered.substr(begin, entered.find(';', begin) - begin) + "\r\n";
    }
    std::string answer(const std::string& request) const {
        HttpClient client(port);
        client.send(request);
        return client.receive();
    }
    std::string get(const std::string& path) const {
        return answer(getRequest(path, host, cookie));
    }
    static std::string contentOf(const std::string& response) {
        return response.substr(response.find("\r\n\r\n") + 4);
    }

    std::uint16_t port = 0;
    std::string host;
    std::string cookie;
};

TEST_F(EndToEndWeb, TheStateAtTheEndIsThatOfDecode) {
    const std::string path = gsmAttach();
    PallaxProcess web(world, {"web", path, "--speed", "max", "--with-identities"});
    enter(web);
    std::string decoded = run({"decode", path}).out;
    decoded.pop_back(); // the line end
    EXPECT_TRUE(eventually([&] {
        return get("/api/state?at=4000000000").find("\"display\":" + decoded + "}") !=
               std::string::npos;
    })) << get("/api/state?at=4000000000");
    EXPECT_NE(get("/").find("<!doctype html>"), std::string::npos);
    web.signal(SIGINT);
    EXPECT_EQ(web.wait(), 0) << web.err();
    EXPECT_EQ(web.err(), "");
    EXPECT_TRUE(doubles::noChildLeft());
}

TEST_F(EndToEndWeb, MasksIdentitiesUnlessToldOtherwise) {
    using std::chrono::milliseconds;
    const std::string path =
        record("sim.pcap",
               {{milliseconds(0), registration(1)},
                {milliseconds(500),
                 doubles::textRecord(kSimFiles, std::string("{kSimFile_ICCID = ") + kIccid + ";}")
                     .prefixed()},
                {milliseconds(3000), registration(2)}});
    for (const bool withIdentities : {false, true}) {
        std::vector<std::string> arguments{"web", path, "--speed", "max"};
        if (withIdentities) {
            arguments.emplace_back("--with-identities");
        }
        PallaxProcess web(world, arguments);
        enter(web);
        const std::string shown = withIdentities ? kIccid : std::string(19, '0');
        EXPECT_TRUE(eventually([&] {
            return get("/api/state?at=4000000000").find("\"EF-ICCID\":\"" + shown + '"') !=
                   std::string::npos;
        })) << get("/api/state?at=4000000000");
        web.signal(SIGINT);
        EXPECT_EQ(web.wait(), 0) << web.err();
    }
}

TEST_F(EndToEndWeb, StrangersGetNothing) {
    PallaxProcess web(world, {"web", "demo", "gsm"});
    enter(web);
    const auto status = [this](const std::string& request) { return answer(request).substr(9, 3); };
    EXPECT_EQ(status(getRequest("/api/figures", host, cookie)), "200");
    EXPECT_EQ(status(getRequest("/api/figures", host)), "403");
    EXPECT_EQ(status(getRequest("/?token=0123456789abcdef0123456789abcdef", host)), "403");
    EXPECT_EQ(status(getRequest("/api/figures", "evil.example:" + std::to_string(port), cookie)),
              "421");
    EXPECT_EQ(status(getRequest("/api/figures", host, cookie + "Host: " + host + "\r\n")), "400");
    EXPECT_EQ(status(getRequest("/api/figures", host, cookie + "Origin: http://evil.example\r\n")),
              "403");
    EXPECT_EQ(status("POST / HTTP/1.1\r\nHost: " + host + "\r\nContent-Length: 9\r\n\r\n"), "405");
    EXPECT_EQ(status(getRequest("/metrics", host, cookie)), "404") << "not asked for";
    web.signal(SIGTERM);
    EXPECT_EQ(web.wait(), 0) << web.err();
}

} // namespace
} // namespace pallax
