#pragma once

#include "timeline/Timeline.h"

#include <cstdint>
#include <vector>

namespace pallax {

/// One reading of a field.
struct SeriesPoint {
    std::uint64_t packet = 0;
    Time time;
    FieldValue value;
};

/// Every reading of a field in the packets from `from` up to and including `to`: of a field in
/// lists, those of one entry, wherever it stands. Decodes the packets again; `mayContinue` may stop
/// it, and the readings so far are returned.
std::vector<SeriesPoint> readSeries(Timeline& timeline, FieldIndex field, EntryId entry,
                                    std::uint64_t from, std::uint64_t to,
                                    const MayContinue& mayContinue = {});

/// The same readings in at most `count` ranges of packets that divide the time evenly or, where the
/// clock steps back between the packets, their number. Few packets are decoded again, with exact
/// borders. For many, the timeline's reduction answers without decoding, and borders move to the
/// next of its cells: the first and the last bucket may then contain up to a cell of packets before
/// `from` and after `to`. What a bucket says is exact for the packets that it names. Texts:
/// `Timeline::series`.
std::vector<Bucket> readBuckets(Timeline& timeline, FieldIndex field, EntryId entry,
                                std::uint64_t from, std::uint64_t to, std::size_t count);

/// The buckets of one entry.
struct EntryBuckets {
    EntryId entry = kNoEntry; ///< outside lists
    std::vector<Bucket> buckets;
};

/// The buckets of a field over all packets, as above, for each entry that has values. They are read
/// together: all have the same borders.
std::vector<EntryBuckets> readBucketsOfEntries(Timeline& timeline, FieldIndex field,
                                               std::size_t count);

} // namespace pallax
