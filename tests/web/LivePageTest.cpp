#include "web/LivePage.h"

#include "tests/timeline/TimelineFixture.h"
#include "web/JsonPatch.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using nlohmann::json;

class LivePageTest : public testing::Test {
protected:
    LivePageTest() { recorded.drive(7, 20s); }

    WebResponse get(const std::string& path, const WebRequest::Fields& query = {}) {
        return page.answer({.method = "GET", .path = path, .query = query});
    }
    WebResponse series(const std::string& ids, const std::string& from, const std::string& to,
                       const std::string& points) {
        return get("/api/series", {{"ids", ids}, {"from", from}, {"to", to}, {"points", points}});
    }
    void show(Timeline& timeline) {
        data.begin(&timeline);
        (void)data.follow([] { return true; });
    }

    TimelineFixture recorded{"lte"};
    NetworkNames names;
    QualityProfile profile = *builtInProfile(kDefaultProfile);
    LiveData data{{names,
                   profile,
                   recorded.resources,
                   {.title = "", .recording = "<script>", .technology = "", .version = "1"}}};
    std::size_t viewers = 0;
    LivePage page{{data, [this] { return SessionCounts{.packets = 7, .viewers = viewers}; }}};
};

TEST_F(LivePageTest, ThePageHasAPolicyThatNoFrameAndNoForeignScriptPasses) {
    const WebResponse answer = get("/");
    EXPECT_EQ(answer.status, 200U);
    EXPECT_EQ(answer.type, "text/html; charset=utf-8");
    EXPECT_TRUE(answer.content->starts_with("<!doctype html>"));
    ASSERT_EQ(answer.headers.size(), 1U);
    EXPECT_EQ(answer.headers[0].first, "Content-Security-Policy");
    const std::string& policy = answer.headers[0].second;
    EXPECT_TRUE(policy.starts_with("default-src 'none'; script-src 'sha256-")) << policy;
    for (const char* part : {"; base-uri 'none'", "; form-action 'none'", "; connect-src 'self'",
                             "; frame-ancestors 'none'"}) {
        EXPECT_NE(policy.find(part), std::string::npos) << part << policy;
    }
    EXPECT_EQ(policy.find("unsafe"), std::string::npos) << policy;
}

TEST_F(LivePageTest, PathsAreFixedNames) {
    for (const char* path : {"", "//", "/index.html", "/api", "/api/", "/api/figures/",
                             "/API/figures", "/../etc/passwd", "/etc/passwd", "/favicon.ico"}) {
        EXPECT_EQ(get(path).status, 404U) << path;
    }
}

TEST_F(LivePageTest, DataAreJsonWithTheTextsAsTheyAre) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    const WebResponse figures = get("/api/figures");
    EXPECT_EQ(figures.type, "application/json");
    EXPECT_EQ(json::parse(*figures.content)["head"]["recording"], "<script>");
    const WebResponse state = get("/api/state", {{"at", "1700000005.5"}});
    EXPECT_EQ(state.type, "application/json");
    EXPECT_EQ(json::parse(*state.content)["tick"], 2);
    const WebResponse drawn = series("1,2", "0", "2e9", "10");
    EXPECT_EQ(drawn.type, "application/json");
    EXPECT_EQ(json::parse(*drawn.content)["values"].size(), 2U);
}

TEST_F(LivePageTest, ATimeOfTheFiguresIsThatOfItsTick) {
    const auto timeline = recorded.indexed();
    show(*timeline);
    data.settle();
    const std::string to = json::parse(*get("/api/figures").content)["head"]["to"].dump();
    EXPECT_EQ(json::parse(*get("/api/state", {{"at", to}}).content)["tick"], 10);
    const WebResponse drawn = series("1", to, to, "2");
    EXPECT_EQ(json::parse(*drawn.content)["times"].dump(), "[" + to + "]");
}

TEST_F(LivePageTest, SeveralSeriesAreAskedForAtOnce) {
    const std::string ids = "1,2,1,5,7,3,11,6,13,1024,4294967295";
    const WebResponse drawn = series(ids, "1700000002.006", "1700000318.006", "672");
    EXPECT_EQ(drawn.status, 200U) << *drawn.content;
    EXPECT_EQ(json::parse(*drawn.content)["values"].size(), 11U);
}

