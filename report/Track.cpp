#include "report/Track.h"

#include "decoding/DisplayJson.h"
#include "report/PageData.h"

#include <pugixml.hpp>

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

constexpr double kMostLatitude = 90;
constexpr double kMostLongitude = 180;
constexpr int kDeepest = 8; ///< gpx, trk, trkseg, trkpt and any that a program puts around them

/// "2023-11-14T22:13:20.250Z": a fraction of a second is dropped. Nothing for a time that no
/// recording has; compared as seconds, because not every year can be one in nanoseconds.
std::optional<Time> timeIn(std::string text) {
    const std::size_t point = text.find('.');
    if (point != std::string::npos) {
        const std::size_t zone = text.find_first_not_of("0123456789", point + 1);
        text.erase(point, std::min(zone, text.size()) - point);
    }
    const auto date = parseIsoDate(text);
    const bool isInRange = date && *date >= dateOf(kEarliestTime) && *date <= dateOf(kLatestTime);
    return isInRange ? std::optional<Time>(*date) : std::nullopt;
}

std::string_view localName(std::string_view name) {
    return name.substr(name.rfind(':') + 1);
}

void addPoint(const pugi::xml_node& node, Track& track) {
    TrackPoint point;
    point.latitude = node.attribute("lat").as_double(NAN);
    point.longitude = node.attribute("lon").as_double(NAN);
    const bool isPlace =
        std::abs(point.latitude) <= kMostLatitude && std::abs(point.longitude) <= kMostLongitude;
    for (const pugi::xml_node& child : node.children()) {
        if (!isPlace || localName(child.name()) != "time") {
            continue;
        }
        if (const auto time = timeIn(child.text().get())) {
            point.time = *time;
            track.push_back(point);
            return;
        }
    }
}

void addPoints(const pugi::xml_node& node, int depth, Track& track) {
    for (const pugi::xml_node& child : node.children()) {
        if (localName(child.name()) == "trkpt") {
            addPoint(child, track);
        } else if (depth < kDeepest) {
            addPoints(child, depth + 1, track);
        }
    }
}

} // namespace

Result<Track, std::string> parseTrack(Bytes content) {
    pugi::xml_document document;
    if (!document.load_buffer(content.data(), content.size())) {
        return std::string("it is no XML");
    }
    if (localName(document.document_element().name()) != "gpx") {
        return std::string("it is no GPX file");
    }
    Track track;
    addPoints(document, 0, track);
    if (track.empty()) {
        return std::string("it has no points with a time");
    }
    std::stable_sort(track.begin(), track.end(),
                     [](const auto& one, const auto& other) { return one.time < other.time; });
    return track;
}

std::string pageTrack(const Track& track) {
    const std::size_t step = track.size() / kMostTrackPoints + 1;
    Array points;
    for (std::size_t index = 0; index < track.size(); index += step) {
        const TrackPoint& point = track[index];
        points.emplace_back(
            Array{PropertyList::integer(dateOf(point.time).time_since_epoch().count()),
                  PropertyList::real(point.latitude), PropertyList::real(point.longitude)});
    }
    std::string json;
    appendJson(json, PropertyList(std::move(points)));
    return pageElement("track", json);
}

} // namespace pallax
