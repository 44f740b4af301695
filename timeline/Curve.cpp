#include "timeline/Curve.h"

#include "timeline/Series.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

constexpr std::chrono::seconds kLeastGap{10}; // many fields are read less often than once a second

Curve decodedCurve(Timeline& timeline, FieldIndex field, EntryId entry, const CurveWindow& window) {
    Curve curve;
    for (const SeriesPoint& point :
         readSeries(timeline, field, entry, window.firstPacket, window.lastPacket)) {
        const double number = point.value.number;
        if (std::isfinite(number)) {
            curve.points.push_back({point.time, number, number, number, number});
        }
    }
    return curve;
}

/// One point for each cell of the timeline's reduction.
Curve keptCurve(const Timeline& timeline, FieldIndex field, EntryId entry,
                const CurveWindow& window) {
    const SeriesStore& store = timeline.series();
    std::vector<std::uint64_t> borders;
    for (std::uint64_t packet = store.cellStart(window.firstPacket); packet <= window.lastPacket;
         packet += store.cellSize()) {
        borders.push_back(packet);
    }
    borders.push_back(borders.back() + store.cellSize());
    Curve curve;
    curve.isReduced = store.cellSize() > 1;
    for (const Bucket& bucket : store.buckets(field, entry, borders)) {
        const double least = bucket.least.number();
        const double most = bucket.most.number();
        if (std::isfinite(least) && std::isfinite(most)) {
            const double first = bucket.first.isNumber() ? bucket.first.number() : least;
            const double last = bucket.last.isNumber() ? bucket.last.number() : most;
            curve.points.push_back({std::max(bucket.time, window.from), first, least, most, last});
        }
    }
    return curve;
}

} // namespace

const Stretch* stretchWith(const Timeline& timeline, std::uint64_t packet) {
    const auto& all = timeline.stretches();
    const auto after = std::upper_bound(
        all.begin(), all.end(), packet,
        [](std::uint64_t wanted, const Stretch& stretch) { return wanted < stretch.firstPacket; });
    return after == all.begin() ? nullptr : &*(after - 1);
}

std::optional<Time> timeOf(const Timeline& timeline, std::uint64_t instant) {
    const auto packet = timeline.journal().reader(instant)->next();
    return packet && packet->number == instant ? std::optional(packet->time) : std::nullopt;
}

CurveWindow windowUntil(const Timeline& timeline, std::uint64_t instant,
                        std::optional<std::chrono::seconds> span) {
    instant = std::min(instant, timeline.packets());
    const Stretch* stretch = stretchWith(timeline, instant);
    const auto end = timeOf(timeline, instant);
    if (stretch == nullptr || !end) {
        return {};
    }
    CurveWindow window{stretch->firstPacket, instant, stretch->first, *end};
    if (span) {
        window.from = *end - *span;
        if (stretch->first < window.from) {
            window.firstPacket = timeline.instantIn(*stretch, window.from) + 1;
        }
    }
    window.firstPacket = std::max(window.firstPacket, timeline.firstInstant() + 1);
    return window;
}

Curve readCurve(Timeline& timeline, FieldIndex field, EntryId entry, const CurveWindow& window,
                std::size_t count) {
    if (window.firstPacket > window.lastPacket) {
        return {};
    }
    const std::uint64_t packets = window.lastPacket - window.firstPacket + 1;
    const std::uint64_t cells = packets / timeline.series().cellSize();
    Curve curve = timeline.series().cellSize() > 1 && cells < count
                      ? decodedCurve(timeline, field, entry, window)
                      : keptCurve(timeline, field, entry, window);
    const auto perPoint = (window.to - window.from) / std::max<std::uint64_t>(count, 1);
    curve.gap = std::max<std::chrono::nanoseconds>(kLeastGap, perPoint * 2);
    return curve;
}

const CurvePoint* pointAt(const Curve& curve, Time time) {
    const auto after =
        std::upper_bound(curve.points.begin(), curve.points.end(), time,
                         [](Time wanted, const CurvePoint& point) { return wanted < point.time; });
    return after == curve.points.begin() ? nullptr : &*(after - 1);
}

} // namespace pallax
