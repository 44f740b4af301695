#pragma once

#include "text/Date.h"
#include "timeline/CurrentValues.h"

#include <bit>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

/// A value of a series in 8 bytes: a number, or the number of a text.
class SeriesValue {
public:
    SeriesValue() = default;
    /// Empty if it is not a number.
    static SeriesValue ofNumber(double number) {
        return std::isnan(number) ? SeriesValue()
                                  : SeriesValue(std::bit_cast<std::uint64_t>(number));
    }
    static SeriesValue ofText(std::uint32_t text) { return SeriesValue(kText | text); }

    bool isEmpty() const { return _bits == kText; }
    bool isNumber() const { return _bits < kText; }
    /// Not a number for a text.
    double number() const { return isNumber() ? std::bit_cast<double>(_bits) : NAN; }
    /// 0: no text.
    std::uint32_t text() const { return isNumber() ? 0 : static_cast<std::uint32_t>(_bits); }
    friend bool operator==(const SeriesValue& a, const SeriesValue& b) {
        return a._bits == b._bits || (a.isNumber() && b.isNumber() && a.number() == b.number());
    }

private:
    /// The high half of a text's bits, which are those of no number: as one, they would be "not a
    /// number", with the greatest bits.
    static constexpr std::uint64_t kText = 0xFFFFFFFF00000000;
    explicit SeriesValue(std::uint64_t bits) : _bits(bits) {}

    std::uint64_t _bits = kText;
};

/// What a series shows in a range of packets. `least` and `most` are of its numbers and empty if
/// there are none.
struct Bucket {
    std::uint64_t from = 0; ///< its first packet
    std::uint64_t to = 0;   ///< the packet after its last one
    Time time;              ///< of its first packet
    SeriesValue first = {};
    SeriesValue least = {};
    SeriesValue most = {};
    SeriesValue last = {};

    void add(const SeriesValue& value);
    /// Adds what a later range shows.
    void add(const Bucket& later);
    bool isEmpty() const { return first.isEmpty(); }
};

/// The texts of series, each once.
class SeriesTexts {
public:
    static constexpr std::size_t kMostTexts = 65536;
    static constexpr std::size_t kMostBytes = std::size_t{1} << 23U;

    SeriesTexts();
    /// From 1 on. Texts that do not fit any more are all "…".
    std::uint32_t numberOf(std::string_view text);
    const std::string& text(std::uint32_t number) const { return _texts[number]; }

private:
    std::deque<std::string> _texts;
    std::unordered_map<std::string_view, std::uint32_t> _numbers;
    std::size_t _bytes = 0;
};

/// A reduction of the series of every field and entry, for curves over long times. The packets are
/// divided into cells of the same size, and of each cell it keeps the first, least, greatest and
/// last value. When there are too many cells, pairs of them become one. It is exact: a bucket that
/// begins and ends with a cell has exactly the values of its packets.
class SeriesStore {
public:
    struct Limits {
        std::size_t cells = 4096;
        std::size_t runs = std::size_t{3} << 17U;
        std::size_t series = 65536;
    };

    SeriesStore() : SeriesStore(Limits{}) {}
    explicit SeriesStore(const Limits& limits) : _limits(limits) {}

    /// The packet whose values follow. Numbers must increase.
    void beginPacket(std::uint64_t number, Time time);
    void add(FieldIndex field, EntryId entry, const FieldValue& value);
    /// The same for each value of an entry.
    void add(const EntryValues& entry);

    /// The first packet of the cell that contains a packet.
    std::uint64_t cellStart(std::uint64_t packet) const {
        return ((packet - 1) >> _shift << _shift) + 1;
    }
    std::uint64_t cellSize() const { return std::uint64_t{1} << _shift; }
    /// The time of the first packet of the cell that contains a packet.
    Time cellTime(std::uint64_t packet) const;

    /// The buckets between the borders, which must ascend and be starts of cells, except the last,
    /// which may lie past the end. One less than there are borders; empty ones included.
    std::vector<Bucket> buckets(FieldIndex field, EntryId entry,
                                const std::vector<std::uint64_t>& borders) const;
    /// The entries for which a field has values.
    std::vector<EntryId> entriesOf(FieldIndex field) const;

    SeriesTexts& texts() { return _texts; }
    const SeriesTexts& texts() const { return _texts; }
    SeriesValue valueOf(const FieldValue& value);
    /// Whether series are missing because there are too many.
    bool isFull() const { return _isFull; }
    std::size_t runCount() const { return _runCount; }

private:
    /// Consecutive cells with the same values. If there is more than one cell, all values are
    /// equal, and each cell has one.
    struct Run {
        std::uint32_t from;
        std::uint32_t to;
        SeriesValue first;
        SeriesValue least;
        SeriesValue most;
        SeriesValue last;

        bool isConstant() const {
            return first == last && least == most && (least.isEmpty() || first == least);
        }
    };
    struct Series {
        FieldIndex field = 0;
        std::vector<Run> runs; ///< empty in `_plain`: there is none
    };

    /// Null if there is no room for another series.
    Series* seriesOf(FieldIndex field, EntryId entry);
    const Series* find(FieldIndex field, EntryId entry) const;
    void add(Series& series, const FieldValue& value);
    void add(Series& series, const SeriesValue& value);
    static void appendMerged(std::vector<Run>& runs, Run run);
    void halveCells();
    void halveCells(Series& series, std::vector<Run>& merged);

    Limits _limits;
    SeriesTexts _texts;
    unsigned _shift = 0;
    std::uint32_t _cell = 0;
    std::vector<Time> _times; ///< of the cells' first packets
    // The series stand where they are found: every step on the way to the latest run counts.
    std::vector<Series> _plain;                  ///< by field: outside lists
    std::vector<std::vector<Series>> _ofEntries; ///< by entry
    std::size_t _count = 0;
    std::size_t _runCount = 0;
    bool _isFull = false;
};

} // namespace pallax