TEST_F(LivePageTest, AWrongArgumentIsNamed) {
    EXPECT_EQ(*get("/api/state").content, "The argument \"at\" is missing or wrong.\n");
    for (const char* at : {"", "x", "1 ", "nan", "inf", "-inf", "1e300", "0x10", "+1"}) {
        EXPECT_EQ(get("/api/state", {{"at", at}}).status, 400U) << at;
    }
    for (const char* ids : {"x", "-1", "1;2", "4294967296", " 1", ",1"}) {
        EXPECT_EQ(*series(ids, "0", "1", "1").content,
                  "The argument \"ids\" is missing or wrong.\n")
            << ids;
    }
    EXPECT_EQ(*series("", "x", "1", "1").content, "The argument \"from\" is missing or wrong.\n");
    EXPECT_EQ(*series("", "0", "", "1").content, "The argument \"to\" is missing or wrong.\n");
    for (const char* points : {"", "-1", "50001", "1.5"}) {
        EXPECT_EQ(*series("", "0", "1", points).content,
                  "The argument \"points\" is missing or wrong.\n")
            << points;
    }
    EXPECT_EQ(*get("/api/state", {{"at", "1"}, {"stretch", "x"}}).content,
              "The argument \"stretch\" is missing or wrong.\n");
    std::string many = "1";
    for (int count = 0; count < 2000; ++count) {
        many += ",1";
    }
    EXPECT_EQ(series(many, "0", "1", "1").status, 400U);
    EXPECT_EQ(get("/api/state", {{"at", "1"}}).status, 404U) << "nothing has come yet";
}

TEST_F(LivePageTest, AStreamBeginsWithEverythingAndGoesOnWithWhatChanges) {
    Timeline timeline(recorded.journal, recorded.source());
    std::uint64_t most = 400;
    const auto part = [&most, &timeline] { return timeline.packets() < most; };
    (void)timeline.index(part);
    show(timeline);
    page.setWords("No telephony service is running");
    const std::string figures = *get("/api/figures").content;
    const WebResponse stream = get("/api/events");
    const std::string begin =
        "event: figures\ndata: " + figures +
        "\n\nevent: words\ndata: {\"text\":\"No telephony service is running\"}\n\n";
    EXPECT_TRUE(stream.isStream);
    EXPECT_EQ(stream.type, "text/event-stream");
    EXPECT_EQ(*stream.content, begin);
    viewers = 1;
    EXPECT_NE(page.news(), nullptr) << "the words";
    EXPECT_EQ(page.news(), nullptr);
    page.setWords("");
    EXPECT_EQ(*page.news(), "event: words\ndata: {\"text\":\"\"}\n\n");
    const PropertyList before = data.figures();
    most = 600;
    (void)timeline.index(part);
    (void)data.follow([] { return true; });
    (void)get("/api/figures"); // takes nothing away from the streams
    EXPECT_TRUE(get("/api/events").content->starts_with("event: figures\ndata: " + figures + "\n"))
        << "what the other streams have: the same patch goes to all";
    EXPECT_EQ(*page.news(), "event: patch\ndata: " + jsonPatch(before, data.figures()) + "\n\n");
    EXPECT_EQ(page.news(), nullptr);
}

TEST_F(LivePageTest, TheFirstStreamBeginsWithTheLatest) {
    Timeline timeline(recorded.journal, recorded.source());
    (void)timeline.index([&timeline] { return timeline.packets() < 400; });
    show(timeline);
    (void)get("/api/events");
    (void)timeline.index([] { return true; });
    (void)data.follow([] { return true; });
    EXPECT_TRUE(
        get("/api/events")
            .content->starts_with("event: figures\ndata: " + *get("/api/figures").content + "\n"));
    EXPECT_EQ(page.news(), nullptr);
}

TEST_F(LivePageTest, MetricsHaveTheFormThatIsAskedFor) {
    const auto answer = [this](const WebRequest::Fields& headers) {
        return page.answer({.method = "GET", .path = "/metrics", .headers = headers});
    };
    EXPECT_EQ(answer({}).type, "text/plain; version=0.0.4; charset=utf-8");
    EXPECT_NE(answer({}).content->find("\npallax_packets_total 7\n"), std::string::npos);
    const WebResponse open = answer({{"accept", "application/openmetrics-text"}});
    EXPECT_EQ(open.type, "application/openmetrics-text; version=1.0.0; charset=utf-8");
    EXPECT_TRUE(open.content->ends_with("# EOF\n"));
    const auto timeline = recorded.indexed();
    show(*timeline);
    EXPECT_NE(answer({}).content->find("\npallax_rsrp_dbm{system=\"LTE\"} -"), std::string::npos);
}

} // namespace
} // namespace pallax
