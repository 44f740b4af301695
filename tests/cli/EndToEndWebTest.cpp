#include "tests/cli/EndToEndWeb.h"

#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/Shell.h"

#include <csignal>
#include <fstream>
#include <sstream>
#include <sys/stat.h>
#include <unistd.h>

// The live page of the real program.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::getRequest;
using doubles::HttpClient;
using doubles::PallaxProcess;

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
    endsQuietly(web);
}

TEST_F(EndToEndWeb, ServesThePageOfAStore) {
    const std::string store = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1",
                   PALLAX_SOURCE_DIR "/samples/lte-drive.pcap"})
                  .status,
              0);
    PallaxProcess web(world, {"web", "--store", store, "--device", "car1"});
    enter(web);
    const std::string page = get("/");
    EXPECT_NE(page.find("<!doctype html>"), std::string::npos);
    const std::string made = run({"report", "--store", store, "-o", "-"}).out;
    EXPECT_TRUE(page.ends_with(made)) << "that of the report";
    EXPECT_NE(get("/api/figures").find("404"), std::string::npos);
    EXPECT_EQ(statusOf(getRequest("/", host)), "403") << "only with the link";
    endsQuietly(web);
}

TEST_F(EndToEndWeb, MasksIdentitiesUnlessToldOtherwise) {
    using std::chrono::milliseconds;
    const std::string path = record("sim.pcap", {{milliseconds(0), registration(1)},
                                                 {milliseconds(500), simFiles()},
                                                 {milliseconds(3000), registration(2)}});
    for (const bool withIdentities : {false, true}) {
        std::vector<std::string> arguments{"web", path, "--speed", "max"};
        if (withIdentities) {
            arguments.emplace_back("--with-identities");
        }
        PallaxProcess web(world, arguments);
        enter(web);
        const std::string shown = withIdentities ? kIccid : "left out";
        EXPECT_TRUE(eventually([&] {
            return get("/api/state?at=4000000000").find("\"EF-ICCID\":\"" + shown + '"') !=
                   std::string::npos;
        })) << get("/api/state?at=4000000000");
        endsQuietly(web);
    }
}

