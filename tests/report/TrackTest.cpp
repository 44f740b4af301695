#include "report/Track.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

Bytes bytesOf(std::string_view text) {
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

std::string gpx(const std::string& points) {
    return "<?xml version=\"1.0\"?><gpx version=\"1.1\"><trk><trkseg>" + points +
           "</trkseg></trk></gpx>";
}

std::string point(const std::string& place, const std::string& time) {
    return "<trkpt " + place + "><ele>80</ele><time>" + time + "</time></trkpt>";
}

TEST(Track, HasThePointsWithATimeInTheirOrder) {
    const auto track =
        parseTrack(bytesOf(gpx(point(R"(lat="50.5" lon="7.25")", "2023-11-14T22:13:22.750Z") +
                               point(R"(lat="50.25" lon="7")", "2023-11-14T22:13:20Z") +
                               R"(<trkpt lat="50" lon="7"></trkpt>)" +
                               point(R"(lat="91" lon="7")", "2023-11-14T22:13:21Z") +
                               point(R"(lat="50" lon="7")", "yesterday"))));
    ASSERT_TRUE(track);
    ASSERT_EQ(track->size(), 2U);
    EXPECT_EQ((*track)[0].time, Time(std::chrono::seconds(1'700'000'000)));
    EXPECT_EQ((*track)[0].latitude, 50.25);
    EXPECT_EQ((*track)[0].longitude, 7);
    EXPECT_EQ((*track)[1].time, Time(std::chrono::seconds(1'700'000'002)));
    EXPECT_EQ((*track)[1].latitude, 50.5);
}

TEST(Track, LeavesOutTimesThatNoRecordingHas) {
    const std::string place = R"(lat="50.5" lon="7.25")";
    // Its nanoseconds would wrap round to a time in range.
    EXPECT_EQ(parseTrack(bytesOf(gpx(point(place, "3313-11-14T22:13:22Z")))).error(),
              "it has no points with a time");
    EXPECT_EQ(parseTrack(bytesOf(gpx(point(place, "1969-12-31T23:59:59Z")))).error(),
              "it has no points with a time");
    EXPECT_EQ(parseTrack(bytesOf(gpx(point(place, "1970-01-01T00:00:00Z"))))->size(), 1U);
}

TEST(Track, RefusesWhatIsNone) {
    EXPECT_EQ(parseTrack(bytesOf("no xml")).error(), "it is no XML");
    EXPECT_EQ(parseTrack(bytesOf("<kml/>")).error(), "it is no GPX file");
    EXPECT_EQ(parseTrack(bytesOf(gpx(""))).error(), "it has no points with a time");
}

TEST(Track, DoesNotFollowElementsWithoutEnd) {
    std::string deep;
    for (int i = 0; i < 1000; ++i) {
        deep += "<a>";
    }
    EXPECT_EQ(parseTrack(bytesOf("<gpx>" + deep + "</gpx>")).error(), "it is no XML");
    std::string closed = deep + point(R"(lat="1" lon="1")", "2023-11-14T22:13:20Z");
    for (int i = 0; i < 1000; ++i) {
        closed += "</a>";
    }
    EXPECT_EQ(parseTrack(bytesOf("<gpx>" + closed + "</gpx>")).error(),
              "it has no points with a time");
}

TEST(Track, ReadsAnyBytes) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string whole = gpx(point(R"(lat="50.5" lon="7.25")", "2023-11-14T22:13:22Z"));
        std::string text = whole.substr(
            0, static_cast<std::size_t>(doubles::any::between(0, static_cast<int>(whole.size()))));
        (void)parseTrack(bytesOf(text));
        for (const std::uint8_t byte : doubles::any::bytesBelow(256, 40)) {
            text += static_cast<char>(byte);
        }
        (void)parseTrack(bytesOf(text));
    }));
}

} // namespace
} // namespace pallax
