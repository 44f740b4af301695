#pragma once

#include "monitor/TickGrid.h"
#include "packets/PacketJournal.h"
#include "query/CellFinder.h"
#include "timeline/EventFinder.h"
#include "timeline/Replay.h"
#include "timeline/SpanMaker.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// Which values a store keeps.
enum class Resolution {
    Tick,  ///< those that the display shows at its ticks
    Packet ///< every one that was read
};

/// "tick".
std::string_view wordOf(Resolution resolution);

/// A value for as long as it held in one serving cell.
struct Interval {
    /// The time of a value that several cells divide.
    enum class Part {
        Whole,    ///< no cell divides it
        First,    ///< the first part, which also has the time of all parts
        Continued ///< a later part
    };

    FieldIndex field = 0;
    EntryId entry = kNoEntry;
    FieldValue value;
    std::uint64_t packet = 0;
    Time start;
    std::chrono::milliseconds hold{0}; ///< between times in whole milliseconds
    std::optional<std::size_t> cell;   ///< among the cells that were found; nothing: unknown
    Part part = Part::Whole;
    std::chrono::milliseconds whole{0};
};

/// What the packets of a recording measure: intervals of values, events and cells. It decodes each
/// packet once, quietly.
class RecordingMeasurements final : private CurrentValues::Listener {
public:
    /// A level that was read longer ago is not known any more, at ticks. Of levels that tell the
    /// same, only the one that was read last is known.
    static constexpr std::chrono::seconds kLevelHolds{10};

    using Take = std::function<void(const Interval& interval)>;

    /// `take` gets the intervals in the order of their ends. What `source` names must outlive it.
    RecordingMeasurements(const DecodingSource& source, Resolution resolution, Take take);

    /// Takes the next packet. False if a record has thrown: nothing can be read after it, and the
    /// latest event tells why.
    bool add(const JournalPacket& packet);
    /// Ends all intervals. Call it once, after the last packet.
    void finish();

    const FieldTable& fields() const { return _fields; }
    const EntryTable& entries() const { return _entries; }
    std::size_t eventCount() const { return _events.size(); }
    /// Those that have happened since the last call.
    std::vector<Event> takeEvents() { return std::exchange(_events, {}); }
    const std::vector<FoundCell>& cells() const { return _cells.soFar(); }

private:
    /// From a packet on, this cell serves.
    struct Served {
        std::uint64_t packet;
        Time time;
        std::size_t cell;
    };

    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override;
    void valueRemoved(FieldIndex field) override;
    void listReplaced(ListId list) override;
    void noteStep(const JournalPacket& packet);
    void showTick(const TickGrid::Tick& tick);
    void findLevels(std::string_view technology);
    bool isKnown(FieldIndex field, const FieldValue& value, Time now) const;
    void noteServing(std::uint64_t packet, Time time);
    void handOut();
    void divide(const Span& span);

    KeptResources _resources;
    FieldTable _fields;
    EntryTable _entries;
    CurrentValues _values;
    Replay _replay;
    EventFinder _eventFinder;
    CellFinder _cells;
    SpanMaker _spans;
    TickGrid _grid;
    Resolution _resolution;
    Take _take;
    JournalPacket _packet;
    std::uint64_t _shown = 0; ///< the latest packet of the latest tick
    std::vector<SampleReader::Item> _items;
    bool _mayNameCell = false;
    std::vector<Served> _served;
    struct Level {
        bool isOne = false;
        std::vector<FieldIndex> others; ///< which tell the same of the serving cell
    };
    std::vector<Level> _levels; ///< by field
    std::vector<Event> _events;
};

} // namespace pallax
