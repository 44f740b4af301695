#include "timeline/Series.h"

#include "timeline/ValueReader.h"

#include <algorithm>
#include <functional>
#include <map>
#include <optional>

namespace pallax {

namespace {

/// Gives the readings of one field, in all entries.
class FieldReader final : public ValueReader {
public:
    using Take =
        std::function<void(const SamplePacket& packet, EntryId entry, const FieldValue& value)>;

    FieldReader(Timeline& timeline, FieldIndex field, Take take)
        : ValueReader(timeline), _field(field), _take(std::move(take)) {}

private:
    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override {
        if (field == _field) {
            _take(packet(), entry, value);
        }
    }

    FieldIndex _field;
    Take _take;
};

/// Up to this number of packets, buckets are read from the packets themselves.
constexpr std::uint64_t kMostDecoded = 16384;

bool isInOneStretch(const Timeline& timeline, std::uint64_t from, std::uint64_t to) {
    return std::none_of(
        timeline.stretches().begin(), timeline.stretches().end(),
        [&](const Stretch& each) { return each.firstPacket > from && each.firstPacket <= to; });
}

/// The borders of buckets with the same number of packets.
std::vector<std::uint64_t> evenBorders(std::uint64_t from, std::uint64_t end, std::size_t count) {
    std::vector<std::uint64_t> borders;
    const std::uint64_t packets = end - from;
    for (std::size_t index = 0; index < count; ++index) {
        borders.push_back(from + packets / count * index + packets % count * index / count);
    }
    return borders;
}

/// For ascending times of numbered packets: which begin one of `count` equal parts of the time.
class EvenTimes {
public:
    EvenTimes(Time first, Time last, std::size_t count)
        : _first(first), _span(std::chrono::duration<double>(last - first)), _count(count) {}

