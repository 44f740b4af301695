#include "tests/cli/EndToEndWeb.h"
#include "tests/doubles/Shell.h"
#include "web/Listener.h"

#include <fstream>

// What collectors make of the metrics of the real program.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::getRequest;
using doubles::HttpClient;
using doubles::PallaxProcess;

class EndToEndMetrics : public EndToEndWeb {
protected:
    std::string metrics(const std::string& accept = "") const {
        const std::string response = answer(getRequest("/metrics", host, accept));
        EXPECT_TRUE(response.starts_with("HTTP/1.1 200 OK\r\n")) << response;
        return response.substr(response.find("\r\n\r\n") + 4);
    }
};

TEST_F(EndToEndMetrics, AreWellFormedForEachTechnology) {
    if (!doubles::isInstalled("promtool")) {
        GTEST_SKIP() << "promtool (of Debian's prometheus) is not installed";
    }
    for (const char* technology : {"ifx", "gsm", "cdma", "lte", "utran"}) {
        PallaxProcess web(world, {"web", "demo", technology, "--metrics", "--speed", "20"});
        EXPECT_NE(linkOf(web), "");
        EXPECT_TRUE(eventually([this] {
            return metrics().find("\npallax_cell_info{") != std::string::npos;
        })) << technology
            << metrics();
        const std::string file = world.path("metrics");
        std::ofstream(file) << metrics();
        const auto checked = doubles::runCommand("promtool check metrics <" + file);
        EXPECT_EQ(checked.status, 0) << technology;
        EXPECT_EQ(checked.out, "") << technology << doubles::contentOf(file);
        endsQuietly(web);
    }
}

/// A port that was free a moment ago.
std::uint16_t freePort() {
    return Listener::at("127.0.0.1", 0)->port;
}

TEST_F(EndToEndMetrics, ArriveInACollector) {
    if (!doubles::isInstalled("prometheus")) {
        GTEST_SKIP() << "prometheus is not installed";
    }
    PallaxProcess web(world, {"web", "demo", "lte", "--metrics", "--speed", "20"});
    EXPECT_NE(linkOf(web), "");
    std::ofstream(world.path("prometheus.yml"))
        << "scrape_configs:\n  - job_name: phone\n    scrape_interval: 200ms\n"
           "    scrape_timeout: 200ms\n    static_configs:\n      - targets: ['"
        << host << "']\n";
    const std::uint16_t collector = freePort();
    const auto started = doubles::runCommand(
        "cd " + world.path() +
        " && { prometheus --config.file=prometheus.yml --storage.tsdb.path=" + world.path("data") +
        " --web.listen-address=127.0.0.1:" + std::to_string(collector) +
        " >collector.log 2>&1 & echo $! >collector.pid; }");
    ASSERT_EQ(started.status, 0) << started.out;
    const auto asked = [collector](const std::string& query) -> std::string {
        try {
            HttpClient client(collector);
            client.send("GET /api/v1/query?query=" + query +
                        " HTTP/1.1\r\nHost: here\r\nConnection: close\r\n\r\n");
            return client.receive();
        } catch (const std::system_error& /*not yet there*/) {
            return "";
        }
    };
    EXPECT_TRUE(eventually([&] {
        return asked("pallax_rsrp_dbm").find("\"system\":\"LTE\"},\"value\":[") !=
               std::string::npos;
    })) << asked("pallax_rsrp_dbm")
        << doubles::contentOf(world.path("collector.log"));
    EXPECT_NE(asked("up").find("\"job\":\"phone\"},\"value\":["), std::string::npos) << asked("up");
    EXPECT_NE(asked("pallax_cell_info").find("\"pci\":\""), std::string::npos);
    (void)doubles::runCommand("kill $(cat " + world.path("collector.pid") + ")");
    endsQuietly(web);
}

} // namespace
} // namespace pallax