TEST_F(EndToEndWeb, StrangersGetNothing) {
    PallaxProcess web(world, {"web", "demo", "gsm"});
    enter(web);
    EXPECT_EQ(statusOf(getRequest("/api/figures", host, cookie)), "200");
    EXPECT_EQ(statusOf(getRequest("/api/figures", host)), "403");
    EXPECT_EQ(statusOf(getRequest("/?token=0123456789abcdef0123456789abcdef", host)), "403");
    EXPECT_EQ(statusOf(getRequest("/api/figures", "evil.example:" + std::to_string(port), cookie)),
              "421");
    EXPECT_EQ(statusOf(getRequest("/api/figures", host, cookie + "Host: " + host + "\r\n")), "400");
    EXPECT_EQ(
        statusOf(getRequest("/api/figures", host, cookie + "Origin: http://evil.example\r\n")),
        "403");
    EXPECT_EQ(statusOf("POST / HTTP/1.1\r\nHost: " + host + "\r\nContent-Length: 9\r\n\r\n"),
              "405");
    EXPECT_EQ(statusOf(getRequest("/", host, "X: " + std::string(20'000, 'x') + "\r\n")), "431");
    EXPECT_EQ(statusOf(getRequest("/metrics", host, cookie)), "404") << "not asked for";
    web.signal(SIGTERM);
    EXPECT_EQ(web.wait(), 0) << web.err();
}

TEST_F(EndToEndWeb, ARequestThatDripsIsCutOffAndNobodyWaitsForIt) {
    PallaxProcess web(world, {"web", "demo", "gsm"});
    enter(web);
    HttpClient slow(port);
    const auto begin = std::chrono::steady_clock::now();
    slow.send("GET / HTTP/1.1\r\nHost: " + host + "\r\nX: ");
    EXPECT_EQ(statusOf(getRequest("/api/figures", host, cookie)), "200");
    const auto taken = [begin] { return std::chrono::steady_clock::now() - begin; };
    while (!slow.isClosedWithin(std::chrono::milliseconds(100)) &&
           taken() < std::chrono::seconds(20)) {
        slow.send("x");
    }
    EXPECT_GT(taken(), std::chrono::milliseconds(4500));
    EXPECT_LT(taken(), std::chrono::seconds(8));
    endsQuietly(web);
}

/// "0100007F:1F90" of each listening TCP socket that the process can see and that has this port.
std::vector<std::string> listeningOn(std::uint16_t port) {
    std::ostringstream digits;
    digits << ':' << std::uppercase << std::hex << port;
    std::vector<std::string> found;
    for (const char* table : {"/proc/net/tcp", "/proc/net/tcp6"}) {
        std::ifstream file(table);
        for (std::string line; std::getline(file, line);) {
            std::istringstream words(line);
            std::string number;
            std::string own;
            std::string other;
            std::string state;
            words >> number >> own >> other >> state;
            if (own.ends_with(digits.str()) && state == "0A") {
                found.push_back(own.substr(0, own.find(':')));
            }
        }
    }
    return found;
}

TEST_F(EndToEndWeb, ListensOnThisMachineAlone) {
    PallaxProcess web(world, {"web", "demo", "gsm"});
    enter(web);
    EXPECT_EQ(listeningOn(port), (std::vector<std::string>{"0100007F"}));
    endsQuietly(web);
}

TEST_F(EndToEndWeb, ListensForOthersOnlyIfToldToAndSaysWhatThatMeans) {
    PallaxProcess web(world, {"web", "demo", "gsm", "--listen", "0.0.0.0"});
    EXPECT_NE(linkOf(web), "");
    EXPECT_TRUE(web.out().starts_with("http://localhost:")) << web.out();
    EXPECT_EQ(listeningOn(port), (std::vector<std::string>{"00000000"}));
    endsQuietly(web, "pallax: Others on the network can read along: the connection is not "
                     "encrypted (see --certificate and --key).\n");
    PallaxProcess loopback(world, {"web", "demo", "gsm", "--listen", "127.0.0.2"});
    EXPECT_NE(linkOf(loopback), "");
    endsQuietly(loopback);
}

TEST_F(EndToEndWeb, IsEncryptedWithACertificate) {
    if (!doubles::isInstalled("openssl")) {
        GTEST_SKIP() << "openssl is not installed";
    }
    const std::string key = world.path("key.pem");
    const std::string certificate = world.path("certificate.pem");
    const auto made = doubles::runCommand(
        "openssl req -x509 -newkey rsa:2048 -nodes -days 2 -subj /CN=127.0.0.1 -addext "
        "subjectAltName=IP:127.0.0.1 -keyout " +
        key + " -out " + certificate);
    ASSERT_EQ(made.status, 0) << made.out;
    PallaxProcess web(world, {"web", "demo", "gsm", "--listen", "0.0.0.0", "--certificate",
                              certificate, "--key", key});
    const std::string path = linkOf(web);
    EXPECT_TRUE(web.out().starts_with("https://")) << web.out();
    std::ofstream(world.path("request")) << getRequest(path, host);
    const auto said = doubles::runCommand("openssl s_client -quiet -verify_return_error -CAfile " +
                                          certificate + " -verify_ip 127.0.0.1 -connect " + host +
                                          " 2>/dev/null <" + world.path("request"));
    EXPECT_TRUE(said.out.starts_with("HTTP/1.1 303 ")) << said.out;
    EXPECT_NE(said.out.find("; HttpOnly; SameSite=Strict; Secure\r\n"), std::string::npos)
        << said.out;
    EXPECT_EQ(answer(getRequest(path, host)).find("Set-Cookie"), std::string::npos)
        << "without encryption there is nothing";
    endsQuietly(web);
}

TEST_F(EndToEndWeb, OpensTheBrowserWithALinkThatWorksOnce) {
    const std::string opener = world.path("xdg-open");
    const std::string opened = world.path("opened");
    std::ofstream(opener) << "#!/bin/sh\nprintf '%s' \"$1\" >" << opened << ".new\nmv " << opened
                          << ".new " << opened << "\n";
    ASSERT_EQ(::chmod(opener.c_str(), S_IRWXU), 0);
    world.environment.push_back("PATH=" + world.path() + ":/usr/bin:/bin");
    PallaxProcess web(world, {"web", "demo", "gsm", "--open"});
    enter(web);
    ASSERT_TRUE(eventually([&] { return ::access(opened.c_str(), F_OK) == 0; }));
    const std::string link = doubles::contentOf(opened);
    ASSERT_TRUE(link.starts_with("http://" + host + "/?token=")) << link;
    const std::string path = link.substr(link.find("/?"));
    EXPECT_EQ(web.out().find(path), std::string::npos) << "it is not the printed one";
    EXPECT_EQ(statusOf(getRequest(path, host)), "303");
    EXPECT_EQ(statusOf(getRequest(path, host)), "403");
    endsQuietly(web);
}

TEST_F(EndToEndWeb, WithoutAnOpenerItSaysSoAndServes) {
    world.environment.push_back("PATH=" + world.path());
    PallaxProcess web(world, {"web", "demo", "gsm", "--open"});
    enter(web);
    endsQuietly(web, "pallax: xdg-open cannot be started: No such file or directory. Open the link "
                     "yourself.\n");
}

/// The processor time that a process has used, in clock ticks.
long usedTime(pid_t process) {
    std::string text = doubles::contentOf("/proc/" + std::to_string(process) + "/stat");
    std::istringstream words(text.substr(text.rfind(')') + 2));
    std::string skipped;
    constexpr int kBefore = 11;
    for (int count = 0; count < kBefore; ++count) {
        words >> skipped;
    }
    long user = 0;
    long system = 0;
    words >> user >> system;
    return user + system;
}

TEST_F(EndToEndWeb, ManyViewersCostOneDecode) {
    const std::string path = world.path("drive.pcap");
    ASSERT_EQ(run({"simulate", "lte", "--seconds", "1800", "-o", path}).status, 0);
    std::vector<long> used;
    for (const int count : {1, 50}) {
        PallaxProcess web(world, {"web", path, "--speed", "max"});
        enter(web);
        std::vector<std::unique_ptr<HttpClient>> viewers;
        for (int each = 0; each < count; ++each) {
            viewers.push_back(std::make_unique<HttpClient>(port));
            viewers.back()->send(getRequest("/api/events", host, cookie));
        }
        for (const auto& viewer : viewers) {
            const std::string end = "data: {\"text\":\"End of the recording\"}\n\n";
            EXPECT_NE(viewer->receive(end).find(end), std::string::npos);
        }
        used.push_back(usedTime(web.id()));
        endsQuietly(web);
    }
    RecordProperty("one", std::to_string(used[0]));
    RecordProperty("fifty", std::to_string(used[1]));
    EXPECT_LT(used[1], 4 * used[0]) << "clock ticks; 50 decodes would be 50 times as many";
}

} // namespace
} // namespace pallax