    /// Whether the packet begins a part. Times may step back a little; parts do not.
    bool begins(Time time) {
        const double share =
            _span.count() > 0 ? std::chrono::duration<double>(time - _first) / _span : 0.0;
        const auto part = static_cast<std::size_t>(
            std::clamp(share * static_cast<double>(_count), 0.0, static_cast<double>(_count - 1)));
        if (part < _next) {
            return false;
        }
        _next = part + 1;
        return true;
    }

private:
    Time _first;
    std::chrono::duration<double> _span;
    std::size_t _count;
    std::size_t _next = 0;
};

struct Stamp {
    std::uint64_t packet;
    Time time;
};

std::vector<Stamp> stampsOf(const Timeline& timeline, std::uint64_t from, std::uint64_t to) {
    std::vector<Stamp> stamps;
    const auto reader = timeline.journal().reader(from);
    for (auto packet = reader->next(); packet && packet->number <= to; packet = reader->next()) {
        stamps.push_back({packet->number, packet->time});
    }
    return stamps;
}

std::vector<std::uint64_t> bordersOf(const std::vector<Stamp>& stamps, bool isByTime,
                                     std::uint64_t end, std::size_t count) {
    std::vector<std::uint64_t> borders;
    if (isByTime) {
        EvenTimes parts(stamps.front().time, stamps.back().time, count);
        for (const Stamp& stamp : stamps) {
            if (parts.begins(stamp.time)) {
                borders.push_back(stamp.packet);
            }
        }
    } else {
        for (const std::uint64_t border : evenBorders(0, stamps.size(), count)) {
            borders.push_back(stamps[border].packet);
        }
        borders.erase(std::unique(borders.begin(), borders.end()), borders.end());
    }
    borders.push_back(end);
    return borders;
}

/// Each entry with its buckets; by default, those that have values.
std::vector<EntryBuckets> decodedBuckets(Timeline& timeline, FieldIndex field,
                                         const std::vector<Stamp>& stamps, std::size_t count,
                                         std::optional<EntryId> only) {
    const std::uint64_t from = stamps.front().packet;
    const std::uint64_t to = stamps.back().packet;
    const auto borders = bordersOf(stamps, isInOneStretch(timeline, from, to), to + 1, count);
    std::vector<Bucket> empty;
    for (std::size_t index = 0; index + 1 < borders.size(); ++index) {
        empty.push_back({borders[index], borders[index + 1], stamps[borders[index] - from].time});
    }
    std::map<EntryId, std::vector<Bucket>> ofEntries;
    if (only) {
        ofEntries.emplace(*only, empty);
    }
    std::size_t bucket = 0;
    FieldReader reader(timeline, field,
                       [&](const SamplePacket& packet, EntryId entry, const FieldValue& value) {
                           while (empty[bucket].to <= packet.number) {
                               ++bucket;
                           }
                           if (!only || entry == *only) {
                               auto& buckets = ofEntries.try_emplace(entry, empty).first->second;
                               buckets[bucket].add(timeline.seriesValueOf(value));
                           }
                       });
    (void)timeline.read(from, to, reader);
    std::vector<EntryBuckets> all;
    all.reserve(ofEntries.size());
    for (auto& [entry, buckets] : ofEntries) {
        all.push_back({entry, std::move(buckets)});
    }
    return all;
}

/// The borders of buckets that the timeline's reduction can answer.
std::vector<std::uint64_t> keptBorders(const Timeline& timeline, std::uint64_t from,
                                       std::uint64_t to, std::size_t count) {
    const SeriesStore& store = timeline.series();
    std::vector<Stamp> cells;
    for (std::uint64_t packet = store.cellStart(from); packet <= to; packet += store.cellSize()) {
        cells.push_back({packet, store.cellTime(packet)});
    }
    return bordersOf(cells, isInOneStretch(timeline, from, to),
                     cells.back().packet + store.cellSize(), count);
}

} // namespace

std::vector<SeriesPoint> readSeries(Timeline& timeline, FieldIndex field, EntryId entry,
                                    std::uint64_t from, std::uint64_t to,
                                    const MayContinue& mayContinue) {
    std::vector<SeriesPoint> points;
    FieldReader reader(timeline, field,
                       [&](const SamplePacket& packet, EntryId ofEntry, const FieldValue& value) {
                           if (ofEntry == entry) {
                               points.push_back({packet.number, packet.time, value});
                           }
                       });
    (void)timeline.read(from, to, reader, mayContinue);
    return points;
}

std::vector<Bucket> readBuckets(Timeline& timeline, FieldIndex field, EntryId entry,
                                std::uint64_t from, std::uint64_t to, std::size_t count) {
    from = std::max<std::uint64_t>(from, 1);
    to = std::min(to, timeline.packets());
    if (from > to || count == 0) {
        return {};
    }
    if (to - from >= kMostDecoded) {
        return timeline.series().buckets(field, entry, keptBorders(timeline, from, to, count));
    }
    const std::vector<Stamp> stamps = stampsOf(timeline, from, to);
    return stamps.empty() ? std::vector<Bucket>()
                          : decodedBuckets(timeline, field, stamps, count, entry).front().buckets;
}

std::vector<EntryBuckets> readBucketsOfEntries(Timeline& timeline, FieldIndex field,
                                               std::size_t count) {
    const std::uint64_t from = timeline.firstInstant() + 1;
    const std::uint64_t to = timeline.packets();
    if (from > to || count == 0) {
        return {};
    }
    if (to - from < kMostDecoded) {
        const std::vector<Stamp> stamps = stampsOf(timeline, from, to);
        return stamps.empty() ? std::vector<EntryBuckets>()
                              : decodedBuckets(timeline, field, stamps, count, std::nullopt);
    }
    const SeriesStore& store = timeline.series();
    const auto borders = keptBorders(timeline, from, to, count);
    std::vector<EntryBuckets> all;
    for (const EntryId entry : store.entriesOf(field)) {
        all.push_back({entry, store.buckets(field, entry, borders)});
    }
    if (all.empty()) {
        all.push_back({kNoEntry, store.buckets(field, kNoEntry, borders)});
    }
    return all;
}

} // namespace pallax
